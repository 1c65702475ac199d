#pragma once

/// @file
/// The framework's bars, and views of controls.

#define __AFXEXT_H__ // hosts ask whether this header came first
#include "afxwin.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/DockState.h"
#include "platform/afx/frames/FormView.h"
#include "platform/afx/frames/StatusBar.h"
#include "platform/afx/frames/ToolBar.h"
