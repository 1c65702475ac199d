#pragma once

#include "tools/rc/Script.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace rc {

/// Reads a statement's words in order and throws `Fault` with the author's line where something else was expected.
class StatementReader {
public:
    StatementReader(const Script& script, const Statement& statement) : m_script(script), m_tokens(statement.tokens) {}

    /// The word ahead, null at the statement's end.
    [[nodiscard]] const Token* peek() const;
    [[nodiscard]] bool ahead(std::string_view keyword) const;
    [[nodiscard]] bool blockEndAhead() const;

    /// The next word; `expected` tells what should stand there should it be missing.
    const Token& next(std::string_view expected);
    /// Passes `keyword` if it is next.
    bool accept(std::string_view keyword);
    const Token& expect(std::string_view keyword);
    /// Passes DISCARDABLE and its like, which have had no meaning for a long time.
    void skipMemoryFlags();
    /// Passes BEGIN and what may stand before it.
    void beginBlock();

    /// A number: constants joined by the operators of scripts. Ends before anything that cannot belong to it.
    std::int64_t number();
    /// A number, of which the low 16 bits count; faulty outside of -32768 to 65535.
    std::uint16_t word();
    /// The UTF-16 units of a text, escapes resolved.
    std::u16string text();

    /// Throws `Fault` with the line of `token`.
    [[noreturn]] void fail(const Token& token, std::string_view expected) const;

private:
    std::int64_t sum();
    std::int64_t operand();

    const Script& m_script;
    const std::vector<Token>& m_tokens;
    std::size_t m_at = 0;
};

/// The UTF-16 units that a string of a script means: quotes removed, "" and escapes resolved.
[[nodiscard]] std::u16string decodeString(std::string_view quoted);

} // namespace rc
