#pragma once

/// @file
/// Dialog windows, and what makes controls from templates.

#include "platform/afx/core/detail/Window.h"
#include "platform/win/DialogTemplate.h"

#include <optional>
#include <string>

namespace tvx::afx {

class ScrollFrame;

/// The window that a dialog stands over whose host names none: another dialog that is active, so that they stack; the
/// frame that the user works in, which may be one beside the main window; that itself.
TVX_PLATFORM_API HWND defaultOwner();
/// Gives the user the window back that a dialog stood over.
TVX_PLATFORM_API void activateAgain(HWND owner);

/// The class of dialogs.
inline constexpr const char* dialogClass = "#32770";

/// The "#32770" class: a top-level dialog with the desktop's decoration, or a child dialog (property pages, form
/// views, dialog bars).
class TVX_PLATFORM_API DialogWindow : public Window {
public:
    using Window::Window;
    ~DialogWindow() override;
    QWidget* clientWidget() const override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    void setWindowRect(const QRect& rect) override;
    int accessibleRole() const override;
    /// Those of the owner, which has a caption as most dialogs do, or those that the desktop promises: sizes that a
    /// host computes for the whole window then come out right before the desktop has told them.
    QMargins expectedBorders() const override;
    /// Gives the area inside a size, and the window a corner.
    void setClientSize(QPoint corner, QSize inside);
    /// Keeps the control for the next activation, and gives the button that Enter presses now the default look.
    void focusMovedWithin(Window& control, bool got) override;

    /// Takes the template's font: it gives the dialog its units, and its controls their text.
    void useFont(const DialogTemplate& description);
    QSize baseUnits() const {
        return m_baseUnits;
    }
    /// The size in pixels that a template's dialog would have inside.
    static QSize insideOf(const DialogTemplate& description);
    /// Pixels for dialog units.
    QRect map(const DialogRect& rect) const;
    void setDefaultId(int id);
    int defaultId() const {
        return m_defaultId;
    }
    /// Shows the default look at the button that Enter presses now: the focused push button, else the default one.
    void showDefault(const Window* focused);
    /// The control that had the keyboard last, null when it is gone.
    HWND lastFocus = nullptr;

protected:
    void showWidget(int command) override;
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;

private:
    void askColor();
    void keepOnScreen();
    void fixSize();
    void pressCancel();
    LRESULT erase(HDC dc);
    void passFocusOn();
    ScrollFrame* m_frame = nullptr; ///< Of a child dialog.
    HFONT m_ownFont = nullptr;
    QSize m_baseUnits{6, 13};
    int m_defaultId = 0;
    QRgb m_color = 0;
};

/// A name or number of a resource, as messages tell it.
std::string resourceNameOf(LPCSTR name);
/// The template of a name; none, which standard error tells, when it is missing or damaged.
std::optional<DialogTemplate> loadDialogTemplate(LPCSTR name);
/// Makes the controls of a template in a dialog that stands. False when one could not be made.
TVX_PLATFORM_API bool makeControls(DialogWindow& dialog, const DialogTemplate& description);
/// Fills list and combo boxes with the first contents that resources (type 240) give the dialog `name`.
TVX_PLATFORM_API bool fillControls(DialogWindow& dialog, LPCSTR name);

} // namespace tvx::afx
