// pidof: the IDs of the running cartels whose program has one of the given
// names.
#include <unistd.h>

#include <array>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string_view>

#include "keltools.h"
#include "records.h"
#include "numbers.h"
#include "kel/worldrecords.h"

namespace {

constexpr char kOptions[] = "sxo:";

constexpr char kUsage[] =
   "find the process ID of running programs\n"
   "pidof program program ...\n"
   "      -s   Single shot, only return one pid\n"
   "      -x   Scripts too, would also return ids of shells\n"
   "      -o   Pid to omit\n";

// With -x a cartel started by one of these shells (the exact path, nothing
// else) is also found by the name of its script.
constexpr std::string_view kShells[] = {"/bin/sh", "/bin/ash", "/bin/bash"};

constexpr size_t kMaxOmits = 256;

struct Search {
   bool singleShot = false;
   bool scripts = false;
   std::array<int32_t, kMaxOmits> omits{};
   size_t omitCount = 0;
};

void Usage() { std::fwrite(kUsage, 1, sizeof kUsage - 1, stderr); }

// What follows the last '/' of a text: the whole text when it has none, the
// empty text when it ends with '/'.  (Unlike a base name, trailing slashes
// are not stripped first.)
std::string_view AfterLastSlash(std::string_view text) {
   size_t slash = text.rfind('/');
   return slash == std::string_view::npos ? text : text.substr(slash + 1);
}

// A word of a command line names the program when it is the name, what
// follows the name's last '/', or what follows its own last '/' is the name.
bool NameMatches(std::string_view word, std::string_view name) {
   return word == name || word == AfterLastSlash(name) || AfterLastSlash(word) == name;
}

bool IsShell(std::string_view word) {
   for (std::string_view shell : kShells)
      if (word == shell) return true;
   return false;
}

bool Omitted(const Search &search, int32_t id) {
   for (size_t i = 0; i < search.omitCount; i++)
      if (search.omits[i] == id) return true;
   return false;
}

// Tests the cartel whose key is the last entry of cartelKeys against one name
// and prints its ID when it matches.  The cartel key doubles as the key of
// the cartel's main world; the command line is read under the cartel ID that
// world names, on idKeys (empty between calls).
bool CartelMatches(const Search &search, const KEL_ParamList *cartelKeys, KEL_ParamList *idKeys,
                   std::string_view name) {
   uint8_t info[worldinfo::kSize];
   if (KEL_Get(KEL_NODE_world_info, cartelKeys, info, sizeof info) != KEL_STATUS_OK) return false;
   uint32_t cartelId = ReadU32(info, worldinfo::kCartelId);
   if (cartelId == 0) return false;

   ScopedKey idKey(idKeys, uint64_t(cartelId));
   if (!idKey.ok()) return false;
   uint8_t cmdline[kCmdlineSize];
   if (KEL_Get(KEL_NODE_userworld_cartel_cmdline, idKeys, cmdline, sizeof cmdline) != KEL_STATUS_OK)
      return false;

   std::string_view text = ReadText(cmdline, 0, sizeof cmdline);
   size_t space = text.find(' ');
   std::string_view program = text.substr(0, space);
   bool found = NameMatches(program, name);
   if (!found && search.scripts && space != std::string_view::npos && IsShell(program)) {
      std::string_view rest = text.substr(space + 1);
      found = NameMatches(rest.substr(0, rest.find(' ')), name);
   }
   if (!found || Omitted(search, int32_t(cartelId))) return false;
   std::printf("%d ", int32_t(cartelId));
   return true;
}

// Walks a fresh cartel list for one name; returns how many IDs it printed.
// A failed append ends the walk and counts nothing for the name.
unsigned SearchName(const Search &search, std::string_view name) {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   ParamListPtr idKeys(KEL_ParamListCreate(1, 1));
   if (!keys || !idKeys) {
      std::fputs("CartelList: Not enough memory\n", stderr);
      return 0;
   }
   unsigned count = 0;
   WalkResult walk = ForEachInstance(KEL_NODE_userworld_cartel, keys.get(), [&](const KEL_Param *) {
      if (!CartelMatches(search, keys.get(), idKeys.get(), name)) return true;
      count++;
      return !search.singleShot;
   });
   switch (walk.end) {
   case WalkEnd::ListFailed:
      std::fprintf(stderr, "CartelList: error fetching cartel list 0x%x\n", walk.status);
      return 0;
   case WalkEnd::AppendFailed:
      return 0;
   case WalkEnd::Done:
   case WalkEnd::Stopped:
      break;
   }
   return count;
}

}  // namespace

int PidofMain(int argc, char **argv) {
   if (argc <= 1) {
      Usage();
      return 1;
   }
   Search search;
   int opt;
   while ((opt = getopt(argc, argv, kOptions)) != -1) {
      switch (opt) {
      case 's':
         search.singleShot = true;
         break;
      case 'x':
         search.scripts = true;
         break;
      case 'o':
         if (search.omitCount == kMaxOmits) {
            std::fputs("Too many omits\n", stderr);
            return 1;
         }
         search.omits[search.omitCount++] =
            std::strcmp(optarg, "%PPID") == 0 ? int32_t(getppid()) : StrtolInt32(optarg);
         break;
      default:
         Usage();
         return 1;
      }
   }
   if (optind >= argc) return 1;

   unsigned total = 0;
   for (int a = optind; a < argc; a++) {
      std::string_view name = argv[a];
      // A name with a '/' that does not begin with one is not searched.
      if (name.find('/') != std::string_view::npos && name[0] != '/') continue;
      total += SearchName(search, name);
      if (total > 0 && search.singleShot) break;
   }
   if (total == 0) return 1;
   std::putchar('\n');
   return 0;
}
