#include "components/photo/lid/reportMessage.h"

#include "components/messageFile/messageStore.h"
#include "host/componentManager/processController.h"

namespace OvPhotometrics {

namespace {

std::wstring numberOf(unsigned id) { return L"Message " + std::to_wstring(id) + L"."; }

}  // namespace

std::wstring Report::formatted(unsigned id, std::initializer_list<Ov::MessageArgument> arguments) const {
    return _texts ? Ov::formatMessageV(_texts->text(id).c_str(), arguments) : numberOf(id);
}

std::wstring Report::rawText(Ov::Message<> message) const {
    return _texts ? _texts->text(message) : numberOf(message);
}

void Report::postText(const std::wstring& text) {
    constexpr int ordinary = 0;
    Ov::rnCast<Ov::RnProcessController>(Ov::RnGetThreadProcessController())->report(ordinary, text.c_str());
}

}  // namespace OvPhotometrics
