#include "platform/afx/frames/StatusBar.h"

#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/base/Text.h"

#include <QLabel>
#include <QLayout>
#include <QStatusBar>

#include <cstring>

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
/// Frame and space around a pane's text, both sides.
constexpr int paneBorder = 10;

QStatusBar* barOf(const CWnd& bar) {
    const Window* state = bar.GetState();
    return state ? qobject_cast<QStatusBar*>(state->widget()) : nullptr;
}

/// A pane's label takes the space it is given, whatever its text.
class PaneLabel : public QLabel {
public:
    explicit PaneLabel(QWidget* parent) : QLabel(parent) {
        setObjectName(QStringLiteral("pane"));
    }
    bool stretches = false;
    QSize minimumSizeHint() const override {
        return {0, QLabel::minimumSizeHint().height()};
    }
};

struct PaneShape {
    bool border = true;
    bool stretch = false;
    int width = 0;
};

/// The labels in the order of their panes.
QList<PaneLabel*> labelsOf(const QStatusBar& bar) {
    QList<PaneLabel*> labels;
    for (QLabel* label : bar.findChildren<QLabel*>(QStringLiteral("pane"), Qt::FindDirectChildrenOnly)) {
        labels.append(static_cast<PaneLabel*>(label));
    }
    return labels;
}

QLabel* labelAt(const CWnd& bar, int index) {
    const QStatusBar* widget = barOf(bar);
    const auto labels = widget ? labelsOf(*widget) : QList<PaneLabel*>();
    return index >= 0 && index < labels.size() ? labels[index] : nullptr;
}

} // namespace

BOOL CStatusBar::Create(CWnd* parent, DWORD style, UINT id) {
    return CreateEx(parent, 0, style, id);
}

BOOL CStatusBar::CreateEx(CWnd* parent, DWORD, DWORD style, UINT id) {
    SetBarStyle(style & barStyles);
    return CWnd::CreateEx(0, "msctls_statusbar32", nullptr, (style & ~barStyles) | WS_CHILD, CRect(0, 0, 0, 0), parent,
                          id);
}

BOOL CStatusBar::SetIndicators(const UINT* ids, int count) {
    const QStatusBar* widget = barOf(*this);
    m_panes.assign(static_cast<std::size_t>(std::max(count, 0)), Pane());
    for (int i = 0; ids && i < count; ++i) {
        Pane& pane = m_panes[static_cast<std::size_t>(i)];
        pane.id = ids[i];
        if (pane.id != ID_SEPARATOR) {
            pane.text.LoadString(pane.id);
        }
        pane.width = widget ? widget->fontMetrics().horizontalAdvance(toQt(pane.text)) : 0;
        if (i == 0) {
            pane.style = SBPS_NOBORDERS | (pane.id == ID_SEPARATOR ? SBPS_STRETCH : 0U);
        }
    }
    m_nCount = count;
    showPanes();
    return TRUE;
}

namespace {

/// Gives a label the look of its pane. The toolkit takes the share of free space with the place in the row only, so a
/// label whose share changes is taken out and put back.
void shapePane(QStatusBar& bar, PaneLabel& label, int index, const PaneShape& shape) {
    label.setFrameStyle(shape.border ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
    label.setMinimumWidth(shape.stretch ? 0 : shape.width);
    label.setMaximumWidth(shape.stretch ? QWIDGETSIZE_MAX : shape.width);
    if (std::exchange(label.stretches, shape.stretch) != shape.stretch) {
        bar.removeWidget(&label);
        bar.insertWidget(index, &label, shape.stretch ? 1 : 0);
        label.show();
    }
}

PaneLabel* addLabel(QStatusBar& bar) {
    auto* label = new PaneLabel(&bar);
    label->setTextFormat(Qt::PlainText);
    label->setContentsMargins(2, 0, 2, 0);
    bar.addWidget(label);
    return label;
}

} // namespace

/// Brings the labels into line with the panes. Panes change while the user looks at them and assistive programs hold
/// them, so labels stay as long as their pane does.
void CStatusBar::showPanes() {
    QStatusBar* widget = barOf(*this);
    if (!widget) {
        return;
    }
    guarded([&] {
        auto labels = labelsOf(*widget);
        while (labels.size() > static_cast<qsizetype>(m_panes.size())) {
            delete labels.takeLast();
        }
        while (labels.size() < static_cast<qsizetype>(m_panes.size())) {
            labels.append(addLabel(*widget));
        }
        for (int i = 0; i < m_nCount; ++i) {
            const Pane& pane = m_panes[static_cast<std::size_t>(i)];
            const bool border = (pane.style & (SBPS_NOBORDERS | SBPS_POPOUT)) == 0;
            const bool stretch = (pane.style & SBPS_STRETCH) != 0;
            shapePane(*widget, *labels[i], i, {border, stretch, pane.width + paneBorder});
        }
    });
    for (int i = 0; i < m_nCount; ++i) {
        showPane(i);
    }
}

void CStatusBar::showPane(int index) {
    QLabel* label = labelAt(*this, index);
    const Pane& pane = m_panes[static_cast<std::size_t>(index)];
    if (label) {
        guarded([&] { label->setText((pane.style & SBPS_DISABLED) != 0 ? QString() : toQt(pane.text)); });
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
    const QLabel* label = labelAt(*this, index);
    if (label) {
        barOf(*this)->layout()->activate();
    }
    *rect = label ? fromQt(label->geometry()) : RECT(CRect(0, 0, 0, 0));
}

CString CStatusBar::GetPaneText(int index) const {
    return has(index) ? m_panes[static_cast<std::size_t>(index)].text : CString();
}

void CStatusBar::GetPaneText(int index, CString& text) const {
    text = GetPaneText(index);
}

BOOL CStatusBar::SetPaneText(int index, LPCSTR text, BOOL) {
    if (!has(index)) {
        return FALSE;
    }
    CString& place = m_panes[static_cast<std::size_t>(index)].text;
    if (place != text) {
        place = text;
        showPane(index);
    }
    return TRUE;
}

UINT CStatusBar::GetPaneStyle(int index) const {
    return has(index) ? m_panes[static_cast<std::size_t>(index)].style : 0;
}

void CStatusBar::SetPaneStyle(int index, UINT style) {
    if (!has(index)) {
        return;
    }
    const UINT old = std::exchange(m_panes[static_cast<std::size_t>(index)].style, style);
    if (((old ^ style) & ~UINT{SBPS_DISABLED}) != 0) {
        showPanes();
    } else if (old != style) {
        showPane(index);
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
    showPanes();
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
    void SetText(LPCSTR text) override {
        static_cast<CStatusBar&>(*m_pOther).SetPaneText(static_cast<int>(m_nIndex), text);
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
