#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

/// The About box: the application's icon and name, the versions of application and installation, and the copyright
/// notice. Ctrl+C copies these texts, one a line, as message boxes do with theirs: for reports of faults.
///
/// @code
/// Gui_AboutDlg about(m_pMainWnd);
/// about.DoModal();
/// @endcode
class GUI_API Gui_AboutDlg : public CDialog {
public:
    /// Asks the application object for icon and version and the installation for its release, and keeps them.
    /// @param parent the window to stand over; null for the application's main window
    explicit Gui_AboutDlg(CWnd* parent);
    ~Gui_AboutDlg() override;

    BOOL PreTranslateMessage(MSG* message) override;

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;

private:
    struct Record;

    void copyTexts();

    std::unique_ptr<Record> m_record;
};
