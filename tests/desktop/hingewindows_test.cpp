#include "desktoptest.h"

#include "hingetools.h"
