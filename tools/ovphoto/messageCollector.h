#pragma once

#include <string>
#include <utility>
#include <vector>

#include "host/componentManager/processController.h"
#include "host/platform/path.h"

namespace OvTool {

/// Collects what is reported while it lives.
class MessageCollector {
public:
    explicit MessageCollector(std::vector<std::string>& messages)
        : _previous(Ov::setMessageReporter(
              [&messages](int, const wchar_t* text) { messages.push_back(Ov::toUtf8(text ? text : L"")); })) {}
    MessageCollector(const MessageCollector&) = delete;
    MessageCollector& operator=(const MessageCollector&) = delete;
    ~MessageCollector() { Ov::setMessageReporter(std::move(_previous)); }

private:
    Ov::MessageReporter _previous;
};

}  // namespace OvTool
