// A text view floats and is docked again, beside the bare toolkit that does the same between new frames with menu, tool
// bar and status bar; a hundred child frames are opened, beside as many of the toolkit's; memory after many moves.

#include "afxext.h"
#include "afxwin.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "s/ExternFrame.h"
#include "s/FloatChildFrame.h"
#include "s/FloatMainFrame.h"
#include "samples/board/Resource.h"

#include <QApplication>
#include <QLabel>
#include <QMainWindow>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QStatusBar>
#include <QToolBar>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <fstream>
#include <string>

namespace {

CWinApp benchApplication("FloatBench");
constexpr const char* text = "The quick brown fox\r\njumps over the lazy dog\r\n";

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

void settle() {
    QCoreApplication::sendPostedEvents();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QCoreApplication::processEvents();
}

/// Megabytes in memory.
double residentMemory() {
    std::ifstream file("/proc/self/statm");
    double pages = 0;
    file >> pages >> pages;
    return pages * 4096 / 1e6;
}

// --- ours ---

class TextDoc : public CDocument {
    DECLARE_DYNCREATE(TextDoc)
};
IMPLEMENT_DYNCREATE(TextDoc, CDocument)

class TextView : public CView {
    DECLARE_DYNCREATE(TextView)

public:
    void OnInitialUpdate() override {
        CView::OnInitialUpdate();
        m_edit.Create(WS_CHILD | WS_VISIBLE | ES_MULTILINE | WS_VSCROLL, CRect(0, 0, 300, 200), this, 1);
        m_edit.SetWindowText(text);
    }
    void OnDraw(CDC*) override {}

private:
    CEdit m_edit;
};
IMPLEMENT_DYNCREATE(TextView, CView)

class TextFrame : public Gui_FloatChildFrame {
    DECLARE_DYNCREATE(TextFrame)

protected:
    TextFrame() {
        SetRipResourceId(IDR_BOARDFLOAT);
    }
};
IMPLEMENT_DYNCREATE(TextFrame, Gui_FloatChildFrame)

class Main : public Gui_FloatMainFrame {};

/// The main frame with its template; stays for the whole run.
Main& mainFrame() {
    static Main* frame = [] {
        prepare();
        CWinApp& app = *AfxGetApp();
        app.AddDocTemplate(new CMultiDocTemplate(IDR_BOARDTYPE, RUNTIME_CLASS(TextDoc), RUNTIME_CLASS(TextFrame),
                                                 RUNTIME_CLASS(TextView)));
        auto* made = new Main;
        app.m_pMainWnd = made;
        made->LoadFrame(IDR_MAINFRAME);
        made->MoveWindow(0, 0, 800, 600);
        made->ShowWindow(SW_SHOW);
        settle();
        return made;
    }();
    return *frame;
}

void move(Main& main) {
    static_cast<TextFrame*>(main.MDIGetActive())->GetFloatHelp().RipOutView();
    settle();
    Gui_ExternFrame::GetAll().front()->GetFloatHelp().UnripView();
    settle();
}

void floatAndDock(benchmark::State& state) {
    Main& main = mainFrame();
    AfxGetApp()->OnFileNew();
    for (int i = 0; i < 10; ++i) {
        move(main);
    }
    const double before = residentMemory();
    for (auto _ : state) {
        move(main);
    }
    state.counters["more_megabytes"] = residentMemory() - before;
    AfxGetApp()->CloseAllDocuments(FALSE);
    settle();
}

void openChildren(benchmark::State& state) {
    mainFrame();
    for (auto _ : state) {
        for (int i = 0; i < 100; ++i) {
            AfxGetApp()->OnFileNew();
        }
        settle();
        state.PauseTiming();
        AfxGetApp()->CloseAllDocuments(FALSE);
        settle();
        state.ResumeTiming();
    }
}

// --- the toolkit's ---

void addBars(QMainWindow& frame) {
    for (const char* title : {"File", "Edit", "View", "Draw", "Tools", "Window", "Help"}) {
        QMenu* menu = frame.menuBar()->addMenu(QString::fromLatin1(title));
        for (int i = 0; i < 7; ++i) {
            menu->addAction(QStringLiteral("Command %1").arg(i));
        }
    }
    static const QPixmap picture(QStringLiteral(TVX_TOOL_BAR_PICTURE));
    QToolBar* bar = frame.addToolBar(QStringLiteral("Tools"));
    for (int i = 0; i < 12; ++i) {
        bar->addAction(QIcon(picture.copy(i * 16, 0, 16, 15)), QStringLiteral("Tool %1").arg(i));
    }
    for (int i = 0; i < 3; ++i) {
        frame.statusBar()->addPermanentWidget(new QLabel(QStringLiteral("pane")));
    }
    frame.statusBar()->showMessage(QStringLiteral("Ready"));
}

struct Area {
    QMainWindow frame;
    QMdiArea* area = new QMdiArea;

    Area() {
        frame.resize(800, 600);
        frame.setCentralWidget(area);
        addBars(frame);
        frame.show();
        settle();
    }
    QMdiSubWindow* add(QWidget* view) {
        auto* sub = new QMdiSubWindow;
        sub->setAttribute(Qt::WA_DeleteOnClose);
        sub->setWidget(view);
        sub->setWindowTitle(QStringLiteral("Drawing"));
        area->addSubWindow(sub);
        sub->resize(500, 350);
        sub->show();
        view->show();
        return sub;
    }
};

QPlainTextEdit* newText() {
    auto* view = new QPlainTextEdit;
    view->setPlainText(QString::fromLatin1(text));
    return view;
}

void toolkitFloatAndDock(benchmark::State& state) {
    prepare();
    Area main;
    QPlainTextEdit* view = newText();
    QMdiSubWindow* sub = main.add(view);
    settle();
    for (auto _ : state) {
        auto* outside = new QMainWindow;
        addBars(*outside);
        outside->setWindowTitle(sub->windowTitle());
        outside->resize(sub->size());
        sub->setWidget(nullptr);
        outside->setCentralWidget(view);
        outside->show();
        outside->activateWindow();
        view->show();
        view->setFocus();
        sub->close();
        settle();
        outside->takeCentralWidget();
        sub = main.add(view);
        outside->close();
        delete outside;
        main.frame.activateWindow();
        view->setFocus();
        settle();
    }
}

void toolkitOpenChildren(benchmark::State& state) {
    prepare();
    Area main;
    for (auto _ : state) {
        for (int i = 0; i < 100; ++i) {
            main.add(newText());
        }
        settle();
        state.PauseTiming();
        main.area->closeAllSubWindows();
        settle();
        state.ResumeTiming();
    }
}

BENCHMARK(floatAndDock)->Unit(benchmark::kMillisecond)->Iterations(1000);
BENCHMARK(toolkitFloatAndDock)->Unit(benchmark::kMillisecond)->Iterations(1000);
BENCHMARK(openChildren)->Unit(benchmark::kMillisecond)->Iterations(5);
BENCHMARK(toolkitOpenChildren)->Unit(benchmark::kMillisecond)->Iterations(5);

} // namespace
