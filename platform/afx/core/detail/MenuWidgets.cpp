#include "platform/afx/core/detail/MenuWidgets.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/ButtonImages.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/FrameworkIds.h"

#include <QActionGroup>
#include <QApplication>
#include <QKeyEvent>
#include <QMainWindow>
#include <QStyleOptionMenuItem>

#include <unordered_map>

namespace tvx::afx {

namespace {

void sendSelect(HWND owner, UINT item, UINT flags, HMENU menu) {
    SendMessageA(owner, WM_MENUSELECT, MAKEWPARAM(static_cast<int>(item), static_cast<int>(flags)),
                 reinterpret_cast<LPARAM>(menu));
}

void applyState(QAction& action, const MenuItem& item) {
    action.setEnabled(item.isEnabled());
    const bool checked = (item.flags & MF_CHECKED) != 0;
    const HBITMAP picture = checked && item.checked ? item.checked : item.unchecked;
    if (picture) {
        action.setIcon(buttonIcon(picture));
        action.setIconVisibleInMenu(true);
    }
    if (!checked) {
        return; // an item that could be checked must not show an empty box
    }
    action.setCheckable(true);
    action.setChecked(true);
    if (item.mark == MenuItem::Mark::Radio) {
        auto* group = new QActionGroup(&action); // the style draws members of exclusive groups with a round mark
        group->setExclusive(true);
        group->addAction(&action);
    }
}

/// The index in the menu's list that an action was made for.
int indexOf(const QAction& action) {
    return action.data().toInt();
}

} // namespace

// --- popups ---

PopupMenu::PopupMenu(HMENU menu, int index, const MenuHost& host, QWidget* parent)
    : QMenu(parent), m_menu(menu), m_index(index), m_host(host) {
    connectStoring(this, &QMenu::aboutToShow, this, [this] { opened(); });
    connectStoring(this, &QMenu::aboutToHide, this, [this] { closed(); });
    connectStoring(this, &QMenu::hovered, this, [this](QAction* action) { hovered(action); });
    fill();
}

void PopupMenu::opened() {
    if (!m_prepared) {
        prepare();
    }
}

void PopupMenu::prepare() {
    m_prepared = true;
    armIdle();
    if (m_host.systemMenu) {
        updateSystemMenu(m_host.owner);
    }
    const bool isWhole = m_host.systemMenu && !qobject_cast<QMenu*>(parentWidget());
    if (m_host.notifies && isWhole) {
        SendMessageA(m_host.owner, WM_INITMENU, reinterpret_cast<WPARAM>(m_menu), 0);
    }
    if (m_host.notifies) {
        SendMessageA(m_host.owner, WM_INITMENUPOPUP, reinterpret_cast<WPARAM>(m_menu),
                     MAKELPARAM(m_index, m_host.systemMenu ? TRUE : FALSE));
    }
    fill();
}

void PopupMenu::closed() {
    m_prepared = false;
    if (m_host.notifies) {
        SendMessageA(m_host.owner, WM_UNINITMENUPOPUP, reinterpret_cast<WPARAM>(m_menu), 0);
        if (!qobject_cast<QMenu*>(parentWidget())) {
            sendSelect(m_host.owner, 0, 0xFFFF, nullptr);
        }
    }
}

void PopupMenu::fill() {
    const auto children = findChildren<PopupMenu*>(QString(), Qt::FindDirectChildrenOnly);
    clear();
    for (PopupMenu* child : children) {
        child->deleteLater();
    }
    const Menu* menu = menuFrom(m_menu);
    if (!menu) {
        return;
    }
    for (std::size_t i = 0; i < menu->items.size(); ++i) {
        addItem(menu->items[i], static_cast<int>(i));
    }
}

void PopupMenu::addItem(const MenuItem& item, int index) {
    if (item.isSeparator()) {
        addSeparator();
        return;
    }
    QAction* action = nullptr;
    if (item.popup) {
        action = addMenu(new PopupMenu(item.popup, index, m_host, this));
        action->setText(QString::fromStdString(item.text));
    } else {
        action = addAction(QString::fromStdString(item.text));
        connectStoring(action, &QAction::triggered, this, [this, action] { chosen(action); });
    }
    action->setMenuRole(QAction::NoRole);
    action->setData(index);
    applyState(*action, item);
    if (item.isDefault) {
        setDefaultAction(action);
    }
}

void PopupMenu::hovered(QAction* action) {
    const MenuPlace place = findItem(m_menu, static_cast<UINT>(indexOf(*action)), MF_BYPOSITION);
    if (!place || !m_host.notifies || action->isSeparator()) {
        return;
    }
    const MenuItem& item = place.item();
    const UINT system = m_host.systemMenu ? MF_SYSMENU : 0U;
    if (item.popup) {
        sendSelect(m_host.owner, static_cast<UINT>(indexOf(*action)), MF_POPUP | MF_HILITE | system, m_menu);
    } else {
        sendSelect(m_host.owner, item.id, (item.flags & 0xFFU) | MF_HILITE | system, m_menu);
    }
}

bool PopupMenu::hasAccessKey(char32_t key) const {
    const Menu* menu = menuFrom(m_menu);
    return menu &&
           std::ranges::any_of(menu->items, [key](const MenuItem& item) { return accessKey(item.text) == key; });
}

void PopupMenu::keyPressEvent(QKeyEvent* event) {
    if (event->key() != Qt::Key_F1 || event->modifiers() != Qt::NoModifier || isRepeated(*event)) {
        const QString text = event->text();
        const char32_t letter = pressedLetter();
        const bool isMeant =
            text.size() == 1 && letter != 0 && !hasAccessKey(QChar::toLower(char32_t{text[0].unicode()}));
        QKeyEvent latin(QEvent::KeyPress, event->key(), event->modifiers(), QString::fromUcs4(&letter, 1));
        QMenu::keyPressEvent(isMeant ? &latin : event);
        return;
    }
    armIdle();
    // Some styles do not highlight items that are disabled; why they are is what help is asked for.
    const QAction* action = activeAction() ? activeAction() : actionAt(mapFromGlobal(QCursor::pos()));
    const MenuPlace place = action ? findItem(m_menu, static_cast<UINT>(indexOf(*action)), MF_BYPOSITION) : MenuPlace();
    requestMenuHelp(m_host.owner, m_menu, place && !place.item().popup ? place.item().id : 0);
}

void PopupMenu::chosen(QAction* action) {
    if (const MenuPlace place = findItem(m_menu, static_cast<UINT>(indexOf(*action)), MF_BYPOSITION)) {
        m_host.choose(place.item().id);
    }
}

// --- bars ---

FrameMenuBar::FrameMenuBar(HWND owner, QWidget* parent) : QMenuBar(parent) {
    setNativeMenuBar(false);
    m_host.owner = owner;
    m_host.choose = [owner](UINT id) { postMenuCommand(owner, id, false); };
}

void FrameMenuBar::setMenu(HMENU menu) {
    m_menu = menu;
    rebuild();
}

void FrameMenuBar::menuChanged(HMENU menu) {
    if (menu == m_menu) {
        rebuild();
    }
}

void FrameMenuBar::rebuild() {
    const auto popups = findChildren<PopupMenu*>(QString(), Qt::FindDirectChildrenOnly);
    clear();
    for (PopupMenu* popup : popups) {
        popup->deleteLater();
    }
    const Menu* menu = menuFrom(m_menu);
    if (!menu) {
        return;
    }
    for (std::size_t i = 0; i < menu->items.size(); ++i) {
        addEntry(menu->items[i], static_cast<int>(i));
    }
}

void FrameMenuBar::addEntry(const MenuItem& item, int index) {
    if (item.isSeparator()) {
        return;
    }
    QAction* action = nullptr;
    if (item.popup) {
        auto* popup = new PopupMenu(item.popup, index, m_host, this);
        connectStoring(popup, &QMenu::aboutToShow, popup,
                       [this] { SendMessageA(m_host.owner, WM_INITMENU, reinterpret_cast<WPARAM>(m_menu), 0); });
        action = addMenu(popup);
        action->setText(QString::fromStdString(item.text));
    } else {
        action = addAction(QString::fromStdString(item.text));
        const UINT id = item.id;
        connectStoring(action, &QAction::triggered, this, [this, id] { m_host.choose(id); });
    }
    action->setData(index);
    action->setEnabled(item.isEnabled());
}

void FrameMenuBar::initStyleOption(QStyleOptionMenuItem* option, const QAction* action) const {
    QMenuBar::initStyleOption(option, action);
    // Some styles show only an entry that is open; without this nobody sees which one the arrows would open.
    if (hasFocus() && action == activeAction()) {
        option->state |= QStyle::State_Sunken | QStyle::State_Selected;
    }
}

/// The bar gives the keyboard back to the widget that it had it from. In an empty main frame no other one has it, or
/// the view that went last: the bar would keep it, and all keys.
void FrameMenuBar::lendKeyboard() {
    const QWidget* holder = QApplication::focusWidget();
    if (!holder || !holder->isVisible()) {
        guarded([this] { window()->setFocus(); });
    }
}

void FrameMenuBar::mousePressEvent(QMouseEvent* event) {
    storing([this] { lendKeyboard(); });
    QMenuBar::mousePressEvent(event);
}

void FrameMenuBar::childEvent(QChildEvent* event) {
    QMenuBar::childEvent(event);
    if (event->added() && event->child() == cornerWidget()) {
        styleCorner();
    }
}

void FrameMenuBar::changeEvent(QEvent* event) {
    QMenuBar::changeEvent(event);
    if (event->type() == QEvent::StyleChange) {
        styleCorner();
    }
}

void FrameMenuBar::styleCorner() {
    QWidget* corner = cornerWidget();
    if (!corner) {
        return;
    }
    const auto former = corner->findChildren<QProxyStyle*>(QString(), Qt::FindDirectChildrenOnly);
    auto* style = new CaptionStyle;
    style->setParent(corner); // which another bar may have next
    corner->setStyle(style);
    qDeleteAll(former);
}

void FrameMenuBar::paintEvent(QPaintEvent* event) {
    QMenuBar::paintEvent(event);
    if (Window* owner = Window::from(m_host.owner)) {
        storing([owner] { paintFrame(*owner, nullptr); });
    }
}

bool FrameMenuBar::openByKey(char32_t key) {
    if (!isVisible()) {
        return false;
    }
    lendKeyboard();
    if (key == 0) {
        // The toolkit gives the bar the keyboard when it sees Alt go down and up; both are taken from it by the
        // translation into messages.
        QKeyEvent down(QEvent::ShortcutOverride, Qt::Key_Alt, Qt::NoModifier); // as it is before the key counts
        QKeyEvent up(QEvent::KeyRelease, Qt::Key_Alt, Qt::NoModifier);
        guarded([&] {
            eventFilter(this, &down);
            eventFilter(this, &up);
        });
        return true;
    }
    const Menu* menu = menuFrom(m_menu);
    const auto entries = actions();
    for (QAction* entry : entries) {
        const auto index = static_cast<std::size_t>(indexOf(*entry));
        if (!menu || index >= menu->items.size() || accessKey(menu->items[index].text) != key || !entry->isEnabled()) {
            continue;
        }
        if (!entry->menu()) {
            m_host.choose(menu->items[index].id);
            return true;
        }
        guarded([&] {
            setActiveAction(entry);
            // Opened by a key, a menu shows its first item as chosen.
            QKeyEvent first(QEvent::KeyPress, Qt::Key_Down, Qt::NoModifier);
            if (entry->menu()->isVisible() && !entry->menu()->activeAction()) {
                QCoreApplication::sendEvent(entry->menu(), &first);
            }
        });
        return true;
    }
    return false;
}

bool menuHasKeyboard() {
    return QApplication::activePopupWidget() || qobject_cast<QMenuBar*>(QApplication::focusWidget());
}

void postMenuCommand(HWND owner, UINT id, bool systemMenu) {
    // Posted, so that the menu is gone and the keyboard back where it was when the command begins.
    armIdle();
    PostMessageA(owner, systemMenu ? WM_SYSCOMMAND : WM_COMMAND, MAKEWPARAM(static_cast<int>(id), 0), 0);
}

// --- popups that are waited for ---

namespace {

struct Tracking {
    MenuHost host;
    UINT chosen = 0;
};

QPoint placeOf(const QMenu& popup, UINT flags, QPoint at) {
    const QSize size = popup.sizeHint();
    if ((flags & TPM_CENTERALIGN) != 0) {
        at.rx() -= size.width() / 2;
    } else if ((flags & TPM_RIGHTALIGN) != 0) {
        at.rx() -= size.width();
    }
    if ((flags & TPM_VCENTERALIGN) != 0) {
        at.ry() -= size.height() / 2;
    } else if ((flags & TPM_BOTTOMALIGN) != 0) {
        at.ry() -= size.height();
    }
    return at;
}

/// Shows a popup until it closes and answers the chosen command, 0 for none.
UINT track(HMENU menu, UINT flags, QPoint at, Tracking& tracking) {
    Window* window = Window::from(tracking.host.owner);
    tracking.host.choose = [&tracking](UINT id) { tracking.chosen = id; };
    QPointer<PopupMenu> popup = new PopupMenu(menu, 0, tracking.host, window ? window->topLevel()->widget() : nullptr);
    struct Closer {
        QPointer<PopupMenu>& popup;
        ~Closer() {
            if (popup) {
                QObject::disconnect(popup, &QMenu::aboutToHide, nullptr, nullptr);
                popup->close();
                popup->deleteLater();
            }
        }
    } closer{popup};
    ModalLoop loop;
    connectStoring(popup.data(), &QMenu::aboutToHide, popup, [&loop] { loop.end(0); });
    guarded([&] {
        storing([&] { popup->prepare(); });
        if (popup && !popup->actions().isEmpty()) {
            popup->popup(placeOf(*popup, flags, at));
        }
    });
    if (popup && popup->isVisible()) {
        loop.run();
    }
    return tracking.chosen;
}

std::unordered_map<std::uintptr_t, HMENU>& systemMenus() {
    static auto* menus = new std::unordered_map<std::uintptr_t, HMENU>;
    return *menus;
}

void fillSystemMenu(HMENU menu, const Window& window) {
    const auto state = [&window](DWORD bit) { return (window.style() & bit) != 0 ? MF_ENABLED : MF_GRAYED; };
    const auto append = [menu](UINT flags, UINT command, UINT text) {
        AppendMenuA(menu, MF_STRING | flags, command, fromQt(ownText(text)).c_str());
    };
    append(0, SC_RESTORE, TVX_IDS_SYS_RESTORE);
    append(0, SC_MOVE, TVX_IDS_SYS_MOVE);
    append(state(WS_THICKFRAME), SC_SIZE, TVX_IDS_SYS_SIZE);
    append(state(WS_MINIMIZEBOX), SC_MINIMIZE, TVX_IDS_SYS_MINIMIZE);
    append(state(WS_MAXIMIZEBOX), SC_MAXIMIZE, TVX_IDS_SYS_MAXIMIZE);
    AppendMenuA(menu, MF_SEPARATOR, 0, nullptr);
    append(0, SC_CLOSE, window.isChild() ? TVX_IDS_SYS_CLOSE_CHILD : TVX_IDS_SYS_CLOSE);
    SetMenuDefaultItem(menu, SC_CLOSE, 0);
}

/// Menus of windows that have ended go with the next one that is asked for.
void forgetEnded() {
    std::erase_if(systemMenus(), [](const auto& entry) {
        const bool ended = Window::from(reinterpret_cast<HWND>(entry.first)) == nullptr;
        if (ended) {
            DestroyMenu(entry.second);
        }
        return ended;
    });
}

} // namespace

void updateSystemMenu(HWND handle) {
    const HMENU menu = GetSystemMenu(handle, FALSE);
    const Window* window = Window::from(handle);
    if (!window) {
        return;
    }
    const bool zoomed = IsZoomed(handle) != FALSE;
    const bool iconic = IsIconic(handle) != FALSE;
    const auto enable = [menu](UINT id, bool on) { EnableMenuItem(menu, id, on ? MF_ENABLED : MF_GRAYED); };
    enable(SC_RESTORE, zoomed || iconic);
    enable(SC_MOVE, !zoomed);
    enable(SC_SIZE, !zoomed && !iconic && (window->style() & WS_THICKFRAME) != 0);
    enable(SC_MAXIMIZE, !zoomed && (window->style() & WS_MAXIMIZEBOX) != 0);
    enable(SC_MINIMIZE, !iconic && (window->style() & WS_MINIMIZEBOX) != 0);
}

void showSystemMenu(Window& window, POINT at) {
    const HWND owner = window.handle();
    Tracking tracking;
    tracking.host.owner = owner;
    tracking.host.systemMenu = true;
    if (const UINT id = track(GetSystemMenu(owner, FALSE), TPM_LEFTALIGN, toQt(at), tracking)) {
        postMenuCommand(owner, id, true);
    }
}

void openMenuByKey(Window& window, char32_t key) {
    if (key == U' ') {
        const QPoint corner = window.clientToScreen(QPoint(0, 0));
        showSystemMenu(window, fromQt(corner));
        return;
    }
    if (key == U'-') {
        if (Window* child = window.activeChildFrame()) {
            showSystemMenu(*child, fromQt(child->clientToScreen(QPoint(0, 0))));
            return;
        }
    }
    auto* frame = qobject_cast<QMainWindow*>(window.widget());
    auto* bar = frame ? dynamic_cast<FrameMenuBar*>(frame->menuWidget()) : nullptr;
    if (bar) {
        const bool opened = bar->openByKey(QChar::toLower(key));
        if (!opened && pressedLetter() != 0) {
            bar->openByKey(pressedLetter());
        }
    }
}

} // namespace tvx::afx

using namespace tvx::afx;

BOOL TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int, HWND owner, const RECT*) {
    if (!menuFrom(menu) || !ensureGui()) {
        return FALSE;
    }
    Tracking tracking;
    tracking.host.owner = owner;
    tracking.host.notifies = (flags & TPM_NONOTIFY) == 0 && owner;
    if (tracking.host.notifies) {
        SendMessageA(owner, WM_INITMENU, reinterpret_cast<WPARAM>(menu), 0);
    }
    const UINT id = track(menu, flags, QPoint(x, y), tracking);
    if ((flags & TPM_RETURNCMD) != 0) {
        return static_cast<BOOL>(id);
    }
    if (id != 0) {
        postMenuCommand(owner, id, false);
    }
    return TRUE;
}

HMENU GetMenu(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->menu() : nullptr;
}

BOOL SetMenu(HWND handle, HMENU menu) {
    Window* window = Window::from(handle);
    if (!window || window->isChild() || (menu && !menuFrom(menu))) {
        return FALSE;
    }
    window->setMenu(menu);
    return TRUE;
}

BOOL DrawMenuBar(HWND handle) {
    return Window::from(handle) ? TRUE : FALSE;
}

HMENU GetSystemMenu(HWND handle, BOOL revert) {
    const Window* window = Window::from(handle);
    if (!window) {
        return nullptr;
    }
    forgetEnded();
    HMENU& menu = systemMenus()[reinterpret_cast<std::uintptr_t>(handle)];
    const bool isNew = !menuFrom(menu);
    if (isNew) {
        menu = CreatePopupMenu();
    }
    // The handle stays: a child frame's caption shows the menu by it.
    while (revert && DeleteMenu(menu, 0, MF_BYPOSITION)) {
    }
    if (isNew || revert) {
        fillSystemMenu(menu, *window);
    }
    return revert ? nullptr : menu;
}
