// kelcache: turns a JSON snapshot of a KEL tree into a cache file, and a
// cache file back into JSON.  Each subcommand is one row of kCommands: its
// names, its usage line and its handler.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <functional>
#include <new>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "cachefile.h"
#include "capture.h"
#include "kel/kel.h"
#include "nodetable.h"
#include "snapshot.h"

#ifdef ORXKEL_VERSION
#define ORXKEL_VERSION_TEXT ORXKEL_VERSION
#else
#define ORXKEL_VERSION_TEXT "1.0.0"
#endif

namespace {

// The words after the subcommand's name.
using Args = std::span<char *const>;

struct Command {
   std::string_view names;  // "--help|-h|help": the first is the one shown
   std::string_view usage;  // what follows "kelcache " on the usage line
   std::string_view about;  // empty: the usage line says enough
   int (*run)(Args args);
};

int Build(Args args);
int Dump(Args args);
int Capture(Args args);
int Verify(Args args);
int Info(Args args);
int Version(Args args);
int ToolBuildDate(Args args);
int ToolSignature(Args args);
int Help(Args args);

constexpr Command kCommands[] = {
   {"build", "build SNAPSHOT.json -o FILE", "make a cache file from a snapshot (- reads stdin)", Build},
   {"dump", "dump FILE", "write a cache file as a snapshot", Dump},
   {"capture", "capture [-o FILE] [--json]", "this Linux machine as a cache file or snapshot", Capture},
   {"verify", "verify FILE", "check every byte of a cache file", Verify},
   {"info", "info FILE", "what a cache file holds, and for which build", Info},
   {"--version", "--version", "version, tree signature and build date", Version},
   {"--tool-build-date", "--tool-build-date", "the build date the tools carry", ToolBuildDate},
   {"--tool-signature", "--tool-signature", "the tree signature the tools expect", ToolSignature},
   {"--help|-h|help", "--help", "", Help},
};

bool HasName(const Command &c, std::string_view word) {
   for (std::string_view names = c.names;;) {
      size_t bar = names.find('|');
      if (names.substr(0, bar) == word) return true;
      if (bar == std::string_view::npos) return false;
      names.remove_prefix(bar + 1);
   }
}

void PrintUsage(FILE *out) {
   const char *lead = "usage:";
   for (const Command &c : kCommands) {
      if (c.about.empty()) {
         std::fprintf(out, "%-6s kelcache %.*s\n", lead, int(c.usage.size()), c.usage.data());
      } else {
         std::fprintf(out, "%-6s kelcache %-29.*s %.*s\n", lead, int(c.usage.size()), c.usage.data(),
                      int(c.about.size()), c.about.data());
      }
      lead = "";
   }
   std::fprintf(out, "The snapshot format is described in docs/snapshot-format.md.\n");
}

int Usage(const std::string &problem) {
   std::fprintf(stderr, "kelcache: %s\n", problem.c_str());
   PrintUsage(stderr);
   return 2;
}

// Standard output is checked once written: a full disk is a failure.
int Flushed() {
   if (std::fflush(stdout) != 0 || std::ferror(stdout)) {
      std::fprintf(stderr, "kelcache: write error: %s\n", std::strerror(errno));
      return 1;
   }
   return 0;
}

// Reads what is left of fd to its end.
bool ReadToEnd(int fd, std::string *bytes, std::string *problem) {
   bytes->clear();
   char chunk[65536];
   for (;;) {
      ssize_t n = read(fd, chunk, sizeof chunk);
      if (n < 0 && errno == EINTR) continue;
      if (n < 0) {
         *problem = std::strerror(errno);
         return false;
      }
      if (n == 0) return true;
      bytes->append(chunk, size_t(n));
   }
}

// Reads a regular file whole.  Opening never waits, so a FIFO is refused
// at once instead of blocking until a writer comes.
bool ReadRegularFile(const char *path, std::string *bytes, std::string *problem) {
   int fd = open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY);
   if (fd < 0) {
      *problem = std::strerror(errno);
      return false;
   }
   struct stat st;
   bool ok = fstat(fd, &st) == 0;
   if (!ok)
      *problem = std::strerror(errno);
   else if (!S_ISREG(st.st_mode))
      *problem = "not a regular file";
   // Room for the whole file at once, so that the text is not copied as it grows.
   if (ok && S_ISREG(st.st_mode)) bytes->reserve(size_t(st.st_size));
   ok = ok && S_ISREG(st.st_mode) && ReadToEnd(fd, bytes, problem);
   close(fd);
   return ok;
}

bool WriteAll(int fd, const std::string &bytes) {
   for (size_t done = 0; done < bytes.size();) {
      ssize_t n = write(fd, bytes.data() + done, bytes.size() - done);
      if (n < 0 && errno == EINTR) continue;
      if (n == 0) errno = EIO;
      if (n <= 0) return false;
      done += size_t(n);
   }
   return true;
}

// Replaces the regular file at path, or makes it.  fill writes the bytes to
// a new temporary in the same folder (mkstemp creates it, so no link is followed
// and nothing that exists is reused), which is then renamed over path: a
// failed run leaves the old file as it was.  Anything else at path (a link,
// a folder, a FIFO, a device) is refused, never replaced.
bool WriteCacheFile(const std::string &path, const std::function<bool(int fd)> &fill, std::string *problem) {
   struct stat st;
   if (lstat(path.c_str(), &st) == 0) {
      if (!S_ISREG(st.st_mode)) {
         *problem = "exists and is not a regular file";
         return false;
      }
   } else if (errno != ENOENT) {
      *problem = std::strerror(errno);
      return false;
   }
   size_t slash = path.rfind('/');
   std::string folder = slash == std::string::npos ? "." : slash == 0 ? "/" : path.substr(0, slash);
   std::string name = folder + "/.kelcache-XXXXXX";
   int fd = mkstemp(name.data());
   if (fd < 0) {
      *problem = std::strerror(errno);
      return false;
   }
   // mkstemp makes the file private; a cache file gets the usual mode.
   mode_t mask = umask(0);
   umask(mask);
   bool ok = fchmod(fd, 0666 & ~mask) == 0 && fill(fd);
   int error = ok ? 0 : errno;
   if (close(fd) != 0 && ok) {
      ok = false;
      error = errno;
   }
   if (ok && rename(name.c_str(), path.c_str()) != 0) {
      ok = false;
      error = errno;
   }
   if (ok) return true;
   unlink(name.c_str());
   *problem = std::strerror(error);
   return false;
}

bool WriteBytesAsCacheFile(const std::string &path, const std::string &bytes, std::string *problem) {
   return WriteCacheFile(path, [&bytes](int fd) { return WriteAll(fd, bytes); }, problem);
}

int Build(Args args) {
   std::string input, output;
   bool haveOutput = false;
   for (size_t i = 0; i < args.size(); i++) {
      std::string_view word = args[i];
      if (word == "-o") {
         if (i + 1 == args.size()) return Usage("-o needs a file name");
         output = args[++i];
         haveOutput = true;
      } else if (input.empty() && !word.empty() && (word[0] != '-' || word == "-")) {
         input = word;
      } else {
         return Usage("unexpected argument '" + std::string(word) + "'");
      }
   }
   if (input.empty() || !haveOutput) return Usage("build needs a snapshot and -o FILE");

   std::string json, problem;
   bool read = input == "-" ? ReadToEnd(STDIN_FILENO, &json, &problem) : ReadRegularFile(input.c_str(), &json, &problem);
   if (!read) {
      std::fprintf(stderr, "kelcache: %s: %s\n", input == "-" ? "standard input" : input.c_str(), problem.c_str());
      return 1;
   }
   SnapshotCache cache;
   if (!ReadSnapshot(json, &cache, &problem)) {
      std::fprintf(stderr, "kelcache: %s\n", problem.c_str());
      return 1;
   }
   // The text is no longer needed: its memory serves the writing (a swap,
   // as assigning an empty string would keep the capacity).
   std::string().swap(json);
   auto fill = [&cache](int fd) {
      try {
         return cache.writer.WriteTo(fd, cache.signature, cache.buildDate);
      } catch (const std::bad_alloc &) {
         errno = ENOMEM;
         return false;
      }
   };
   if (!WriteCacheFile(output, fill, &problem)) {
      std::fprintf(stderr, "kelcache: %s: %s\n", output.c_str(), problem.c_str());
      return 1;
   }
   return 0;
}

// Opens a cache file for a subcommand; false after the message.
bool OpenCache(const char *path, int flags, kelplat::CacheReader *reader) {
   KEL_Status status = reader->Open(path, flags);
   if (status == KEL_STATUS_OK) return true;
   std::string detail;
   if (status == KEL_STATUS_CACHE_OPEN) detail = std::string(" (") + std::strerror(errno) + ")";
   std::fprintf(stderr, "kelcache: %s: %s%s\n", path, ORX_ReturnStatusToString(status), detail.c_str());
   return false;
}

int Dump(Args args) {
   if (args.size() != 1) return Usage("dump needs exactly one cache file");
   const char *path = args[0];
   // The reader maps the file and checks its header before anything else,
   // so a hostile size is refused at once instead of read into memory.
   // The dump verifies the whole file itself.
   kelplat::CacheReader reader;
   if (!OpenCache(path, kelplat::kCacheQuickOpen, &reader)) return 1;
   std::string error;
   if (!DumpCacheTo(reader.Bytes(), stdout, &error)) {
      std::fprintf(stderr, "kelcache: %s: %s\n", path, error.c_str());
      return 1;
   }
   return Flushed();
}

int Capture(Args args) { return RunCapture(args, WriteBytesAsCacheFile); }

int Verify(Args args) {
   if (args.size() != 1) return Usage("verify needs exactly one cache file");
   kelplat::CacheReader reader;
   if (!OpenCache(args[0], 0, &reader)) return 1;
   std::printf("%s: OK, %u entries, %zu bytes\n", args[0], reader.EntryCount(), reader.Bytes().size());
   return Flushed();
}

void PrintSignature(std::span<const uint8_t, 16> signature) {
   for (uint8_t b : signature) std::printf("%02x", b);
}

// What a cache holds: its header, and per node how many entries of each
// operation, from the slot table alone (no full verification).
int Info(Args args) {
   if (args.size() != 1) return Usage("info needs exactly one cache file");
   kelplat::CacheReader reader;
   if (!OpenCache(args[0], kelplat::kCacheQuickOpen, &reader)) return 1;
   constexpr std::string_view kOps = "LGSDM";
   std::span<const kelplat::NodeInfo> nodes = kelplat::Nodes();
   // One row per node number (0: settings stored with the tree), one column per operation.
   std::vector<std::array<uint32_t, 5>> counts(nodes.size() + 1);
   uint32_t other = 0;
   for (uint32_t i = 0; i < reader.SlotCount(); i++) {
      std::string_view key;
      kelplat::CacheHit hit;
      uint32_t tag;
      if (!reader.SlotAt(i, &key, &hit, &tag)) continue;
      size_t op = key.size() >= 3 ? kOps.find(key[0]) : std::string_view::npos;
      unsigned node = key.size() >= 3 ? uint8_t(key[1]) | unsigned(uint8_t(key[2])) << 8 : 0;
      if (op == std::string_view::npos || node >= counts.size())
         other++;
      else
         counts[node][op]++;
   }
   bool matches = std::equal(reader.Signature().begin(), reader.Signature().end(),
                             kelplat::ToolSignature().begin());
   std::printf("file:        %s\n", args[0]);
   std::printf("signature:   ");
   PrintSignature(reader.Signature());
   std::printf("%s\n", matches ? " (matches this build)" : " (does not match this build)");
   std::printf("build date:  %s\n", reader.BuildDate().c_str());
   std::printf("size:        %zu bytes\n", reader.Bytes().size());
   std::printf("entries:     %u\n", reader.EntryCount());
   std::printf("%-40s %9s %9s %9s %9s\n", "node", "listings", "reads", "sets", "data");
   for (size_t n = 0; n < counts.size(); n++) {
      const std::array<uint32_t, 5> &c = counts[n];
      if (c[0] + c[1] + c[2] + c[3] + c[4] == 0) continue;
      std::string name = n == 0 ? "(settings)" : std::string(nodes[n - 1].name);
      std::printf("%-40s %9u %9u %9u %9u\n", name.c_str(), c[0], c[1] + c[4], c[2], c[3]);
   }
   if (other > 0) std::printf("%-40s %9u\n", "(other keys)", other);
   return Flushed();
}

int Version(Args args) {
   if (!args.empty()) return Usage("--version takes no arguments");
   std::printf("kelcache %s\n", ORXKEL_VERSION_TEXT);
   std::printf("tree signature: ");
   PrintSignature(kelplat::ToolSignature());
   std::printf("\nbuild date: %s\n", kelplat::ToolBuildDate());
   return Flushed();
}

int ToolBuildDate(Args args) {
   if (!args.empty()) return Usage("--tool-build-date takes no arguments");
   std::printf("%s\n", kelplat::ToolBuildDate());
   return Flushed();
}

int ToolSignature(Args args) {
   if (!args.empty()) return Usage("--tool-signature takes no arguments");
   for (uint8_t b : kelplat::ToolSignature()) std::printf("%02x", b);
   std::printf("\n");
   return Flushed();
}

int Help(Args) {
   PrintUsage(stdout);
   return Flushed();
}

}  // namespace

int main(int argc, char **argv) {
   if (argc < 2) return Usage("no command given");
   std::string_view word = argv[1];
   Args rest(argv + 2, size_t(argc - 2));
   for (const Command &c : kCommands)
      if (HasName(c, word)) return c.run(rest);
   return Usage("unknown command '" + std::string(word) + "'");
}
