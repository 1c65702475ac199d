#include "s/FrameTheme.h"

#include "platform/win/Module.h"
#include "platform/win/ResourceLibrary.h"

#include <algorithm>
#include <cstdlib>
#include <utility>

// The parts, states, colours and sizes that are asked for, by the numbers that visual-styles libraries have for them.
namespace {

constexpr int minimizeButton = 15;
constexpr int childMinimizeButton = 16;
constexpr int normal = 1;
constexpr int pushed = 3;
constexpr int disabled = 4;
constexpr int inactive = 5;

constexpr std::array colorIndexes{2, 9, 3, 19, 15, 18, 15, 18};

bool switchedOn = true;
Gui_FrameTheme* shared = nullptr;

template <class Function>
void find(HMODULE module, LPCSTR name, Function& function) {
    function = reinterpret_cast<Function>(GetProcAddress(module, name));
}

} // namespace

ThemeLibrary ThemeLibrary::load() {
    ThemeLibrary library;
    library.module = LoadLibraryA("uxtheme");
    if (!library.module) {
        return library;
    }
    find(library.module, "IsThemeActive", library.isThemeActive);
    find(library.module, "IsAppThemed", library.isAppThemed);
    find(library.module, "OpenThemeData", library.openThemeData);
    find(library.module, "CloseThemeData", library.closeThemeData);
    find(library.module, "GetThemeSysColor", library.getThemeSysColor);
    find(library.module, "GetThemeSysSize", library.getThemeSysSize);
    find(library.module, "DrawThemeBackground", library.drawThemeBackground);
    return library;
}

void ThemeLibrary::unload() {
    if (module) {
        FreeLibrary(module);
    }
    *this = ThemeLibrary();
}

// --- the process's own ---

Gui_FrameTheme::Gui_FrameTheme(std::function<ThemeLibrary()> load) : m_load(std::move(load)) {}

Gui_FrameTheme::~Gui_FrameTheme() {
    close();
    m_library.unload();
}

void Gui_FrameTheme::acquire() {
    if (!shared) {
        shared = new Gui_FrameTheme;
    }
    ++shared->m_references;
}

void Gui_FrameTheme::release() {
    if (shared && --shared->m_references == 0) {
        delete std::exchange(shared, nullptr);
        switchedOn = false;
    }
}

Gui_FrameTheme* Gui_FrameTheme::current() {
    return shared;
}

bool Gui_FrameTheme::isSwitchedOn() {
    return switchedOn;
}

// --- preparing ---

void Gui_FrameTheme::initialise() {
    const char* wish = std::getenv("TVX_GUI_USETHEMES");
    if (wish && *wish == '0') {
        switchedOn = false;
    }
    CWnd* window = AfxGetMainWnd();
    if (!switchedOn || !loadLibrary() || !window) {
        return;
    }
    if (!m_theme) {
        open(*window);
    }
    if (m_theme && !hasPictures()) {
        renderAll(*window);
    }
}

/// False when there is none, or none that is in use, which turns the visual style off.
bool Gui_FrameTheme::loadLibrary() {
    if (m_library.module) {
        return true;
    }
    m_library = m_load();
    const bool used = m_library.module && m_library.isThemeActive && m_library.isThemeActive() &&
                      m_library.isAppThemed && m_library.isAppThemed();
    switchedOn = used;
    return used;
}

void Gui_FrameTheme::open(CWnd& window) {
    m_theme = m_library.openThemeData ? m_library.openThemeData(window.m_hWnd, "WINDOW") : nullptr;
    for (std::size_t i = 0; i < m_colors.size(); ++i) {
        m_colors[i] = color(colorIndexes[i]);
    }
    measureCaption(window);
    measureMenuBar();
}

void Gui_FrameTheme::close() {
    if (m_theme && m_library.closeThemeData) {
        m_library.closeThemeData(m_theme);
    }
    m_theme = nullptr;
    m_pictures = {};
}

void Gui_FrameTheme::changed(CFrameWnd& frame) {
    close();
    initialise();
    frame.PostMessage(WM_NCPAINT, 1);
}

COLORREF Gui_FrameTheme::color(int index) const {
    return m_theme && m_library.getThemeSysColor ? m_library.getThemeSysColor(m_theme, index) : ::GetSysColor(index);
}

int Gui_FrameTheme::size(int index) const {
    return m_theme && m_library.getThemeSysSize ? m_library.getThemeSysSize(m_theme, index) : ::GetSystemMetrics(index);
}

/// Asks the main window from its right edge leftwards for its minimise button, beside which the button goes.
void Gui_FrameTheme::measureCaption(const CWnd& window) {
    m_caption = Place();
    CRect frame;
    window.GetWindowRect(&frame);
    const int edge = ::GetSystemMetrics(SM_CYFRAME);
    const int height = size(SM_CYSIZE);
    const int line = frame.top + edge + height / 2;
    const auto isMinimize = [&](int x) {
        return ::SendMessageA(window.m_hWnd, WM_NCHITTEST, 0, MAKELPARAM(x, line)) == HTMINBUTTON;
    };
    int right = frame.right - 1;
    while (right >= frame.left && !isMinimize(right)) {
        --right;
    }
    if (right < frame.left) {
        return;
    }
    int left = right;
    while (left > frame.left && isMinimize(left - 1)) {
        --left;
    }
    const int width = right - left;
    m_caption = {left - width - frame.right - 1, (height - width) / 2 + edge, width, width};
}

void Gui_FrameTheme::measureMenuBar() {
    const int width = size(SM_CXMENUSIZE);
    m_menuBar = {-4 * width - ::GetSystemMetrics(SM_CXFRAME),
                 ::GetSystemMetrics(SM_CYFRAME) + ::GetSystemMetrics(SM_CYCAPTION), width, size(SM_CYMENUSIZE)};
}

// --- pictures ---

/// How one of the six pictures is made.
struct Gui_FrameTheme::Picture {
    int part;
    int state;
    Color background;
    Color sign;
    bool samplesSign;  ///< whether the colour of the sign is read from the picture
    bool searchesSign; ///< whether its place is; else it is where it was in the picture before
};

bool Gui_FrameTheme::hasPictures() const {
    return m_pictures[0] != nullptr;
}

void Gui_FrameTheme::renderAll(CWnd& window) {
    static constexpr std::array pictures{Picture{minimizeButton, normal, ActiveCaption, ActiveSign, false, true},
                                         Picture{minimizeButton, inactive, InactiveCaption, InactiveSign, false, false},
                                         Picture{minimizeButton, pushed, ActiveCaption, ActiveSign, false, false},
                                         Picture{childMinimizeButton, normal, MenuFace, MenuSign, true, true},
                                         Picture{childMinimizeButton, disabled, MenuGrey, MenuGreySign, true, false},
                                         Picture{childMinimizeButton, pushed, MenuFace, MenuSign, false, false}};
    if (m_caption.isEmpty()) {
        measureCaption(window);
    }
    if (m_caption.isEmpty()) {
        return;
    }
    CRect sign;
    for (std::size_t i = 0; i < pictures.size(); ++i) {
        m_pictures[i] = render(window, pictures[i], sign);
    }
}

namespace {

/// The colour below the middle of a picture that differs from the middle: that of the sign. A picture of one colour has
/// none to read: the sign keeps the colour that it has, or nobody would see it on that ground.
COLORREF sampledSign(const CDC& dc, CSize size, COLORREF present) {
    const COLORREF middle = dc.GetPixel(size.cx / 2, size.cy / 2);
    for (int y = size.cy / 2 + 1; y < size.cy; ++y) {
        if (const COLORREF found = dc.GetPixel(size.cx / 2, y); found != middle) {
            return found;
        }
    }
    return present;
}

/// The place of what has the sign's colour in the lower half of a picture; both edges belong to it.
CRect signPlace(const CDC& dc, CSize size, COLORREF sign) {
    CRect place(size.cx, size.cx, 0, 0);
    for (int y = size.cy / 2 + 1; y < size.cy - 1; ++y) {
        for (int x = 1; x < size.cx - 1; ++x) {
            if (dc.GetPixel(x, y) == sign) {
                place = CRect(std::min<int>(place.left, x), std::min<int>(place.top, y), std::max<int>(place.right, x),
                              std::max<int>(place.bottom, y));
            }
        }
    }
    return place;
}

/// Lets what is above the sign run down over it.
void eraseSign(CDC& dc, const CRect& place) {
    for (int y = place.top; y <= place.bottom; ++y) {
        for (int x = place.left; x <= place.right; ++x) {
            dc.SetPixel(x, y, dc.GetPixel(x, y - 1));
        }
    }
}

} // namespace

std::unique_ptr<Gui_Bitmap> Gui_FrameTheme::render(CWnd& window, const Picture& picture, CRect& sign) {
    if (!m_theme || !m_library.drawThemeBackground) {
        return nullptr;
    }
    const Place& place = picture.part == minimizeButton ? m_caption : m_menuBar;
    const CSize size(place.width, place.height);
    CClientDC screen(&window);
    CDC dc;
    auto bitmap = std::make_unique<Gui_Bitmap>();
    if (!dc.CreateCompatibleDC(&screen) || !bitmap->CreateCompatibleBitmap(&screen, size.cx, size.cy)) {
        return nullptr;
    }
    CBitmap* before = dc.SelectObject(bitmap.get());
    const CRect whole(CPoint(0, 0), size);
    dc.FillSolidRect(whole, m_colors[picture.background]);
    m_library.drawThemeBackground(m_theme, dc.m_hDC, picture.part, picture.state, whole, nullptr);
    if (picture.samplesSign) {
        m_colors[picture.sign] = sampledSign(dc, size, m_colors[picture.sign]);
    }
    if (picture.searchesSign) {
        sign = signPlace(dc, size, m_colors[picture.sign]);
    }
    eraseSign(dc, sign);
    dc.SelectObject(before);
    return bitmap;
}

// --- for one frame ---

namespace {

/// Of child frames only one is drawn active, whatever window they are in: the button is a part of that picture.
bool isActive(const CFrameWnd& frame) {
    const CWnd* top = frame.GetTopLevelParent();
    const auto* child = DYNAMIC_DOWNCAST(CMDIChildWnd, &frame);
    const CMDIFrameWnd* main = child ? child->GetMDIFrame() : nullptr;
    return top && top == CWnd::GetActiveWindow() && (!main || main->MDIGetActive() == child);
}

} // namespace

bool Gui_FrameTheme::isInMenuBar(const CFrameWnd& frame) {
    const auto* main = DYNAMIC_DOWNCAST(CMDIFrameWnd, AfxGetMainWnd());
    BOOL maximized = FALSE;
    return main && main == &frame && main->MDIGetActive(&maximized) && maximized;
}

CRect Gui_FrameTheme::buttonPlace(const CFrameWnd& frame, bool onScreen) const {
    const Place& place = isInMenuBar(frame) ? m_menuBar : m_caption;
    CRect window;
    frame.GetWindowRect(&window);
    const CPoint at(window.Width() + place.x, place.y);
    return {onScreen ? at + window.TopLeft() : at, CSize(place.width, place.height)};
}

bool Gui_FrameTheme::drawButton(const CFrameWnd& frame, CDC& dc, CPoint at, bool pushed) const {
    const std::size_t first = isInMenuBar(frame) ? 3 : 0;
    const auto& picture = m_pictures[first + (!isActive(frame) ? 1 : pushed ? 2 : 0)];
    return picture && picture->Draw(&dc, at, SRCCOPY) != 0;
}

bool Gui_FrameTheme::signColor(const CFrameWnd& frame, COLORREF& color) const {
    if (!switchedOn || !hasPictures()) {
        return false;
    }
    const bool active = isActive(frame);
    color =
        isInMenuBar(frame) ? m_colors[active ? MenuSign : MenuGreySign] : m_colors[active ? ActiveSign : InactiveSign];
    return true;
}
