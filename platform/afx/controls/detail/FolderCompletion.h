#pragma once

/// @file
/// The list of folders below a field that a name is typed into.

#include "platform/win/Background.h"
#include "platform/win/FolderNames.h"

#include <QListView>
#include <QObject>
#include <QPointer>
#include <QStringListModel>

#include <memory>
#include <optional>
#include <string>

class QLineEdit;
class QSocketNotifier;

namespace tvx::afx {

/// Completes what is typed into a field. It belongs to the field's control; see SHAutoComplete for what users see.
class FolderCompletion : public QObject {
public:
    explicit FolderCompletion(QLineEdit& field);
    ~FolderCompletion() override;

    [[nodiscard]] bool isOpen() const;
    /// Whether a key (VK_...) that was pressed in the field is meant for the list.
    [[nodiscard]] bool wantsKey(WPARAM key) const;
    /// Acts on a key that it wants. False for others.
    bool takeKey(WPARAM key);

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    /// What is typed: a folder, with its separator, and how the name behind it begins.
    struct Typed {
        std::string folder;
        std::string start;
    };
    [[nodiscard]] std::optional<Typed> typed() const;
    void look();
    void ask(const Typed& typed);
    void answered();
    void show(const Typed& typed);
    void place();
    void close();
    void move(int rows);
    void take(const QString& name);
    /// What all lines have in common, when that is more than is typed.
    [[nodiscard]] QString common() const;

    QLineEdit& m_field;
    QPointer<QListView> m_list;
    QStringListModel m_lines;
    Question<FolderNames> m_question;
    std::unique_ptr<QSocketNotifier> m_notifier;
    std::string m_folder; ///< that is asked about
    HiddenFolders m_hidden = HiddenFolders::LeaveOut;
    bool m_taking = false;
};

} // namespace tvx::afx
