#include "platform/afx/dialogs/detail/FileDialogWindow.h"

#include "platform/afx/core/App.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/SystemPath.h"
#include "platform/win/Files.h"
#include "platform/win/FrameworkIds.h"

#include <QAction>
#include <QComboBox>
#include <QCompleter>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QHeaderView>
#include <QLineEdit>
#include <QListView>
#include <QScreen>
#include <QTreeView>

#include <algorithm>
#include <cstring>

namespace tvx::afx {

namespace {

/// The first pattern's extension: "brd" of "*.brd *.txt". One with wildcards is none.
QString extensionOf(const QString& patterns) {
    const QString first = patterns.section(QLatin1Char(' '), 0, 0);
    const QString extension = first.startsWith(QLatin1String("*.")) ? first.mid(2) : QString();
    return extension.contains(QLatin1Char('*')) || extension.contains(QLatin1Char('?')) ? QString() : extension;
}

/// A description without the patterns that many hosts write behind it in brackets; the toolkit writes them itself.
QString withoutPatterns(const QString& description) {
    const auto bracket = description.lastIndexOf(QLatin1Char('('));
    const bool hasPatterns = bracket > 0 && description.indexOf(QLatin1Char('*'), bracket) > 0;
    return (hasPatterns ? description.left(bracket) : description).trimmed();
}

int say(UINT message, const QString& file, UINT type = MB_OK | MB_ICONEXCLAMATION) {
    CString text;
    AfxFormatString1(text, message, tvx::shownName(fromQt(file)).c_str());
    return AfxMessageBox(text, type, message);
}

bool agrees(UINT question, const QString& file) {
    return say(question, file, MB_YESNO | MB_ICONEXCLAMATION | MB_DEFBUTTON2) == IDYES;
}

bool isFolder(const QString& file) {
    return QFileInfo(file).isDir();
}

QString folderOf(const QString& file) {
    return QFileInfo(file).path();
}

bool isReadOnly(const QString& file) {
    const DWORD attributes = GetFileAttributesA(fromQt(file).c_str());
    return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_READONLY) != 0;
}

/// The folder, or the nearest one above it that is still there.
QString livingFolder(QString folder) {
    while (!folder.isEmpty() && folder != QLatin1String("/") && !isFolder(folder)) {
        folder = folderOf(folder);
    }
    return folder;
}

/// The patterns of a text that separates them by ";" or blanks. What old patterns mean by all files is all files.
QStringList patternsOf(QString text) {
    QStringList patterns = text.replace(QLatin1Char(';'), QLatin1Char(' ')).split(QLatin1Char(' '), Qt::SkipEmptyParts);
    std::ranges::replace(patterns, QStringLiteral("*.*"), QStringLiteral("*"));
    return patterns;
}

} // namespace

std::vector<FileFilter> filtersOf(LPCSTR text) {
    std::vector<FileFilter> filters;
    while (text && *text != '\0') {
        const QString description = toQt(text);
        text += std::strlen(text) + 1;
        const QString patterns = patternsOf(toQt(text)).join(QLatin1Char(' '));
        text += std::strlen(text) + 1;
        const QString name = withoutPatterns(description);
        filters.push_back(
            {QStringLiteral("%1 (%2)").arg(name.isEmpty() ? description : name, patterns), extensionOf(patterns)});
    }
    return filters;
}

FileDialogWindow::FileDialogWindow(const OPENFILENAME& record, bool opens, FileIcons& icons)
    : ToolkitDialog(record.hwndOwner, opens ? AFX_IDS_OPENFILE : AFX_IDS_SAVEFILE,
                    opens ? AFX_IDD_FILEOPEN : AFX_IDD_FILESAVE),
      m_record(record),
      m_opens(opens),
      m_filters(filtersOf(record.lpstrFilter)),
      m_field(findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))),
      m_types(findChild<QComboBox*>(QStringLiteral("fileTypeCombo"))) {
    setIconProvider(&icons);
    setAcceptMode(opens ? AcceptOpen : AcceptSave);
    // In its other modes the toolkit's button is grey for a name that has yet to get its extension.
    setFileMode(AnyFile);
    label();
    if (has(OFN_ALLOWMULTISELECT)) {
        allowSeveral();
    }
    fillFilters();
    fillName();
    showColumnsWhole();
    // The toolkit has it in the list's context menu only.
    if (auto* hidden = findChild<QAction*>(QStringLiteral("qt_show_hidden_action"))) {
        hidden->setShortcut(Qt::CTRL | Qt::Key_H);
        addAction(hidden);
    }
}

// --- what is shown ---

void FileDialogWindow::label() {
    if (m_record.lpstrTitle) {
        setWindowTitle(toQt(m_record.lpstrTitle));
    }
    setLabelText(LookIn, ownText(m_opens ? TVX_IDS_FILE_LOOK_IN : TVX_IDS_FILE_SAVE_IN));
    setLabelText(FileName, ownText(TVX_IDS_FILE_NAME));
    setLabelText(FileType, ownText(TVX_IDS_FILE_TYPE));
    setLabelText(Accept, ownText(m_opens ? TVX_IDS_FILE_OPEN : TVX_IDS_FILE_SAVE));
    setLabelText(Reject, ownText(TVX_IDS_FILE_CANCEL));
}

void FileDialogWindow::allowSeveral() {
    const auto views = findChildren<QAbstractItemView*>();
    for (QAbstractItemView* view : views) {
        if (view->objectName() == QLatin1String("treeView") || view->objectName() == QLatin1String("listView")) {
            view->setSelectionMode(QAbstractItemView::ExtendedSelection);
        }
    }
}

void FileDialogWindow::fillFilters() {
    if (m_filters.empty()) {
        return;
    }
    QStringList texts;
    for (const FileFilter& filter : m_filters) {
        texts.append(filter.shown);
    }
    setNameFilters(texts);
    const auto count = static_cast<DWORD>(m_filters.size());
    const DWORD chosen = m_record.nFilterIndex >= 1 && m_record.nFilterIndex <= count ? m_record.nFilterIndex - 1 : 0;
    selectNameFilter(texts[static_cast<qsizetype>(chosen)]);
    // The toolkit goes by the text, of which there may be several.
    m_types->setCurrentIndex(static_cast<int>(chosen));
}

DWORD FileDialogWindow::filterIndex() const {
    return m_filters.empty() ? m_record.nFilterIndex : static_cast<DWORD>(m_types->currentIndex() + 1);
}

void FileDialogWindow::fillName() {
    const std::string given(m_record.lpstrFile ? m_record.lpstrFile : "");
    const auto name = QString::fromStdString(systemPath(given, PathUse::Creating).value_or(given));
    const QFileInfo info(name);
    const bool isWhole = info.isAbsolute();
    QString folder = isWhole ? info.path() : QDir::currentPath();
    if (!isWhole && m_record.lpstrInitialDir && *m_record.lpstrInitialDir != '\0') {
        folder = QString::fromStdString(systemPath(m_record.lpstrInitialDir).value_or(fromQt(folder)));
    }
    setDirectory(livingFolder(QDir::cleanPath(folder)));
    if (name.isEmpty()) {
        return;
    }
    const QString shown = isWhole ? info.fileName() : name;
    selectFile(shown);
    // The toolkit shows the last part of a name with folders.
    m_field->setText(shown);
    m_field->selectAll();
}

/// The columns behind the name are as wide as what they show, and the name takes the rest.
void FileDialogWindow::showColumnsWhole() {
    auto* list = findChild<QTreeView*>(QStringLiteral("treeView"));
    if (!list) {
        return;
    }
    QHeaderView* header = list->header();
    header->setStretchLastSection(false);
    header->setSectionResizeMode(QHeaderView::ResizeToContents);
    header->setSectionResizeMode(0, QHeaderView::Stretch);
    header->setResizeContentsPrecision(0); // by the lines that are shown, not by a thousand
    const QSize room = screen()->availableGeometry().size() * 9 / 10;
    resize(sizeHint().expandedTo(fontMetrics().averageCharWidth() * QSize(130, 70)).boundedTo(room));
}

// --- what was typed ---

bool FileDialogWindow::isHere(const QString& name) const {
    return !name.isEmpty() && QFileInfo::exists(directory().absoluteFilePath(name));
}

/// The files marked in the list, where the field shows just them. They may lie in another folder than the list: the
/// toolkit marks what a typed name leads to.
QStringList FileDialogWindow::markedFiles() const {
    const auto rows = findChild<QListView*>(QStringLiteral("listView"))->selectionModel()->selectedRows();
    QStringList files;
    QStringList names;
    for (const QModelIndex& row : rows) {
        files.append(row.data(QFileSystemModel::FilePathRole).toString());
        names.append(row.data().toString());
    }
    const QString several = QLatin1Char('"') + names.join(QLatin1String("\" \"")) + QLatin1Char('"');
    return m_field->text() == (names.size() == 1 ? names.front() : several) ? files : QStringList();
}

/// What stands in the field: one name, or several in quotation marks. A file that is called so comes first.
QStringList FileDialogWindow::typedNames() const {
    const QString text = m_field->text();
    QStringList marked = markedFiles();
    if (!marked.isEmpty()) {
        return marked;
    }
    if (isHere(text)) {
        return {text};
    }
    const QLatin1Char quote('"');
    if (!text.contains(quote)) {
        return text.trimmed().isEmpty() ? QStringList() : QStringList(text.trimmed());
    }
    QStringList names;
    const QStringList parts = text.split(quote);
    for (const QString& part : parts) {
        if (!part.trimmed().isEmpty()) {
            names.append(part);
        }
    }
    return has(OFN_ALLOWMULTISELECT) ? names : names.mid(0, 1);
}

/// The system's form of a typed name from the root on; nothing for one that cannot be.
std::optional<QString> FileDialogWindow::whole(const QString& name) const {
    if (isHere(name)) {
        return QDir::cleanPath(directory().absoluteFilePath(name));
    }
    std::string text = fromQt(name);
    if (name == QLatin1String("~") || name.startsWith(QLatin1String("~/"))) {
        text = fromQt(QDir::homePath() + name.mid(1));
    }
    const bool isWhole = text.starts_with('/') || text.starts_with('\\') || hasDrive(text);
    if (!isWhole) {
        text = fromQt(directory().absolutePath()) + '/' + text;
    }
    const auto path = systemPath(text, m_opens ? PathUse::Existing : PathUse::Creating);
    if (!path) {
        return std::nullopt;
    }
    return QDir::cleanPath(directory().absoluteFilePath(QString::fromStdString(*path)));
}

QString FileDialogWindow::withExtension(const QString& file) const {
    if (!m_record.lpstrDefExt || QFileInfo(file).fileName().contains(QLatin1Char('.'))) {
        return file;
    }
    QString extension = m_filters.empty() ? QString() : m_filters[filterIndex() - 1].extension;
    // Some hosts say "*.*" where they mean none.
    if (extension.isEmpty() && !std::strpbrk(m_record.lpstrDefExt, "*?")) {
        extension = toQt(m_record.lpstrDefExt);
    }
    return extension.isEmpty() ? file : file + QLatin1Char('.') + extension;
}

// --- the answer ---

void FileDialogWindow::accept() {
    storing([this] {
        // The toolkit leaves its proposals open, for the dialog that goes away with them.
        if (m_field->completer()) {
            m_field->completer()->popup()->hide();
        }
        const QStringList typed = typedNames();
        QStringList files;
        for (const QString& name : typed) {
            const auto file = whole(name);
            if (!file) {
                AfxMessageBox(AFX_IDP_INVALID_FILENAME, MB_OK | MB_ICONEXCLAMATION);
                return;
            }
            files.append(*file);
        }
        if (goElsewhere(typed.value(0), files)) {
            return;
        }
        for (QString& file : files) {
            if (!settle(file)) {
                return;
            }
        }
        if (isAccepted(files)) {
            done(QDialog::Accepted);
        }
    });
}

/// Whether the answer is no file: a folder, which is gone into, or a pattern, by which the list is filtered.
bool FileDialogWindow::goElsewhere(const QString& text, const QStringList& names) {
    if (names.isEmpty()) {
        const QStringList selected = selectedFiles();
        return selected.isEmpty() || !isFolder(selected.front()) || goInto(selected.front());
    }
    if (names.size() == 1 && isFolder(names.front())) {
        return goInto(names.front());
    }
    const bool isPattern = text.contains(QLatin1Char('*')) || text.contains(QLatin1Char('?'));
    if (names.size() == 1 && isPattern && !QFileInfo::exists(names.front())) {
        findChild<QFileSystemModel*>()->setNameFilters(patternsOf(text));
        m_field->selectAll();
        return true;
    }
    return false;
}

bool FileDialogWindow::goInto(const QString& folder) {
    const QFileInfo info(folder);
    if (!info.isReadable() || !info.isExecutable()) {
        say(AFX_IDP_FAILED_ACCESS_READ, folder);
        return true;
    }
    setDirectory(folder);
    m_field->clear();
    return true;
}

/// Gives a name its final form and asks and says what there is to. False keeps the dialog open.
bool FileDialogWindow::settle(QString& file) const {
    if (!(m_opens ? settleToOpen(file) : settleToSave(file))) {
        return false;
    }
    if (isFolder(file)) {
        say(TVX_IDS_IS_FOLDER, file);
        return false;
    }
    return true;
}

bool FileDialogWindow::settleToOpen(QString& file) const {
    if (!QFileInfo::exists(file)) {
        const QString completed = withExtension(file);
        file = QString::fromStdString(systemPath(fromQt(completed)).value_or(fromQt(completed)));
    }
    if (QFileInfo::exists(file) || has(OFN_NOVALIDATE)) {
        return true;
    }
    if (has(OFN_FILEMUSTEXIST)) {
        say(AFX_IDP_FAILED_INVALID_PATH, file);
        return false;
    }
    if (has(OFN_PATHMUSTEXIST | OFN_CREATEPROMPT) && !isFolder(folderOf(file))) {
        say(TVX_IDS_FILE_NO_FOLDER, folderOf(file));
        return false;
    }
    return !has(OFN_CREATEPROMPT) || agrees(TVX_IDS_FILE_CREATE, file);
}

bool FileDialogWindow::settleToSave(QString& file) const {
    file = withExtension(file);
    if (has(OFN_PATHMUSTEXIST) && !has(OFN_NOVALIDATE) && !isFolder(folderOf(file))) {
        say(TVX_IDS_FILE_NO_FOLDER, folderOf(file));
        return false;
    }
    if (!QFileInfo::exists(file) || isFolder(file)) {
        return true;
    }
    if (isReadOnly(file)) {
        say(AFX_IDP_FAILED_ACCESS_WRITE, file);
        return false;
    }
    return !has(OFN_OVERWRITEPROMPT) || agrees(TVX_IDS_FILE_REPLACE, file);
}

} // namespace tvx::afx
