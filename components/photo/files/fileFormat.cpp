#include "components/photo/files/fileFormat.h"

#include <cwchar>

#include "components/photo/lid/component.h"

namespace OvPhotometrics {

FileFormat* formatOf(Ov::RnComponentBuilder* builder) { return dynamic_cast<FileFormat*>(builder); }

FileFormat* recognise(Ov::RnBufferedIO& io) {
    FileFormat* first = nullptr;
    const wchar_t* firstName = nullptr;
    for (const auto& [classId, builder] : builderTable()) {
        FileFormat* const format = formatOf(builder);
        if (!format || (first && std::wcscmp(builder->getName(), firstName) > 0) || !format->recognises(io))
            continue;
        first = format;
        firstName = builder->getName();
    }
    return first;
}

}  // namespace OvPhotometrics
