#pragma once

/// @file
/// Stands for the objects of the desktop's file manager, which do not exist here.

#include "windows.h"
