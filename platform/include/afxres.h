#pragma once

/* What a host's resource script includes: constants of the platform and identifiers of the framework. */
#include "platform/win/FrameworkIds.h"
#include "winres.h"
