#pragma once

#include "afxwin.h"
#include "s/Bitmap.h"
#include "s/Export.h"

#include <array>
#include <functional>
#include <memory>

/// @file
/// Not for hosts: the desktop's visual style, for the floating frames.

/// The visual-styles library: its entry points, each null where it is missing.
struct ThemeLibrary {
    using Theme = void*; ///< the data of one class of parts

    HMODULE module = nullptr;
    BOOL (*isThemeActive)() = nullptr;
    BOOL (*isAppThemed)() = nullptr;
    Theme (*openThemeData)(HWND window, LPCSTR classes) = nullptr;
    LONG (*closeThemeData)(Theme theme) = nullptr;
    COLORREF (*getThemeSysColor)(Theme theme, int index) = nullptr;
    int (*getThemeSysSize)(Theme theme, int index) = nullptr;
    LONG (*drawThemeBackground)(Theme theme, HDC dc, int part, int state, const RECT* place,
                                const RECT* clip) = nullptr;

    /// Loads it; without one the module and all entry points are null.
    GUI_API static ThemeLibrary load();
    void unload();
};

/// What floating frames need to draw their button in the desktop's style: its place in captions and menu bars, its
/// colours and six pictures of it. One for the process, made for the first floating frame and gone with the last one.
///
/// Pictures are the style's minimise button with its sign taken out. Everything that is missing (the library, one of
/// its functions, the style, a minimise button) ends in no pictures: frames then draw a button of their own.
///
/// Used on the thread of the user interface only.
class GUI_API Gui_FrameTheme {
public:
    /// Frames share the one of `acquire`.
    /// @param load gives the visual-styles library when it is needed first; tests have others
    explicit Gui_FrameTheme(std::function<ThemeLibrary()> load = &ThemeLibrary::load);
    ~Gui_FrameTheme();
    Gui_FrameTheme(const Gui_FrameTheme&) = delete;
    Gui_FrameTheme& operator=(const Gui_FrameTheme&) = delete;

    /// Adds a user of the process's own and makes it for the first one.
    static void acquire();
    /// Takes one away. The last one turns the visual style off for the rest of the process.
    static void release();
    /// The process's own; null when nobody uses it.
    static Gui_FrameTheme* current();
    /// Whether the visual style is used: on at first, and once it is off, off for good.
    static bool isSwitchedOn();

    /// Brings it up to date: loads the library, measures, and draws the pictures, whatever of it is not done yet.
    /// Nothing happens without a main window of the application.
    void initialise();
    /// Follows a change of the desktop's style, and has the frame's border painted.
    void changed(CFrameWnd& frame);

    /// The button's place in a frame.
    /// @param onScreen in coordinates of the screen instead of the frame's window
    CRect buttonPlace(const CFrameWnd& frame, bool onScreen) const;
    /// Draws the button without a sign. False without pictures.
    bool drawButton(const CFrameWnd& frame, CDC& dc, CPoint at, bool pushed) const;
    /// The colour of the sign. False without pictures.
    bool signColor(const CFrameWnd& frame, COLORREF& color) const;

private:
    struct Place {
        int x = 0; ///< from the right edge of the window, negative
        int y = 0; ///< from its top
        int width = 0;
        int height = 0;
        bool isEmpty() const {
            return x == 0 && y == 0 && width == 0 && height == 0;
        }
    };
    struct Picture;
    enum Color { ActiveCaption, ActiveSign, InactiveCaption, InactiveSign, MenuFace, MenuSign, MenuGrey, MenuGreySign };
    static bool isInMenuBar(const CFrameWnd& frame);
    bool loadLibrary();
    void open(CWnd& window);
    void close();
    void measureCaption(const CWnd& window);
    void measureMenuBar();
    void renderAll(CWnd& window);
    std::unique_ptr<Gui_Bitmap> render(CWnd& window, const Picture& picture, CRect& sign);
    bool hasPictures() const;
    int size(int index) const;
    COLORREF color(int index) const;

    std::function<ThemeLibrary()> m_load;
    ThemeLibrary m_library;
    ThemeLibrary::Theme m_theme = nullptr;
    int m_references = 0;
    Place m_caption;
    Place m_menuBar;
    std::array<COLORREF, 8> m_colors{};
    std::array<std::unique_ptr<Gui_Bitmap>, 6> m_pictures;
};
