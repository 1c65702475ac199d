#pragma once

#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/DialogWatch.h"
#include "platform/afx/dialogs/detail/DialogWindow.h"

#include <QDialog>
#include <QKeyEvent>
#include <QPushButton>

namespace tvx::afx {

/// One of the toolkit's dialogs on a loop of ours, so that an exception of a handler gets out of it.
/// @tparam Base the toolkit's class, whose option DontUseNativeDialog is set: a desktop's own dialog would wait in a
///         loop of its own
template <class Base>
class ToolkitDialog : public Base {
public:
    /// @param owner the window that it stands over; null: defaultOwner
    /// @param title string resource of the caption
    /// @param help  number that help is asked for under, from FrameworkIds.h
    ToolkitDialog(HWND owner, UINT title, UINT help)
        : Base(parentFor(owner)), m_owner(owner ? owner : defaultOwner()), m_help(help) {
        this->setOption(Base::DontUseNativeDialog);
        this->setWindowModality(Qt::ApplicationModal);
        this->setWindowTitle(ownText(title));
    }
    /// Shows it and answers whether the user chose OK.
    bool ask() {
        tellDialogOpens();
        guarded([this] {
            // Pictures on buttons come and go with the desktop's style; no other dialog of the framework has them.
            for (auto* button : this->template findChildren<QPushButton*>()) {
                button->setIcon(QIcon());
            }
            this->show();
        });
        const int answer = m_loop.run();
        guarded([this] { this->hide(); });
        activateAgain(m_owner);
        return answer == QDialog::Accepted;
    }
    void done(int result) override {
        storing([&] { m_loop.end(result); });
    }

protected:
    /// Asked for before the key counts: the field for names takes all keys for itself.
    bool event(QEvent* event) override {
        if (event->type() == QEvent::ShortcutOverride) {
            const auto& key = static_cast<const QKeyEvent&>(*event);
            if (key.key() == Qt::Key_F1 && key.modifiers() == Qt::NoModifier && !isRepeated(key)) {
                event->accept();
                explain(m_owner, HID_BASE_RESOURCE + m_help);
                return true;
            }
        }
        return Base::event(event);
    }

private:
    static QWidget* parentFor(HWND owner) {
        Window* over = Window::from(owner ? owner : defaultOwner());
        return over ? over->topLevel()->widget() : nullptr;
    }
    HWND m_owner;
    UINT m_help;
    ModalLoop m_loop;
};

} // namespace tvx::afx
