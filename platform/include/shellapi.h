#pragma once

/// @file
/// Stands for the calls of the desktop's file manager: files dropped on a window are all there is here.

#include "windows.h"
