#pragma once

/// Marks what the library offers to hosts. Everything else stays hidden inside it.
#ifdef GUI_BUILD
#define GUI_API __attribute__((visibility("default")))
#else
#define GUI_API
#endif
