#pragma once

#include "afx.h"
#include "s/Export.h"

#include <memory>

/// A message for the user: a format with the markers `%1` to `%9`, and the texts that take their places.
///
/// @code
/// Gui_Msg message(GUI_IDS_KEY_ASSIGNED);   // "%1 is assigned to %2"
/// message << "Ctrl+A" << "Edit Copy";
/// AfxMessageBox(message);                  // Ctrl+A is assigned to Edit Copy
/// @endcode
///
/// A marker is one digit: "%10" is parameter 1 and a zero. A parameter may be used several times or not at all. A
/// marker without its parameter, and any "%" without a digit from 1 to 9 behind it, gives "???"; a percent sign cannot
/// be written. Markers inside a parameter stay as they are.
///
/// The text is made when it is first asked for, and kept: parameters added later do not change it. Call ClearParameters
/// or SetFormat before a message is used again. Messages are not copied; make them where they are shown.
class GUI_API Gui_Msg {
public:
    /// An empty format.
    Gui_Msg();
    /// @param format copied; null counts as empty
    Gui_Msg(const char* format);
    /// As SetFormat(id, module) on an empty message.
    Gui_Msg(unsigned int id, HINSTANCE module = nullptr);
    ~Gui_Msg();
    Gui_Msg(const Gui_Msg&) = delete;
    Gui_Msg& operator=(const Gui_Msg&) = delete;

    /// Begins a new message: takes a copy of the format, forgets parameters and text. Null counts as empty.
    void SetFormat(const char* format);
    /// Begins a new message with a format from a string table.
    /// @param id     the string's number
    /// @param module whose table; null searches the application, then the libraries that bring resources. A string that
    ///               does not exist makes the format empty when a module was given, and leaves it as it was otherwise.
    void SetFormat(unsigned int id, HINSTANCE module = nullptr);

    /// Forgets the parameters and the text, and keeps the format.
    void ClearParameters();

    /// Appends the next parameter, a copy of the text; null counts as empty.
    Gui_Msg& operator<<(const char* text);
    /// Appends the next parameter, the number in decimal digits.
    Gui_Msg& operator<<(int number);

    /// The message's text.
    CString GetValue();
    /// The message's text, valid until the message is changed or destroyed.
    operator const char*();

    /// A text made from a `printf` format with one integer: "%d items" and 3 give "3 items".
    static CString Format(const char* format, int number);

private:
    struct Record;

    const CString& expanded();

    std::unique_ptr<Record> m_record;
};
