// Views that get windows of their own and come back: by the mouse, by menus and keys, by program.
#include "tests/ui/s/FloatTesting.h"

#include "afxdlgs.h"
#include "s/Profile.h"

#include <QTabBar>

#include <algorithm>

using namespace frametest;

namespace {

using Lines = std::vector<std::string>;

std::size_t floating() {
    return Gui_ExternFrame::GetAll().size();
}

TEST_F(FloatTest, AViewMovesWithAllThatItHolds) {
    PadFrame& frame = open();
    PadView& view = viewOf(frame);
    const HWND child = frame.m_hWnd;
    const HWND moved = view.m_hWnd;
    view.edit.SetWindowText("one\r\ntwo\r\nthree");
    view.edit.SetFocus();
    view.edit.SetSel(5, 8);
    const HICON icon = ::LoadIcon(nullptr, MAKEINTRESOURCE(32515));
    frame.SetIcon(icon, FALSE);
    const std::string title = titleOf(frame);
    journal().clear();

    PadWindow& window = floated(frame);
    EXPECT_EQ(journal(), (Lines{"load before", "load after", "set before", "set after"}));
    EXPECT_FALSE(::IsWindow(child));
    EXPECT_EQ(view.m_hWnd, moved);
    EXPECT_EQ(window.GetActiveView(), &view);
    EXPECT_EQ(titleOf(window).substr(0, title.size()), title);
    EXPECT_EQ(window.GetIcon(FALSE), icon);
    EXPECT_EQ(window.GetParent(), nullptr);
    EXPECT_EQ(window.GetStyle() & 0xCF8000, 0xCF8000U);
    EXPECT_EQ(CWnd::GetFocus(), &view.edit);
    int from = 0;
    int to = 0;
    view.edit.GetSel(from, to);
    EXPECT_EQ(from, 5);
    EXPECT_EQ(to, 8);
    EXPECT_EQ(window.tools().GetDockSide(), static_cast<UINT>(AFX_IDW_DOCKBAR_TOP));
    EXPECT_EQ(window.status().GetCount(), 4);
    window.SetStatusPaneText(1, "wide enough");
    UINT id = 0;
    UINT style = 0;
    int width = 0;
    window.status().GetPaneInfo(1, id, style, width);
    EXPECT_EQ(window.status().GetPaneText(1), "wide enough");
    EXPECT_GT(width, 30);

    journal().clear();
    const HWND outside = window.m_hWnd;
    window.SetRipResourceId(IDR_TESTBOARD); // of the window's own, so that it is seen to travel
    window.GetFloatHelp().UnripView();
    settle();
    PadFrame& docked = *active();
    EXPECT_EQ(journal(), (Lines{"child before", "child after"}));
    EXPECT_FALSE(::IsWindow(outside));
    EXPECT_EQ(docked.GetActiveView(), &view);
    EXPECT_EQ(docked.GetIcon(FALSE), icon);
    EXPECT_EQ(docked.GetRipResourceId(), static_cast<unsigned>(IDR_TESTBOARD));
    EXPECT_EQ(CWnd::GetFocus(), &view.edit);
    view.edit.GetSel(from, to);
    EXPECT_EQ(to, 8);
    POSITION at = view.GetDocument()->GetFirstViewPosition();
    EXPECT_EQ(view.GetDocument()->GetNextView(at), &view);
    EXPECT_EQ(at, nullptr) << "the template's own view has gone";
    EXPECT_EQ(floating(), 0U);
}

TEST_F(FloatTest, WhatCannotMoveStaysWhereItIs) {
    PadFrame& frame = open();
    Gui_FloatHelp& help = frame.GetFloatHelp();
    const auto refuses = [&](const char* what) {
        help.RipOutView();
        settle();
        EXPECT_EQ(floating(), 0U) << what;
        EXPECT_EQ(active(), &frame) << what;
        EXPECT_EQ(viewOf(frame).GetParentFrame(), &frame) << what;
    };
    frame.SetRipEnabled(false);
    refuses("disabled");
    main->GetFloatHelp().RipOutView();
    EXPECT_EQ(floating(), 0U) << "disabled in the child frame, asked of the main one";
    frame.SetRipEnabled(true);
    frame.SetRipResourceId(0xFFFFFFFF);
    EXPECT_FALSE(help.CanMove());
    refuses("no resources");
    frame.SetRipResourceId(IDR_TESTMAIN);
    frame.SetRipOutFrame(RUNTIME_CLASS(NoteFrame));
    refuses("a class of another kind");
    frame.SetRipOutFrame(nullptr);
    refuses("no class");
    frame.SetRipOutFrame(RUNTIME_CLASS(PadWindow));
    PadWindow::failsStatusBar = true;
    refuses("a window that fails");
    PadWindow::failsStatusBar = false;
    frame.SetRipResourceId(999);
    refuses("resources that are not there");
    frame.SetRipResourceId(IDR_TESTMAIN);

    // A splitter's view does not stand in the frame itself.
    CWnd splitter;
    splitter.Create(nullptr, nullptr, WS_CHILD | WS_VISIBLE, CRect(0, 0, 100, 100), &frame, 77);
    viewOf(frame).SetParent(&splitter);
    refuses("a splitter");
    viewOf(frame).SetParent(&frame);
    splitter.DestroyWindow();

    PadWindow& window = floated(frame);
    window.SetUnRipEnabled(false);
    window.GetFloatHelp().UnripView();
    EXPECT_EQ(floating(), 1U);
    window.SetUnRipEnabled(true);

    PadFrame& plain = open();
    plain.SetRipResourceId(IDR_TESTBOARD);
    EXPECT_EQ(floated(plain).tools().m_hWnd, nullptr) << "resources without a tool bar";
}

// A move that a host's code breaks off leaves the view in the one frame or in the other, whole, and no frame without
// one.
TEST_F(FloatTest, WhatAHostThrowsLosesNoView) {
    PadView& view = viewOf(open());
    const auto isWhole = [&](const std::string& where, bool floats) {
        settle();
        CFrameWnd* frame = view.GetParentFrame();
        EXPECT_TRUE(throwsIn.empty()) << where;
        EXPECT_EQ(floating(), floats ? 1U : 0U) << where;
        EXPECT_EQ(frame->IsKindOf(RUNTIME_CLASS(PadWindow)) != FALSE, floats) << where;
        EXPECT_TRUE(frame->IsWindowVisible()) << where;
        EXPECT_EQ(!active(), floats) << where;
        EXPECT_TRUE(frame->GetActiveView() == &view || !frame->GetActiveView()) << where;
        frame->SetActiveView(&view);
    };
    const auto move = [&](const std::string& where, bool floats) {
        throwsIn = where;
        Gui_FloatHelp& help = floating() ? Gui_ExternFrame::GetAll().front()->GetFloatHelp() : active()->GetFloatHelp();
        EXPECT_EQ(where.empty(), [&] {
            try {
                help.Move();
                return true;
            } catch (const std::runtime_error&) {
                return false;
            }
        }()) << where;
        isWhole(where, floats);
    };
    for (const char* before : {"load before", "load after", "set before"}) {
        move(before, false);
    }
    for (const char* during : {"deactivated", "activated", "set after"}) {
        move(during, true);
        move("child before", true);
        move("child after", false);
    }
}

TEST_F(FloatTest, TheButtonTakesAPressAndMovesOnRelease) {
    PadFrame& frame = open();
    const CRect place = OpenHelp(frame.GetFloatHelp()).place(true);
    CRect whole;
    frame.GetWindowRect(&whole);
    ASSERT_TRUE(whole.PtInRect(place.CenterPoint()));

    press(frame, place.CenterPoint());
    EXPECT_EQ(CWnd::GetCapture(), &frame);
    release(frame, whole.CenterPoint());
    EXPECT_EQ(CWnd::GetCapture(), nullptr);
    EXPECT_EQ(floating(), 0U) << "released elsewhere";

    press(frame, place.CenterPoint());
    ::SetCapture(main->m_hWnd); // as a box that comes up does
    ::ReleaseCapture();

    // The rules themselves, with nothing pressed before.
    EXPECT_EQ(frame.GetFloatHelp().OnNcLButtonUp(HTCAPTION, place.CenterPoint()), 0);
    EXPECT_EQ(frame.GetFloatHelp().OnNcLButtonDown(HTCAPTION, place.TopLeft() - CPoint(1, 0)), 0);

    press(frame, place.CenterPoint());
    release(frame, place.CenterPoint());
    ASSERT_EQ(floating(), 1U);
    auto& window = static_cast<PadWindow&>(*Gui_ExternFrame::GetAll().front());
    ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(window)));
    settle();
    const CRect back = OpenHelp(window.GetFloatHelp()).place(true);
    press(window, back.CenterPoint());
    EXPECT_EQ(CWnd::GetCapture(), &window);
    release(window, back.CenterPoint());
    EXPECT_EQ(floating(), 0U);
    EXPECT_NE(active(), nullptr);
}

TEST_F(FloatTest, TheMainFrameHasTheButtonOfAMaximisedChildFrame) {
    PadFrame& frame = open();
    frame.MDIMaximize();
    settle();
    const CRect place = OpenHelp(main->GetFloatHelp()).place(true);
    press(*main, place.CenterPoint());
    EXPECT_EQ(CWnd::GetCapture(), main);
    release(*main, place.CenterPoint());
    EXPECT_EQ(floating(), 1U);
    EXPECT_EQ(main->GetActiveView(), nullptr);
    settle();

    // With no child frame maximised there is no button, and nothing to press.
    open().MDIRestore();
    settle();
    press(*main, place.CenterPoint());
    release(*main, place.CenterPoint());
    EXPECT_EQ(floating(), 1U);
}

TEST_F(FloatTest, SystemMenusHaveTheCommand) {
    PadFrame& frame = open();
    CMenu* menu = frame.GetSystemMenu(FALSE);
    CString text;
    menu->GetMenuString(GUI_ID_FLOAT_WINDOW, text, MF_BYCOMMAND);
    EXPECT_EQ(text, "&Float Window");
    menu->EnableMenuItem(GUI_ID_FLOAT_WINDOW, MF_GRAYED);
    frame.SendMessage(WM_INITMENU, reinterpret_cast<WPARAM>(menu->m_hMenu));
    EXPECT_EQ(menu->GetMenuState(GUI_ID_FLOAT_WINDOW, MF_BYCOMMAND) & MF_GRAYED, 0U);
    frame.SendMessage(WM_SYSCOMMAND, GUI_ID_FLOAT_WINDOW);
    settle();
    ASSERT_EQ(floating(), 1U);
    Gui_ExternFrame& window = *Gui_ExternFrame::GetAll().front();
    window.GetSystemMenu(FALSE)->GetMenuString(GUI_ID_DOCK_WINDOW, text, MF_BYCOMMAND);
    EXPECT_EQ(text, "&Dock Window");
    window.SendMessage(WM_SYSCOMMAND, GUI_ID_DOCK_WINDOW);
    settle();
    EXPECT_EQ(floating(), 0U);
}

TEST_F(FloatTest, CommandsGoToTheFloatingViewWhileItIsActive) {
    PadFrame& other = open();
    PadWindow& window = floated(open());
    EXPECT_EQ(AfxGetRoutingFrame(), &window);
    journal().clear();
    key(Qt::Key_D, Qt::ControlModifier); // an accelerator of both frames
    EXPECT_EQ(journal(), Lines{"draw"});
    main->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_TRUE(viewOf(window).grid);
    EXPECT_FALSE(viewOf(other).grid);
    journal().clear();
    window.SendMessage(WM_COMMAND, ID_TEST_ORPHAN);
    EXPECT_EQ(journal(), Lines{"main"}) << "what only the main frame knows";

    // A dialog of the frame's leaves it the one to ask.
    CWnd dialog;
    dialog.CreateEx(0, AfxRegisterWndClass(0), "Dialog", WS_POPUP | WS_CAPTION, 0, 0, 100, 100, window.m_hWnd, nullptr);
    window.SendMessage(WM_ACTIVATE, WA_INACTIVE, reinterpret_cast<LPARAM>(dialog.m_hWnd));
    EXPECT_EQ(AfxGetRoutingFrame(), &window);
    dialog.DestroyWindow();
    window.SendMessage(WM_ACTIVATE, WA_INACTIVE, reinterpret_cast<LPARAM>(main->m_hWnd));
    EXPECT_EQ(AfxGetRoutingFrame(), nullptr);
    window.SendMessage(WM_ACTIVATE, WA_ACTIVE);
    main->SendMessage(WM_ACTIVATE, WA_ACTIVE);
    EXPECT_EQ(AfxGetRoutingFrame(), nullptr) << "the dialog was followed by the main frame";

    window.SetForegroundWindow();
    settle();
    HELPINFO help{};
    help.cbSize = sizeof help;
    help.iContextType = HELPINFO_WINDOW;
    EXPECT_EQ(window.SendMessage(WM_HELP, 0, reinterpret_cast<LPARAM>(&help)), TRUE);
}

TEST_F(FloatTest, DialogsAndOpenDocumentsComeUpWhereTheUserWorks) {
    open();
    PadWindow& window = floated(open());
    later([&] {
        QWidget* box = QApplication::activeModalWidget();
        ASSERT_NE(box, nullptr);
        EXPECT_EQ(box->parentWidget(), widgetOf(window));
        box->close();
    });
    CColorDialog().DoModal();
    EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(window)));

    viewOf(window).GetDocument()->SetPathName("/tmp/floating.brd", FALSE);
    AfxGetApp()->OnFileNew();
    ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(*main)));
    AfxGetApp()->OpenDocumentFile("/tmp/floating.brd");
    EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(window)));
}

TEST_F(FloatTest, TheWindowMenuListsAllViews) {
    open();
    PadWindow& window = floated(open());
    CMenu popup;
    popup.CreatePopupMenu();
    main->ListWindows(popup);
    ASSERT_EQ(popup.GetMenuItemCount(), 3U) << "a line, the docked view, the floating one";
    EXPECT_NE(popup.GetMenuState(2, MF_BYPOSITION) & MF_CHECKED, 0U) << "the one that is active";
    main->SetForegroundWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(*main)));
    window.SendMessage(WM_COMMAND, popup.GetMenuItemID(2));
    EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(window)));
    main->ListWindows(popup);
    EXPECT_EQ(popup.GetMenuItemCount(), 3U) << "listed anew, not twice";

    floated(*active());
    EXPECT_EQ(floating(), 2U);
    main->SendMessage(WM_COMMAND, GUI_ID_DOCK_ALL);
    settle();
    EXPECT_EQ(floating(), 0U);
}

TEST_F(FloatTest, TabsNameTheChildFrames) {
    auto* tabs = widgetOf(*main)->findChild<QTabBar*>();
    ASSERT_NE(tabs, nullptr);
    EXPECT_FALSE(tabs->isVisible());
    PadFrame& first = open();
    const std::string other = titleOf(open());
    first.SetWindowText("R&D");
    settle();
    ASSERT_EQ(tabs->count(), 2);
    EXPECT_EQ(tabs->tabText(0), "R&&D");
    EXPECT_EQ(tabs->currentIndex(), 1);
    EXPECT_TRUE(tabs->isVisible());
    const auto icon = [&] { return tabs->tabIcon(0).pixmap(16).toImage(); };
    const QImage own = icon();
    main->SetSheetIcon(&first, ::LoadIcon(nullptr, MAKEINTRESOURCE(32515)));
    EXPECT_NE(icon(), own);
    main->SetSheetIcon(&first, nullptr);
    EXPECT_EQ(icon(), own);
    QTest::mouseClick(tabs, Qt::LeftButton, Qt::NoModifier, tabs->tabRect(0).center());
    settle();
    EXPECT_EQ(active(), &first);
    floated(first);
    ASSERT_EQ(tabs->count(), 1);
    EXPECT_EQ(tabs->tabText(0).toStdString(), other);
}

TEST_F(FloatTest, ClosingAsksTheDocumentAndLeavesNothingBehind) {
    PadWindow& window = floated(open());
    viewOf(window).GetDocument()->SetModifiedFlag();
    {
        BoxAnswer cancel("Cancel");
        window.SendMessage(WM_CLOSE);
        main->SendMessage(WM_CLOSE);
        EXPECT_EQ(cancel.texts.size(), 2U);
        EXPECT_EQ(floating(), 1U);
    }
    Gui_ExternFrame::SetCloseAction(Gui_ExternFrame::CloseAction::DockBack);
    window.SendMessage(WM_CLOSE);
    settle();
    EXPECT_EQ(floating(), 0U);
    Gui_ExternFrame::SetCloseAction(Gui_ExternFrame::CloseAction::Close);

    PadWindow& again = floated(*active());
    viewOf(again).GetDocument()->SetModifiedFlag(FALSE);
    const HWND self = again.m_hWnd;
    main->SendMessage(WM_CLOSE);
    settle();
    EXPECT_FALSE(::IsWindow(self));
    EXPECT_EQ(AfxGetMainWnd(), nullptr);
}

TEST_F(FloatTest, AMoveAskedForDuringActivationWaits) {
    PadFrame& first = open();
    open();
    PadView::whenActivated = [&] {
        first.GetFloatHelp().RipOutView();
        EXPECT_EQ(floating(), 0U);
    };
    first.MDIActivate();
    settle();
    EXPECT_EQ(floating(), 1U);
    PadView::whenActivated = [&] {
        Gui_ExternFrame::GetAll().front()->GetFloatHelp().UnripView();
        EXPECT_EQ(floating(), 1U);
    };
    main->SetForegroundWindow();
    settle();
    EXPECT_EQ(floating(), 0U);
}

TEST_F(FloatTest, WindowsComeUpWhereTheLastOneStood) {
    PadWindow& first = floated(open());
    first.MoveWindow(60, 70, 444, 333);
    settle();
    first.GetFloatHelp().UnripView();
    PadWindow& second = floated(*active());
    CRect place;
    second.GetWindowRect(&place);
    EXPECT_EQ(place, CRect(60, 70, 504, 403));
    PadWindow& third = floated(open());
    CRect beside;
    third.GetWindowRect(&beside);
    EXPECT_EQ(beside.Size(), place.Size());
    EXPECT_NE(beside.TopLeft(), place.TopLeft());
    main->DestroyWindow();
    CString entry;
    entry.Format("FloatPlacement%d", IDR_TESTMAIN);
    WINDOWPLACEMENT kept{};
    ASSERT_TRUE(Gui_Profile::ReadWindowPlacement(kept, entry, nullptr)) << "over restarts, too";
    EXPECT_EQ(CRect(kept.rcNormalPosition).Size(), place.Size());
}

TEST_F(FloatTest, ViewsMoveAndDocumentsCloseUnderADialogAndFromTheirWindow) {
    PadFrame& frame = open();
    later([&] {
        frame.GetFloatHelp().RipOutView();
        settle();
        EXPECT_EQ(floating(), 1U);
        Gui_ExternFrame::GetAll().front()->GetFloatHelp().UnripView();
        settle();
        EXPECT_EQ(floating(), 0U);
        active()->GetFloatHelp().RipOutView();
        auto* box = QApplication::activeModalWidget();
        ASSERT_NE(box, nullptr);
        box->close();
    });
    AfxMessageBox("A question");
    ASSERT_EQ(floating(), 1U);
    Gui_ExternFrame& window = *Gui_ExternFrame::GetAll().front();
    const HWND self = window.m_hWnd;
    window.SendMessage(WM_COMMAND, ID_FILE_CLOSE);
    settle();
    EXPECT_FALSE(::IsWindow(self));
    EXPECT_EQ(main->MDIGetActive(), nullptr);
}

// What a hasty user and a program in a loop do.
TEST_F(FloatTest, NothingDanglesAfterManyMoves) {
    const int count = 1000;
    PadFrame* frame = &open();
    frame->MDIMaximize();
    PadView& view = viewOf(*frame);
    for (int i = 0; i < count; ++i) {
        if (i % 50 == 0) {
            settle();                                                            // the others come as fast as keys do
            QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete); // as the loop does
        }
        frame->GetFloatHelp().RipOutView();
        ASSERT_EQ(floating(), 1U);
        Gui_ExternFrame::GetAll().front()->GetFloatHelp().UnripView();
        frame = active();
        ASSERT_NE(frame, nullptr);
        ASSERT_EQ(frame->GetActiveView(), &view);
    }
    settle();
    EXPECT_EQ(floating(), 0U);
}

TEST_F(FloatTest, FramesMayEndInAnyOrder) {
    for (int order = 0; order < 12; ++order) {
        std::vector<HWND> frames;
        for (int i = 0; i < 3; ++i) {
            frames.push_back(open().m_hWnd);
        }
        // One floats half of the times, one is maximised with the button in the menu bar, which is replaced meanwhile.
        if (order < 6) {
            frames[0] = floated(static_cast<PadFrame&>(*CWnd::FromHandle(frames[0]))).m_hWnd;
        }
        active()->MDIMaximize();
        settle();
        main->SetMenu(nullptr);
        settle();
        active()->OnUpdateFrameMenu(nullptr);
        std::array<int, 3> turn{0, 1, 2};
        for (int i = 0; i < order % 6; ++i) {
            std::next_permutation(turn.begin(), turn.end());
        }
        QApplication::setStyle(QStringLiteral("Fusion")); // a change of style while all of them stand
        for (const int each : turn) {
            ::SendMessageA(frames[static_cast<std::size_t>(each)], WM_CLOSE, 0, 0);
            settle();
            EXPECT_FALSE(::IsWindow(frames[static_cast<std::size_t>(each)]));
        }
        ASSERT_EQ(main->MDIGetActive(), nullptr);
        ASSERT_EQ(floating(), 0U);
    }
}

} // namespace
