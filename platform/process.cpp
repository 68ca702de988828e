// Signals to processes: the one call through which the tool signals anything.
#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <new>
#include <string>

#include "cachefile.h"
#include "internal.h"
#include "kel/kel.h"
#include "kel/worldrecords.h"
#include "linuxtree.h"

namespace {

// Appends "pid signal" and a newline to the file at path instead of
// signalling.  A file that cannot be written is a failure with its errno;
// nothing is signalled either way.
int RecordSignal(const char *path, int32_t pid, int signal) {
   char line[32];
   int length = std::snprintf(line, sizeof line, "%d %d\n", pid, signal);
   int fd = open(path, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0644);
   if (fd < 0) return -1;
   ssize_t written = write(fd, line, size_t(length));
   int saved = errno;
   close(fd);
   if (written != length) {
      errno = written < 0 ? saved : EIO;
      return -1;
   }
   return 0;
}

// In the simulator a cartel ID is a process ID of this machine, but the
// snapshot may come from another one: a process is signalled only when its
// command line here, made as a capture makes it, is the cartel's command
// line in the snapshot.  A snapshot's "signalAnyProcess" setting lifts this.
bool SimulatorMaySignal(int32_t pid) {
   std::optional<std::string_view> any = kelplat::TreeMeta("signal.any");
   if (any && *any == "1") return true;
   KEL_ParamList *keys = KEL_ParamListCreate(1, 1);
   if (keys == nullptr) return false;
   char stored[kCmdlineSize] = "";
   bool read = KEL_ParamListAddInt(keys, pid) == KEL_STATUS_OK &&
               KEL_Get(KEL_NODE_userworld_cartel_cmdline, keys, stored, sizeof stored) == KEL_STATUS_OK;
   KEL_ParamListDestroy(keys);
   stored[sizeof stored - 1] = '\0';
   std::string here;
   return read && kelplat::LinuxCommandLine(pid, &here) && here == stored;
}

}  // namespace

extern "C" int OrxProc_Signal(int32_t pid, int signal) {
   if (kelplat::InSimulator()) {
      // No exception leaves the call: memory running out refuses the signal.
      bool may = false;
      try {
         may = SimulatorMaySignal(pid);
      } catch (const std::bad_alloc &) {
         errno = ENOMEM;
         return -1;
      }
      if (!may) {
         errno = ESRCH;
         return -1;
      }
   }
   // Tests set the variable so that no process is ever signalled.
   if (const char *record = std::getenv("ORXKEL_SIGNAL_RECORD")) return RecordSignal(record, pid, signal);
   return kill(pid, signal);
}
