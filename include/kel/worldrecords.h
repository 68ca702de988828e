// Records about worlds and cartels that the process tools read.
#ifndef KEL_WORLDRECORDS_H
#define KEL_WORLDRECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

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
static_assert(worldinfo::kSize == KEL_RECORD_SIZE_world_info);

// Open file descriptor record (KEL_NODE_userworld_cartel_fd_fds, 2084 bytes):
//
//    4 type          text, ends before byte 100
//  100 description   text, to the end of the record
namespace fdrec {
constexpr uint32_t kSize = 2084;
constexpr size_t kType = 4;
constexpr size_t kDescription = 100;
}  // namespace fdrec
static_assert(fdrec::kSize == KEL_RECORD_SIZE_userworld_cartel_fd_fds);

// Mapping record (KEL_NODE_userworld_cartel_mem_mmaps, 2036 bytes):
//
//    8 length        u32     20 protection bits   u32 (1 readable, 2 writable)
//   16 kind          u32     24 fd number         i32
//   28 description   text, to the end of the record
namespace mmaprec {
constexpr uint32_t kSize = 2036;
constexpr size_t kLength = 8;
constexpr size_t kKind = 16;
constexpr size_t kProt = 20;
constexpr size_t kFd = 24;
constexpr size_t kDescription = 28;
}  // namespace mmaprec
static_assert(mmaprec::kSize == KEL_RECORD_SIZE_userworld_cartel_mem_mmaps);

// A world's name (KEL_NODE_world_name) and a cartel's command line
// (KEL_NODE_userworld_cartel_cmdline): NUL-terminated texts filling buffers
// of these sizes.
constexpr uint32_t kWorldNameSize = 128;
constexpr uint32_t kCmdlineSize = 1024;
static_assert(kWorldNameSize == KEL_RECORD_SIZE_world_name);
static_assert(kCmdlineSize == KEL_RECORD_SIZE_userworld_cartel_cmdline);

#endif
