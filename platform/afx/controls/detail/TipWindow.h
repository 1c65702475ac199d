#pragma once

/// @file
/// Tool-tip controls: what brings up the toolkit's tips over rectangles of windows.

#include "platform/afx/core/detail/Window.h"

#include <QElapsedTimer>
#include <QTimer>

#include <map>
#include <utility>

namespace tvx::afx {

/// A window that cuts texts off, and tells the whole of them by tips.
class CutTexts {
public:
    /// The whole of the text at a point of the client area; empty where nothing is cut off.
    [[nodiscard]] virtual QString cutTextAt(QPoint point) const = 0;

protected:
    ~CutTexts() = default;
};

/// The "tooltips_class32" class.
class TVX_PLATFORM_API TipWindow : public QObject, public Window {
public:
    explicit TipWindow(const CREATESTRUCT& cs);
    ~TipWindow() override;

    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;

    /// A tool's window and number.
    using Key = std::pair<HWND, UINT_PTR>;
    void add(const Key& key, const QRect& place, const QString& text);
    void setPlace(const Key& key, const QRect& place);
    void setText(const Key& key, const QString& text);
    void activate(bool active);
    void relay(const MSG& message);

    /// Whether a control has something to show at a point of a window's client area: the window then leaves what it has
    /// to tell there to the control.
    [[nodiscard]] static bool tellsAt(const Window& window, QPoint point);

    /// The pointer is gone from the tools' windows, or they are.
    bool eventFilter(QObject* watched, QEvent* event) override;

protected:
    QWidget* makeWidget(QWidget* parent) override;

private:
    struct Tool {
        QRect place;
        QString text;
    };
    using Tools = std::map<Key, Tool>;
    [[nodiscard]] Tools::const_iterator toolAt(HWND window, QPoint point) const;
    void moveTo(HWND window, QPoint point);
    void leave();
    void show();
    void hide();
    [[nodiscard]] bool isShown() const;

    Tools m_tools;
    bool m_isActive = true;
    Key m_under;           ///< the tool that the pointer is in; null and 0 for none
    QPoint m_point;        ///< the pointer, in the client area of that tool's window
    QTimer m_rest;         ///< runs while the pointer has not rested long enough
    QString m_shown;       ///< the tip brought up last
    QElapsedTimer m_awake; ///< since a tip of ours was seen last
};

/// A text as the toolkit's tips show it as it is: they take some texts for mark-up, and break lines of mark-up only.
[[nodiscard]] TVX_PLATFORM_API QString tipText(const QString& text);

} // namespace tvx::afx
