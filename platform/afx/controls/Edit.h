#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A field for text, of one line or, with ES_MULTILINE, of many. Positions are bytes of UTF-8; a line's end counts as
/// "\r\n". Text is got and set with GetWindowText and SetWindowText.
class TVX_PLATFORM_API CEdit : public CWnd {
    DECLARE_DYNAMIC(CEdit)

public:
    /// Creates the control with ES_... styles.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// The selection; both numbers are the caret's place when nothing is selected.
    void GetSel(int& start, int& end) const;
    /// Selects from `start` to before `end`. 0, -1 selects all; a negative start takes the selection away.
    void SetSel(int start, int end, BOOL noScroll = FALSE);
    /// The same with both positions in one number: start in the low half, end in the high one.
    void SetSel(DWORD selection, BOOL noScroll = FALSE) {
        SetSel(static_cast<SHORT>(LOWORD(selection)), static_cast<SHORT>(HIWORD(selection)), noScroll);
    }
    /// Puts a text into the place of the selection; no limit applies. Without `canUndo` nothing, not even what was
    /// done before, can be taken back afterwards.
    void ReplaceSel(LPCSTR text, BOOL canUndo = FALSE) {
        SendMessage(EM_REPLACESEL, static_cast<WPARAM>(canUndo), reinterpret_cast<LPARAM>(text));
    }
    /// How many bytes the user may type; 0 for no limit. 30000 from the start.
    void SetLimitText(UINT limit) {
        SendMessage(EM_SETLIMITTEXT, limit);
    }
    /// The same by its older name.
    void LimitText(int limit = 0) {
        SendMessage(EM_LIMITTEXT, static_cast<WPARAM>(limit));
    }
    /// How many bytes the user may type.
    UINT GetLimitText() const {
        return static_cast<UINT>(SendMessage(EM_GETLIMITTEXT));
    }
    /// Whether the user has changed the text since SetWindowText or SetModify(FALSE).
    BOOL GetModify() const {
        return static_cast<BOOL>(SendMessage(EM_GETMODIFY));
    }
    /// Says whether the text counts as changed.
    void SetModify(BOOL modified = TRUE) {
        SendMessage(EM_SETMODIFY, static_cast<WPARAM>(modified));
    }
    /// Keeps the user from changing the text; it can still be selected and copied.
    BOOL SetReadOnly(BOOL readOnly = TRUE) {
        return static_cast<BOOL>(SendMessage(EM_SETREADONLY, static_cast<WPARAM>(readOnly)));
    }
    /// Hides what is typed; 0 shows it. The desktop's own dot stands for each character, whatever `character` is.
    void SetPasswordChar(char character) {
        SendMessage(EM_SETPASSWORDCHAR, static_cast<WPARAM>(static_cast<unsigned char>(character)));
    }
    /// What SetPasswordChar was told, '*' for a control created with ES_PASSWORD, 0 when the text is shown.
    char GetPasswordChar() const {
        return static_cast<char>(SendMessage(EM_GETPASSWORDCHAR));
    }

    // --- lines, counted from 0 as they are shown: a wrapped line is several ---

    /// Number of lines, 1 for an empty text.
    int GetLineCount() const {
        return static_cast<int>(SendMessage(EM_GETLINECOUNT));
    }
    /// Where a line begins (-1: that of the caret); -1 when there is no such line.
    int LineIndex(int line = -1) const {
        return static_cast<int>(SendMessage(EM_LINEINDEX, static_cast<WPARAM>(line)));
    }
    /// Length of the line that holds the position (-1: the caret), without its end.
    int LineLength(int position = -1) const {
        return static_cast<int>(SendMessage(EM_LINELENGTH, static_cast<WPARAM>(position)));
    }
    /// The line that holds the position (-1: the selection's beginning).
    int LineFromChar(int position = -1) const {
        return static_cast<int>(SendMessage(EM_LINEFROMCHAR, static_cast<WPARAM>(position)));
    }
    /// Copies at most `size` bytes of a line; no zero is written behind them. Answers how many.
    int GetLine(int line, LPSTR buffer, int size) const;
    /// Scrolls down by `lines`, up when they are negative.
    void LineScroll(int lines, int characters = 0) {
        SendMessage(EM_LINESCROLL, static_cast<WPARAM>(characters), lines);
    }
    /// The first line that is seen.
    int GetFirstVisibleLine() const {
        return static_cast<int>(SendMessage(EM_GETFIRSTVISIBLELINE));
    }

    // --- undo and clipboard: what the user asks for by keys, menu, mouse and drops comes as the same messages ---

    /// Whether Undo would change anything.
    BOOL CanUndo() const {
        return static_cast<BOOL>(SendMessage(EM_CANUNDO));
    }
    /// Takes the last change back; a second call brings it again.
    BOOL Undo() {
        return static_cast<BOOL>(SendMessage(EM_UNDO));
    }
    /// Forgets what could be taken back.
    void EmptyUndoBuffer() {
        SendMessage(EM_EMPTYUNDOBUFFER);
    }
    /// Moves the selection to the clipboard; a read-only control only copies it. Nothing happens without a selection.
    void Cut() {
        SendMessage(WM_CUT);
    }
    /// Copies the selection to the clipboard.
    void Copy() {
        SendMessage(WM_COPY);
    }
    /// Puts the clipboard's text into the place of the selection, within the limit.
    void Paste() {
        SendMessage(WM_PASTE);
    }
    /// Deletes the selection.
    void Clear() {
        SendMessage(WM_CLEAR);
    }
};
