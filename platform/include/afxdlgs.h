#pragma once

/// @file
/// The framework's ready-made dialogs.

#define __AFXDLGS_H__ // hosts ask whether this header came first
#include "afxwin.h"
#include "platform/afx/dialogs/ColorDialog.h"
#include "platform/afx/dialogs/FileDialog.h"
#include "platform/afx/dialogs/FontDialog.h"
#include "platform/afx/dialogs/PropertySheet.h"
