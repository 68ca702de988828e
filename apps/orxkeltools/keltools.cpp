// orxkeltools: start-up, the command table and the common services.
//
// Start-up decides between live and cache mode, runs the signature check,
// then hands the (re-based) command line to the command named by the base
// name of argv[0].
#include "keltools.h"

#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include <fcntl.h>
#include <unistd.h>

uint8_t InvokedWithCache = 0;

namespace {
int gOutputError = 0;  // the first errno of a failed raw write to standard output
// What the exit check reports a write error under, and the status it then
// ends with: the running command's name and failure status.
const char *gCommandName = "orxkeltools";
int gWriteFailureStatus = 1;
}  // namespace

void NoteOutputError(int err) {
   if (gOutputError == 0) gOutputError = err != 0 ? err : EIO;
}

namespace {

struct Command {
   const char *name;
   int (*handler)(int argc, char **argv);
   int failureStatus = 1;  // the exit status of a failed run (pgrep's 1 means "no match")
};

// Both command listings print the names in this order.
constexpr Command kCommands[] = {
   {"lspci", ListPCI},
   {"ps", PsMain},
   {"hwclock", HwclockMain},
   {"halvex", HalvexMain},
   {"irqinfo", InterruptInfo},
   {"bootOption", BootOptionMain},
   {"amldump", AmldumpMain},
   {"pci-info", PciInfoMain},
   {"pidof", PidofMain},
   {"userspaceof", UserspaceofMain},
   {"vdu", VduMain},
   {"lsof", LsofMain},
   {"vdf", VdfMain},
   {"pkill", PkillMain},
   {"pgrep", PgrepMain, 3},
   {"uptime", UptimeMain},
};

constexpr std::string_view kOwnName = "orxkeltools";

// POSIX basename without touching the argument: trailing slashes are
// ignored, "/" stays "/" and the empty text becomes ".".
std::string_view BaseName(std::string_view path) {
   if (path.empty()) return ".";
   size_t end = path.find_last_not_of('/');
   if (end == std::string_view::npos) return "/";
   path = path.substr(0, end + 1);
   size_t slash = path.rfind('/');
   return slash == std::string_view::npos ? path : path.substr(slash + 1);
}

bool IsCacheWord(const char *word) {
   return std::strcmp(word, "-c") == 0 || std::strcmp(word, "--cache") == 0;
}

void PrintCommandNames() {
   for (const Command &c : kCommands) std::fprintf(stderr, "   %s\n", c.name);
}

[[noreturn]] void ShortUsage() {
   std::fputs("usage: orxkeltools -c cache function\n", stderr);
   std::fputs("  available functions:\n", stderr);
   PrintCommandNames();
   std::exit(1);
}

void VReport(const char *fmt, va_list ap) {
   char buf[1024];
   std::vsnprintf(buf, sizeof buf, fmt, ap);
   std::fputs(buf, stderr);
}

// Descriptors 0-2 that are closed are opened on /dev/null, read-only: writes
// to a closed standard output then fail (and are reported) instead of
// landing in whatever file the command opens next.
void OpenMissingStandardDescriptors() {
   for (int fd = 0; fd <= 2; fd++) {
      if (fcntl(fd, F_GETFD) != -1 || errno != EBADF) continue;
      int opened = open("/dev/null", O_RDONLY);
      if (opened != fd) {
         // Descriptors are handed out lowest first, so anything else means
         // /dev/null could not be opened; give up rather than loop.
         if (opened >= 0) close(opened);
         return;
      }
   }
}

// Runs at every exit, also through exit() in help texts and Panic: output
// that could not be written makes the run fail, so that a cut file never
// passes for a complete one.
void CheckOutputAtExit() {
   errno = 0;
   bool failed = std::fflush(stdout) != 0 || std::ferror(stdout);
   int err = gOutputError != 0 ? gOutputError : errno != 0 ? errno : EIO;
   if (!failed && gOutputError == 0) return;
   std::fprintf(stderr, "%s: write error on standard output: %s\n", gCommandName, std::strerror(err));
   _exit(gWriteFailureStatus);
}

}  // namespace

extern "C" void Panic(const char *fmt, ...) {
   va_list ap;
   va_start(ap, fmt);
   VReport(fmt, ap);
   va_end(ap);
   std::exit(1);
}

extern "C" void Warning(const char *fmt, ...) {
   va_list ap;
   va_start(ap, fmt);
   VReport(fmt, ap);
   va_end(ap);
}

// Byte counts as whole mebibytes, kibibytes or bytes, rounded down.  The
// count is 64-bit so that totals of 4 GiB and more stay right.
void SizeToString(uint64_t bytes, char *buf, size_t size) {
   if (bytes > 0xFFFFF)
      std::snprintf(buf, size, "%lluM", static_cast<unsigned long long>(bytes >> 20));
   else if (bytes > 0x3FF)
      std::snprintf(buf, size, "%lluK", static_cast<unsigned long long>(bytes >> 10));
   else
      std::snprintf(buf, size, "%lluB", static_cast<unsigned long long>(bytes));
}

KEL_Status GetInstanceList(KEL_Node node, const KEL_ParamList *keys, KEL_ParamList **list) {
   return KEL_GetInstanceListAlloc(node, keys, list);
}

// Copies one instance-list entry onto a key list.
int AddParamToList(const KEL_Param *param, KEL_ParamList *list) {
   if (param == nullptr) {
      std::fprintf(stderr, "Couldn't add param to list: %#x", KEL_STATUS_BAD_PARAM);
      return 0;
   }
   uint32_t kind;
   std::memcpy(&kind, static_cast<const void *>(param), sizeof kind);
   KEL_Status status;
   if (kind == KEL_PARAM_INT) {
      status = KEL_ParamListAddInt(list, uint64_t(KEL_ParamGetInt(param)));
   } else if (kind == KEL_PARAM_STRING) {
      const char *text = KEL_ParamGetString(param);
      status = text ? KEL_ParamListAddString(list, text) : KEL_Status(KEL_STATUS_BAD_PARAM);
   } else {
      // The message names this source and line as the tool always has.
      Panic("NOT_IMPLEMENTED %s:%d\n", "apps/orxkeltools/keltools", 178);
   }
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "Couldn't add param to list: %#x", status);
      return 0;
   }
   return 1;
}

#ifndef ORXKEL_NO_MAIN
int main(int argc, char **argv) {
   OpenMissingStandardDescriptors();
   std::atexit(CheckOutputAtExit);
   if (argc < 1 || argv[0] == nullptr) ShortUsage();

   bool ownName = BaseName(argv[0]).substr(0, kOwnName.size()) == kOwnName;

   if (!HostType_OSIsORX() && !HostType_OSIsSimulator()) {
      // An ordinary machine has no kernel to read: a cache file is required.
      if (argc < 4) ShortUsage();
      if (!IsCacheWord(argv[1])) {
         std::fputs("error: must be invoked with cache when not on Nerio\n", stderr);
         std::exit(1);
      }
   }

   if (ownName && argc >= 4 && IsCacheWord(argv[1])) {
      KEL_Status status = KEL_UseCache(argv[2], 0);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "Couldn't use specifed cache file %s: %s\n", argv[2],
                      ORX_ReturnStatusToString(status));
         return 1;
      }
      argc -= 3;
      argv += 3;
      InvokedWithCache = 1;
   } else {
      OrxSyscall_Init(1, 0, 0);
      if (ownName && argc >= 2) {
         argc -= 1;
         argv += 1;
      }
      InvokedWithCache = 0;
   }

   char kernelDate[21];
   const char *myDate = "";
   if (KEL_CheckSig(kernelDate, sizeof kernelDate, &myDate) != 0) {
      kernelDate[20] = '\0';
      std::fprintf(stderr, "error: md5 signature mismatch with running orvik built on %s (my build date: %s)\n",
                   kernelDate, myDate);
      std::exit(1);
   }

   std::string_view name = BaseName(argv[0]);
   for (const Command &c : kCommands) {
      if (name != c.name) continue;
      gCommandName = c.name;
      gWriteFailureStatus = c.failureStatus;
      return c.handler(argc, argv);
   }

   std::fprintf(stderr,
                "usage: %s [options] [function] [arguments]\n"
                "       or [function] [arguments]\n\n"
                "Options:\n"
                "   --cache, -c    Perform the operation on a given KEL cache file\n\n"
                "Functions:\n",
                argv[0]);
   PrintCommandNames();
   return 1;
}
#endif
