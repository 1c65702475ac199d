#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// A text as its file has it. What the user does not change is written as it was read, byte for byte: the mark at the
/// beginning, the end of each line, characters in another encoding than UTF-8.
///
/// It knows nothing of windows, so that it can be tested without one.
class FileText {
public:
    /// The empty text of a new file.
    FileText() = default;
    /// @param bytes what the file holds; see isText
    explicit FileText(std::string_view bytes);

    /// Whether a file's bytes are a text. Others, such as pictures and programs, hold zero bytes.
    static bool isText(std::string_view bytes) {
        return bytes.find('\0') == std::string_view::npos;
    }

    /// The text as an edit control takes it: lines with "\r\n" between them.
    std::string edited() const;
    /// What the file is to hold when the user has made this text of `edited()`. Lines before and behind the change keep
    /// their ends, those that took the place of others get the ends of these, and the rest the end that most lines
    /// have.
    std::string bytesOf(std::string_view edited) const;

private:
    struct Line {
        std::string text;
        std::string end; ///< empty for the last line
    };
    std::string usualEnd() const;

    std::string m_mark; ///< what tells programs that the file is UTF-8; mostly empty
    std::vector<Line> m_lines = {{}};
};
