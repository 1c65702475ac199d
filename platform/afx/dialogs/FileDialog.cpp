#include "platform/afx/dialogs/FileDialog.h"

#include "platform/afx/core/detail/Paths.h"
#include "platform/afx/dialogs/detail/ToolkitDialog.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/FrameworkIds.h"

#include <QFileDialog>
#include <QFileInfo>
#include <QHeaderView>
#include <QScreen>
#include <QTreeView>

#include <cstring>

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

namespace {

/// A filter as the toolkit writes it: "Boards (*.brd) (*.brd)"; the pattern "*.*" means all files.
QStringList filtersOf(LPCSTR text) {
    QStringList filters;
    while (text && *text != '\0') {
        const QString description = toQt(text);
        text += std::strlen(text) + 1;
        QString patterns = toQt(text);
        text += std::strlen(text) + 1;
        patterns.replace(QLatin1Char(';'), QLatin1Char(' '));
        if (patterns == QLatin1String("*.*")) {
            patterns = QStringLiteral("*");
        }
        QString name = description.section(QLatin1Char('('), 0, 0).trimmed();
        filters.append(QStringLiteral("%1 (%2)").arg(name.isEmpty() ? description : name, patterns));
    }
    return filters;
}

class Dialog : public ToolkitDialog<QFileDialog> {
public:
    Dialog(HWND owner, UINT title, UINT help) : ToolkitDialog(owner, title, help) {
        showColumnsWhole();
    }
    std::function<bool()> isAccepted;

    /// The toolkit calls this from slots of its own. A host whose OnFileNameOK throws ends the loop with that.
    void done(int result) override {
        storing([&] {
            if (result != QDialog::Accepted || isAccepted()) {
                ToolkitDialog::done(result);
            }
        });
    }

private:
    /// The columns behind the name are as wide as what they show, and the name takes the rest.
    void showColumnsWhole() {
        auto* list = findChild<QTreeView*>(QStringLiteral("treeView"));
        if (!list) {
            return;
        }
        QHeaderView* header = list->header();
        header->setStretchLastSection(false);
        header->setSectionResizeMode(QHeaderView::ResizeToContents);
        header->setSectionResizeMode(0, QHeaderView::Stretch);
        const QSize room = screen()->availableGeometry().size() * 9 / 10;
        resize(sizeHint().expandedTo(fontMetrics().averageCharWidth() * QSize(130, 70)).boundedTo(room));
    }
};

void labelDialog(Dialog& dialog, bool open) {
    dialog.setLabelText(QFileDialog::LookIn, ownText(open ? TVX_IDS_FILE_LOOK_IN : TVX_IDS_FILE_SAVE_IN));
    dialog.setLabelText(QFileDialog::FileName, ownText(TVX_IDS_FILE_NAME));
    dialog.setLabelText(QFileDialog::FileType, ownText(TVX_IDS_FILE_TYPE));
    dialog.setLabelText(QFileDialog::Accept, ownText(open ? TVX_IDS_FILE_OPEN : TVX_IDS_FILE_SAVE));
    dialog.setLabelText(QFileDialog::Reject, ownText(TVX_IDS_FILE_CANCEL));
}

void fillDialog(Dialog& dialog, const OPENFILENAME& record, bool open) {
    const bool several = (record.Flags & OFN_ALLOWMULTISELECT) != 0;
    const bool mustExist = (record.Flags & OFN_FILEMUSTEXIST) != 0;
    dialog.setAcceptMode(open ? QFileDialog::AcceptOpen : QFileDialog::AcceptSave);
    dialog.setFileMode(!open || !mustExist ? QFileDialog::AnyFile
                       : several           ? QFileDialog::ExistingFiles
                                           : QFileDialog::ExistingFile);
    labelDialog(dialog, open);
    dialog.setOption(QFileDialog::DontConfirmOverwrite, (record.Flags & OFN_OVERWRITEPROMPT) == 0);
    if (record.lpstrTitle) {
        dialog.setWindowTitle(toQt(record.lpstrTitle));
    }
    const QStringList filters = filtersOf(record.lpstrFilter);
    dialog.setNameFilters(filters);
    const auto chosen = static_cast<qsizetype>(record.nFilterIndex) - 1;
    if (chosen >= 0 && chosen < filters.size()) {
        dialog.selectNameFilter(filters[chosen]);
    }
    // Some hosts say "*.*" where they mean none.
    if (record.lpstrDefExt && !std::strpbrk(record.lpstrDefExt, "*?")) {
        dialog.setDefaultSuffix(toQt(record.lpstrDefExt));
    }
    if (record.lpstrInitialDir && *record.lpstrInitialDir != '\0') {
        dialog.setDirectory(QString::fromStdString(tvx::systemPath(record.lpstrInitialDir).value_or("")));
    }
    const CString name(record.lpstrFile ? record.lpstrFile : "");
    if (!name.IsEmpty()) {
        const auto path = tvx::systemPath(name.GetString(), tvx::PathUse::Creating).value_or(name.GetString());
        const QFileInfo info(QString::fromStdString(path));
        if (info.isAbsolute()) {
            dialog.setDirectory(info.absolutePath());
        }
        dialog.selectFile(info.isAbsolute() ? info.fileName() : QString::fromStdString(path));
    }
}

} // namespace

struct CFileDialog::Answer {
    QStringList files;
    int filter = 0;
};

INT_PTR CFileDialog::DoModal() {
    if (!ensureGui()) {
        return IDCANCEL;
    }
    Dialog dialog(m_ofn.hwndOwner, m_bOpenFileDialog ? AFX_IDS_OPENFILE : AFX_IDS_SAVEFILE,
                  m_bOpenFileDialog ? AFX_IDD_FILEOPEN : AFX_IDD_FILESAVE);
    fillDialog(dialog, m_ofn, m_bOpenFileDialog != FALSE);
    dialog.isAccepted = [this, &dialog] {
        const auto filters = dialog.nameFilters();
        takeAnswer({dialog.selectedFiles(), static_cast<int>(filters.indexOf(dialog.selectedNameFilter()))});
        return OnFileNameOK() == 0;
    };
    return dialog.ask() ? IDOK : IDCANCEL;
}

void CFileDialog::takeAnswer(const Answer& answer) {
    m_paths.clear();
    for (const QString& file : answer.files) {
        m_paths.emplace_back(tvx::driveName(fromQt(file)).c_str());
    }
    m_ofn.nFilterIndex = static_cast<DWORD>(answer.filter + 1);
    const CString path = GetPathName();
    if (m_ofn.lpstrFile && m_ofn.nMaxFile > static_cast<DWORD>(path.GetLength())) {
        std::memcpy(m_ofn.lpstrFile, path.GetString(), static_cast<std::size_t>(path.GetLength()) + 1);
    }
    const CString name = lastPart(path);
    m_ofn.nFileOffset = static_cast<WORD>(path.GetLength() - name.GetLength());
    const int extension = extensionOf(path).GetLength();
    m_ofn.nFileExtension = static_cast<WORD>(extension > 0 ? path.GetLength() - extension + 1 : 0);
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
