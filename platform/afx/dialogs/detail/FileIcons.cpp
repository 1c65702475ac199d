#include "platform/afx/dialogs/detail/FileIcons.h"

#include "platform/afx/core/detail/OwnText.h"
#include "platform/win/FrameworkIds.h"

#include <QFileInfo>
#include <QMimeDatabase>
#include <QMutexLocker>

namespace tvx::afx {

namespace {

/// Kinds that are looked up. A folder of "part.00001", "part.00002", ... has as many suffixes as files, none of a kind.
constexpr int mostKinds = 200;

} // namespace

FileIcons::FileIcons()
    : m_folder(QFileIconProvider::icon(Folder)),
      m_file(QFileIconProvider::icon(File)),
      m_plain(ownText(TVX_IDS_FILE_PLAIN)),
      m_ofKind(ownText(TVX_IDS_FILE_OF_KIND)) {}

QIcon FileIcons::icon(const QFileInfo& info) const {
    if (info.isRoot()) {
        return QFileIconProvider::icon(info);
    }
    return info.isDir() ? m_folder : kindOf(info.suffix()).icon;
}

QString FileIcons::type(const QFileInfo& info) const {
    return info.isFile() ? kindOf(info.suffix()).name : QFileIconProvider::type(info);
}

FileIcons::Kind FileIcons::kindOf(const QString& suffix) const {
    const QMutexLocker locked(&m_lock);
    QString key = suffix.toLower();
    if (m_kinds.size() >= mostKinds && !m_kinds.contains(key)) {
        key.clear();
    }
    const auto known = m_kinds.constFind(key);
    if (known != m_kinds.constEnd()) {
        return *known;
    }
    const QMimeType kind = QMimeDatabase().mimeTypeForFile(QStringLiteral("a.") + key, QMimeDatabase::MatchExtension);
    const QIcon generic = QIcon::fromTheme(kind.genericIconName(), m_file);
    const QString unknown = key.isEmpty() ? m_plain : m_ofKind.arg(key.toUpper());
    return *m_kinds.insert(key,
                           {QIcon::fromTheme(kind.iconName(), generic), kind.isDefault() ? unknown : kind.comment()});
}

} // namespace tvx::afx
