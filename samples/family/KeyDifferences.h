#pragma once

#include "s/AccelMap.h"

/// How many keys mean another command in one table than in the other, or none.
int CountDifferences(const Gui_AccelMap& one, const Gui_AccelMap& other);
