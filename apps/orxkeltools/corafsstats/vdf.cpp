// vdf
#include "keltools.h"

int VdfMain(int, char **) { return CommandNotBuilt("vdf"); }
