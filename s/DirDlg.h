#pragma once

#include "afxcmn.h"
#include "afxwin.h"
#include "s/Export.h"

#include <memory>

class Gui_FileName;

/// "Directory": the user chooses a directory, by typing its name, in a tree, or from the list of drives.
///
/// @code
/// Gui_DirDlg dialog(m_backupFolder, "Backup Directory", IDH_BACKUP, this);
/// if (dialog.DoModal() == IDOK) {
///     m_backupFolder = dialog.GetPathName(1); // "C:\work\backup\"
/// }
/// @endcode
///
/// The tree shows the way from the drive's root to the current directory, and that one's subdirectories. A double click
/// makes a directory the current one. OK does so first with a name that was typed, else with the directory that is
/// selected in the tree; pressed again it takes the current directory, if that exists and can be written, as far as
/// this is asked for.
///
/// Names are typed in the family's form or the system's ("/home/ann"), with blanks or quotes around them if need be;
/// one that does not say where it begins lies below the current directory. Names of directories that exist are
/// completed. New Folder makes a directory in the current one. Directories whose names begin with a dot are shown when
/// the user asks for them.
///
/// A directory is read, and asked whether it may be taken, in the background: one on a server that does not answer
/// keeps nobody from typing, choosing another drive, or cancelling. Its entries are not asked for anything, so looking
/// mounts nothing.
///
/// An object on the stack; docs/directory-dialog.md tells more.
class GUI_API Gui_DirDlg : public CDialog {
public:
    /// @param initialDirectory  where the dialog opens, copied; null: the current directory of the current drive
    /// @param title             its caption, copied; null or empty: "Directory"
    /// @param helpId            the number of its help, to which HID_BASE_RESOURCE is added; 0: it has no help, and no
    ///                          Help button
    /// @param parent            the window to stand over; null for the application's main window
    /// @param validate          0: OK takes what was chosen without asking about it
    /// @param mustExist         0: as `validate`
    /// @param mustBeWritable    0: a directory that cannot be written will do
    explicit Gui_DirDlg(const char* initialDirectory = nullptr, const char* title = nullptr, unsigned int helpId = 0,
                        CWnd* parent = nullptr, int validate = 1, int mustExist = 1, int mustBeWritable = 1);
    ~Gui_DirDlg() override;

    /// The directory that was chosen, with a backslash at the end; to be read after DoModal answered IDOK. Before that
    /// it is where the dialog opens; after Cancel it is where the user was.
    /// @param unc  non-zero: a directory on a network drive in the form of its share ("\\server\share\plans\"); 0: in
    ///             that of the drive ("X:\plans\")
    CString GetPathName(int unc = 1) const;

protected:
    BOOL OnInitDialog() override;
    void OnOK() override;
    afx_msg void OnSelchangeDrivecombo();
    afx_msg void OnDblclkDirpathtree(NMHDR* header, LRESULT* result);
    afx_msg void OnDrawItem(int id, DRAWITEMSTRUCT* item);
    afx_msg void OnHelp();
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    afx_msg BOOL OnSetCursor(CWnd* window, UINT part, UINT message);
    afx_msg void OnChangeName();
    afx_msg void OnSelchangedTree(NMHDR* header, LRESULT* result);
    afx_msg void OnShowHidden();
    afx_msg void OnNewFolder();
    afx_msg LRESULT OnListed(WPARAM wParam, LPARAM lParam);
    afx_msg LRESULT OnChecked(WPARAM wParam, LPARAM lParam);
    afx_msg LRESULT OnCreated(WPARAM wParam, LPARAM lParam);
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    CTreeCtrl& tree();
    CComboBox& drives();

    void setDirectory(const Gui_FileName& directory);
    void showDirectory();
    void go(const Gui_FileName& directory);
    void completeDirectory();
    CString typedName();
    void showState();

    void fillDrives();
    int addDrive(const CString& drive);
    void selectDrive();

    void fillTree();
    void fillSubdirectories();
    HTREEITEM insertItem(const CString& name, HTREEITEM parent, int image, int children);
    Gui_FileName directoryOf(HTREEITEM item);
    void select(const CString& name);

    void check();
    void finishCheck();
    void askForFolder(const CString& name);
    void createFolder(const CString& name);
    void finishCreation();

    std::unique_ptr<Record> m_record;
};
