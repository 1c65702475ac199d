#include "platform/afx/dialogs/PropertySheet.h"

#include "platform/afx/controls/detail/TabWindow.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/dialogs/detail/DialogKeys.h"
#include "platform/afx/dialogs/detail/DialogWindow.h"
#include "platform/afx/dialogs/detail/HelpOffered.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/FrameworkIds.h"

#include <algorithm>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CPropertySheet, CDialog)

// clang-format off
BEGIN_MESSAGE_MAP(CPropertySheet, CDialog)
    ON_COMMAND(ID_APPLY_NOW, &CPropertySheet::OnApplyNow)
    ON_COMMAND(IDHELP, &CPropertySheet::OnHelpButton)
    ON_NOTIFY(TCN_SELCHANGE, AFX_IDC_TAB_CONTROL, &CPropertySheet::OnChooseTab)
    ON_MESSAGE(WM_COMMANDHELP, &CPropertySheet::OnCommandHelp)
    ON_WM_CLOSE()
END_MESSAGE_MAP()
// clang-format on

CPropertySheet::CPropertySheet(LPCSTR caption, CWnd* parent, UINT firstPage) : m_caption(caption) {
    m_pParentWnd = parent;
    m_psh.pszCaption = m_caption;
    m_psh.nStartPage = firstPage;
    m_psh.dwFlags = isHelpOffered() ? PSH_HASHELP : 0;
}

CPropertySheet::CPropertySheet(UINT captionId, CWnd* parent, UINT firstPage) : CPropertySheet("", parent, firstPage) {
    (void)m_caption.LoadString(captionId);
    m_psh.pszCaption = m_caption;
}

CPropertySheet::~CPropertySheet() = default;

// --- pages ---

int CPropertySheet::GetPageCount() const {
    return static_cast<int>(m_pages.size());
}

CPropertyPage* CPropertySheet::GetPage(int index) const {
    return index >= 0 && index < GetPageCount() ? m_pages[static_cast<std::size_t>(index)] : nullptr;
}

int CPropertySheet::GetPageIndex(const CPropertyPage* page) const {
    const auto found = std::ranges::find(m_pages, page);
    return found != m_pages.end() ? static_cast<int>(found - m_pages.begin()) : -1;
}

int CPropertySheet::GetActiveIndex() const {
    return m_hWnd ? m_active : static_cast<int>(m_psh.nStartPage);
}

CPropertyPage* CPropertySheet::GetActivePage() const {
    return GetPage(GetActiveIndex());
}

namespace {

TabWindow& tabsOf(const CWnd& sheet) {
    return static_cast<TabWindow&>(*sheet.GetState()->child(AFX_IDC_TAB_CONTROL));
}

QString titleOf(const tvx::DialogTemplate& description) {
    return toQt(description.title.c_str());
}

} // namespace

void CPropertySheet::AddPage(CPropertyPage* page) {
    m_pages.push_back(page);
    if (m_hWnd) {
        const auto description = page->describe();
        tabsOf(*this).insert(GetPageCount() - 1, description ? titleOf(*description) : QString());
        if (m_active < 0) {
            activate(0);
        }
    }
}

void CPropertySheet::RemovePage(CPropertyPage* page) {
    RemovePage(GetPageIndex(page));
}

void CPropertySheet::RemovePage(int index) {
    CPropertyPage* page = GetPage(index);
    if (!page) {
        return;
    }
    m_pages.erase(m_pages.begin() + index);
    if (!m_hWnd) {
        return;
    }
    tabsOf(*this).remove(index);
    if (page->m_hWnd) {
        page->DestroyWindow();
    }
    page->m_isModified = false;
    noteModified();
    if (index < m_active) {
        --m_active;
    } else if (index == m_active) {
        m_active = -1;
        activate(std::min(index, GetPageCount() - 1));
    }
}

BOOL CPropertySheet::SetActivePage(CPropertyPage* page) {
    return SetActivePage(GetPageIndex(page));
}

BOOL CPropertySheet::SetActivePage(int index) {
    if (!GetPage(index)) {
        return FALSE;
    }
    if (m_hWnd) {
        return activate(index) ? TRUE : FALSE;
    }
    m_psh.nStartPage = static_cast<UINT>(index);
    return TRUE;
}

LRESULT CPropertySheet::tell(CPropertyPage& page, UINT code) {
    NMHDR header{m_hWnd, 0, code};
    return page.SendMessage(WM_NOTIFY, 0, reinterpret_cast<LPARAM>(&header));
}

/// Makes the window of a page that is to be seen for the first time.
bool CPropertySheet::make(CPropertyPage& page) {
    if (page.m_hWnd) {
        return true;
    }
    page.m_isFilled = true;
    page.m_isModified = false;
    if (!page.Create(page.m_lpszTemplateName, this)) {
        return false;
    }
    // Behind the tabs in the order of Tab, before the buttons.
    page.GetState()->placeAfter(&tabsOf(*this));
    return true;
}

/// The first page that lets itself be shown, from one on in a direction; -1 when none does.
int CPropertySheet::firstWilling(int index, int step) {
    for (CPropertyPage* page = GetPage(index); page; page = GetPage(index)) {
        if (!make(*page)) {
            return -1;
        }
        const bool willing = tell(*page, PSN_SETACTIVE) != -1;
        if (!m_hWnd) {
            return -1;
        }
        if (willing) {
            return index;
        }
        index += step;
    }
    return -1;
}

bool CPropertySheet::activate(int index) {
    if (index == m_active || !GetPage(index)) {
        return index == m_active;
    }
    CPropertyPage* old = GetPage(m_active);
    if (old && tell(*old, PSN_KILLACTIVE) != FALSE) {
        if (m_hWnd) {
            tabsOf(*this).select(m_active);
        }
        return false;
    }
    if (!m_hWnd) {
        return false;
    }
    const int willing = firstWilling(index, index < m_active ? -1 : 1);
    if (!m_hWnd) {
        return false;
    }
    if (willing < 0) {
        tabsOf(*this).select(m_active);
        if (old) {
            tell(*old, PSN_SETACTIVE);
        }
        return false;
    }
    show(willing);
    return willing == index;
}

/// Shows a page in place of the one that is seen.
void CPropertySheet::show(int index) {
    TabWindow& tabs = tabsOf(*this);
    CPropertyPage& page = *GetPage(index);
    CPropertyPage* old = GetPage(m_active);
    m_active = index;
    tabs.select(index);
    const bool hadKeyboard = old && old->IsChild(GetFocus());
    const QRect area = tabs.pageArea().translated(tabs.windowRect().topLeft());
    page.MoveWindow(area.x(), area.y(), area.width(), area.height());
    page.ShowWindow(SW_SHOW);
    if (CWnd* first = hadKeyboard ? page.GetNextDlgTabItem(nullptr) : nullptr) {
        GotoDlgCtrl(first);
    } else if (hadKeyboard) {
        GetDlgItem(AFX_IDC_TAB_CONTROL)->SetFocus();
    }
    if (old && old != &page && old->m_hWnd) {
        old->ShowWindow(SW_HIDE);
    }
    if (CWnd* help = GetDlgItem(IDHELP)) {
        help->EnableWindow((page.m_psp.dwFlags & PSP_HASHELP) != 0);
    }
}

// --- buttons ---

void CPropertySheet::noteModified() {
    CWnd* apply = GetDlgItem(ID_APPLY_NOW);
    if (!apply) {
        return;
    }
    const bool any = std::ranges::any_of(m_pages, [](const CPropertyPage* page) { return page->m_isModified; });
    if (!any && GetFocus() == apply) {
        GetDlgItem(IDOK)->SetFocus();
    }
    apply->EnableWindow(any);
}

/// Has all pages take over what was changed. False when one refuses.
bool CPropertySheet::applyAll() {
    CPropertyPage* shown = GetPage(m_active);
    if (shown && tell(*shown, PSN_KILLACTIVE) != FALSE) {
        return false;
    }
    for (int i = 0; m_hWnd && i < GetPageCount(); ++i) {
        CPropertyPage& page = *GetPage(i);
        const LRESULT answer = page.m_hWnd ? tell(page, PSN_APPLY) : PSNRET_NOERROR;
        if (answer == PSNRET_INVALID && m_hWnd) {
            activate(i);
        }
        if (answer != PSNRET_NOERROR) {
            return false;
        }
    }
    return m_hWnd != nullptr;
}

void CPropertySheet::OnOK() {
    if (applyAll()) {
        EndDialog(IDOK);
    }
}

void CPropertySheet::OnApplyNow() {
    if (!applyAll()) {
        return;
    }
    for (CPropertyPage* page : m_pages) {
        page->m_isModified = false;
    }
    noteModified();
    if (CPropertyPage* shown = GetPage(m_active)) {
        tell(*shown, PSN_SETACTIVE);
    }
}

void CPropertySheet::OnCancel() {
    CPropertyPage* shown = GetPage(m_active);
    if (shown && tell(*shown, PSN_QUERYCANCEL) != FALSE) {
        return;
    }
    for (int i = 0; m_hWnd && i < GetPageCount(); ++i) {
        if (CPropertyPage& page = *GetPage(i); page.m_hWnd) {
            tell(page, PSN_RESET);
        }
    }
    if (m_hWnd) {
        EndDialog(IDCANCEL);
    }
}

void CPropertySheet::OnClose() {
    // Cancel may not be there, or not to be pressed any more.
    OnCancel();
}

void CPropertySheet::OnHelpButton() {
    if (CPropertyPage* shown = GetPage(m_active)) {
        tell(*shown, PSN_HELP);
    }
}

BOOL CPropertySheet::PressButton(int button) {
    int id = 0;
    switch (button) {
    case PSBTN_OK:
        id = IDOK;
        break;
    case PSBTN_APPLYNOW:
        id = ID_APPLY_NOW;
        break;
    case PSBTN_CANCEL:
        id = IDCANCEL;
        break;
    case PSBTN_HELP:
        id = IDHELP;
        break;
    default:
        return FALSE;
    }
    const CWnd* pressed = m_hWnd ? GetDlgItem(id) : nullptr;
    if (!pressed || !pressed->IsWindowEnabled()) {
        return FALSE;
    }
    SendMessage(WM_COMMAND, MAKEWPARAM(id, BN_CLICKED), reinterpret_cast<LPARAM>(pressed->m_hWnd));
    return TRUE;
}

// --- keys and help ---

void CPropertySheet::OnChooseTab(NMHDR*, LRESULT*) {
    activate(tabsOf(*this).current());
}

/// Goes to the next or previous page, round and round.
void CPropertySheet::turnTo(int step) {
    const int count = GetPageCount();
    if (count > 1) {
        activate((m_active + step + count) % count);
    }
}

BOOL CPropertySheet::PreTranslateMessage(MSG* message) {
    const bool isControl = message->message == WM_KEYDOWN && GetKeyState(VK_CONTROL) < 0;
    const bool isBack = GetKeyState(VK_SHIFT) < 0;
    if (isControl && message->wParam == VK_TAB) {
        turnTo(isBack ? -1 : 1);
        return TRUE;
    }
    if (isControl && !isBack && (message->wParam == VK_PRIOR || message->wParam == VK_NEXT)) {
        turnTo(message->wParam == VK_PRIOR ? -1 : 1);
        return TRUE;
    }
    const CWnd* cancel = GetDlgItem(IDCANCEL);
    if (message->message == WM_KEYDOWN && message->wParam == VK_ESCAPE && cancel && !cancel->IsWindowEnabled()) {
        OnCancel();
        return TRUE;
    }
    return CDialog::PreTranslateMessage(message);
}

LRESULT CPropertySheet::OnCommandHelp(WPARAM wParam, LPARAM lParam) {
    const CPropertyPage* shown = GetPage(m_active);
    const LRESULT answer = shown ? shown->SendMessage(WM_COMMANDHELP, wParam, lParam) : 0;
    return answer != 0 ? answer : CDialog::OnCommandHelp(wParam, lParam);
}
