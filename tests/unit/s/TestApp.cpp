#include "TestApp.h"

TestApp theApp;
