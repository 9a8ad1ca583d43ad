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
std::wstring textOf(unsigned id, std::va_list args) {
    try {
        return Ov::messageFile().formatV(id, args);
    } catch (const Ov::RnMessageFileEx&) {
        return L"Message " + std::to_wstring(id) + L".";
    }
}

/// Posts a message that holds `detail`, or that alone without a catalogue.
void postWrapped(const std::wstring& detail, unsigned wrapper, std::va_list args) {
    try {
        post(Ov::messageFile().formatV(wrapper, args));
    } catch (const Ov::RnMessageFileEx&) {
        post(detail);
    }
}

}  // namespace

void reportMessage(unsigned id, ...) {
    std::va_list args;
    va_start(args, id);
    std::wstring text = textOf(id, args);
    va_end(args);
    post(std::move(text));
}

std::wstring messageText(unsigned id, ...) {
    std::va_list args;
    va_start(args, id);
    std::wstring text = textOf(id, args);
    va_end(args);
    return text;
}

void reportWrapped(const std::wstring& detail, unsigned wrapper, ...) {
    std::va_list args;
    va_start(args, wrapper);
    postWrapped(detail, wrapper, args);
    va_end(args);
}

void reportParseMessage(unsigned id, ...) {
    std::va_list args;
    va_start(args, id);
    const std::wstring detail = textOf(id, args);
    va_end(args);
    reportWrapped(detail, messages::fileNotRead, detail.c_str());
}

}  // namespace OvPhotometrics
