// The node table as data, for the platform and the snapshot tool.
#ifndef PLATFORM_NODETABLE_H
#define PLATFORM_NODETABLE_H

#include <cstdint>
#include <span>
#include <string_view>

#include "kel/kel.h"

namespace kelplat {

enum NodeFlags : uint32_t { KEL_NF_SET = 1, KEL_NF_DATA = 2 };

struct NodeInfo {
   std::string_view name;   // "world_info"
   KEL_Node number;
   std::string_view path;   // "world/#/info"
   uint32_t recordSize;
   uint32_t flags;
   unsigned levels;         // instance levels in the path, counted once
};

// Every node, in number order (number i is at index i - 1).
std::span<const NodeInfo> Nodes();
const NodeInfo *FindNode(KEL_Node number);

// Number of instance levels in a path ("#" and "$" components).
constexpr unsigned LevelCount(std::string_view path) {
   unsigned n = 0;
   for (char c : path) n += c == '#' || c == '$';
   return n;
}
// Kind of instance level i (0 integer, 1 text), counted from the root.
int LevelKind(std::string_view path, unsigned level);
// Whether the path ends with an instance level, so that the node is listed.
bool EndsWithLevel(std::string_view path);

// The tool's tree signature (16 raw bytes) and build date, set by the build.
std::span<const uint8_t, 16> ToolSignature();
const char *ToolBuildDate();

}  // namespace kelplat

#endif
