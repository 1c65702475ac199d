#pragma once

/// @file
/// The framework's collection templates.

#include "afx.h"
#include "platform/base/Collections.h"
