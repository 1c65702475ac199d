#pragma once

/// @file
/// Controls of dialogs.

#include "platform/afx/controls/Controls.h"
#include "platform/include/afxwin.h"
