// lsof: every cartel's open file descriptors and mappings, one row each.
#include <cstdint>
#include <cstdio>
#include <string_view>

#include "keltools.h"
#include "records.h"
#include "kel/worldrecords.h"

namespace {

constexpr char kHeader[] =
   "Cartel    |      World name     |        Type         |   fd   |  Description     ";
constexpr char kRule[] =
   "----------+---------------------+---------------------+--------+------------------";

// Only mappings of this kind are listed.
constexpr uint32_t kListedMappingKind = 2;

// One row's leading columns: the cartel and its main world's name.
struct CartelRow {
   int32_t cartelId;
   std::string_view worldName;
};

void PrintFdRow(const CartelRow &row, int32_t fd, const uint8_t *rec) {
   std::string_view type = ReadText(rec, fdrec::kType, fdrec::kDescription - fdrec::kType);
   std::string_view description = ReadText(rec, fdrec::kDescription, fdrec::kSize - fdrec::kDescription);
   std::printf("%-10d  %-20.*s  %-20.*s   %6d   %.*s\n", row.cartelId, int(row.worldName.size()),
               row.worldName.data(), int(type.size()), type.data(), fd, int(description.size()),
               description.data());
}

void PrintMappingRow(const CartelRow &row, const uint8_t *rec) {
   uint32_t prot = ReadU32(rec, mmaprec::kProt);
   std::string_view description =
      ReadText(rec, mmaprec::kDescription, mmaprec::kSize - mmaprec::kDescription);
   std::printf("%-10d  %-20.*s  %-20s   %6d   %.*s (prot:%s%s/len:%u)\n", row.cartelId,
               int(row.worldName.size()), row.worldName.data(), "MMAP", ReadI32(rec, mmaprec::kFd),
               int(description.size()), description.data(), (prot & 1) ? "R" : "-",
               (prot & 2) ? "W" : "-", ReadU32(rec, mmaprec::kLength));
}

// Lists the instances of node under the keys; null when the listing fails.
ParamListPtr ListUnder(KEL_Node node, const KEL_ParamList *keys) {
   ParamListPtr list;
   GetInstanceList(node, keys, &list);
   return list;
}

// Prints the fd rows of the cartel whose key ends keys.  A record that cannot
// be read gives no row.
KEL_Status PrintFds(const CartelRow &row, KEL_ParamList *keys, const KEL_ParamList *fds) {
   uint8_t rec[fdrec::kSize];
   uint32_t n = KEL_ParamListUsedCount(fds);
   for (uint32_t i = 0; i < n; i++) {
      int64_t fd = KEL_ParamGetInt(KEL_ParamListGetParam(fds, i));
      ScopedKey fdKey(keys, uint64_t(fd));
      if (!fdKey.ok()) {
         // Appending to a list that exists fails only for want of memory.
         std::puts("failed to add fd to KEL parameter list");
         return KEL_STATUS_NO_MEMORY;
      }
      if (KEL_Get(KEL_NODE_userworld_cartel_fd_fds, keys, rec, sizeof rec) == KEL_STATUS_OK)
         PrintFdRow(row, int32_t(fd), rec);
   }
   return KEL_STATUS_OK;
}

KEL_Status PrintMappings(const CartelRow &row, KEL_ParamList *keys, const KEL_ParamList *mmaps) {
   uint8_t rec[mmaprec::kSize];
   uint32_t n = KEL_ParamListUsedCount(mmaps);
   for (uint32_t i = 0; i < n; i++) {
      int64_t key = KEL_ParamGetInt(KEL_ParamListGetParam(mmaps, i));
      ScopedKey mappingKey(keys, uint64_t(key));
      if (!mappingKey.ok()) {
         std::puts("failed to add mmap to KEL parameter list");
         return KEL_STATUS_NO_MEMORY;
      }
      if (KEL_Get(KEL_NODE_userworld_cartel_mem_mmaps, keys, rec, sizeof rec) == KEL_STATUS_OK &&
          ReadU32(rec, mmaprec::kKind) == kListedMappingKind)
         PrintMappingRow(row, rec);
   }
   return KEL_STATUS_OK;
}

// The rows of the cartel whose key ends keys.  A cartel whose world name or
// fd list cannot be read has no rows at all; one whose mapping list cannot
// be read has only fd rows.
KEL_Status PrintCartel(int32_t cartelId, KEL_ParamList *keys) {
   uint8_t name[kWorldNameSize];
   if (KEL_Get(KEL_NODE_world_name, keys, name, sizeof name) != KEL_STATUS_OK) return KEL_STATUS_OK;
   CartelRow row{cartelId, ReadText(name, 0, sizeof name)};

   ParamListPtr fds = ListUnder(KEL_NODE_userworld_cartel_fd_fds, keys);
   if (!fds) return KEL_STATUS_OK;
   KEL_Status status = PrintFds(row, keys, fds.get());
   fds.reset();
   if (status != KEL_STATUS_OK) return status;

   ParamListPtr mmaps = ListUnder(KEL_NODE_userworld_cartel_mem_mmaps, keys);
   if (!mmaps) return KEL_STATUS_OK;
   return PrintMappings(row, keys, mmaps.get());
}

KEL_Status WalkWorldList() {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("WalkWorldList: Not enough memory\n", stderr);
      return KEL_STATUS_FAILURE;
   }
   ParamListPtr cartels;
   KEL_Status status = GetInstanceList(KEL_NODE_userworld_cartel, nullptr, &cartels);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "WalkWorldList: error fetching world list 0x%x\n", status);
      return status;
   }

   std::puts(kHeader);
   std::puts(kRule);
   uint32_t n = KEL_ParamListUsedCount(cartels.get());
   for (uint32_t i = 0; i < n; i++) {
      const KEL_Param *cartel = KEL_ParamListGetParam(cartels.get(), i);
      // The first column shows the key's low 32 bits, signed.
      int32_t cartelId = int32_t(uint32_t(KEL_ParamGetInt(cartel)));
      ScopedKey cartelKey(keys.get(), cartel);
      if (!cartelKey.ok()) return KEL_STATUS_FAILURE;
      status = PrintCartel(cartelId, keys.get());
      if (status != KEL_STATUS_OK) return status;
   }
   return KEL_STATUS_OK;
}

}  // namespace

// Takes no options; arguments are ignored.
int LsofMain(int, char **) { return KelExitStatus(WalkWorldList()); }
