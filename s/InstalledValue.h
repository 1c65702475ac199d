#pragma once

#include "platform/port/StringBase.h"

/// A value of the installation's file, for what goes on without it: unlike `Port::Version::getValue` it says nothing
/// when there is no such file.
/// @return empty when there is no file, or no such value in it
Port::StringBase<char> InstalledValue(const char* key);
