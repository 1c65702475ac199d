#pragma once

/// @file
/// What edit controls and the fields of combo boxes do when the user asks for clipboard work: by keys, by the menu, by
/// the middle button and by dropping a text. All of it goes through the control's messages, so that a host that takes
/// one of them sees every such act.

#include "platform/afx/controls/detail/TextField.h"
#include "platform/afx/core/detail/Window.h"

namespace tvx::afx {

/// A control with a field for text.
struct FieldControl {
    enum class Kind { Edit, ComboBox };

    Window& window;
    TextField& field;
    Kind kind = Kind::Edit;
    bool readOnly = false;
    bool secret = false; ///< What is in it is never copied.
};

/// Sends the messages for what keys asked for. The control may be gone afterwards; the same goes for the others here.
void carryOut(const FieldControl& control, FieldCommand command);
/// What WM_CONTEXTMENU does where neither the host's control nor a parent takes it.
void showFieldMenu(const FieldControl& control, WPARAM wParam, LPARAM lParam);
/// Pastes the selection of the desktop at a point of the client area, as the middle button does.
void pasteSelectionAt(const FieldControl& control, QPoint point);
void takeDropped(const FieldControl& control, const DroppedText& dropped);

/// What WM_CUT, WM_COPY, WM_CLEAR and WM_UNDO do where the host does not take them; none for other messages.
std::optional<LRESULT> clipboardProc(const FieldControl& control, UINT message);

} // namespace tvx::afx
