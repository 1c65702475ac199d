// What the states of 2,000 commands cost that have not changed: of a tool bar when the application is idle, of a menu
// that opens. Beside them what the toolkit's own commands cost that are told the state they have.

#include "afxext.h"
#include "afxwin.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QAction>
#include <QToolBar>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <memory>
#include <vector>

namespace {

CWinApp benchApplication("KeyboardBench");
constexpr UINT firstCommand = 0x8100;
constexpr int commandCount = 2000;

/// Has a handler for all of the commands, behind ten entries of others.
class BenchFrame : public CFrameWnd {
public:
    afx_msg void OnCommand() {}
    afx_msg void OnUpdate(CCmdUI* element) {
        element->Enable(TRUE);
    }
    afx_msg void OnUpdateOther(CCmdUI* element) {
        element->Enable(FALSE);
    }
    DECLARE_MESSAGE_MAP()

protected:
    void PostNcDestroy() override {}
};

BEGIN_MESSAGE_MAP(BenchFrame, CFrameWnd)
ON_UPDATE_COMMAND_UI(100, &BenchFrame::OnUpdateOther)
ON_UPDATE_COMMAND_UI(101, &BenchFrame::OnUpdateOther)
ON_UPDATE_COMMAND_UI(102, &BenchFrame::OnUpdateOther)
ON_UPDATE_COMMAND_UI(103, &BenchFrame::OnUpdateOther)
ON_UPDATE_COMMAND_UI(104, &BenchFrame::OnUpdateOther)
ON_COMMAND(100, &BenchFrame::OnCommand)
ON_COMMAND(101, &BenchFrame::OnCommand)
ON_COMMAND(102, &BenchFrame::OnCommand)
ON_COMMAND(103, &BenchFrame::OnCommand)
ON_COMMAND(104, &BenchFrame::OnCommand)
ON_UPDATE_COMMAND_UI_RANGE(firstCommand, firstCommand + commandCount - 1, &BenchFrame::OnUpdate)
END_MESSAGE_MAP()

std::unique_ptr<BenchFrame> makeFrame() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
    auto frame = std::make_unique<BenchFrame>();
    frame->Create(nullptr, "frame");
    return frame;
}

void toolBarStates(benchmark::State& state) {
    const auto frame = makeFrame();
    CToolBar bar;
    bar.Create(frame.get(), WS_CHILD | CBRS_TOP);
    std::vector<UINT> commands;
    for (int i = 0; i < commandCount; ++i) {
        commands.push_back(firstCommand + static_cast<UINT>(i));
    }
    bar.SetButtons(commands.data(), commandCount);
    for (auto _ : state) {
        bar.OnUpdateCmdUI(frame.get(), TRUE);
    }
    frame->DestroyWindow();
}
BENCHMARK(toolBarStates)->Unit(benchmark::kMicrosecond);

void menuStates(benchmark::State& state) {
    const auto frame = makeFrame();
    CMenu menu;
    menu.CreatePopupMenu();
    for (int i = 0; i < commandCount; ++i) {
        menu.AppendMenu(MF_STRING, firstCommand + static_cast<UINT>(i), "&Command\tCtrl+C");
    }
    for (auto _ : state) {
        frame->SendMessage(WM_INITMENUPOPUP, reinterpret_cast<WPARAM>(menu.m_hMenu), 0);
    }
    frame->DestroyWindow();
}
BENCHMARK(menuStates)->Unit(benchmark::kMicrosecond);

void toolkitStates(benchmark::State& state) {
    const auto frame = makeFrame();
    QToolBar bar;
    std::vector<QAction*> actions;
    for (int i = 0; i < commandCount; ++i) {
        actions.push_back(bar.addAction(QStringLiteral("Command")));
    }
    for (auto _ : state) {
        for (QAction* action : actions) {
            action->setEnabled(true);
        }
    }
    frame->DestroyWindow();
}
BENCHMARK(toolkitStates)->Unit(benchmark::kMicrosecond);

void keyNames(benchmark::State& state) {
    const auto frame = makeFrame();
    char name[50];
    for (auto _ : state) {
        for (const int key : {VK_CONTROL, VK_SHIFT, VK_F5, VK_HOME, +'O'}) {
            benchmark::DoNotOptimize(
                GetKeyNameText(static_cast<LONG>(MapVirtualKey(static_cast<UINT>(key), 0) << 16), name, sizeof(name)));
        }
    }
    frame->DestroyWindow();
}
BENCHMARK(keyNames)->Unit(benchmark::kMicrosecond);

void keyPress(benchmark::State& state) {
    const auto frame = makeFrame();
    std::vector<ACCEL> entries;
    for (int i = 0; i < commandCount; ++i) {
        entries.push_back({FVIRTKEY | FCONTROL, static_cast<WORD>(0x100 + i), 1});
    }
    const HACCEL table = CreateAcceleratorTable(entries.data(), commandCount);
    MSG message{frame->m_hWnd, WM_KEYDOWN, 'A', 1, 0, {}};
    for (auto _ : state) {
        benchmark::DoNotOptimize(TranslateAccelerator(frame->m_hWnd, table, &message));
    }
    DestroyAcceleratorTable(table);
    frame->DestroyWindow();
}
BENCHMARK(keyPress)->Unit(benchmark::kMicrosecond);

} // namespace
