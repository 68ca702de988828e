// vdf: free space of the in-memory root file system.  One table of
// tardisks and one of ramdisks, a row per disk, in 1 KiB blocks, in
// human-readable sizes (-h) or as the resource-pool view (-p).
#include <unistd.h>

#include <cinttypes>
#include <cstdio>

#include "kel/corafsrecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr char kOptions[] = "hp";
constexpr char kUsage[] =
   "Gather stats about corafs\n"
   "corafsdf [filepath]\n"
   "   -h       multiple instead of blocks\n"
   "   -p       resource pool view\n";

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
   constexpr uint64_t kPage = ramdiskstats::kPageSize;
   uint64_t used = ReadU32(record, tardiskstats::kSizeBytes);
   // The space a tardisk takes: its size rounded up to whole pages.
   uint64_t space = (used + kPage - 1) & ~(kPage - 1);
   if (view.pool)
      std::printf("%-20s%10s%10s%10s%10s%10s%10s\n", name, "", "", Show(view, used).text, "", "",
                  Show(view, space).text);
   else
      std::printf("%-20s%10s%10s\n", name, Show(view, space).text, Show(view, used).text);
}

void PrintRamdiskRow(const char *name, const uint8_t *record, const View &view) {
   uint64_t min = uint64_t(ReadU32(record, ramdiskstats::kMinMiB)) << 20;
   uint64_t max = uint64_t(ReadU32(record, ramdiskstats::kMaxMiB)) << 20;
   uint64_t used = uint64_t(ReadU32(record, ramdiskstats::kUsedPages)) * ramdiskstats::kPageSize;
   uint64_t peak = uint64_t(ReadU32(record, ramdiskstats::kPeakPages)) * ramdiskstats::kPageSize;
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
   const KEL_Node listNode = tar ? KEL_NODE_system_corafs_tardisks : KEL_NODE_system_corafs_ramdisks;
   const KEL_Node statsNode = tar ? KEL_NODE_system_corafs_tardisks_stats : KEL_NODE_system_corafs_ramdisks_stats;
   const uint32_t recordSize = tar ? tardiskstats::kSize : ramdiskstats::kSize;
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   WalkResult walk{WalkEnd::ListFailed, KEL_STATUS_NO_MEMORY};
   if (keys) {
      walk = ForEachInstance(listNode, keys.get(), [&](const KEL_Param *key) {
         const char *name = KEL_ParamGetString(key);
         if (name == nullptr) {
            // A disk list holds names; show any other key as its number.
            char number[24];
            std::snprintf(number, sizeof number, "%" PRId64, KEL_ParamGetInt(key));
            std::fprintf(stderr, "KEL_Get error for '%s' (%s)\n", number,
                         ORX_ReturnStatusToString(KEL_STATUS_BAD_PARAM));
            return true;
         }
         static_assert(tardiskstats::kSize <= ramdiskstats::kSize);
         uint8_t record[ramdiskstats::kSize];
         KEL_Status status = KEL_Get(statsNode, keys.get(), record, recordSize);
         if (status != KEL_STATUS_OK) {
            std::fprintf(stderr, "KEL_Get error for '%s' (%s)\n", name, ORX_ReturnStatusToString(status));
            return true;
         }
         if (tar)
            PrintTardiskRow(name, record, view);
         else
            PrintRamdiskRow(name, record, view);
         return true;
      });
   }
   if (walk.end == WalkEnd::ListFailed) {
      std::fprintf(stderr, "Error fetching %sdisk list (%s)\n", tar ? "tar" : "ram",
                   ORX_ReturnStatusToString(walk.status));
      return false;
   }
   // A key that could not be appended (reported by AddParamToList) leaves
   // the table incomplete.
   return walk.end == WalkEnd::Done;
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
