#pragma once

/// @file
/// Tips as users see them.

#include <QProxyStyle>
#include <QTest>
#include <QTimer>
#include <QToolTip>

#include <string>

/// A style whose tips come up as soon as the pointer rests.
class QuickTips : public QProxyStyle {
public:
    QuickTips() : QProxyStyle(QStringLiteral("Fusion")) {}
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override {
        return hint == SH_ToolTip_WakeUpDelay ? 1 : QProxyStyle::styleHint(hint, option, widget, data);
    }
};

/// Puts the pointer at a point of a widget and leaves it there for longer than tips take.
inline void rest(QWidget& widget, QPoint point) {
    QTest::mouseMove(&widget, point);
    bool rested = false;
    QTimer::singleShot(50, &widget, [&rested] { rested = true; });
    (void)QTest::qWaitFor([&rested] { return rested; });
}

/// Whether a tip is shown, or comes to be; the empty text: whether none is, or goes.
inline bool isTip(const std::string& text) {
    return QTest::qWaitFor([&text] { return (QToolTip::isVisible() ? QToolTip::text().toStdString() : "") == text; });
}
