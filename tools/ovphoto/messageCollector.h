#pragma once

#include <string>
#include <utility>
#include <vector>

#include "components/support/path.h"
#include "host/componentManager/processController.h"

namespace OvTool {

/// Collects what is reported while it lives.
class MessageCollector {
public:
    explicit MessageCollector(std::vector<std::string>& messages) : MessageCollector(messages, [] {}) {}
    /// `also` runs with each report, where the library makes it.
    template <class Also>
    MessageCollector(std::vector<std::string>& messages, Also also)
        : _previous(Ov::setMessageReporter([&messages, also](int, const wchar_t* text) {
              messages.push_back(Ov::toUtf8(text ? text : L""));
              also();
          })) {}
    MessageCollector(const MessageCollector&) = delete;
    MessageCollector& operator=(const MessageCollector&) = delete;
    ~MessageCollector() { Ov::setMessageReporter(std::move(_previous)); }

private:
    Ov::MessageReporter _previous;
};

}  // namespace OvTool
