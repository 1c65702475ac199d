#pragma once

/// @file
/// Static controls: texts, pictures, lines and frames.

#include "platform/afx/controls/detail/Control.h"

namespace tvx::afx {

/// The "Static" class.
class TVX_PLATFORM_API StaticWindow : public Control {
public:
    using Control::Control;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    void setText(const QString& text) override;
    bool passesMouse() const override {
        return (style() & SS_NOTIFY) == 0;
    }
    QString mnemonicText() const override;
    /// Called when the next control is made: tells assistive tools that the text, if there is one, stands for it.
    void labelFor(Control& next);
    /// Tells assistive tools that the text stands for a window, null: for none.
    void setLabelled(const Window* window);
    /// Draws the control into its widget.
    void paint(QPainter& painter);

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    bool takesFocus() const override {
        return false;
    }

private:
    DWORD type() const {
        return style() & SS_TYPEMASK;
    }
    bool isText() const;
    void tellText();
    void paintText(QPainter& painter, const QRect& area) const;
    void paintPicture(QPainter& painter, const QRect& area) const;
    bool paintShape(QPainter& painter, const QRect& area) const;
    QImage picture() const;
    void loadPicture();
    LRESULT setPicture(UINT kind, HANDLE picture);
    HANDLE m_picture = nullptr;
};

} // namespace tvx::afx
