// Signals to processes: the one call through which the tool signals anything.
#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>

#include "kel/kel.h"

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

}  // namespace

extern "C" int OrxProc_Signal(int32_t pid, int signal) {
   // Tests set the variable so that no process is ever signalled.
   if (const char *record = std::getenv("ORXKEL_SIGNAL_RECORD")) return RecordSignal(record, pid, signal);
   return kill(pid, signal);
}
