#pragma once

/// @file
/// Buttons: push buttons, check boxes, radio buttons and group boxes.

#include "platform/afx/controls/detail/Control.h"

class QAbstractButton;

namespace tvx::afx {

/// The "Button" class.
class TVX_PLATFORM_API ButtonWindow : public Control {
public:
    using Control::Control;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    void setText(const QString& text) override;
    bool passesMouse() const override {
        return type() == BS_GROUPBOX;
    }
    int accessibleRole() const override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override;
    QString mnemonicText() const override {
        return text();
    }

    DWORD type() const {
        return style() & BS_TYPEMASK;
    }
    bool isPushButton() const {
        return type() == BS_PUSHBUTTON || type() == BS_DEFPUSHBUTTON || type() == BS_OWNERDRAW;
    }
    bool isRadio() const {
        return type() == BS_RADIOBUTTON || type() == BS_AUTORADIOBUTTON;
    }
    int check() const {
        return m_check;
    }
    void setCheck(int check);
    /// What a click does: the automatic kinds change their mark, then the parent is told.
    void click();
    /// Shows or takes away the look of the default button.
    void showAsDefault(bool isDefault);
    /// Has the parent draw an owner-drawn button.
    void paintByOwner(QPainter& painter);
    void paintGroupBox(QPainter& painter) const;

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void fontChanged() override;
    void focusMoved(bool got) override;
    bool takesFocus() const override {
        return type() != BS_GROUPBOX;
    }
    void applyColors(QPalette& palette, const QColor& text, const QColor& background) const override;

private:
    QAbstractButton* button() const;
    void applyType();
    void applyCheck();
    void applyText();
    void checkInGroup();
    LRESULT setPicture(UINT kind, HANDLE picture);
    LRESULT state() const;
    int m_check = 0;
    HANDLE m_picture = nullptr;
    bool m_shownAsDefault = false;
};

} // namespace tvx::afx
