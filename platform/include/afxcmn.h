#pragma once

/// @file
/// Controls of dialogs.

#include "platform/afx/Controls.h"
#include "platform/include/afxwin.h"
