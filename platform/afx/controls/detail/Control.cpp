#include "platform/afx/controls/detail/Control.h"

#include "platform/afx/controls/detail/StaticWindow.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QApplication>
#include <QFrame>
#include <QPainter>

#include <algorithm>

namespace tvx::afx {

namespace {

QColor fromColorRef(COLORREF color) {
    return QColor(GetRValue(color), GetGValue(color), GetBValue(color));
}

COLORREF toColorRef(const QColor& color) {
    return RGB(color.red(), color.green(), color.blue());
}

/// The context that parents set colours in; nothing is ever drawn with it.
HDC colorContext() {
    static const HDC dc = CreateCompatibleDC(nullptr);
    return dc;
}

} // namespace

QFont toolkitFont(HFONT font) {
    const auto tool = findTool<FontObject>(reinterpret_cast<HGDIOBJ>(font));
    return controlFont(tool ? tool->description : pointFont(80, "MS Shell Dlg"));
}

void Control::widgetMade() {
    // Earlier controls lie over later ones, unlike in the toolkit: a group box must not cover what stands before it.
    widget()->lower();
    applyFocusPolicy();
    fontChanged();
    const auto& siblings = parent()->children();
    if (takesFocus() && siblings.size() > 1) {
        if (auto* label = dynamic_cast<StaticWindow*>(siblings[siblings.size() - 2])) {
            label->labelFor(*this);
        }
    }
}

void Control::applyFocusPolicy() {
    const bool tab = (style() & WS_TABSTOP) != 0;
    QWidget* target = focusWidget();
    target->setFocusPolicy(!takesFocus() ? Qt::NoFocus : tab ? Qt::StrongFocus : Qt::ClickFocus);
}

void Control::styleChanged(DWORD oldStyle, DWORD) {
    if (((oldStyle ^ style()) & WS_TABSTOP) != 0) {
        applyFocusPolicy();
    }
}

void Control::fontChanged() {
    guarded([this] { widget()->setFont(toolkitFont(font)); });
}

void Control::notify(int code) {
    // What the handler changes may change the states of commands.
    armIdle();
    if (parent() && !isDestroyed()) {
        SendMessageA(parent()->handle(), WM_COMMAND, MAKEWPARAM(id(), code), reinterpret_cast<LPARAM>(handle()));
    }
}

UINT Control::dialogCode(const MSG*) const {
    return DLGC_STATIC;
}

UINT Control::colorMessage() const {
    return WM_CTLCOLORSTATIC;
}

// --- colours ---

Control::Colors Control::chosenColors() const {
    const HDC dc = colorContext();
    const auto context = findContext(dc);
    if (!parent() || !context) {
        return {};
    }
    const QPalette palette = QApplication::palette(widget());
    context->state.textColor = toColorRef(palette.color(QPalette::WindowText));
    context->state.backColor = toColorRef(palette.color(QPalette::Window));
    context->state.backMode = OPAQUE;
    const LRESULT answer = SendMessageA(parent()->handle(), colorMessage(), reinterpret_cast<WPARAM>(dc),
                                        reinterpret_cast<LPARAM>(handle()));
    const auto brush = findTool<BrushObject>(reinterpret_cast<HGDIOBJ>(answer));
    if (!brush) {
        return {};
    }
    Colors colors{true, fromColorRef(context->state.textColor).rgb(), 0};
    // Any other brush, such as the hollow one, leaves the background transparent.
    if (brush->description.lbStyle == BS_SOLID) {
        const bool system = brush->systemColor >= 0;
        colors.background = fromColorRef(system ? GetSysColor(brush->systemColor) : brush->description.lbColor).rgb();
    }
    return colors;
}

void Control::askColors() {
    const HWND self = handle();
    const Colors colors = chosenColors();
    // This runs in each paint request; setting a palette asks for another one.
    if (!from(self) || colors == m_colors) {
        return;
    }
    m_colors = colors;
    applyPalette();
}

/// Names the chosen colours only: all others go on following the desktop's.
void Control::applyPalette() {
    QPalette palette = ownPalette();
    if (m_colors.chosen) {
        applyColors(palette, QColor(m_colors.text), QColor::fromRgba(m_colors.background));
    }
    guarded([&] { colorWidget()->setPalette(palette); });
}

void Control::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    palette.setColor(QPalette::Active, QPalette::WindowText, text);
    palette.setColor(QPalette::Inactive, QPalette::WindowText, text);
    palette.setColor(QPalette::Window, background);
}

void Control::applyFieldColors(QPalette& palette, const QColor& text, const QColor& background) {
    palette.setColor(QPalette::Active, QPalette::Text, text);
    palette.setColor(QPalette::Inactive, QPalette::Text, text);
    palette.setColor(QPalette::Base, background);
}

LRESULT Control::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_PAINT: {
        const HWND self = handle();
        askColors();
        if (from(self)) {
            passEvent(*this, message);
        }
        return 0;
    }
    case WM_GETDLGCODE:
        return static_cast<LRESULT>(dialogCode(reinterpret_cast<const MSG*>(lParam)));
    case WM_SETFOCUS:
    case WM_KILLFOCUS: {
        const HWND self = handle();
        for (Window* around = parent(); around; around = around->parent()) {
            around->focusMovedWithin(*this, message == WM_SETFOCUS);
        }
        if (from(self)) {
            focusMoved(message == WM_SETFOCUS);
        }
        return 0;
    }
    case WM_SYSCOLORCHANGE:
        applyPalette();
        return 0;
    default:
        return Window::defaultProc(message, wParam, lParam);
    }
}

// --- owner drawing ---

// All pixels of a display with a scale are drawn.
OwnerPainting::OwnerPainting(Control& control, QSize size, QPalette::ColorRole back)
    : m_control(control), m_ratio(control.widget()->devicePixelRatioF()) {
    const QPalette palette = control.widget()->palette();
    const QColor background = palette.color(back);
    const QColor text = palette.color(back == QPalette::Window ? QPalette::WindowText : QPalette::Text);
    const RECT all{0, 0, std::max(size.width(), 1), std::max(size.height(), 1)};
    m_bitmap = addBitmap(all.right, all.bottom, PixelFormat::Color, m_ratio);
    m_dc = CreateCompatibleDC(nullptr);
    m_oldBitmap = SelectObject(m_dc, reinterpret_cast<HGDIOBJ>(m_bitmap));
    CDC* context = CDC::FromHandle(m_dc);
    context->SetTextColor(toColorRef(text));
    context->SetBkColor(toColorRef(background));
    const HBRUSH brush = CreateSolidBrush(toColorRef(background));
    FillRect(m_dc, &all, brush);
    DeleteObject(reinterpret_cast<HGDIOBJ>(brush));
    if (control.font) {
        m_oldFont = SelectObject(m_dc, reinterpret_cast<HGDIOBJ>(control.font));
    }
}

OwnerPainting::~OwnerPainting() {
    if (m_oldFont) {
        SelectObject(m_dc, m_oldFont);
    }
    SelectObject(m_dc, m_oldBitmap);
    DeleteDC(m_dc);
    DeleteObject(reinterpret_cast<HGDIOBJ>(m_bitmap));
}

void OwnerPainting::draw(DRAWITEMSTRUCT item) {
    const Window* parent = m_control.parent();
    if (!parent) {
        return;
    }
    item.CtlID = static_cast<UINT>(m_control.id());
    item.itemAction = ODA_DRAWENTIRE;
    item.hwndItem = m_control.handle();
    item.hDC = m_dc;
    SendMessageA(parent->handle(), WM_DRAWITEM, item.CtlID, reinterpret_cast<LPARAM>(&item));
}

QImage OwnerPainting::image() const {
    // All of its pixels, not those that the host knows of.
    const auto bitmap = findTool<BitmapObject>(reinterpret_cast<HGDIOBJ>(m_bitmap));
    QImage picture = bitmap ? bitmap->image.copy() : QImage();
    picture.setDevicePixelRatio(m_ratio);
    return picture;
}

void Control::paintByOwner(QPainter& painter, UINT type, UINT state) {
    const HWND self = handle();
    OwnerPainting drawing(*this, widget()->size(), QPalette::Window);
    DRAWITEMSTRUCT item{};
    item.CtlType = type;
    item.rcItem = fromQt(widget()->rect());
    item.itemState = state | (isEnabled() ? 0U : ODS_DISABLED);
    drawing.draw(item);
    // The owner may have ended the control while it drew.
    if (from(self)) {
        painter.drawImage(0, 0, drawing.image());
    }
}

// --- controls that bring no behaviour yet ---

namespace {

/// Stands for a control of an unknown class, so that the rest of a dialog can be used: an empty frame.
class EmptyPane : public Control {
public:
    using Control::Control;

protected:
    QWidget* makeWidget(QWidget* parent) override {
        auto* frame = new QFrame(parent);
        frame->setFrameStyle(hasBorder() ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
        return frame;
    }
    bool takesFocus() const override {
        return false;
    }
};

std::unique_ptr<Window> makeEmptyPane(const CREATESTRUCT& cs) {
    return std::make_unique<EmptyPane>(cs);
}

const WindowClassEntry emptyPaneEntry(emptyPaneClass, &makeEmptyPane);

} // namespace

} // namespace tvx::afx
