#pragma once

#include <memory>
#include <string>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"

namespace OvPhotometrics {

/// One report. It looks the catalogue up once, so that all texts in it come from there, or none does: then a message
/// is its number, "Message 12960.". Arguments are ints, doubles and wide strings, as the text of the message says.
///
/// Errors:   std::bad_alloc; ExBadCast in a host without a controller; what the host's reporter throws.
/// Threads:  any number; the host's controller is called on the reporting one, with a text that nobody else changes.
class Report {
public:
    /// The formatted text of a message.
    std::wstring text(unsigned id, ...) const;
    /// The text as the catalogue has it.
    std::wstring rawText(unsigned id) const;

    /// Posts a message to the host's reporter.
    void post(unsigned id, ...) const;
    /// Posts the message `wrapper` with its arguments, the text `detail` among them. Without a catalogue `detail`
    /// alone is posted, which tells more than the wrapper's number.
    void postWrapped(const std::wstring& detail, unsigned wrapper, ...) const;
    /// Posts what is wrong with a text: the message inside the general reading message.
    template <class... Arguments>
    void postParseMessage(unsigned id, Arguments... arguments) const {
        const std::wstring detail = text(id, arguments...);
        postWrapped(detail, messages::fileNotRead, detail.c_str());
    }

private:
    std::wstring textV(unsigned id, std::va_list args) const;

    std::shared_ptr<const Ov::RnMessageFile::Store> _texts = Ov::messageFile().store();
};

/// Posts one message.
template <class... Arguments>
void reportMessage(unsigned id, Arguments... arguments) {
    Report().post(id, arguments...);
}

/// Posts what is wrong with a text.
template <class... Arguments>
void reportParseMessage(unsigned id, Arguments... arguments) {
    Report().postParseMessage(id, arguments...);
}

}  // namespace OvPhotometrics
