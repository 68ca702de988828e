// userspaceof: the userspace ID of the world with a given world ID.
#include <cstdint>
#include <cstdio>

#include "keltools.h"
#include "records.h"
#include "numbers.h"
#include "kel/worldrecords.h"

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
   // Every world is read: the walk does not stop at the first hit.
   unsigned printed = 0;
   WalkResult walk = ForEachInstance(KEL_NODE_world, keys.get(), [&](const KEL_Param *) {
      uint8_t info[worldinfo::kSize];
      if (KEL_Get(KEL_NODE_world_info, keys.get(), info, sizeof info) == KEL_STATUS_OK &&
          ReadU32(info, worldinfo::kWorldId) == worldId) {
         std::printf("%d ", ReadI32(info, worldinfo::kUserspaceId));
         printed++;
      }
      return true;
   });
   if (walk.end == WalkEnd::ListFailed) {
      std::fprintf(stderr, "CartelList: error fetching cartel list 0x%x\n", walk.status);
      return 1;
   }
   // A key that cannot be appended ends the command; what was printed stays.
   if (walk.end != WalkEnd::Done) return 1;
   if (printed == 0) return 1;
   std::putchar('\n');
   return 0;
}
