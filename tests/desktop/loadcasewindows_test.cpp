#include "desktoptest.h"

#include "loadcasetools.h"
