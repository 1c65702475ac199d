#pragma once

#include "afxwin.h"
#include "s/ConsoleHistory.h"

#include <chrono>
#include <functional>
#include <optional>
#include <vector>

/// @file
/// The controls of the console's window. Not for hosts.

/// The lines: an owner-drawn list whose items are lines of the history.
class Gui_ConsoleListBox : public CListBox {
public:
    /// Shows a line at the end, without scrolling.
    void AddLine(Gui_ConsoleHistoryLine* line);
    /// Brings the last line into view, as far as lines were added one by one.
    void ShowEnd();
    /// Shows these lines, in which the last one is in view.
    void Fill(const Gui_ConsoleHistoryLineArray& lines);
    /// Takes all lines away; the widest one is forgotten.
    void RemoveLines();

    /// The line of an item; null when there is no such item.
    [[nodiscard]] Gui_ConsoleHistoryLine* LineAt(int index) const;
    /// Whether a command is selected, or anything with @p anything.
    [[nodiscard]] bool HasSelection(bool anything) const;
    /// The selected commands, from the top.
    [[nodiscard]] std::vector<CString> GetSelectedCommands() const;

    void DrawItem(DRAWITEMSTRUCT* item) override;
    /// Nothing: all lines have the height of the font.
    void MeasureItem(MEASUREITEMSTRUCT* item) override {}
    CString GetAccessibleText(int index) const override;

protected:
    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnContextMenu(CWnd* window, CPoint point);
    afx_msg UINT OnGetDlgCode();
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags);
    DECLARE_MESSAGE_MAP()

private:
    [[nodiscard]] std::vector<int> Selected() const;
    void Measure(CDC& dc, const Gui_ConsoleHistoryLine& line);
    [[nodiscard]] CPoint MenuPoint() const;
    void ScrollToEnd();
    void PaintNowAndThen();

    std::chrono::steady_clock::time_point m_painted;
};

/// The field in which commands are typed.
class Gui_ConsoleEdit : public CEdit {
public:
    /// Shows a text about a search in place of the prompt; an empty one: the prompt again.
    std::function<void(const CString&)> showSearch;
    /// Whether Paste would do anything.
    [[nodiscard]] static bool CanPaste();

protected:
    afx_msg void OnChar(UINT character, UINT repeat, UINT flags);
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags);
    afx_msg void OnKillFocus(CWnd* next);
    afx_msg UINT OnGetDlgCode();
    afx_msg LRESULT OnPaste(WPARAM, LPARAM);
    DECLARE_MESSAGE_MAP()

private:
    void Run();
    void Show(const CString& text);
    bool OnWalkKey(UINT key);
    // --- searching ---
    bool OnSearchKey(UINT key);
    bool OnSearchChar(UINT character);
    void Search(int step);
    void SearchAgain();
    void ShowPattern(bool found);
    void EndSearch();
    void GiveUpSearch();

    /// A search that is under way.
    struct SearchState {
        CString pattern;
        CString before; ///< What stood in the field.
        int place = -1; ///< Of the command that is shown.
        bool found = true;
    };
    std::optional<SearchState> m_search;
};
