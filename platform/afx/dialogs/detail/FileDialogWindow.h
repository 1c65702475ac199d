#pragma once

#include "platform/afx/dialogs/FileDialog.h"
#include "platform/afx/dialogs/detail/FileIcons.h"
#include "platform/afx/dialogs/detail/ToolkitDialog.h"

#include <QFileDialog>
#include <QStringList>

#include <functional>
#include <optional>
#include <vector>

class QComboBox;
class QLineEdit;

namespace tvx::afx {

/// One entry of a dialog's filters.
struct FileFilter {
    QString shown;     ///< as the toolkit takes it: "Boards (*.brd *.txt)"
    QString extension; ///< of names typed without one; empty when the entry is for all files
};

/// Takes a record's filter text apart; see OPENFILENAME::lpstrFilter.
[[nodiscard]] std::vector<FileFilter> filtersOf(LPCSTR text);

/// The toolkit's file dialog with the answers checked here: what was typed becomes the names that will be used, and
/// what is asked and said is about those. The toolkit would ask before an extension is added, and in a loop of its own.
class FileDialogWindow : public ToolkitDialog<QFileDialog> {
public:
    /// @param icons must live longer than the dialog
    FileDialogWindow(const OPENFILENAME& record, bool opens, FileIcons& icons);
    /// Asked with the chosen files before the dialog closes; false keeps it open.
    std::function<bool(const QStringList& files)> isAccepted;
    /// The chosen filter, counted from 1; the record's where there are none.
    DWORD filterIndex() const;

    void accept() override;

private:
    void label();
    void fillFilters();
    void fillName();
    void allowSeveral();
    void showColumnsWhole();

    QStringList markedFiles() const;
    QStringList typedNames() const;
    std::optional<QString> whole(const QString& name) const;
    bool isHere(const QString& name) const;
    bool goElsewhere(const QString& text, const QStringList& names);
    bool goInto(const QString& folder);
    QString withExtension(const QString& file) const;
    bool settle(QString& file) const;
    bool settleToOpen(QString& file) const;
    bool settleToSave(QString& file) const;
    bool has(DWORD flags) const {
        return (m_record.Flags & flags) != 0;
    }

    const OPENFILENAME& m_record;
    bool m_opens;
    std::vector<FileFilter> m_filters;
    QLineEdit* m_field;
    QComboBox* m_types;
};

} // namespace tvx::afx
