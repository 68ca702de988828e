// userspaceof
#include "keltools.h"

int UserspaceofMain(int, char **) { return CommandNotBuilt("userspaceof"); }
