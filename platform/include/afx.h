#pragma once

/// @file
/// The framework's basics: text, run-time classes, exceptions, files, archives, geometry.

#define __AFX_H__ // hosts ask whether this header came first
#include "platform/base/Archive.h"
#include "platform/base/Exception.h"
#include "platform/base/File.h"
#include "platform/base/Geometry.h"
#include "platform/base/MemFile.h"
#include "platform/base/Object.h"
#include "platform/base/StdioFile.h"
#include "platform/base/String.h"
#include "platform/base/Types.h"
