// How ps finds the parent of each node of its cartel tree; apart from ps.cpp
// so that a unit test can hold it against the plain scan.
#ifndef ORXKELTOOLS_WORLDS_PSPARENTS_H
#define ORXKELTOOLS_WORLDS_PSPARENTS_H

#include <cstdint>

namespace psparents {

// The IDs of a node that decide its place in the tree.
struct NodeIds {
   uint32_t worldId;
   uint32_t cartelId;
   uint32_t parentCartelId;
};

// For each node i whose cartel ID is not 0, parents[i] becomes the first
// node in the given order whose cartel ID is not 0 and whose world ID is
// node i's parent cartel ID; it becomes -1 for the other nodes and when no
// node matches.  World IDs may repeat.  False when memory runs out.
bool FindParents(const NodeIds *nodes, uint32_t count, int32_t *parents);

}  // namespace psparents

#endif
