// pidof
#include "keltools.h"

int PidofMain(int, char **) { return CommandNotBuilt("pidof"); }
