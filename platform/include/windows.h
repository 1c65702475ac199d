#pragma once

/// @file
/// Stands for the system's calls as a whole: those that exist here, and the old names that go with them.

#include "afxwin.h"
#include "compatibility.h"
