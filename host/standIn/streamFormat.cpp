#include <algorithm>
#include <cwchar>

#include "components/support/textFormat.h"
#include "host/standIn/arguments.h"
#include "host/standIn/streamState.h"

namespace Ov {

namespace {

void fetchWidth(Directive& directive, Arguments& arguments) {
    if (directive.widthIsArgument) {
        const int width = std::clamp(arguments.next<int>(), -maxFormatWidth, maxFormatWidth);
        directive.left |= width < 0;
        directive.width = width < 0 ? -width : width;
    }
    if (directive.precisionIsArgument) directive.precision = std::clamp(arguments.next<int>(), -1, maxFormatWidth);
}

/// Appends the next argument as its directive says; false for a letter that stands for no conversion.
bool appendArgument(std::wstring& out, Directive& directive, Arguments& arguments) {
    if (directive.modifier == L'L') return false;
    fetchWidth(directive, arguments);
    switch (directive.letter) {
        // Integers and characters.
        case L'd':
        case L'i':
        case L'u':
        case L'x':
        case L'X':
        case L'o':
        case L'c':
        case L'C':
            appendInteger(out, directive, arguments.next<int>());
            return true;
        // Numbers with a fraction.
        case L'e':
        case L'E':
        case L'f':
        case L'F':
        case L'g':
        case L'G':
            appendDouble(out, directive, arguments.next<double>());
            return true;
        case L's':
            appendText(out, directive, arguments.next<const wchar_t*>());
            return true;
        // The characters written so far, told to the caller.
        case L'n':
            *arguments.next<int*>() = static_cast<int>(out.size());
            return true;
        default:
            return false;
    }
}

/// Appends the text of a whole format. It ends before the first directive that is malformed.
void appendFormatted(std::wstring& out, const wchar_t* format, Arguments& arguments) {
    const wchar_t* const end = format + std::wcslen(format);
    while (format != end) {
        const wchar_t* percent = std::find(format, end, L'%');
        out.append(format, percent);
        if (percent == end) return;
        format = percent + 1;
        if (format != end && *format == L'%') {
            out.push_back(*format++);
            continue;
        }
        Directive directive;
        format = parseDirective(format, end, directive);
        if (!format || !appendArgument(out, directive, arguments)) return;
    }
}

}  // namespace

int RnStream::formattedWrite(const wchar_t* format, ...) {
    std::wstring& text = _state->text;
    text.clear();
    Arguments arguments;
    va_start(arguments.list, format);
    appendFormatted(text, format, arguments);
    va_end(arguments.list);
    return device().writeChars(text.data(), static_cast<int>(text.size()));
}

}  // namespace Ov
