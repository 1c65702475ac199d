#pragma once

#include "afxwin.h"
#include "platform/port/StringBase.h"
#include "s/Export.h"

/// The band above the page of a property sheet: a title and a line below it, white on the shadow colour of buttons.
///
/// The title is bold and as high as the band allows, five twelfths of it. Texts stand in the middle; one that is wider
/// than the band ends in dots. Assistive tools read both texts as the label of the page.
class GUI_API Gui_TitleStatic : public CStatic { // NOLINT(cppcoreguidelines-virtual-class-destructor)
public:
    /// Both empty at first. A change is painted at once.
    /// @{
    void SetTitle(const Port::StringBase<char>& title);
    void SetSubTitle(const Port::StringBase<char>& subTitle);
    /// @}
    /// Whether the shadow colour is darkened, where it is too light, until white on it has a contrast of 4.5 to 1. Off
    /// at first.
    void SetReadable(bool readable);

protected:
    afx_msg void OnPaint();
    DECLARE_MESSAGE_MAP()

private:
    void changed();

    Port::StringBase<char> m_title;
    Port::StringBase<char> m_subTitle;
    bool m_readable = false;
};
