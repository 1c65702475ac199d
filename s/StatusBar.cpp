#include "s/StatusBar.h"

#include "s/Record.h"
#include "s/StringOf.h"

#include <cstddef>
#include <vector>

struct Gui_StatusBar::Record {
    std::vector<UINT> tips; ///< the string of each pane's tip, 0 for none
    CToolTipCtrl control;   ///< its tools are the panes: index + 1
    unsigned char enabled = 0;
};

// clang-format off
BEGIN_MESSAGE_MAP(Gui_StatusBar, CStatusBar)
    ON_WM_SIZE()
END_MESSAGE_MAP()
// clang-format on

namespace {

UINT_PTR toolOf(int pane) {
    return static_cast<UINT_PTR>(pane) + 1;
}

/// Where a pane is; empty, so that no pointer is in it, for one that there is not yet.
CRect placeOf(const CStatusBar& bar, int pane) {
    CRect place(0, 0, 0, 0);
    bar.SendMessage(SB_GETRECT, static_cast<WPARAM>(pane), reinterpret_cast<LPARAM>(&place));
    return place;
}

int widthOf(const CStatusBar& bar, const CString& text) {
    CClientDC screen(nullptr);
    CFont* font = bar.GetFont();
    CFont* before = font ? screen.SelectObject(font) : nullptr;
    const int width = screen.GetTextExtent(text).cx;
    if (before) {
        screen.SelectObject(before);
    }
    return width;
}

} // namespace

Gui_StatusBar::Gui_StatusBar() : m_record(MakeRecord<Record>()) {}

Gui_StatusBar::~Gui_StatusBar() = default;

// --- tips ---

/// The control ends with the bar's window, and the tips with it.
bool Gui_StatusBar::hasToolTips() const {
    return m_record->control.m_hWnd;
}

int Gui_StatusBar::SetToolTips(const unsigned int* ids, unsigned short count) {
    Record& record = *m_record;
    record.control.DestroyWindow();
    if (!record.control.Create(this)) {
        return 0;
    }
    record.tips.assign(ids, ids + count);
    for (int pane = 0; pane < count; ++pane) {
        if (const UINT id = record.tips[static_cast<std::size_t>(pane)]; id != 0) {
            const CRect place = placeOf(*this, pane);
            record.control.AddTool(this, StringOf(id), &place, toolOf(pane));
        }
    }
    record.control.Activate(TRUE);
    record.enabled = 1;
    return 1;
}

void Gui_StatusBar::placeTools() {
    Record& record = *m_record;
    if (!hasToolTips() || record.enabled == 0) {
        return;
    }
    for (std::size_t pane = 0; pane < record.tips.size(); ++pane) {
        if (record.tips[pane] != 0) {
            const CRect place = placeOf(*this, static_cast<int>(pane));
            record.control.SetToolRect(this, toolOf(static_cast<int>(pane)), &place);
        }
    }
}

void Gui_StatusBar::EnableTooltips(unsigned char enable) {
    if (m_record->enabled == enable) {
        return;
    }
    m_record->enabled = enable;
    m_record->control.Activate(enable != 0);
    if (enable == 1) {
        placeTools();
    }
}

void Gui_StatusBar::ReactivateTooltips() {
    if (m_record->enabled != 0) {
        m_record->control.Activate(TRUE);
    }
}

void Gui_StatusBar::ChangeTooltipText(int pane, const char* text) {
    m_record->control.UpdateTipText(text, this, toolOf(pane));
}

void Gui_StatusBar::ChangeTooltipText(int pane, unsigned int id) {
    ChangeTooltipText(pane, StringOf(id));
}

// --- panes ---

BOOL Gui_StatusBar::SetPaneText(int pane, LPCSTR text, BOOL update) {
    return CStatusBar::SetPaneText(pane, text, update);
}

BOOL Gui_StatusBar::SetPaneText(int pane, unsigned int id, BOOL update) {
    return SetPaneText(pane, StringOf(id), update);
}

BOOL Gui_StatusBar::SetPaneTextEx(int pane, const char* text, BOOL update) {
    UINT id = 0;
    UINT style = 0;
    int width = 0;
    GetPaneInfo(pane, id, style, width);
    if (const int wanted = widthOf(*this, text) + 2; wanted != width) {
        SetPaneInfo(pane, id, style, wanted);
    }
    return SetPaneText(pane, text, update);
}

BOOL Gui_StatusBar::SetPaneTextEx(int pane, unsigned int id, BOOL update) {
    return SetPaneTextEx(pane, StringOf(id), update);
}

void Gui_StatusBar::SetPaneInfo(int pane, unsigned int id, unsigned int style, int width) {
    CStatusBar::SetPaneInfo(pane, id, style, width);
    placeTools();
}

// --- messages ---

BOOL Gui_StatusBar::PreTranslateMessage(MSG* message) {
    if (hasToolTips() && m_record->enabled != 0) {
        m_record->control.RelayEvent(message);
    }
    return CStatusBar::PreTranslateMessage(message);
}

void Gui_StatusBar::OnUpdateCmdUI(CFrameWnd* target, BOOL disable) {
    ReactivateTooltips();
    CStatusBar::OnUpdateCmdUI(target, disable);
}

void Gui_StatusBar::OnSize(UINT type, int width, int height) {
    CStatusBar::OnSize(type, width, height);
    placeTools();
}
