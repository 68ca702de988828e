// ps
#include "keltools.h"

int PsMain(int, char **) { return CommandNotBuilt("ps"); }
