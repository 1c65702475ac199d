#include "platform/afx/frames/StatusBar.h"

#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/frames/detail/StatusBarWindow.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <utility>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CStatusBar, CControlBar)

// clang-format off
BEGIN_MESSAGE_MAP(CStatusBar, CControlBar)
    ON_MESSAGE(WM_SETTEXT, &CStatusBar::OnSetText)
    ON_MESSAGE(WM_GETTEXT, &CStatusBar::OnGetText)
    ON_MESSAGE(WM_GETTEXTLENGTH, &CStatusBar::OnGetTextLength)
END_MESSAGE_MAP()
// clang-format on

namespace {

constexpr DWORD barStyles = 0x0040FFFF;

StatusBarWidget* barOf(const CWnd& bar) {
    const auto* state = dynamic_cast<const StatusBarWindow*>(bar.GetState());
    return state && state->widget() ? state->bar() : nullptr;
}

StatusPane* paneOf(const CWnd& bar, int index) {
    const StatusBarWidget* widget = barOf(bar);
    return widget ? widget->pane(index) : nullptr;
}

} // namespace

BOOL CStatusBar::Create(CWnd* parent, DWORD style, UINT id) {
    return CreateEx(parent, 0, style, id);
}

BOOL CStatusBar::CreateEx(CWnd* parent, DWORD, DWORD style, UINT id) {
    SetBarStyle(style & barStyles);
    if (!CWnd::CreateEx(0, "msctls_statusbar32", nullptr, (style & ~barStyles) | WS_CHILD, CRect(0, 0, 0, 0), parent,
                        id)) {
        return FALSE;
    }
    showPanes();
    return TRUE;
}

BOOL CStatusBar::SetIndicators(const UINT* ids, int count) {
    const StatusBarWidget* widget = barOf(*this);
    m_nCount = std::max(count, 0);
    m_panes.assign(static_cast<std::size_t>(m_nCount), Pane());
    for (int i = 0; ids && i < m_nCount; ++i) {
        Pane& pane = m_panes[static_cast<std::size_t>(i)];
        pane.id = ids[i];
        if (pane.id != ID_SEPARATOR) {
            pane.text.LoadString(pane.id);
        }
        pane.width = widget ? QFontMetrics(widget->paneFont()).horizontalAdvance(toQt(pane.text)) : 0;
        if (i == 0) {
            pane.style = SBPS_NOBORDERS | (pane.id == ID_SEPARATOR ? SBPS_STRETCH : 0U);
        }
    }
    showPanes();
    return TRUE;
}

/// Gives the bar's window the panes that there are. Those that stay are changed in place: the user looks at them, and
/// assistive programs hold them.
void CStatusBar::showPanes() {
    StatusBarWidget* widget = barOf(*this);
    if (!widget) {
        return;
    }
    guarded([&] {
        widget->setCount(m_nCount);
        for (int i = 0; i < m_nCount; ++i) {
            const Pane& pane = m_panes[static_cast<std::size_t>(i)];
            widget->pane(i)->setShape(pane.style, pane.width);
            widget->pane(i)->setText(pane.text);
        }
        widget->place();
        widget->update();
    });
}

/// Gives one of them its shape.
void CStatusBar::shapePane(int index) {
    const Pane& pane = m_panes[static_cast<std::size_t>(index)];
    if (StatusBarWidget* widget = barOf(*this)) {
        guarded([&] {
            widget->pane(index)->setShape(pane.style, pane.width);
            widget->place();
        });
    }
}

int CStatusBar::CommandToIndex(UINT id) const {
    for (int i = 0; i < m_nCount; ++i) {
        if (m_panes[static_cast<std::size_t>(i)].id == id) {
            return i;
        }
    }
    return -1;
}

UINT CStatusBar::GetItemID(int index) const {
    return has(index) ? m_panes[static_cast<std::size_t>(index)].id : 0;
}

void CStatusBar::GetItemRect(int index, RECT* rect) const {
    if (!SendMessage(SB_GETRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect))) {
        *rect = CRect(0, 0, 0, 0);
    }
}

CString CStatusBar::GetPaneText(int index) const {
    return has(index) ? m_panes[static_cast<std::size_t>(index)].text : CString();
}

void CStatusBar::GetPaneText(int index, CString& text) const {
    text = GetPaneText(index);
}

BOOL CStatusBar::SetPaneText(int index, LPCSTR text, BOOL update) {
    if (!has(index)) {
        return FALSE;
    }
    StatusBarWidget* widget = barOf(*this);
    StatusPane* pane = widget ? widget->pane(index) : nullptr;
    CString& place = m_panes[static_cast<std::size_t>(index)].text;
    if (place != text) {
        place = text;
        if (pane) {
            pane->setText(place);
        }
    }
    if (pane && update) {
        guarded([&] { widget->showNow(*pane); });
    }
    return TRUE;
}

UINT CStatusBar::GetPaneStyle(int index) const {
    return has(index) ? m_panes[static_cast<std::size_t>(index)].style : 0;
}

void CStatusBar::SetPaneStyle(int index, UINT style) {
    if (has(index) && std::exchange(m_panes[static_cast<std::size_t>(index)].style, style) != style) {
        shapePane(index);
    }
}

void CStatusBar::GetPaneInfo(int index, UINT& id, UINT& style, int& width) const {
    const Pane pane = has(index) ? m_panes[static_cast<std::size_t>(index)] : Pane();
    id = pane.id;
    style = pane.style;
    width = pane.width;
}

void CStatusBar::SetPaneInfo(int index, UINT id, UINT style, int width) {
    if (!has(index)) {
        return;
    }
    Pane& pane = m_panes[static_cast<std::size_t>(index)];
    if (pane.id == id && pane.style == style && pane.width == width) {
        return;
    }
    pane.id = id;
    pane.style = style;
    pane.width = width;
    shapePane(index);
}

CSize CStatusBar::CalcFixedLayout(BOOL stretch, BOOL horizontal) {
    return CControlBar::CalcFixedLayout(stretch, horizontal);
}

// --- texts as a window ---

LRESULT CStatusBar::OnSetText(WPARAM, LPARAM text) {
    return SetPaneText(0, reinterpret_cast<LPCSTR>(text));
}

LRESULT CStatusBar::OnGetTextLength(WPARAM, LPARAM) {
    return GetPaneText(0).GetLength();
}

LRESULT CStatusBar::OnGetText(WPARAM size, LPARAM buffer) {
    const CString text = GetPaneText(0);
    if (size == 0 || buffer == 0) {
        return 0;
    }
    return static_cast<LRESULT>(tvx::text::copyCut(text.View(), reinterpret_cast<char*>(buffer), size));
}

// --- states ---

namespace {

class PaneState : public CCmdUI {
public:
    void Enable(BOOL on) override {
        m_bEnableChanged = TRUE;
        change(SBPS_DISABLED, on ? 0U : SBPS_DISABLED);
    }
    void SetCheck(int check) override {
        change(SBPS_POPOUT, check != 0 ? SBPS_POPOUT : 0U);
    }
    void SetRadio(BOOL on) override {
        SetCheck(on ? 1 : 0);
    }
    /// The panes are painted together, behind the round of updates.
    void SetText(LPCSTR text) override {
        auto& bar = static_cast<CStatusBar&>(*m_pOther);
        bar.SetPaneText(static_cast<int>(m_nIndex), text, FALSE);
        if (StatusPane* pane = paneOf(bar, static_cast<int>(m_nIndex))) {
            pane->showSoon();
        }
    }

private:
    void change(UINT remove, UINT add) {
        auto& bar = static_cast<CStatusBar&>(*m_pOther);
        const auto index = static_cast<int>(m_nIndex);
        bar.SetPaneStyle(index, (bar.GetPaneStyle(index) & ~remove) | add);
    }
};

} // namespace

void CStatusBar::OnUpdateCmdUI(CFrameWnd* target, BOOL disable) {
    PaneState state;
    state.m_pOther = this;
    state.m_nIndexMax = static_cast<UINT>(m_nCount);
    for (state.m_nIndex = 0; state.m_nIndex < static_cast<UINT>(m_nCount); ++state.m_nIndex) {
        state.m_nID = GetItemID(static_cast<int>(state.m_nIndex));
        if (!CWnd::OnCmdMsg(state.m_nID, CN_UPDATE_COMMAND_UI, &state, nullptr)) {
            state.DoUpdate(target, FALSE);
        }
    }
    UpdateDialogControls(target, disable);
}
