#include "components/photo/lid/reportMessage.h"

#include "components/messageFile/messageStore.h"
#include "host/componentManager/processController.h"

namespace OvPhotometrics {

namespace {

std::wstring numberOf(unsigned id) { return L"Message " + std::to_wstring(id) + L"."; }

void postText(const std::wstring& text) {
    constexpr int ordinary = 0;
    Ov::rnCast<Ov::RnProcessController>(Ov::RnGetThreadProcessController())->report(ordinary, text.c_str());
}

}  // namespace

std::wstring Report::textV(unsigned id, std::va_list args) const {
    return _texts ? Ov::formatMessageV(_texts->text(id).c_str(), args) : numberOf(id);
}

std::wstring Report::text(unsigned id, ...) const {
    std::va_list args;
    va_start(args, id);
    std::wstring result = textV(id, args);
    va_end(args);
    return result;
}

std::wstring Report::rawText(unsigned id) const { return _texts ? _texts->text(id) : numberOf(id); }

void Report::post(unsigned id, ...) const {
    std::va_list args;
    va_start(args, id);
    const std::wstring text = textV(id, args);
    va_end(args);
    postText(text);
}

void Report::postWrapped(const std::wstring& detail, unsigned wrapper, ...) const {
    if (!_texts) return postText(detail);
    std::va_list args;
    va_start(args, wrapper);
    const std::wstring text = textV(wrapper, args);
    va_end(args);
    postText(text);
}

}  // namespace OvPhotometrics
