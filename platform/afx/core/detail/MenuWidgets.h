#pragma once

/// @file
/// Menus on the screen: the toolkit's menu bars and popups, made from the lists behind menu handles.

#include "platform/afx/core/detail/Menus.h"

#include <QMenu>
#include <QMenuBar>

#include <functional>

namespace tvx::afx {

class Window;

/// Whom the popups of one menu tell what happens.
struct MenuHost {
    HWND owner = nullptr;
    bool notifies = true; ///< Whether the owner gets WM_INITMENUPOPUP and WM_MENUSELECT.
    bool systemMenu = false;
    std::function<void(UINT id)> choose;
};

/// A popup. It fills itself each time it is about to be shown, after its owner has had the chance to update the items.
class TVX_PLATFORM_API PopupMenu : public QMenu {
public:
    PopupMenu(HMENU menu, int index, const MenuHost& host, QWidget* parent);
    /// Tells the owner that the popup is about to be shown and fills it.
    void prepare();
    HMENU handle() const {
        return m_menu;
    }

protected:
    /// The help key asks for help on the chosen item; letters are access keys on layouts of other scripts, too.
    void keyPressEvent(QKeyEvent* event) override;

private:
    bool hasAccessKey(char32_t key) const;
    void fill();
    void addItem(const MenuItem& item, int index);
    void opened();
    void closed();
    void hovered(QAction* action);
    void chosen(QAction* action);
    HMENU m_menu;
    int m_index;
    const MenuHost& m_host;
    bool m_prepared = false;
};

/// The menu bar of a frame.
class TVX_PLATFORM_API FrameMenuBar : public QMenuBar, private MenuListener {
public:
    FrameMenuBar(HWND owner, QWidget* parent);
    /// Shows another menu.
    void setMenu(HMENU menu);
    /// Opens the popup with an access key; 0 gives the bar the keyboard. False when there is no such popup.
    bool openByKey(char32_t key);

protected:
    void initStyleOption(QStyleOptionMenuItem* option, const QAction* action) const override;
    void mousePressEvent(QMouseEvent* event) override;
    /// The buttons of a child frame that fills the frame stand in the bar, and are drawn as captions are.
    void childEvent(QChildEvent* event) override;
    void changeEvent(QEvent* event) override;
    /// The bar is a part of its frame: hosts draw on it when the frame around the client area is painted.
    void paintEvent(QPaintEvent* event) override;

private:
    void menuChanged(HMENU menu) override;
    void lendKeyboard();
    void styleCorner();
    void rebuild();
    void addEntry(const MenuItem& item, int index);
    HMENU m_menu = nullptr;
    MenuHost m_host;
};

/// The menu bar has the keyboard, or a menu is open: keys are no accelerators then.
[[nodiscard]] TVX_PLATFORM_API bool menuHasKeyboard();
/// What SC_KEYMENU asks a top-level window for: the menu of an access key, of the bar as a whole (0), or of the caption
/// (blank).
void openMenuByKey(Window& window, char32_t key);
/// Brings the state of a window's system menu up to date with the window.
void updateSystemMenu(HWND window);
/// Shows a window's system menu at a point of the screen and sends what is chosen.
void showSystemMenu(Window& window, POINT at);
/// Carries out what a menu item stands for: posts its command to the owner.
void postMenuCommand(HWND owner, UINT id, bool systemMenu);

} // namespace tvx::afx
