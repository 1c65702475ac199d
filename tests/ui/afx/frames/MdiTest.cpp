#include "platform/afx/core/detail/MenuWidgets.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QProxyStyle>

#include <malloc.h>
#include <set>

using namespace frametest;

namespace {

class Mdi : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        frame = &openBoards();
    }
    CMDIChildWnd* open() {
        CDocument* document = boards().OpenDocumentFile(nullptr);
        POSITION at = document->GetFirstViewPosition();
        settle();
        return static_cast<CMDIChildWnd*>(document->GetNextView(at)->GetParentFrame());
    }
    QMdiArea* area() const {
        return widgetOf(*frame)->findChild<QMdiArea*>();
    }
    QStringList barTexts() const {
        QStringList texts;
        for (const QAction* action : qobject_cast<QMenuBar*>(widgetOf(*frame)->menuWidget())->actions()) {
            texts.append(QString(action->text()).remove('&'));
        }
        return texts;
    }
    BoardsFrame* frame = nullptr;
};

} // namespace

TEST_F(Mdi, NewChildrenBecomeActive) {
    EXPECT_EQ(frame->MDIGetActive(), nullptr);
    EXPECT_EQ(titleOf(*frame), "Frame Test");
    CMDIChildWnd* first = open();
    EXPECT_EQ(frame->MDIGetActive(), first);
    EXPECT_EQ(titleOf(*first), "Board1");
    CMDIChildWnd* second = open();
    EXPECT_EQ(frame->MDIGetActive(), second);
    EXPECT_EQ(frame->GetActiveFrame(), second);
    EXPECT_EQ(titleOf(*frame), "Board2 - Frame Test");
    EXPECT_EQ(CWnd::GetFocus(), second->GetActiveView());
    EXPECT_NE(first->GetState()->widget()->pos(), second->GetState()->widget()->pos());
    EXPECT_EQ(second->GetParentFrame(), frame);
    EXPECT_EQ(second->GetTopLevelFrame(), frame);
}

// Without a child frame nothing else has the keyboard, which the menu bar borrows.
TEST_F(Mdi, AnEmptyFramesMenuGivesTheKeyboardBack) {
    open()->SendMessage(WM_CLOSE);
    settle();
    for (const bool byMouse : {false, true}) {
        if (byMouse) {
            ASSERT_NE(clickBar(*frame, "File"), nullptr);
        } else {
            key(Qt::Key_F, Qt::AltModifier);
            ASSERT_NE(openMenu(), nullptr);
        }
        key(Qt::Key_Escape);
        key(Qt::Key_Escape);
        EXPECT_FALSE(tvx::afx::menuHasKeyboard()) << byMouse;
    }
}

TEST_F(Mdi, ActivationBringsMenuFocusAndCommands) {
    EXPECT_EQ(barTexts(), QStringList({"File", "Edit", "View"}));
    CMDIChildWnd* first = open();
    EXPECT_EQ(barTexts(), QStringList({"Board", "Window"}));
    CMDIChildWnd* second = open();
    auto& firstView = static_cast<NoteView&>(*first->GetActiveView());
    QTest::mouseClick(tvx::afx::peerOf(firstView.m_hWnd), Qt::LeftButton, Qt::NoModifier, QPoint(2, 2));
    settle();
    EXPECT_EQ(frame->MDIGetActive(), first);
    EXPECT_EQ(CWnd::GetFocus(), &firstView);
    frame->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_TRUE(firstView.grid);
    EXPECT_FALSE(static_cast<NoteView*>(second->GetActiveView())->grid);
    key(Qt::Key_F7);
    EXPECT_TRUE(noted("draw")) << "the document type's accelerators";
}

namespace {

/// A frame beside the main frame, which hands on to that one what it does not know.
class BesideFrame : public NoteFrame {
public:
    NoteView* open() {
        CCreateContext context;
        context.m_pNewViewClass = RUNTIME_CLASS(NoteView);
        EXPECT_TRUE(LoadFrame(IDR_TESTMAIN, WS_OVERLAPPEDWINDOW, nullptr, &context));
        InitialUpdateFrame(nullptr, TRUE);
        EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(*this)));
        settle();
        return static_cast<NoteView*>(GetActiveView());
    }
    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override {
        return NoteFrame::OnCmdMsg(id, code, extra, info) || AfxGetMainWnd()->OnCmdMsg(id, code, extra, info);
    }
};

} // namespace

TEST_F(Mdi, ARoutingFrameHasThePlaceOfTheActiveChild) {
    const auto* inside = static_cast<NoteView*>(open()->GetActiveView());
    auto* beside = new BesideFrame;
    const NoteView* outside = beside->open();
    frame->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_TRUE(inside->grid) << "without a routing frame nothing is different";
    EXPECT_EQ(AfxSetRoutingFrame(frame), nullptr);
    frame->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_FALSE(inside->grid);
    EXPECT_EQ(AfxSetRoutingFrame(beside), frame);
    frame->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_TRUE(!inside->grid && outside->grid);
    const std::pair<UINT, const CCmdTarget*> handlers[] = {{ID_TEST_GRID, outside},
                                                           {ID_TEST_FRAME, beside},
                                                           {ID_WINDOW_CASCADE, frame},
                                                           {ID_HELP, beside},
                                                           {ID_APP_EXIT, AfxGetApp()}};
    for (const auto& [id, handler] : handlers) {
        AFX_CMDHANDLERINFO info;
        EXPECT_TRUE(frame->OnCmdMsg(id, CN_COMMAND, nullptr, &info)) << id;
        EXPECT_EQ(info.pTarget, handler) << id;
    }
    // A key of the main frame's only, one that both know, and those of the active child's.
    const ACCEL entries[] = {{FVIRTKEY, VK_F9, ID_TEST_DRAW}, {FVIRTKEY, VK_F5, ID_TEST_GRID}};
    frame->m_hAccelTable = CreateAcceleratorTable(entries, 2);
    journal().clear();
    for (const Qt::Key pressed : {Qt::Key_F9, Qt::Key_F5, Qt::Key_F7}) {
        key(pressed);
    }
    key(Qt::Key_F4, Qt::ControlModifier);
    EXPECT_EQ(journal(), (std::vector<std::string>{"draw", "grid"}));
    EXPECT_TRUE(!inside->grid && !outside->grid && frame->MDIGetActive());
    beside->DestroyWindow();
    EXPECT_EQ(AfxGetRoutingFrame(), nullptr);
    frame->SendMessage(WM_COMMAND, ID_TEST_GRID);
    EXPECT_TRUE(inside->grid);
    frame->SetActiveWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(*frame)));
    key(Qt::Key_F7);
    EXPECT_EQ(journal(), (std::vector<std::string>{"draw", "grid", "grid", "draw"}));
}

TEST_F(Mdi, KeysWalkAndClose) {
    CMDIChildWnd* first = open();
    CMDIChildWnd* second = open();
    CMDIChildWnd* third = open();
    key(Qt::Key_F6, Qt::ControlModifier);
    EXPECT_EQ(frame->MDIGetActive(), first);
    key(Qt::Key_F6, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(frame->MDIGetActive(), third);
    frame->MDINext();
    EXPECT_EQ(frame->MDIGetActive(), first);
    frame->MDIPrev();
    EXPECT_EQ(frame->MDIGetActive(), third);
    frame->MDIActivate(second);
    frame->MDIActivate(third);
    key(Qt::Key_F4, Qt::ControlModifier);
    EXPECT_EQ(frame->MDIGetActive(), second) << "the one that was active before";
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 2);
    frame->MDIGetActive()->MDIDestroy();
    frame->MDIGetActive()->SendMessage(WM_CLOSE);
    settle();
    EXPECT_EQ(frame->MDIGetActive(), nullptr);
    EXPECT_EQ(barTexts(), QStringList({"File", "Edit", "View"}));
    EXPECT_EQ(titleOf(*frame), "Frame Test");
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 0);
}

TEST_F(Mdi, DocumentsThatWereClosedLeaveNothing) {
    const auto openAndClose = [this](int times) {
        for (int i = 0; i < times; ++i) {
            open()->SendMessage(WM_CLOSE);
            settle();
            QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete); // else in the loop of Run only
        }
        const struct mallinfo2 heap = mallinfo2();
        return heap.uordblks + heap.hblkhd;
    };
    constexpr int times = 100;
    const auto before = static_cast<std::ptrdiff_t>(openAndClose(20)); // fills caches
    const auto after = static_cast<std::ptrdiff_t>(openAndClose(times));
    EXPECT_LT(after - before, times * 1000);
}

TEST_F(Mdi, ChildrenNeedNoDocument) {
    CMDIChildWnd* board = open();
    CMDIChildWnd* child = frame->CreateNewChild(RUNTIME_CLASS(CMDIChildWnd), IDR_TESTBOARD);
    ASSERT_NE(child, nullptr);
    EXPECT_EQ(frame->MDIGetActive(), child);
    EXPECT_TRUE(child->IsWindowVisible());
    EXPECT_EQ(child->GetActiveDocument(), nullptr);
    EXPECT_EQ(barTexts(), QStringList({"Board", "Window"}));
    EXPECT_EQ(frame->CreateNewChild(RUNTIME_CLASS(CFrameWnd), IDR_TESTBOARD), nullptr) << "no child frame";
    child->SendMessage(WM_CLOSE);
    EXPECT_EQ(frame->MDIGetActive(), board);
}

TEST_F(Mdi, WindowMenuListsTheChildren) {
    CMDIChildWnd* first = open();
    open();
    QMenu* menu = clickBar(*frame, "Window");
    ASSERT_NE(menu, nullptr);
    ASSERT_NE(itemOf(*menu, "1 Board1"), nullptr);
    EXPECT_FALSE(itemOf(*menu, "1 Board1")->isChecked());
    EXPECT_TRUE(itemOf(*menu, "2 Board2")->isChecked());
    clickItem(*menu, "1 Board1");
    EXPECT_EQ(frame->MDIGetActive(), first);
    first->SendMessage(WM_CLOSE);
    settle();
    menu = clickBar(*frame, "Window");
    ASSERT_NE(menu, nullptr);
    EXPECT_NE(itemOf(*menu, "1 Board2"), nullptr);
    EXPECT_EQ(itemOf(*menu, "2 Board2"), nullptr) << "the list is made anew";
    EXPECT_EQ(menu->actions().size(), 5);
    key(Qt::Key_Escape);
}

TEST_F(Mdi, ViewsOfOneDocumentAreNumbered) {
    CMDIChildWnd* first = open();
    QMenu* menu = clickBar(*frame, "Window");
    ASSERT_NE(menu, nullptr);
    clickItem(*menu, "New Window");
    CMDIChildWnd* second = frame->MDIGetActive();
    ASSERT_NE(second, first);
    EXPECT_EQ(second->GetActiveDocument(), first->GetActiveDocument());
    EXPECT_EQ(titleOf(*first), "Board1:1");
    EXPECT_EQ(titleOf(*second), "Board1:2");
    EXPECT_EQ(titleOf(*frame), "Board1:2 - Frame Test");
    second->GetActiveDocument()->SetModifiedFlag();
    second->SendMessage(WM_CLOSE);
    settle();
    EXPECT_EQ(titleOf(*first), "Board1") << "closed without a question: the document is still shown";
    BoxAnswer box("Cancel");
    first->SendMessage(WM_CLOSE);
    EXPECT_EQ(box.texts, std::vector<std::string>{"Save changes to Board1?"});
    EXPECT_EQ(frame->MDIGetActive(), first);
    first->GetActiveDocument()->SetModifiedFlag(FALSE);
}

TEST_F(Mdi, MaximizedChild) {
    CMDIChildWnd* first = open();
    first->MDIMaximize();
    settle();
    BOOL maximized = FALSE;
    frame->MDIGetActive(&maximized);
    EXPECT_TRUE(maximized);
    EXPECT_TRUE(first->IsZoomed());
    idle();
    EXPECT_EQ(widgetOf(*frame)->windowTitle().toStdString(), "Frame Test - [Board1]");
    CMDIChildWnd* second = open();
    EXPECT_TRUE(second->IsZoomed()) << "a new frame is as large as the active one";
    EXPECT_FALSE(first->IsZoomed()) << "one at a time";
    frame->MDIActivate(first);
    settle();
    EXPECT_TRUE(first->IsZoomed());
    CMDIChildWnd* third = open();
    third->SendMessage(WM_CLOSE);
    settle();
    EXPECT_EQ(frame->MDIGetActive(), first);
    EXPECT_TRUE(first->IsZoomed()) << "the next one comes up as large";
    frame->MDIActivate(second);
    settle();
    second->MDIRestore();
    settle();
    idle();
    frame->MDIGetActive(&maximized);
    EXPECT_FALSE(maximized);
    EXPECT_EQ(widgetOf(*frame)->windowTitle().toStdString(), "Board2 - Frame Test");
    EXPECT_TRUE(first->IsWindowVisible());
}

TEST_F(Mdi, TilesAndCascades) {
    CMDIChildWnd* first = open();
    CMDIChildWnd* second = open();
    frame->MDITile(MDITILE_VERTICAL);
    settle();
    const QRect left = first->GetState()->widget()->geometry();
    const QRect right = second->GetState()->widget()->geometry();
    EXPECT_EQ(left.top(), right.top());
    EXPECT_EQ(left.right() + 1, right.left());
    EXPECT_EQ(right.right() + 1, area()->viewport()->width());
    frame->SendMessage(WM_COMMAND, ID_WINDOW_CASCADE);
    settle();
    EXPECT_NE(first->GetState()->widget()->y(), second->GetState()->widget()->y());
    const QSize room = area()->viewport()->size();
    EXPECT_GE(second->GetState()->widget()->height(), room.height() / 2);
    for (int i = 0; i < 3; ++i) {
        open();
    }
    frame->MDITile(MDITILE_HORIZONTAL);
    settle();
    std::set<std::pair<int, int>> columns;
    int covered = 0;
    for (const QMdiSubWindow* sub : area()->subWindowList()) {
        columns.insert({sub->x(), sub->width()});
        covered += sub->width() * sub->height();
    }
    EXPECT_EQ(columns.size(), 2U) << "five in a grid";
    EXPECT_EQ(covered, room.width() * room.height());
}

TEST_F(FrameTest, ChildrenOfAFrameThatIsStillToBePlacedFitIt) {
    BoardsFrame& frame = makeBoards();
    const auto open = [&] {
        CDocument* document = boards().OpenDocumentFile(nullptr);
        POSITION at = document->GetFirstViewPosition();
        return document->GetNextView(at)->GetParentFrame();
    };
    CFrameWnd* placed = open();
    placed->MoveWindow(20, 30, 300, 200);
    const QWidget* early = open()->GetState()->widget();
    const QSize before = early->size();
    QWidget* main = frame.GetState()->widget();
    frame.ShowWindow(SW_SHOW);
    // What a window manager does with a frame that comes up maximised: it tells its size later.
    main->resize(main->size() * 2);
    settle();
    EXPECT_GT(early->width(), before.width() * 3 / 2);
    EXPECT_EQ(placed->GetState()->widget()->geometry(), QRect(20, 30, 300, 200)) << "where it was moved to";
    QTest::qWait(50);
    const QSize known = early->size();
    main->resize(main->size() / 2);
    settle();
    EXPECT_EQ(early->size(), known) << "the user's own sizing leaves children alone";
}

TEST_F(Mdi, ChildrenMoveAndSizeByKeys) {
    CMDIChildWnd* child = open();
    child->MoveWindow(20, 30, 300, 200);
    settle();
    const auto change = [child](UINT command, const std::vector<Qt::Key>& keys) {
        later([keys] {
            for (const Qt::Key each : keys) {
                key(each);
            }
        });
        child->SendMessage(WM_SYSCOMMAND, command);
        return child->GetState()->widget()->geometry();
    };
    EXPECT_EQ(change(SC_MOVE, {Qt::Key_Right, Qt::Key_Down, Qt::Key_Down, Qt::Key_Return}), QRect(28, 46, 300, 200));
    EXPECT_EQ(change(SC_SIZE, {Qt::Key_Left, Qt::Key_Return}), QRect(28, 46, 292, 200));
    EXPECT_EQ(change(SC_MOVE, {Qt::Key_Right, Qt::Key_Escape}), QRect(28, 46, 292, 200));
    EXPECT_TRUE(journal().empty()) << "the keys are nobody else's";
}

TEST_F(Mdi, OpenFilesAreActivatedInsteadOfOpenedTwice) {
    write(file("x.tbrd"), std::string("\x02hi"));
    CDocument* opened = AfxGetApp()->OpenDocumentFile(file("x.tbrd").c_str());
    ASSERT_NE(opened, nullptr);
    open();
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("x.tbrd").c_str()), opened);
    EXPECT_EQ(frame->MDIGetActive()->GetActiveDocument(), opened);
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 2);
}

TEST_F(Mdi, MainFrameAsksForEachChangedDocument) {
    open()->GetActiveDocument()->SetModifiedFlag();
    open()->GetActiveDocument()->SetModifiedFlag();
    {
        BoxAnswer box("Cancel");
        frame->SendMessage(WM_CLOSE);
        EXPECT_EQ(box.texts.size(), 1U);
        EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 2);
    }
    BoxAnswer box("No");
    frame->SendMessage(WM_CLOSE);
    EXPECT_EQ(box.texts, (std::vector<std::string>{"Save changes to Board1?", "Save changes to Board2?"}));
    EXPECT_EQ(AfxGetApp()->m_pMainWnd, nullptr);
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 0);
}

TEST_F(Mdi, SystemMenuOfAChild) {
    CMDIChildWnd* child = open();
    auto* sub = qobject_cast<QMdiSubWindow*>(child->GetState()->widget());
    QMenu* menu = sub->systemMenu();
    ASSERT_NE(menu, nullptr);
    menu->popup(QPoint(100, 100));
    EXPECT_FALSE(itemOf(*menu, "Restore")->isEnabled());
    clickItem(*menu, "Close");
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 0);
}

TEST_F(Mdi, ChildrenKnowWhereTheyGoBackTo) {
    CMDIChildWnd* child = open();
    child->MoveWindow(20, 30, 300, 200);
    settle();
    WINDOWPLACEMENT placement;
    frame->MDIMaximize(child);
    settle();
    ASSERT_TRUE(child->GetWindowPlacement(&placement));
    EXPECT_EQ(placement.showCmd, UINT{SW_SHOWMAXIMIZED});
    EXPECT_EQ(CRect(placement.rcNormalPosition), CRect(20, 30, 320, 230));
    placement.rcNormalPosition = CRect(5, 6, 305, 206);
    ASSERT_TRUE(child->SetWindowPlacement(&placement));
    settle();
    EXPECT_TRUE(child->IsZoomed());
    frame->MDIRestore(child);
    settle();
    ASSERT_TRUE(child->GetWindowPlacement(&placement));
    EXPECT_EQ(placement.showCmd, UINT{SW_SHOWNORMAL});
    EXPECT_EQ(CRect(placement.rcNormalPosition), CRect(5, 6, 305, 206));
}

TEST_F(FrameTest, ButtonsOfChildFramesAreSeenOnADarkDesktop) {
    BoardsFrame& frame = openBoards();
    const QPalette before = QApplication::palette();
    QApplication::setPalette(QPalette(QColor(50, 50, 50), QColor(40, 40, 40)));
    boards().OpenDocumentFile(nullptr);
    boards().OpenDocumentFile(nullptr);
    settle();
    for (QMdiSubWindow* child : widgetOf(frame)->findChildren<QMdiSubWindow*>()) {
        const int height = child->style()->pixelMetric(QStyle::PM_TitleBarHeight, nullptr, child);
        const QImage buttons = child->grab(QRect(child->width() - 3 * height, 0, 3 * height, height)).toImage();
        int brightest = 0;
        for (int y = 0; y < buttons.height(); ++y) {
            for (int x = 0; x < buttons.width(); ++x) {
                brightest = std::max(brightest, buttons.pixelColor(x, y).lightness());
            }
        }
        EXPECT_GT(brightest, 200) << child->windowTitle().toStdString();
    }
    frame.MDIGetActive()->MDIMaximize();
    settle();
    QWidget* corner = dynamic_cast<QMainWindow*>(widgetOf(frame))->menuBar()->cornerWidget();
    ASSERT_NE(corner, nullptr);
    const auto seen = [corner] {
        const QImage image = corner->grab().toImage();
        const int ground = corner->palette().button().color().lightness();
        int pixels = 0;
        for (int i = 0; i < image.width() * image.height(); ++i) {
            const int light = image.pixelColor(i % image.width(), i / image.width()).lightness();
            pixels += std::abs(light - ground) > 70 ? 1 : 0;
        }
        return pixels;
    };
    const int onDark = seen();
    QApplication::setPalette(before);
    settle();
    EXPECT_GE(onDark, seen()) << "in the menu bar";
    const QString style = QApplication::style()->name();
    QApplication::setStyle("Windows");
    EXPECT_EQ(dynamic_cast<QProxyStyle&>(*corner->style()).baseStyle()->name(), "windows") << "it follows the desktop";
    QApplication::setStyle(style);
}
