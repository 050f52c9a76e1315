#include "desktoptest.h"

#include "ulftools.h"
