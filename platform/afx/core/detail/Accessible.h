#pragma once

/// @file
/// What assistive tools are told of the layer's windows and menus where the toolkit cannot know it: roles of windows
/// whose widgets are plain ones, their children in the order of tabbing, menu entries without their keys.

#include "platform/base/Export.h"

#include <QString>

namespace tvx::afx {

/// A text without the marks of access keys: "&Close" and "閉じる(&C)" without "&" and "(&C)", "&&" as "&".
TVX_PLATFORM_API QString withoutMarks(const QString& text);

/// Has the toolkit ask here first. To be called once.
void answerAssistiveTools();

} // namespace tvx::afx
