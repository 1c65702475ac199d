#pragma once

/// @file
/// Stands for the system's calls for windows and messages.

#include "windows.h"
