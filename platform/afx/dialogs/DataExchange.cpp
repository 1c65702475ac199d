#include "platform/afx/dialogs/DataExchange.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/base/Exception.h"
#include "platform/base/Text.h"
#include "platform/win/FrameworkIds.h"

#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

namespace text = tvx::text;

CDataExchange::CDataExchange(CWnd* dialog, BOOL saveAndValidate)
    : m_bSaveAndValidate(saveAndValidate), m_pDlgWnd(dialog) {}

HWND CDataExchange::PrepareCtrl(int id) {
    const HWND control = ::GetDlgItem(m_pDlgWnd->m_hWnd, id);
    if (!control) {
        std::fprintf(stderr, "Data exchange: the dialog has no control %d.\n", id);
        AfxThrowNotSupportedException();
    }
    m_idLastControl = id;
    m_bEditLastControl = false;
    return control;
}

HWND CDataExchange::PrepareEditCtrl(int id) {
    const HWND control = PrepareCtrl(id);
    m_bEditLastControl = true;
    return control;
}

void CDataExchange::Fail() {
    const HWND control = m_idLastControl != 0 ? ::GetDlgItem(m_pDlgWnd->m_hWnd, m_idLastControl) : nullptr;
    if (m_bSaveAndValidate && control) {
        ::SetFocus(control);
        if (m_bEditLastControl) {
            ::SendMessageA(control, EM_SETSEL, 0, -1);
        }
    }
    AfxThrowUserException();
}

namespace {

CString textOf(HWND control) {
    CString value;
    const int length = ::GetWindowTextLengthA(control);
    LPSTR buffer = value.GetBufferSetLength(length);
    value.ReleaseBufferSetLength(::GetWindowTextA(control, buffer, length + 1));
    return value;
}

/// Sets a text unless the control has it: the caret stays where it is then.
void showText(HWND control, LPCSTR value) {
    if (textOf(control) != value) {
        ::SetWindowTextA(control, value);
    }
}

std::string_view trimmed(const CString& value) {
    std::string_view view = value.View();
    const auto first = view.find_first_not_of(" \t");
    if (first == std::string_view::npos) {
        return {};
    }
    view.remove_prefix(first);
    return view.substr(0, view.find_last_not_of(" \t") + 1);
}

/// A whole number that fits the range; nothing else may stand beside it.
bool parseWhole(const CString& value, long long min, long long max, long long& number) {
    std::string_view view = trimmed(value);
    // std::from_chars knows no plus sign.
    if (!view.empty() && view.front() == '+') {
        view.remove_prefix(1);
    }
    const auto [end, error] = std::from_chars(view.data(), view.data() + view.size(), number);
    return error == std::errc() && end == view.data() + view.size() && number >= min && number <= max;
}

bool parseReal(const CString& value, double& number) {
    const std::string view(trimmed(value));
    const char* end = nullptr;
    number = text::toDouble(view.c_str(), &end);
    return !view.empty() && end == view.c_str() + view.size() && std::isfinite(number);
}

[[noreturn]] void refuse(CDataExchange& dx, UINT messageId) {
    AfxMessageBox(messageId, MB_ICONEXCLAMATION);
    dx.Fail();
}

template <class Number>
void exchangeWhole(CDataExchange* dx, int id, Number& value, long long min, long long max, UINT messageId) {
    const HWND control = dx->PrepareEditCtrl(id);
    if (!dx->m_bSaveAndValidate) {
        showText(control, std::to_string(value).c_str());
        return;
    }
    long long number = 0;
    if (!parseWhole(textOf(control), min, max, number)) {
        refuse(*dx, messageId);
    }
    value = static_cast<Number>(number);
}

template <class Number>
void exchangeReal(CDataExchange* dx, int id, Number& value) {
    const HWND control = dx->PrepareEditCtrl(id);
    if (!dx->m_bSaveAndValidate) {
        showText(control, text::formatDouble(value, std::numeric_limits<Number>::digits10).c_str());
        return;
    }
    double number = 0;
    const bool read = parseReal(textOf(control), number);
    if (!read || std::abs(number) > static_cast<double>(std::numeric_limits<Number>::max())) {
        refuse(*dx, AFX_IDP_PARSE_REAL);
    }
    value = static_cast<Number>(number);
}

constexpr long long intMin = std::numeric_limits<std::int32_t>::min();
constexpr long long intMax = std::numeric_limits<std::int32_t>::max();
constexpr long long uintMax = std::numeric_limits<std::uint32_t>::max();

} // namespace

void DDX_Control(CDataExchange* dx, int id, CWnd& control) {
    if (control.m_hWnd) {
        return;
    }
    const HWND window = dx->PrepareCtrl(id);
    if (!control.SubclassWindow(window)) {
        std::fprintf(stderr, "Data exchange: the control %d is bound to two objects.\n", id);
        AfxThrowNotSupportedException();
    }
}

// --- texts and numbers ---

void DDX_Text(CDataExchange* dx, int id, CString& value) {
    const HWND control = dx->PrepareEditCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = textOf(control);
    } else {
        showText(control, value);
    }
}

void DDX_Text(CDataExchange* dx, int id, LPSTR value, int size) {
    const HWND control = dx->PrepareEditCtrl(id);
    if (dx->m_bSaveAndValidate) {
        ::GetWindowTextA(control, value, size);
    } else {
        showText(control, value);
    }
}

void DDX_Text(CDataExchange* dx, int id, BYTE& value) {
    exchangeWhole(dx, id, value, 0, 255, AFX_IDP_PARSE_BYTE);
}

void DDX_Text(CDataExchange* dx, int id, short& value) {
    exchangeWhole(dx, id, value, std::numeric_limits<short>::min(), std::numeric_limits<short>::max(),
                  AFX_IDP_PARSE_INT);
}

void DDX_Text(CDataExchange* dx, int id, int& value) {
    exchangeWhole(dx, id, value, intMin, intMax, AFX_IDP_PARSE_INT);
}

void DDX_Text(CDataExchange* dx, int id, UINT& value) {
    exchangeWhole(dx, id, value, 0, uintMax, AFX_IDP_PARSE_UINT);
}

void DDX_Text(CDataExchange* dx, int id, long& value) {
    exchangeWhole(dx, id, value, intMin, intMax, AFX_IDP_PARSE_INT);
}

void DDX_Text(CDataExchange* dx, int id, unsigned long& value) {
    exchangeWhole(dx, id, value, 0, uintMax, AFX_IDP_PARSE_UINT);
}

void DDX_Text(CDataExchange* dx, int id, float& value) {
    exchangeReal(dx, id, value);
}

void DDX_Text(CDataExchange* dx, int id, double& value) {
    exchangeReal(dx, id, value);
}

// --- marks and lines ---

void DDX_Check(CDataExchange* dx, int id, int& value) {
    const HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = static_cast<int>(::SendMessageA(control, BM_GETCHECK, 0, 0));
    } else {
        // A member that was never set shows no mark.
        value = value >= 0 && value <= 2 ? value : 0;
        ::SendMessageA(control, BM_SETCHECK, static_cast<WPARAM>(value), 0);
    }
}

void DDX_Radio(CDataExchange* dx, int id, int& value) {
    HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = -1;
    }
    int index = 0;
    bool first = true;
    const auto style = [&] { return static_cast<DWORD>(::GetWindowLongPtrA(control, GWL_STYLE)); };
    // The group ends before the next control with WS_GROUP. What stands in it beside radio buttons does not count.
    while (control && (first || (style() & WS_GROUP) == 0)) {
        first = false;
        if ((::SendMessageA(control, WM_GETDLGCODE, 0, 0) & DLGC_RADIOBUTTON) != 0) {
            if (!dx->m_bSaveAndValidate) {
                ::SendMessageA(control, BM_SETCHECK, index == value ? BST_CHECKED : BST_UNCHECKED, 0);
            } else if (::SendMessageA(control, BM_GETCHECK, 0, 0) != 0) {
                value = index;
            }
            ++index;
        }
        control = ::GetWindow(control, GW_HWNDNEXT);
    }
}

namespace {

/// The messages by which list and combo boxes do the same.
struct ListMessages {
    UINT find;
    UINT select;
    UINT current;
    UINT setCurrent;
    UINT textLength;
    UINT text;
};
constexpr ListMessages listBox{LB_FINDSTRINGEXACT, LB_SELECTSTRING, LB_GETCURSEL,
                               LB_SETCURSEL,       LB_GETTEXTLEN,   LB_GETTEXT};

CString lineOf(HWND control, const ListMessages& messages) {
    const LRESULT index = ::SendMessageA(control, messages.current, 0, 0);
    const LRESULT length = ::SendMessageA(control, messages.textLength, static_cast<WPARAM>(index), 0);
    if (index < 0 || length < 0) {
        return {};
    }
    std::vector<char> buffer(static_cast<std::size_t>(length) + 1);
    ::SendMessageA(control, messages.text, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(buffer.data()));
    return CString(buffer.data());
}

/// Selects the line that is the whole text; false when there is none.
bool selectWhole(HWND control, const CString& value, UINT find, UINT setCurrent) {
    const LRESULT index =
        ::SendMessageA(control, find, static_cast<WPARAM>(-1), reinterpret_cast<LPARAM>(value.GetString()));
    // Without such a line, -1 takes the former choice away.
    ::SendMessageA(control, setCurrent, static_cast<WPARAM>(index), 0);
    return index >= 0;
}

void exchangeIndex(CDataExchange* dx, int id, int& value, UINT current, UINT setCurrent) {
    const HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = static_cast<int>(::SendMessageA(control, current, 0, 0));
    } else {
        ::SendMessageA(control, setCurrent, static_cast<WPARAM>(value), 0);
    }
}

} // namespace

void DDX_LBString(CDataExchange* dx, int id, CString& value) {
    const HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = lineOf(control, listBox);
    } else {
        ::SendMessageA(control, LB_SELECTSTRING, static_cast<WPARAM>(-1), reinterpret_cast<LPARAM>(value.GetString()));
    }
}

void DDX_LBStringExact(CDataExchange* dx, int id, CString& value) {
    if (dx->m_bSaveAndValidate) {
        DDX_LBString(dx, id, value);
    } else {
        selectWhole(dx->PrepareCtrl(id), value, LB_FINDSTRINGEXACT, LB_SETCURSEL);
    }
}

void DDX_LBIndex(CDataExchange* dx, int id, int& value) {
    exchangeIndex(dx, id, value, LB_GETCURSEL, LB_SETCURSEL);
}

void DDX_CBString(CDataExchange* dx, int id, CString& value) {
    const HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = textOf(control);
        return;
    }
    const auto text = reinterpret_cast<LPARAM>(value.GetString());
    if (::SendMessageA(control, CB_SELECTSTRING, static_cast<WPARAM>(-1), text) == CB_ERR) {
        showText(control, value); // a field that is typed into takes any text
    }
}

void DDX_CBStringExact(CDataExchange* dx, int id, CString& value) {
    const HWND control = dx->PrepareCtrl(id);
    if (dx->m_bSaveAndValidate) {
        value = textOf(control);
    } else if (!selectWhole(control, value, CB_FINDSTRINGEXACT, CB_SETCURSEL)) {
        showText(control, value);
    }
}

void DDX_CBIndex(CDataExchange* dx, int id, int& value) {
    exchangeIndex(dx, id, value, CB_GETCURSEL, CB_SETCURSEL);
}

void DDX_Scroll(CDataExchange* dx, int id, int& value) {
    exchangeIndex(dx, id, value, SBM_GETPOS, SBM_SETPOS);
}

// --- checks ---

namespace {

void checkRange(CDataExchange* dx, bool inside, UINT messageId, const std::string& min, const std::string& max) {
    if (inside || !dx->m_bSaveAndValidate) {
        return; // a member that is out of range itself is shown as it is
    }
    CString message;
    AfxFormatString2(message, messageId, min.c_str(), max.c_str());
    AfxMessageBox(message.GetString(), MB_ICONEXCLAMATION, messageId);
    dx->Fail();
}

template <class Number>
void checkWhole(CDataExchange* dx, Number value, Number min, Number max) {
    checkRange(dx, value >= min && value <= max, AFX_IDP_PARSE_INT_RANGE, std::to_string(min), std::to_string(max));
}

template <class Number>
void checkReal(CDataExchange* dx, Number value, Number min, Number max) {
    constexpr int digits = std::numeric_limits<Number>::digits10;
    checkRange(dx, value >= min && value <= max, AFX_IDP_PARSE_REAL_RANGE, text::formatDouble(min, digits),
               text::formatDouble(max, digits));
}

} // namespace

void DDV_MaxChars(CDataExchange* dx, const CString& value, int count) {
    if (dx->m_bSaveAndValidate) {
        if (value.GetLength() > count) {
            CString message;
            AfxFormatString1(message, AFX_IDP_PARSE_STRING_SIZE, std::to_string(count).c_str());
            AfxMessageBox(message.GetString(), MB_ICONEXCLAMATION, AFX_IDP_PARSE_STRING_SIZE);
            dx->Fail();
        }
        return;
    }
    const HWND control = ::GetDlgItem(dx->m_pDlgWnd->m_hWnd, dx->m_idLastControl);
    char className[16] = "";
    ::GetClassNameA(control, className, sizeof(className));
    const UINT message = text::equalNoCase(className, "ComboBox") ? CB_LIMITTEXT : EM_LIMITTEXT;
    ::SendMessageA(control, message, static_cast<WPARAM>(count), 0);
}

void DDV_MinMaxByte(CDataExchange* dx, BYTE value, BYTE min, BYTE max) {
    checkWhole<int>(dx, value, min, max);
}

void DDV_MinMaxShort(CDataExchange* dx, short value, short min, short max) {
    checkWhole<int>(dx, value, min, max);
}

void DDV_MinMaxInt(CDataExchange* dx, int value, int min, int max) {
    checkWhole(dx, value, min, max);
}

void DDV_MinMaxLong(CDataExchange* dx, long value, long min, long max) {
    checkWhole(dx, value, min, max);
}

void DDV_MinMaxUInt(CDataExchange* dx, UINT value, UINT min, UINT max) {
    checkWhole(dx, value, min, max);
}

void DDV_MinMaxDWord(CDataExchange* dx, DWORD value, DWORD min, DWORD max) {
    checkWhole(dx, value, min, max);
}

void DDV_MinMaxFloat(CDataExchange* dx, const float& value, float min, float max) {
    checkReal(dx, value, min, max);
}

void DDV_MinMaxDouble(CDataExchange* dx, const double& value, double min, double max) {
    checkReal(dx, value, min, max);
}
