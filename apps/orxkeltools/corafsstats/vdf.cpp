// vdf: free space of the in-memory root file system.  One table of
// tardisks and one of ramdisks, a row per disk, in 1 KiB blocks, in
// human-readable sizes (-h) or as the resource-pool view (-p).
#include <unistd.h>

#include <cinttypes>
#include <cstdio>

#include "keltools.h"
#include "records.h"

namespace {

constexpr char kOptions[] = "hp";
constexpr char kUsage[] =
   "Gather stats about corafs\n"
   "corafsdf [filepath]\n"
   "   -h       multiple instead of blocks\n"
   "   -p       resource pool view\n";

// Tardisk stats record (28 bytes asked for):
//    0  u32  size in bytes
//    8  u8   set when the tardisk is a boot module (read by bootOption)
constexpr uint32_t kTardiskStatsSize = 28;
constexpr size_t kTardiskSize = 0;

// Ramdisk stats record (180 bytes asked for):
//    0  u32  minimum (reserved) size in MiB
//    4  u32  maximum size in MiB
//    8  u32  pages in use (4096 bytes each)
//   12  u32  peak pages in use
constexpr uint32_t kRamdiskStatsSize = 180;
constexpr size_t kRamdiskMinMiB = 0;
constexpr size_t kRamdiskMaxMiB = 4;
constexpr size_t kRamdiskUsedPages = 8;
constexpr size_t kRamdiskPeakPages = 12;

constexpr uint32_t kPageSize = 4096;

enum class Disk { Tar, Ram };

struct View {
   bool human = false;
   bool pool = false;
};

// One value as a column shows it: whole KiB, or the SizeToString text.
// Values are 64-bit so that disks of 4 GiB and more are not shown wrapped.
struct Shown {
   char text[24];
};

Shown Show(const View &view, uint64_t bytes) {
   Shown s;
   if (view.human)
      SizeToString(bytes, s.text, 16);
   else
      std::snprintf(s.text, sizeof s.text, "%" PRIu64, bytes >> 10);
   return s;
}

void PrintHeader(Disk disk, const View &view) {
   if (disk == Disk::Tar) {
      if (view.pool)
         std::printf("%-20s%10s%10s%10s%10s%10s%10s\n", "Tardisk", "", "", "Used", "", "", "Space");
      else
         std::printf("%-20s%10s%10s\n", "Tardisk", view.human ? "Space" : "1k-blocks", "Used");
   } else {
      if (view.pool)
         std::printf("%-20s%10s%10s%10s%10s%10s%10s\n", "Ramdisk", "Min", "Max", "Used", "Sure avl",
                     "Maybe avl", "Peak used");
      else
         std::printf("%-20s%10s%10s%10s%4s%% %s\n", "Ramdisk", view.human ? "Size" : "1k-blocks", "Used",
                     "Available", "Use", "Mounted on");
   }
}

void PrintTardiskRow(const char *name, const uint8_t *record, const View &view) {
   uint64_t used = ReadU32(record, kTardiskSize);
   uint64_t space = (used + kPageSize - 1) & ~uint64_t(kPageSize - 1);
   if (view.pool)
      std::printf("%-20s%10s%10s%10s%10s%10s%10s\n", name, "", "", Show(view, used).text, "", "",
                  Show(view, space).text);
   else
      std::printf("%-20s%10s%10s\n", name, Show(view, space).text, Show(view, used).text);
}

void PrintRamdiskRow(const char *name, const uint8_t *record, const View &view) {
   uint64_t min = uint64_t(ReadU32(record, kRamdiskMinMiB)) << 20;
   uint64_t max = uint64_t(ReadU32(record, kRamdiskMaxMiB)) << 20;
   uint64_t used = uint64_t(ReadU32(record, kRamdiskUsedPages)) * kPageSize;
   uint64_t peak = uint64_t(ReadU32(record, kRamdiskPeakPages)) * kPageSize;
   // What is left of the reservation, and of the maximum; never below 0.
   uint64_t sureAvailable = min >= used ? min - used : 0;
   uint64_t maybeAvailable = max >= used ? max - used : 0;
   uint64_t usePercent = max == 0 ? 100 : 100 * used / max;
   if (view.pool)
      std::printf("%-20s%10s%10s%10s%10s%10s%10s\n", name, Show(view, min).text, Show(view, max).text,
                  Show(view, used).text, Show(view, sureAvailable).text, Show(view, maybeAvailable).text,
                  Show(view, peak).text);
   else
      std::printf("%-20s%10s%10s%10s%4" PRIu64 "%% %s\n", name, Show(view, max).text, Show(view, used).text,
                  Show(view, maybeAvailable).text, usePercent, "--");
}

// Prints a row for each disk of one kind; false when the list cannot be
// fetched.  A disk whose stats cannot be read is reported and left out.
bool PrintTable(Disk disk, const View &view) {
   const bool tar = disk == Disk::Tar;
   ParamListPtr disks;
   KEL_Status status =
      GetInstanceList(tar ? KEL_NODE_system_corafs_tardisks : KEL_NODE_system_corafs_ramdisks, nullptr, &disks);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "Error fetching %sdisk list (%s)\n", tar ? "tar" : "ram",
                   ORX_ReturnStatusToString(status));
      return false;
   }
   const KEL_Node statsNode = tar ? KEL_NODE_system_corafs_tardisks_stats : KEL_NODE_system_corafs_ramdisks_stats;
   const uint32_t recordSize = tar ? kTardiskStatsSize : kRamdiskStatsSize;
   uint32_t count = KEL_ParamListUsedCount(disks.get());
   for (uint32_t i = 0; i < count; i++) {
      const KEL_Param *entry = KEL_ParamListGetParam(disks.get(), i);
      const char *name = entry ? KEL_ParamGetString(entry) : nullptr;
      char number[24];
      if (name == nullptr) {
         // A disk list holds names; show any other key as its number.
         std::snprintf(number, sizeof number, "%" PRId64, entry ? KEL_ParamGetInt(entry) : int64_t(0));
         std::fprintf(stderr, "KEL_Get error for '%s' (%s)\n", number,
                      ORX_ReturnStatusToString(KEL_STATUS_BAD_PARAM));
         continue;
      }
      ParamListPtr keys(KEL_ParamListCreate(1, 1));
      status = keys ? KEL_ParamListAddString(keys.get(), name) : KEL_Status(KEL_STATUS_NO_MEMORY);
      uint8_t record[kRamdiskStatsSize];
      if (status == KEL_STATUS_OK) status = KEL_Get(statsNode, keys.get(), record, recordSize);
      keys.reset();
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "KEL_Get error for '%s' (%s)\n", name, ORX_ReturnStatusToString(status));
         continue;
      }
      if (tar)
         PrintTardiskRow(name, record, view);
      else
         PrintRamdiskRow(name, record, view);
   }
   return true;
}

}  // namespace

int VdfMain(int argc, char **argv) {
   View view;
   int opt;
   while ((opt = getopt(argc, argv, kOptions)) != -1) {
      switch (opt) {
      case 'h': view.human = true; break;
      case 'p': view.pool = true; break;
      default: std::fputs(kUsage, stderr); return 1;
      }
   }
   if (argc - optind > 1) {
      std::fputs(kUsage, stderr);
      return 1;
   }
   if (argc - optind == 1) std::printf("Argument not supported yet. Ignoring.");

   PrintHeader(Disk::Tar, view);
   if (!PrintTable(Disk::Tar, view)) return 1;
   std::printf("-----\n");
   PrintHeader(Disk::Ram, view);
   return PrintTable(Disk::Ram, view) ? 0 : 1;
}
