// The console with 65,535 commands: filled, flooded while it is open, searched; beside the toolkit's list view and GNU
// readline's history. Each filling ends with the list painted.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "res/resource.h"
#include "s/Console.h"
#include "s/ConsoleHistory.h"
#include "s/WinApp.h"

#include <QAbstractListModel>
#include <QApplication>
#include <QListView>

#include <benchmark/benchmark.h>
#include <cstdio>
#include <cstdlib>
#include <readline/history.h>
#include <string>
#include <vector>

namespace {

constexpr int lineCount = 65535;
constexpr int linesAFrame = 100;

class BenchApp : public Gui_WinApp {
public:
    BenchApp() : Gui_WinApp("consolebench") {}
    HICON GetAppIcon() override {
        return nullptr;
    }
    CString GetAppVersion() override {
        return {};
    }
} benchApplication;

const std::vector<std::string>& lines() {
    static const std::vector<std::string> made = [] {
        std::vector<std::string> all;
        for (int i = 0; i < lineCount; ++i) {
            all.push_back("run part" + std::to_string(i * 7919LL % lineCount) + " of the assembly");
        }
        return all;
    }();
    return made;
}

int onCommand(const char* text) {
    return 1;
}

/// A main frame in which the console opens.
class Host {
public:
    Host() {
        setenv("QT_QPA_PLATFORM", "offscreen", 1);
        tvx::afx::ensureGui();
        benchApplication.InitApplication();
        auto* frame = new CMDIFrameWnd;
        frame->Create(nullptr, "Host", WS_OVERLAPPEDWINDOW, CRect(0, 0, 700, 500));
        frame->ShowWindow(SW_SHOW);
        benchApplication.m_pMainWnd = frame;
        QApplication::processEvents();
    }
    static Host& get() {
        static auto* host = new Host;
        return *host;
    }
    QWidget* list() {
        auto* frame = static_cast<CMDIFrameWnd*>(benchApplication.m_pMainWnd);
        CWnd* view = frame->MDIGetActive()->GetActiveView();
        return tvx::afx::peerOf(view->GetDlgItem(GUI_IDC_CONSOLE_LINES)->m_hWnd);
    }
};

void consoleFilled(benchmark::State& state) {
    Host& host = Host::get();
    for (auto _ : state) {
        Gui_Console console(onCommand, 0);
        console.Init();
        for (const std::string& line : lines()) {
            console.AddCommand(line.c_str());
        }
        console.Open();
        QApplication::processEvents();
        host.list()->repaint();
        console.Close();
    }
}

enum class Widths { Ignored, Measured };

class Model : public QAbstractListModel {
public:
    void add(const QString& line) {
        const int row = static_cast<int>(m_lines.size());
        beginInsertRows({}, row, row);
        m_lines.push_back(line);
        endInsertRows();
    }
    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(m_lines.size());
    }
    QVariant data(const QModelIndex& index, int role) const override {
        return role == Qt::DisplayRole ? QVariant(m_lines[static_cast<std::size_t>(index.row())]) : QVariant();
    }

private:
    std::vector<QString> m_lines;
};

void viewFilled(benchmark::State& state, Widths widths) {
    Host::get();
    for (auto _ : state) {
        Model model;
        QListView view;
        view.setUniformItemSizes(true);
        view.setModel(&model);
        view.resize(650, 400);
        int widest = 0;
        const QFontMetrics metrics(view.font());
        for (const std::string& line : lines()) {
            const QString text = QString::fromStdString(line);
            model.add(text);
            if (widths == Widths::Measured) {
                widest = std::max(widest, metrics.horizontalAdvance(text));
            }
        }
        view.show();
        QApplication::processEvents();
        view.viewport()->repaint();
        view.scrollToBottom();
        benchmark::DoNotOptimize(widest);
    }
}

/// Lines come while the console is open, and are painted a hundred at a time.
void consoleFlooded(benchmark::State& state) {
    Host& host = Host::get();
    for (auto _ : state) {
        Gui_Console console(onCommand, 0);
        console.Init();
        console.SetShowCommandStatusFlag(1);
        console.Open();
        QApplication::processEvents();
        QWidget* list = host.list();
        int count = 0;
        for (const std::string& line : lines()) {
            console.AddStatusLine(line.c_str());
            if (++count % linesAFrame == 0) {
                list->repaint();
            }
        }
        console.Close();
    }
}

void repaintsAlone(benchmark::State& state) {
    Host& host = Host::get();
    Gui_Console console(onCommand, 0);
    console.Init();
    console.SetShowCommandStatusFlag(1);
    for (const std::string& line : lines()) {
        console.AddStatusLine(line.c_str());
    }
    console.Open();
    QApplication::processEvents();
    QWidget* list = host.list();
    for (auto _ : state) {
        for (int i = 0; i < lineCount / linesAFrame; ++i) {
            list->repaint();
        }
    }
    console.Close();
}

void recall(benchmark::State& state, const char* first, const std::string& request) {
    Gui_ConsoleHistory history;
    history.AddCommand(first);
    for (const std::string& line : lines()) {
        history.AddCommand(line.c_str());
    }
    for (auto _ : state) {
        benchmark::DoNotOptimize(history.Resolve(request.c_str()));
    }
}

void readlineRecall(benchmark::State& state, const char* first, const char* pattern) {
    clear_history();
    add_history(first);
    for (const std::string& line : lines()) {
        add_history(line.c_str());
    }
    for (auto _ : state) {
        history_set_pos(history_length);
        benchmark::DoNotOptimize(history_search_prefix(pattern, -1));
    }
}

BENCHMARK(consoleFilled)->Unit(benchmark::kMillisecond)->MinTime(2);
BENCHMARK_CAPTURE(viewFilled, measured, Widths::Measured)->Unit(benchmark::kMillisecond)->MinTime(2);
BENCHMARK_CAPTURE(viewFilled, plain, Widths::Ignored)->Unit(benchmark::kMillisecond)->MinTime(2);
BENCHMARK(consoleFlooded)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK(repaintsAlone)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK_CAPTURE(recall, different, "open first", "!open")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(readlineRecall, different, "open first", "open")->Unit(benchmark::kMicrosecond);
// The pattern shares its first eight characters with every command.
BENCHMARK_CAPTURE(recall, alike, "run parts", "!run parts")->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(readlineRecall, alike, "run parts", "run parts")->Unit(benchmark::kMicrosecond);

} // namespace
