#pragma once

/// @file
/// Stands for sound and timers of multimedia programs, which do not exist here.

#include "windows.h"
