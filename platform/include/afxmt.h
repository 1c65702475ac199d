#pragma once

/// @file
/// Stands for the framework's locks and events between threads, which do not exist here: windows, and what hosts do
/// with them, live on one thread.

#define __AFXMT_H__ // hosts ask whether this header came first
#include "afx.h"
