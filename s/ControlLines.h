#pragma once

#include "afxwin.h"

/// Orders two texts as `strcmp` does: negative, 0 or positive.
using CompareTexts = int (*)(const CString*, const CString*);

/// The numbers of the messages by which a kind of control is asked for its lines.
struct LineMessages {
    UINT add;
    UINT remove;
    UINT removeAll;
    UINT count;
    UINT text;
    UINT textLength;
    UINT findExact;
};

/// The lines of a list or combo box. Everything goes through messages, so that classes derived from the controls see
/// it.
class ControlLines {
public:
    ControlLines(const CWnd& control, const LineMessages& messages) : m_control(control), m_messages(messages) {}

    int count() const;
    CString text(int line) const;
    /// The line that equals the text without regard to case, searched behind `after` and then from the first one on.
    int find(int after, const char* text) const;
    /// Appends all texts; answers the number of lines.
    int appendTo(CStringList& texts) const;
    void add(const CStringList& texts);
    /// Puts the texts and the present lines in order, equal ones as they came.
    void merge(const CStringList& texts, CompareTexts compare);
    /// Removes one line for each text; answers how many.
    int remove(const CStringList& texts);
    int removeUnmatched(const CString& pattern);

private:
    const CWnd& m_control;
    const LineMessages& m_messages;
};
