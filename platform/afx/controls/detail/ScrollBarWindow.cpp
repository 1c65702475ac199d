#include "platform/afx/controls/detail/ScrollBarWindow.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/ScrollCode.h"

#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"

#include <QScrollBar>

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeScrollBar(const CREATESTRUCT& cs) {
    return std::make_unique<ScrollBarWindow>(cs);
}

const WindowClassEntry scrollBarEntry("ScrollBar", &makeScrollBar);

} // namespace

QWidget* ScrollBarWindow::makeWidget(QWidget* parent) {
    auto* bar = new QScrollBar((style() & SBS_VERT) != 0 ? Qt::Vertical : Qt::Horizontal, parent);
    bar->setRange(0, 0);
    bar->setInvertedControls(bar->orientation() == Qt::Vertical);
    // The parent decides where the slider stands; the toolkit's own idea is put back before it acts on it.
    connectStoring(bar, &QScrollBar::actionTriggered, bar, [this, bar](int action) {
        const int code = scrollCodeOf(action);
        const int position = bar->sliderPosition();
        if (code != SB_THUMBTRACK) {
            bar->setSliderPosition(bar->value());
        }
        tell(code, position);
    });
    connectStoring(bar, &QScrollBar::sliderReleased, bar, [this, bar] {
        const HWND self = handle();
        tell(SB_THUMBPOSITION, bar->sliderPosition());
        if (from(self)) {
            tell(SB_ENDSCROLL, 0);
        }
    });
    return bar;
}

QScrollBar* ScrollBarWindow::bar() const {
    return static_cast<QScrollBar*>(widget());
}

void ScrollBarWindow::tell(int code, int position) {
    armIdle();
    if (parent()) {
        const UINT message = (style() & SBS_VERT) != 0 ? WM_VSCROLL : WM_HSCROLL;
        SendMessageA(parent()->handle(), message, MAKEWPARAM(code, position), reinterpret_cast<LPARAM>(handle()));
    }
}

void ScrollBarWindow::setInfo(const SCROLLINFO& info) {
    SCROLLINFO now{};
    getInfo(now);
    now.nMin = (info.fMask & SIF_RANGE) != 0 ? info.nMin : now.nMin;
    now.nMax = (info.fMask & SIF_RANGE) != 0 ? info.nMax : now.nMax;
    now.nPage = (info.fMask & SIF_PAGE) != 0 ? info.nPage : now.nPage;
    now.nPos = (info.fMask & SIF_POS) != 0 ? info.nPos : now.nPos;
    const int page = static_cast<int>(now.nPage);
    // Kept, because the toolkit's range does not tell it any more.
    m_max = now.nMax;
    m_page = page;
    guarded([&] {
        bar()->setPageStep(std::max(page, 1));
        // The platform's range holds the page that is seen; the toolkit's ends with the last position.
        bar()->setRange(now.nMin, std::max(now.nMin, now.nMax - std::max(page - 1, 0)));
        bar()->setValue(now.nPos);
    });
}

void ScrollBarWindow::getInfo(SCROLLINFO& info) const {
    info.nMin = bar()->minimum();
    info.nMax = std::max(m_max, bar()->minimum());
    info.nPage = static_cast<UINT>(m_page);
    info.nPos = bar()->value();
    info.nTrackPos = bar()->sliderPosition();
}

UINT ScrollBarWindow::dialogCode(const MSG*) const {
    return DLGC_WANTARROWS;
}

LRESULT ScrollBarWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    SCROLLINFO info{};
    switch (message) {
    case SBM_SETPOS: {
        const int previous = bar()->value();
        info.fMask = SIF_POS;
        info.nPos = static_cast<int>(wParam);
        setInfo(info);
        return previous;
    }
    case SBM_GETPOS:
        return bar()->value();
    case SBM_SETRANGE:
        info.fMask = SIF_RANGE;
        info.nMin = static_cast<int>(wParam);
        info.nMax = static_cast<int>(lParam);
        setInfo(info);
        return 0;
    case SBM_GETRANGE:
        getInfo(info);
        *reinterpret_cast<int*>(wParam) = info.nMin;
        *reinterpret_cast<int*>(lParam) = info.nMax;
        return 0;
    case SBM_SETSCROLLINFO:
        setInfo(*reinterpret_cast<const SCROLLINFO*>(lParam));
        return bar()->value();
    case SBM_GETSCROLLINFO:
        getInfo(*reinterpret_cast<SCROLLINFO*>(lParam));
        return TRUE;
    default:
        return Control::defaultProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx
