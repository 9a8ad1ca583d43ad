#include "tools/ovphoto/language.h"

#include "host/sdk/util.h"

namespace OvTool {

const char* inLanguage(const char* english, const char* german) {
    return WendSDK::Util::language() == L"de" ? german : english;
}

}  // namespace OvTool
