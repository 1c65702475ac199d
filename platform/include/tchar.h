#pragma once

/// @file
/// Stands for the names of texts for two character widths, which compatibility.h holds.

#include "compatibility.h"
