// lsof
#include "keltools.h"

int LsofMain(int, char **) { return CommandNotBuilt("lsof"); }
