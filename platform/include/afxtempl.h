#pragma once

/// @file
/// The framework's collection templates.

#define __AFXTEMPL_H__ // hosts ask whether this header came first
#include "afx.h"
#include "platform/base/Collections.h"
