#include "platform/afx/dialogs/FileDialog.h"

#include "platform/afx/core/detail/Paths.h"
#include "platform/afx/dialogs/detail/FileDialogWindow.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"

#include <cstring>
#include <filesystem>
#include <string>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CFileDialog, CWnd)

CFileDialog::CFileDialog(BOOL openDialog, LPCSTR defaultExtension, LPCSTR fileName, DWORD flags, LPCSTR filter,
                         CWnd* parent, DWORD)
    : m_bOpenFileDialog(openDialog), m_defaultExtension(defaultExtension ? defaultExtension : "") {
    m_ofn.lStructSize = sizeof(m_ofn);
    m_ofn.Flags = flags;
    m_ofn.hwndOwner = parent ? parent->m_hWnd : nullptr;
    m_ofn.lpstrFile = m_fileName;
    m_ofn.nMaxFile = sizeof(m_fileName);
    m_ofn.nFilterIndex = 1;
    m_ofn.lpstrDefExt = defaultExtension ? m_defaultExtension.GetString() : nullptr;
    if (fileName) {
        tvx::text::copyCut(fileName, m_fileName, sizeof(m_fileName));
    }
    if (filter) {
        m_filter = filter;
        m_filter.Replace('|', '\0');
        m_ofn.lpstrFilter = m_filter.GetString();
    }
}

CFileDialog::~CFileDialog() = default;

BOOL CFileDialog::OnFileNameOK() {
    return 0;
}

INT_PTR CFileDialog::DoModal() {
    if (!ensureGui()) {
        return IDCANCEL;
    }
    FileIcons icons;
    FileDialogWindow dialog(m_ofn, m_bOpenFileDialog != FALSE, icons);
    dialog.isAccepted = [this, &dialog](const QStringList& files) {
        m_paths.clear();
        for (const QString& file : files) {
            m_paths.emplace_back(tvx::driveName(fromQt(file)).c_str());
        }
        m_ofn.nFilterIndex = dialog.filterIndex();
        fillRecord();
        return OnFileNameOK() == 0;
    };
    if (!dialog.ask()) {
        return IDCANCEL;
    }
    if ((m_ofn.Flags & OFN_NOCHANGEDIR) == 0) {
        std::error_code ignored;
        std::filesystem::current_path(tvx::systemPath(folderOf(m_paths.front()).View()).value_or(""), ignored);
    }
    return IDOK;
}

namespace {

/// Hands a text to a host's buffer. One that has no room is emptied: it must not go on naming another file.
void give(std::string_view text, LPSTR buffer, DWORD room) {
    if (buffer && room > 0) {
        const bool fits = text.size() < room;
        std::memcpy(buffer, text.data(), fits ? text.size() : 0);
        buffer[fits ? text.size() : 0] = '\0';
    }
}

} // namespace

CString CFileDialog::folderOf(const CString& path) {
    return path.Left(path.GetLength() - lastPart(path).GetLength());
}

/// Several files are one text: their folder, zero, a name, zero, ..., and one more zero.
void CFileDialog::fillRecord() {
    const CString path = GetPathName();
    const CString folder = folderOf(path);
    std::string all = path.GetString();
    if (m_paths.size() > 1) {
        const bool isRoot = folder.GetLength() <= 3;
        all = isRoot ? folder.View() : folder.View().substr(0, folder.View().size() - 1);
        for (const CString& each : m_paths) {
            all += '\0';
            all += each.View().starts_with(folder.View()) ? each.Mid(folder.GetLength()).View() : each.View();
        }
    }
    if ((m_ofn.Flags & OFN_ALLOWMULTISELECT) != 0) {
        all += '\0';
    }
    give(all, m_ofn.lpstrFile, m_ofn.nMaxFile);
    const CString name = lastPart(path);
    give(name.View(), m_ofn.lpstrFileTitle, m_ofn.nMaxFileTitle);
    m_ofn.nFileOffset = static_cast<WORD>(folder.GetLength());
    const CString extension = extensionOf(path);
    m_ofn.nFileExtension = static_cast<WORD>(extension.IsEmpty() ? 0 : path.GetLength() - extension.GetLength() + 1);
    m_ofn.Flags &= ~static_cast<DWORD>(OFN_READONLY | OFN_EXTENSIONDIFFERENT);
    if (m_ofn.lpstrDefExt && extension.Mid(1).CompareNoCase(m_ofn.lpstrDefExt) != 0) {
        m_ofn.Flags |= OFN_EXTENSIONDIFFERENT;
    }
}

CString CFileDialog::GetPathName() const {
    return m_paths.empty() ? CString(m_ofn.lpstrFile ? m_ofn.lpstrFile : "") : m_paths.front();
}

CString CFileDialog::GetFileName() const {
    return lastPart(GetPathName());
}

CString CFileDialog::GetFileExt() const {
    const CString extension = extensionOf(GetPathName());
    return extension.IsEmpty() ? extension : extension.Mid(1);
}

CString CFileDialog::GetFileTitle() const {
    return withoutExtension(GetFileName());
}

POSITION CFileDialog::GetStartPosition() const {
    return m_paths.empty() ? nullptr : reinterpret_cast<POSITION>(std::uintptr_t{1});
}

CString CFileDialog::GetNextPathName(POSITION& position) const {
    // A position is the path's number, counted from 1.
    const auto number = reinterpret_cast<std::uintptr_t>(position);
    position = number < m_paths.size() ? reinterpret_cast<POSITION>(number + 1) : nullptr;
    return number >= 1 && number <= m_paths.size() ? m_paths[number - 1] : CString();
}
