#pragma once

#include <concepts>
#include <cstdint>
#include <string>
#include <type_traits>
#include <variant>

// Messages that know their arguments: a list says for each its name, its number and the types of what its text shows,
//
//     #define MY_MESSAGES(message) message(lineTooLong, 13100, int, std::wstring)  /* line, its start */
//     namespace mine::messages { OVPHOTO_DEFINE_MESSAGES(MY_MESSAGES) }
//
// and a call with other arguments does not compile: report.post(mine::messages::lineTooLong, 3, text). A module with a
// catalogue of its own makes a list of its own.

namespace Ov {

/// An argument as the formatting takes it: 32 bits of an integer or character, a double, or a text that ends at its
/// first NUL and stays the caller's; null is an empty one.
using MessageArgument = std::variant<std::int32_t, double, const wchar_t*>;

inline MessageArgument messageArgument(std::int32_t value) { return value; }
inline MessageArgument messageArgument(double value) { return value; }
inline MessageArgument messageArgument(const wchar_t* text) { return text; }
inline MessageArgument messageArgument(const std::wstring& text) { return text.c_str(); }

/// A message by its number, and the types of its arguments: int, double, wchar_t for a character, std::wstring.
template <class... Types>
struct Message {
    unsigned id;
    constexpr operator unsigned() const { return id; }
};

/// One argument of a message, of whatever turns into its type by itself and without loss: a float for a double, a
/// literal for a text, but no double for an int.
template <class Type>
class TypedArgument {
public:
    template <class Given>
    requires std::convertible_to<Given, Type> && requires(Given given) { Type{given}; }
    TypedArgument(const Given& given) : _argument(messageArgument(given)) {}
    operator MessageArgument() const { return _argument; }

private:
    MessageArgument _argument;
};

/// The parameter type of functions that take a message and its arguments; the message alone decides the types.
template <class Type>
using ArgumentFor = std::type_identity_t<TypedArgument<Type>>;

/// A message among others: its number, and its arguments as the letters that texts print them with.
struct MessageEntry {
    unsigned id;
    const char* arguments;
};

template <class Type>
inline constexpr char argumentLetter = 0;
template <>
inline constexpr char argumentLetter<int> = 'd';
template <>
inline constexpr char argumentLetter<double> = 'f';
template <>
inline constexpr char argumentLetter<wchar_t> = 'c';
template <>
inline constexpr char argumentLetter<std::wstring> = 's';
template <class... Types>
inline constexpr char argumentLetters[] = {argumentLetter<Types>..., '\0'};

template <class... Types>
constexpr MessageEntry messageEntry(Message<Types...> message) {
    static_assert((argumentLetter<Types> && ...), "no type of an argument");
    return {message.id, argumentLetters<Types...>};
}

}  // namespace Ov

/// Defines the messages of a list by their names, and `all` of them for checks of the texts.
#define OVPHOTO_DEFINE_MESSAGES(list) \
    list(OVPHOTO_DEFINE_MESSAGE) inline constexpr Ov::MessageEntry all[] = {list(OVPHOTO_MESSAGE_ENTRY)};
#define OVPHOTO_DEFINE_MESSAGE(name, number, ...) inline constexpr Ov::Message<__VA_ARGS__> name{number};
#define OVPHOTO_MESSAGE_ENTRY(name, number, ...) Ov::messageEntry(name),
