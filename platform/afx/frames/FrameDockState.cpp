#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Placement.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/DockState.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/frames/detail/BarWindow.h"

#include <QLayout>
#include <QMainWindow>
#include <QToolBar>

#include <algorithm>
#include <limits>
#include <memory>
#include <tuple>

using namespace tvx::afx;

// The bars of a frame as a state that can be kept, and back.

namespace {

/// Where a tool bar stands in the frame's layout, or stood before it floated.
struct DockPlace {
    QToolBar* bar = nullptr;
    UINT side = 0;
    int row = 0;
    int place = 0;
};

/// All tool bars side by side and row by row, as the toolkit's layout has them.
std::vector<DockPlace> dockPlaces(const QMainWindow& main) {
    std::vector<DockPlace> places;
    for (int i = 0; const QLayoutItem* item = main.layout()->itemAt(i); ++i) {
        auto* bar = qobject_cast<QToolBar*>(item->widget());
        if (!bar) {
            continue;
        }
        DockPlace next{bar, dockBarOf(main.toolBarArea(bar)), 0, 0};
        if (!places.empty() && places.back().side == next.side) {
            const bool newRow = main.toolBarBreak(bar);
            next.row = places.back().row + (newRow ? 1 : 0);
            next.place = newRow ? 0 : places.back().place + 1;
        }
        places.push_back(next);
    }
    return places;
}

/// Takes all tool bars out of the layout and puts them back in the order of their places.
void arrangeBars(QMainWindow& main, std::vector<DockPlace>& places) {
    std::stable_sort(places.begin(), places.end(), [](const DockPlace& a, const DockPlace& b) {
        return std::tie(a.side, a.row, a.place) < std::tie(b.side, b.row, b.place);
    });
    std::vector<bool> shown;
    for (const DockPlace& each : places) {
        shown.push_back(!each.bar->isHidden());
        main.removeToolBarBreak(each.bar);
        main.removeToolBar(each.bar);
    }
    for (std::size_t i = 0; i < places.size(); ++i) {
        const Qt::ToolBarArea area = areaOf(places[i].side);
        main.addToolBar(area, places[i].bar);
        if (i > 0 && places[i - 1].side == places[i].side && places[i - 1].row != places[i].row) {
            main.insertToolBarBreak(places[i].bar);
        }
        places[i].bar->setVisible(shown[i]);
    }
}

/// The records of the frame's own bars, each bar once.
std::vector<const CControlBarInfo*> ownRecords(CFrameWnd& frame, const CDockState& state) {
    std::vector<const CControlBarInfo*> records;
    std::vector<const CControlBar*> seen;
    for (INT_PTR i = 0; i < state.m_arrBarInfo.GetSize(); ++i) {
        const auto* info = static_cast<const CControlBarInfo*>(state.m_arrBarInfo[i]);
        const CControlBar* bar = info ? frame.GetControlBar(info->m_nBarID) : nullptr;
        if (bar && std::find(seen.begin(), seen.end(), bar) == seen.end()) {
            records.push_back(info);
            seen.push_back(bar);
        }
    }
    return records;
}

} // namespace

void CFrameWnd::GetDockState(CDockState& state) const {
    state.Clear();
    const Window* window = GetState();
    const QMainWindow* main = window ? mainWindowOf(*window) : nullptr;
    const auto places = main ? dockPlaces(*main) : std::vector<DockPlace>();
    for (CControlBar* bar : m_bars) {
        auto info = std::make_unique<CControlBarInfo>();
        info->m_pBar = bar;
        info->m_nBarID = static_cast<UINT>(bar->GetDlgCtrlID());
        info->m_bVisible = bar->IsVisible();
        info->m_bFloating = bar->IsFloating();
        const QToolBar* tools = toolsOf(*bar);
        const auto place = std::find_if(places.begin(), places.end(), [&](const auto& at) { return at.bar == tools; });
        if (place != places.end()) {
            info->m_uMRUDockID = place->side;
            info->m_nRow = place->row;
            info->m_nPlace = place->place;
        }
        if (info->m_bFloating) {
            const QPoint at = placeOfFloating(*tools);
            info->m_pointPos = CPoint(at.x(), at.y());
        }
        state.m_arrBarInfo.Add(info.release());
    }
}

void CFrameWnd::SetDockState(const CDockState& state) {
    const auto records = ownRecords(*this, state);
    dockBars(records);
    for (const CControlBarInfo* info : records) {
        CControlBar* bar = GetControlBar(info->m_nBarID);
        if (!bar) {
            continue; // a handler of the ones before has ended it
        }
        const QToolBar* tools = toolsOf(*bar);
        if (tools && info->m_bFloating && bar->m_dockable) {
            const QRect place =
                reachableFrame(QRect(QPoint(info->m_pointPos.x, info->m_pointPos.y), tools->sizeHint()));
            FloatControlBar(bar, CPoint(place.x(), place.y()));
        }
        ShowControlBar(bar, info->m_bVisible, FALSE);
    }
}

/// Docks the bars as their records say; bars without one stand behind them.
void CFrameWnd::dockBars(const std::vector<const CControlBarInfo*>& records) {
    // Half the range, so that the rows of bars without a record can be added to it.
    constexpr int behindAll = std::numeric_limits<int>::max() / 2;
    const Window* window = GetState();
    QMainWindow* main = window ? mainWindowOf(*window) : nullptr;
    if (!main) {
        return;
    }
    auto places = dockPlaces(*main);
    for (DockPlace& each : places) {
        each.row += behindAll;
    }
    for (const CControlBarInfo* info : records) {
        const CControlBar* bar = GetControlBar(info->m_nBarID);
        const auto place =
            std::find_if(places.begin(), places.end(), [&](const auto& at) { return at.bar == toolsOf(*bar); });
        if (place == places.end()) {
            continue;
        }
        const bool allowed = (sideOfDockBar(info->m_uMRUDockID) & m_dockSides & bar->GetDockSides()) != 0;
        place->side = allowed ? info->m_uMRUDockID : place->side;
        place->row = std::clamp(info->m_nRow, 0, behindAll - 1);
        place->place = info->m_nPlace;
    }
    std::erase_if(places, [](const DockPlace& each) { return each.row >= behindAll && each.bar->isFloating(); });
    guarded([&] { arrangeBars(*main, places); });
}

void CFrameWnd::LoadBarState(LPCSTR profileName) {
    CDockState state;
    state.LoadState(profileName);
    SetDockState(state);
}

void CFrameWnd::SaveBarState(LPCSTR profileName) const {
    CDockState state;
    GetDockState(state);
    state.SaveState(profileName);
}
