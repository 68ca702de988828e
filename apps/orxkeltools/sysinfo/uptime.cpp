// uptime
#include "keltools.h"

int UptimeMain(int, char **) { return CommandNotBuilt("uptime"); }
