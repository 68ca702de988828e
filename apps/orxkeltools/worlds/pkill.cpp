// pkill: signal the cartels whose command line matches a pattern.
#include <signal.h>
#include <unistd.h>

#include <cctype>
#include <cerrno>
#include <cstdio>
#include <cstring>

#include "keltools.h"
#include "worlds/cartelwalk.h"
#include "numbers.h"
#include "worlds/signals.h"

namespace {

constexpr char kOptions[] = "fh";
constexpr char kUsage[] = "Usage: pkill [-SIGNAL] [PATTERN]";
constexpr int kDefaultSignal = SIGTERM;

struct Killing {
   int signal;
   pid_t self;
};

// Takes a leading -NAME or -NUMBER out of the arguments and returns its
// signal; any other first argument stays for getopt and gives 0.
int TakeSignalArgument(int *argc, char **argv) {
   const char *word = argv[1];
   if (word[0] != '-') return 0;
   int signal = SignalByName(word + 1);
   if (signal == 0 && std::isdigit(static_cast<unsigned char>(word[1])))
      signal = StrtolInt32(word + 1);
   if (signal == 0) return 0;
   // The later arguments, and the terminating null, move down one place.
   std::memmove(&argv[1], &argv[2], sizeof(char *) * size_t(*argc - 1));
   (*argc)--;
   return signal;
}

KEL_Status SignalCartel(const CartelSeen &seen, void *context) {
   const Killing &killing = *static_cast<const Killing *>(context);
   if (!seen.matches) return KEL_STATUS_OK;
   int32_t id;
   KEL_Status status = KEL_ParamListGetInt32(seen.cartels, seen.index, &id);
   if (status != KEL_STATUS_OK) return status;
   // pkill never signals itself.  An ID below 1 names no single process: kill
   // would signal a whole process group (or every process) instead.
   if (id == killing.self || id <= 0) return KEL_STATUS_OK;
   if (OrxProc_Signal(id, killing.signal) != 0 && errno != ESRCH) {
      std::fprintf(stderr, "pkill: failed to kill %s (%d): %s\n", seen.text, id, std::strerror(errno));
      return KEL_STATUS_FAILURE;
   }
   return KEL_STATUS_OK;
}

void Fail(KEL_Status status) { std::fprintf(stderr, "pkill: %s\n", ORX_ReturnStatusToString(status)); }

}  // namespace

int PkillMain(int argc, char **argv) {
   if (InvokedWithCache) {
      std::fputs("Using KEL cache is unsupported\n", stderr);
      return 1;
   }
   if (argc < 2) {
      std::fputs("pkill: No matching criteria specified\n", stderr);
      std::puts(kUsage);
      return 1;
   }
   Killing killing{kDefaultSignal, getpid()};
   if (int signal = TakeSignalArgument(&argc, argv)) killing.signal = signal;

   bool full = false;
   int opt;
   while ((opt = getopt(argc, argv, kOptions)) != -1) {
      if (opt == 'f') full = true;
      if (opt == 'h') {
         std::puts(kUsage);
         return 0;
      }
      // getopt has reported any other option; it is passed over.
   }

   // Each pattern gets its own walk over a freshly read cartel list.
   for (int a = optind; a < argc; a++) {
      PatternPtr pattern;
      if (CompilePattern("pkill", argv[a], &pattern) != PatternResult::Compiled) return 1;
      KEL_Status status = WalkCartels(*pattern, full, SignalCartel, &killing);
      if (status != KEL_STATUS_OK) {
         Fail(status);
         return 1;
      }
   }
   return 0;
}
