// The node table's paths as one tree, the shape a snapshot's "tree" follows.
#ifndef KELCACHE_NODETREE_H
#define KELCACHE_NODETREE_H

#include <string>
#include <string_view>
#include <vector>

#include "nodetable.h"

namespace kelcache {

// A place in the tree: the root, a fixed name, or an instance level ("#" or
// "$").  Its children are fixed names, or exactly one instance level.
struct Position {
   std::string_view name;
   int levelKind = -1;  // KEL_PARAM_INT or KEL_PARAM_STRING at an instance level
   int parent = -1;
   std::vector<int> children;
   const kelplat::NodeInfo *node = nullptr;  // the node whose path ends here
};

struct NodeTree {
   std::vector<Position> positions;  // the root first
   std::vector<int> nodePosition;    // by node number
   std::string error;                // set when the node table does not form such a tree

   const Position &at(int i) const { return positions[size_t(i)]; }
   // The instance level below position i, or -1.
   int LevelChild(int i) const;
   // The fixed child of position i with that name, or -1.
   int FixedChild(int i, std::string_view name) const;
   // The positions from below the root down to i.
   std::vector<int> Chain(int i) const;
};

const NodeTree &TheNodeTree();

}  // namespace kelcache

#endif
