#pragma once

/// @file
/// The framework's bars.

#include "afxwin.h"
#include "platform/afx/ControlBar.h"
#include "platform/afx/DockState.h"
#include "platform/afx/StatusBar.h"
#include "platform/afx/ToolBar.h"
