#include "fuzz/web.h"

// Any file, as the importer takes it: by the first of the builders that accept its content.

namespace OvPhotometrics::fuzz {

namespace {

template <class Format>
void tryFileOf(const Ov::RnUid& classId, std::string_view bytes) {
    if (classId == Format::info.classId) tryFile<Format>(bytes);
}

}  // namespace

void tryInput(std::string_view bytes) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(bytes);
    const auto classId = recognisedAs(*io);
    demand(io->seek(0, 1) == 0 && takeMessages() == 0, "the content tests leave no trace");
    tryFileOf<CibseFormat>(classId, bytes);
    tryFileOf<IesFormat>(classId, bytes);
    tryFileOf<NimbFormat>(classId, bytes);
    tryFileOf<TbtFormat>(classId, bytes);
}

}  // namespace OvPhotometrics::fuzz
