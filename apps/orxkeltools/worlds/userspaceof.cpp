// userspaceof: the userspace ID of the world with a given world ID.
#include <cstdint>
#include <cstdio>

#include "keltools.h"
#include "records.h"
#include "numbers.h"
#include "worlds/worldinfo.h"

namespace {

constexpr char kUsage[] =
   "find the userspace ID of running programs\n"
   "userspaceof WID\n";

}  // namespace

int UserspaceofMain(int argc, char **argv) {
   if (argc < 2) {
      std::fputs(kUsage, stderr);
      return 1;
   }
   // Digits after the first non-digit are ignored: "12abc" is world 12.
   uint32_t worldId = StrtoulUInt32(argv[1]);
   if (worldId == 0) {
      std::puts("bad world ID");
      return 1;
   }

   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("CartelList: Not enough memory\n", stderr);
      return 1;
   }
   ParamListPtr worlds;
   KEL_Status status = GetInstanceList(KEL_NODE_world, nullptr, &worlds);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "CartelList: error fetching cartel list 0x%x\n", status);
      return 1;
   }

   // Every world is read: the walk does not stop at the first hit.
   unsigned printed = 0;
   uint32_t n = KEL_ParamListUsedCount(worlds.get());
   for (uint32_t i = 0; i < n; i++) {
      if (!AddParamToList(KEL_ParamListGetParam(worlds.get(), i), keys.get())) return 1;
      uint8_t info[worldinfo::kSize];
      if (KEL_Get(KEL_NODE_world_info, keys.get(), info, sizeof info) == KEL_STATUS_OK &&
          ReadU32(info, worldinfo::kWorldId) == worldId) {
         std::printf("%d ", ReadI32(info, worldinfo::kUserspaceId));
         printed++;
      }
      KEL_ParamListRemoveLastParam(keys.get());
   }
   if (printed == 0) return 1;
   std::putchar('\n');
   return 0;
}
