#pragma once

#include <CLI/CLI.hpp>
#include <string>

namespace OvTool {

struct OptionText {
    const char* name;
    const char* form;  // of its argument
    const char* help;
};

/// Declares an option. `parse` makes a value of its argument, or nothing, which is wrong usage; `take` gets the
/// value.
template <class Parse, class Take>
CLI::Option* addParsed(CLI::App& app, const OptionText& text, Parse parse, Take take) {
    const auto onText = [text, parse, take](const std::string& given) {
        const auto value = parse(given);
        if (!value) throw CLI::ValidationError(text.name, "'" + given + "' is no valid " + text.form);
        take(*value);
    };
    return app.add_option_function<std::string>(text.name, onText, text.help)->type_name(text.form);
}

}  // namespace OvTool
