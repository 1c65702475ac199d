#pragma once

// The C library's header (2.36) forgets to say that these are C functions.
extern "C" {
#include <sys/pidfd.h>
}
