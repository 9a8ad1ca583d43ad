#pragma once

#include <memory>
#include <string>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"

namespace OvPhotometrics {

/// One report. It looks the catalogue up once, so that all texts in it come from there, or none does: then a message
/// is its number, "Message 12960.".
///
/// Errors:   std::bad_alloc; ExBadCast in a host without a controller; what the host's reporter throws.
/// Threads:  any number; the host's controller is called on the reporting one, with a text that nobody else changes.
class Report {
public:
    /// The formatted text of a message.
    template <class... Types>
    std::wstring text(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) const {
        return formatted(message, {arguments...});
    }
    /// The text as the catalogue has it.
    std::wstring rawText(Ov::Message<> message) const;

    /// Posts a message to the host's reporter.
    template <class... Types>
    void post(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) const {
        postText(formatted(message, {arguments...}));
    }
    /// Posts the message `wrapper` with its arguments, the text `detail` among them. Without a catalogue `detail`
    /// alone is posted, which tells more than the wrapper's number.
    template <class... Types>
    void postWrapped(const std::wstring& detail, Ov::Message<Types...> wrapper,
                     Ov::ArgumentFor<Types>... arguments) const {
        postText(_texts ? formatted(wrapper, {arguments...}) : detail);
    }
    /// Posts what is wrong with a text: the message inside the general reading message.
    template <class... Types>
    void postParseMessage(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) const {
        const std::wstring detail = formatted(message, {arguments...});
        postWrapped(detail, messages::fileNotRead, detail);
    }

private:
    std::wstring formatted(unsigned id, std::initializer_list<Ov::MessageArgument> arguments) const;
    static void postText(const std::wstring& text);

    std::shared_ptr<const Ov::RnMessageFile::Store> _texts = Ov::messageFile().store();
};

/// Posts one message.
template <class... Types>
void reportMessage(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) {
    Report().post(message, arguments...);
}

/// Posts what is wrong with a text.
template <class... Types>
void reportParseMessage(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) {
    Report().postParseMessage(message, arguments...);
}

}  // namespace OvPhotometrics
