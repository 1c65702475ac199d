#pragma once

/// @file
/// Controls of dialogs, and tool tips.

#define __AFXCMN_H__ // hosts ask whether this header came first
#include "platform/afx/controls/Controls.h"
#include "platform/afx/controls/HotKey.h"
#include "platform/afx/controls/ImageList.h"
#include "platform/afx/controls/ToolTip.h"
#include "platform/afx/controls/TreeCtrl.h"
#include "platform/include/afxwin.h"
