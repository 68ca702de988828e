// uptime: the local time of day, how long the host has been up, and the 1-,
// 5- and 15-minute load averages of its physical CPUs, on one line.
#include <cstdio>
#include <ctime>

#include "kel/sysinforecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr uint32_t kSecondsPerDay = 86400;

struct LoadHistory {
   const KEL_Node &node;
   const char *failure;
};
constexpr LoadHistory kLoadHistories[] = {
   {KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory1MinInPct,
    "Failed to get 1 minute cpu load history.\n"},
   {KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory5MinInPct,
    "Failed to get 5 minute cpu load history.\n"},
   {KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory15MinInPct,
    "Failed to get 15 minute cpu load history.\n"},
};

}  // namespace

int UptimeMain(int, char **) {
   time_t now = std::time(nullptr);
   struct tm local;
   if (localtime_r(&now, &local) == nullptr) {
      std::fputs("Failed to get the local time.\n", stderr);
      return 1;
   }
   std::printf(" %2d:%02d:%02d ", local.tm_hour, local.tm_min, local.tm_sec);

   uint8_t upTime[uptimeinfo::kSize];
   KEL_Status status = KEL_Get(KEL_NODE_system_ntpclock_upTime, nullptr, upTime, sizeof upTime);
   if (status != KEL_STATUS_OK) {
      std::fputs("Failed to get ntpclock_uptime.\n", stderr);
      return KelExitStatus(status);
   }
   uint32_t up = ReadU32(upTime, uptimeinfo::kSeconds);
   uint32_t days = up / kSecondsPerDay, hours = up / 3600 % 24, minutes = up / 60 % 60, seconds = up % 60;
   std::fputs("up ", stdout);
   if (days != 0)
      std::printf("%u days, %02u:%02u:%02u, ", days, hours, minutes, seconds);
   else
      std::printf("%02u:%02u:%02u, ", hours, minutes, seconds);

   uint8_t numPcpus[numpcpus::kSize];
   status = KEL_Get(KEL_NODE_sched_globalStats_numPcpus, nullptr, numPcpus, sizeof numPcpus);
   if (status != KEL_STATUS_OK) {
      std::fputs("Failed to get number of pcups.\n", stderr);
      return KelExitStatus(status);
   }
   // Each average is the load divided by 100 x PCPUs, formed in unsigned
   // 32-bit arithmetic; a count that makes it 0 (no PCPUs) cannot be used.
   uint32_t pcpus = ReadU32(numPcpus, numpcpus::kCount);
   uint32_t capacity = 100u * pcpus;
   if (capacity == 0) {
      std::fprintf(stderr, "Cannot average the load over %u pcpus.\n", pcpus);
      return 1;
   }

   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("Failed to allocate inputparam.\n", stderr);
      return 1;
   }
   // The load histories of scheduler group 0.
   status = KEL_ParamListAddInt(keys.get(), 0);
   if (status != KEL_STATUS_OK) {
      std::fputs("Failed to add inputparams.\n", stderr);
      return KelExitStatus(status);
   }

   double averages[3];
   for (size_t i = 0; i < 3; i++) {
      uint8_t history[loadhistory::kSize];
      status = KEL_Get(kLoadHistories[i].node, keys.get(), history, sizeof history);
      if (status != KEL_STATUS_OK) {
         std::fputs(kLoadHistories[i].failure, stderr);
         return KelExitStatus(status);
      }
      averages[i] = double(ReadU32(history, loadhistory::kLoadPct)) / double(capacity);
   }
   std::printf("load average: %.2f, %.2f, %.2f\n", averages[0], averages[1], averages[2]);
   return 0;
}
