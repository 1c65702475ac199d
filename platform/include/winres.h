#pragma once

/* What a resource script includes for styles, keys and standard answers. */
#include "platform/win/ResourceConstants.h"

#ifdef RC_INVOKED
/* In C++ these are pointers (platform/win/Resource.h), in scripts plain numbers. */
#define RT_MANIFEST 24
#define CREATEPROCESS_MANIFEST_RESOURCE_ID 1
#define ISOLATIONAWARE_MANIFEST_RESOURCE_ID 2
#endif
