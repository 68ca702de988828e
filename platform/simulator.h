// The simulator: live mode off the host against a snapshot (see docs/simulator.md).
#ifndef PLATFORM_SIMULATOR_H
#define PLATFORM_SIMULATOR_H

#include <optional>
#include <string_view>

#include "cachefile.h"
#include "nodetable.h"

struct stat;

namespace kelplat {

// Shared with kel.cpp: lookups in the loaded tree.
bool TreeLookup(Op op, KEL_Node node, const KEL_ParamList *keys, CacheHit *hit, KEL_Status *status);
std::optional<std::string_view> TreeMeta(std::string_view name);
const char *SimulatorPath();

// Reads the simulator answers itself; false leaves the read to the snapshot.
bool SimulatorGet(const NodeInfo &node, const KEL_ParamList *keys, void *buf, uint32_t size,
                  KEL_Status *status);
KEL_Status SimulatorSet(const NodeInfo &node, const KEL_ParamList *input, void *buf, uint32_t size);
int SimulatorLstat(const char *path, struct stat *st);

}  // namespace kelplat

#endif
