#pragma once

/// @file
/// The row of tabs that names the child frames of a workbook.

#include "platform/win/Handle.h"

#include <QHash>
#include <QIcon>
#include <QTabBar>
#include <QTimer>

class QMdiSubWindow;

namespace tvx::afx {
class MdiClientWindow;
}

namespace tvx::sec {

/// Follows the child frames of a client window: which there are, their titles and icons, which one is active.
class SheetTabs : public QTabBar {
public:
    explicit SheetTabs(afx::MdiClientWindow& client);
    /// Shows an icon for a frame instead of its own; an empty one brings that back.
    void setIcon(const QMdiSubWindow& sheet, const QIcon& icon, bool atOnce);
    bool eventFilter(QObject* watched, QEvent* event) override;

protected:
    /// The tabs are as wide as their titles; the row never makes the main frame wider.
    QSize minimumSizeHint() const override;

private:
    void follow();
    void fill(const QList<QMdiSubWindow*>& sheets);
    void show(int index, QMdiSubWindow& sheet);
    void choose(int index);

    afx::MdiClientWindow* client() const;

    HWND m_client; ///< its widgets, this one too, go a little later than the window
    QHash<const QObject*, QIcon> m_icons;
    QTimer m_later; ///< Many changes in a row are followed once.
    bool m_following = false;
};

} // namespace tvx::sec
