// pkill
#include "keltools.h"

int PkillMain(int, char **) { return CommandNotBuilt("pkill"); }
