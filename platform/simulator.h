// The simulator: live mode off the host against a snapshot (see docs/simulator.md).
#ifndef PLATFORM_SIMULATOR_H
#define PLATFORM_SIMULATOR_H

#include <optional>
#include <string_view>

#include "cachefile.h"
#include "nodetable.h"

struct stat;

namespace kelplat {

// The real-time clock once it has been set; false leaves the read to the snapshot.
bool SimulatorClock(const NodeInfo &node, void *buf, uint32_t size, KEL_Status *status);
// A read the snapshot has no entry for: inode statistics made from the real
// file; NOT_FOUND for anything else.
KEL_Status SimulatorInodeStats(const NodeInfo &node, const KEL_ParamList *keys, void *buf, uint32_t size);
KEL_Status SimulatorSet(const NodeInfo &node, const KEL_ParamList *input, void *buf, uint32_t size);
int SimulatorLstat(const char *path, struct stat *st);

}  // namespace kelplat

#endif
