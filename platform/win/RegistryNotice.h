#pragma once

/// @file
/// How the user hears that something is wrong with the file of the settings.

#include "platform/base/Export.h"

#include <string>

namespace tvx {

/// Tells the user something about the settings.
/// @param text  sentences in English that name the file and what became of it
using RegistryNotice = void (*)(const std::string& text);

/// Installs the function that tells the user; null goes back to standard error. Called once by the floor that has
/// message boxes. The function is called after the settings call that met the fault, on its thread, once for each
/// fault.
TVX_PLATFORM_API void setRegistryNotice(RegistryNotice notice) noexcept;

} // namespace tvx
