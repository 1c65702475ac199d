#pragma once

/// @file
/// Top-level frames that draw their caption and border themselves.

#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/CaptionMouse.h"
#include "platform/afx/core/detail/PlainWindow.h"

namespace tvx::afx {

/// A top-level frame with WS_EX_OWNCAPTION: hosts are asked and told of its caption as of any part of the window, and
/// may draw on it.
class TVX_PLATFORM_API CaptionedWindow : public TopLevelWindow {
public:
    explicit CaptionedWindow(const CREATESTRUCT& cs);
    Caption* caption() const override;
    int hitTest(QPoint screen) const override;
    QRect screenRect() const override;
    void updateFrame() override;
    void stateChanged() override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;

    bool isHeldByCaption() const override;

protected:
    void widgetMade() override;
    QSize leastSize() const override;

private:
    void followStyle();
    mutable Caption m_caption;
    CaptionMouse m_mouse;
};

} // namespace tvx::afx
