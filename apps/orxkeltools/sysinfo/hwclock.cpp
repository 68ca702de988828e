// hwclock
#include "keltools.h"

int HwclockMain(int, char **) { return CommandNotBuilt("hwclock"); }
