#include "s/BrowserPreference.h"

#include "res/resource.h"
#include "s/BrowserPref.h"
#include "s/Record.h"

struct Gui_BrowserPreference::Record {
    // The sheet goes first: its window holds the page's.
    std::unique_ptr<Gui_BrowserPref> page;
    std::unique_ptr<CPropertySheet> sheet;
};

Gui_BrowserPreference::Gui_BrowserPreference() : m_record(MakeRecord<Record>()) {}

Gui_BrowserPreference::~Gui_BrowserPreference() = default;

CPropertyPage& Gui_BrowserPreference::GetPropertyPage() {
    if (!m_record->page) {
        tvx::allocating([this] { m_record->page = std::make_unique<Gui_BrowserPref>(); });
    }
    return *m_record->page;
}

CPropertySheet& Gui_BrowserPreference::GetModalPreferenceDialog() {
    if (!m_record->sheet) {
        tvx::allocating([this] {
            auto sheet = std::make_unique<CPropertySheet>(GUI_IDS_BROWSER_TITLE);
            CPropertyPage& page = GetPropertyPage();
            page.m_psp.dwFlags &= ~DWORD{PSP_HASHELP};
            sheet->m_psh.dwFlags |= PSH_NOAPPLYNOW;
            sheet->m_psh.dwFlags &= ~DWORD{PSH_HASHELP};
            sheet->AddPage(&page);
            m_record->sheet = std::move(sheet);
        });
    }
    return *m_record->sheet;
}
