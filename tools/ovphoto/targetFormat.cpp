#include "tools/ovphoto/targetFormat.h"

#include "components/support/path.h"

namespace OvTool {

namespace {

using Functions = OvPhotometrics::NumberedFunctions;

constexpr TargetFormat formats[] = {
    {"IES", "ies", &Functions::writeIes, false},
    {"CIBSE", "cib", &Functions::writeCibse, false},
    {"NIMB", "nmb", &Functions::writeNimb, true},
    {"TBT", "tbt", &Functions::writeTbt, true},
};

}  // namespace

std::span<const TargetFormat> targetFormats() { return formats; }

const TargetFormat* targetNamed(const std::string& name) {
    for (const TargetFormat& format : formats)
        if (name == format.name) return &format;
    return nullptr;
}

const TargetFormat* targetOf(const std::string& path) {
    std::string extension = Ov::toUtf8(Ov::widePath(Ov::nativePath(Ov::fromUtf8(path)).extension()));
    for (char& c : extension)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    for (const TargetFormat& format : formats)
        if (extension == std::string(".") + format.extension) return &format;
    return nullptr;
}

}  // namespace OvTool
