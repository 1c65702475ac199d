#include "Preferences.h"

#include "FamilyPages.h"
#include "FamilyResource.h"

#include "platform/sec/TreeCtrl.h"
#include "res/resource.h"
#include "s/Profile.h"

#include <algorithm>

namespace {

/// Where the sheet is remembered among the settings.
constexpr const char* section = "Preferences";
/// Tells the sheet to select an item again, once what leaves it is over.
constexpr UINT comeBackMessage = WM_APP + 1;

Port::StringBase<char> portText(const CString& text) {
    return Port::StringBase<char>(text.GetString());
}

/// Takes the first line of a text away.
CString takeLine(CString& text) {
    const int end = text.Find('\n');
    const CString line = end < 0 ? text : text.Left(end);
    text = end < 0 ? CString() : text.Mid(end + 1);
    return line;
}

CString textOf(UINT id) {
    CString text;
    text.LoadString(id);
    return text;
}

} // namespace

// clang-format off
BEGIN_MESSAGE_MAP(CPreferences, Gui_PropSheet)
    ON_MESSAGE(comeBackMessage, &CPreferences::OnComeBack)
END_MESSAGE_MAP()
// clang-format on

/// The page of the library, which is made for sheets with tabs: it is a child of this one as well.
CWnd* MakeBrowserPage(Gui_PropItem*, Gui_PropSheet* sheet) {
    CPropertyPage& page = static_cast<CPreferences*>(sheet)->m_browser.GetPropertyPage();
    return page.Create(GUI_IDD_BROWSER, sheet) ? &page : nullptr;
}

CPreferences::CPreferences(CWnd* parent)
    : Gui_PropSheet(portText(textOf(IDS_PREFERENCES)), parent, false),
      m_family(FamilyOptions::Read()),
      m_familyBefore(m_family) {
    SetSearch(true);
    SetChangeMarks(true);
    SetMemory(section);
    SetPageScrolling(true);
    SetWheelGuard(true);
    SetReadableBand(true);
}

CPreferences::~CPreferences() {
    if (m_browserItem) {
        m_browserItem->SetCachedPage(nullptr); // its page is the preference's, not the item's
    }
}

Gui_PropItem* CPreferences::AddPage(UINT texts, CWnd* (*make)(Gui_PropItem*, Gui_PropSheet*), Gui_PropItem* parent,
                                    bool hasDefaults) {
    CString text = textOf(texts);
    const CString name = takeLine(text);
    auto* item = new Gui_PropItem(portText(name), make, OnPreferencePage, Gui_PropItem::StateExpanded);
    item->SetPageTitle(portText(name));
    item->SetPageSubTitle(portText(takeLine(text)));
    item->SetKeywords(portText(text));
    if (hasDefaults) {
        item->SetDefaultsFunction(
            [](Gui_PropItem*, CWnd* page) { static_cast<CPreferencePage*>(page)->ShowDefaults(); });
    }
    AddItem(item, parent, false);
    m_pages.push_back(item);
    return item;
}

void CPreferences::AddFamilyPages() {
    AddPage(IDS_PREF_FILES, &MakePage<CFilesPage, CPreferences>, nullptr, true);
    AddPage(IDS_PREF_KEYBOARD, &MakePage<CKeyboardPage, CPreferences>, nullptr, false);
    Gui_PropItem* const help = AddPage(IDS_PREF_HELP, &MakePage<CHelpPage, CPreferences>, nullptr, true);
    m_browserItem = AddPage(IDS_PREF_BROWSER, &MakeBrowserPage, help, false);
    m_browserItem->SetNotifyPageFunction(&OnTabPage);
    AddPage(IDS_PREF_INSTALLATION, &MakePage<CInstallationPage, CPreferences>, nullptr, false);
}

BOOL CPreferences::OnInitDialog() {
    const BOOL result = Gui_PropSheet::OnInitDialog();
    WidenTree();
    CString size;
    if (!Gui_Profile::ReadString(size, "PropertySize", section)) {
        MakeRoom(); // the user has not chosen a size yet
    }
    return result;
}

// Names of pages that are marked as changed are wider than the tree of the library.
void CPreferences::WidenTree() {
    CRect more(0, 0, 22, 0); // dialog units
    MapDialogRect(&more);
    const auto shift = [&](CWnd* control, int left, int right) {
        if (control && control->m_hWnd) {
            CRect rect;
            control->GetWindowRect(&rect);
            ScreenToClient(&rect);
            rect.left += left;
            rect.right += right;
            control->MoveWindow(&rect);
        }
    };
    for (const UINT id : {GUI_IDC_PROP_SEARCH, GUI_IDC_PROP_TREE}) {
        shift(GetDlgItem(id), 0, more.Width());
    }
    for (CWnd* right : {GetDlgItem(GUI_IDC_PROP_TITLE), GetDlgItem(GUI_IDC_PROP_PAGE_FRAME), GetCurrentPage()}) {
        shift(right, more.Width(), 0);
    }
    CRect client;
    GetClientRect(&client);
    SendMessage(WM_SIZE, SIZE_RESTORED, MAKELPARAM(client.Width(), client.Height())); // lays out what is left
}

// The page of the web browser is made for sheets of its own, and wider than others. A small screen has no room for
// that: the page is scrolled there.
void CPreferences::MakeRoom() {
    constexpr int widest = 258; // dialog units, with what surrounds it
    CRect wanted(0, 0, widest, 0);
    CRect frame;
    CRect window;
    MapDialogRect(&wanted);
    GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)->GetClientRect(&frame);
    GetWindowRect(&window);
    const int room = GetSystemMetrics(SM_CXFULLSCREEN) - window.Width();
    const int more = std::max(std::min(wanted.Width() - frame.Width(), room), 0);
    SetWindowPos(nullptr, 0, 0, window.Width() + more, window.Height(), SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
    CenterWindow();
}

void CPreferences::Store() {
    m_family.Write(m_familyBefore);
    m_familyBefore = m_family;
    if (m_browserItem && m_browserItem->GetCachedPage()) {
        m_browser.GetPropertyPage().OnApply(); // took its field over when it was left
    }
    StoreOwn();
    for (Gui_PropItem* page : m_pages) {
        page->SetChanged(false);
    }
}

void CPreferences::SetPageChanged(const CPreferencePage& page) {
    const auto item =
        std::ranges::find_if(m_pages, [&](Gui_PropItem* candidate) { return candidate->GetCachedPage() == &page; });
    if (item != m_pages.end()) {
        (*item)->SetChanged(true);
    }
}

void CPreferences::OnCancel() {
    MarkBrowser();
    Gui_PropSheet::OnCancel();
}

void CPreferences::MarkBrowser() {
    const CWnd* const page = m_browserItem ? m_browserItem->GetCachedPage() : nullptr;
    if (page && page->m_hWnd) {
        CString shown;
        CString holds;
        page->GetDlgItemText(GUI_IDC_BROWSER_COMMAND, shown);
        Gui_Profile::ReadWebBrowserName(holds);
        m_browserItem->SetChanged(shown != holds);
    }
}

void CPreferences::ComeBack(Gui_PropItem& item) {
    PostMessage(comeBackMessage, 0, reinterpret_cast<LPARAM>(&item));
}

LRESULT CPreferences::OnComeBack(WPARAM, LPARAM lParam) {
    auto* const item = reinterpret_cast<Gui_PropItem*>(lParam);
    auto* const page = static_cast<CPreferencePage*>(item->GetCachedPage());
    auto* const tree = static_cast<SECTreeCtrl*>(GetDlgItem(GUI_IDC_PROP_TREE));
    HTREEITEM node = tree->GetRootItem();
    while (node && tree->GetItemData(node) != static_cast<DWORD_PTR>(lParam)) {
        node = tree->GetNextItem(node);
    }
    if (node) {
        tree->SelectItem(node);
        page->ShowWrong();
    } else { // the search hides it
        page->ForgetWrong();
    }
    return 0;
}

void CPreferences::FocusPage(CWnd& page, bool last) {
    if (CWnd* control = page.GetNextDlgTabItem(nullptr, last)) {
        GotoDlgCtrl(control);
    } else if (last) {
        SetFocusPrev();
    } else {
        SetFocusNext(); // a page without anything to change
    }
}
