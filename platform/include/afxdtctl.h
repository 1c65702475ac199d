#pragma once

/// @file
/// Stands for the controls of dates and times, which do not exist here.

#define __AFXDTCTL_H__ // hosts ask whether this header came first
#include "afxwin.h"
