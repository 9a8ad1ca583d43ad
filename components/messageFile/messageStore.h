#pragma once

#include <memory>
#include <string>

#include "components/messageFile/message.h"

namespace Ov {

/// An open companion file. Each platform has its own: message_<platform>.cpp.
class RnMessageFile::Store {
public:
    /// Opens the companion of the language set in the host, or the companion itself; null when neither is a
    /// whole catalogue. The file is not watched: to replace it while it is open, rename another over it.
    static std::unique_ptr<Store> open(const std::wstring& fileName);

    Store(const Store&) = delete;
    Store& operator=(const Store&) = delete;
    ~Store();

    /// The text of a message, empty when there is none.
    std::wstring text(unsigned id) const;

private:
    explicit Store(void* catalogue) : _catalogue(catalogue) {}

    void* _catalogue;
};

}  // namespace Ov
