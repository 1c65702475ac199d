// Which page a property sheet shows, and how the keyboard gets into it and out of it.
#include "res/resource.h"
#include "s/PropSheetRecord.h"
#include "s/StringOf.h"

#include <algorithm>
#include <array>
#include <cstring>

// --- switching ---

void Gui_PropSheet::Record::revivePages(Gui_PropItem* item) {
    CWnd* const old = wasOpen ? item->GetCachedPage() : nullptr;
    if (!old || old->m_hWnd) {
        return;
    }
    item->SetCachedPage(nullptr);
    CWnd* const fresh = item->GetPage();
    if (!fresh) {
        item->SetCachedPage(old);
    } else if (fresh != old) {
        formerPages.emplace_back(old);
    }
}

void Gui_PropSheet::Record::switchTo(const std::vector<Gui_PropItem*>& chosen) {
    Gui_PropItem* const target = sheet->GetPageItem(chosen);
    if (target == currentItem) {
        if (currentItem) {
            currentItem->DeactivatePage();
        }
        refreshCurrent();
        return;
    }
    leaveCurrent();
    currentItem = target;
    refreshCurrent();
    showCurrent();
    showDefaultsButton();
}

void Gui_PropSheet::Record::leaveCurrent() {
    if (!currentItem) {
        return;
    }
    currentItem->DeactivatePage();
    if (CWnd* page = currentItem->GetPage()) {
        page->ShowWindow(SW_HIDE);
    }
    titleBand.SetLabelled(nullptr);
    titleBand.SetTitle("");
    titleBand.SetSubTitle("");
}

void Gui_PropSheet::Record::refreshCurrent() {
    if (currentItem) {
        currentItem->ActivatePage();
        titleBand.SetTitle(currentItem->GetPageTitle());
        titleBand.SetSubTitle(currentItem->GetPageSubTitle());
    }
}

namespace {

/// Makes a page's controls ones of the dialog around it, standing behind the frame in the order of Tab. A page that is
/// a control itself is left alone.
void joinTabOrder(CWnd& page, CWnd& sheet, CWnd& frame) {
    if (page.GetParent() != &sheet) {
        return;
    }
    if (page.GetTopWindow() && (page.GetStyle() & WS_TABSTOP) == 0) {
        page.ModifyStyleEx(0, WS_EX_CONTROLPARENT);
    }
    page.SetWindowPos(&frame, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
}

} // namespace

void Gui_PropSheet::Record::showCurrent() {
    CWnd* const frame = sheet->GetDlgItem(GUI_IDC_PROP_PAGE_FRAME);
    CWnd* const page = sheet->GetCurrentPage();
    if (!page || !page->m_hWnd || !frame) {
        place.leave();
        return;
    }
    joinTabOrder(*page, *sheet, *frame);
    const CRect rect = rectOf(*frame);
    place.place(*sheet, *page, rect, rect.TopLeft());
    page->ShowWindow(SW_SHOWNA);
    page->Invalidate(FALSE);
    page->UpdateWindow();
    titleBand.SetTitle(currentItem->GetPageTitle());
    titleBand.SetSubTitle(currentItem->GetPageSubTitle());
    titleBand.SetLabelled(page);
}

void Gui_PropSheet::Record::apply() {
    Gui_PropItem* const item = currentItem;
    if (item) {
        item->ApplyPageChanges();
        if (!dontClose) {
            item->SetChanged(false);
        }
    }
}

bool Gui_PropSheet::Record::mayDiscard() {
    const auto isChanged = [](const Gui_PropItem* item) { return item->IsChanged(); };
    if (!tree.showsChanges || std::ranges::none_of(items, isChanged)) {
        return true;
    }
    CString caption;
    sheet->GetWindowText(caption);
    const int answer =
        sheet->MessageBox(StringOf(GUI_IDS_PROP_DISCARD), caption, MB_YESNO | MB_ICONQUESTION | MB_DEFBUTTON2);
    if (answer != IDYES) {
        return false;
    }
    for (Gui_PropItem* item : items) {
        item->SetChanged(false);
    }
    return true;
}

// --- keys ---

void Gui_PropSheet::Record::focusFirst() {
    clearFlags();
    currentItem->SetFocusFirst();
    if (!sheet->m_hWnd || ::GetFocus() != treeWindow) {
        return;
    }
    // A page that does not care must not hold the keyboard in the tree.
    CWnd* const page = currentItem ? currentItem->GetPage() : nullptr;
    CWnd* const first = page ? page->GetNextDlgTabItem(nullptr) : nullptr;
    if (first) {
        sheet->GotoDlgCtrl(first);
    } else if (page && (page->GetStyle() & WS_TABSTOP) != 0) {
        page->SetFocus();
    } else {
        sheet->SetFocusNext();
    }
}

void Gui_PropSheet::Record::focusLast() {
    clearFlags();
    currentItem->SetFocusLast();
    if (!sheet->m_hWnd || ::GetFocus() != okWindow) {
        return;
    }
    CWnd* const page = currentItem ? currentItem->GetPage() : nullptr;
    CWnd* const last = page ? page->GetNextDlgTabItem(nullptr, TRUE) : nullptr;
    if (last) {
        sheet->GotoDlgCtrl(last);
    } else if (page && (page->GetStyle() & WS_TABSTOP) != 0) {
        page->SetFocus();
    } else {
        sheet->SetFocusPrev();
    }
}

bool Gui_PropSheet::Record::onTab() {
    if (!currentItem) {
        return false;
    }
    const bool shift = (GetAsyncKeyState(VK_SHIFT) & ~1) != 0;
    const HWND focus = ::GetFocus();
    if (!shift && focus == treeWindow) {
        focusFirst();
    } else if (shift && focus == okWindow) {
        focusLast();
    } else {
        return false;
    }
    if (sheet->m_hWnd) {
        place.show(::GetFocus());
    }
    return true;
}

bool Gui_PropSheet::Record::onSearchKey(UINT key) {
    if (!searchField.m_hWnd) {
        return false;
    }
    const bool isFind = key == 'F' && GetAsyncKeyState(VK_CONTROL) < 0 && GetAsyncKeyState(VK_MENU) >= 0;
    if (isFind) {
        sheet->GotoDlgCtrl(&searchField);
        return true;
    }
    if (::GetFocus() != searchField.m_hWnd) {
        return false;
    }
    const bool isEmpty = searchField.GetWindowTextLength() == 0;
    switch (key) {
    case VK_DOWN:
        if (sheet->GetSelectedItems().empty()) {
            selectNextFound();
        }
        sheet->SetFocusPrev();
        return true;
    case VK_ESCAPE:
        searchField.SetWindowText("");
        return !isEmpty;
    case VK_RETURN:
        selectNextFound();
        return !isEmpty;
    default:
        return false;
    }
}

void Gui_PropSheet::Record::selectNextFound() {
    const std::vector<Gui_PropItem*> selected = sheet->GetSelectedItems();
    if (const Gui_PropItem* next = tree.nextFound(selected.empty() ? nullptr : selected.front())) {
        tree.control.SelectItem(tree.nodeOf(next));
    }
}

// --- wheel ---

namespace {

bool scrollsItself(HWND control) {
    char name[24] = {};
    GetClassNameA(control, name, sizeof name);
    constexpr std::array<const char*, 4> scrolling = {"ListBox", "Edit", "SysTreeView32", "ScrollBar"};
    return std::ranges::any_of(scrolling, [&name](const char* known) { return std::strcmp(known, name) == 0; });
}

} // namespace

bool Gui_PropSheet::Record::isGuarded(const MSG& message) const {
    const CWnd* const page = guardsWheel ? sheet->GetCurrentPage() : nullptr;
    const HWND focus = ::GetFocus();
    return page && ::IsChild(page->m_hWnd, message.hwnd) && message.hwnd != focus && !::IsChild(message.hwnd, focus) &&
           !scrollsItself(message.hwnd);
}
