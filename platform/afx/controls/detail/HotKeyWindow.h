#pragma once

/// @file
/// Hot-key controls.

#include "platform/afx/controls/detail/Control.h"

class QLineEdit;

namespace tvx::afx {

/// The "msctls_hotkey32" class: takes every key while it has the keyboard, and keeps the last one.
class TVX_PLATFORM_API HotKeyWindow : public Control {
public:
    using Control::Control;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override {
        return WM_CTLCOLOREDIT;
    }
    bool takesShortcuts() const override {
        return true;
    }

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void focusMoved(bool got) override;
    void applyColors(QPalette& palette, const QColor& text, const QColor& background) const override;

private:
    struct HotKey {
        int key = 0;       ///< VK_..., 0 for none
        int modifiers = 0; ///< HOTKEYF_...
    };
    void pressed(int key, LPARAM parameter);
    void released();
    HotKey byRules(HotKey typed) const;
    void show();
    HotKey m_hotKey;
    int m_invalid = 0;     ///< HKCOMB_...
    int m_added = 0;       ///< HOTKEYF_... for what is invalid
    bool m_awaits = false; ///< modifiers are held and their key is still to come
};

} // namespace tvx::afx
