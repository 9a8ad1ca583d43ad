#pragma once

#include <initializer_list>
#include <memory>
#include <mutex>
#include <string>

#include "components/messageFile/typedMessage.h"
#include "host/base/exBase.h"

namespace Ov {

/// The catalogue of numbered message texts. Texts live in a companion file beside the module, so that a language
/// pack replaces them without touching the module.
///
/// Formatting language of the texts:
///   "%%", "%!", "%.", "% "   the second character alone
///   "%1" to "%99"            the argument of that number, a wide string
///   "%1!5.2f!"               the same, printed with flags, width, precision and letter of printf; letters
///                            d i u o x c C X (32 bits; with h, 16 bits), e f g E G (double), s (flags unused)
///   A text without markers stands as it is, escapes included. Numbers run from 1 to the highest without gaps or
///   repeats, and an argument is of the kind that its letter prints; anything else gives "MALFORMED FORMATTING
///   STRING: " and the text.
///
/// Errors:   RnMessageFileEx before a file name is set or when the file cannot be opened; a number without a text
///           gives the empty text.
/// Threads:  any number may look up and set the file at once; a lookup uses the file that it found to its end.
class RnMessageFile {
public:
    RnMessageFile();
    RnMessageFile(const RnMessageFile&) = delete;
    RnMessageFile& operator=(const RnMessageFile&) = delete;
    ~RnMessageFile();

    /// Sets the companion file; the next lookup opens it, or the one of the language set in the host
    /// (<folder>/<language>/<file>) where that exists. A file opened before is closed.
    void setFileName(const wchar_t* path);
    std::wstring fileName() const;

    class Store;
    /// The open companion (messageStore.h), which stays open as long as it is held; null when there is none.
    std::shared_ptr<const Store> store();
    /// The raw text of a message.
    std::wstring getText(unsigned id);
    /// The text with its arguments put in.
    template <class... Arguments>
    std::wstring format(unsigned id, const Arguments&... arguments);

private:
    mutable std::mutex _lock;  // of all below
    std::wstring _fileName;
    std::shared_ptr<const Store> _store;
};

/// The formatting language on its own. Arguments that a text does not ask for are left out.
std::wstring formatMessageV(const wchar_t* text, std::initializer_list<MessageArgument> arguments);
template <class... Arguments>
std::wstring formatMessage(const wchar_t* text, const Arguments&... arguments) {
    return formatMessageV(text, {messageArgument(arguments)...});
}

template <class... Arguments>
std::wstring RnMessageFile::format(unsigned id, const Arguments&... arguments) {
    return formatMessage(getText(id).c_str(), arguments...);
}

/// A message cannot be looked up. Also caught as std::runtime_error.
class RnMessageFileEx : public ExBase, public std::runtime_error {
public:
    RnMessageFileEx(const std::string& reason, int line);
    ~RnMessageFileEx() override;
    std::string getDetailedReason() const override;

    class ExNoFilename;
    class ExNoCatalogue;
};

class RnMessageFileEx::ExNoFilename : public RnMessageFileEx {
public:
    ExNoFilename();
    ~ExNoFilename() override;
};

class RnMessageFileEx::ExNoCatalogue : public RnMessageFileEx {
public:
    explicit ExNoCatalogue(const std::wstring& fileName);
    ~ExNoCatalogue() override;
};

/// The library's one catalogue, which is never destroyed.
RnMessageFile& messageFile();

/// A text of it that takes no arguments, valid as long as the module is loaded. Errors and threads are those of
/// RnMessageFile.
const wchar_t* keptText(Message<> message);

/// Closes the catalogue, forgets its name and lets go of the kept texts: the module is about to be unloaded.
void releaseTexts();

}  // namespace Ov
