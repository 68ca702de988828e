// bootOption
#include "keltools.h"

int BootOptionMain(int, char **) { return CommandNotBuilt("bootOption"); }
