#pragma once

/// @file
/// Scroll bars that stand alone.

#include "platform/afx/controls/detail/Control.h"

class QScrollBar;

namespace tvx::afx {

/// The "ScrollBar" class: tells its parent by WM_HSCROLL or WM_VSCROLL where the user wants to go. The parent moves the
/// slider.
class TVX_PLATFORM_API ScrollBarWindow : public Control {
public:
    using Control::Control;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override {
        return WM_CTLCOLORSCROLLBAR;
    }

protected:
    QWidget* makeWidget(QWidget* parent) override;
    /// A click takes the keyboard to a bar that Tab reaches only.
    bool takesFocus() const override {
        return (style() & WS_TABSTOP) != 0;
    }

private:
    QScrollBar* bar() const;
    void tell(int code, int position);
    void setInfo(const SCROLLINFO& info);
    void getInfo(SCROLLINFO& info) const;
    int m_max = 0;
    int m_page = 0;
};

} // namespace tvx::afx
