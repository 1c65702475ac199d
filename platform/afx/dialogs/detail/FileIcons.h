#pragma once

#include <QFileIconProvider>
#include <QHash>
#include <QIcon>
#include <QMutex>

namespace tvx::afx {

/// Pictures and kinds of files by the ends of their names. The toolkit's own provider opens each file for that, which
/// takes most of the time until a large folder is shown (docs/decisions.md). The dialog's reading thread asks too.
class FileIcons : public QFileIconProvider {
public:
    FileIcons();
    QIcon icon(const QFileInfo& info) const override;
    QString type(const QFileInfo& info) const override;

private:
    struct Kind {
        QIcon icon;
        QString name;
    };
    Kind kindOf(const QString& suffix) const;
    QIcon m_folder;
    QIcon m_file;
    // Kept, since resources are not for the reading thread.
    QString m_plain;
    QString m_ofKind; ///< of a suffix that the desktop knows nothing of: "%1 File"
    mutable QMutex m_lock;
    mutable QHash<QString, Kind> m_kinds; ///< by suffix in lower case
};

} // namespace tvx::afx
