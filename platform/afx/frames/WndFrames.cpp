#include "platform/afx/frames/Frame.h"

CFrameWnd* CWnd::GetParentFrame() const {
    for (CWnd* parent = GetParent(); parent; parent = parent->GetParent()) {
        if (parent->IsFrameWnd()) {
            return static_cast<CFrameWnd*>(parent);
        }
    }
    return nullptr;
}

CFrameWnd* CWnd::GetTopLevelFrame() const {
    auto* frame = const_cast<CWnd*>(this);
    CFrameWnd* top = IsFrameWnd() ? static_cast<CFrameWnd*>(frame) : GetParentFrame();
    if (!top) {
        return nullptr;
    }
    while (CFrameWnd* outer = top->GetParentFrame()) {
        top = outer;
    }
    return top;
}
