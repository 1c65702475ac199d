// Filling, merging and measuring a list box of 65,535 items, beside the toolkit's list widget with uniform items whose
// widths are measured. Each run ends with the list painted.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "s/ListBox.h"

#include <QApplication>
#include <QListWidget>
#include <QScrollBar>

#include <algorithm>
#include <benchmark/benchmark.h>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

CWinApp benchApplication("ListBench");
constexpr int lineCount = 65535;

std::string lineText(int number) {
    return "Part " + std::to_string(number * 7919LL % lineCount + 100000) + " of the assembly";
}

const std::vector<QString>& toolkitLines() {
    static const std::vector<QString> made = [] {
        std::vector<QString> lines;
        for (int i = 0; i < lineCount; ++i) {
            lines.push_back(QString::fromStdString(lineText(i)));
        }
        return lines;
    }();
    return made;
}

void collect(CStringList& lines, int first, int last) {
    for (int i = first; i < last; ++i) {
        lines.AddTail(lineText(i).c_str());
    }
}

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

class Host : public CWnd {
public:
    explicit Host(DWORD style) {
        CreateEx(0, AfxRegisterWndClass(0), "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 400, 300, nullptr, nullptr);
        list.Create(WS_CHILD | WS_VISIBLE | WS_HSCROLL | WS_VSCROLL | style, CRect(0, 0, 400, 300), this, 1);
        QApplication::processEvents(); // nothing is painted before
        paint();
    }
    ~Host() override {
        DestroyWindow();
    }
    void paint() {
        tvx::afx::peerOf(list.m_hWnd)->repaint();
    }
    Gui_ListBox list;
};

enum class Widths { Ignored, Measured };

void listWidget(benchmark::State& state, Widths widths) {
    prepare();
    const std::vector<QString>& lines = toolkitLines();
    for (auto _ : state) {
        QListWidget list;
        list.setUniformItemSizes(true);
        list.resize(400, 300);
        list.show();
        int widest = 0;
        const QFontMetrics metrics(list.font());
        for (const QString& line : lines) {
            list.addItem(line);
            if (widths == Widths::Measured) {
                widest = std::max(widest, metrics.horizontalAdvance(line));
            }
        }
        QApplication::processEvents();
        list.viewport()->repaint();
        benchmark::DoNotOptimize(widest);
    }
}

void sortedListWidget(benchmark::State& state) {
    prepare();
    const std::vector<QString>& lines = toolkitLines();
    for (auto _ : state) {
        QListWidget list;
        list.setUniformItemSizes(true);
        list.resize(400, 300);
        list.show();
        int widest = 0;
        const QFontMetrics metrics(list.font());
        for (const QString& line : lines) {
            list.addItem(line);
            widest = std::max(widest, metrics.horizontalAdvance(line));
        }
        list.sortItems();
        benchmark::DoNotOptimize(widest);
        QApplication::processEvents();
        list.viewport()->repaint();
    }
}

void fill(benchmark::State& state, Widths widths) {
    prepare();
    CStringList lines;
    collect(lines, 0, lineCount);
    for (auto _ : state) {
        Host host(0);
        host.list.AddStringList(lines, nullptr);
        if (widths == Widths::Measured) {
            host.list.UpdateHorizontalExtent();
        }
        host.paint();
    }
}

/// The last tenth comes to nine that are there, in order; every hundredth item is selected.
void merge(benchmark::State& state) {
    prepare();
    CStringList first;
    CStringList second;
    collect(first, 0, lineCount / 10 * 9);
    collect(second, lineCount / 10 * 9, lineCount);
    for (auto _ : state) {
        Host host(LBS_EXTENDEDSEL);
        host.list.AddStringList(first, Gui_ListBox::StringCompare);
        for (int i = 0; i < lineCount / 10 * 9; i += 100) {
            host.list.SetSel(i);
        }
        host.list.AddStringList(second, Gui_ListBox::StringCompare);
        host.list.UpdateHorizontalExtent();
        host.paint();
    }
}

void sortedBox(benchmark::State& state) {
    prepare();
    CStringList lines;
    collect(lines, 0, lineCount);
    for (auto _ : state) {
        Host host(LBS_SORT);
        host.list.AddStringList(lines, nullptr);
        host.paint();
    }
}

/// Most items stay, every few one goes.
void filter(benchmark::State& state) {
    prepare();
    CStringList lines;
    collect(lines, 0, lineCount);
    for (auto _ : state) {
        state.PauseTiming();
        Host host(0);
        host.list.AddStringList(lines, nullptr);
        state.ResumeTiming();
        benchmark::DoNotOptimize(host.list.DeleteUnmatched("*1*"));
    }
}

BENCHMARK_CAPTURE(listWidget, uniform, Widths::Ignored)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(listWidget, uniform_widths, Widths::Measured)->Unit(benchmark::kMillisecond);
BENCHMARK(sortedListWidget)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(fill, Gui_ListBox, Widths::Ignored)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(fill, Gui_ListBox_widths, Widths::Measured)->Unit(benchmark::kMillisecond);
BENCHMARK(merge)->Unit(benchmark::kMillisecond);
BENCHMARK(sortedBox)->Unit(benchmark::kMillisecond);
BENCHMARK(filter)->Unit(benchmark::kMillisecond);

} // namespace
