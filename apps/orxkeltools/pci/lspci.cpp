// lspci
#include "keltools.h"

int ListPCI(int, char **) { return CommandNotBuilt("lspci"); }
