// The dialog of a property sheet: how it opens and ends, and what its controls, keys and size do.
#include "res/resource.h"
#include "s/PropSheetRecord.h"

// clang-format off
BEGIN_MESSAGE_MAP(Gui_PropSheet, CDialog)
    ON_BN_CLICKED(GUI_IDC_PROP_APPLY, &Gui_PropSheet::OnApply)
    ON_BN_CLICKED(GUI_IDC_HELP, &Gui_PropSheet::OnHelp)
    ON_BN_CLICKED(GUI_IDC_PROP_DEFAULTS, &Gui_PropSheet::OnDefaults)
    ON_EN_CHANGE(GUI_IDC_PROP_SEARCH, &Gui_PropSheet::OnChangeSearch)
    ON_NOTIFY(TVN_SELCHANGEDA, GUI_IDC_PROP_TREE, &Gui_PropSheet::OnSelchangedTree)
    ON_MESSAGE(WM_COMMANDHELP, &Gui_PropSheet::OnCommandHelp)
    ON_WM_HELPINFO()
    ON_WM_SIZE()
    ON_WM_GETMINMAXINFO()
    ON_WM_DESTROY()
    ON_WM_VSCROLL()
    ON_WM_HSCROLL()
    ON_WM_MOUSEWHEEL()
END_MESSAGE_MAP()
// clang-format on

// --- opening and closing ---

BOOL Gui_PropSheet::OnInitDialog() {
    CDialog::OnInitDialog();
    Record& record = *m_record;
    record.currentItem = nullptr;
    record.titleBand.SubclassDlgItem(GUI_IDC_PROP_TITLE, this);
    record.tree.attach(*this, GUI_IDC_PROP_TREE, record.multipleSelection);
    record.titleBand.SetWindowText("");
    record.titleBand.SetTitle("");
    record.titleBand.SetSubTitle("");
    record.addSearchField();
    record.tree.build(record.items);
    record.selection = record.firstSelection();
    record.tree.select(record.selection);
    record.switchTo(record.selection);
    if (!m_hWnd) { // a page may have had enough
        return TRUE;
    }
    if (CWnd* frame = GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)) {
        frame->ShowWindow(SW_HIDE);
    }
    if (!record.windowTitle.IsEmpty()) {
        SetWindowText(record.windowTitle.c_str());
    }
    record.treeWindow = record.tree.control.m_hWnd;
    record.okWindow = ::GetDlgItem(m_hWnd, IDOK);
    record.restoreSize();
    record.fitScreen();
    record.wasOpen = true;
    return TRUE;
}

void Gui_PropSheet::OnDestroy() {
    m_record->remember();
    CDialog::OnDestroy();
    m_record->tree.forget();
    m_record->place.forget();
    m_record->treeWindow = m_record->okWindow = nullptr;
    m_record->isLaidOut = false;
}

// --- buttons ---

void Gui_PropSheet::OnApply() {
    m_record->clearFlags();
    m_record->apply();
}

void Gui_PropSheet::OnOK() {
    m_record->clearFlags();
    m_record->wantsToClose = true;
    m_record->apply();
    if (m_hWnd && !m_record->dontClose) {
        CDialog::OnOK();
    }
}

void Gui_PropSheet::OnCancel() {
    m_record->clearFlags();
    if (m_record->mayDiscard()) {
        CDialog::OnCancel();
    }
}

void Gui_PropSheet::OnHelp() {
    m_record->clearFlags();
    if (m_record->currentItem) {
        m_record->currentItem->ShowHelp();
    }
}

LRESULT Gui_PropSheet::OnCommandHelp(WPARAM, LPARAM) {
    OnHelp();
    return TRUE;
}

BOOL Gui_PropSheet::OnHelpInfo(HELPINFO* info) {
    if (info->iContextType != HELPINFO_WINDOW) {
        return CDialog::OnHelpInfo(info);
    }
    // Taken here already: a page that is a dialog would answer WM_COMMANDHELP with its own number.
    OnHelp();
    return TRUE;
}

void Gui_PropSheet::OnDefaults() {
    m_record->clearFlags();
    Gui_PropItem* const item = m_record->currentItem;
    if (item && item->GetDefaultsFunction()) {
        item->GetDefaultsFunction()(item, item->GetPage());
    }
}

// --- tree, keys and wheel ---

void Gui_PropSheet::OnSelchangedTree(NMHDR*, LRESULT* result) {
    *result = 0;
    if (!m_record->tree.isQuiet()) {
        m_record->selection = GetSelectedItems();
        m_record->switchTo(m_record->selection);
    }
}

void Gui_PropSheet::OnChangeSearch() {
    CString words;
    m_record->searchField.GetWindowText(words);
    m_record->tree.filter(words, m_record->selection);
}

BOOL Gui_PropSheet::PreTranslateMessage(MSG* message) {
    if (message->message == WM_KEYDOWN) {
        const bool isTab = message->wParam == VK_TAB;
        if (isTab ? m_record->onTab() : m_record->onSearchKey(static_cast<UINT>(message->wParam))) {
            return TRUE;
        }
    }
    if (message->message == WM_MOUSEWHEEL && m_record->isGuarded(*message)) {
        m_record->place.onWheel(GET_WHEEL_DELTA_WPARAM(message->wParam));
        return TRUE;
    }
    const HWND self = m_hWnd;
    const HWND before = ::GetFocus();
    const BOOL taken = CDialog::PreTranslateMessage(message);
    if (::IsWindow(self) && ::GetFocus() != before) {
        m_record->place.show(::GetFocus());
    }
    return taken;
}

// --- size ---

void Gui_PropSheet::OnSize(UINT type, int cx, int cy) {
    CDialog::OnSize(type, cx, cy);
    if (type != SIZE_MINIMIZED) {
        m_record->layOut(CSize(cx, cy));
    }
}

void Gui_PropSheet::OnGetMinMaxInfo(MINMAXINFO* info) {
    CDialog::OnGetMinMaxInfo(info);
    CRect window;
    CRect client;
    GetWindowRect(&window);
    GetClientRect(&client);
    const CSize least = m_record->leastClient();
    if (least.cx > 0) {
        info->ptMinTrackSize.x = least.cx + window.Width() - client.Width();
        info->ptMinTrackSize.y = least.cy + window.Height() - client.Height();
    }
}

void Gui_PropSheet::OnVScroll(UINT code, UINT position, CScrollBar* bar) {
    if (!m_record->place.onScroll(SB_VERT, code, bar)) {
        CDialog::OnVScroll(code, position, bar);
    }
}

void Gui_PropSheet::OnHScroll(UINT code, UINT position, CScrollBar* bar) {
    if (!m_record->place.onScroll(SB_HORZ, code, bar)) {
        CDialog::OnHScroll(code, position, bar);
    }
}

BOOL Gui_PropSheet::OnMouseWheel(UINT flags, short delta, CPoint point) {
    CRect frame;
    if (const CWnd* control = GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)) {
        control->GetWindowRect(&frame);
    }
    const bool isTaken = frame.PtInRect(point) && m_record->place.onWheel(delta);
    return isTaken ? TRUE : CDialog::OnMouseWheel(flags, delta, point);
}
