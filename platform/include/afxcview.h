#pragma once

/// @file
/// Stands for the views made of one control, which do not exist here.

#define __AFXCVIEW_H__ // hosts ask whether this header came first
#include "afxwin.h"
