#include "tests/ui/afx/TestApplication.h"

/// Pre-translation and the road of commands end at the application object, so there is one.
TestApplication testApplication;
