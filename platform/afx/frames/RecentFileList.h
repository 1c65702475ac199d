#pragma once

/// @file
/// CRecentFileList: the files that the user worked with last, in the settings and in a menu.

#include "platform/afx/core/CmdTarget.h"
#include "platform/base/String.h"

#include <vector>

/// Characters that a file's name has room for in the menu.
#define AFX_ABBREV_FILENAME_LEN 30

/// The files that the user worked with last, the last one first. CWinApp::LoadStdProfileSettings makes one; documents
/// put themselves into it (CWinApp::AddToRecentFileList), and the entries of a menu that has ID_FILE_MRU_FILE1 open
/// them. docs/documents-and-views.md tells more.
///
/// Each change is made to what the settings hold at that time, and stored at once, so that two programs of a user's do
/// not undo each other's. The files themselves are not looked at: one on a server that does not answer must not hold up
/// anything.
class TVX_PLATFORM_API CRecentFileList {
public:
    /// Reads nothing yet: the settings are asked when the list is first needed.
    /// @param start       number that the entries of the menu are counted from: 0 for "1" first
    /// @param section     section of the application's settings
    /// @param entryFormat name of an entry, with "%d" for its number from 1 on
    /// @param size        files that are kept, at least 1
    /// @param maxDisplayLength characters that a name has room for in the menu
    CRecentFileList(UINT start, LPCSTR section, LPCSTR entryFormat, int size,
                    int maxDisplayLength = AFX_ABBREV_FILENAME_LEN);
    virtual ~CRecentFileList();
    CRecentFileList(const CRecentFileList&) = delete;
    CRecentFileList& operator=(const CRecentFileList&) = delete;

    /// Files that are kept at most.
    int GetSize() const {
        return static_cast<int>(m_names.size());
    }
    /// The full name of a file, from 0 on; empty behind the last one. A change is stored by WriteList.
    CString& operator[](int index);

    /// Puts a file first. It is listed once: under the name given last where it had another spelling, or where that
    /// name is a link to a listed file.
    virtual void Add(LPCSTR path);
    /// Takes a file out.
    virtual void Remove(int index);
    /// What the menu shows of a file: its name alone when it lies in the current folder, else what the application
    /// makes of it (CWinApp::GetAbbreviatedFileName).
    /// @param currentFolder with a separator at its end
    /// @param length        of that
    /// @param atLeastName   whether the name itself is shown even where it has no room
    /// @return FALSE when there is no such file
    virtual BOOL GetDisplayName(CString& name, int index, LPCSTR currentFolder, int length,
                                BOOL atLeastName = TRUE) const;
    /// Puts the files into a menu, in place of the entries that there are from the item's command on. Without files
    /// there is one grey entry with the text that the menu had at first.
    virtual void UpdateMenu(CCmdUI* item);
    /// Reads the list from the settings.
    virtual void ReadList();
    /// Stores the list, if it is not what was read.
    virtual void WriteList();

protected:
    UINT m_nStart;
    CString m_strSectionName;
    CString m_strEntryFormat;
    int m_nMaxDisplayLength;
    CString m_strOriginal; ///< The menu's text for an empty list.

private:
    template <class Change>
    void change(Change make);
    CString entry(int index) const;
    void readOnce();
    CString menuText(int index) const;
    std::vector<CString> m_names;
    std::vector<CString> m_stored; ///< As read; empty before that.
};
