#pragma once

/// @file
/// Texts as arguments of the calls that format as printf does.

#include <concepts>

namespace tvx {

/// The framework's text classes, which cannot be passed through "..." themselves.
template <class Type>
concept FormattedText = requires(const Type& text) {
    { text.GetString() } -> std::convertible_to<const char*>;
};

/// The address of a text's bytes in place of the text; any other argument as it is.
template <class Type>
auto formatArgument(const Type& argument) {
    if constexpr (FormattedText<Type>) {
        return argument.GetString();
    } else {
        return argument;
    }
}

} // namespace tvx
