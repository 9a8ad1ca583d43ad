#include "components/photo/lid/reportMessage.h"

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"
#include "host/componentManager/processController.h"

namespace OvPhotometrics {

namespace {

std::wstring lastMessage;

void post(std::wstring text) {
    lastMessage = std::move(text);
    const auto controller = Ov::rnCast<Ov::RnProcessController>(Ov::RnGetProcessController());
    controller->report(0, lastMessage.c_str());
}

/// The formatted text of a message, or its number without a catalogue.
std::wstring messageText(unsigned id, std::va_list args) {
    try {
        return Ov::messageFile().formatV(id, args);
    } catch (const Ov::RnMessageFileEx&) {
        return L"Message " + std::to_wstring(id) + L".";
    }
}

}  // namespace

void reportMessage(unsigned id, ...) {
    std::va_list args;
    va_start(args, id);
    std::wstring text = messageText(id, args);
    va_end(args);
    post(std::move(text));
}

void reportParseMessage(unsigned id, ...) {
    std::va_list args;
    va_start(args, id);
    const std::wstring detail = messageText(id, args);
    va_end(args);
    try {
        post(Ov::messageFile().format(messages::fileNotRead, detail.c_str()));
    } catch (const Ov::RnMessageFileEx&) {
        post(detail);
    }
}

}  // namespace OvPhotometrics
