#pragma once

/// @file
/// The framework's ready-made dialogs.

#include "afxwin.h"
#include "platform/afx/dialogs/FileDialog.h"
