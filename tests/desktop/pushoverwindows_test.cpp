#include "desktoptest.h"

#include "pushovertools.h"
