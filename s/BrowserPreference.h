#pragma once

#include "afxdlgs.h"
#include "s/Export.h"

#include <memory>

/// The user's choice of a web browser: a page for a host's own preferences, or a ready-made dialog around it.
///
/// @code
/// Gui_BrowserPreference browser;
/// browser.GetModalPreferenceDialog().DoModal();     // a dialog, or
/// m_settings.AddPage(&browser.GetPropertyPage());   // a page among others
/// @endcode
///
/// The choice is one for all applications of the family. Page and dialog are made when they are first asked for, and
/// go with the object.
class GUI_API Gui_BrowserPreference {
public:
    Gui_BrowserPreference();
    virtual ~Gui_BrowserPreference();
    Gui_BrowserPreference(const Gui_BrowserPreference&) = delete;
    Gui_BrowserPreference& operator=(const Gui_BrowserPreference&) = delete;

    /// The page, the same one each time; it stores what was changed when the dialog around it is confirmed. A host that
    /// calls this does not show GetModalPreferenceDialog of the same object: a page is in one dialog only.
    CPropertyPage& GetPropertyPage();
    /// A dialog "Web Browser" with that page, OK and Cancel; the same one each time. Its DoModal answers IDOK or
    /// IDCANCEL.
    CPropertySheet& GetModalPreferenceDialog();

private:
    struct Record;

    std::unique_ptr<Record> m_record;
};
