#pragma once

#include "afxcmn.h"
#include "afxext.h"
#include "s/Export.h"

#include <memory>

/// A status bar with a tip for each pane that has one, with panes that are as wide as their texts, and with texts and
/// tips from the resources.
///
/// @code
/// constexpr UINT panes[] = {ID_SEPARATOR, ID_INDICATOR_ZOOM, ID_INDICATOR_NUM};
/// constexpr UINT tips[] = {0, IDS_ZOOM_TIP, IDS_NUM_TIP};
///
/// m_statusBar.Create(this);                            // in OnCreate of the frame, whose member the bar is
/// m_statusBar.SetIndicators(panes, std::size(panes));
/// m_statusBar.SetToolTips(tips, std::size(tips));
///
/// m_statusBar.SetPaneTextEx(1, "12.5 %", TRUE);        // the pane gets the width of this text
/// m_statusBar.ChangeTooltipText(1, "Zoom of the left view");
/// @endcode
///
/// The tips follow the panes: after a resize, after SetPaneInfo and SetPaneTextEx, and when they are enabled. A host
/// that changes panes in another way (SetIndicators, SetPaneStyle) calls EnableTooltips(0) and EnableTooltips(1). They
/// come up as the desktop's do, and tell the whole of a text that its pane has no room for on a line of their own.
///
/// Tips are set up once for a window. When the bar's window has ended and Create has made another, the bar is without
/// tips until SetToolTips is called again; all other operations can be called at any time.
///
/// An index outside the bar changes nothing. A string that there is not is an empty text: the pane shows nothing, the
/// tip does not come up.
class GUI_API Gui_StatusBar : public CStatusBar {
public:
    /// A bar without tips.
    Gui_StatusBar();
    ~Gui_StatusBar() override;

    /// Sets up the tips and enables them. Tips that were set up before are gone.
    /// @param ids  the string of each pane's tip, 0 for a pane without; they are copied
    /// @param count how many; those beyond the panes that there are count when such panes are made
    /// @return 1, or 0 without tips when the bar has no window
    int SetToolTips(const unsigned int* ids, unsigned short count);
    /// Lets tips come up (1) or keeps them from it (0).
    void EnableTooltips(unsigned char enable);
    /// Lets tips come up again if they are enabled. The bar does so itself when the frame is idle, so that only a host
    /// without an idle time needs it.
    void ReactivateTooltips();
    /// Changes the tip of a pane that SetToolTips gave one; for another pane nothing happens.
    /// @param text shown as it is; the empty one keeps the tip from coming up
    void ChangeTooltipText(int pane, const char* text);
    /// The same with a string of the resources.
    void ChangeTooltipText(int pane, unsigned int id);

    /// Shows a text in a pane; see CStatusBar::SetPaneText.
    BOOL SetPaneText(int pane, LPCSTR text, BOOL update = TRUE) override;
    /// The same with a string of the resources.
    BOOL SetPaneText(int pane, unsigned int id, BOOL update = TRUE);
    /// Makes a pane as wide as a text, wider or narrower than it was, and shows the text there: 2 pixels more than it
    /// measures in the bar's font. The number and the style of the pane stay; one that stretches gets no other width by
    /// this. For texts that change all the time a pane of one width is calmer.
    /// @return that of SetPaneText
    BOOL SetPaneTextEx(int pane, const char* text, BOOL update = TRUE);
    /// The same with a string of the resources.
    BOOL SetPaneTextEx(int pane, unsigned int id, BOOL update = TRUE);
    /// Changes number, style and width of a pane, as CStatusBar::SetPaneInfo does; the tips follow.
    void SetPaneInfo(int pane, unsigned int id, unsigned int style, int width);

    /// Tells the tips of the mouse.
    BOOL PreTranslateMessage(MSG* message) override;
    void OnUpdateCmdUI(CFrameWnd* target, BOOL disable) override;

protected:
    afx_msg void OnSize(UINT type, int width, int height);

    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    bool hasToolTips() const;
    void placeTools();

    std::unique_ptr<Record> m_record;
};
