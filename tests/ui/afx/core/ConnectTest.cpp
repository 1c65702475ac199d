#include "afxwin.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"

#include <QAbstractScrollArea>
#include <QComboBox>
#include <QKeyEvent>
#include <QLineEdit>
#include <QPaintEvent>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScrollBar>

#include <functional>
#include <gtest/gtest.h>
#include <stdexcept>

namespace {

/// A host's window whose handlers of commands and scrolling fail.
class FailingParent : public CWnd {
public:
    bool fails = false;
    FailingParent() {
        CreateEx(0, AfxRegisterWndClass(0), "failing", WS_OVERLAPPEDWINDOW, 10, 10, 300, 200, nullptr, nullptr);
    }
    ~FailingParent() override {
        DestroyWindow();
    }

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (fails && (message == WM_COMMAND || message == WM_HSCROLL || message == WM_DRAWITEM)) {
            throw std::runtime_error("failed");
        }
        return CWnd::WindowProc(message, wParam, lParam);
    }
};

template <class Part>
Part& part(const CWnd& window) {
    QWidget* peer = tvx::afx::Window::from(window.m_hWnd)->widget();
    auto* own = qobject_cast<Part*>(peer);
    Part* found = own ? own : peer->findChild<Part*>();
    if (!found) {
        throw std::logic_error("the window has no such part");
    }
    return *found;
}

/// Has a widget handle an event past the place where all events are caught, as the toolkit's own widgets do among each
/// other.
void handle(QObject& widget, QEvent&& event) {
    widget.event(&event);
}

struct Signal {
    const char* name;
    const char* windowClass;
    DWORD style;
    std::function<void(const CWnd&)> emitIt; ///< without an event, as code of the toolkit does
};

class SignalTest : public testing::TestWithParam<Signal> {};

const Signal cases[] = {
    {"Button", "Button", BS_PUSHBUTTON, [](const CWnd& window) { part<QPushButton>(window).clicked(); }},
    {"ScrollBar", "ScrollBar", SBS_HORZ,
     [](const CWnd& window) { part<QScrollBar>(window).triggerAction(QAbstractSlider::SliderSingleStepAdd); }},
    {"ScrollBarReleased", "ScrollBar", SBS_HORZ, [](const CWnd& window) { part<QScrollBar>(window).sliderReleased(); }},
    {"Line", "Edit", 0, [](const CWnd& window) { part<QLineEdit>(window).insert(QStringLiteral("x")); }},
    {"Area", "Edit", ES_MULTILINE,
     [](const CWnd& window) { part<QPlainTextEdit>(window).insertPlainText(QStringLiteral("x")); }},
    {"Choice", "ComboBox", CBS_DROPDOWNLIST,
     [](const CWnd& window) {
         window.SendMessage(CB_ADDSTRING, 0, reinterpret_cast<LPARAM>("one"));
         part<QComboBox>(window).activated(0);
     }},
    {"ChoiceField", "ComboBox", CBS_DROPDOWN,
     [](const CWnd& window) { part<QLineEdit>(window).textEdited(QStringLiteral("x")); }},
    {"ChoiceOpened", "ComboBox", CBS_DROPDOWNLIST,
     [](const CWnd& window) {
         part<QComboBox>(window).showPopup();
         part<QComboBox>(window).hidePopup();
     }},
    {"ListKey", "ListBox", LBS_NOTIFY,
     [](const CWnd& window) {
         window.SendMessage(LB_ADDSTRING, 0, reinterpret_cast<LPARAM>("one"));
         handle(part<QAbstractScrollArea>(window), QKeyEvent(QEvent::KeyPress, Qt::Key_Down, Qt::NoModifier));
     }},
    {"OwnerDrawnButton", "Button", BS_OWNERDRAW,
     [](const CWnd& window) { handle(part<QPushButton>(window), QPaintEvent(QRect(0, 0, 10, 10))); }},
    {"OwnerDrawnStatic", "Static", SS_OWNERDRAW,
     [](const CWnd& window) { handle(part<QWidget>(window), QPaintEvent(QRect(0, 0, 10, 10))); }},
};

} // namespace

TEST_P(SignalTest, KeepsWhatAHandlerThrowsForThePlaceBelowTheToolkit) {
    using tvx::afx::ExceptionCarrier;
    FailingParent parent;
    CWnd control;
    ASSERT_TRUE(control.Create(GetParam().windowClass, "", WS_CHILD | WS_VISIBLE | GetParam().style,
                               CRect(10, 10, 150, 60), &parent, 100));
    parent.fails = true;
    EXPECT_NO_THROW(GetParam().emitIt(control)) << "nothing may unwind the toolkit's own frames";
    parent.fails = false;
    EXPECT_TRUE(ExceptionCarrier::isPending());
    EXPECT_THROW(ExceptionCarrier::rethrow(), std::runtime_error);
    EXPECT_FALSE(ExceptionCarrier::isPending());
}

INSTANTIATE_TEST_SUITE_P(Controls, SignalTest, testing::ValuesIn(cases),
                         [](const auto& test) { return test.param.name; });

TEST(WindowScrollBar, KeepsWhatAHandlerThrowsForThePlaceBelowTheToolkit) {
    FailingParent parent;
    class Pane : public CWnd {
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
            if (message == WM_HSCROLL) {
                throw std::runtime_error("failed");
            }
            return CWnd::WindowProc(message, wParam, lParam);
        }
    } scrolled;
    ASSERT_TRUE(scrolled.CreateEx(0, AfxRegisterWndClass(0), "", WS_CHILD | WS_VISIBLE | WS_HSCROLL, 0, 0, 100, 100,
                                  parent.m_hWnd, nullptr));
    QScrollBar* bar = nullptr;
    for (QScrollBar* candidate : tvx::afx::Window::from(scrolled.m_hWnd)->widget()->findChildren<QScrollBar*>()) {
        bar = candidate->orientation() == Qt::Horizontal ? candidate : bar;
    }
    ASSERT_TRUE(bar);
    EXPECT_NO_THROW(bar->triggerAction(QAbstractSlider::SliderPageStepAdd));
    EXPECT_THROW(tvx::afx::ExceptionCarrier::rethrow(), std::runtime_error);
}
