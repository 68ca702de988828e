// pgrep
#include "keltools.h"

int PgrepMain(int, char **) { return CommandNotBuilt("pgrep"); }
