// Records about a world's scheduling and a cartel's children, read by ps.
#ifndef KEL_SCHEDRECORDS_H
#define KEL_SCHEDRECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

// Scheduler summary (KEL_NODE_sched_Vcpus_stats_summaryStats, 248 bytes):
//
//    4 run-state number   u32 (index into CpuSched_RunStateElements)
//    8 wait-state number  u32 (index into CpuSched_WaitStateElements)
namespace summarystats {
constexpr uint32_t kSize = 248;
constexpr size_t kRunState = 4;
constexpr size_t kWaitState = 8;
}  // namespace summarystats
static_assert(summarystats::kSize == KEL_RECORD_SIZE_sched_Vcpus_stats_summaryStats);

// Affinity (KEL_NODE_sched_Vcpus_stats_affinity, 2304 bytes):
//
//    0 the CPUs the world may run on, a NUL-terminated text
namespace affinity {
constexpr uint32_t kSize = 2304;
constexpr size_t kText = 0;
}  // namespace affinity
static_assert(affinity::kSize == KEL_RECORD_SIZE_sched_Vcpus_stats_affinity);

// State times (KEL_NODE_sched_Vcpus_stats_stateTimes, 120 bytes):
//
//    8 used time          u64, microseconds
namespace statetimes {
constexpr uint32_t kSize = 120;
constexpr size_t kUsedTime = 8;
}  // namespace statetimes
static_assert(statetimes::kSize == KEL_RECORD_SIZE_sched_Vcpus_stats_stateTimes);

// Cartel child (KEL_NODE_userworld_cartel_child, 28 bytes, keyed by the
// cartel ID and the child ID):
//
//    4 child state        u32 (kZombie: the child has ended)
namespace cartelchild {
constexpr uint32_t kSize = 28;
constexpr size_t kState = 4;
constexpr uint32_t kZombie = 1;
}  // namespace cartelchild
static_assert(cartelchild::kSize == KEL_RECORD_SIZE_userworld_cartel_child);

#endif
