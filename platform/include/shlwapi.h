#pragma once

/// @file
/// Stands for the small helpers of the desktop's file manager: the completion of folder names is all there is here.

#include "platform/afx/controls/AutoComplete.h"
#include "windows.h"
