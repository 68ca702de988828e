/*
 * Records of the system information commands: the real-time clock (hwclock,
 * and the simulator that keeps a settable clock), the version record
 * (halvex), the boot records and the chunk request of a boot option file
 * read (bootOption), the uptime, PCPU count and load history (uptime).
 * Fields are little-endian and read by byte offset (never through a struct),
 * so the offsets here are the whole layout.  For C++ sources.
 */
#ifndef KEL_SYSINFORECORDS_H
#define KEL_SYSINFORECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

// Real-time clock record (hardware/chipset/rtc, 32 bytes), plain signed
// 32-bit integers (not BCD), the year in full:
//
//    0 hours     4 minutes    8 seconds    12 day of the month
//   16 month    20 year      24..31 not used
namespace rtc {
constexpr uint32_t kSize = 32;
constexpr size_t kHours = 0;
constexpr size_t kMinutes = 4;
constexpr size_t kSeconds = 8;
constexpr size_t kDay = 12;
constexpr size_t kMonth = 16;
constexpr size_t kYear = 20;
}  // namespace rtc

// Version record (system/version, 312 bytes), NUL-terminated texts:
//
//     0 product name    32 bytes      160 update text, up to the build
//    32 version         64 bytes      292 build number   i32
//    96 release level   64 bytes
namespace versioninfo {
constexpr uint32_t kSize = 312;
constexpr size_t kProduct = 0, kProductWidth = 32;
constexpr size_t kVersion = 32, kVersionWidth = 64;
constexpr size_t kLevel = 96, kLevelWidth = 64;
constexpr size_t kUpdate = 160, kUpdateWidth = 132;
constexpr size_t kBuild = 292;
}  // namespace versioninfo

// Boot switches (system/bootOption, 4 bytes), each a u8:
//
//    0 audit mode    1 file-system check mode    2 booted after a rollback
namespace bootoption {
constexpr uint32_t kSize = 4;
constexpr size_t kAudit = 0;
constexpr size_t kFsck = 1;
constexpr size_t kRollback = 2;
}  // namespace bootoption

// Boot command line (system/bootCmdLine, 4096 bytes): "<kernel> <options>",
// NUL-terminated unless it fills the record.
namespace bootcmdline {
constexpr uint32_t kSize = 4096;
}  // namespace bootcmdline

// Network boot record (system/bootMAC, 24 bytes):
//
//    0 non-zero when the host booted over the network   u8
namespace bootmac {
constexpr uint32_t kSize = 24;
constexpr size_t kPxe = 0;
}  // namespace bootmac

// Chunk request (8 bytes), the input data object of a boot option file read
// (system/bootOptionFiles/<name>/content):
//
//    0 offset of the first byte wanted   u32    4 bytes wanted   u32
namespace chunkrequest {
constexpr uint32_t kSize = 8;
constexpr size_t kOffset = 0;
constexpr size_t kCount = 4;
}  // namespace chunkrequest

// Uptime record (system/ntpclock/upTime, 8 bytes):
//
//    0 seconds since boot   u32      4 not used
namespace uptimeinfo {
constexpr uint32_t kSize = 8;
constexpr size_t kSeconds = 0;
}  // namespace uptimeinfo

// PCPU count record (sched/globalStats/numPcpus, 12 bytes):
//
//    4 number of PCPUs   u32
namespace numpcpus {
constexpr uint32_t kSize = 12;
constexpr size_t kCount = 4;
}  // namespace numpcpus

// Load history record (sched/groups/<group>/stats/cpuStatsDir/cpuLoadHistory/
// cpuLoadHistory{1,5,15}MinInPct, 144 bytes):
//
//    4 load in percent of one PCPU   u32
namespace loadhistory {
constexpr uint32_t kSize = 144;
constexpr size_t kLoadPct = 4;
}  // namespace loadhistory

static_assert(rtc::kSize == KEL_RECORD_SIZE_hardware_chipset_rtc);
static_assert(versioninfo::kSize == KEL_RECORD_SIZE_system_version);
static_assert(versioninfo::kUpdate + versioninfo::kUpdateWidth == versioninfo::kBuild);
static_assert(bootoption::kSize == KEL_RECORD_SIZE_system_bootOption);
static_assert(bootcmdline::kSize == KEL_RECORD_SIZE_system_bootCmdLine);
static_assert(bootmac::kSize == KEL_RECORD_SIZE_system_bootMAC);
static_assert(uptimeinfo::kSize == KEL_RECORD_SIZE_system_ntpclock_upTime);
static_assert(numpcpus::kSize == KEL_RECORD_SIZE_sched_globalStats_numPcpus);
static_assert(loadhistory::kSize ==
              KEL_RECORD_SIZE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory1MinInPct);
static_assert(loadhistory::kSize ==
              KEL_RECORD_SIZE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory5MinInPct);
static_assert(loadhistory::kSize ==
              KEL_RECORD_SIZE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory15MinInPct);

#endif
