#pragma once

/// @file
/// A resource script after the C preprocessor: lines that know where they came from, cut into words and statements.

#include <cstddef>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace rc {

/// Where something stands in the host's files.
struct Place {
    std::string file;
    int line = 0;
};

/// A fault in a script, with the place to show to its author. Thrown by the steps of the compilation.
struct Fault {
    Place place;
    std::string message;
};

/// One word of a script.
struct Token {
    enum class Kind { Word, Number, String, Mark };
    Kind kind = Kind::Word;
    std::string text;     ///< as written, strings with their quotes
    std::size_t line = 0; ///< index into `Script::lines`

    /// Compares with a keyword, given in upper case.
    [[nodiscard]] bool is(std::string_view keyword) const;
    [[nodiscard]] bool opensBlock() const {
        return is("BEGIN") || is("{");
    }
    [[nodiscard]] bool closesBlock() const {
        return is("END") || is("}");
    }
};

/// A line of the preprocessed script.
struct Line {
    std::string text;
    Place place;
};

/// A statement on the outermost level: a dialog from its name to its END, a line that names a file, a LANGUAGE line.
struct Statement {
    std::vector<Token> tokens; ///< never empty

    /// The resource type in upper case: the second word, or the first one of STRINGTABLE and LANGUAGE.
    [[nodiscard]] std::string type() const;
    [[nodiscard]] std::size_t firstLine() const {
        return tokens.front().line;
    }
};

/// A script cut into statements.
struct Script {
    std::vector<Line> lines;
    std::vector<Statement> statements;
    std::vector<std::filesystem::path> files; ///< every file that was read, for the build's dependencies

    [[nodiscard]] const Place& placeOf(const Token& token) const {
        return lines[token.line].place;
    }
};

/// Cuts the output of the C preprocessor (with its line marks). Lines that come from C headers are declarations of the
/// host's program and are left out, as are `#pragma` lines.
[[nodiscard]] Script parseScript(std::string_view preprocessed);

/// The text in ASCII upper case.
[[nodiscard]] std::string upperCase(std::string_view text);

} // namespace rc
