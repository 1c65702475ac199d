#pragma once

#include "afx.h"
#include "afxcoll.h"
#include "s/Export.h"

/// The family's text: the framework's string with strict number conversion and splitting into fields. It adds no data,
/// so the two are exchanged freely.
///
/// @code
/// int count = 0;
/// if (!Gui_String(setting).GetIntValue(count, 10))
///     return; // not a number, or more than a number
///
/// std::unique_ptr<CStringArray> folders(Gui_String(path).GetStringArray(";", 1, 0));
/// @endcode
class GUI_API Gui_String : public CString {
public:
    /// The empty text.
    Gui_String();
    Gui_String(const CString& text);
    Gui_String(const Gui_String& text);
    /// @p repeat copies of @p ch; none when @p repeat is 0 or negative.
    Gui_String(char ch, int repeat);
    /// @param text zero-terminated; null gives the empty text
    Gui_String(const char* text);
    /// The first @p length bytes of @p text.
    Gui_String(const char* text, int length);
    Gui_String(const unsigned char* text);
    /// Wide text, converted to UTF-8.
    Gui_String(const wchar_t* text);
    ~Gui_String();

    Gui_String& operator=(const Gui_String& text);

    /// Converts the whole text to a 32-bit integer, as `strtol` reads one: white space and a sign may stand before it,
    /// nothing may stand behind it. The empty text is 0; a number beyond the range gives the nearest limit.
    /// @param value receives the number; left alone on failure
    /// @param base  2 to 36, or 0 to let a prefix "0x" or "0" decide
    /// @return 1, or 0 when the text is something else than a number
    int GetIntValue(int& value, int base) const;

    /// Converts the whole text to a double, with "." as decimal sign whatever the user's locale. Otherwise as
    /// GetIntValue.
    int GetDoubleValue(double& value) const;

    /// What ends a line in the family's texts: carriage return and line feed.
    static const char* GetEndOfLineChars();

    /// Splits the text into fields.
    ///
    /// Unless quotes are ignored, a stretch between two double quotes or two apostrophes is a field of its own: it
    /// keeps its quotes, and separators inside it do not split. There is no escape. A stretch that is not closed
    /// reaches to the end of the text.
    /// @param separators   the characters that end a field; null counts as none
    /// @param skipEmpty    non-zero: runs of separators count as one and empty fields are left out
    /// @param ignoreQuotes non-zero: quotes are ordinary characters
    /// @return the fields, in order; the caller deletes the array. A separator at the end adds no empty field. An
    ///     exhausted heap raises the framework's memory exception.
    CStringArray* GetStringArray(const char* separators, int skipEmpty, int ignoreQuotes) const;
};
