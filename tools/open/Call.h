#pragma once

#include <string>
#include <vector>

namespace opening {

/// Why a document cannot be handed to a program.
struct Failure {
    std::string message;
};

/// What a program takes.
enum class Takes { AddressesAndNames, Names };

/// A call of a program.
struct Call {
    Takes takes = Takes::AddressesAndNames;
    /// The program and its arguments. "{}" stands for the document, "{41}" for the character of that number (in
    /// hexadecimal digits). Without "{}" the document comes last.
    std::vector<std::string> words;
};

/// The words that the program is to be started with for a document.
/// @throw Failure when the program cannot take it
[[nodiscard]] std::vector<std::string> wordsFor(const Call& call, const std::string& document);

} // namespace opening
