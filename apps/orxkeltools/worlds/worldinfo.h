// Records about worlds and cartels that several commands read.
#ifndef ORXKELTOOLS_WORLDS_WORLDINFO_H
#define ORXKELTOOLS_WORLDS_WORLDINFO_H

#include <cstddef>
#include <cstdint>

// World information record (KEL_NODE_world_info, 72 bytes):
//
//    0 world ID           u32      20 process group ID  i32
//    4 group ID           i32      24 session ID        i32
//    8 userspace ID       i32      28 world type bits   u32
//   12 cartel ID          u32      45 security domain   i32 (not aligned)
//   16 parent cartel ID   u32
namespace worldinfo {
constexpr uint32_t kSize = 72;
constexpr size_t kWorldId = 0;
constexpr size_t kGroupId = 4;
constexpr size_t kUserspaceId = 8;
constexpr size_t kCartelId = 12;
constexpr size_t kParentCartelId = 16;
constexpr size_t kProcessGroupId = 20;
constexpr size_t kSessionId = 24;
constexpr size_t kTypeBits = 28;
constexpr size_t kSecurityDomain = 45;
}  // namespace worldinfo

// A world's name (KEL_NODE_world_name) and a cartel's command line
// (KEL_NODE_userworld_cartel_cmdline) fill buffers of these sizes.
constexpr uint32_t kWorldNameSize = 128;
constexpr uint32_t kCmdlineSize = 1024;

#endif
