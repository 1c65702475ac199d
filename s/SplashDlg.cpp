#include "s/SplashDlg.h"

#include "platform/afx/dialogs/DialogWatch.h"
#include "res/resource.h"
#include "s/Bitmap.h"
#include "s/ProductTexts.h"
#include "s/Profile.h"
#include "s/Record.h"
#include "s/SplashTime.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdint>
#include <ctime>
#include <optional>
#include <thread>

namespace {

/// Notices that the user works with the main window in a way that brings no message to the application: the desktop
/// draws captions, and keeps the button presses on them.
class DesktopActs {
public:
    /// Looks again. Whether the window, once it was the active one and stood still, has been moved, or no window of
    /// the application is active any more.
    bool areSeen(CWnd* window) {
        const CWnd* active = CWnd::GetActiveWindow();
        if (!window || !window->m_hWnd || (!m_wasActive && active != window)) {
            return false;
        }
        CRect place;
        window->GetWindowRect(&place);
        const bool seen = m_stoodStill && (!active || place != m_place);
        m_stoodStill = m_wasActive && place == m_place;
        m_wasActive = true;
        m_place = place;
        return seen;
    }

private:
    bool m_wasActive = false;
    bool m_stoodStill = false; ///< From one look to the next: what brought it to its place at the start is over.
    CRect m_place;
};

} // namespace

struct Gui_SplashDlg::Record {
    std::int64_t shownAt = std::time(nullptr); ///< seconds
    std::unique_ptr<Gui_Bitmap> picture;       ///< while it is needed
    ProductTexts texts;
    bool painted = false;
    std::optional<tvx::DialogWatch> dialogs;
    DesktopActs acts;
};

namespace {

constexpr UINT_PTR wakeTimer = 1;
constexpr UINT wakeInterval = 200;  ///< milliseconds
constexpr DWORD longestWait = 1000; ///< milliseconds; a desktop shows a window in some tens

/// Where the picture's left top corner goes when it stands over the middle of the saved window; 0, 0 when nothing is
/// saved that helps.
CPoint savedCorner(CSize picture) {
    WINDOWPLACEMENT saved{};
    if (!Gui_Profile::ReadWindowPlacement(saved, nullptr, nullptr) || saved.showCmd == SW_SHOWMINIMIZED ||
        saved.showCmd == SW_SHOWMAXIMIZED) {
        return {0, 0};
    }
    const RECT& window = saved.rcNormalPosition;
    const CPoint corner(window.left + (window.right - window.left) / 2 - picture.cx / 2,
                        window.top + (window.bottom - window.top) / 2 - picture.cy / 2);
    const CRect screen(0, 0, GetSystemMetrics(SM_CXSCREEN), GetSystemMetrics(SM_CYSCREEN));
    return screen.PtInRect(corner) ? corner : CPoint(0, 0);
}

bool isPress(UINT message) {
    constexpr std::array presses = {WM_KEYDOWN,     WM_SYSKEYDOWN,    WM_LBUTTONDOWN,   WM_RBUTTONDOWN,
                                    WM_MBUTTONDOWN, WM_NCLBUTTONDOWN, WM_NCRBUTTONDOWN, WM_NCMBUTTONDOWN};
    return std::ranges::any_of(presses, [message](auto press) { return message == static_cast<UINT>(press); });
}

} // namespace

BEGIN_MESSAGE_MAP(Gui_SplashDlg, CDialog)
ON_WM_PAINT()
ON_WM_TIMER()
END_MESSAGE_MAP()

Gui_SplashDlg::Gui_SplashDlg(CWnd* parent) : CDialog(GUI_IDD_SPLASH, parent), m_record(MakeRecord<Record>()) {}

Gui_SplashDlg::~Gui_SplashDlg() = default;

int Gui_SplashDlg::Create(CWnd* parent) {
    if (!CDialog::Create(GUI_IDD_SPLASH, parent)) {
        return 0;
    }
    if (!loadPicture()) {
        return 1;
    }
    place();
    showNow();
    // From here on: the window itself is a dialog.
    m_record->dialogs.emplace([this] { Destroy(); });
    SetTimer(wakeTimer, wakeInterval);
    return 1;
}

BOOL Gui_SplashDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    m_record->shownAt = std::time(nullptr);
    m_record->texts = GetProductTexts();
    SetWindowText(AfxGetAppName()); // for task lists and assistive tools
    return FALSE;                   // the keyboard stays where it is
}

void Gui_SplashDlg::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
}

bool Gui_SplashDlg::loadPicture() {
    if (!m_record->picture) {
        auto picture = std::make_unique<Gui_Bitmap>();
        if (!picture->LoadBitmap("CDSPLASHBMP")) {
            return false;
        }
        m_record->picture = std::move(picture);
    }
    return true;
}

void Gui_SplashDlg::place() {
    const CSize picture = m_record->picture->GetSize();
    const CPoint corner = savedCorner(picture);
    const bool centred = corner == CPoint(0, 0);
    const UINT keep = centred ? SWP_NOMOVE : 0;
    SetWindowPos(&wndTopMost, corner.x, corner.y, picture.cx, picture.cy, SWP_NOACTIVATE | keep);
    if (centred) {
        CenterWindow();
    }
}

void Gui_SplashDlg::showNow() {
    CRect place;
    GetWindowRect(&place);
    ShowWindow(SW_SHOWNA);
    if (GetSystemMetrics(SM_CMONITORS) == 1) {
        // Dialogs are kept on a screen, which keeps this one from lying across two. On a single screen it stays in the
        // middle of the saved window, wherever that was.
        SetWindowPos(nullptr, place.left, place.top, 0, 0, SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
    }
    InvalidateRect(nullptr);
    UpdateWindow();
    // A desktop takes a while to bring up a window, and the application, which starts, is not going to ask for events
    // soon. Asked for a message that is never posted, the queue stays as it is while the desktop is listened to.
    const DWORD begin = GetTickCount();
    MSG message{};
    while (m_hWnd && !m_record->painted && GetTickCount() - begin < longestWait) {
        PeekMessage(&message, m_hWnd, WM_NCDESTROY, WM_NCDESTROY, PM_NOREMOVE);
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
}

// --- the end ---

void Gui_SplashDlg::CheckMessage(MSG* message, CWnd* mainWindow) {
    if (m_hWnd && isPress(message->message)) {
        dismiss(mainWindow);
    }
}

int Gui_SplashDlg::CheckTimeout(CWnd* mainWindow) {
    if (m_hWnd && IsSplashOver(m_record->shownAt, std::time(nullptr))) {
        dismiss(mainWindow);
    }
    return m_hWnd ? 1 : 0;
}

void Gui_SplashDlg::Destroy() {
    if (m_hWnd) {
        DestroyWindow();
    }
}

void Gui_SplashDlg::dismiss(CWnd* mainWindow) {
    Destroy();
    if (mainWindow) {
        mainWindow->UpdateWindow();
    }
}

void Gui_SplashDlg::PostNcDestroy() {
    m_record->dialogs.reset();
    m_record->picture.reset();
    CDialog::PostNcDestroy();
}

void Gui_SplashDlg::OnTimer(UINT_PTR id) {
    // The message brings the idle time, too, in which the host looks at the clock.
    CWnd* mainWindow = AfxGetMainWnd();
    if (m_record->acts.areSeen(mainWindow)) {
        dismiss(mainWindow);
        return;
    }
    CDialog::OnTimer(id);
}

// --- the picture ---

namespace {

constexpr int unitsPerInch = 1440;

/// One line of text on the picture. Places are pixels, heights logical units.
struct Line {
    CString text;
    int height;
    CPoint place;
    bool staysCentred;
};

constexpr int leftMargin = 10;

class LineFont {
public:
    LineFont(CDC& dc, int height) : m_dc(dc) {
        LOGFONT description{};
        description.lfHeight = height;
        description.lfCharSet = DEFAULT_CHARSET;
        description.lfPitchAndFamily = FF_SWISS;
        m_font.CreateFontIndirect(&description);
        m_old = m_dc.SelectObject(&m_font);
    }
    ~LineFont() {
        m_dc.SelectObject(m_old);
    }
    LineFont(const LineFont&) = delete;
    LineFont& operator=(const LineFont&) = delete;

private:
    CDC& m_dc;
    CFont m_font;
    CFont* m_old;
};

int widthOf(CDC& dc, const CString& text, int height) {
    const LineFont font(dc, height);
    return dc.GetTextExtent(text).cx;
}

/// The line's height, or less for a text that would leave the picture.
int fittingHeight(CDC& dc, const Line& line, int room) {
    constexpr int least = 100; // 5 points: smaller, it could not be read
    constexpr int step = 20;
    int height = line.height;
    while (height > least && widthOf(dc, line.text, height) > room) {
        height -= step;
    }
    return height;
}

void draw(CDC& dc, const Line& line, int pictureWidth) {
    std::array<POINT, 3> points = {line.place, CPoint(leftMargin, line.place.y), CPoint(pictureWidth, 0)};
    dc.DPtoLP(points.data(), points.size());
    const auto& [centre, left, edge] = points;
    const bool fits = centre.x - widthOf(dc, line.text, line.height) / 2 >= 0;
    const bool centred = fits || line.staysCentred;
    const LineFont font(dc, fittingHeight(dc, line, centred ? 2 * centre.x : edge.x - 2 * left.x));
    const POINT at = centred ? centre : left;
    dc.SetTextAlign(centred ? TA_CENTER : TA_LEFT);
    dc.TextOut(at.x, at.y, line.text);
}

} // namespace

void Gui_SplashDlg::OnPaint() {
    CPaintDC dc(this);
    if (!m_record->picture) {
        return;
    }
    m_record->painted = true;
    m_record->picture->Draw(&dc, 0, 0, SRCCOPY);
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(unitsPerInch, unitsPerInch);
    dc.SetViewportExt(dc.GetDeviceCaps(LOGPIXELSX), dc.GetDeviceCaps(LOGPIXELSY));
    dc.SetTextColor(RGB(0, 0, 0));
    dc.SetBkMode(TRANSPARENT);
    const ProductTexts& texts = m_record->texts;
    for (const Line& line :
         {Line{texts.name, 280, CPoint(100, 115), true}, //
          Line{texts.release, 200, CPoint(100, 147), false}, Line{texts.version, 200, CPoint(100, 169), false},
          Line{texts.copyright1, 160, CPoint(100, 213), false}, Line{texts.copyright2, 160, CPoint(100, 233), false}}) {
        draw(dc, line, m_record->picture->GetSize().cx);
    }
}
