#include "platform/port/detail/CommandFile.h"

#include <algorithm>

namespace Port::detail {

namespace {

constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";

bool isLineEnd(char character) {
    return character == '\n' || character == '\r';
}

bool isWhite(char character) {
    return isLineEnd(character) || character == ' ' || character == '\t' || character == '\v' || character == '\f';
}

class WordReader {
public:
    explicit WordReader(std::string_view text) : m_rest(text) {
        if (m_rest.starts_with(byteOrderMark)) {
            m_rest.remove_prefix(byteOrderMark.size());
        }
    }

    CommandWords read() {
        while (skipToWord()) {
            m_result.words.push_back(takeWord());
        }
        return std::move(m_result);
    }

private:
    /// Skips white space and comments; whether a word follows.
    bool skipToWord() {
        while (!m_rest.empty()) {
            if (m_rest.front() == '#') {
                m_rest.remove_prefix(std::min(m_rest.find_first_of("\r\n"), m_rest.size()));
            } else if (isWhite(m_rest.front())) {
                skipWhite();
            } else {
                return true;
            }
        }
        return false;
    }

    void skipWhite() {
        const bool isPair = m_rest.starts_with("\r\n");
        if (isLineEnd(m_rest.front())) {
            ++m_line;
        }
        m_rest.remove_prefix(isPair ? 2 : 1);
    }

    std::string takeWord() {
        std::string word;
        while (!m_rest.empty() && !isWhite(m_rest.front())) {
            const std::size_t plain = std::min(m_rest.find_first_of(" \t\v\f\r\n\"'"), m_rest.size());
            word += m_rest.substr(0, plain);
            m_rest.remove_prefix(plain);
            if (m_rest.starts_with('"') || m_rest.starts_with('\'')) {
                takeQuoted(word);
            }
        }
        return word;
    }

    void takeQuoted(std::string& word) {
        const char ends[] = {m_rest.front(), '\r', '\n'};
        m_rest.remove_prefix(1);
        const std::size_t end = std::min(m_rest.find_first_of({ends, sizeof ends}), m_rest.size());
        word += m_rest.substr(0, end);
        const bool isClosed = end < m_rest.size() && m_rest[end] == ends[0];
        m_rest.remove_prefix(isClosed ? end + 1 : end);
        if (!isClosed) {
            m_result.unclosedLines.push_back(m_line);
        }
    }

    std::string_view m_rest;
    std::size_t m_line = 1;
    CommandWords m_result;
};

} // namespace

CommandWords splitCommandText(std::string_view text) {
    return WordReader(text).read();
}

} // namespace Port::detail
