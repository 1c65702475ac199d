#include "platform/afx/dialogs/detail/DialogWindow.h"

#include "platform/afx/controls/detail/ButtonWindow.h"
#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/core/App.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/DesktopAnswers.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/core/detail/ScrollFrame.h"
#include "platform/afx/dialogs/DialogWatch.h"
#include "platform/afx/dialogs/detail/DialogKeys.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

#include <QAccessible>
#include <QApplication>
#include <QFontInfo>
#include <QFontMetrics>
#include <QScreen>
#include <QWindow>

#include <cstdio>
#include <set>
#include <string>

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeDialog(const CREATESTRUCT& cs) {
    return std::make_unique<DialogWindow>(cs);
}

const WindowClassEntry dialogEntry(dialogClass, &makeDialog);

/// number * numerator / denominator, rounded half away from zero.
int mulDiv(int number, int numerator, int denominator) {
    const long long product = static_cast<long long>(number) * numerator;
    const long long half = product < 0 ? -denominator / 2 : denominator / 2;
    return static_cast<int>((product + half) / denominator);
}

/// Controls that show their edge sunken in dialogs, whatever the template says of it.
bool hasClientEdge(const std::string& className) {
    return text::equalNoCase(className, "Edit") || text::equalNoCase(className, "ListBox") ||
           text::equalNoCase(className, "SysTreeView32") || text::equalNoCase(className, "SysListView32");
}

std::string captionOf(const ResourceName& name) {
    const auto* number = std::get_if<WORD>(&name);
    if (!number) {
        return std::get<std::string>(name);
    }
    return *number != 0 ? "#" + std::to_string(*number) : std::string();
}

} // namespace

DialogWindow::~DialogWindow() {
    DeleteObject(reinterpret_cast<HGDIOBJ>(m_ownFont));
}

// --- the window ---

namespace {

/// The dialog flag lets the window manager keep it over its owner, without entries of its own in task lists.
Qt::WindowFlags flags(DWORD style, DWORD exStyle) {
    return windowFlags(style, exStyle) | Qt::Dialog;
}

} // namespace

QWidget* DialogWindow::makeWidget(QWidget* parent) {
    if (isChild()) {
        m_frame = new ScrollFrame(*this, parent, ScrollFrame::Background::Toolkits);
        return m_frame;
    }
    QWidget* over = owner() ? owner()->widget() : nullptr;
    return new QWidget(over, flags(style(), exStyle()));
}

QWidget* DialogWindow::clientWidget() const {
    return widget() && m_frame ? m_frame->viewport() : widget();
}

void DialogWindow::widgetMade() {
    if (!isChild()) {
        widget()->setWindowTitle(text());
        fixSize();
    }
    widget()->setMouseTracking(true);
}

int DialogWindow::accessibleRole() const {
    if (!isChild()) {
        return QAccessible::Dialog;
    }
    return dynamic_cast<const DialogWindow*>(parent()) ? QAccessible::PropertyPage : QAccessible::Form;
}

void DialogWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    if (m_frame) {
        guarded([this] { m_frame->followStyle(); });
        tellGeometry();
        return;
    }
    if (!isChild() && flags(style(), exStyle()) != flags(oldStyle, oldExStyle)) {
        changeWindowFlags(*widget(), flags(style(), exStyle()));
    }
    if (!isChild() && ((oldStyle ^ style()) & WS_THICKFRAME) != 0) {
        fixSize();
    }
}

/// A dialog without a sizing border has the size it was given.
void DialogWindow::fixSize() {
    if ((style() & WS_THICKFRAME) == 0) {
        widget()->setFixedSize(widget()->size());
        return;
    }
    widget()->setMinimumSize(0, 0);
    widget()->setMaximumSize(QWIDGETSIZE_MAX, QWIDGETSIZE_MAX);
    if (widget()->isVisible()) {
        applySizeLimits(*this, QSize(0, 0));
    }
}

void DialogWindow::setWindowRect(const QRect& rect) {
    if (isChild() || !widget()) {
        Window::setWindowRect(rect);
        return;
    }
    // The limits that keep the user from sizing it would keep the program from it as well.
    widget()->setMinimumSize(0, 0);
    widget()->setMaximumSize(QWIDGETSIZE_MAX, QWIDGETSIZE_MAX);
    Window::setWindowRect(rect);
    fixSize();
}

QMargins DialogWindow::expectedBorders() const {
    const bool framed = !isChild() && (style() & WS_CAPTION) == WS_CAPTION;
    // A frame is known only of a window that is shown; the owner's is like the dialog's will be.
    const QWidget* over = framed && owner() ? owner()->widget() : nullptr;
    const QWindow* native = over && over->isVisible() ? over->windowHandle() : nullptr;
    if (native && !native->frameMargins().isNull()) {
        return native->frameMargins();
    }
    return framed ? expectedWindowBorders() : QMargins();
}

void DialogWindow::setClientSize(QPoint corner, QSize inside) {
    const QMargins around = isChild() ? QMargins() : expectedBorders();
    setWindowRect(QRect(corner, inside + QSize(around.left() + around.right(), around.top() + around.bottom())));
}

void DialogWindow::keepOnScreen() {
    // The window manager's frame is unknown until the dialog is shown.
    constexpr QMargins frame(0, 0, 8, 32);
    const bool isGuess = (style() & WS_CAPTION) != 0 && expectedBorders().isNull();
    const QRect area = widget()->screen()->availableGeometry() - (isGuess ? frame : QMargins());
    const QRect now = windowRect();
    QRect place = now;
    place.moveRight(std::min(place.right(), area.right()));
    place.moveBottom(std::min(place.bottom(), area.bottom()));
    place.moveLeft(std::max(place.left(), area.left()));
    place.moveTop(std::max(place.top(), area.top()));
    if (place != now) {
        setWindowRect(place);
    }
}

void DialogWindow::showWidget(int command) {
    if (isChild()) {
        Window::showWidget(command);
        return;
    }
    if (command != SW_HIDE && widget()->isHidden()) {
        tellDialogOpens();
        keepOnScreen();
        if ((style() & WS_THICKFRAME) != 0) {
            applySizeLimits(*this, QSize(0, 0)); // asked once its controls stand
        }
    }
    showTopLevel(*this, command);
}

// --- units and fonts ---

namespace {

constexpr int usualPoints = 8; // of templates' fonts, beside menus of the same size

/// The desktop's font in the size of its menus, for templates that name the interface's font in its usual size;
/// larger or smaller in the same measure for others, but never smaller than the template says.
void useDesktopFont(LOGFONTA& font, int points) {
    const QFont menus = QApplication::font("QMenu");
    font.lfHeight = std::min(font.lfHeight, -scaled(QFontInfo(menus).pixelSize(), points, usualPoints));
    text::copyCut(fromQt(QFontInfo(menus).family()), font.lfFaceName, LF_FACESIZE);
}

/// Makes another font larger by as much as the desktop's is larger than the one that templates were laid out beside:
/// who chose large menus reads dialogs as well. A smaller one would leave texts that nobody can read.
void followDesktop(LOGFONTA& font) {
    constexpr int usualPixels = 12; // of nine points, which a desktop has that nobody has set
    const int desktop = QFontInfo(QApplication::font("QMenu")).pixelSize();
    if (desktop > usualPixels) {
        font.lfHeight = scaled(font.lfHeight, desktop, usualPixels);
    }
}

/// The font of a template, as the desktop has it.
LOGFONTA fontOf(const DialogTemplate& description) {
    const DialogFont wanted = description.font.value_or(DialogFont{.faceName = "MS Shell Dlg"});
    LOGFONTA font = pointFont(wanted.pointSize * 10, wanted.faceName);
    if (description.extended) {
        font.lfWeight = wanted.weight;
        font.lfItalic = wanted.italic ? 1 : 0;
    }
    if (isInterfaceFace(wanted.faceName)) {
        useDesktopFont(font, wanted.pointSize);
    } else {
        followDesktop(font);
    }
    return font;
}

QRect mapped(const DialogRect& rect, QSize units) {
    return {mulDiv(rect.x, units.width(), 4), mulDiv(rect.y, units.height(), 8), mulDiv(rect.width, units.width(), 4),
            mulDiv(rect.height, units.height(), 8)};
}

} // namespace

void DialogWindow::useFont(const DialogTemplate& description) {
    const LOGFONTA font = fontOf(description);
    const HFONT old = std::exchange(m_ownFont, CreateFontIndirectA(&font));
    SendMessageA(handle(), WM_SETFONT, reinterpret_cast<WPARAM>(m_ownFont), FALSE);
    DeleteObject(reinterpret_cast<HGDIOBJ>(old));
    const QFont shown = controlFont(font);
    widget()->setFont(shown);
    m_baseUnits = dialogBaseUnits(shown);
}

QSize DialogWindow::insideOf(const DialogTemplate& description) {
    return mapped(description.rect, dialogBaseUnits(controlFont(fontOf(description)))).size();
}

QRect DialogWindow::map(const DialogRect& rect) const {
    return mapped(rect, m_baseUnits);
}

// --- the default button ---

void DialogWindow::setDefaultId(int id) {
    m_defaultId = id;
    showDefault(from(GetFocus()));
}

void DialogWindow::showDefault(const Window* focused) {
    const auto* pushed = dynamic_cast<const ButtonWindow*>(focused);
    const bool focusDecides = pushed && pushed->isPushButton();
    for (Window* child : children()) {
        auto* button = dynamic_cast<ButtonWindow*>(child);
        if (button && button->isPushButton()) {
            button->showAsDefault(focusDecides ? button == pushed : m_defaultId != 0 && button->id() == m_defaultId);
        }
    }
}

void DialogWindow::focusMovedWithin(Window& control, bool got) {
    showDefault(got ? &control : nullptr);
    lastFocus = got ? control.handle() : lastFocus;
}

// --- messages ---

void DialogWindow::askColor() {
    static const HDC dc = CreateCompatibleDC(nullptr);
    const LRESULT answer = call(WM_CTLCOLORDLG, reinterpret_cast<WPARAM>(dc), reinterpret_cast<LPARAM>(handle()));
    const auto brush = findTool<BrushObject>(reinterpret_cast<HGDIOBJ>(answer));
    QRgb color = 0;
    if (brush && brush->description.lbStyle == BS_SOLID) {
        const COLORREF chosen = brush->systemColor >= 0 ? GetSysColor(brush->systemColor) : brush->description.lbColor;
        color = qRgb(GetRValue(chosen), GetGValue(chosen), GetBValue(chosen));
    }
    if (color == m_color || !widget()) {
        return;
    }
    m_color = color;
    QWidget& inside = *clientWidget();
    QPalette palette; // names this colour only, so that others go on following the desktop's
    if (color != 0) {
        palette.setColor(QPalette::Window, QColor(color));
    }
    guarded([&] {
        inside.setAutoFillBackground(color != 0);
        inside.setPalette(palette);
    });
}

void DialogWindow::pressCancel() {
    const Window* button = child(IDCANCEL);
    if (button && !button->isEnabled()) {
        QApplication::beep();
        return;
    }
    const HWND control = button ? button->handle() : nullptr;
    call(WM_COMMAND, MAKEWPARAM(IDCANCEL, BN_CLICKED), reinterpret_cast<LPARAM>(control));
}

LRESULT DialogWindow::erase(HDC dc) {
    const HWND self = handle();
    askColor();
    if (from(self)) {
        const QSize size = clientRect().size();
        const RECT rect{0, 0, size.width(), size.height()};
        const HBRUSH own =
            m_color != 0 ? CreateSolidBrush(RGB(qRed(m_color), qGreen(m_color), qBlue(m_color))) : nullptr;
        FillRect(dc, &rect, own ? own : GetSysColorBrush(COLOR_BTNFACE));
        DeleteObject(reinterpret_cast<HGDIOBJ>(own));
    }
    return TRUE;
}

/// The keyboard belongs to a control; it comes here when the dialog becomes active again. A child dialog is given it
/// before any of its controls had it, too.
void DialogWindow::passFocusOn() {
    const Window* last = from(lastFocus);
    if (last && last != this && last->isEnabled() && last->isVisible()) {
        SetFocus(lastFocus);
    } else if (Window* first = isChild() ? nextTabItem(*this, nullptr, Direction::Forward) : nullptr) {
        focusControl(*first);
    }
}

LRESULT DialogWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case DM_GETDEFID:
        return m_defaultId != 0 ? MAKELONG(m_defaultId, DC_HASDEFID) : 0;
    case DM_SETDEFID:
        setDefaultId(static_cast<int>(wParam));
        return TRUE;
    case WM_CLOSE:
        pressCancel();
        return 0;
    case WM_ERASEBKGND:
        return erase(reinterpret_cast<HDC>(wParam));
    case WM_PAINT: {
        const HWND self = handle();
        askColor();
        if (from(self)) {
            passEvent(*this, message);
        }
        return 0;
    }
    case WM_SETFOCUS:
        passFocusOn();
        return 0;
    default:
        return Window::defaultProc(message, wParam, lParam);
    }
}

// --- templates ---

std::string resourceNameOf(LPCSTR name) {
    return IS_INTRESOURCE(name) ? std::to_string(reinterpret_cast<std::uintptr_t>(name)) : std::string(name);
}

std::optional<DialogTemplate> loadDialogTemplate(LPCSTR name) {
    const auto bytes = resourceBytes(AfxFindResourceHandle(name, RT_DIALOG), name, RT_DIALOG);
    if (bytes.empty()) {
        std::fprintf(stderr, "The dialog %s is not among the resources.\n", resourceNameOf(name).c_str());
        return std::nullopt;
    }
    auto description = parseDialogTemplate(bytes);
    if (!description) {
        std::fprintf(stderr, "The dialog %s was refused: %s.\n", resourceNameOf(name).c_str(),
                     description.reason().c_str());
        return std::nullopt;
    }
    return std::move(*description);
}

namespace {

/// Tells of a class that a template names and nobody has registered: the host forgot to, or relies on a control that
/// does not exist here. Once for each class, as dialogs are opened again and again.
void tellUnknownClass(const std::string& className) {
    static std::set<std::string> told;
    if (told.insert(className).second) {
        std::fprintf(stderr, "Nobody has registered the window class %s: dialogs show an empty pane instead.\n",
                     className.c_str());
    }
}

HWND makeControl(DialogWindow& dialog, const DialogItemTemplate& item) {
    const std::string caption = captionOf(item.title);
    const QRect place = dialog.map(item.rect);
    CREATESTRUCT cs{};
    const bool known = findWindowClass(item.className.c_str()) != nullptr;
    if (!known) {
        tellUnknownClass(item.className);
    }
    cs.lpszClass = known ? item.className.c_str() : emptyPaneClass;
    cs.lpszName = caption.c_str();
    // It is shown when it has its size; and an empty pane takes no keyboard.
    const DWORD later = WS_VISIBLE | (known ? 0U : DWORD{WS_TABSTOP});
    cs.style = static_cast<LONG>((item.style | WS_CHILD) & ~later);
    const bool edge = hasClientEdge(item.className) && (item.style & WS_BORDER) != 0;
    cs.dwExStyle = item.extendedStyle | (edge ? DWORD{WS_EX_CLIENTEDGE} : 0);
    cs.x = place.x();
    cs.y = place.y();
    cs.cx = place.width();
    cs.cy = place.height();
    cs.hwndParent = dialog.handle();
    cs.hMenu = reinterpret_cast<HMENU>(static_cast<UINT_PTR>(item.id));
    cs.hInstance = AfxGetInstanceHandle();
    return createWindow(cs, nullptr);
}

} // namespace

bool makeControls(DialogWindow& dialog, const DialogTemplate& description) {
    bool complete = true;
    dialog.helpContext = description.helpId;
    for (const DialogItemTemplate& item : description.items) {
        const HWND control = makeControl(dialog, item);
        if (!control) {
            complete = false;
            continue;
        }
        Window::from(control)->helpContext = item.helpId;
        SendMessageA(control, WM_SETFONT, reinterpret_cast<WPARAM>(dialog.font), FALSE);
        // The font has changed the height of lines, and with it that of boxes that show whole lines only.
        const QRect place = dialog.map(item.rect);
        Window::from(control)->setWindowRect(place);
        if ((item.style & WS_VISIBLE) != 0) {
            ShowWindow(control, SW_SHOWNA);
        }
        const auto* button = dynamic_cast<const ButtonWindow*>(Window::from(control));
        if (button && button->type() == BS_DEFPUSHBUTTON && dialog.defaultId() == 0) {
            dialog.setDefaultId(static_cast<int>(item.id));
        }
    }
    return complete;
}

bool fillControls(DialogWindow& dialog, LPCSTR name) {
    const auto bytes = resourceBytes(AfxFindResourceHandle(name, RT_DLGINIT), name, RT_DLGINIT);
    if (bytes.empty()) {
        return true;
    }
    const auto entries = parseDialogData(bytes);
    if (!entries) {
        std::fprintf(stderr, "The first contents of a dialog were refused: %s.\n", entries.reason().c_str());
        return false;
    }
    for (const DialogDataEntry& entry : *entries) {
        UINT message = entry.message;
        if (entry.kind != DialogDataEntry::Kind::Other) {
            message = entry.kind == DialogDataEntry::Kind::AddToListBox ? LB_ADDSTRING : CB_ADDSTRING;
        }
        SendMessageA(GetDlgItem(dialog.handle(), entry.controlId), message, 0,
                     reinterpret_cast<LPARAM>(entry.text.c_str()));
    }
    return true;
}

HWND defaultOwner() {
    HWND active = ::GetActiveWindow();
    while (active && !dynamic_cast<const DialogWindow*>(Window::from(active)) && ::GetWindow(active, GW_OWNER)) {
        active = ::GetWindow(active, GW_OWNER); // a bar that floats belongs to a frame
    }
    const Window* window = Window::from(active);
    const bool isDialog = dynamic_cast<const DialogWindow*>(window) && !window->isChild();
    if (isDialog || (window && window->object() && window->object()->IsFrameWnd())) {
        return active;
    }
    const CWnd* main = AfxGetMainWnd();
    return main ? main->m_hWnd : nullptr;
}

void activateAgain(HWND owner) {
    Window* given = Window::from(owner);
    Window* window = given ? given->topLevel() : nullptr;
    if (window && window->isVisible() && !window->widget()->isMinimized()) {
        guarded([window] { window->widget()->activateWindow(); });
    }
}

} // namespace tvx::afx

LONG GetDialogBaseUnits() {
    if (!tvx::afx::ensureGui()) {
        return 0;
    }
    const QFont font = tvx::afx::toolkitFont(static_cast<HFONT>(GetStockObject(SYSTEM_FONT)));
    const QSize units = tvx::afx::dialogBaseUnits(font);
    return static_cast<LONG>(MAKELONG(units.width(), units.height()));
}
