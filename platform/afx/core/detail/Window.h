#pragma once

/// @file
/// What lies behind a window handle: the widget, the place in the tree of windows, and the default behaviour.

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/Placement.h"
#include "platform/afx/gdi/detail/Geometry.h"
#include "platform/base/Export.h"

#include <QPointer>
#include <QRegion>
#include <QWidget>

#include <memory>
#include <string>
#include <vector>

class CWnd;

namespace tvx::afx {

class Caption;
class FrameButton;

/// One window. Each kind of window (plain child, top-level frame, dialog, each control) derives from it and brings the
/// widget and the default procedure of its kind; the CWnd attached to it, if any, sees every message first.
class TVX_PLATFORM_API Window {
public:
    explicit Window(const CREATESTRUCT& cs);
    virtual ~Window();
    Window(const Window&) = delete;
    Window& operator=(const Window&) = delete;

    /// The window of a handle, null for none.
    static Window* from(HWND handle);
    /// The window that a widget belongs to: that of the widget itself or of its nearest ancestor within the same
    /// top-level widget. Null for foreign widgets (menus, the toolkit's own dialogs).
    static Window* of(const QObject* widget);
    /// All top-level windows, in order of creation.
    static const std::vector<Window*>& topLevels();
    /// Their handles, for those who call what may end any of them.
    static std::vector<HWND> topLevelHandles();

    HWND handle() const {
        return m_handle;
    }
    /// The outermost widget of the window.
    QWidget* widget() const {
        return m_widget;
    }
    /// The widget that shows the client area. The same as widget() unless the kind has parts around its client area.
    virtual QWidget* clientWidget() const;
    /// The client area within clientWidget().
    virtual QRect clientRect() const;
    /// The widget that gets the keyboard when the window gets the focus.
    virtual QWidget* focusWidget() const;
    /// The parent widget for the widgets of child windows.
    virtual QWidget* childHost() const;

    // --- messages ---

    /// Hands a message to the attached CWnd's WindowProc, or to the default procedure when there is none.
    LRESULT call(UINT message, WPARAM wParam = 0, LPARAM lParam = 0);
    /// The same for a message that stands on the stack of dispatches already.
    LRESULT deliver(UINT message, WPARAM wParam, LPARAM lParam);
    /// What this kind of window does with a message that nobody handled. Overrides end in Window::defaultProc.
    virtual LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam);

    // --- state ---

    CWnd* object() const {
        return m_object;
    }
    /// The attached object, or a temporary one made for the asking.
    CWnd* objectOrTemporary();
    void attach(CWnd* object);
    void detach();
    void dropTemporary();

    DWORD style() const {
        return m_style;
    }
    DWORD exStyle() const {
        return m_exStyle;
    }
    /// Changes the style bits and lets the kind follow (styleChanged).
    void setStyle(DWORD style, DWORD exStyle);
    int id() const {
        return m_id;
    }
    void setId(int id) {
        m_id = id;
    }
    const std::string& className() const {
        return m_className;
    }
    bool isChild() const {
        return (m_style & WS_CHILD) != 0;
    }
    Window* parent() const {
        return m_parent;
    }
    /// The window a top-level window stands over.
    Window* owner() const {
        return m_owner;
    }
    /// Children in their order: that of creation, which is the order of tabbing, unless placeAfter changed it.
    const std::vector<Window*>& children() const {
        return m_children;
    }
    Window* topLevel();
    Window* child(int id) const;
    void setParent(Window* parent);
    void setOwner(Window* owner) {
        m_owner = owner;
    }
    /// Puts this child directly behind `after` in the order of its siblings; null: first.
    void placeAfter(Window* after);
    /// Told that the keyboard came to a control somewhere below this window, or left it.
    virtual void focusMovedWithin(Window& control, bool got) {}
    /// Whether the mouse passes through to the parent, as it does on captions and group boxes.
    virtual bool passesMouse() const {
        return false;
    }
    /// Whether keys are its own before short-cuts, menus and dialogs around it may act on them.
    virtual bool takesShortcuts() const {
        return false;
    }
    /// Its own active child frame, for a window that holds such.
    virtual Window* heldChildFrame() const {
        return nullptr;
    }
    /// The caption and border that it draws itself; null where the desktop draws them and where there are none.
    virtual Caption* caption() const {
        return nullptr;
    }
    /// The part of the window (HT...) at a point of the screen.
    virtual int hitTest(QPoint screen) const;
    /// The whole window in its widget's coordinates. A frame that the desktop draws reaches beyond the widget.
    QRect wholeRect() const;
    /// The button that its host draws into its frame, null for none; setFrameButton makes, moves or ends (null) it. The
    /// place counts from the window's corner.
    FrameButton* frameButton() const {
        return m_frameButton.get();
    }
    void setFrameButton(const QString& name, const QRect* place, UINT command);
    /// Asks for the part around the client area to be painted: caption, border, menu bar.
    virtual void updateFrame() {}
    /// Whether the mouse holds it by a part of its caption or border.
    virtual bool isHeldByCaption() const {
        return false;
    }
    /// Told that its widget was maximised, minimised or brought back.
    virtual void stateChanged() {}
    bool isDestroyed() const {
        return m_destroyed;
    }
    bool isEnabled() const;
    void setEnabled(bool enabled);

    LONG_PTR userData = 0;
    HFONT font = nullptr;
    HICON bigIcon = nullptr;
    HICON smallIcon = nullptr;
    HCURSOR classCursor = nullptr;
    HBRUSH classBrush = nullptr;
    DWORD helpContext = 0; ///< What its help requests carry; 0 for none.
    /// What is to be repainted while WM_PAINT is handled, in client coordinates; empty outside of it.
    QRegion paintRegion;
    bool inPaint = false;
    bool inFramePaint = false; ///< while WM_NCPAINT is handled for something that the toolkit paints

    // --- place and size; rectangles in the parent's client coordinates, top-level ones in screen coordinates ---

    virtual QRect windowRect() const;
    /// The borders that the desktop will put around a top-level window, as far as they can be known before it is shown.
    virtual QMargins expectedBorders() const {
        return {};
    }
    virtual void setWindowRect(const QRect& rect);
    /// What keeps the window's place; null for windows that are always inside another.
    Placement* placement() const {
        return m_placement.get();
    }
    virtual QRect screenRect() const;
    QPoint clientToScreen(const QPoint& point) const;
    QPoint screenToClient(const QPoint& point) const;
    /// Does what a show command (SW_...) says, and tells the window of it.
    virtual void show(int command);
    bool isVisible() const;
    /// Sends WM_SIZE or WM_MOVE when size or place differ from those told last.
    void tellGeometry();

    /// What assistive tools take the window for, a number of QAccessible::Role; 0 when its widget tells it better.
    virtual int accessibleRole() const {
        return 0;
    }
    virtual QString text() const {
        return m_text;
    }
    virtual void setText(const QString& text);
    /// The active child frame of a main frame; null for other windows and when there is none.
    Window* activeChildFrame() const;
    /// The frame's menu (top-level windows only).
    virtual HMENU menu() const {
        return nullptr;
    }
    virtual void setMenu(HMENU menu);

    /// Ends the window, its children and the windows it owns.
    void destroy();

protected:
    /// Makes the next tellGeometry send WM_SIZE in any case; frames hear of their size when they are first shown.
    void forgetToldSize() {
        m_toldSize = QSize(-1, -1);
    }
    /// Makes the widget of this kind, hidden, as a child of `parent` (null for top-level windows).
    virtual QWidget* makeWidget(QWidget* parent) = 0;
    /// Called once the widget stands and the first text is to be shown, before WM_CREATE.
    virtual void widgetMade();
    /// Called when the window is about to appear or vanish, before WM_SHOWWINDOW.
    virtual void beforeShow(bool visible);
    /// Does what a show command says with the kind's widget.
    virtual void showWidget(int command);
    /// Lets the kind follow a change of style bits.
    virtual void styleChanged(DWORD oldStyle, DWORD oldExStyle);
    /// Lets the kind follow WM_SETFONT.
    virtual void fontChanged();
    /// Lets the kind follow WM_SETICON.
    virtual void iconChanged();

private:
    friend HWND createWindow(const CREATESTRUCT& cs, CWnd* object, bool* stood);
    void realize(const CREATESTRUCT& cs);
    void keepPlace();
    bool start(const CREATESTRUCT& cs);
    void markDestroyed();
    void tellDestroy();
    void finishDestroy();
    void unlink();
    LRESULT reflect(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT textProc(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT appearanceProc(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT parentProc(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT mouseProc(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT systemCommand(UINT command, LPARAM lParam);
    LRESULT systemKey(UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT helpProc(const HELPINFO* info);
    LRESULT keyDown(WPARAM key, LPARAM lParam);
    bool showClassCursor(WPARAM under);

    HWND m_handle = nullptr;
    QPointer<QWidget> m_widget;
    CWnd* m_object = nullptr;
    std::unique_ptr<CWnd> m_temporary;
    std::unique_ptr<Placement> m_placement;
    std::unique_ptr<FrameButton> m_frameButton;
    DWORD m_style = 0;
    DWORD m_exStyle = 0;
    int m_id = 0;
    std::string m_className;
    QString m_text;
    Window* m_parent = nullptr;
    Window* m_owner = nullptr;
    std::vector<Window*> m_children;
    QSize m_toldSize{-1, -1};
    QPoint m_toldPlace;
    UINT m_toldState = 0;
    bool m_creating = true;
    bool m_destroyed = false;
};

/// Makes windows of one class.
using WindowFactory = std::unique_ptr<Window> (*)(const CREATESTRUCT& cs);

/// What a window class brings along.
struct WindowClass {
    std::string name;
    WindowFactory factory = nullptr; ///< Null for plain windows.
    UINT style = 0;                  ///< CS_...
    HCURSOR cursor = nullptr;
    HBRUSH background = nullptr;
    HICON icon = nullptr;
};

/// Adds a class, or replaces the one of the same name (compared without case).
TVX_PLATFORM_API void addWindowClass(WindowClass windowClass);
/// The class of a name, null for none.
TVX_PLATFORM_API const WindowClass* findWindowClass(const char* name);

/// Registers a class when the library is loaded: `static const WindowClassEntry entry("Button", &makeButton);`
struct WindowClassEntry {
    WindowClassEntry(const char* name, WindowFactory factory) {
        WindowClass entry;
        entry.name = name;
        entry.factory = factory;
        addWindowClass(std::move(entry));
    }
};

/// Creates a window and attaches `object` (may be null) before its first message. Null when the class is unknown, when
/// there is no display, or when WM_CREATE was answered with -1.
/// @param stood set when the window got so far that its object has seen messages, its end included.
TVX_PLATFORM_API HWND createWindow(const CREATESTRUCT& cs, CWnd* object, bool* stood = nullptr);

/// The widget that shows a window's client area; null for no window. The area begins at clientRect() in it.
TVX_PLATFORM_API QWidget* peerOf(HWND handle);

/// UTF-8 text and the toolkit's. A byte of a broken sequence is the lone surrogate U+DC00 + byte there: it shows as a
/// replacement character and comes back as the same byte.
TVX_PLATFORM_API QString toQt(const char* text);
TVX_PLATFORM_API std::string fromQt(const QString& text);

} // namespace tvx::afx
