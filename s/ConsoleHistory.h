#pragma once

#include "afxwin.h"

#include <array>
#include <cstdint>
#include <memory>
#include <vector>

/// @file
/// What a console remembers, and its recall language. Not for hosts, who reach it through Gui_Console.

/// One line of a console.
struct Gui_ConsoleHistoryLine {
    CString m_text;             ///< As it was added, without number and prompt.
    unsigned long m_number = 0; ///< A command's number, counted from 1; 0 for a status line.

    [[nodiscard]] bool IsCommand() const {
        return m_number != 0;
    }
};

/// Lines in an order. They belong to the history.
class Gui_ConsoleHistoryLineArray : public CPtrArray {
public:
    [[nodiscard]] Gui_ConsoleHistoryLine* LineAt(INT_PTR index) const {
        return static_cast<Gui_ConsoleHistoryLine*>(GetAt(index));
    }
};

/// All lines of a console, in the order they were added, and its commands, which are numbered from 1. Lines are only
/// ever appended.
class Gui_ConsoleHistory {
public:
    Gui_ConsoleHistory();
    /// Deletes all lines.
    ~Gui_ConsoleHistory();
    Gui_ConsoleHistory(const Gui_ConsoleHistory&) = delete;
    Gui_ConsoleHistory& operator=(const Gui_ConsoleHistory&) = delete;

    /// Appends a command, which gets the next number.
    Gui_ConsoleHistoryLine* AddCommand(const char* text);
    /// Appends a status line. It has no number and cannot be recalled.
    Gui_ConsoleHistoryLine* AddStatusLine(const char* text);
    /// All lines, as the console shows them.
    [[nodiscard]] const Gui_ConsoleHistoryLineArray& GetLines() const {
        return m_lines;
    }
    /// The commands only, by their numbers: in the first history of a process number n stands at n - 1.
    [[nodiscard]] const Gui_ConsoleHistoryLineArray& GetCommands() const {
        return m_commands;
    }

    /// What an input means.
    struct Resolved {
        bool runs = false;    ///< Whether there is a command to run.
        CString command;      ///< The one that is run.
        unsigned message = 0; ///< Why none is: the number of the string that says so; 0: nothing is said.
    };
    /// Looks up a recall expression; any other input is a command itself.
    ///
    /// | input | means |
    /// |---|---|
    /// | `!!` | the last command; before the first one nothing, without a word |
    /// | `!21` | the command with that number |
    /// | `!run` | the newest command that begins with "run", without case; there are no wildcards |
    [[nodiscard]] Resolved Resolve(const char* input) const;

private:
    [[nodiscard]] Resolved ByNumber(const char* input) const;
    [[nodiscard]] Resolved ByPattern(const char* pattern) const;
    [[nodiscard]] Resolved Command(unsigned long number) const;

    unsigned long m_first; ///< The number of the first command: 1 in the first history of a process.
    Gui_ConsoleHistoryLineArray m_commands;
    Gui_ConsoleHistoryLineArray m_lines;
    /// The first bytes of each command without case, so that a search through many looks at few of them.
    std::vector<std::array<std::uint64_t, 2>> m_beginnings;
};

/// The number that the process's next command will have. It begins with 1 and is never set back.
unsigned long NextCommandNumber();
