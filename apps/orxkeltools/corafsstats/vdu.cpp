// vdu
#include "keltools.h"

int VduMain(int, char **) { return CommandNotBuilt("vdu"); }
