#include "components/support/path.h"
#include "fuzz/web.h"

// Any file as one of a format, that of the folder OVPHOTO_FORMAT.

namespace OvPhotometrics::fuzz {

namespace {

std::string lowered(std::string text) {
    for (char& c : text)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return text;
}

Ov::RnPhotoFormat& formatOfFolder() {
    for (const auto& format : formats())
        if (lowered(Ov::toUtf8(format->getTraits().name)) == OVPHOTO_FORMAT) return *format;
    demand(false, "the folder's format is registered");
    std::abort();
}

}  // namespace

void tryInput(std::string_view bytes) {
    static Ov::RnPhotoFormat& format = formatOfFolder();
    tryFile(format, bytes);
}

}  // namespace OvPhotometrics::fuzz
