// irqinfo
#include "keltools.h"

int InterruptInfo(int, char **) { return CommandNotBuilt("irqinfo"); }
