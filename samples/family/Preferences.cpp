#include "Preferences.h"

#include "FamilyPages.h"
#include "FamilyResource.h"

#include "res/resource.h"
#include "s/Profile.h"

#include <algorithm>

namespace {

/// Where the sheet is remembered among the settings.
constexpr const char* section = "Preferences";

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

/// The page of the library, which is made for sheets with tabs: it is a child of this one as well.
CWnd* MakeBrowserPage(Gui_PropItem*, Gui_PropSheet* sheet) {
    CPropertyPage& page = static_cast<CPreferences*>(sheet)->m_browser.GetPropertyPage();
    return page.Create(GUI_IDD_BROWSER, sheet) ? &page : nullptr;
}

CPreferences::CPreferences(CWnd* parent)
    : Gui_PropSheet(portText(textOf(IDS_PREFERENCES)), parent, false), m_family(FamilyOptions::Read()) {
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
    CString size;
    if (!Gui_Profile::ReadString(size, "PropertySize", section)) {
        MakeRoom(); // the user has not chosen a size yet
    }
    return result;
}

// The page of the web browser is made for sheets of its own, and wider than others.
void CPreferences::MakeRoom() {
    constexpr int widest = 258; // dialog units, with what surrounds it
    CRect wanted(0, 0, widest, 0);
    CRect frame;
    CRect window;
    MapDialogRect(&wanted);
    GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)->GetClientRect(&frame);
    GetWindowRect(&window);
    const int more = std::max(wanted.Width() - frame.Width(), 0);
    SetWindowPos(nullptr, 0, 0, window.Width() + more, window.Height(), SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
    CenterWindow();
}

void CPreferences::Store() {
    m_family.Write();
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

void CPreferences::FocusPage(CWnd& page, bool last) {
    if (CWnd* control = page.GetNextDlgTabItem(nullptr, last)) {
        GotoDlgCtrl(control);
    } else if (last) {
        SetFocusPrev();
    } else {
        SetFocusNext(); // a page without anything to change
    }
}
