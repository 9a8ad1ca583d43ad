#include "fuzz/web.h"

// Any file, as the importer takes it: by the first of the builders that accept its content.

void OvPhotometrics::fuzz::tryInput(std::string_view bytes) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(bytes);
    Ov::RnPhotoFormat* const format = recognisedFormat(*io);
    demand(io->seek(0, 1) == 0 && takeMessages() == 0, "the content tests leave no trace");
    if (format) tryFile(*format, bytes);
}
