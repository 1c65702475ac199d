#pragma once

#include "afxwin.h"

/// Orders two texts as `strcmp` does: negative, 0 or positive.
using CompareTexts = int (*)(const CString*, const CString*);

/// The numbers of the messages by which a kind of control is asked for its lines.
struct LineMessages {
    UINT add;        ///< appends a text, or puts it in order in a sorted control
    UINT remove;     ///< by index
    UINT removeAll;  ///< empties the control
    UINT count;      ///< asks for the number of lines
    UINT text;       ///< asks for a line by index
    UINT textLength; ///< asks for the bytes of a line, without its zero
    UINT findExact;  ///< asks for the next line that equals a text without regard to case
};

/// The lines of a list or combo box. Everything goes through messages, so that classes derived from the controls see
/// it.
class ControlLines {
public:
    /// Both must live as long as this object.
    ControlLines(const CWnd& control, const LineMessages& messages) : m_control(control), m_messages(messages) {}

    /// How many there are; 0 without a window.
    int count() const;
    /// The line with an index, from 0 on.
    CString text(int line) const;
    /// The line that equals the text without regard to case, searched behind `after` and then from the first one on.
    int find(int after, const char* text) const;
    /// Appends all texts; answers the number of lines.
    int appendTo(CStringList& texts) const;
    /// Gives the control the texts one by one, in their order.
    void add(const CStringList& texts);
    /// Puts the texts and the present lines in order, equal ones as they came.
    void merge(const CStringList& texts, CompareTexts compare);
    /// Removes one line for each text; answers how many.
    int remove(const CStringList& texts);
    /// Removes the lines that the pattern does not match; answers how many.
    int removeUnmatched(const CString& pattern);

private:
    const CWnd& m_control;
    const LineMessages& m_messages;
};
