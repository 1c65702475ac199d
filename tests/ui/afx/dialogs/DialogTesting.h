#pragma once

/// @file
/// Acting on dialogs as a user does.

#include "platform/afx/controls/Controls.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/DataExchange.h"
#include "platform/afx/dialogs/Dialog.h"
#include "tests/ui/afx/dialogs/DialogTestIds.h"

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QMessageBox>
#include <QTest>
#include <QTimer>

#include <functional>
#include <string>
#include <vector>

/// Presses a key where the keyboard is.
inline void key(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
    QWidget* focus = QApplication::focusWidget();
    ASSERT_NE(focus, nullptr);
    QTest::keyClick(focus, key, modifiers);
}

inline void type(const char* text) {
    QWidget* focus = QApplication::focusWidget();
    ASSERT_NE(focus, nullptr);
    for (const char32_t character : QString::fromUtf8(text).toUcs4()) {
        const Qt::Key key = character < 0x80 ? QTest::asciiToKey(static_cast<char>(character)) : Qt::Key_unknown;
        QTest::sendKeyEvent(QTest::Click, focus, key, QString::fromUcs4(&character, 1), Qt::NoModifier);
    }
}

/// Clicks a point of a control's client area, its middle when none is given.
inline void click(const CWnd* control, QPoint point = {-1, -1}, Qt::KeyboardModifiers modifiers = Qt::NoModifier,
                  Qt::MouseButton button = Qt::LeftButton) {
    QWidget* widget = tvx::afx::peerOf(control->m_hWnd);
    QTest::mouseClick(widget, button, modifiers, point.x() < 0 ? widget->rect().center() : point);
}

/// Waits until a window is the active one; the toolkit's own test takes a dialog for active when its owner is.
[[nodiscard]] inline bool waitForActive(const CWnd& window) {
    return QTest::qWaitFor([&] { return QApplication::activeWindow() == tvx::afx::peerOf(window.m_hWnd)->window(); });
}

inline std::string textOf(const CWnd* window) {
    CString text;
    window->GetWindowText(text);
    return text.GetString();
}

/// A dialog that a test works in once it is shown, and that ends then.
class ScriptedDialog : public CDialog {
public:
    explicit ScriptedDialog(UINT id, CWnd* parent = nullptr) : CDialog(id, parent) {}

    /// Answered when the script ran to its end with the dialog still open.
    static constexpr int scriptDone = 99;
    std::function<void()> script;
    std::function<void()> prepare;             ///< Runs in OnInitDialog.
    std::vector<std::pair<int, int>> commands; ///< Identifier and notification code of each WM_COMMAND, in order.

    int codes(int id, int code) const {
        return static_cast<int>(std::count(commands.begin(), commands.end(), std::pair(id, code)));
    }
    /// The identifier of the control that has the keyboard, 0 for none.
    int focus() const {
        const CWnd* control = GetFocus();
        return control ? control->GetDlgCtrlID() : 0;
    }

protected:
    BOOL OnInitDialog() override {
        CDialog::OnInitDialog();
        if (prepare) {
            prepare();
        }
        PostMessage(WM_APP);
        return TRUE;
    }
    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override {
        commands.emplace_back(LOWORD(wParam), HIWORD(wParam));
        return CDialog::OnCommand(wParam, lParam);
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return CDialog::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        if (script) {
            script();
        }
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(scriptDone);
        }
        return 0;
    }
};

/// Waits for a message box, notes its text and answers it by Enter.
class BoxAnswer {
public:
    BoxAnswer() {
        QObject::connect(&m_timer, &QTimer::timeout, &m_timer, [this] {
            auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
            if (box && box->isActiveWindow() && text.empty()) {
                text = box->text().toStdString();
                QTest::keyClick(box, Qt::Key_Enter);
                m_timer.stop();
            }
        });
        m_timer.start(0);
    }
    std::string text;

private:
    QTimer m_timer;
};
