#pragma once

/// @file
/// Stands for the system's common controls: those of the framework's index that exist here.

#include "afxcmn.h"
#include "windows.h"
