#include "PreferencePage.h"

#include "Preferences.h"
#include "s/Help.h"

#include <algorithm>
#include <cstring>

// clang-format off
BEGIN_MESSAGE_MAP(CPreferencePage, CDialog)
    ON_WM_SIZE()
END_MESSAGE_MAP()
// clang-format on

CPreferencePage::CPreferencePage(UINT templateId, CPreferences& sheet)
    : CDialog(templateId), m_template(templateId), m_sheet(sheet) {}

BOOL CPreferencePage::Create(CWnd* parent) {
    m_isFilling = true;
    const BOOL made = CDialog::Create(m_template, parent);
    m_isFilling = false;
    FindPlaces(); // only now the page has its size
    return made;
}

BOOL CPreferencePage::OnInitDialog() {
    CDialog::OnInitDialog();
    return FALSE; // the keyboard stays in the tree until the user comes here
}

void CPreferencePage::Show() {
    if (m_wrong != 0) {
        return;
    }
    m_isFilling = true;
    UpdateData(FALSE);
    m_isFilling = false;
}

bool CPreferencePage::Take() {
    CDataExchange exchange(this, TRUE);
    m_wrong = 0;
    try {
        DoDataExchange(&exchange);
    } catch (CUserException* told) {
        told->Delete();
        m_wrong = exchange.m_idLastControl;
    }
    return m_wrong == 0;
}

void CPreferencePage::ShowWrong() {
    if (CWnd* field = GetDlgItem(m_wrong)) {
        GotoDlgCtrl(field);
    }
}

void CPreferencePage::ForgetWrong() {
    m_wrong = 0;
}

void CPreferencePage::ShowDefaults() {
    m_wrong = 0;
    SetDefaults();
    Show();
    SetChanged();
}

// --- layout ---

void CPreferencePage::FindPlaces() {
    CRect page;
    GetWindowRect(&page); // what is inside is known when the page is shown; it has no border
    m_made = page.Size();
    m_places.clear();
    const CWnd* tall = nullptr;
    for (CWnd* control = GetTopWindow(); control; control = control->GetNextWindow()) {
        Place place;
        place.control = control->m_hWnd;
        control->GetWindowRect(&place.rect);
        ScreenToClient(&place.rect);
        char kind[16] = {};
        GetClassNameA(place.control, kind, sizeof kind);
        const DWORD style = control->GetStyle();
        const bool isText = std::strcmp(kind, "Edit") == 0 && (style & ES_NUMBER) == 0;
        const bool isPush = std::strcmp(kind, "Button") == 0 && (style & 0x0F) <= BS_DEFPUSHBUTTON;
        const bool atEdge = place.rect.right >= m_made.cx - 1;
        // Rounded to pixels, a place and a width may end behind the page.
        const LONG over = std::max<LONG>(place.rect.right - m_made.cx, 0);
        place.rect.OffsetRect(isPush ? -over : 0, 0);
        place.rect.right -= isPush ? 0 : over;
        place.isTall = isText && (style & ES_MULTILINE) != 0;
        place.isBeneath = tall != nullptr;
        place.moves = isPush && atEdge;
        place.grows = isText || (atEdge && !isPush);
        tall = place.isTall ? control : tall;
        m_places.push_back(place);
    }
}

void CPreferencePage::OnSize(UINT type, int cx, int cy) {
    CDialog::OnSize(type, cx, cy);
    LayOut(CSize(std::max(cx - m_made.cx, 0), std::max(cy - m_made.cy, 0)));
}

void CPreferencePage::LayOut(CSize more) {
    for (const Place& place : m_places) {
        CRect rect = place.rect;
        rect.right += place.grows ? more.cx : 0;
        rect.bottom += place.isTall ? more.cy : 0;
        rect.OffsetRect(place.moves ? more.cx : 0, place.isBeneath ? more.cy : 0);
        ::MoveWindow(place.control, rect.left, rect.top, rect.Width(), rect.Height(), TRUE);
    }
}

void CPreferencePage::SetChanged() {
    m_sheet.SetPageChanged(*this);
}

// Enter and Esc mean the buttons of the sheet, wherever the keyboard is.
void CPreferencePage::OnOK() {
    m_sheet.PostMessage(WM_COMMAND, IDOK);
}

void CPreferencePage::OnCancel() {
    m_sheet.PostMessage(WM_COMMAND, IDCANCEL);
}

BOOL CPreferencePage::OnCommand(WPARAM wParam, LPARAM lParam) {
    const UINT code = HIWORD(wParam);
    const auto* control = CWnd::FromHandle(reinterpret_cast<HWND>(lParam));
    const bool isButton = control && (control->SendMessage(WM_GETDLGCODE) & DLGC_BUTTON) != 0;
    const DWORD kind = isButton ? control->GetStyle() & 0x0F : 0;
    const bool isCheck = kind >= BS_CHECKBOX && kind <= BS_AUTORADIOBUTTON; // others open something
    const bool changes = code == EN_CHANGE || (isCheck ? code == BN_CLICKED : !isButton && code == CBN_SELCHANGE);
    if (lParam != 0 && changes && !m_isFilling) {
        SetChanged();
    }
    return CDialog::OnCommand(wParam, lParam);
}

void OnPreferencePage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what) {
    auto* const fields = static_cast<CPreferencePage*>(page);
    auto* const sheet = static_cast<CPreferences*>(item->GetPropSheet());
    if (!fields) {
        return;
    }
    switch (what) {
    case Gui_PropItem::NotifyActivate:
    case Gui_PropItem::NotifyReactivate:
        fields->Show();
        break;
    case Gui_PropItem::NotifyDeactivate:
        if (!fields->Take()) {
            sheet->ComeBack(*item);
        }
        break;
    case Gui_PropItem::NotifyApply:
        if (!fields->Take()) {
            sheet->DontClose();
        } else {
            sheet->Store();
        }
        break;
    case Gui_PropItem::NotifyHelp:
        Gui_Help::OnDialog(fields->GetTopic());
        break;
    case Gui_PropItem::NotifyFocusFirst:
        sheet->FocusPage(*fields, false);
        break;
    case Gui_PropItem::NotifyFocusLast:
        sheet->FocusPage(*fields, true);
        break;
    }
}
