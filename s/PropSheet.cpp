#include "s/PropSheet.h"

#include "res/resource.h"
#include "s/PropSheetRecord.h"
#include "s/Record.h"
#include "s/StringOf.h"

#include <algorithm>
#include <set>

IMPLEMENT_DYNAMIC(Gui_PropSheet, CDialog)

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
    if (m_record->treeWindow) {
        ::SetFocus(m_record->treeWindow);
    }
}

void Gui_PropSheet::SetFocusNext() {
    if (m_record->okWindow) {
        ::SetFocus(m_record->okWindow);
    }
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
