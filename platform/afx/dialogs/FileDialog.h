#pragma once

/// @file
/// CFileDialog: asks for the name of a file to open or save.

#include "platform/afx/core/Wnd.h"
#include "platform/base/List.h"

#include <vector>

// Flags of a file dialog
#define OFN_READONLY 0x00000001
#define OFN_OVERWRITEPROMPT 0x00000002
#define OFN_HIDEREADONLY 0x00000004
#define OFN_NOCHANGEDIR 0x00000008
#define OFN_SHOWHELP 0x00000010
#define OFN_ENABLEHOOK 0x00000020
#define OFN_ENABLETEMPLATE 0x00000040
#define OFN_NOVALIDATE 0x00000100
#define OFN_ALLOWMULTISELECT 0x00000200
#define OFN_EXTENSIONDIFFERENT 0x00000400
#define OFN_PATHMUSTEXIST 0x00000800
#define OFN_FILEMUSTEXIST 0x00001000
#define OFN_CREATEPROMPT 0x00002000
#define OFN_NOREADONLYRETURN 0x00008000
#define OFN_EXPLORER 0x00080000
#define OFN_ENABLESIZING 0x00800000

/// What a file dialog is told and answers. Texts belong to whoever sets them and must live until DoModal has returned.
struct OPENFILENAMEA {
    DWORD lStructSize; ///< Size of this record in bytes; set, and not looked at.
    HWND hwndOwner;    ///< The window it stands over.
    HINSTANCE hInstance;
    LPCSTR lpstrFilter; ///< Description, zero, pattern ("*.brd;*.txt"), zero, ..., and one more zero; null: all files.
    LPSTR lpstrCustomFilter;
    DWORD nMaxCustFilter;
    DWORD nFilterIndex; ///< The chosen filter, counted from 1.
    /// In: the name shown first. Out: the full name; with OFN_ALLOWMULTISELECT, one zero more behind it, and of several
    /// files their folder, zero, a name, zero, ..., and one more zero. Emptied where that has no room.
    LPSTR lpstrFile;
    DWORD nMaxFile;       ///< Size of lpstrFile in bytes.
    LPSTR lpstrFileTitle; ///< Out: the name without its folder; may be null.
    DWORD nMaxFileTitle;
    LPCSTR lpstrInitialDir; ///< The folder to begin in; null: that of the name, else the current one.
    LPCSTR lpstrTitle;      ///< Null: "Open" or "Save As".
    DWORD Flags;            ///< OFN_...
    WORD nFileOffset;
    WORD nFileExtension;
    /// Extension, without its dot, for names typed without one under a filter for all files; other filters have their
    /// own. Null: names stay as they are typed.
    LPCSTR lpstrDefExt;
    LPARAM lCustData;
};
using OPENFILENAME = OPENFILENAMEA;

/// The file dialog. docs/dialogs.md tells what it does with typed names, and what the flags do.
///
/// @code
/// CFileDialog dialog(TRUE, "brd", nullptr, OFN_HIDEREADONLY | OFN_FILEMUSTEXIST, "Boards (*.brd)|*.brd||", this);
/// if (dialog.DoModal() == IDOK) read(dialog.GetPathName());
/// @endcode
class TVX_PLATFORM_API CFileDialog : public CWnd {
    DECLARE_DYNAMIC(CFileDialog)

public:
    /// The record behind the dialog; m_pOFN is the same by its other name.
    OPENFILENAME m_ofn{};
    OPENFILENAME*& m_pOFN = m_record;

    /// @param openDialog TRUE to open, FALSE to save
    /// @param defaultExtension without its dot; null for none
    /// @param fileName the name shown first; null for none
    /// @param filter   descriptions and patterns with "|" between them and "||" at the end; null for all files
    /// @param parent   the window it stands over; null: the main window
    explicit CFileDialog(BOOL openDialog, LPCSTR defaultExtension = nullptr, LPCSTR fileName = nullptr,
                         DWORD flags = OFN_HIDEREADONLY | OFN_OVERWRITEPROMPT, LPCSTR filter = nullptr,
                         CWnd* parent = nullptr, DWORD structSize = 0);
    ~CFileDialog() override;

    /// The record, to be changed before DoModal.
    OPENFILENAME& GetOFN() {
        return m_ofn;
    }
    /// Shows the dialog and answers IDOK or IDCANCEL.
    virtual INT_PTR DoModal();

    /// The chosen file's full name.
    CString GetPathName() const;
    /// Its last part: "board.brd".
    CString GetFileName() const;
    /// Its extension without the dot: "brd".
    CString GetFileExt() const;
    /// Its last part without the extension: "board".
    CString GetFileTitle() const;
    /// The first of several chosen files (OFN_ALLOWMULTISELECT); null when there are none.
    POSITION GetStartPosition() const;
    /// The full name of the chosen file at a position, which moves on to the next one: null behind the last. Empty for
    /// a position that is null already.
    CString GetNextPathName(POSITION& position) const;

protected:
    BOOL m_bOpenFileDialog;
    /// Called when the user presses OK; 0 accepts the file, another number keeps the dialog open.
    virtual BOOL OnFileNameOK();

private:
    static CString folderOf(const CString& path);
    void fillRecord();
    OPENFILENAME* m_record = &m_ofn;
    CString m_filter;
    CString m_defaultExtension;
    char m_fileName[1024] = {};
    std::vector<CString> m_paths;
};
