#pragma once

/// @file
/// Controls of dialogs.

#define __AFXCMN_H__ // hosts ask whether this header came first
#include "platform/afx/controls/Controls.h"
#include "platform/afx/controls/HotKey.h"
#include "platform/include/afxwin.h"
