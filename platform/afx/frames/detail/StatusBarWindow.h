#pragma once

/// @file
/// The windows of status bars.

#include "platform/afx/controls/detail/TipWindow.h"
#include "platform/afx/frames/detail/BarWindow.h"
#include "platform/afx/frames/detail/StatusPane.h"
#include "platform/afx/gdi/GdiTypes.h"

#include <QElapsedTimer>
#include <QStatusBar>

#include <vector>

namespace tvx::afx {

/// The toolkit's status bar with our panes, which lie in a row of their own. No pane keeps the window wide: those that
/// stretch give way first, then the ones at the end are cut.
class StatusBarWidget : public QStatusBar {
public:
    explicit StatusBarWidget(QWidget* parent);

    void setCount(int count);
    /// The pane of an index, null outside the bar.
    [[nodiscard]] StatusPane* pane(int index) const;
    /// The pane at a point, null where there is none.
    [[nodiscard]] StatusPane* paneAt(QPoint point) const;
    /// Gives the panes their places.
    void place();
    /// Draws the panes with a font of the host's; null for the desktop's, also when that becomes another one.
    void useFont(HFONT font);
    /// What the panes are drawn with.
    [[nodiscard]] const QFont& paneFont() const {
        return m_paneFont;
    }
    /// The desktop's font for status bars, described as hosts measure with it.
    [[nodiscard]] LOGFONT desktopFont() const;
    /// Shows a pane's text at once, unless texts come faster than anybody sees them: then it is seen soon.
    void showNow(StatusPane& pane);

    [[nodiscard]] QSize sizeHint() const override;
    [[nodiscard]] QSize minimumSizeHint() const override;

protected:
    bool event(QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    [[nodiscard]] QRect room() const;
    void applyFont();
    bool isDue();

    std::vector<StatusPane*> m_panes;
    HFONT m_hostFont = nullptr;
    QFont m_paneFont;
    QElapsedTimer m_frame; ///< since the first text of those that count together
    int m_inFrame = 0;     ///< how many of them have been shown
};

class TVX_PLATFORM_API StatusBarWindow : public BarWindow, public CutTexts {
public:
    using BarWindow::BarWindow;
    ~StatusBarWindow() override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    /// The bar's name; its texts are those of the panes.
    [[nodiscard]] QString text() const override;
    [[nodiscard]] QString cutTextAt(QPoint point) const override;
    [[nodiscard]] StatusBarWidget* bar() const {
        return static_cast<StatusBarWidget*>(widget());
    }

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void fontChanged() override;

private:
    HFONT desktopFont();
    HFONT m_desktopFont = nullptr; ///< for hosts that ask for the bar's font; null before
    LOGFONT m_described{};         ///< what it was made from
};

} // namespace tvx::afx
