#include "afxwin.h"
#include "platform/afx/core/LastReport.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QApplication>
#include <QClipboard>
#include <QDropEvent>
#include <QLabel>
#include <QLayout>
#include <QMessageBox>
#include <QMimeData>
#include <QTest>
#include <QTimer>
#include <QUrl>

#include <functional>
#include <gtest/gtest.h>
#include <map>
#include <stdexcept>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace {

std::vector<std::string> journal;

/// A window that writes down what reaches it and does what a test wants done with a message.
class Probe : public CWnd {
public:
    std::string name;
    std::map<UINT, std::function<void()>> on;
    UINT consumed = 0; ///< A message that pre-translation takes.
    bool passes = true;

    BOOL create(const char* called, CWnd* parent = nullptr) {
        name = called;
        const DWORD style = parent ? WS_CHILD | WS_VISIBLE : WS_OVERLAPPEDWINDOW | WS_VISIBLE;
        return CreateEx(0, AfxRegisterWndClass(CS_DBLCLKS), called, style, 10, 10, 200, 120,
                        parent ? parent->m_hWnd : nullptr, nullptr);
    }
    QWidget* widget() const {
        return tvx::afx::peerOf(m_hWnd);
    }
    void act(UINT message) {
        if (const auto found = on.find(message); found != on.end()) {
            found->second();
        }
    }
    BOOL PreTranslateMessage(MSG* message) override {
        if (message->message == WM_KEYDOWN) {
            journal.push_back(name + " pre-translates");
        }
        return message->message == consumed ? TRUE : CWnd::PreTranslateMessage(message);
    }

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_KEYDOWN) {
            journal.push_back(name + " procedure");
        }
        if (message >= WM_APP && message < WM_APP + 100) {
            journal.push_back(name + " " + std::to_string(message - WM_APP));
        }
        act(message);
        return CWnd::WindowProc(message, wParam, lParam);
    }
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags) {
        journal.push_back(name + " handler");
        if (passes) {
            CWnd::OnKeyDown(key, repeat, flags);
        }
    }
    afx_msg void OnChar(UINT character, UINT, UINT) {
        journal.push_back(name + " char " + std::to_string(character));
    }
    afx_msg LRESULT OnDouble(WPARAM wParam, LPARAM) {
        return static_cast<LRESULT>(wParam * 2);
    }
    DECLARE_MESSAGE_MAP()
};

constexpr UINT doubleIt = WM_APP + 1000;

// clang-format off
BEGIN_MESSAGE_MAP(Probe, CWnd)
    ON_WM_KEYDOWN()
    ON_WM_CHAR()
    ON_MESSAGE(doubleIt, &Probe::OnDouble)
END_MESSAGE_MAP()
// clang-format on

class Core : public testing::Test {
protected:
    Core() {
        journal.clear();
        frame.create("frame");
        view.create("view", &frame);
        AfxGetApp()->m_pMainWnd = &frame;
        EXPECT_TRUE(QTest::qWaitForWindowExposed(frame.widget()));
        view.SetFocus();
    }
    ~Core() override {
        AfxGetApp()->m_pMainWnd = nullptr;
        frame.DestroyWindow();
    }
    /// Runs a loop while something happens in it, and answers the text of the exception that comes out.
    std::string escaped(const std::function<void()>& act) {
        tvx::afx::ModalLoop loop;
        QTimer::singleShot(0, [&] { act(); });
        try {
            loop.run();
        } catch (const std::runtime_error& error) {
            return error.what();
        }
        return {};
    }
    static void fail() {
        throw std::runtime_error("escaped");
    }

    Probe frame;
    Probe view;
};

TEST_F(Core, AKeyGoesThroughPreTranslationProcedureAndHandler) {
    QTest::keyClick(view.widget(), Qt::Key_A);
    EXPECT_EQ(journal, (std::vector<std::string>{"view pre-translates", "frame pre-translates", "view procedure",
                                                 "view handler", "view char 97"}));
}

TEST_F(Core, AKeyThatPreTranslationTakesReachesNobody) {
    frame.consumed = WM_KEYDOWN;
    QTest::keyClick(view.widget(), Qt::Key_F5);
    EXPECT_EQ(journal, (std::vector<std::string>{"view pre-translates", "frame pre-translates"}));
}

TEST_F(Core, AnEditGetsItsCharactersByDefault) {
    CWnd edit;
    ASSERT_TRUE(edit.Create("Edit", "", WS_VISIBLE, CRect(0, 0, 80, 20), &frame, 5));
    edit.SetFocus();
    QTest::keyClicks(QApplication::focusWidget(), "ab");
    CString text;
    edit.GetWindowText(text);
    EXPECT_STREQ(text, "ab");
    edit.DestroyWindow();
}

TEST_F(Core, PostedMessagesComeInOrderAndSentOnesAtOnce) {
    view.PostMessage(WM_APP + 1);
    view.PostMessage(WM_APP + 2);
    EXPECT_EQ(view.SendMessage(doubleIt, 21), 42);
    view.SendMessage(WM_APP + 3);
    EXPECT_EQ(journal, (std::vector<std::string>{"view 3"}));
    view.on[WM_APP + 1] = [this] { view.PostMessage(WM_APP + 4); };
    tvx::afx::ModalLoop loop;
    view.on[WM_APP + 4] = [&] { loop.end(7); };
    EXPECT_EQ(loop.run(), 7);
    EXPECT_EQ(journal, (std::vector<std::string>{"view 3", "view 1", "view 2", "view 4"}));
}

TEST_F(Core, MessagesPostedBeforeANestedLoopAreHandledInIt) {
    tvx::afx::ModalLoop outer;
    view.on[WM_APP + 1] = [] {
        tvx::afx::ModalLoop inner;
        QTimer::singleShot(0, [&] { inner.end(0); });
        inner.run();
        journal.push_back("inner ended");
    };
    view.PostMessage(WM_APP + 1);
    view.PostMessage(WM_APP + 2);
    view.on[WM_APP + 3] = [&] { outer.end(0); };
    view.PostMessage(WM_APP + 3);
    outer.run();
    EXPECT_EQ(journal, (std::vector<std::string>{"view 1", "view 2", "view 3", "inner ended"}));
}

TEST_F(Core, OtherThreadsSendAndPost) {
    tvx::afx::ModalLoop loop;
    LRESULT answer = 0;
    std::thread worker([&] {
        answer = ::SendMessageA(view.m_hWnd, doubleIt, 4, 0);
        ::PostMessageA(view.m_hWnd, WM_APP + 9, 0, 0);
    });
    view.on[WM_APP + 9] = [&] { loop.end(0); };
    loop.run();
    worker.join();
    EXPECT_EQ(answer, 8);
}

TEST_F(Core, MessagesForAWindowThatHasEndedAreDropped) {
    const HWND handle = view.m_hWnd;
    view.PostMessage(WM_APP + 1);
    view.DestroyWindow();
    EXPECT_FALSE(::PostMessageA(handle, WM_APP + 2, 0, 0));
    EXPECT_EQ(::SendMessageA(handle, WM_APP + 3, 0, 0), 0);
    MSG msg;
    EXPECT_FALSE(::PeekMessage(&msg, handle, 0, 0, PM_NOREMOVE));
    EXPECT_TRUE(journal.empty());
}

TEST_F(Core, PeekedMessagesAreDispatchedByTheirFetcher) {
    MSG msg;
    view.PostMessage(WM_APP + 5, 1, 2);
    ASSERT_TRUE(::PeekMessage(&msg, nullptr, WM_APP, WM_APP + 99, PM_NOREMOVE));
    ASSERT_TRUE(::PeekMessage(&msg, nullptr, WM_APP, WM_APP + 99, PM_REMOVE));
    EXPECT_EQ(msg.hwnd, view.m_hWnd);
    EXPECT_EQ(msg.wParam, 1U);
    EXPECT_FALSE(::PeekMessage(&msg, nullptr, WM_APP, WM_APP + 99, PM_REMOVE));
    msg.message = WM_APP + 5;
    ::DispatchMessage(&msg);
    EXPECT_EQ(journal, (std::vector<std::string>{"view 5"}));
}

TEST_F(Core, AHostsOwnLoopFetchesUntilItIsToQuit) {
    const DWORD start = GetTickCount();
    const QPoint clicked(20, 30);
    QTimer::singleShot(0, [&] {
        QTest::mouseClick(view.widget(), Qt::LeftButton, Qt::NoModifier, clicked);
        QTest::keyClick(view.widget(), Qt::Key_F7);
    });
    view.on[WM_LBUTTONDOWN] = [&] {
        const QPoint screen = view.widget()->mapToGlobal(clicked);
        EXPECT_EQ(GetMessagePos(), static_cast<DWORD>(MAKELONG(screen.x(), screen.y())));
        EXPECT_EQ(AfxGetCurrentMessage()->hwnd, view.m_hWnd);
        const auto age = static_cast<DWORD>(GetMessageTime()) - start;
        EXPECT_LE(age, GetTickCount() - start);
    };
    view.on[WM_KEYUP] = [] { ::PostQuitMessage(5); };
    MSG msg;
    bool clickCame = false;
    while (::GetMessage(&msg, nullptr, 0, 0)) {
        const bool key = msg.message == WM_KEYDOWN || msg.message == WM_KEYUP;
        EXPECT_EQ(::TranslateMessage(&msg) != FALSE, key) << msg.message;
        clickCame = clickCame || msg.message == WM_LBUTTONDOWN;
        ::DispatchMessage(&msg);
    }
    EXPECT_TRUE(clickCame);
    EXPECT_EQ(msg.message, UINT{WM_QUIT});
    EXPECT_EQ(msg.wParam, 5U);
    EXPECT_EQ(AfxGetCurrentMessage(), nullptr);
    EXPECT_EQ(tvx::afx::takeQuit(), 5);
}

TEST_F(Core, TheThreadPumpsMessagesAndTakesItsOwn) {
    CWinThread* thread = AfxGetThread();
    MSG msg;
    EXPECT_TRUE(thread->PostThreadMessage(WM_APP + 6, 1, 2));
    ASSERT_TRUE(::PeekMessage(&msg, nullptr, WM_APP, WM_APP + 99, PM_REMOVE));
    EXPECT_EQ(msg.hwnd, nullptr);
    EXPECT_EQ(msg.lParam, 2);
    view.PostMessage(WM_APP + 5);
    QTimer::singleShot(0, [&] { QTest::keyClick(view.widget(), Qt::Key_F7); });
    EXPECT_TRUE(thread->PumpMessage());
    EXPECT_EQ(journal, (std::vector<std::string>{"view 5"}));
    EXPECT_TRUE(thread->PumpMessage()) << "waits for input";
    EXPECT_EQ(journal.back(), "view handler");
    ::PostQuitMessage(0);
    EXPECT_FALSE(thread->PumpMessage());
    tvx::afx::takeQuit();
}

TEST_F(Core, DroppedFilesAreNamedByTheirHandle) {
    std::vector<std::string> names;
    view.on[WM_DROPFILES] = [&] {
        const auto drop = reinterpret_cast<HDROP>(AfxGetCurrentMessage()->wParam);
        char name[16];
        for (UINT i = 0; i < DragQueryFile(drop, 0xFFFFFFFF, nullptr, 0); ++i) {
            names.emplace_back(name, DragQueryFile(drop, i, name, sizeof(name)));
        }
        EXPECT_EQ(DragQueryFile(drop, 0, name, 4), 3U) << "a short buffer gets the beginning";
        DragFinish(drop);
        EXPECT_EQ(DragQueryFile(drop, 0xFFFFFFFF, nullptr, 0), 0U);
    };
    view.DragAcceptFiles();
    QMimeData data;
    data.setUrls({QUrl::fromLocalFile("/a.brd"), QUrl("http://host/b.brd"), QUrl::fromLocalFile("/c.brd")});
    QDropEvent event(QPointF(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QCoreApplication::sendEvent(view.widget(), &event);
    EXPECT_TRUE(AfxGetThread()->PumpMessage()) << "told once the other program has its answer";
    ASSERT_EQ(names.size(), 2U) << "what is no file is left out";
    EXPECT_NE(names[1].find("c.brd"), std::string::npos) << names[1];
}

TEST_F(Core, CapturedMouseComesToTheCapturingWindow) {
    CPoint seen(-1, -1);
    view.on[WM_MOUSEMOVE] = [&] {
        const LPARAM where = CWnd::GetCurrentMessage()->lParam;
        seen = CPoint(GET_X_LPARAM(where), GET_Y_LPARAM(where));
    };
    view.SetCapture();
    EXPECT_EQ(CWnd::GetCapture(), &view);
    QTest::mouseMove(frame.widget(), QPoint(3, 4));
    const QPoint expected = view.widget()->mapFromGlobal(frame.widget()->mapToGlobal(QPoint(3, 4)));
    EXPECT_EQ(seen, CPoint(expected.x(), expected.y()));
    bool told = false;
    view.on[WM_CAPTURECHANGED] = [&] { told = true; };
    ::ReleaseCapture();
    EXPECT_TRUE(told);
    EXPECT_EQ(::GetCapture(), nullptr);
}

TEST_F(Core, ExceptionsComeOutOfTheLoopWhateverHandlerTheyEscape) {
    const std::map<std::string, std::pair<UINT, std::function<void()>>> ways{
        {"posted", {WM_APP + 1, [this] { view.PostMessage(WM_APP + 1); }}},
        {"key", {WM_KEYDOWN, [this] { QTest::keyClick(view.widget(), Qt::Key_F7); }}},
        {"mouse", {WM_LBUTTONDOWN, [this] { QTest::mouseClick(view.widget(), Qt::LeftButton); }}},
        {"paint", {WM_PAINT, [this] { view.Invalidate(); }}},
        {"timer", {WM_TIMER, [this] { view.SetTimer(1, 1); }}},
        {"size", {WM_SIZE, [this] { view.MoveWindow(0, 0, 50, 50); }}},
    };
    for (const auto& [name, way] : ways) {
        SCOPED_TRACE(name);
        view.on = {{way.first, &Core::fail}};
        EXPECT_EQ(escaped(way.second), "escaped");
        view.on.clear();
        view.KillTimer(1);
    }
}

TEST_F(Core, AnExceptionCrossesNestedLoopsAndKeepsLaterMessages) {
    bool unwound = false;
    view.on[WM_APP + 1] = [&] {
        struct Guard {
            bool& flag;
            ~Guard() {
                flag = true;
            }
        } guard{unwound};
        view.PostMessage(WM_APP + 2);
        view.PostMessage(WM_APP + 3);
        tvx::afx::ModalLoop inner;
        inner.run();
        journal.push_back("behind the loop");
    };
    view.on[WM_APP + 2] = &Core::fail;
    EXPECT_EQ(escaped([this] { view.PostMessage(WM_APP + 1); }), "escaped");
    EXPECT_TRUE(unwound);
    EXPECT_EQ(journal, (std::vector<std::string>{"view 1", "view 2"}));
    tvx::afx::ModalLoop again;
    view.on[WM_APP + 3] = [&] { again.end(0); };
    again.run();
    EXPECT_EQ(journal.back(), "view 3");
}

TEST_F(Core, AHandlerMayCatchWhatACallThrows) {
    view.on[WM_SIZE] = &Core::fail;
    bool caught = false;
    view.on[WM_APP + 1] = [&] {
        try {
            view.MoveWindow(0, 0, 70, 30);
        } catch (const std::runtime_error&) {
            caught = true;
        }
        view.on[WM_SIZE] = [] {};
    };
    tvx::afx::ModalLoop loop;
    view.on[WM_APP + 2] = [&] { loop.end(5); };
    view.PostMessage(WM_APP + 1);
    view.PostMessage(WM_APP + 2);
    EXPECT_EQ(loop.run(), 5);
    EXPECT_TRUE(caught);
}

TEST_F(Core, HandlersKnowThatTheyRunDuringAnActivation) {
    bool isSeen = false;
    const auto look = [&] { isSeen = AfxIsActivating(); };
    view.on[WM_APP] = look;
    frame.on[WM_COMMAND] = look;
    frame.SendMessage(WM_COMMAND, 1);
    EXPECT_FALSE(isSeen);
    for (const UINT message :
         {WM_ACTIVATE, WM_NCACTIVATE, WM_MDIACTIVATE, WM_MOUSEACTIVATE, WM_SETFOCUS, WM_KILLFOCUS}) {
        isSeen = false;
        frame.on = {{message, [this] {
                         view.SendMessage(WM_APP);
                         fail();
                     }}};
        EXPECT_THROW(frame.SendMessage(message), std::runtime_error);
        EXPECT_TRUE(isSeen) << message << ": in a message sent from the handler";
        EXPECT_FALSE(AfxIsActivating()) << message;
    }
    frame.on.clear();
}

TEST_F(Core, QuittingEndsEveryLoop) {
    tvx::afx::ModalLoop outer;
    view.on[WM_APP + 1] = [] {
        tvx::afx::ModalLoop inner;
        ::PostQuitMessage(3);
        EXPECT_EQ(inner.run(), -1);
    };
    view.PostMessage(WM_APP + 1);
    EXPECT_EQ(outer.run(), -1);
    EXPECT_TRUE(tvx::afx::isQuitting());
    EXPECT_EQ(tvx::afx::takeQuit(), 3);
}

TEST_F(Core, DestructionTellsParentsFirstAndEndsChildrenFirst) {
    std::vector<std::string> order;
    for (Probe* window : {&frame, &view}) {
        window->on[WM_DESTROY] = [&order, window] { order.push_back(window->name + " destroy"); };
        window->on[WM_NCDESTROY] = [&order, window] { order.push_back(window->name + " gone"); };
    }
    AfxGetApp()->m_pMainWnd = nullptr;
    frame.DestroyWindow();
    EXPECT_EQ(order, (std::vector<std::string>{"frame destroy", "view destroy", "view gone", "frame gone"}));
    EXPECT_EQ(view.m_hWnd, nullptr);
}

TEST_F(Core, OwnedWindowsMayEndEachOtherWithTheirOwner) {
    Probe first, second;
    for (Probe* popup : {&first, &second}) {
        ASSERT_TRUE(popup->CreateEx(0, AfxRegisterWndClass(0), "popup", WS_POPUP, 0, 0, 50, 50, frame.m_hWnd, nullptr));
    }
    first.on[WM_DESTROY] = [&] { second.DestroyWindow(); };
    second.on[WM_DESTROY] = [&] { frame.DestroyWindow(); };
    AfxGetApp()->m_pMainWnd = nullptr;
    frame.DestroyWindow();
    for (const Probe* window : {&first, &second, &frame, &view}) {
        EXPECT_EQ(window->m_hWnd, nullptr) << window->name;
    }
}

TEST_F(Core, RegisteredMessagesAreOneNumberPerText) {
    const UINT number = ::RegisterWindowMessage("board.changed");
    EXPECT_GE(number, 0xC000U);
    EXPECT_EQ(::RegisterWindowMessage("BOARD.CHANGED"), number);
    EXPECT_NE(::RegisterWindowMessage("board.closed"), number);
    EXPECT_EQ(::RegisterWindowMessage(""), 0U);
}

TEST_F(Core, FrameworkExceptionsAreReportedInAMessageBox) {
    QString shown;
    QTimer::singleShot(0, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        shown = box->text();
        QTest::keyClick(box, Qt::Key_Escape);
    });
    CFileException error(CFileException::fileNotFound, 2, "plan.brd");
    error.ReportError(MB_ICONSTOP);
    EXPECT_TRUE(shown.contains("plan.brd")) << shown.toStdString();
}

TEST_F(Core, MessageBoxesBelongToWindowsThatAreSeen) {
    QString shown;
    const QWidget* owner = nullptr;
    int width = 0;
    const auto ask = [&](const char* text, const char* caption) {
        QTimer::singleShot(0, [&] {
            auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            shown = box->text();
            owner = box->parentWidget();
            width = box->width();
            QTest::keyClick(box, Qt::Key_Escape);
        });
        ::MessageBoxA(view.m_hWnd, text, caption, MB_OK);
    };
    ask("\nFirst line.\r\nLast line.\r\n\n", "Short");
    EXPECT_EQ(shown, "\nFirst line.\r\nLast line.") << "an empty line at the end would only take room";
    EXPECT_EQ(owner, frame.widget());
    frame.ShowWindow(SW_HIDE);
    ask("", "A caption that is much longer than the text of the box");
    EXPECT_EQ(owner, nullptr);
    EXPECT_GT(width,
              QFontMetrics(QApplication::font()).horizontalAdvance("A caption that is much longer than the text"));
}

TEST_F(Core, MessageBoxesOfWindowsHaveTheCaptionOfTheApplications) {
    const LPCSTR name = std::exchange(AfxGetApp()->m_pszAppName, "A name for display");
    for (const bool isOfWindow : {true, false}) {
        QString caption;
        QTimer::singleShot(0, [&] {
            QWidget* box = QApplication::activeModalWidget();
            ASSERT_NE(box, nullptr);
            caption = box->windowTitle();
            QTest::keyClick(box, Qt::Key_Escape);
        });
        isOfWindow ? view.MessageBox("text") : AfxMessageBox("text");
        EXPECT_EQ(caption, "A name for display");
    }
    AfxGetApp()->m_pszAppName = name;
}

TEST_F(Core, MessageBoxesPlaceTheirTextByTheIcon) {
    const auto ask = [&](UINT type, const std::function<void(QMessageBox&, const QLabel&)>& look) {
        QTimer::singleShot(0, [&] {
            auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            look(*box, *box->findChild<QLabel*>("qt_msgbox_label"));
            QTest::keyClick(box, Qt::Key_C, Qt::ControlModifier);
            QTest::keyClick(box, Qt::Key_Escape);
        });
        ::MessageBoxA(view.m_hWnd, "One line.", "A caption", type);
        EXPECT_EQ(QApplication::clipboard()->text(), "One line.");
        QApplication::clipboard()->clear();
    };
    ask(MB_ICONERROR, [](const QMessageBox& box, const QLabel& label) {
        const auto* icon = box.findChild<QLabel*>("qt_msgboxex_icon_label");
        const int line = label.y() + label.contentsMargins().top() + label.fontMetrics().height() / 2;
        EXPECT_NEAR(line, icon->y() + box.iconPixmap().deviceIndependentSize().height() / 2, 2);
    });
    ask(MB_OK, [](const QMessageBox& box, const QLabel& label) {
        EXPECT_EQ(label.x() + label.indent(), box.layout()->contentsMargins().left()) << "no room for an icon";
    });
}

TEST_F(Core, LastReportsOutliveHandlersThatFailAgain) {
    view.on[WM_APP + 1] = [] { throw std::runtime_error("again"); };
    {
        const CLastReport report;
        tvx::afx::ModalLoop loop;
        view.on[WM_APP + 2] = [&] {
            loop.end(7);
            AfxThrowMemoryException();
        };
        view.PostMessage(WM_APP + 1);
        view.PostMessage(WM_APP + 2);
        EXPECT_EQ(loop.run(), 7);
    }
    tvx::afx::ModalLoop loop;
    view.PostMessage(WM_APP + 1);
    EXPECT_THROW((void)loop.run(), std::runtime_error);
}

} // namespace
