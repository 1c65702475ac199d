#pragma once

#include "afxwin.h"

#include <vector>

/// @file
/// Walking through earlier commands with the arrow keys, and searching them. Not for hosts.

class Gui_ConsoleHistory;

/// The commands that Up, Down and Ctrl+R in a console's field go through: those of the history and, before them, texts
/// of earlier starts. Equal neighbours count once. A walk begins with the text that stands in the field, which is what
/// Down comes back to in the end.
class Gui_ConsoleRecall {
public:
    /// The commands of the running process. It must outlive the object.
    explicit Gui_ConsoleRecall(const Gui_ConsoleHistory& history) : m_history(history) {}

    /// Puts texts before the commands of this process, the oldest first.
    void SetEarlier(std::vector<CString> texts);
    /// Ends a walk: the next one begins with the newest command.
    void Leave();

    /// The next older command, or the next newer one and at last the text that the walk began with.
    /// @param text  the text in the field; receives the other one
    /// @return false: there is none, and the text stays
    /// @{
    bool Older(CString& text);
    bool Newer(CString& text);
    /// @}

    /// A command that holds a pattern somewhere, without case.
    /// @param pattern  an empty one finds nothing
    /// @param place    where the search begins, that place included, counted from the oldest. Receives where the
    ///     command was found; unchanged when there is none
    /// @param step     -1 towards older ones, 1 towards newer ones
    /// @param text     receives the command; unchanged when there is none
    [[nodiscard]] bool Search(const CString& pattern, int& place, int step, CString& text) const;

    /// The place of the newest command, -1 when there is none.
    [[nodiscard]] int GetNewest() const;

private:
    [[nodiscard]] bool ShowsNothingNew(int place, const CString& text) const;
    [[nodiscard]] int Count() const;
    [[nodiscard]] const CString& At(int place) const;

    const Gui_ConsoleHistory& m_history;
    std::vector<CString> m_earlier;
    int m_place = -1;     ///< Of the command that is shown; -1: none, the field holds a text of its own.
    CString m_unfinished; ///< The text that the walk began with.
};
