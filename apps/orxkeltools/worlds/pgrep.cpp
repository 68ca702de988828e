// pgrep: the cartels whose command line matches a pattern.
#include <unistd.h>

#include <cstdio>

#include "keltools.h"
#include "worlds/cartelwalk.h"

namespace {

constexpr char kOptions[] = "fhlv";
constexpr char kUsage[] = "Usage: pgrep [-flv] [PATTERN]";

// Exit statuses.
constexpr int kSelected = 0;
constexpr int kNoneSelected = 1;
constexpr int kBadArguments = 2;
constexpr int kFailed = 3;

struct Listing {
   bool list;    // -l: print the match text after the ID
   bool invert;  // -v: select the cartels that do not match
   bool live;
   pid_t self;
   bool matchMark = false;  // some cartel matched
};

KEL_Status PrintSelected(const CartelSeen &seen, void *context) {
   Listing &listing = *static_cast<Listing *>(context);
   bool selected = seen.matches != listing.invert;
   int32_t id = 0;
   if (selected || (listing.live && seen.matches)) {
      KEL_Status status = KEL_ParamListGetInt32(seen.cartels, seen.index, &id);
      if (status != KEL_STATUS_OK) return status;
      // In live mode pgrep's own cartel is neither printed nor counted: with
      // -f it matches any pattern taken from its own command line.
      if (listing.live && id == listing.self) return KEL_STATUS_OK;
   }
   if (seen.matches) listing.matchMark = true;
   // Without -l the ID is followed by a space and a lone backspace.
   if (selected) std::printf("%d %s\n", id, listing.list ? seen.text : "\b");
   return KEL_STATUS_OK;
}

int NoCriteria() {
   std::fputs("pgrep: no matching criteria specified\n", stderr);
   return kBadArguments;
}

}  // namespace

int PgrepMain(int argc, char **argv) {
   if (argc < 2) return NoCriteria();
   Listing listing{false, false, InvokedWithCache == 0, getpid()};
   bool full = false;
   int opt;
   while ((opt = getopt(argc, argv, kOptions)) != -1) {
      switch (opt) {
      case 'f':
         full = true;
         break;
      case 'l':
         listing.list = true;
         break;
      case 'v':
         listing.invert = true;
         break;
      case 'h':
         std::puts(kUsage);
         return 0;
      default:
         std::puts(kUsage);
         return kBadArguments;
      }
   }
   // Only the first argument after the options is the pattern.
   if (optind >= argc) return NoCriteria();

   PatternPtr pattern;
   switch (CompilePattern("pgrep", argv[optind], &pattern)) {
   case PatternResult::Compiled:
      break;
   case PatternResult::NoMemory:
      return kFailed;
   case PatternResult::BadPattern:
      return kBadArguments;
   }
   // Tree failures are silent, apart from what AddParamToList reports itself.
   if (WalkCartels(*pattern, full, PrintSelected, &listing) != KEL_STATUS_OK) return kFailed;
   return listing.matchMark == listing.invert ? kNoneSelected : kSelected;
}
