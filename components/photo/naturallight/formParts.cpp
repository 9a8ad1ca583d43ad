#include "components/photo/naturallight/formParts.h"

#include <string>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"

namespace OvPhotometrics {

namespace {

using Settings = Ov::NaturalLightSettings;

constexpr unsigned flag3Set = 0x100;
constexpr unsigned flag1Clear = 0x200;
constexpr unsigned flag2Clear = 0x400;

std::uint16_t flagWord(bool flag1, bool flag2, bool flag3) {
    return static_cast<std::uint16_t>((flag3 ? flag3Set : 0) | (flag1 ? 0 : flag1Clear) |
                                      (flag2 ? 0 : flag2Clear));
}

void setFlags(unsigned word, bool& flag1, bool& flag2, bool& flag3) {
    flag1 = (word & flag1Clear) == 0;
    flag2 = (word & flag2Clear) == 0;
    flag3 = (word & flag3Set) != 0;
}

}  // namespace

std::uint16_t sunFlagWord(const Settings& s) { return flagWord(s.sunCastsShadows, s.sunFlag2, s.sunFlag3); }
std::uint16_t skyFlagWord(const Settings& s) { return flagWord(s.skyCastsShadows, s.skyFlag2, s.skyFlag3); }
void setSunFlags(Settings& s, unsigned word) { setFlags(word, s.sunCastsShadows, s.sunFlag2, s.sunFlag3); }
void setSkyFlags(Settings& s, unsigned word) { setFlags(word, s.skyCastsShadows, s.skyFlag2, s.skyFlag3); }

void reportFormError(Ov::Message<> message, int line) {
    const Report report;
    const std::wstring detail = report.rawText(message);
    report.postWrapped(detail, messages::daylightLine, detail, line);
}

}  // namespace OvPhotometrics
