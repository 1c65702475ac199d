#pragma once

/// @file
/// Moving data between the controls of a dialog and the members of its class.

#include "platform/afx/core/Wnd.h"

/// One exchange in progress; DoDataExchange hands it to the DDX_ and DDV_ functions below.
///
/// Each DDX_ function moves one value, from the control into the member when m_bSaveAndValidate is TRUE. Each DDV_
/// function checks the value moved just before. A value that cannot be read or is out of range is reported in a message
/// box, the control gets the keyboard, and the exchange ends: UpdateData answers FALSE.
///
/// Numbers have 32 bits and are written in the C locale.
class TVX_PLATFORM_API CDataExchange {
public:
    /// Begins an exchange; UpdateData makes one.
    CDataExchange(CWnd* dialog, BOOL saveAndValidate);

    /// TRUE when values go from the controls into the members.
    BOOL m_bSaveAndValidate;
    /// The dialog.
    CWnd* m_pDlgWnd;
    int m_idLastControl = 0; ///< The control moved last: where a failed check puts the keyboard.
    /// Whether that control's text is typed in.
    bool m_bEditLastControl = false;

    /// The control of a number. Raises the framework's not-supported exception when the dialog has none.
    HWND PrepareCtrl(int id);
    /// The same for a control whose text is typed in: it is selected when a check fails.
    HWND PrepareEditCtrl(int id);
    /// Ends the exchange; nothing behind the call runs. The user must have been told before.
    [[noreturn]] void Fail();
};

/// Binds a member to the control: its messages go through the member's class from then on.
TVX_PLATFORM_API void DDX_Control(CDataExchange* dx, int id, CWnd& control);

/// The whole text of a control.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, CString& value);
/// A number from 0 to 255.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, BYTE& value);
/// A number of 16 bits.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, short& value);
/// A number of 32 bits.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, int& value);
/// A number of 32 bits without sign.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, UINT& value);
/// A number of 32 bits, as everywhere.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, long& value);
/// A number of 32 bits without sign, as everywhere.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, unsigned long& value);
/// Shows 6 significant digits.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, float& value);
/// Shows 15 significant digits.
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, double& value);
/// @param size of the buffer, the final zero included; a longer text is cut between characters
TVX_PLATFORM_API void DDX_Text(CDataExchange* dx, int id, LPSTR value, int size);

/// The mark of a check box: 0, 1, or 2 for neither.
TVX_PLATFORM_API void DDX_Check(CDataExchange* dx, int id, int& value);
/// The marked button of a group of radio buttons, counted from 0; -1 for none.
/// @param id of the group's first button, which has WS_GROUP
TVX_PLATFORM_API void DDX_Radio(CDataExchange* dx, int id, int& value);
/// The selected line of a list box: its text (found again by prefix, or as a whole) or its index, -1 for none.
TVX_PLATFORM_API void DDX_LBString(CDataExchange* dx, int id, CString& value);
/// Selects only a line that is the whole text.
TVX_PLATFORM_API void DDX_LBStringExact(CDataExchange* dx, int id, CString& value);
/// The index of the selected line, -1 for none.
TVX_PLATFORM_API void DDX_LBIndex(CDataExchange* dx, int id, int& value);
/// The same for a combo box; the text is that of its field, which need not be among the lines.
TVX_PLATFORM_API void DDX_CBString(CDataExchange* dx, int id, CString& value);
/// Chooses only a line that is the whole text.
TVX_PLATFORM_API void DDX_CBStringExact(CDataExchange* dx, int id, CString& value);
/// The index of the chosen line, -1 for none.
TVX_PLATFORM_API void DDX_CBIndex(CDataExchange* dx, int id, int& value);
/// The position of a scroll-bar control.
TVX_PLATFORM_API void DDX_Scroll(CDataExchange* dx, int id, int& value);

/// At most `count` bytes; the control takes no more while it is typed into.
TVX_PLATFORM_API void DDV_MaxChars(CDataExchange* dx, const CString& value, int count);
/// Refuses a value that is not within `min` and `max`; the message names both.
TVX_PLATFORM_API void DDV_MinMaxByte(CDataExchange* dx, BYTE value, BYTE min, BYTE max);
/// The same for a number of 16 bits.
TVX_PLATFORM_API void DDV_MinMaxShort(CDataExchange* dx, short value, short min, short max);
/// The same for a number of 32 bits.
TVX_PLATFORM_API void DDV_MinMaxInt(CDataExchange* dx, int value, int min, int max);
/// The same for a number of 32 bits, as everywhere.
TVX_PLATFORM_API void DDV_MinMaxLong(CDataExchange* dx, long value, long min, long max);
/// The same for a number without sign.
TVX_PLATFORM_API void DDV_MinMaxUInt(CDataExchange* dx, UINT value, UINT min, UINT max);
/// The same for a number without sign.
TVX_PLATFORM_API void DDV_MinMaxDWord(CDataExchange* dx, DWORD value, DWORD min, DWORD max);
/// The same for a real number, shown with 6 digits.
TVX_PLATFORM_API void DDV_MinMaxFloat(CDataExchange* dx, const float& value, float min, float max);
/// The same for a real number, shown with 15 digits.
TVX_PLATFORM_API void DDV_MinMaxDouble(CDataExchange* dx, const double& value, double min, double max);
