// Filling, merging and measuring a list box of 65,535 items, beside the toolkit's list widget with uniform items whose
// widths are measured; and lines that come one by one to a list drawn by its owner, beside the toolkit's list over a
// model. Each run ends with the list painted.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "s/ListBox.h"

#include <QAbstractListModel>
#include <QApplication>
#include <QListView>
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

// --- lines that come one by one, each measured, as a console's do ---

/// The lines of a list without texts of its own: what each stands for.
const std::vector<std::string>& consoleLines() {
    static const std::vector<std::string> made = [] {
        std::vector<std::string> lines;
        for (int i = 0; i < lineCount; ++i) {
            lines.push_back(lineText(i));
        }
        return lines;
    }();
    return made;
}

enum class Watched { No, Yes };

/// A list that its object draws and measures.
class Console : public CListBox {
public:
    void append(const std::string& line) {
        SetRedraw(FALSE);
        AddString(reinterpret_cast<LPCSTR>(&line));
        SetRedraw(TRUE);
        CClientDC dc(this);
        const LONG width = dc.GetTextExtent(line.c_str(), static_cast<int>(line.size())).cx;
        if (width > m_extent) {
            m_extent = width;
            SetHorizontalExtent(m_extent);
        }
    }
    /// Shows the end, as it is after each line that comes while a user looks on.
    void showEnd(int rows) {
        const int top = std::max(GetCount() - rows, 0);
        if (GetTopIndex() < top) {
            SetTopIndex(top);
        }
    }
    void DrawItem(DRAWITEMSTRUCT* item) override {
        const auto& line = *reinterpret_cast<const std::string*>(item->itemData);
        CDC::FromHandle(item->hDC)->TextOut(item->rcItem.left, item->rcItem.top, line.c_str(),
                                            static_cast<int>(line.size()));
    }
    void MeasureItem(MEASUREITEMSTRUCT* item) override {
        item->itemHeight = 15;
    }

private:
    LONG m_extent = 0;
};

class ConsoleHost : public CWnd {
public:
    ConsoleHost() {
        CreateEx(0, AfxRegisterWndClass(0), "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 400, 300, nullptr, nullptr);
        list.Create(WS_CHILD | WS_VISIBLE | WS_HSCROLL | WS_VSCROLL | LBS_OWNERDRAWFIXED | LBS_EXTENDEDSEL,
                    CRect(0, 0, 400, 300), this, 1);
        QApplication::processEvents();
        tvx::afx::peerOf(list.m_hWnd)->repaint();
    }
    ~ConsoleHost() override {
        DestroyWindow();
    }
    Console list;
};

/// Lines that a frame of a display has time for: a user sees no more.
constexpr int linesOfAFrame = 100;

void console(benchmark::State& state, Watched watched) {
    prepare();
    const auto& lines = consoleLines();
    for (auto _ : state) {
        ConsoleHost host;
        const int rows = 300 / 15;
        for (int i = 0; i < lineCount; ++i) {
            host.list.append(lines[static_cast<std::size_t>(i)]);
            if (watched == Watched::Yes) {
                host.list.showEnd(rows);
                if (i % linesOfAFrame == 0) {
                    QApplication::processEvents();
                }
            }
        }
        QApplication::processEvents();
        tvx::afx::peerOf(host.list.m_hWnd)->repaint();
    }
}

/// The repaints of a list that is watched, and nothing else.
void repaints(benchmark::State& state) {
    prepare();
    const auto& lines = consoleLines();
    ConsoleHost host;
    for (const std::string& line : lines) {
        host.list.append(line);
    }
    for (auto _ : state) {
        for (int i = 0; i < lineCount; i += linesOfAFrame) {
            host.list.SetTopIndex(i);
            QApplication::processEvents();
        }
    }
}

class LineModel : public QAbstractListModel {
public:
    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(m_lines.size());
    }
    QVariant data(const QModelIndex& index, int role) const override {
        return role == Qt::DisplayRole ? QVariant(m_lines[static_cast<std::size_t>(index.row())]) : QVariant();
    }
    void append(const QString& line) {
        const int row = static_cast<int>(m_lines.size());
        beginInsertRows({}, row, row);
        m_lines.push_back(line);
        endInsertRows();
    }

private:
    std::vector<QString> m_lines;
};

void listView(benchmark::State& state, Widths widths) {
    prepare();
    const auto& lines = toolkitLines();
    for (auto _ : state) {
        LineModel model;
        QListView view;
        view.setUniformItemSizes(true);
        view.setModel(&model);
        view.resize(400, 300);
        view.show();
        QApplication::processEvents();
        int widest = 0;
        const QFontMetrics metrics(view.font());
        for (int i = 0; i < lineCount; ++i) {
            model.append(lines[static_cast<std::size_t>(i)]);
            if (widths == Widths::Measured) {
                widest = std::max(widest, metrics.horizontalAdvance(lines[static_cast<std::size_t>(i)]));
            }
        }
        benchmark::DoNotOptimize(widest);
        QApplication::processEvents();
        view.viewport()->repaint();
    }
}

BENCHMARK_CAPTURE(console, filled, Watched::No)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(listView, filled, Widths::Ignored)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(listView, filled_widths, Widths::Measured)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(console, watched, Watched::Yes)->Unit(benchmark::kMillisecond);
BENCHMARK(repaints)->Unit(benchmark::kMillisecond);

BENCHMARK_CAPTURE(listWidget, uniform, Widths::Ignored)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(listWidget, uniform_widths, Widths::Measured)->Unit(benchmark::kMillisecond);
BENCHMARK(sortedListWidget)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(fill, Gui_ListBox, Widths::Ignored)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(fill, Gui_ListBox_widths, Widths::Measured)->Unit(benchmark::kMillisecond);
BENCHMARK(merge)->Unit(benchmark::kMillisecond);
BENCHMARK(sortedBox)->Unit(benchmark::kMillisecond);
BENCHMARK(filter)->Unit(benchmark::kMillisecond);

} // namespace
