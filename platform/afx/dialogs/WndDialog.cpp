#include "platform/afx/core/Wnd.h"

#include "platform/afx/controls/detail/ButtonWindow.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/DataExchange.h"
#include "platform/afx/dialogs/detail/DialogKeys.h"
#include "platform/base/Exception.h"
#include "platform/base/Text.h"
#include "platform/win/FrameworkIds.h"

#include <charconv>
#include <limits>

// The members of CWnd that work on the items of a dialog.

using namespace tvx::afx;

void CWnd::SetDlgItemText(int id, LPCSTR text) {
    ::SetWindowTextA(::GetDlgItem(m_hWnd, id), text);
}

int CWnd::GetDlgItemText(int id, LPSTR buffer, int size) const {
    const HWND item = ::GetDlgItem(m_hWnd, id);
    if (!item && size > 0) {
        *buffer = '\0';
    }
    return item ? ::GetWindowTextA(item, buffer, size) : 0;
}

int CWnd::GetDlgItemText(int id, CString& text) const {
    const CWnd* item = GetDlgItem(id);
    if (!item) {
        text.Empty();
    } else {
        item->GetWindowText(text);
    }
    return text.GetLength();
}

void CWnd::SetDlgItemInt(int id, UINT value, BOOL isSigned) {
    const long long number = isSigned ? static_cast<long long>(static_cast<int>(value)) : value;
    SetDlgItemText(id, std::to_string(number).c_str());
}

UINT CWnd::GetDlgItemInt(int id, BOOL* translated, BOOL isSigned) const {
    CString text;
    GetDlgItemText(id, text);
    std::string_view view = text.View();
    view.remove_prefix(std::min(view.find_first_not_of(" \t"), view.size()));
    long long number = 0;
    const auto [end, error] = std::from_chars(view.data(), view.data() + view.size(), number);
    const long long min = isSigned ? std::numeric_limits<int>::min() : 0;
    const long long max = isSigned ? std::numeric_limits<int>::max() : std::numeric_limits<UINT>::max();
    const bool whole = error == std::errc() && end == view.data() + view.size() && number >= min && number <= max;
    if (translated) {
        *translated = whole ? TRUE : FALSE;
    }
    return whole ? static_cast<UINT>(number) : 0;
}

void CWnd::CheckDlgButton(int id, UINT check) {
    SendDlgItemMessage(id, BM_SETCHECK, check);
}

void CWnd::CheckRadioButton(int first, int last, int checked) {
    for (int id = first; id <= last; ++id) {
        SendDlgItemMessage(id, BM_SETCHECK, id == checked ? BST_CHECKED : BST_UNCHECKED);
    }
}

UINT CWnd::IsDlgButtonChecked(int id) const {
    return static_cast<UINT>(::SendMessageA(::GetDlgItem(m_hWnd, id), BM_GETCHECK, 0, 0));
}

int CWnd::GetCheckedRadioButton(int first, int last) const {
    for (int id = first; id <= last; ++id) {
        if (IsDlgButtonChecked(id) != 0) {
            return id;
        }
    }
    return 0;
}

LRESULT CWnd::SendDlgItemMessage(int id, UINT message, WPARAM wParam, LPARAM lParam) {
    return ::SendMessageA(::GetDlgItem(m_hWnd, id), message, wParam, lParam);
}

namespace {

CWnd* objectOf(Window* window) {
    return window ? CWnd::FromHandle(window->handle()) : nullptr;
}

Direction directionOf(BOOL previous) {
    return previous ? Direction::Backward : Direction::Forward;
}

} // namespace

CWnd* CWnd::GetNextDlgTabItem(CWnd* from, BOOL previous) const {
    Window* dialog = GetState();
    const Window* start = from ? from->GetState() : nullptr;
    return dialog ? objectOf(nextTabItem(*dialog, start, directionOf(previous))) : nullptr;
}

CWnd* CWnd::GetNextDlgGroupItem(CWnd* from, BOOL previous) const {
    const Window* start = from ? from->GetState() : nullptr;
    return start ? objectOf(nextGroupItem(*start, directionOf(previous))) : nullptr;
}

// --- data exchange ---

void CWnd::DoDataExchange(CDataExchange*) {}

BOOL CWnd::UpdateData(BOOL save) {
    CDataExchange dx(this, save);
    // What the exchange itself changes is no act of the user's.
    const HeldNotifications held(m_hWnd);
    try {
        DoDataExchange(&dx);
        return TRUE;
    } catch (CUserException* error) {
        error->Delete(); // the user has been told and the control has the keyboard
    } catch (CException* error) {
        error->ReportError(MB_ICONEXCLAMATION, AFX_IDP_INTERNAL_FAILURE);
        error->Delete();
    }
    return FALSE;
}

// --- states of controls that stand for commands ---

void CWnd::UpdateDialogControls(CCmdTarget* target, BOOL disableIfNoHandler) {
    const Window* window = GetState();
    if (!window) {
        return;
    }
    const auto children = window->children();
    UINT index = 0;
    for (const Window* child : children) {
        CCmdUI element;
        element.m_pOther = CWnd::FromHandle(child->handle());
        element.m_nID = static_cast<UINT>(child->id());
        element.m_nIndex = index++;
        element.m_nIndexMax = static_cast<UINT>(children.size());
        if (element.m_nID == 0 || element.m_nID == 0xFFFF) {
            continue;
        }
        // The dialog's own handlers come first. Only push buttons stand for commands and are greyed without one.
        if (CWnd::OnCmdMsg(element.m_nID, CN_UPDATE_COMMAND_UI, &element, nullptr)) {
            continue;
        }
        const auto* button = dynamic_cast<const ButtonWindow*>(child);
        element.DoUpdate(target, disableIfNoHandler && button && button->isPushButton());
    }
}
