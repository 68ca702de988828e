// pci-info
#include "keltools.h"

int PciInfoMain(int, char **) { return CommandNotBuilt("pci-info"); }
