/*
 * Records of the in-memory root file system (system/corafs): the statistics
 * of a tardisk, of a ramdisk and of an inode.  vdf, vdu and bootOption read
 * them; the simulator makes inode statistics from real files.  Fields are
 * little-endian and read by byte offset (never through a struct), so the
 * offsets here are the whole layout.  For C++ sources.
 */
#ifndef KEL_CORAFSRECORDS_H
#define KEL_CORAFSRECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

// Tardisk stats record (system/corafs/tardisks/<name>/stats, 28 bytes):
//
//    0 size in bytes                      u32
//    8 set when a module used to boot     u8
//    the other bytes are not used
namespace tardiskstats {
constexpr uint32_t kSize = 28;
constexpr size_t kSizeBytes = 0;
constexpr size_t kBootModule = 8;
}  // namespace tardiskstats

// Ramdisk stats record (system/corafs/ramdisks/<name>/stats, 180 bytes):
//
//    0 minimum (reserved) size in MiB     u32
//    4 maximum size in MiB                u32
//    8 pages in use (4096 bytes each)     u32
//   12 peak pages in use                  u32
//    the other bytes are not used
namespace ramdiskstats {
constexpr uint32_t kSize = 180;
constexpr size_t kMinMiB = 0;
constexpr size_t kMaxMiB = 4;
constexpr size_t kUsedPages = 8;
constexpr size_t kPeakPages = 12;
constexpr uint32_t kPageSize = 4096;
}  // namespace ramdiskstats

// Inode stats record (system/corafs/inodes/<inode>/stats, 544 bytes):
//
//     4 flags                             u32   bit 0 on a tardisk (else a
//                                               ramdisk), bit 6 size not charged
//    20 link state                        i32   -4 (0xFFFFFFFC) when unlinked
//    28 size in bytes                     u32
//    32 tardisk name                      text  128 bytes
//   160 ramdisk name                      text  128 bytes
//   288 file name                         text  256 bytes
namespace inodestats {
constexpr uint32_t kSize = 544;
constexpr size_t kFlags = 4;
constexpr size_t kLinkState = 20;
constexpr size_t kSizeBytes = 28;
constexpr size_t kTardisk = 32;
constexpr size_t kRamdisk = 160;
constexpr size_t kName = 288;
constexpr size_t kDiskNameWidth = 128;
constexpr size_t kNameWidth = 256;

constexpr uint32_t kOnTardisk = 0x1;    // flags: the inode lives on a tardisk
constexpr uint32_t kNotCharged = 0x40;  // flags: its size is not charged
constexpr uint32_t kUnlinked = 0xFFFFFFFC;
}  // namespace inodestats

static_assert(tardiskstats::kSize == KEL_RECORD_SIZE_system_corafs_tardisks_stats);
static_assert(ramdiskstats::kSize == KEL_RECORD_SIZE_system_corafs_ramdisks_stats);
static_assert(inodestats::kSize == KEL_RECORD_SIZE_system_corafs_inodes_stats);
static_assert(inodestats::kName + inodestats::kNameWidth == inodestats::kSize);

#endif
