#include "platform/afx/frames/RecentFileList.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/Menu.h"
#include "platform/afx/core/detail/Paths.h"
#include "platform/base/SystemPath.h"

#include <algorithm>

using namespace tvx::afx;

CRecentFileList::CRecentFileList(UINT start, LPCSTR section, LPCSTR entryFormat, int size, int maxDisplayLength)
    : m_nStart(start),
      m_strSectionName(section),
      m_strEntryFormat(entryFormat),
      m_nMaxDisplayLength(maxDisplayLength),
      m_names(static_cast<std::size_t>(std::max(size, 1))) {}

CRecentFileList::~CRecentFileList() = default;

// --- the settings ---

CString CRecentFileList::entry(int index) const {
    CString name;
    name.Format(m_strEntryFormat, index + 1);
    return name;
}

void CRecentFileList::ReadList() {
    for (int i = 0; i < GetSize(); ++i) {
        m_names[static_cast<std::size_t>(i)] = AfxGetApp()->GetProfileString(m_strSectionName, entry(i));
    }
    // What somebody deleted between others leaves no gap.
    std::ranges::stable_partition(m_names, [](const CString& name) { return !name.IsEmpty(); });
    m_stored = m_names;
}

void CRecentFileList::readOnce() {
    if (m_stored.empty()) {
        ReadList();
    }
}

void CRecentFileList::WriteList() {
    if (m_stored.empty() || m_stored == m_names) {
        return;
    }
    CWinApp& app = *AfxGetApp();
    app.WriteProfileString(m_strSectionName, nullptr, nullptr);
    for (int i = 0; i < GetSize() && !m_names[static_cast<std::size_t>(i)].IsEmpty(); ++i) {
        app.WriteProfileString(m_strSectionName, entry(i), m_names[static_cast<std::size_t>(i)]);
    }
    m_stored = m_names;
}

/// Changes what the settings hold now. Where they cannot be locked, another program's change of the same moment may be
/// lost; the list is not worth an error.
template <class Change>
void CRecentFileList::change(Change make) {
    tvx::RegistryTransaction transaction;
    const bool isTogether = transaction.begin() == ERROR_SUCCESS;
    ReadList();
    make();
    WriteList();
    if (isTogether) {
        (void)transaction.commit();
    }
}

// --- the files ---

CString& CRecentFileList::operator[](int index) {
    readOnce();
    return m_names.at(static_cast<std::size_t>(index));
}

void CRecentFileList::Add(LPCSTR path) {
    const CString name = spelledPath(path);
    if (name.IsEmpty()) {
        return;
    }
    ReadList();
    if (m_names.front() == name) {
        return;
    }
    const CString target = realPath(name);
    change([&] {
        // Two files may differ in case alone. Only one that has the same folder as the new one is looked for.
        auto at = std::ranges::find_if(m_names, [&](const CString& listed) {
            return listed == name || listed == target ||
                   (listed.CompareNoCase(name) == 0 && spelledPath(listed) == name);
        });
        at = at == m_names.end() ? at - 1 : at;
        std::rotate(m_names.begin(), at, at + 1);
        m_names.front() = name;
    });
}

void CRecentFileList::Remove(int index) {
    const CString name = (*this)[index];
    change([&] {
        const auto gone = std::ranges::find(m_names, name);
        if (gone != m_names.end()) {
            std::rotate(gone, gone + 1, m_names.end());
            m_names.back().Empty();
        }
    });
}

// --- the menu ---

BOOL CRecentFileList::GetDisplayName(CString& name, int index, LPCSTR currentFolder, int length,
                                     BOOL atLeastName) const {
    const CString& path = m_names.at(static_cast<std::size_t>(index));
    const CString last = lastPart(path);
    const bool isHere =
        path.GetLength() == length + last.GetLength() && path.Left(length) == CString(currentFolder, length);
    name = isHere ? last : AfxGetApp()->GetAbbreviatedFileName(path, m_nMaxDisplayLength, atLeastName);
    return !path.IsEmpty();
}

/// "&1 C:\plans\gear.brd"; the tenth is "1&0", and those behind it have no key.
CString CRecentFileList::menuText(int index) const {
    const CString folder = CString(tvx::currentFolderName().c_str()) + "\\";
    CString name;
    if (!GetDisplayName(name, index, folder, folder.GetLength())) {
        return {};
    }
    name.Replace("&", "&&");
    name.Replace("\t", " "); // what follows one is a key
    const UINT number = m_nStart + static_cast<UINT>(index) + 1;
    CString key;
    key.Format(number < 10 ? "&%u " : "%u ", number);
    return (number == 10 ? CString("1&0 ") : key) + name;
}

void CRecentFileList::UpdateMenu(CCmdUI* item) {
    CMenu* menu = item->m_pMenu;
    if (!menu || item->m_pSubMenu) {
        readOnce();
        item->Enable(!m_names.front().IsEmpty());
        return;
    }
    if (m_strOriginal.IsEmpty()) {
        menu->GetMenuString(item->m_nID, m_strOriginal, MF_BYCOMMAND);
    }
    ReadList();
    const UINT first = item->m_nID;
    for (UINT i = 1; i < m_names.size(); ++i) {
        menu->DeleteMenu(first + i, MF_BYCOMMAND);
    }
    const CString text = menuText(0);
    item->SetText(text.IsEmpty() ? m_strOriginal : text);
    item->Enable(!text.IsEmpty());
    for (int i = 1; i < GetSize() && !m_names[static_cast<std::size_t>(i)].IsEmpty(); ++i) {
        menu->InsertMenu(++item->m_nIndex, MF_STRING | MF_BYPOSITION, ++item->m_nID, menuText(i));
    }
    item->m_nIndexMax = menu->GetMenuItemCount();
}
