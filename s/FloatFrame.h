#pragma once

#include "s/FloatHelp.h"
#include "s/FrameTheme.h"

/// What the three frames with a button for floating have in common: they draw it with their border, hand it the mouse,
/// and have its command in their system menu. Their message maps name these handlers.
template <class Base>
class FloatFrame : public Base {
public:
    ~FloatFrame() override {
        Gui_FrameTheme::release();
    }

    /// What the button and the moves are set up with.
    /// @{
    const Gui_FloatHelp& GetFloatHelp() const {
        return m_help;
    }
    Gui_FloatHelp& GetFloatHelp() {
        return m_help;
    }
    /// @}

    void OnUpdateFrameTitle(BOOL addToTitle) override {
        Base::OnUpdateFrameTitle(addToTitle);
        drawButton();
    }

    /// Handlers.
    /// @{
    afx_msg void OnNcPaint() {
        Base::OnNcPaint();
        drawButton();
    }
    afx_msg BOOL OnNcActivate(BOOL active) {
        const BOOL answer = Base::OnNcActivate(active);
        drawButton();
        return answer;
    }
    afx_msg void OnNcLButtonDown(UINT hitTest, CPoint point) {
        if (!m_help.OnNcLButtonDown(hitTest, point)) {
            Base::OnNcLButtonDown(hitTest, point);
        }
    }
    /// A second press soon after the first is one more press for the button, not a wish for a larger window.
    afx_msg void OnNcLButtonDblClk(UINT hitTest, CPoint point) {
        if (!m_help.OnNcLButtonDown(hitTest, point)) {
            Base::OnNcLButtonDblClk(hitTest, point);
        }
    }
    afx_msg void OnNcLButtonUp(UINT hitTest, CPoint point) {
        const HWND self = this->m_hWnd;
        Base::OnNcLButtonUp(hitTest, point);
        if (::IsWindow(self)) {
            m_help.OnNcLButtonUp(hitTest, point);
        }
    }
    afx_msg void OnLButtonUp(UINT flags, CPoint point) {
        CPoint onScreen(point);
        this->ClientToScreen(&onScreen);
        if (CWnd::GetCapture() != this || !m_help.OnNcLButtonUp(HTCAPTION, onScreen)) {
            Base::OnLButtonUp(flags, point);
        }
    }
    /// The mouse went elsewhere, to a box that came up: the press is given up.
    afx_msg void OnCaptureChanged(CWnd* taker) {
        m_help.CancelPress();
        Base::OnCaptureChanged(taker);
    }
    afx_msg LRESULT OnThemeChanged() {
        const LRESULT answer = Base::OnThemeChanged();
        this->PostMessage(WM_NCPAINT, 1);
        return answer;
    }
    /// @}

protected:
    /// @param floats true: the button floats the view; false: it docks it back
    explicit FloatFrame(bool floats) : m_floats(floats) {
        Gui_FrameTheme::acquire();
        m_help.SetIsRipOut(floats);
        m_help.SetOwner(this);
    }
    void prepareTheme() {
        if (Gui_FrameTheme* theme = Gui_FrameTheme::current()) {
            theme->initialise();
        }
    }
    /// Puts the command of the button into the system menu, with its picture.
    void addToSystemMenu(UINT command, UINT text, UINT picture) {
        CString name;
        CMenu* menu = this->GetSystemMenu(FALSE);
        if (!menu || !name.LoadString(text)) {
            return;
        }
        menu->AppendMenu(MF_STRING, command, name);
        if (m_picture.LoadBitmap(picture)) {
            menu->SetMenuItemBitmaps(command, MF_BYCOMMAND, &m_picture, &m_picture);
        }
    }

private:
    void drawButton() {
        if (m_floats) {
            m_help.DrawRipRect();
        } else {
            m_help.DrawUnripRect();
        }
    }

    bool m_floats;
    Gui_FloatHelp m_help;
    CBitmap m_picture;
};
