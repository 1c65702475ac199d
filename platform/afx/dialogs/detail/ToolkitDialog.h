#pragma once

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/DialogWatch.h"

#include <QDialog>
#include <QPushButton>

namespace tvx::afx {

/// One of the toolkit's dialogs on a loop of ours, so that an exception of a handler gets out of it.
/// @tparam Base the toolkit's class, whose option DontUseNativeDialog is set: a desktop's own dialog would wait in a
///         loop of its own
template <class Base>
class ToolkitDialog : public Base {
public:
    /// @param owner the window that it stands over; null: the main window
    /// @param title string resource of the caption
    ToolkitDialog(HWND owner, UINT title) : Base(parentFor(owner)) {
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
        return answer == QDialog::Accepted;
    }
    void done(int result) override {
        storing([&] { m_loop.end(result); });
    }

private:
    static QWidget* parentFor(HWND owner) {
        const CWnd* main = AfxGetMainWnd();
        Window* over = Window::from(owner || !main ? owner : main->m_hWnd);
        return over ? over->topLevel()->widget() : nullptr;
    }
    ModalLoop m_loop;
};

} // namespace tvx::afx
