#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QApplication>
#include <QScreen>
#include <QStyle>
#include <QStyleHints>
#include <QStyleOption>

#include <algorithm>

namespace {

QRect primaryScreen() {
    const QScreen* screen = qGuiApp ? QGuiApplication::primaryScreen() : nullptr;
    return screen ? screen->geometry() : QRect();
}

QRect workArea() {
    const QScreen* screen = qGuiApp ? QGuiApplication::primaryScreen() : nullptr;
    return screen ? screen->availableGeometry() : QRect();
}

QRect allScreens() {
    const QScreen* screen = qGuiApp ? QGuiApplication::primaryScreen() : nullptr;
    return screen ? screen->virtualGeometry() : QRect();
}

int screenMetric(int index) {
    switch (index) {
    case SM_CXSCREEN:
        return primaryScreen().width();
    case SM_CYSCREEN:
        return primaryScreen().height();
    case SM_CXFULLSCREEN:
        return workArea().width();
    // The client area of a maximised window: it has a caption, but its borders lie beyond the screen.
    case SM_CYFULLSCREEN:
        return workArea().height() - GetSystemMetrics(SM_CYCAPTION);
    case SM_XVIRTUALSCREEN:
        return allScreens().left();
    case SM_YVIRTUALSCREEN:
        return allScreens().top();
    case SM_CXVIRTUALSCREEN:
        return allScreens().width();
    case SM_CYVIRTUALSCREEN:
        return allScreens().height();
    case SM_CMONITORS:
        return static_cast<int>(QGuiApplication::screens().size());
    default:
        return 0;
    }
}

int pixelMetric(QStyle::PixelMetric metric) {
    return QApplication::style()->pixelMetric(metric);
}

/// Size of a button in the corner of a menu bar that serves a maximized document window.
QSize menuButtonSize() {
    QStyleOptionComplex option;
    option.subControls = QStyle::SC_MdiMinButton | QStyle::SC_MdiNormalButton | QStyle::SC_MdiCloseButton;
    const QSize three = QApplication::style()->sizeFromContents(QStyle::CT_MdiControls, &option, QSize());
    return {three.width() / 3, three.height()};
}

/// What a button takes in a caption.
QSize captionButtonSize() {
    QStyleOptionTitleBar option;
    option.rect = QRect(0, 0, 400, pixelMetric(QStyle::PM_TitleBarHeight));
    option.titleBarFlags = Qt::Window | Qt::WindowTitleHint | Qt::WindowSystemMenuHint | Qt::WindowMinMaxButtonsHint |
                           Qt::WindowCloseButtonHint;
    option.subControls = QStyle::SC_All;
    const auto place = [&option](QStyle::SubControl button) {
        return QApplication::style()->subControlRect(QStyle::CC_TitleBar, &option, button);
    };
    // From one button to the next; and with the two pixels above and below that hosts leave free around theirs.
    return {place(QStyle::SC_TitleBarMaxButton).left() - place(QStyle::SC_TitleBarMinButton).left(),
            std::min(place(QStyle::SC_TitleBarMinButton).height() + 4, option.rect.height())};
}

int frameMetric(int index) {
    switch (index) {
    case SM_CYCAPTION:
    case SM_CYSMCAPTION:
        return pixelMetric(QStyle::PM_TitleBarHeight);
    case SM_CXFRAME:
    case SM_CYFRAME:
    case SM_CXDLGFRAME:
    case SM_CYDLGFRAME:
        return pixelMetric(QStyle::PM_MdiSubWindowFrameWidth);
    case SM_CXSIZE:
        return captionButtonSize().width();
    case SM_CYSIZE:
        return captionButtonSize().height();
    case SM_CXMENUSIZE:
        return menuButtonSize().width();
    case SM_CYMENUSIZE:
        return menuButtonSize().height();
    case SM_CXMIN:
        return pixelMetric(QStyle::PM_MdiSubWindowMinimizedWidth);
    case SM_CYMIN:
        return pixelMetric(QStyle::PM_TitleBarHeight) + 2 * pixelMetric(QStyle::PM_MdiSubWindowFrameWidth);
    default:
        return 0;
    }
}

int controlMetric(int index) {
    switch (index) {
    case SM_CXVSCROLL:
    case SM_CYHSCROLL:
    case SM_CYVSCROLL:
    case SM_CXHSCROLL:
        return pixelMetric(QStyle::PM_ScrollBarExtent);
    case SM_CYMENU:
        return QFontMetrics(QApplication::font()).height() + 2 * pixelMetric(QStyle::PM_MenuBarVMargin) +
               2 * pixelMetric(QStyle::PM_MenuBarPanelWidth) + pixelMetric(QStyle::PM_MenuBarItemSpacing);
    case SM_CXSMICON:
    case SM_CYSMICON:
        return pixelMetric(QStyle::PM_SmallIconSize);
    case SM_CXMENUCHECK:
    case SM_CYMENUCHECK:
        return pixelMetric(QStyle::PM_IndicatorWidth);
    default:
        return 0;
    }
}

/// Sizes that do not depend on the desktop.
int fixedMetric(int index) {
    switch (index) {
    case SM_CXBORDER:
    case SM_CYBORDER:
    case SM_MOUSEPRESENT:
        return 1;
    case SM_CXEDGE:
    case SM_CYEDGE:
        return 2;
    case SM_CMOUSEBUTTONS:
        return 3;
    case SM_CXDOUBLECLK:
    case SM_CYDOUBLECLK:
        return 4;
    case SM_CXICON:
    case SM_CYICON:
    case SM_CXCURSOR:
    case SM_CYCURSOR:
        return 32;
    case SM_CXDRAG:
    case SM_CYDRAG:
        return qGuiApp ? QGuiApplication::styleHints()->startDragDistance() : 4;
    default:
        return 0;
    }
}

} // namespace

int GetSystemMetrics(int index) {
    // These first: they are answered where there is no display, without starting the toolkit.
    if (const int fixed = fixedMetric(index)) {
        return fixed;
    }
    if (!tvx::afx::ensureGui()) {
        return 0;
    }
    if (const int metric = frameMetric(index)) {
        return metric;
    }
    const int metric = controlMetric(index);
    return metric ? metric : screenMetric(index);
}
