#pragma once

#include <string>
#include <vector>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"
#include "host/componentManager/processController.h"
#include "host/sdk/util.h"
#include "tests/support/tempFolder.h"

/// Collects what is reported while it lives. Its catalogue answers each number with itself and its arguments, so
/// "12945 12960 1" is message 12945 around message 12960 with the argument 1.
class MessageLog {
public:
    MessageLog() {
        WendSDK::Util::setLanguage(L"");
        Ov::messageFile().setFileName(catalogue().c_str());
        _previous =
            Ov::setMessageReporter([this](int, const wchar_t* text) { _texts.push_back(Ov::toUtf8(text)); });
    }
    MessageLog(const MessageLog&) = delete;
    MessageLog& operator=(const MessageLog&) = delete;
    ~MessageLog() { Ov::setMessageReporter(_previous); }

    /// What was reported since the last call, joined by "; ".
    std::string take() {
        std::string all;
        for (const std::string& text : _texts) all += (all.empty() ? "" : "; ") + text;
        _texts.clear();
        return all;
    }

private:
    static std::wstring catalogue() {
        static const TempFolder folder;
        static const bool compiled = (compileCatalogue(folder.path() / "numbers", numbers()), true);
        return compiled ? folder.wide("numbers") : L"";
    }

    static std::string numbers() {
        std::string lines;
        for (const auto& message : OvPhotometrics::messages::all) {
            lines += std::to_string(message.id) + " " + std::to_string(message.id);
            int number = 0;
            for (const char* letter = message.arguments; *letter; ++letter)
                lines += " %" + std::to_string(++number) +
                         (*letter == 's'   ? ""
                          : *letter == 'f' ? "!g!"
                                           : std::string("!") + *letter + "!");
            lines += "\n";
        }
        return lines;
    }

    Ov::MessageReporter _previous;
    std::vector<std::string> _texts;
};
