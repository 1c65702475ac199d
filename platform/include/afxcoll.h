#pragma once

/// @file
/// The framework's collections.

#define __AFXCOLL_H__ // hosts ask whether this header came first
#include "afx.h"
#include "platform/base/Collections.h"
