#include "host/componentManager/builder.h"

#include <string>

#include "components/support/file.h"
#include "components/support/path.h"
#include "host/componentManager/streamEx.h"

namespace Ov {

RnRefPtr<RnComponentBuilder> RnComponentBuilder::getBuilder() { return RnRefPtr<RnComponentBuilder>::share(this); }

RnCRefPtr<RnComponentBuilder> RnComponentBuilder::getBuilder() const {
    return RnCRefPtr<RnComponentBuilder>::share(this);
}

bool RnImportBuilder::canImport(const wchar_t* path, const wchar_t*) {
    const RnRef<RnBufferedIO> io = openInputFile(path);
    return io && canImport(io.get());
}

RnRef<RnCastable> RnImportBuilder::import(const wchar_t* path, const wchar_t* basePath) {
    const RnRef<RnBufferedIO> io = openInputFile(path);
    if (!io) {
        throw RnStreamEx::ExReadError("host/componentManager/builder", __LINE__, openFailure(path).c_str());
    }
    const std::wstring folder = basePath && *basePath ? basePath : pathFolder(path);
    return import(io.get(), pathStem(path).c_str(), folder.c_str());
}

}  // namespace Ov
