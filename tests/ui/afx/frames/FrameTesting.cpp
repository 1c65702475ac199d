#include "tests/ui/afx/frames/FrameTesting.h"

#include <QElapsedTimer>
#include <QWindow>

#include <cstdlib>

namespace frametest {

IMPLEMENT_DYNCREATE(Note, CDocument)
IMPLEMENT_DYNCREATE(NoteView, CView)
IMPLEMENT_DYNCREATE(NoteFrame, CFrameWnd)
IMPLEMENT_DYNCREATE(BoardsFrame, CMDIFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(Note, CDocument)
    ON_COMMAND(ID_TEST_DOC, &Note::OnDoc)
END_MESSAGE_MAP()

BEGIN_MESSAGE_MAP(NoteView, CView)
    ON_COMMAND(ID_TEST_DRAW, &NoteView::OnDrawShape)
    ON_COMMAND(ID_TEST_GRID, &NoteView::OnGrid)
    ON_UPDATE_COMMAND_UI(ID_TEST_GRID, &NoteView::OnUpdateGrid)
    ON_COMMAND(ID_TEST_LOCKED, &NoteView::OnLocked)
    ON_UPDATE_COMMAND_UI(ID_TEST_LOCKED, &NoteView::OnUpdateLocked)
    ON_COMMAND_RANGE(ID_TEST_SMALL, ID_TEST_LARGE, &NoteView::OnSize1)
    ON_UPDATE_COMMAND_UI_RANGE(ID_TEST_SMALL, ID_TEST_LARGE, &NoteView::OnUpdateSize)
END_MESSAGE_MAP()

BEGIN_MESSAGE_MAP(NoteFrame, CFrameWnd)
    ON_WM_CREATE()
    ON_COMMAND(ID_TEST_FRAME, &NoteFrame::OnFrame)
END_MESSAGE_MAP()

BEGIN_MESSAGE_MAP(BoardsFrame, CMDIFrameWnd)
    ON_WM_CREATE()
END_MESSAGE_MAP()
// clang-format on

// --- the document ---

void Note::Serialize(CArchive& archive) {
    if (archive.IsStoring()) {
        archive << text;
        if (failsHalfWay) {
            archive.Flush();
            AfxThrowFileException(CFileException::diskFull);
        }
    } else {
        archive >> text;
    }
}

void Note::DeleteContents() {
    text.Empty();
}

void Note::OnDoc() {
    frametest::note("document");
}

// --- the view ---

void NoteView::OnDraw(CDC* dc) {
    dc->FillSolidRect(10, 10, 20, 20, RGB(255, 0, 0));
}

void NoteView::OnUpdate(CView* sender, LPARAM hint, CObject* object) {
    ++updates;
    lastHint = hint;
    CView::OnUpdate(sender, hint, object);
}

void NoteView::OnDrawShape() {
    frametest::note("draw");
}

void NoteView::OnGrid() {
    grid = !grid;
    frametest::note("grid");
}

void NoteView::OnUpdateGrid(CCmdUI* item) {
    item->SetCheck(grid ? 1 : 0);
}

void NoteView::OnLocked() {
    frametest::note("locked");
}

void NoteView::OnUpdateLocked(CCmdUI* item) {
    item->Enable(FALSE);
}

void NoteView::OnSize1(UINT id) {
    large = id == ID_TEST_LARGE;
}

void NoteView::OnUpdateSize(CCmdUI* item) {
    item->SetRadio((item->m_nID == ID_TEST_LARGE) == large);
}

// --- frames ---

namespace {

const UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_COUNT, ID_INDICATOR_CAPS};

} // namespace

int NoteFrame::OnCreate(CREATESTRUCT* cs) {
    if (CFrameWnd::OnCreate(cs) == -1) {
        return -1;
    }
    const DWORD style = WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_TOOLTIPS | CBRS_FLYBY;
    if (!tools.CreateEx(this, TBSTYLE_FLAT, style) || !tools.LoadToolBar(IDR_TESTMAIN) || !status.Create(this)) {
        return -1;
    }
    status.SetIndicators(indicators, 3);
    tools.EnableDocking(CBRS_ALIGN_ANY);
    EnableDocking(CBRS_ALIGN_ANY);
    DockControlBar(&tools);
    return 0;
}

void NoteFrame::OnFrame() {
    note("frame");
}

int BoardsFrame::OnCreate(CREATESTRUCT* cs) {
    if (CMDIFrameWnd::OnCreate(cs) == -1 || !status.Create(this)) {
        return -1;
    }
    status.SetIndicators(indicators, 1);
    return 0;
}

// --- set-up ---

void FrameTest::SetUp() {
    journal().clear();
    std::string pattern = (std::filesystem::temp_directory_path() / "frames.XXXXXX").string();
    ASSERT_NE(mkdtemp(pattern.data()), nullptr);
    m_folder = pattern;
}

void FrameTest::TearDown() {
    CWinApp& app = *AfxGetApp();
    app.CloseAllDocuments(FALSE);
    if (app.m_pMainWnd) {
        app.m_pMainWnd->DestroyWindow();
    }
    settle();
    tvx::afx::takeQuit(); // the main window's end asks for the application's
    delete app.m_pDocManager;
    app.m_pDocManager = nullptr;
    app.m_nCmdShow = SW_SHOWNORMAL;
    std::filesystem::remove_all(m_folder);
}

void FrameTest::showMain(CFrameWnd& frame) {
    ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(frame)));
    settle();
    idle();
}

NoteFrame& FrameTest::openNote() {
    CWinApp& app = *AfxGetApp();
    app.AddDocTemplate(
        new CSingleDocTemplate(IDR_TESTMAIN, RUNTIME_CLASS(Note), RUNTIME_CLASS(NoteFrame), RUNTIME_CLASS(NoteView)));
    app.OnFileNew();
    auto& frame = static_cast<NoteFrame&>(*app.m_pMainWnd);
    showMain(frame);
    return frame;
}

BoardsFrame& FrameTest::openBoards() {
    BoardsFrame& frame = makeBoards();
    frame.ShowWindow(SW_SHOW);
    showMain(frame);
    return frame;
}

BoardsFrame& FrameTest::makeBoards() {
    CWinApp& app = *AfxGetApp();
    m_boards =
        new CMultiDocTemplate(IDR_TESTBOARD, RUNTIME_CLASS(Note), RUNTIME_CLASS(CMDIChildWnd), RUNTIME_CLASS(NoteView));
    app.AddDocTemplate(m_boards);
    auto* frame = new BoardsFrame;
    EXPECT_TRUE(frame->LoadFrame(IDR_TESTMAIN));
    app.m_pMainWnd = frame;
    return *frame;
}

NoteView& FrameTest::view() const {
    auto* frame = static_cast<CFrameWnd*>(AfxGetApp()->m_pMainWnd)->GetActiveFrame();
    return static_cast<NoteView&>(*frame->GetActiveView());
}

Note& FrameTest::document() const {
    return *view().note();
}

// --- acts ---

void idle() {
    AfxGetApp()->OnIdle(0);
    AfxGetApp()->OnIdle(1);
}

void settle() {
    for (int i = 0; i < 3; ++i) {
        QCoreApplication::sendPostedEvents();
        QCoreApplication::processEvents();
    }
}

void key(Qt::Key key, Qt::KeyboardModifiers modifiers) {
    QWidget* target = QApplication::activePopupWidget();
    target = target ? target : QApplication::focusWidget();
    ASSERT_NE(target, nullptr);
    // A press in the same millisecond as the key's release would count as the repetition of one that is held.
    QElapsedTimer clock;
    clock.start();
    while (clock.elapsed() == 0) {
    }
    // To the window, as the display server sends keys: only so does the toolkit ask for shortcuts first.
    QTest::keyClick(target->window()->windowHandle(), key, modifiers);
    settle();
}

QMenu* openMenu() {
    return qobject_cast<QMenu*>(QApplication::activePopupWidget());
}

QAction* itemOf(const QMenu& menu, const QString& text) {
    const auto actions = menu.actions();
    for (QAction* action : actions) {
        if (action->text().section(QLatin1Char('\t'), 0, 0).remove(QLatin1Char('&')) == text) {
            return action;
        }
    }
    return nullptr;
}

QMenu* clickBar(const CFrameWnd& frame, const QString& text) {
    auto* bar = qobject_cast<QMenuBar*>(widgetOf(frame)->menuWidget());
    const auto actions = bar->actions();
    for (QAction* action : actions) {
        if (QString(action->text()).remove(QLatin1Char('&')) == text) {
            QTest::mouseClick(bar, Qt::LeftButton, Qt::NoModifier, bar->actionGeometry(action).center());
            settle();
            return openMenu();
        }
    }
    return nullptr;
}

void clickItem(QMenu& menu, const QString& text) {
    QAction* action = itemOf(menu, text);
    ASSERT_NE(action, nullptr) << text.toStdString();
    const QPoint at = menu.actionGeometry(action).center();
    QTest::mouseMove(&menu, at);
    QTest::mouseClick(&menu, Qt::LeftButton, Qt::NoModifier, at);
    settle();
}

std::string contents(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void write(const std::filesystem::path& path, const std::string& text) {
    std::ofstream(path, std::ios::binary) << text;
}

BoxAnswer::BoxAnswer(const QString& button) {
    QObject::connect(&m_timer, &QTimer::timeout, &m_timer, [this, button] {
        auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (!box || !box->isVisible()) {
            return;
        }
        const auto buttons = box->buttons();
        for (QAbstractButton* each : buttons) {
            if (QString(each->text()).remove(QLatin1Char('&')) == button) {
                texts.push_back(box->text().toStdString());
                QTest::mouseClick(each, Qt::LeftButton);
                return;
            }
        }
    });
    m_timer.start(0);
}

void later(std::function<void()> act) {
    QTimer::singleShot(0, qApp, std::move(act));
}

} // namespace frametest
