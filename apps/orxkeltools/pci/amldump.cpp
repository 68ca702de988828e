// amldump
#include "keltools.h"

int AmldumpMain(int, char **) { return CommandNotBuilt("amldump"); }
