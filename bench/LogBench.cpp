// 100,000 lines appended to a log of limited size, beside the toolkit's text area with a limited number of lines. The
// visible logs are painted once every hundred lines.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "s/Edit.h"

#include <QApplication>
#include <QPlainTextEdit>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

CWinApp benchApplication("LogBench");
constexpr int lineCount = 100000;
constexpr int lineBytes = 40;
constexpr int linesAFrame = 100;

std::string lineText(int number) {
    std::string text = "Step " + std::to_string(1000000 + number) + " of the analysis";
    text.resize(lineBytes - 2, '.');
    return text;
}

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

enum class Shown { No, Yes };

class Host : public CWnd {
public:
    explicit Host(Shown shown) {
        const DWORD visible = shown == Shown::Yes ? WS_VISIBLE : 0;
        CreateEx(0, AfxRegisterWndClass(0), "", WS_OVERLAPPEDWINDOW | visible, 0, 0, 500, 300, nullptr, nullptr);
        constexpr DWORD style = WS_CHILD | WS_VISIBLE | WS_VSCROLL | WS_HSCROLL;
        edit.Create(style | ES_MULTILINE | ES_READONLY | ES_AUTOHSCROLL | ES_AUTOVSCROLL, CRect(0, 0, 500, 300), this,
                    1);
        QApplication::processEvents(); // nothing is painted before
    }
    ~Host() override {
        DestroyWindow();
    }
    void paint() {
        tvx::afx::peerOf(edit.m_hWnd)->repaint();
    }
    Gui_Edit edit;
};

void textArea(benchmark::State& state, Shown shown) {
    prepare();
    std::vector<QString> lines;
    for (int i = 0; i < lineCount; ++i) {
        lines.push_back(QString::fromStdString(lineText(i)));
    }
    for (auto _ : state) {
        QPlainTextEdit area;
        area.setReadOnly(true);
        area.setUndoRedoEnabled(false);
        area.setLineWrapMode(QPlainTextEdit::NoWrap);
        area.setMaximumBlockCount(static_cast<int>(state.range(0)) / lineBytes);
        area.resize(500, 300);
        area.setVisible(shown == Shown::Yes);
        QApplication::processEvents();
        for (int i = 0; i < lineCount; ++i) {
            area.appendPlainText(lines[static_cast<std::size_t>(i)]);
            if (shown == Shown::Yes && i % linesAFrame == 0) {
                area.viewport()->repaint();
            }
        }
    }
}

void append(benchmark::State& state, Shown shown) {
    prepare();
    std::vector<CString> lines;
    for (int i = 0; i < lineCount; ++i) {
        lines.emplace_back((lineText(i) + "\r\n").c_str());
    }
    for (auto _ : state) {
        Host host(shown);
        host.edit.SetLimitText(static_cast<UINT>(state.range(0)));
        for (int i = 0; i < lineCount; ++i) {
            host.edit.AppendText(lines[static_cast<std::size_t>(i)]);
            if (shown == Shown::Yes && i % linesAFrame == 0) {
                host.paint();
            }
        }
    }
}

/// The same in the chunks that a busy program's output comes in.
void appendChunks(benchmark::State& state) {
    prepare();
    std::vector<CString> chunks;
    for (int i = 0; i < lineCount; i += linesAFrame) {
        std::string chunk;
        for (int line = i; line < i + linesAFrame; ++line) {
            chunk += lineText(line) + "\r\n";
        }
        chunks.emplace_back(chunk.c_str());
    }
    for (auto _ : state) {
        Host host(Shown::Yes);
        host.edit.SetLimitText(static_cast<UINT>(state.range(0)));
        for (const CString& chunk : chunks) {
            host.edit.AppendText(chunk);
            host.paint();
        }
    }
}

/// The repaints alone.
void paintOnly(benchmark::State& state) {
    prepare();
    Host host(Shown::Yes);
    for (int i = 0; i < 1000; ++i) {
        host.edit.AppendText((lineText(i) + "\r\n").c_str());
    }
    for (auto _ : state) {
        for (int i = 0; i < lineCount; i += linesAFrame) {
            host.paint();
        }
    }
}

BENCHMARK_CAPTURE(textArea, hidden, Shown::No)->Arg(60000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(append, hidden, Shown::No)->Arg(60000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(textArea, shown, Shown::Yes)->Arg(60000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(append, shown, Shown::Yes)->Arg(60000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK(appendChunks)->Arg(60000)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK(paintOnly)->Unit(benchmark::kMillisecond);

} // namespace
