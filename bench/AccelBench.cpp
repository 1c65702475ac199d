// Keys of 2,000 commands, beside what the toolkit takes for as many: writing them into a menu tree, beside setting the
// texts of actions; opening the accelerator dialog, beside a dialog with a sorted list widget; a key pressed in the
// command palette, until everything is painted.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "res/resource.h"
#include "s/AccelDlg.h"
#include "s/AccelMap.h"
#include "s/CommandPalette.h"

#include <QAction>
#include <QApplication>
#include <QDialog>
#include <QKeyEvent>
#include <QListWidget>
#include <QMenu>
#include <QVBoxLayout>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

namespace {

CWinApp benchApplication("AccelBench");
constexpr int menuCount = 20;
constexpr int commandCount = 2000;
constexpr WORD firstCommand = 0x8000;

std::string commandText(int number) {
    static const char* const verbs[] = {"Open", "Insert", "Draw", "Measure", "Align", "Export", "Select"};
    static const char* const things[] = {"Rectangle", "Layer", "Symbol", "Net", "Report", "Reference", "Grid", "Text"};
    return std::string(verbs[number % 7]) + ' ' + things[number / 7 % 8] + ' ' + std::to_string(number);
}

/// Every command has a key of its own.
std::vector<tagACCEL> accels() {
    std::vector<tagACCEL> all;
    for (int i = 0; i < commandCount; ++i) {
        const int modifiers = i / 250;
        const int flags =
            FVIRTKEY | (modifiers & 1 ? FSHIFT : 0) | (modifiers & 2 ? FCONTROL : 0) | (modifiers & 4 ? FALT : 0);
        all.push_back({static_cast<BYTE>(flags), static_cast<WORD>(i % 250 + 1), static_cast<WORD>(firstCommand + i)});
    }
    return all;
}

void fill(CMenu& bar) {
    bar.CreateMenu();
    for (int menu = 0; menu < menuCount; ++menu) {
        const HMENU popup = ::CreatePopupMenu();
        for (int i = menu; i < commandCount; i += menuCount) {
            ::AppendMenu(popup, MF_STRING, static_cast<UINT_PTR>(firstCommand + i), commandText(i).c_str());
        }
        bar.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup), ("Menu " + std::to_string(menu)).c_str());
    }
}

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

void annotate(benchmark::State& state) {
    prepare();
    CMenu bar;
    fill(bar);
    const std::vector<tagACCEL> all = accels();
    const Gui_AccelMap map(all.data(), commandCount);
    for (auto _ : state) {
        map.AnnotateMenu(&bar);
    }
}

/// The texts change each time: actions pass over a text that they have.
void actionTexts(benchmark::State& state) {
    prepare();
    std::vector<std::unique_ptr<QMenu>> menus;
    std::vector<QAction*> actions;
    for (int menu = 0; menu < menuCount; ++menu) {
        menus.push_back(std::make_unique<QMenu>());
        for (int i = menu; i < commandCount; i += menuCount) {
            actions.push_back(menus.back()->addAction(QString::fromStdString(commandText(i))));
        }
    }
    const QString keys[] = {QStringLiteral("\tCtrl+Shift+F5"), QStringLiteral("\tCtrl+Shift+F6")};
    std::vector<QString> texts;
    for (int i = 0; i < commandCount; ++i) {
        texts.push_back(QString::fromStdString(commandText(i)));
    }
    std::size_t turn = 0;
    for (auto _ : state) {
        turn = 1 - turn;
        for (std::size_t i = 0; i < texts.size(); ++i) {
            actions[i]->setText(texts[i] + keys[turn]);
        }
    }
}

void openDialog(benchmark::State& state) {
    prepare();
    auto* frame = new CFrameWnd;
    frame->Create(nullptr, "Frame");
    CMenu bar;
    fill(bar);
    const std::vector<tagACCEL> all = accels();
    const HACCEL table = CreateAcceleratorTableA(all.data(), commandCount);
    for (auto _ : state) {
        Gui_AccelDlg dialog(&bar, table, frame);
        dialog.Create(GUI_IDD_ACCELERATORS, frame);
        dialog.ShowWindow(SW_SHOW);
        QApplication::processEvents();
        tvx::afx::peerOf(dialog.m_hWnd)->repaint();
        dialog.DestroyWindow();
    }
    DestroyAcceleratorTable(table);
    frame->DestroyWindow();
}

void listWidget(benchmark::State& state) {
    prepare();
    for (auto _ : state) {
        QDialog dialog;
        QVBoxLayout layout(&dialog);
        QListWidget list;
        layout.addWidget(&list);
        for (int i = 0; i < commandCount; ++i) {
            list.addItem(QString::fromStdString("Menu " + std::to_string(i % menuCount) + ' ' + commandText(i)));
        }
        list.sortItems();
        dialog.resize(500, 400);
        dialog.show();
        QApplication::processEvents();
        dialog.repaint();
    }
}

void press(QWidget& widget, int key, const QString& text) {
    QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier, text);
    QApplication::sendEvent(&widget, &event);
}

/// A letter that many commands have comes and goes.
void pressInPalette(benchmark::State& state) {
    prepare();
    auto* frame = new CFrameWnd;
    frame->Create(nullptr, "Frame");
    CMenu bar;
    fill(bar);
    frame->SetMenu(&bar);
    bar.Detach();
    const std::vector<tagACCEL> all = accels();
    frame->m_hAccelTable = CreateAcceleratorTableA(all.data(), commandCount);
    frame->ShowWindow(SW_SHOW);
    QApplication::processEvents();
    Gui_CommandPalette::Open(frame);
    QApplication::processEvents();
    QWidget* field = QApplication::focusWidget();
    bool typed = false;
    for (auto _ : state) {
        typed = !typed;
        typed ? press(*field, Qt::Key_R, QStringLiteral("r")) : press(*field, Qt::Key_Backspace, QStringLiteral("\b"));
        QApplication::processEvents();
        field->window()->repaint();
    }
    DestroyAcceleratorTable(frame->m_hAccelTable);
    frame->DestroyWindow();
}

BENCHMARK(annotate)->Unit(benchmark::kMicrosecond);
BENCHMARK(actionTexts)->Unit(benchmark::kMicrosecond);
BENCHMARK(openDialog)->Unit(benchmark::kMillisecond);
BENCHMARK(listWidget)->Unit(benchmark::kMillisecond);
BENCHMARK(pressInPalette)->Unit(benchmark::kMillisecond);

} // namespace
