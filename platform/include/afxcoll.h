#pragma once

/// @file
/// The framework's collections.

#include "afx.h"
#include "platform/base/Collections.h"
