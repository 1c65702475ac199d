#pragma once

#include "platform/afx/controls/detail/TreeWindow.h"

#include <QAbstractScrollArea>

namespace tvx::afx {

/// The widget of a tree. Between these overrides and the place of ours below stand frames of the toolkit, which cannot
/// be unwound: what a host's handler throws is stored.
class TreeArea : public QAbstractScrollArea {
public:
    TreeArea(QWidget* parent, TreeWindow& window);

protected:
    bool viewportEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;

private:
    TreeWindow& m_window;
};

} // namespace tvx::afx
