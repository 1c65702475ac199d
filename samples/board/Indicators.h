#pragma once

#include "Resource.h"
#include "afxwin.h"

#include <iterator>

/// The panes of the status bars, in the main window and in those of drawings, and their tips.
/// @{
constexpr UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_POSITION, ID_INDICATOR_CAPS, ID_INDICATOR_NUM};
constexpr UINT indicatorTips[] = {0, IDS_TIP_POSITION, IDS_TIP_CAPS, IDS_TIP_NUM};
/// @}
