#include "s/PropSheet.h"

#include "res/resource.h"
#include "s/PropSheetRecord.h"
#include "s/Record.h"
#include "s/StringOf.h"

#include <algorithm>
#include <set>

IMPLEMENT_DYNAMIC(Gui_PropSheet, CDialog)

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

Gui_PropSheet::Gui_PropSheet(const Port::StringBase<char>& title, CWnd* parent, bool multipleSelection)
    : CDialog(GUI_IDD_PROPERTIES, parent), m_record(MakeRecord<Record>(this, title, multipleSelection)) {}

Gui_PropSheet::~Gui_PropSheet() {
    // Pages and the tree tell a window that still stands of their end; there must be somebody to be told.
    if (m_hWnd) {
        try {
            DestroyWindow();
        } catch (...) {
            TRACE("A handler of a property sheet threw while the sheet was deleted.\n");
        }
    }
    m_record->currentItem = nullptr;
    const std::set<Gui_PropItem*> owned(m_record->items.begin(), m_record->items.end());
    for (Gui_PropItem* item : owned) {
        delete item;
    }
}

// --- items ---

void Gui_PropSheet::AddItem(Gui_PropItem* item, Gui_PropItem* parent, bool select) {
    item->SetParentItem(parent);
    AddItem(item, select);
}

void Gui_PropSheet::AddItem(Gui_PropItem* item, bool select) {
    item->SetPropSheet(this);
    m_record->items.push_back(item);
    if (select) {
        m_record->initiallySelected.push_back(item);
    }
}

std::vector<Gui_PropItem*> Gui_PropSheet::GetChildItems(const Gui_PropItem* parent) const {
    std::vector<Gui_PropItem*> children;
    std::ranges::copy_if(m_record->items, std::back_inserter(children),
                         [parent](const Gui_PropItem* item) { return item->GetParentItem() == parent; });
    return children;
}

std::vector<Gui_PropItem*> Gui_PropSheet::GetSelectedItems() const {
    return m_record->tree.selectedItems();
}

Gui_PropItem* Gui_PropSheet::GetPageItem(const std::vector<Gui_PropItem*>& items) {
    std::set<const Gui_PropItem*> seen; // items that stand above each other in a circle have an end, too
    for (Gui_PropItem* item = items.empty() ? nullptr : items.front(); item && seen.insert(item).second;
         item = item->GetParentItem()) {
        m_record->revivePages(item);
        if (item->GetPage()) {
            return item;
        }
    }
    return nullptr;
}

CWnd* Gui_PropSheet::GetCurrentPage() {
    return m_record->currentItem ? m_record->currentItem->GetPage() : nullptr;
}

void Gui_PropSheet::RefreshItemTree(bool reactivate) {
    m_record->tree.relabel();
    if (reactivate && m_record->currentItem) {
        m_record->currentItem->ReactivatePage();
    }
}

void Gui_PropSheet::itemChanged(Gui_PropItem* item) {
    m_record->tree.relabel(item);
    if (item == m_record->currentItem) {
        m_record->showDefaultsButton();
    }
}

// --- the window ---

Port::StringBase<char> Gui_PropSheet::GetWindowTitle() const {
    return m_record->windowTitle;
}

void Gui_PropSheet::SetWindowTitle(const Port::StringBase<char>& title) {
    m_record->windowTitle = title;
    if (m_hWnd) {
        SetWindowText(title.c_str());
    }
}

void Gui_PropSheet::SetFocusPrev() {
    ::SetFocus(m_record->treeWindow);
}

void Gui_PropSheet::SetFocusNext() {
    ::SetFocus(m_record->okWindow);
}

void Gui_PropSheet::ChangeCancelToClose() {
    if (CWnd* cancel = m_hWnd ? GetDlgItem(IDCANCEL) : nullptr) {
        cancel->SetWindowText(StringOf(GUI_IDS_CLOSE));
    }
}

bool Gui_PropSheet::WantsToClose() const {
    return m_record->wantsToClose;
}

void Gui_PropSheet::DontClose() {
    m_record->dontClose = true;
}

// --- what it has when a host asks ---

void Gui_PropSheet::SetSearch(bool search) {
    m_record->hasSearch = search;
}

void Gui_PropSheet::SetChangeMarks(bool marks) {
    m_record->tree.showsChanges = marks;
}

void Gui_PropSheet::SetMemory(const char* section) {
    m_record->remembers = section != nullptr;
    m_record->section = section;
}

void Gui_PropSheet::SetPageScrolling(bool scrolling) {
    m_record->place.scrolls = scrolling;
}

void Gui_PropSheet::SetWheelGuard(bool guard) {
    m_record->guardsWheel = guard;
}

void Gui_PropSheet::SetReadableBand(bool readable) {
    m_record->titleBand.SetReadable(readable);
}

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
