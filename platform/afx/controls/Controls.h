#pragma once

/// @file
/// The plain controls.

#include "platform/afx/controls/Button.h"
#include "platform/afx/controls/ComboBox.h"
#include "platform/afx/controls/Edit.h"
#include "platform/afx/controls/ListBox.h"
#include "platform/afx/controls/ScrollBar.h"
#include "platform/afx/controls/Static.h"
