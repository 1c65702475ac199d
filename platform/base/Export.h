#pragma once

/// Marks what the layer's shared library offers to others. Everything else stays hidden inside it.
#ifdef TVX_PLATFORM_BUILD
#define TVX_PLATFORM_API __attribute__((visibility("default")))
#else
#define TVX_PLATFORM_API
#endif
