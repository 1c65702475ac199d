// Where the bars of a frame stand, taken and given back, and kept in the profile.
#include "platform/afx/frames/DockState.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/frames/StatusBar.h"
#include "platform/afx/frames/ToolBar.h"
#include "platform/afx/gdi/Gdi.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/frames/SettingsFolder.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QMainWindow>
#include <QTest>

#include <memory>
#include <string>

namespace {

constexpr UINT firstBarId = AFX_IDW_CONTROLBAR_FIRST + 40;

/// A frame with tool bars A, B, C (and D where asked for) and a status bar.
class BarFrame : public CFrameWnd {
public:
    explicit BarFrame(int count) {
        EXPECT_TRUE(Create(nullptr, "Bars", WS_OVERLAPPEDWINDOW, CRect(50, 50, 650, 450)));
        EXPECT_TRUE(status.Create(this));
        EnableDocking(CBRS_ALIGN_ANY);
        for (int i = 0; i < count; ++i) {
            CToolBar& bar = bars[i];
            EXPECT_TRUE(bar.CreateEx(this, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP, CRect(), firstBarId + i));
            const UINT commands[] = {100, 101};
            bar.SetButtons(commands, 2);
            bar.EnableDocking(CBRS_ALIGN_ANY);
            DockControlBar(&bar);
        }
    }
    void open() {
        ShowWindow(SW_SHOW);
        EXPECT_TRUE(QTest::qWaitForWindowExposed(tvx::afx::mainWindowOf(*GetState())));
    }
    std::string layout() const {
        CDockState state;
        GetDockState(state);
        return describe(state);
    }
    static std::string describe(const CDockState& state);

    CToolBar bars[4];
    CStatusBar status;

protected:
    void PostNcDestroy() override {}
};

std::string sideName(UINT side) {
    switch (side) {
    case AFX_IDW_DOCKBAR_TOP:
        return "top";
    case AFX_IDW_DOCKBAR_LEFT:
        return "left";
    case AFX_IDW_DOCKBAR_RIGHT:
        return "right";
    case AFX_IDW_DOCKBAR_BOTTOM:
        return "bottom";
    default:
        return "nowhere";
    }
}

/// One bar as "A:top0.1", hidden ones in small letters, floating ones with "*" and their corner.
std::string BarFrame::describe(const CDockState& state) {
    std::string text;
    for (INT_PTR i = 0; i < state.m_arrBarInfo.GetSize(); ++i) {
        const auto& info = *static_cast<const CControlBarInfo*>(state.m_arrBarInfo[i]);
        if (info.m_nBarID < firstBarId) {
            continue;
        }
        text += text.empty() ? "" : " ";
        text += static_cast<char>((info.m_bVisible ? 'A' : 'a') + (info.m_nBarID - firstBarId));
        text += ":" + sideName(info.m_uMRUDockID) + std::to_string(info.m_nRow) + "." + std::to_string(info.m_nPlace);
        if (info.m_bFloating) {
            text += "*" + std::to_string(info.m_pointPos.x) + "," + std::to_string(info.m_pointPos.y);
        }
    }
    return text;
}

class DockState : public testing::Test {
protected:
    void SetUp() override {
        testApplication.SetRegistryKey("Maker");
        reopen();
    }
    /// A new frame as it comes up at first.
    void reopen(int count = 3) {
        if (frame) {
            frame->DestroyWindow();
        }
        frame = std::make_unique<BarFrame>(count);
    }
    void TearDown() override {
        frame->DestroyWindow();
    }
    /// All over the place: B left, C floating, A hidden.
    void scatter() {
        frame->open();
        frame->DockControlBar(&frame->bars[1], AFX_IDW_DOCKBAR_LEFT);
        frame->FloatControlBar(&frame->bars[2], CPoint(300, 260));
        frame->ShowControlBar(&frame->bars[0], FALSE, FALSE);
        ASSERT_EQ(frame->layout(), scattered);
    }
    static constexpr const char* scattered = "a:top0.0 B:left0.0 C:top0.1*300,260";
    static void write(const char* section, const char* entry, const char* value) {
        EXPECT_TRUE(testApplication.WriteProfileString(section, entry, value));
    }

    SettingsFolder settings;
    std::unique_ptr<BarFrame> frame;
};

} // namespace

TEST_F(DockState, ComesBackInAnotherFrame) {
    ASSERT_EQ(frame->layout(), "A:top0.0 B:top0.1 C:top0.2");
    scatter();
    frame->ShowControlBar(&frame->status, FALSE, FALSE);
    frame->SaveBarState("Bars");
    reopen();
    frame->open();
    frame->LoadBarState("Bars");
    EXPECT_EQ(frame->layout(), scattered);
    EXPECT_FALSE(frame->status.IsVisible());
    EXPECT_TRUE(frame->bars[2].IsFloating());
    EXPECT_TRUE(frame->bars[2].GetState()->widget()->isVisible());
    CRect left;
    frame->bars[1].GetWindowRect(left);
    EXPECT_GT(left.Height(), left.Width());
}

TEST_F(DockState, KeepsRowsAndTheOrderInThem) {
    CDockState state;
    frame->GetDockState(state);
    const auto record = [&](UINT index) {
        for (INT_PTR i = 0; i < state.m_arrBarInfo.GetSize(); ++i) {
            auto* info = static_cast<CControlBarInfo*>(state.m_arrBarInfo[i]);
            if (info->m_nBarID == firstBarId + index) {
                return info;
            }
        }
        return static_cast<CControlBarInfo*>(nullptr);
    };
    record(2)->m_nRow = record(2)->m_nPlace = 0;
    record(0)->m_nRow = 1;
    record(1)->m_nRow = record(1)->m_nPlace = 1;
    frame->SetDockState(state);
    EXPECT_EQ(frame->layout(), "A:top1.0 B:top1.1 C:top0.0");
    frame->open();
    frame->ShowControlBar(&frame->bars[0], FALSE, FALSE);
    EXPECT_EQ(frame->layout(), "a:top1.0 B:top1.1 C:top0.0") << "a hidden bar keeps its place";
    CRect second;
    frame->bars[1].GetWindowRect(second);
    CRect first;
    frame->bars[2].GetWindowRect(first);
    EXPECT_GE(second.top, first.bottom);
}

TEST_F(DockState, LoadedBeforeTheFrameIsShownFloatingBarsWaitForIt) {
    scatter();
    frame->SaveBarState("Bars");
    reopen();
    frame->LoadBarState("Bars");
    const QWidget* floating = frame->bars[2].GetState()->widget();
    EXPECT_TRUE(frame->bars[2].IsFloating());
    EXPECT_FALSE(floating->isVisible());
    frame->open();
    EXPECT_TRUE(QTest::qWaitFor([&] { return floating->isVisible(); }));
    EXPECT_EQ(frame->layout(), scattered);
}

TEST_F(DockState, BarsAddedSinceStandBehindAndGoneOnesAreForgotten) {
    scatter();
    frame->SaveBarState("Bars");
    reopen(4);
    frame->LoadBarState("Bars");
    EXPECT_EQ(frame->layout().substr(0, 19), std::string(scattered).substr(0, 19));
    EXPECT_EQ(frame->layout().substr(frame->layout().rfind(' ') + 1), "D:top1.0");
    frame->SaveBarState("Bars");
    reopen(2);
    frame->LoadBarState("Bars");
    EXPECT_EQ(frame->layout(), "a:top0.0 B:left0.0");
}

TEST_F(DockState, DamagedRecordsDoNoHarm) {
    const std::string initial = frame->layout();
    frame->LoadBarState("Nothing");
    EXPECT_EQ(frame->layout(), initial);
    for (const char* count : {"-1", "99999999", "three", "4294967297", ""}) {
        write("Bars-Summary", "Bars", count);
        frame->LoadBarState("Bars");
        EXPECT_EQ(frame->layout(), initial) << count;
    }
    write("Bars-Summary", "Bars", "3"); // the first is missing, the others are nonsense
    write("Bars-Bar1", "BarID", "nonsense");
    write("Bars-Bar2", "BarID", std::to_string(firstBarId).c_str());
    write("Bars-Bar2", "MRUDockID", "7");
    write("Bars-Bar2", "Row", "-2147483648");
    write("Bars-Bar2", "Place", "2147483647");
    frame->LoadBarState("Bars");
    EXPECT_EQ(frame->layout(), "A:top0.0 B:top1.0 C:top1.1") << "the side stays, the row counts";
    CDockState state;
    state.LoadState("Bars");
    ASSERT_EQ(state.m_arrBarInfo.GetSize(), 3);
    EXPECT_EQ(state.m_arrBarInfo[0], nullptr);
    EXPECT_EQ(state.m_arrBarInfo[1], nullptr);
}

TEST_F(DockState, AFloatingBarOffTheScreenComesBackToIt) {
    frame->open();
    CDockState state;
    frame->GetDockState(state);
    auto& info = *static_cast<CControlBarInfo*>(state.m_arrBarInfo[1]);
    ASSERT_EQ(info.m_nBarID, firstBarId);
    info.m_bFloating = TRUE;
    info.m_pointPos = CPoint(90000, -70000);
    frame->SetDockState(state);
    CRect rect;
    frame->bars[0].GetWindowRect(rect);
    EXPECT_TRUE(
        CRect(0, 0, ::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN)).PtInRect(rect.CenterPoint()));
}

TEST_F(DockState, BarsThatMayNotDockElsewhereStay) {
    frame->bars[0].EnableDocking(CBRS_ALIGN_TOP);
    CDockState state;
    frame->GetDockState(state);
    static_cast<CControlBarInfo*>(state.m_arrBarInfo[1])->m_uMRUDockID = AFX_IDW_DOCKBAR_LEFT;
    static_cast<CControlBarInfo*>(state.m_arrBarInfo[2])->m_uMRUDockID = AFX_IDW_DOCKBAR_LEFT;
    frame->SetDockState(state);
    EXPECT_EQ(frame->bars[0].GetDockSide(), UINT{AFX_IDW_DOCKBAR_TOP});
    EXPECT_EQ(frame->bars[1].GetDockSide(), UINT{AFX_IDW_DOCKBAR_LEFT});
}
