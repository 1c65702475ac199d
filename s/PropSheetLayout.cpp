// How a property sheet is laid out, and what is kept of it from one opening to the next.
#include "res/resource.h"
#include "s/Profile.h"
#include "s/PropSheetRecord.h"
#include "s/StringOf.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace {

/// From the left to the right.
constexpr std::array<int, 4> buttonIds = {GUI_IDC_PROP_APPLY, IDOK, IDCANCEL, GUI_IDC_HELP};

constexpr const char* nodeEntry = "PropertyNode";
constexpr const char* sizeEntry = "PropertySize";

void resize(CWnd& control, int width, int height) {
    control.SetWindowPos(nullptr, 0, 0, std::max(0, width), std::max(0, height),
                         SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}

CSize mapped(const CDialog& dialog, int x, int y) {
    CRect rect(0, 0, x, y);
    dialog.MapDialogRect(&rect);
    return rect.Size();
}

CSize bordersOf(const CWnd& dialog) {
    CRect window;
    CRect client;
    dialog.GetWindowRect(&window);
    dialog.GetClientRect(&client);
    return window.Size() - client.Size();
}

} // namespace

CSize Gui_PropSheet::Record::margin() const {
    return mapped(*sheet, 5, 5);
}

CRect Gui_PropSheet::Record::rectOf(const CWnd& control) const {
    CRect rect;
    control.GetWindowRect(&rect);
    sheet->ScreenToClient(&rect);
    return rect;
}

int Gui_PropSheet::Record::buttonHeight() const {
    for (const int id : buttonIds) {
        if (const CWnd* button = sheet->GetDlgItem(id)) {
            return rectOf(*button).Height();
        }
    }
    return 3 * margin().cy;
}

// --- layout ---

void Gui_PropSheet::Record::layOut(CSize client) {
    isLaidOut = treeWindow != nullptr; // until the dialog is open its controls stand as the template has them
    const CSize gap = margin();
    const int height = buttonHeight();
    if (CWnd* band = sheet->GetDlgItem(GUI_IDC_PROP_TITLE)) {
        const CRect rect = rectOf(*band);
        resize(*band, client.cx - rect.left - gap.cx, rect.Height());
        band->Invalidate(FALSE);
    }
    const int left = layOutButtons(client, gap, height);
    if (CWnd* control = sheet->GetDlgItem(GUI_IDC_PROP_TREE)) {
        const CRect rect = rectOf(*control);
        const int defaults = layOutDefaults(client, left);
        resize(*control, rect.Width(), client.cy - 2 * gap.cy - rect.top - height - defaults);
    }
    if (CWnd* frame = sheet->GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)) {
        const CRect rect = rectOf(*frame);
        resize(*frame, client.cx - rect.left - gap.cx, client.cy - 2 * gap.cy - rect.top - height);
        CWnd* const page = sheet->GetCurrentPage();
        if (page && page->m_hWnd) {
            place.place(*sheet, *page, rectOf(*frame), rectOf(*page).TopLeft());
        }
    }
}

int Gui_PropSheet::Record::layOutButtons(CSize client, CSize gap, int height) {
    const int top = client.cy - gap.cy - height;
    int right = client.cx;
    for (auto id = buttonIds.rbegin(); id != buttonIds.rend(); ++id) {
        if (CWnd* button = sheet->GetDlgItem(*id)) {
            right -= gap.cx + rectOf(*button).Width();
            button->SetWindowPos(nullptr, right, top, 0, 0, SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
            button->Invalidate(FALSE);
        }
    }
    return right;
}

int Gui_PropSheet::Record::layOutDefaults(CSize client, int left) {
    if (!defaultsButton.m_hWnd || !currentItem || !currentItem->GetDefaultsFunction()) {
        return 0;
    }
    const CSize gap = margin();
    const CSize size = defaultsSize();
    const int row = size.cy + gap.cy;
    const bool isAbove = gap.cx + size.cx + gap.cx > left;
    defaultsButton.SetWindowPos(nullptr, gap.cx, client.cy - row - (isAbove ? row : 0), 0, 0,
                                SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
    return isAbove ? row : 0;
}

CSize Gui_PropSheet::Record::leastClient() const {
    const CWnd* const frame = sheet->GetDlgItem(GUI_IDC_PROP_PAGE_FRAME);
    if (!frame) {
        return {0, 0};
    }
    const CSize gap = margin();
    const CSize page = mapped(*sheet, 100, 50);
    int buttons = gap.cx;
    for (const int id : buttonIds) {
        const CWnd* button = sheet->GetDlgItem(id);
        buttons += button ? rectOf(*button).Width() + gap.cx : 0;
    }
    const CRect rect = rectOf(*frame);
    const CSize borders = bordersOf(*sheet);
    // A small screen, or large fonts, may have room for less.
    return {
        std::min(std::max<int>(buttons, rect.left + page.cx + gap.cx), GetSystemMetrics(SM_CXFULLSCREEN) - borders.cx),
        std::min<int>(rect.top + page.cy + 2 * gap.cy + buttonHeight(),
                      GetSystemMetrics(SM_CYFULLSCREEN) - borders.cy)};
}

// --- controls that only some sheets have ---

void Gui_PropSheet::Record::addSearchField() {
    if (!hasSearch) {
        return;
    }
    CWnd* const first = sheet->GetTopWindow();
    CWnd* const control = sheet->GetDlgItem(GUI_IDC_PROP_TREE);
    CRect treeRect = rectOf(*control);
    CRect labelRect = rectOf(*first);
    const CSize field = mapped(*sheet, 85, 13);
    const int shift = treeRect.top - labelRect.top + field.cy + margin().cy / 2;
    searchLabel.Create(StringOf(GUI_IDS_PROP_SEARCH), WS_CHILD | WS_VISIBLE | SS_LEFT, labelRect, sheet,
                       GUI_IDC_PROP_SEARCH_LABEL);
    searchField.CreateEx(WS_EX_CLIENTEDGE, "Edit", "", WS_CHILD | WS_VISIBLE | WS_TABSTOP | WS_BORDER | ES_AUTOHSCROLL,
                         CRect(treeRect.TopLeft(), CSize(treeRect.Width(), field.cy)), sheet, GUI_IDC_PROP_SEARCH);
    searchLabel.SetFont(sheet->GetFont());
    searchField.SetFont(sheet->GetFont());
    labelRect.OffsetRect(0, shift);
    treeRect.top += shift;
    first->MoveWindow(&labelRect);
    control->MoveWindow(&treeRect);
    // Tab and access keys come to the field before the tree.
    const CWnd* before = &searchField;
    for (CWnd* next = first; next && next != &searchLabel;) {
        CWnd* const behind = next->GetNextWindow();
        next->SetWindowPos(before, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
        before = next;
        next = behind;
    }
}

CSize Gui_PropSheet::Record::defaultsSize() const {
    return {mapped(*sheet, 60, 14).cx, buttonHeight()};
}

void Gui_PropSheet::Record::showDefaultsButton() {
    if (!sheet->m_hWnd) {
        return;
    }
    const bool isWanted = currentItem && currentItem->GetDefaultsFunction();
    if (isWanted && !defaultsButton.m_hWnd) {
        const CWnd* const ok = sheet->GetDlgItem(IDOK);
        const CPoint corner(margin().cx, ok ? rectOf(*ok).top : 0);
        defaultsButton.Create(StringOf(GUI_IDS_PROP_DEFAULTS), WS_CHILD | WS_TABSTOP | BS_PUSHBUTTON,
                              CRect(corner, defaultsSize()), sheet, GUI_IDC_PROP_DEFAULTS);
        defaultsButton.SetFont(sheet->GetFont());
    }
    if (!defaultsButton.m_hWnd) {
        return;
    }
    defaultsButton.ShowWindow(isWanted ? SW_SHOWNA : SW_HIDE);
    if (isLaidOut) {
        CRect client;
        sheet->GetClientRect(&client);
        layOut(client.Size());
    }
}

// --- size and memory ---

void Gui_PropSheet::Record::fitScreen() {
    CRect window;
    sheet->GetWindowRect(&window);
    const CSize screen(GetSystemMetrics(SM_CXFULLSCREEN), GetSystemMetrics(SM_CYFULLSCREEN));
    if (place.scrolls && screen.cx > 0 && (window.Width() > screen.cx || window.Height() > screen.cy)) {
        resize(*sheet, std::min<int>(window.Width(), screen.cx), std::min<int>(window.Height(), screen.cy));
    }
}

void Gui_PropSheet::Record::restoreSize() {
    CString text;
    CSize size;
    CSize units;
    if (!remembers || !Gui_Profile::ReadString(text, sizeEntry, section) ||
        std::sscanf(text, "%d %d %d %d", &size.cx, &size.cy, &units.cx, &units.cy) != 4 ||
        units != mapped(*sheet, 100, 100)) {
        return;
    }
    const CSize least = leastClient();
    const CSize screen(GetSystemMetrics(SM_CXFULLSCREEN), GetSystemMetrics(SM_CYFULLSCREEN));
    const CSize borders = bordersOf(*sheet);
    resize(*sheet, std::min<int>(std::max(size.cx, least.cx) + borders.cx, screen.cx),
           std::min<int>(std::max(size.cy, least.cy) + borders.cy, screen.cy));
}

void Gui_PropSheet::Record::remember() const {
    if (!remembers || sheet->IsZoomed() || sheet->IsIconic()) {
        return;
    }
    CRect client;
    sheet->GetClientRect(&client);
    const CSize units = mapped(*sheet, 100, 100);
    CString text;
    text.Format("%d %d %d %d", client.Width(), client.Height(), static_cast<int>(units.cx), static_cast<int>(units.cy));
    Gui_Profile::WriteString(text, sizeEntry, section);
    if (!selection.empty()) {
        Gui_Profile::WriteString(tree.pathOf(selection.front()), nodeEntry, section);
    }
}

std::vector<Gui_PropItem*> Gui_PropSheet::Record::firstSelection() const {
    if (!initiallySelected.empty()) {
        return multipleSelection ? initiallySelected : std::vector{initiallySelected.front()};
    }
    CString path;
    const bool hasPath = remembers && Gui_Profile::ReadString(path, nodeEntry, section) != 0;
    Gui_PropItem* const kept = hasPath ? tree.itemAt(path) : nullptr;
    Gui_PropItem* const first = kept ? kept : tree.firstItem();
    return first ? std::vector{first} : std::vector<Gui_PropItem*>();
}
