#pragma once

/// @file
/// What nearly every source of the rooms includes and rarely changes, parsed once for all of them. Sources include what
/// they use all the same: a build with CMAKE_DISABLE_PRECOMPILE_HEADERS, such as the lint check's, finds what is
/// missing.

#include "platform/base/Collections.h"
#include "platform/base/Exception.h"
#include "platform/base/Geometry.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"
#include "platform/base/Types.h"

#include <QtWidgets>

#include <algorithm>
#include <array>
#include <cstring>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>
