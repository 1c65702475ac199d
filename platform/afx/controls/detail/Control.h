#pragma once

/// @file
/// What all controls have in common: notifications to the parent, fonts, colours the parent chooses, owner drawing.

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/GdiTypes.h"

#include <QFont>
#include <QImage>
#include <QPalette>

namespace tvx::afx {

/// The class that stands for control classes nobody has registered: an empty frame.
inline constexpr const char* emptyPaneClass = "TvxEmptyPane";

/// The toolkit's font for a handle; the user-interface font for null.
TVX_PLATFORM_API QFont toolkitFont(HFONT font);

/// A control: a child window that tells its parent what the user does with it.
class TVX_PLATFORM_API Control : public Window {
public:
    using Window::Window;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    /// Sends WM_COMMAND with this notification code to the parent. The control may be gone afterwards.
    void notify(int code);
    /// What WM_GETDLGCODE answers (DLGC_...).
    /// @param msg the key message that is asked about, null when none is.
    virtual UINT dialogCode(const MSG* msg) const;
    /// The message that asks the parent for this control's colours.
    virtual UINT colorMessage() const;
    /// The text as mnemonics are looked up in it; empty for controls whose text has none.
    virtual QString mnemonicText() const {
        return {};
    }

protected:
    void widgetMade() override;
    void fontChanged() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    /// The widget whose palette carries the colours.
    virtual QWidget* colorWidget() const {
        return clientWidget();
    }
    /// The colours of the kind that are not the desktop's for its widget.
    virtual QPalette ownPalette() const {
        return {};
    }
    /// How the colours that the parent chose are put into a palette.
    virtual void applyColors(QPalette& palette, const QColor& text, const QColor& background) const;
    /// The same for what is typed into or chosen from: its text stands on the palette's base.
    static void applyFieldColors(QPalette& palette, const QColor& text, const QColor& background);
    /// Tells the parent of the keyboard's coming and going, where the kind has a notification for it.
    virtual void focusMoved(bool got) {}
    /// Whether the user can give the control the keyboard.
    virtual bool takesFocus() const {
        return true;
    }
    void applyFocusPolicy();
    bool hasBorder() const {
        return (style() & WS_BORDER) != 0 || (exStyle() & (WS_EX_CLIENTEDGE | WS_EX_STATICEDGE)) != 0;
    }
    void askColors();
    void applyPalette();
    /// Has the parent draw the whole control.
    /// @param type ODT_... @param state ODS_..., without ODS_DISABLED
    void paintByOwner(QPainter& painter, UINT type, UINT state);

private:
    struct Colors {
        bool chosen = false;
        QRgb text = 0;
        QRgb background = 0;
        bool operator==(const Colors&) const = default;
    };
    Colors chosenColors() const;
    Colors m_colors;
};

/// A picture that the parent paints items of an owner-drawn control into, in the control's client coordinates.
///
/// Drawing goes into memory rather than to the screen, so that it also shows where the toolkit renders the widget into
/// something else.
class TVX_PLATFORM_API OwnerPainting {
public:
    /// @param back which of the control's colours the picture is filled with first, Window or Base. The owner finds it
    /// as the colour behind texts, and the one that belongs to it as the colour of texts.
    OwnerPainting(Control& control, QSize size, QPalette::ColorRole back);
    ~OwnerPainting();
    OwnerPainting(const OwnerPainting&) = delete;
    OwnerPainting& operator=(const OwnerPainting&) = delete;
    /// Sends WM_DRAWITEM; handles and identifiers are filled in here.
    void draw(DRAWITEMSTRUCT item);
    QImage image() const;

private:
    Control& m_control;
    double m_ratio; ///< pixels of the picture in one of the control
    HDC m_dc = nullptr;
    HBITMAP m_bitmap = nullptr;
    HGDIOBJ m_oldBitmap = nullptr;
    HGDIOBJ m_oldFont = nullptr;
};

} // namespace tvx::afx
