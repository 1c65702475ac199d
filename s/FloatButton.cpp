#include "s/FloatHelp.h"
#include "s/FrameTheme.h"

#include <array>

// The button that floats or docks a view, as it stands in a frame's caption or in the main window's menu bar.

namespace {

// Colours of the platform, by its numbers.
constexpr int face = 15;
constexpr int shadow = 16;
constexpr int text = 18;
constexpr int highlight = 20;
constexpr int darkShadow = 21;
constexpr int light = 22;

/// The classic button: a bevel of two lines around its face.
void drawClassic(CDC& dc, CRect place, bool pushed) {
    const COLORREF outer = ::GetSysColor(highlight);
    const COLORREF dark = ::GetSysColor(darkShadow);
    dc.Draw3dRect(place, pushed ? dark : outer, pushed ? outer : dark);
    place.DeflateRect(1, 1);
    dc.Draw3dRect(place, ::GetSysColor(pushed ? shadow : light), ::GetSysColor(pushed ? face : shadow));
    place.DeflateRect(1, 1);
    dc.FillSolidRect(place, ::GetSysColor(face));
}

struct Stroke {
    std::array<POINT, 3> points;
};

/// Two chevrons, each two lines thick, around the point (0, 0).
constexpr std::array<Stroke, 4> floatSign{Stroke{{{{-4, -3}, {-1, 0}, {-5, 4}}}}, Stroke{{{{-3, -3}, {0, 0}, {-4, 4}}}},
                                          Stroke{{{{-1, -3}, {2, 0}, {-2, 4}}}}, Stroke{{{{0, -3}, {3, 0}, {-1, 4}}}}};
constexpr std::array<Stroke, 4> dockSign{Stroke{{{{-1, -3}, {-4, 0}, {0, 4}}}}, Stroke{{{{0, -3}, {-3, 0}, {1, 4}}}},
                                         Stroke{{{{2, -3}, {-1, 0}, {3, 4}}}}, Stroke{{{{3, -3}, {0, 0}, {4, 4}}}}};

void drawSign(CDC& dc, const std::array<Stroke, 4>& sign, CPoint center, COLORREF color) {
    CPen pen(PS_SOLID, 1, color);
    CPen* before = dc.SelectObject(&pen);
    for (Stroke stroke : sign) {
        for (POINT& point : stroke.points) {
            point.x += center.x;
            point.y += center.y;
        }
        dc.Polyline(stroke.points.data(), static_cast<int>(stroke.points.size()));
    }
    dc.SelectObject(before);
}

} // namespace

void Gui_FloatHelp::DrawRipRect() {
    drawButton(true);
}

void Gui_FloatHelp::DrawUnripRect() {
    drawButton(false);
}

void Gui_FloatHelp::drawButton(bool floats) {
    if (!m_owner || !m_owner->m_hWnd) {
        return;
    }
    announce();
    if (!isShown()) {
        return;
    }
    CWindowDC dc(m_owner);
    CRect place;
    GetButtonRect(place, false);
    CRect box(place);
    box.DeflateRect(2, 2);
    COLORREF color = ::GetSysColor(text);
    const Gui_FrameTheme* theme = Gui_FrameTheme::isSwitchedOn() ? Gui_FrameTheme::current() : nullptr;
    if (theme && theme->drawButton(*m_owner, dc, place.TopLeft(), m_isPushed)) {
        box.right += 2;
        box.bottom += 2;
        theme->signColor(*m_owner, color);
    } else {
        drawClassic(dc, box, m_isPushed);
    }
    CPoint center = box.CenterPoint();
    if (!m_isPushed) {
        center.Offset(-1, -1);
    }
    drawSign(dc, floats ? floatSign : dockSign, center, color);
}
