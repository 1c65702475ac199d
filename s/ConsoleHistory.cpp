#include "s/ConsoleHistory.h"

#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/Record.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <string_view>

namespace {

/// The counter outlives the histories of a process.
unsigned long nextNumber = 1;

using Beginning = std::array<std::uint64_t, 2>;
constexpr std::size_t beginningLength = sizeof(Beginning);

/// The beginning of a text, comparable with those of others. Upper and lower case are one; characters outside of ASCII
/// are all alike here, since their case may change their bytes.
Beginning beginningOf(std::string_view text) {
    std::array<unsigned char, beginningLength> bytes{};
    const std::string_view first = text.substr(0, beginningLength);
    for (std::size_t i = 0; i < first.size(); ++i) {
        const auto byte = static_cast<unsigned char>(first[i]);
        // From the first such character on even the places of bytes are not sure.
        if (byte >= 0x80) {
            break;
        }
        bytes[i] = byte >= 'A' && byte <= 'Z' ? byte + ('a' - 'A') : byte;
    }
    return std::bit_cast<Beginning>(bytes);
}

/// The bits of a beginning that a pattern decides.
Beginning maskOf(std::string_view pattern) {
    std::array<unsigned char, beginningLength> bytes{};
    for (std::size_t i = 0; i < pattern.size() && i < bytes.size(); ++i) {
        if (static_cast<unsigned char>(pattern[i]) >= 0x80) {
            break;
        }
        bytes[i] = 0xFF;
    }
    return std::bit_cast<Beginning>(bytes);
}

Gui_ConsoleHistory::Resolved refused(unsigned message) {
    return {false, {}, message};
}

} // namespace

unsigned long NextCommandNumber() {
    return nextNumber;
}

Gui_ConsoleHistory::Gui_ConsoleHistory() : m_first(nextNumber) {}

Gui_ConsoleHistory::~Gui_ConsoleHistory() {
    for (INT_PTR i = 0; i < m_lines.GetSize(); ++i) {
        delete m_lines.LineAt(i);
    }
}

Gui_ConsoleHistoryLine* Gui_ConsoleHistory::AddCommand(const char* text) {
    auto line = MakeRecord<Gui_ConsoleHistoryLine>(CString(text), nextNumber);
    const INT_PTR count = m_commands.GetSize();
    try {
        tvx::allocating([&] { m_beginnings.push_back(beginningOf(line->m_text.GetString())); });
        m_commands.Add(line.get());
        m_lines.Add(line.get());
    } catch (...) {
        // In all of them or in none.
        m_beginnings.resize(static_cast<std::size_t>(count));
        m_commands.SetSize(count);
        throw;
    }
    ++nextNumber;
    return line.release();
}

Gui_ConsoleHistoryLine* Gui_ConsoleHistory::AddStatusLine(const char* text) {
    auto line = MakeRecord<Gui_ConsoleHistoryLine>(CString(text));
    m_lines.Add(line.get());
    return line.release();
}

Gui_ConsoleHistory::Resolved Gui_ConsoleHistory::Resolve(const char* input) const {
    if (*input != '!') {
        return {true, input, 0};
    }
    const char* const rest = input + 1;
    if (std::strcmp(rest, "!") == 0) {
        return m_commands.IsEmpty() ? refused(0) : Command(nextNumber - 1);
    }
    if (*rest >= '0' && *rest <= '9') {
        return ByNumber(rest);
    }
    std::size_t at = 0;
    return tvx::text::isLetter(tvx::text::decode(rest, at)) ? ByPattern(rest) : refused(GUI_IDS_RECALL_PATTERN_PLACE);
}

Gui_ConsoleHistory::Resolved Gui_ConsoleHistory::ByNumber(const char* input) const {
    unsigned long number = 0;
    for (; *input >= '0' && *input <= '9'; ++input) {
        // Numbers that are too large stay so.
        number = std::min(number * 10 + static_cast<unsigned long>(*input - '0'), nextNumber);
    }
    if (input[std::strspn(input, " \t\n\v\f\r")] != '\0') {
        return refused(GUI_IDS_RECALL_ONE_NUMBER);
    }
    return number >= m_first && number < nextNumber ? Command(number) : refused(GUI_IDS_RECALL_NUMBER_RANGE);
}

Gui_ConsoleHistory::Resolved Gui_ConsoleHistory::ByPattern(const char* pattern) const {
    const Beginning wanted = beginningOf(pattern);
    const Beginning mask = maskOf(pattern);
    const auto mayMatch = [&](const Beginning& beginning) {
        return (((beginning[0] ^ wanted[0]) & mask[0]) | ((beginning[1] ^ wanted[1]) & mask[1])) == 0;
    };
    for (auto at = static_cast<INT_PTR>(m_beginnings.size()) - 1; at >= 0; --at) {
        if (mayMatch(m_beginnings[static_cast<std::size_t>(at)])) {
            const CString& text = m_commands.LineAt(at)->m_text;
            if (tvx::text::startsWithNoCase(text.GetString(), pattern)) {
                return {true, text, 0};
            }
        }
    }
    return refused(GUI_IDS_RECALL_NO_MATCH);
}

Gui_ConsoleHistory::Resolved Gui_ConsoleHistory::Command(unsigned long number) const {
    return {true, m_commands.LineAt(static_cast<INT_PTR>(number - m_first))->m_text, 0};
}
