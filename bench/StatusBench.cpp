// 100,000 texts for a pane of a status bar, beside the toolkit's label in its status bar: hidden, as while a frame is
// being made, and shown by a loop that looks for no messages, at whose end the last text is painted.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "s/StatusBar.h"

#include <QApplication>
#include <QLabel>
#include <QMainWindow>
#include <QStatusBar>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

CWinApp benchApplication("StatusBench");
constexpr int textCount = 100000;

enum class Bar { Hidden, Shown };

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

std::vector<std::string> texts() {
    std::vector<std::string> made;
    for (int i = 0; i < textCount; ++i) {
        made.push_back("Line " + std::to_string(i) + " of the drawing");
    }
    return made;
}

void label(benchmark::State& state, Bar bar) {
    prepare();
    std::vector<QString> lines;
    for (const std::string& text : texts()) {
        lines.push_back(QString::fromStdString(text));
    }
    QMainWindow window;
    auto* pane = new QLabel;
    window.statusBar()->addWidget(pane, 1);
    window.resize(600, 200);
    window.setVisible(bar == Bar::Shown);
    QApplication::processEvents();
    for (auto _ : state) {
        for (const QString& line : lines) {
            pane->setText(line);
        }
        QApplication::processEvents();
    }
}

class Frame : public CFrameWnd {
public:
    explicit Frame(Bar shown) {
        constexpr UINT panes[] = {ID_SEPARATOR};
        Create(nullptr, "Bench", WS_OVERLAPPEDWINDOW, CRect(0, 0, 600, 200));
        bar.Create(this);
        bar.SetIndicators(panes, 1);
        ShowWindow(shown == Bar::Shown ? SW_SHOW : SW_HIDE);
        QApplication::processEvents();
    }
    Gui_StatusBar bar;
};

void pane(benchmark::State& state, Bar bar, BOOL update) {
    prepare();
    const std::vector<std::string> lines = texts();
    auto* frame = new Frame(bar); // deletes itself
    for (auto _ : state) {
        for (const std::string& line : lines) {
            frame->bar.SetPaneText(0, line.c_str(), update);
        }
        QApplication::processEvents();
    }
    frame->DestroyWindow();
}

BENCHMARK_CAPTURE(label, hidden, Bar::Hidden)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(pane, hidden, Bar::Hidden, TRUE)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(label, shown, Bar::Shown)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(pane, shown, Bar::Shown, TRUE)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(pane, shown_later, Bar::Shown, FALSE)->Unit(benchmark::kMillisecond);

} // namespace
