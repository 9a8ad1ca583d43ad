#include <algorithm>
#include <cwchar>
#include <optional>
#include <string_view>
#include <variant>
#include <vector>

#include "components/messageFile/message.h"
#include "components/support/textFormat.h"

namespace Ov {

namespace {

/// Literal text and the marker behind it. In the last piece, and behind the character of an escape, there is none.
struct Piece {
    std::wstring_view text;
    std::size_t number = 0;  // the marker's, from 1; 0: no marker
    Directive directive;
};

bool isOneOf(wchar_t c, std::wstring_view set) { return set.find(c) != set.npos; }
bool isDigit(wchar_t c) { return c >= L'0' && c <= L'9'; }
bool isInteger(const Directive& directive) { return isOneOf(directive.letter, L"CXcdioux"); }
bool isDouble(const Directive& directive) { return isOneOf(directive.letter, L"EGefg"); }

/// Reads the conversion between two exclamation marks.
bool readConversion(std::wstring_view text, Directive& directive) {
    const wchar_t* const end = text.data() + text.size();
    if (parseDirective(text.data(), end, directive) != end) return false;
    if (directive.widthIsArgument || directive.precisionIsArgument) return false;
    if (isInteger(directive)) return isOneOf(directive.modifier, std::wstring_view(L"\0hl", 3));
    return directive.modifier == 0 && (isDouble(directive) || directive.letter == L's');
}

/// Reads the marker whose number starts at the front of `text` and removes it there.
bool readMarker(std::wstring_view& text, Piece& piece) {
    const std::size_t digits = text.size() > 1 && isDigit(text[1]) ? 2 : 1;
    for (std::size_t i = 0; i < digits; ++i)
        piece.number = piece.number * 10 + static_cast<std::size_t>(text[i] - L'0');
    text.remove_prefix(digits);
    piece.directive.letter = L's';
    if (!text.starts_with(L'!')) return true;
    const std::size_t closing = text.find(L'!', 1);
    if (closing == text.npos) return true;  // the mark is text
    const std::wstring_view conversion = text.substr(1, closing - 1);
    text.remove_prefix(closing + 1);
    return readConversion(conversion, piece.directive);
}

/// Cuts a message at its markers and escapes; nothing when it is malformed.
std::optional<std::vector<Piece>> cutText(std::wstring_view text) {
    std::vector<Piece> pieces;
    while (!text.empty()) {
        Piece& piece = pieces.emplace_back();
        const std::size_t percent = text.find(L'%');
        piece.text = text.substr(0, percent);
        text.remove_prefix(piece.text.size());
        if (text.empty()) break;
        text.remove_prefix(1);
        if (text.empty()) return std::nullopt;
        if (isOneOf(text.front(), L" !%.")) {
            pieces.push_back({text.substr(0, 1), 0, {}});
            text.remove_prefix(1);
        } else if (!isDigit(text.front()) || text.front() == L'0' || !readMarker(text, piece)) {
            return std::nullopt;
        }
    }
    return pieces;
}

/// The markers in the order of their arguments; nothing unless each of 1 to the highest stands there once.
std::optional<std::vector<const Directive*>> orderMarkers(const std::vector<Piece>& pieces) {
    std::vector<const Directive*> order(pieces.size(), nullptr);
    std::size_t count = 0;
    for (const Piece& piece : pieces) {
        if (piece.number == 0) continue;
        if (piece.number > order.size() || order[piece.number - 1]) return std::nullopt;
        order[piece.number - 1] = &piece.directive;
        ++count;
    }
    order.resize(count);
    if (std::find(order.begin(), order.end(), nullptr) != order.end()) return std::nullopt;
    return order;
}

/// Whether each marker prints the kind of its argument.
bool fit(const std::vector<const Directive*>& markers, std::initializer_list<MessageArgument> arguments) {
    if (markers.size() > arguments.size()) return false;
    return std::equal(markers.begin(), markers.end(), arguments.begin(),
                      [](const auto* directive, const auto& argument) {
                          if (isInteger(*directive)) return std::holds_alternative<std::int32_t>(argument);
                          if (isDouble(*directive)) return std::holds_alternative<double>(argument);
                          return std::holds_alternative<const wchar_t*>(argument);
                      });
}

void appendArgument(std::wstring& out, const Directive& directive, const MessageArgument& argument) {
    if (const auto* integer = std::get_if<std::int32_t>(&argument))
        appendInteger(out, directive, *integer);
    else if (const auto* number = std::get_if<double>(&argument))
        appendDouble(out, directive, *number);
    else if (const wchar_t* text = std::get<const wchar_t*>(argument))
        out += text;
}

}  // namespace

std::wstring formatMessageV(const wchar_t* text, std::initializer_list<MessageArgument> arguments) {
    const auto pieces = cutText(text);
    const auto markers = pieces ? orderMarkers(*pieces) : std::nullopt;
    if (!markers || !fit(*markers, arguments)) return std::wstring(L"MALFORMED FORMATTING STRING: ") + text;
    if (markers->empty()) return text;

    std::wstring result;
    for (const Piece& piece : *pieces) {
        result += piece.text;
        if (piece.number > 0) appendArgument(result, piece.directive, arguments.begin()[piece.number - 1]);
    }
    return result;
}

}  // namespace Ov
