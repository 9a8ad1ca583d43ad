#include "components/photo/lid/reportMessage.h"

#include <chrono>

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

/// Whether there is a catalogue. One that is missing is looked for again a little later, not for each of the
/// thousands of faults that a file may have.
bool hasTexts() {
    using Clock = std::chrono::steady_clock;
    static std::wstring missing;
    static Clock::time_point again;
    const std::wstring& name = Ov::messageFile().fileName();
    if (name == missing && Clock::now() < again) return false;
    if (Ov::messageFile().isThere()) return true;
    missing = name;
    again = Clock::now() + std::chrono::milliseconds(10);
    return false;
}

/// The formatted text of a message, or its number without a catalogue.
std::wstring textOf(unsigned id, std::va_list args) {
    return hasTexts() ? Ov::messageFile().formatV(id, args) : L"Message " + std::to_wstring(id) + L".";
}

/// Posts a message that holds `detail`, or that alone without a catalogue.
void postWrapped(const std::wstring& detail, unsigned wrapper, std::va_list args) {
    post(hasTexts() ? Ov::messageFile().formatV(wrapper, args) : detail);
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
