#pragma once

/// @file
/// The list of recent files.

#include "afxwin.h"
#include "platform/afx/frames/RecentFileList.h"
