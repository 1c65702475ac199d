#pragma once

/// @file
/// The framework's basics: text, run-time classes, exceptions, geometry.

#include "platform/base/Exception.h"
#include "platform/base/Geometry.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"
#include "platform/base/Types.h"
