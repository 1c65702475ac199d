#pragma once

/// @file
/// The framework's bars.

#include "afxwin.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/DockState.h"
#include "platform/afx/frames/StatusBar.h"
#include "platform/afx/frames/ToolBar.h"
