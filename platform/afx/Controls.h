#pragma once

/// @file
/// The plain controls.

#include "platform/afx/Button.h"
#include "platform/afx/ComboBox.h"
#include "platform/afx/Edit.h"
#include "platform/afx/ListBox.h"
#include "platform/afx/ScrollBar.h"
#include "platform/afx/Static.h"
