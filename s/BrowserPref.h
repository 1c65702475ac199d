#pragma once

#include "afxdlgs.h"
#include "s/Export.h"

#include <memory>

/// The page on which the user names the program that opens web pages, with its arguments: what
/// Gui_Profile::ReadWebBrowserName answers. Hosts get it from Gui_BrowserPreference.
///
/// "%1" in the command line stands for the address. A program whose path has blanks stands in quotation marks, as in
/// `"C:/my programs/browser" -new %1`.
class GUI_API Gui_BrowserPref : public CPropertyPage {
public:
    /// Reads the command line that holds now: the stored one, else the system's.
    Gui_BrowserPref();
    ~Gui_BrowserPref() override;

protected:
    void DoDataExchange(CDataExchange* dx) override;
    /// Stores the command line if it is another one than holds now: a default that was only shown is not stored.
    void OnOK() override;
    /// Asks for a program, which takes the place of the one in the field; its arguments stay.
    afx_msg void OnBrowse();
    /// Shows the system's command line in the field.
    afx_msg void OnShowDefault();
    afx_msg void OnChangeCommand();
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    std::unique_ptr<Record> m_record;
};
