// lsof: every cartel's open file descriptors and mappings, one row each.
#include <cstdint>
#include <cstdio>
#include <string_view>

#include "keltools.h"
#include "records.h"
#include "worlds/worldinfo.h"

namespace {

constexpr char kHeader[] =
   "Cartel    |      World name     |        Type         |   fd   |  Description     ";
constexpr char kRule[] =
   "----------+---------------------+---------------------+--------+------------------";

// Fd record (KEL_NODE_userworld_cartel_fd_fds, 2084 bytes):
//
//    4 type          text, ends before byte 100
//  100 description   text, to the end of the record
namespace fdrec {
constexpr uint32_t kSize = 2084;
constexpr size_t kType = 4;
constexpr size_t kDescription = 100;
}  // namespace fdrec

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
      KEL_Status status = KEL_ParamListAddInt(keys, uint64_t(fd));
      if (status != KEL_STATUS_OK) {
         std::puts("failed to add fd to KEL parameter list");
         return status;
      }
      if (KEL_Get(KEL_NODE_userworld_cartel_fd_fds, keys, rec, sizeof rec) == KEL_STATUS_OK)
         PrintFdRow(row, int32_t(fd), rec);
      KEL_ParamListRemoveLastParam(keys);
   }
   return KEL_STATUS_OK;
}

KEL_Status PrintMappings(const CartelRow &row, KEL_ParamList *keys, const KEL_ParamList *mmaps) {
   uint8_t rec[mmaprec::kSize];
   uint32_t n = KEL_ParamListUsedCount(mmaps);
   for (uint32_t i = 0; i < n; i++) {
      int64_t key = KEL_ParamGetInt(KEL_ParamListGetParam(mmaps, i));
      KEL_Status status = KEL_ParamListAddInt(keys, uint64_t(key));
      if (status != KEL_STATUS_OK) {
         std::puts("failed to add mmap to KEL parameter list");
         return status;
      }
      if (KEL_Get(KEL_NODE_userworld_cartel_mem_mmaps, keys, rec, sizeof rec) == KEL_STATUS_OK &&
          ReadU32(rec, mmaprec::kKind) == kListedMappingKind)
         PrintMappingRow(row, rec);
      KEL_ParamListRemoveLastParam(keys);
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

// The walk's result as an exit status: the system keeps the low 8 bits of
// a status, so a failure whose low 8 bits are 0 ends with 1 instead of
// passing for success.
int ExitStatus(KEL_Status status) {
   if (status == KEL_STATUS_OK) return 0;
   return (status & 0xff) != 0 ? int(status & 0xff) : 1;
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
      int32_t cartelId = int32_t(uint32_t(KEL_ParamGetInt(cartel)));
      if (!AddParamToList(cartel, keys.get())) return KEL_STATUS_FAILURE;
      status = PrintCartel(cartelId, keys.get());
      if (status != KEL_STATUS_OK) return status;
      KEL_ParamListRemoveLastParam(keys.get());
   }
   return KEL_STATUS_OK;
}

}  // namespace

// Takes no options; arguments are ignored.
int LsofMain(int, char **) { return ExitStatus(WalkWorldList()); }
