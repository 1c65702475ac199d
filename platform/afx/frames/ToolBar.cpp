#include "platform/afx/frames/ToolBar.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/detail/BarWindow.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/ButtonImages.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/Resource.h"
#include "platform/win/ToolBarTemplate.h"

#include <QLayout>
#include <QPixmap>
#include <QToolBar>
#include <QToolButton>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CToolBar, CControlBar)

// clang-format off
BEGIN_MESSAGE_MAP(CToolBar, CControlBar)
    ON_WM_DESTROY()
    ON_MESSAGE(WM_HELPHITTEST, &CToolBar::OnHelpHitTest)
END_MESSAGE_MAP()
// clang-format on

namespace {

/// The bits of a creation style that are the bar's, not the window's.
constexpr DWORD barStyles = 0x0040FFFF;
/// Space around a picture in a button.
constexpr int buttonMargin = 7;
/// Separators from this width on make room for a control.
constexpr int placeholderWidth = 9;

QAction* actionAt(const CWnd& bar, int index) {
    const QToolBar* tools = toolsOf(bar);
    const auto actions = tools ? tools->actions() : QList<QAction*>();
    return index >= 0 && index < actions.size() ? actions[index] : nullptr;
}

/// Splits a command's string into the prompt and the tip.
struct CommandText {
    CString prompt;
    CString tip;
    explicit CommandText(UINT id) {
        CString text;
        if (text.LoadString(id)) {
            AfxExtractSubString(prompt, text, 0);
            AfxExtractSubString(tip, text, 1);
        }
    }
};

void addSeparator(QToolBar& tools, int width) {
    if (width < placeholderWidth) {
        tools.addSeparator();
        return;
    }
    auto* place = new QWidget(&tools);
    place->setFixedWidth(width);
    tools.addWidget(place);
}

/// Gives a button the texts of its command. It takes no keyboard: the view keeps it while buttons are clicked.
void dressButton(QToolBar& tools, QAction& action, const CommandText& text, DWORD barStyle) {
    action.setToolTip((barStyle & CBRS_TOOLTIPS) != 0 ? toQt(text.tip) : QString());
    action.setStatusTip((barStyle & CBRS_FLYBY) != 0 ? toQt(text.prompt) : QString());
    action.setMenuRole(QAction::NoRole);
    QWidget* button = tools.widgetForAction(&action);
    button->setFocusPolicy(Qt::NoFocus);
    button->setAccessibleName(toQt(text.tip.IsEmpty() ? text.prompt : text.tip));
}

} // namespace

BOOL CToolBar::Create(CWnd* parent, DWORD style, UINT id) {
    return CreateEx(parent, 0, style, CRect(0, 0, 0, 0), id);
}

BOOL CToolBar::CreateEx(CWnd* parent, DWORD, DWORD style, CRect, UINT id) {
    SetBarStyle(style & barStyles);
    const CString name = nameOfBar(id, TVX_IDS_TOOL_BAR);
    return CWnd::CreateEx(0, "ToolbarWindow32", name, (style & ~barStyles) | WS_CHILD, CRect(0, 0, 0, 0), parent, id);
}

void CToolBar::OnDestroy() {
    if (m_ownBitmap) {
        ::DeleteObject(m_bitmap);
    }
    m_bitmap = nullptr;
    m_ownBitmap = false;
    CControlBar::OnDestroy();
}

// --- buttons and pictures ---

BOOL CToolBar::LoadToolBar(LPCSTR name) {
    const HINSTANCE module = AfxFindResourceHandle(name, RT_TOOLBAR);
    const auto bar = tvx::parseToolBarTemplate(tvx::resourceBytes(module, name, RT_TOOLBAR));
    const HBITMAP bitmap = bar ? ::LoadBitmapA(AfxFindResourceHandle(name, RT_BITMAP), name) : nullptr;
    if (!bitmap) {
        return FALSE;
    }
    SetSizes(CSize(bar->buttonWidth + buttonMargin, bar->buttonHeight + buttonMargin),
             CSize(bar->buttonWidth, bar->buttonHeight));
    SetBitmap(bitmap);
    m_ownBitmap = true;
    const std::vector<UINT> ids(bar->commands.begin(), bar->commands.end());
    return SetButtons(ids.data(), static_cast<int>(ids.size()));
}

BOOL CToolBar::LoadToolBar(UINT id) {
    return LoadToolBar(MAKEINTRESOURCE(id));
}

BOOL CToolBar::LoadBitmap(LPCSTR name) {
    const HBITMAP bitmap = ::LoadBitmapA(AfxFindResourceHandle(name, RT_BITMAP), name);
    if (!bitmap) {
        return FALSE;
    }
    SetBitmap(bitmap);
    m_ownBitmap = true;
    return TRUE;
}

BOOL CToolBar::LoadBitmap(UINT id) {
    return LoadBitmap(MAKEINTRESOURCE(id));
}

BOOL CToolBar::SetBitmap(HBITMAP bitmap) {
    if (m_ownBitmap && m_bitmap != bitmap) {
        ::DeleteObject(m_bitmap);
    }
    m_bitmap = bitmap;
    m_ownBitmap = false;
    rebuild();
    return bitmap ? TRUE : FALSE;
}

BOOL CToolBar::SetButtons(const UINT* ids, int count) {
    m_buttons.assign(static_cast<std::size_t>(std::max(count, 0)), Button());
    int image = 0;
    for (int i = 0; ids && i < count; ++i) {
        Button& button = m_buttons[static_cast<std::size_t>(i)];
        button.id = ids[i];
        button.style = ids[i] == ID_SEPARATOR ? TBBS_SEPARATOR : TBBS_BUTTON;
        button.image = ids[i] == ID_SEPARATOR ? 0 : image++;
    }
    m_nCount = count;
    rebuild();
    return TRUE;
}

void CToolBar::SetSizes(SIZE button, SIZE image) {
    m_buttonSize = button;
    m_imageSize = image;
    rebuild();
}

void CToolBar::SetHeight(int height) {
    if (QToolBar* tools = toolsOf(*this)) {
        guarded([&] { tools->setMinimumHeight(height); });
    }
}

void CToolBar::rebuild() {
    QToolBar* tools = toolsOf(*this);
    if (!tools) {
        return;
    }
    const QImage pictures = buttonImages(m_bitmap);
    guarded([&] {
        tools->clear();
        tools->setIconSize(QSize(m_imageSize.cx, m_imageSize.cy));
        for (const Button& button : m_buttons) {
            if ((button.style & TBBS_SEPARATOR) != 0) {
                addSeparator(*tools, button.image);
                continue;
            }
            QAction* action = tools->addAction(toQt(button.text));
            const QRect part(button.image * m_imageSize.cx, 0, m_imageSize.cx, m_imageSize.cy);
            if (pictures.rect().contains(part)) {
                action->setIcon(buttonIcon(pictures.copy(part)));
            }
            dressButton(*tools, *action, CommandText(button.id), m_dwStyle);
            tools->widgetForAction(action)->setMinimumSize(m_buttonSize.cx, m_buttonSize.cy);
            connectStoring(action, &QAction::triggered, tools, [this, id = button.id] {
                armIdle();
                if (const CWnd* owner = GetOwner()) {
                    owner->SendMessage(WM_COMMAND, MAKEWPARAM(static_cast<int>(id), 0),
                                       reinterpret_cast<LPARAM>(m_hWnd));
                }
            });
        }
    });
    for (int i = 0; i < m_nCount; ++i) {
        showState(i);
    }
}

void CToolBar::showState(int index) {
    QAction* action = actionAt(*this, index);
    const Button& button = m_buttons[static_cast<std::size_t>(index)];
    if (!action || (button.style & TBBS_SEPARATOR) != 0) {
        return;
    }
    guarded([&] {
        action->setVisible((button.style & TBBS_HIDDEN) == 0);
        action->setEnabled((button.style & TBBS_DISABLED) == 0);
        action->setCheckable((button.style & TBBS_CHECKBOX) != 0);
        // The toolkit's buttons have two states; the third one looks pressed.
        action->setChecked((button.style & (TBBS_CHECKED | TBBS_INDETERMINATE)) != 0);
    });
}

int CToolBar::CommandToIndex(UINT id) const {
    for (int i = 0; i < m_nCount; ++i) {
        const Button& button = m_buttons[static_cast<std::size_t>(i)];
        if (button.id == id && (id != ID_SEPARATOR || (button.style & TBBS_SEPARATOR) != 0)) {
            return i;
        }
    }
    return -1;
}

UINT CToolBar::GetItemID(int index) const {
    return has(index) ? m_buttons[static_cast<std::size_t>(index)].id : 0;
}

void CToolBar::GetItemRect(int index, RECT* rect) const {
    *rect = CRect(0, 0, 0, 0);
    QAction* action = actionAt(*this, index);
    QToolBar* tools = toolsOf(*this);
    if (!action) {
        return;
    }
    if (!tools->isVisible()) {
        // The toolkit lays out what is shown; hosts place controls before.
        tools->layout()->setGeometry(QRect(QPoint(0, 0), tools->sizeHint()));
    }
    if (const QWidget* widget = tools->widgetForAction(action)) {
        *rect = fromQt(widget->geometry());
    }
}

UINT CToolBar::GetButtonStyle(int index) const {
    return has(index) ? m_buttons[static_cast<std::size_t>(index)].style : 0;
}

void CToolBar::SetButtonStyle(int index, UINT style) {
    if (!has(index)) {
        return;
    }
    UINT& place = m_buttons[static_cast<std::size_t>(index)].style;
    const UINT old = std::exchange(place, style);
    if (((old ^ style) & TBBS_SEPARATOR) != 0) {
        rebuild();
    } else if (old != style) {
        showState(index);
    }
}

void CToolBar::GetButtonInfo(int index, UINT& id, UINT& style, int& image) const {
    const Button button = has(index) ? m_buttons[static_cast<std::size_t>(index)] : Button();
    id = button.id;
    style = button.style;
    image = button.image;
}

void CToolBar::SetButtonInfo(int index, UINT id, UINT style, int image) {
    if (!has(index)) {
        return;
    }
    Button& button = m_buttons[static_cast<std::size_t>(index)];
    button.id = id;
    button.style = style;
    button.image = image;
    rebuild();
}

BOOL CToolBar::SetButtonText(int index, LPCSTR text) {
    if (!has(index)) {
        return FALSE;
    }
    m_buttons[static_cast<std::size_t>(index)].text = text ? text : "";
    bool texts = false;
    for (const Button& button : m_buttons) {
        texts = texts || !button.text.IsEmpty();
    }
    if (QToolBar* tools = toolsOf(*this)) {
        tools->setToolButtonStyle(texts ? Qt::ToolButtonTextUnderIcon : Qt::ToolButtonIconOnly);
    }
    rebuild();
    return TRUE;
}

CString CToolBar::GetButtonText(int index) const {
    return has(index) ? m_buttons[static_cast<std::size_t>(index)].text : CString();
}

CSize CToolBar::CalcFixedLayout(BOOL stretch, BOOL horizontal) {
    return CControlBar::CalcFixedLayout(stretch, horizontal);
}

// --- buttons by their commands ---

bool CToolBarCtrl::has(int id, UINT state) const {
    return (m_bar.GetButtonStyle(m_bar.CommandToIndex(static_cast<UINT>(id))) & state) != 0;
}

BOOL CToolBarCtrl::change(int id, UINT state, bool on) {
    const int index = m_bar.CommandToIndex(static_cast<UINT>(id));
    const UINT style = m_bar.GetButtonStyle(index);
    m_bar.SetButtonStyle(index, on ? style | state : style & ~state);
    return index >= 0;
}

BOOL CToolBarCtrl::EnableButton(int id, BOOL enable) {
    return change(id, TBBS_DISABLED, !enable);
}

BOOL CToolBarCtrl::CheckButton(int id, BOOL check) {
    return change(id, TBBS_CHECKBOX, true) && change(id, TBBS_CHECKED, check != FALSE);
}

BOOL CToolBarCtrl::HideButton(int id, BOOL hide) {
    return change(id, TBBS_HIDDEN, hide != FALSE);
}

BOOL CToolBarCtrl::IsButtonEnabled(int id) const {
    return m_bar.CommandToIndex(static_cast<UINT>(id)) >= 0 && !has(id, TBBS_DISABLED);
}

BOOL CToolBarCtrl::IsButtonChecked(int id) const {
    return has(id, TBBS_CHECKED);
}

BOOL CToolBarCtrl::IsButtonHidden(int id) const {
    return has(id, TBBS_HIDDEN);
}

int CToolBarCtrl::GetButtonCount() const {
    return m_bar.GetCount();
}

// --- states ---

namespace {

class ButtonState : public CCmdUI {
public:
    void Enable(BOOL on) override {
        m_bEnableChanged = TRUE;
        change(TBBS_DISABLED, on ? 0U : TBBS_DISABLED);
    }
    void SetCheck(int check) override {
        const UINT state = check == 1 ? TBBS_CHECKED : check == 2 ? TBBS_INDETERMINATE : 0U;
        change(TBBS_CHECKED | TBBS_INDETERMINATE, state | TBBS_CHECKBOX);
    }
    void SetRadio(BOOL on) override {
        SetCheck(on ? 1 : 0);
    }
    void SetText(LPCSTR) override {} // handlers mean the menu item

private:
    void change(UINT remove, UINT add) {
        auto& bar = static_cast<CToolBar&>(*m_pOther);
        const auto index = static_cast<int>(m_nIndex);
        bar.SetButtonStyle(index, (bar.GetButtonStyle(index) & ~remove) | add);
    }
};

} // namespace

void CToolBar::OnUpdateCmdUI(CFrameWnd* target, BOOL disable) {
    ButtonState state;
    state.m_pOther = this;
    state.m_nIndexMax = static_cast<UINT>(m_nCount);
    for (state.m_nIndex = 0; state.m_nIndex < static_cast<UINT>(m_nCount); ++state.m_nIndex) {
        const auto index = static_cast<int>(state.m_nIndex);
        state.m_nID = GetItemID(index);
        if ((GetButtonStyle(index) & TBBS_SEPARATOR) != 0 ||
            CWnd::OnCmdMsg(state.m_nID, CN_UPDATE_COMMAND_UI, &state, nullptr)) {
            continue; // a bar may have update handlers of its own
        }
        state.DoUpdate(target, disable);
    }
    UpdateDialogControls(target, disable);
}
