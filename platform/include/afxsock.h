#pragma once

/// @file
/// Stands for the framework's sockets, which do not exist here.

#define __AFXSOCK_H__ // hosts ask whether this header came first
#include "afxwin.h"
