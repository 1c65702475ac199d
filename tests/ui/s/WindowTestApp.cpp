#include "tests/ui/s/WindowTestApp.h"

WindowTestApp windowTestApp;
