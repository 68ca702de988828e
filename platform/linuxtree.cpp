// The KEL tree of the Linux machine the platform runs on (see docs/capture.md
// for which Linux fact each field comes from).  Each source is read once:
// one pass over /proc, one over the PCI functions in /sys, one read each of
// /proc/interrupts, /proc/modules and the other files.
#include "linuxtree.h"

#include <dirent.h>
#include <fcntl.h>
#include <linux/rtc.h>
#include <sched.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <sys/statfs.h>
#include <sys/utsname.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <map>
#include <set>

#include "kel/corafsrecords.h"
#include "kel/hwrecords.h"
#include "kel/pcirecords.h"
#include "kel/schedrecords.h"
#include "kel/sysinforecords.h"
#include "kel/worldrecords.h"

namespace kelplat {

namespace {

// Flag of a kernel thread in the flags field of /proc/PID/stat.
constexpr unsigned long kKernelThread = 0x00200000;
// World type bits.
constexpr uint32_t kSystemWorld = 0x1, kUserWorld = 0x4, kCloneWorld = 0x20;
// Mapping kinds: a mapping of a file, and any other (anonymous, stack, heap).
constexpr uint32_t kMapAnonymous = 1, kMapFile = 2;
// What a failed read of something that needs more privilege stores.
constexpr uint32_t kDenied = KEL_STATUS_FAILURE;

// Owns a descriptor.
struct Fd {
   int fd = -1;
   explicit Fd(int f) : fd(f) {}
   Fd(const Fd &) = delete;
   Fd &operator=(const Fd &) = delete;
   ~Fd() {
      if (fd >= 0) close(fd);
   }
};

// Owns a directory stream.
struct Dir {
   DIR *dir = nullptr;
   explicit Dir(DIR *d) : dir(d) {}
   Dir(const Dir &) = delete;
   Dir &operator=(const Dir &) = delete;
   ~Dir() {
      if (dir != nullptr) closedir(dir);
   }
};

// Reads the file name below dir whole (at most limit bytes); false with
// errno set when it cannot be opened or read.
bool ReadAt(int dir, const char *name, std::string *out, size_t limit = size_t(1) << 24) {
   Fd fd(openat(dir, name, O_RDONLY | O_CLOEXEC | O_NOCTTY));
   if (fd.fd < 0) return false;
   out->clear();
   char chunk[16384];
   while (out->size() < limit) {
      ssize_t n = read(fd.fd, chunk, sizeof chunk);
      if (n < 0 && errno == EINTR) continue;
      if (n < 0) return false;
      if (n == 0) break;
      out->append(chunk, size_t(n));
   }
   if (out->size() > limit) out->resize(limit);
   return true;
}

bool ReadFile(const char *path, std::string *out) { return ReadAt(AT_FDCWD, path, out); }

Dir OpenDirAt(int dir, const char *name) {
   int fd = openat(dir, name, O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   if (fd < 0) return Dir(nullptr);
   DIR *d = fdopendir(fd);
   if (d == nullptr) close(fd);
   return Dir(d);
}

bool IsNumber(const char *s) {
   if (*s == '\0') return false;
   for (; *s != '\0'; s++)
      if (*s < '0' || *s > '9') return false;
   return true;
}

// The entries of a directory whose names are numbers, in numeric order.
std::vector<int64_t> NumberedEntries(DIR *dir) {
   std::vector<int64_t> out;
   while (dirent *e = readdir(dir))
      if (IsNumber(e->d_name)) out.push_back(std::strtoll(e->d_name, nullptr, 10));
   std::sort(out.begin(), out.end());
   return out;
}

void PutU16(std::string &r, size_t at, uint16_t v) {
   r[at] = char(v & 0xff);
   r[at + 1] = char(v >> 8);
}
void PutU32(std::string &r, size_t at, uint32_t v) { StoreU32(reinterpret_cast<uint8_t *>(r.data() + at), v); }
void PutU64(std::string &r, size_t at, uint64_t v) { StoreU64(reinterpret_cast<uint8_t *>(r.data() + at), v); }
// A text cut to width - 1 bytes and NUL-terminated.  Records are kept only
// as long as their last non-zero byte (a read zero-fills the rest), so the
// record grows to hold the text when needed.
void PutText(std::string &r, size_t at, size_t width, std::string_view text) {
   size_t n = std::min(text.size(), width - 1);
   if (r.size() < at + n + 1) r.resize(at + n + 1);
   std::memcpy(r.data() + at, text.data(), n);
   r[at + n] = '\0';
}

Key IntKey(int64_t v) { return Key{KEL_PARAM_INT, uint64_t(v), {}}; }
Key TextKey(std::string_view t) { return Key{KEL_PARAM_STRING, 0, std::string(t)}; }

std::string_view Trimmed(std::string_view s) {
   while (!s.empty() && (s.back() == '\n' || s.back() == ' ' || s.back() == '\0')) s.remove_suffix(1);
   return s;
}

// The value of "Name:\t..." in a status file, or empty.
std::string_view StatusField(std::string_view status, std::string_view name) {
   for (size_t at = 0; at < status.size();) {
      size_t end = status.find('\n', at);
      if (end == std::string_view::npos) end = status.size();
      std::string_view line = status.substr(at, end - at);
      if (line.size() > name.size() && line.starts_with(name) && line[name.size()] == ':') {
         line.remove_prefix(name.size() + 1);
         while (!line.empty() && (line.front() == '\t' || line.front() == ' ')) line.remove_prefix(1);
         return line;
      }
      at = end + 1;
   }
   return {};
}

// The fields of /proc/PID/stat a capture uses.
struct Stat {
   std::string comm;
   char state = '?';
   int64_t ppid = 0, pgrp = 0, session = 0;
   unsigned long flags = 0;
   uint64_t utime = 0, stime = 0;
};

bool ParseStat(std::string_view text, Stat *st) {
   size_t open = text.find('('), close = text.rfind(')');
   if (open == std::string_view::npos || close == std::string_view::npos || close < open) return false;
   st->comm = std::string(text.substr(open + 1, close - open - 1));
   std::string rest(text.substr(close + 1));
   // Fields after the name: state ppid pgrp session tty tpgid flags minflt
   // cminflt majflt cmajflt utime stime.
   unsigned long long f[13] = {};
   char state = '?';
   int n = std::sscanf(rest.c_str(), " %c %lld %lld %lld %*d %*d %lu %*u %*u %*u %*u %llu %llu", &state,
                       reinterpret_cast<long long *>(&f[0]), reinterpret_cast<long long *>(&f[1]),
                       reinterpret_cast<long long *>(&f[2]), &st->flags, &f[3], &f[4]);
   if (n < 7) return false;
   st->state = state;
   st->ppid = int64_t(f[0]);
   st->pgrp = int64_t(f[1]);
   st->session = int64_t(f[2]);
   st->utime = f[3];
   st->stime = f[4];
   return true;
}

// Run and wait state numbers (the platform's state tables) for a state letter.
void States(char letter, uint32_t *run, uint32_t *wait) {
   switch (letter) {
   case 'R': *run = 1, *wait = 0; return;   // RUN, NONE
   case 'S': *run = 3, *wait = 4; return;   // WAIT, EVENT
   case 'D': *run = 3, *wait = 6; return;   // WAIT, IO
   case 'T':
   case 't': *run = 3, *wait = 10; return;  // WAIT, SIGNAL
   case 'Z':
   case 'X':
   case 'x': *run = 0, *wait = 0; return;   // ZOMBIE, NONE
   case 'I': *run = 3, *wait = 1; return;   // WAIT, IDLE
   default: *run = 3, *wait = 0; return;
   }
}

std::string CommandLineFrom(std::string_view raw, std::string_view comm) {
   std::string text(Trimmed(raw));
   std::replace(text.begin(), text.end(), '\0', ' ');
   if (text.empty()) text = "[" + std::string(comm) + "]";
   if (text.size() > 1023) text.resize(1023);
   return text;
}

// The file-type word of a descriptor's target.
const char *FdType(mode_t mode) {
   switch (mode & S_IFMT) {
   case S_IFREG: return "REG";
   case S_IFDIR: return "DIR";
   case S_IFCHR: return "CHAR";
   case S_IFBLK: return "BLK";
   case S_IFIFO: return "FIFO";
   case S_IFSOCK: return "SOCK";
   case S_IFLNK: return "LINK";
   default: return "UNKNOWN";
   }
}

// The CPUs a thread may run on, as Cpus_allowed_list writes them ("0-3,6").
// sched_getaffinity answers without /proc's status text.
std::string Affinity(int64_t tid) {
   cpu_set_t set;
   CPU_ZERO(&set);
   if (sched_getaffinity(pid_t(tid), sizeof set, &set) != 0) return "";
   std::string out;
   for (int cpu = 0; cpu < CPU_SETSIZE;) {
      if (!CPU_ISSET(cpu, &set)) {
         cpu++;
         continue;
      }
      int last = cpu;
      while (last + 1 < CPU_SETSIZE && CPU_ISSET(last + 1, &set)) last++;
      if (!out.empty()) out += ',';
      out += std::to_string(cpu);
      if (last > cpu) out += '-' + std::to_string(last);
      cpu = last + 1;
   }
   return out;
}

// One thread, as read during the pass.
struct Task {
   int64_t tid;
   Stat stat;
   std::string affinity;
};

// One process.
struct Process {
   int64_t pid;
   Stat stat;
   bool kernel = false;
   uint32_t userspace = 0;
   bool namespaceInit = false;
   std::string cmdline;
   std::vector<Task> tasks;
};

class Capturer {
public:
   explicit Capturer(LinuxTree &t) : t_(t) {}
   void Processes();
   void Pci();
   void Interrupts();
   void Acpi();
   void System();

private:
   bool ReadProcess(int64_t pid, Process *p);
   void Descriptors(int procDir, int64_t pid);
   void Mappings(int procDir, int64_t pid);
   uint32_t Userspace(int procDir, int64_t pid, bool *namespaceInit);

   LinuxTree &t_;
   std::map<std::string, uint32_t> namespaces_;  // PID namespace link to userspace ID
   std::string rootNamespace_;
   bool rootKnown_ = false;
   std::map<std::string, uint32_t> modules_;     // module name to module ID
   uint32_t pcpus_ = 1;
};

uint32_t Capturer::Userspace(int procDir, int64_t pid, bool *namespaceInit) {
   // The namespace of the /proc being read is that of its PID 1.  A process
   // whose namespace link names it (or PID 1 itself) is in it; for any other
   // the status file's NSpid (its ID in each namespace, outermost first)
   // says how deep it is and whether it is its namespace's first process.
   // PID 1's link may be unreadable even for root (a sandbox); then the first
   // process NSpid places in /proc's namespace names it.
   if (rootNamespace_.empty()) {
      char link[64];
      ssize_t n = readlink("/proc/1/ns/pid", link, sizeof link - 1);
      rootKnown_ = n > 0;
      rootNamespace_ = rootKnown_ ? std::string(link, size_t(n)) : "/proc's own";
      namespaces_[rootNamespace_] = 1;
   }
   char link[64];
   ssize_t n = readlinkat(procDir, "ns/pid", link, sizeof link - 1);
   std::string name = n > 0 ? std::string(link, size_t(n)) : "";
   *namespaceInit = pid == 1;
   if (pid == 1) {
      name = rootNamespace_;
   } else if (name != rootNamespace_) {
      std::string status;
      ReadAt(procDir, "status", &status);
      std::string_view nspid = StatusField(status, "NSpid");
      size_t depth = 1 + size_t(std::count(nspid.begin(), nspid.end(), '\t'));
      size_t tab = nspid.rfind('\t');
      *namespaceInit = (tab == std::string_view::npos ? nspid : nspid.substr(tab + 1)) == "1";
      if (depth == 1 && !rootKnown_ && !name.empty()) {
         rootNamespace_ = name;
         rootKnown_ = true;
         namespaces_[name] = 1;
      }
      if (depth == 1) name = rootNamespace_;
      else if (name.empty()) name = "depth " + std::to_string(depth);
   }
   auto it = namespaces_.find(name);
   if (it != namespaces_.end()) return it->second;
   uint32_t next = 1;
   for (const auto &[_, id] : namespaces_) next = std::max(next, id + 1);
   namespaces_[name] = next;
   return next;
}

bool Capturer::ReadProcess(int64_t pid, Process *p) {
   char name[24];
   std::snprintf(name, sizeof name, "/proc/%lld", static_cast<long long>(pid));
   Fd dir(open(name, O_RDONLY | O_DIRECTORY | O_CLOEXEC));
   std::string text;
   if (dir.fd < 0 || !ReadAt(dir.fd, "stat", &text) || !ParseStat(text, &p->stat)) return false;
   p->pid = pid;
   p->kernel = (p->stat.flags & kKernelThread) != 0;
   if (!p->kernel) p->userspace = Userspace(dir.fd, pid, &p->namespaceInit);
   if (!ReadAt(dir.fd, "cmdline", &text)) return false;
   p->cmdline = CommandLineFrom(text, p->stat.comm);

   Dir tasks = OpenDirAt(dir.fd, "task");
   if (tasks.dir == nullptr) return false;
   for (int64_t tid : NumberedEntries(tasks.dir)) {
      Task task{tid, {}, Affinity(tid)};
      if (tid == pid) {
         task.stat = p->stat;
      } else {
         char sub[48];
         std::snprintf(sub, sizeof sub, "%lld/stat", static_cast<long long>(tid));
         if (!ReadAt(dirfd(tasks.dir), sub, &text) || !ParseStat(text, &task.stat)) {
            t_.Skip("threads ended during the capture");
            continue;
         }
      }
      p->tasks.push_back(std::move(task));
   }
   if (!p->kernel) {
      Descriptors(dir.fd, pid);
      Mappings(dir.fd, pid);
   }
   return true;
}

void Capturer::Descriptors(int procDir, int64_t pid) {
   Key cartel = IntKey(pid);
   Dir fds = OpenDirAt(procDir, "fd");
   if (fds.dir == nullptr) {
      t_.AddLevel("userworld/cartel/#/fd/fds/#", std::span(&cartel, 1), kDenied, {});
      t_.Skip("processes' open descriptors (permission denied)");
      return;
   }
   std::vector<Key> listed;
   for (int64_t fd : NumberedEntries(fds.dir)) {
      char name[24], target[2048];
      std::snprintf(name, sizeof name, "%lld", static_cast<long long>(fd));
      ssize_t n = readlinkat(dirfd(fds.dir), name, target, sizeof target - 1);
      if (n < 0) continue;  // closed meanwhile
      struct stat st;
      const char *type = fstatat(dirfd(fds.dir), name, &st, 0) == 0 ? FdType(st.st_mode) : "UNKNOWN";
      std::string r(fdrec::kDescription, '\0');
      PutText(r, fdrec::kType, fdrec::kDescription - fdrec::kType, type);
      PutText(r, fdrec::kDescription, fdrec::kSize - fdrec::kDescription, std::string_view(target, size_t(n)));
      Key keys[2] = {cartel, IntKey(fd)};
      t_.AddRecord(KEL_NODE_userworld_cartel_fd_fds, keys, KEL_STATUS_OK, std::move(r));
      listed.push_back(keys[1]);
   }
   t_.AddLevel("userworld/cartel/#/fd/fds/#", std::span(&cartel, 1), KEL_STATUS_OK, std::move(listed));
}

void Capturer::Mappings(int procDir, int64_t pid) {
   Key cartel = IntKey(pid);
   std::string maps;
   if (!ReadAt(procDir, "maps", &maps)) {
      t_.AddLevel("userworld/cartel/#/mem/mmaps/#", std::span(&cartel, 1), kDenied, {});
      t_.Skip("processes' mappings (permission denied)");
      return;
   }
   std::vector<Key> listed;
   int64_t index = 0;
   for (size_t at = 0; at < maps.size();) {
      size_t end = maps.find('\n', at);
      if (end == std::string::npos) end = maps.size();
      std::string line = maps.substr(at, end - at);
      at = end + 1;
      unsigned long long start = 0, stop = 0;
      char perms[8] = "";
      int pathAt = 0;
      if (std::sscanf(line.c_str(), "%llx-%llx %7s %*s %*s %*s %n", &start, &stop, perms, &pathAt) < 3) continue;
      std::string_view path = pathAt > 0 ? std::string_view(line).substr(size_t(pathAt)) : std::string_view();
      std::string r(mmaprec::kDescription, '\0');
      // Lengths beyond the 32-bit field are stored as 0xffffffff.
      uint64_t length = stop - start;
      PutU32(r, mmaprec::kLength, length > 0xffffffffu ? 0xffffffffu : uint32_t(length));
      PutU32(r, mmaprec::kKind, path.starts_with("/") ? kMapFile : kMapAnonymous);
      PutU32(r, mmaprec::kProt, (perms[0] == 'r' ? 1u : 0u) | (perms[1] == 'w' ? 2u : 0u));
      PutU32(r, mmaprec::kFd, uint32_t(-1));
      PutText(r, mmaprec::kDescription, mmaprec::kSize - mmaprec::kDescription, path);
      Key keys[2] = {cartel, IntKey(index++)};
      t_.AddRecord(KEL_NODE_userworld_cartel_mem_mmaps, keys, KEL_STATUS_OK, std::move(r));
      listed.push_back(keys[1]);
   }
   t_.AddLevel("userworld/cartel/#/mem/mmaps/#", std::span(&cartel, 1), KEL_STATUS_OK, std::move(listed));
}

void Capturer::Processes() {
   Dir proc(opendir("/proc"));
   if (proc.dir == nullptr) {
      t_.Skip("processes: /proc cannot be read");
      return;
   }
   std::vector<Process> processes;
   for (int64_t pid : NumberedEntries(proc.dir)) {
      Process p;
      if (ReadProcess(pid, &p))
         processes.push_back(std::move(p));
      else
         t_.Skip("processes ended during the capture");
   }
   long ticks = sysconf(_SC_CLK_TCK);
   if (ticks <= 0) ticks = 100;
   std::vector<Key> worlds, cartels;
   std::map<int64_t, std::vector<const Process *>> children;
   for (const Process &p : processes)
      if (!p.kernel) children[p.stat.ppid].push_back(&p);
   for (const Process &p : processes) {
      for (const Task &task : p.tasks) {
         Key world = IntKey(task.tid);
         worlds.push_back(world);
         bool leader = task.tid == p.pid;
         std::string info(worldinfo::kSize, '\0');
         PutU32(info, worldinfo::kWorldId, uint32_t(task.tid));
         PutU32(info, worldinfo::kUserspaceId, p.userspace);
         PutU32(info, worldinfo::kCartelId, p.kernel ? 0 : uint32_t(p.pid));
         int64_t parent = !leader ? p.pid : p.namespaceInit ? 0 : p.stat.ppid;
         PutU32(info, worldinfo::kParentCartelId, uint32_t(parent));
         PutU32(info, worldinfo::kProcessGroupId, uint32_t(task.stat.pgrp));
         PutU32(info, worldinfo::kSessionId, uint32_t(task.stat.session));
         PutU32(info, worldinfo::kTypeBits, (p.kernel ? kSystemWorld : kUserWorld) | (leader ? 0 : kCloneWorld));
         t_.AddRecord(KEL_NODE_world_info, std::span(&world, 1), KEL_STATUS_OK, std::move(info));
         std::string name;
         PutText(name, 0, kWorldNameSize, task.stat.comm);
         t_.AddRecord(KEL_NODE_world_name, std::span(&world, 1), KEL_STATUS_OK, std::move(name));

         uint32_t run, wait;
         States(task.stat.state, &run, &wait);
         std::string summary(summarystats::kWaitState + 4, '\0');
         PutU32(summary, summarystats::kRunState, run);
         PutU32(summary, summarystats::kWaitState, wait);
         t_.AddRecord(KEL_NODE_sched_Vcpus_stats_summaryStats, std::span(&world, 1), KEL_STATUS_OK,
                      std::move(summary));
         std::string affinity;
         PutText(affinity, affinity::kText, affinity::kSize, task.affinity);
         t_.AddRecord(KEL_NODE_sched_Vcpus_stats_affinity, std::span(&world, 1), KEL_STATUS_OK,
                      std::move(affinity));
         std::string times(statetimes::kSize, '\0');
         uint64_t ticksUsed = task.stat.utime + task.stat.stime;
         PutU64(times, statetimes::kUsedTime, ticksUsed * 1000000 / uint64_t(ticks));
         t_.AddRecord(KEL_NODE_sched_Vcpus_stats_stateTimes, std::span(&world, 1), KEL_STATUS_OK,
                      std::move(times));
      }
      if (p.kernel) continue;
      Key cartel = IntKey(p.pid);
      cartels.push_back(cartel);
      std::string cmdline;
      PutText(cmdline, 0, kCmdlineSize, p.cmdline);
      t_.AddRecord(KEL_NODE_userworld_cartel_cmdline, std::span(&cartel, 1), KEL_STATUS_OK, std::move(cmdline));
      std::vector<Key> kids;
      for (const Process *c : children[p.pid]) {
         Key keys[2] = {cartel, IntKey(c->pid)};
         std::string r(cartelchild::kSize, '\0');
         PutU32(r, cartelchild::kState, c->stat.state == 'Z' ? cartelchild::kZombie : 0);
         t_.AddRecord(KEL_NODE_userworld_cartel_child, keys, KEL_STATUS_OK, std::move(r));
         kids.push_back(keys[1]);
      }
      t_.AddLevel("userworld/cartel/#/child/#", std::span(&cartel, 1), KEL_STATUS_OK, std::move(kids));
   }
   t_.AddLevel("world/#", {}, KEL_STATUS_OK, worlds);
   t_.AddLevel("sched/Vcpus/#", {}, KEL_STATUS_OK, std::move(worlds));
   t_.AddLevel("userworld/cartel/#", {}, KEL_STATUS_OK, std::move(cartels));
}

// A hexadecimal number in a sysfs file ("0x8086\n"); fallback when unreadable.
uint64_t HexAt(int dir, const char *name, uint64_t fallback) {
   std::string text;
   if (!ReadAt(dir, name, &text, 64)) return fallback;
   return std::strtoull(text.c_str(), nullptr, 16);
}

void Capturer::Pci() {
   // Modules first: a function's driver names its module.
   std::string modules;
   std::vector<Key> moduleKeys;
   if (ReadFile("/proc/modules", &modules)) {
      uint32_t id = 1;
      for (size_t at = 0; at < modules.size();) {
         size_t end = modules.find('\n', at);
         if (end == std::string::npos) end = modules.size();
         std::string_view line = std::string_view(modules).substr(at, end - at);
         at = end + 1;
         std::string_view name = line.substr(0, line.find(' '));
         if (name.empty()) continue;
         modules_[std::string(name)] = id;
         std::string r(modulerecord::kSize, '\0');
         PutText(r, modulerecord::kName, modulerecord::kNameWidth, name);
         PutU32(r, modulerecord::kId, id);
         Key key = IntKey(id);
         t_.AddRecord(KEL_NODE_system_modules_general, std::span(&key, 1), KEL_STATUS_OK, std::move(r));
         moduleKeys.push_back(key);
         id++;
      }
   } else {
      t_.Skip("modules: /proc/modules cannot be read");
   }
   t_.AddLevel("system/modules/#", {}, KEL_STATUS_OK, std::move(moduleKeys));

   // Physical slots: /sys/bus/pci/slots/<name>/address is "0000:00:01".
   std::map<std::string, uint32_t> slots;
   if (Dir d(opendir("/sys/bus/pci/slots")); d.dir != nullptr) {
      while (dirent *e = readdir(d.dir)) {
         if (!IsNumber(e->d_name)) continue;
         std::string address, path = std::string(e->d_name) + "/address";
         if (ReadAt(dirfd(d.dir), path.c_str(), &address, 64))
            slots[std::string(Trimmed(address))] = uint32_t(std::strtoul(e->d_name, nullptr, 10));
      }
   }

   Dir devices(opendir("/sys/bus/pci/devices"));
   if (devices.dir == nullptr) {
      t_.Skip("PCI: the machine has no PCI functions in /sys/bus/pci/devices");
      t_.AddLevel("hardware/pci/seg/#", {}, KEL_STATUS_OK, {});
      return;
   }
   // segment -> bus -> slot -> functions
   std::map<int64_t, std::map<int64_t, std::map<int64_t, std::set<int64_t>>>> tree;
   unsigned configShort = 0;
   while (dirent *e = readdir(devices.dir)) {
      unsigned seg, bus, slot, func;
      if (std::sscanf(e->d_name, "%x:%x:%x.%x", &seg, &bus, &slot, &func) != 4) continue;
      Fd dev(openat(dirfd(devices.dir), e->d_name, O_RDONLY | O_DIRECTORY | O_CLOEXEC));
      if (dev.fd < 0) continue;
      tree[seg][bus][slot].insert(func);
      Key keys[4] = {IntKey(seg), IntKey(bus), IntKey(slot), IntKey(func)};
      std::string config;
      ReadAt(dev.fd, "config", &config, pciextconfigspace::kSize);
      auto cfg = [&](size_t at) { return at < config.size() ? uint8_t(config[at]) : uint8_t(0); };

      std::string r(pcirecord::kSize, '\0');
      PutU16(r, pcirecord::kVendor, uint16_t(HexAt(dev.fd, "vendor", 0xffff)));
      PutU16(r, pcirecord::kDevice, uint16_t(HexAt(dev.fd, "device", 0xffff)));
      PutU16(r, pcirecord::kSubvendor, uint16_t(HexAt(dev.fd, "subsystem_vendor", 0)));
      PutU16(r, pcirecord::kSubdevice, uint16_t(HexAt(dev.fd, "subsystem_device", 0)));
      PutU16(r, pcirecord::kClassCode, uint16_t(HexAt(dev.fd, "class", 0) >> 8));
      std::string irqText;
      unsigned long irq = ReadAt(dev.fd, "irq", &irqText, 32) ? std::strtoul(irqText.c_str(), nullptr, 10) : 0;
      uint8_t pin = cfg(0x3d);
      r[pcirecord::kIsaIrq] = char(cfg(0x3c));
      r[pcirecord::kIrq] = char(irq > 0 && irq < 0xff ? uint8_t(irq) : 0xff);
      r[pcirecord::kVector] = 0;
      r[pcirecord::kIntPin] = char(pin > 0 ? pin - 1 : 0);
      uint8_t headerType = cfg(0x0e) & 0x7f;
      bool bridge = headerType == 1 || headerType == 2;
      r[pcirecord::kSpawnedBus] = char(bridge ? cfg(0x19) : 0);
      r[pcirecord::kIrqFlags] =
         char((pin != 0 && irq != 0 ? pcirecord::kIrqValid : 0) | (bridge ? pcirecord::kSpawnsBus : 0));
      char link[512];
      ssize_t n = readlinkat(dev.fd, "driver/module", link, sizeof link - 1);
      uint32_t module = 0;
      if (n > 0) {
         std::string_view target(link, size_t(n));
         auto it = modules_.find(std::string(target.substr(target.rfind('/') + 1)));
         if (it != modules_.end()) module = it->second;
      }
      PutU32(r, pcirecord::kModuleId, module);
      for (const char *kind : {"net", "block"}) {
         Dir names = OpenDirAt(dev.fd, kind);
         std::string first;
         while (names.dir != nullptr && first.empty())
            if (dirent *d = readdir(names.dir); d == nullptr)
               break;
            else if (d->d_name[0] != '.')
               first = d->d_name;
         if (!first.empty()) {
            PutText(r, pcirecord::kDeviceName, pcirecord::kDeviceNameWidth, first);
            break;
         }
      }
      char address[16];
      std::snprintf(address, sizeof address, "%04x:%02x:%02x", seg, bus, slot);
      if (auto it = slots.find(address); it != slots.end()) PutU32(r, pcirecord::kPhysSlot, it->second);
      t_.AddRecord(KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigHeader, keys, KEL_STATUS_OK, std::move(r));
      if (config.size() >= pciconfigspace::kSize)
         t_.AddRecord(KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigSpace, keys, KEL_STATUS_OK,
                      config.substr(0, pciconfigspace::kSize));
      else
         configShort++;
      if (config.size() >= pciextconfigspace::kSize)
         t_.AddRecord(KEL_NODE_hardware_pci_seg_bus_slot_func_pciExtConfigSpace, keys, KEL_STATUS_OK, config);
   }
   if (configShort > 0)
      t_.Skip("PCI functions' configuration spaces (only root reads past the first 64 bytes)", configShort);
   std::vector<Key> segs;
   for (const auto &[seg, buses] : tree) {
      segs.push_back(IntKey(seg));
      std::vector<Key> busKeys;
      for (const auto &[bus, slotMap] : buses) {
         busKeys.push_back(IntKey(bus));
         std::vector<Key> slotKeys;
         for (const auto &[slot, funcs] : slotMap) {
            slotKeys.push_back(IntKey(slot));
            std::vector<Key> funcKeys;
            for (int64_t f : funcs) funcKeys.push_back(IntKey(f));
            Key keys[3] = {IntKey(seg), IntKey(bus), IntKey(slot)};
            t_.AddLevel("hardware/pci/seg/#/bus/#/slot/#/func/#", keys, KEL_STATUS_OK, std::move(funcKeys));
         }
         Key keys[2] = {IntKey(seg), IntKey(bus)};
         t_.AddLevel("hardware/pci/seg/#/bus/#/slot/#", keys, KEL_STATUS_OK, std::move(slotKeys));
      }
      Key key = IntKey(seg);
      t_.AddLevel("hardware/pci/seg/#/bus/#", std::span(&key, 1), KEL_STATUS_OK, std::move(busKeys));
   }
   if (segs.empty()) t_.Skip("PCI: the machine has no PCI functions");
   t_.AddLevel("hardware/pci/seg/#", {}, KEL_STATUS_OK, std::move(segs));
}

void Capturer::Interrupts() {
   long online = sysconf(_SC_NPROCESSORS_ONLN);
   pcpus_ = online > 0 ? uint32_t(online) : 1;
   std::string text;
   std::vector<Key> cookies;
   uint32_t cpus = 0;
   if (!ReadFile("/proc/interrupts", &text)) {
      t_.Skip("interrupts: /proc/interrupts cannot be read");
   } else {
      size_t at = text.find('\n');
      std::string_view header = std::string_view(text).substr(0, at);
      for (size_t i = header.find("CPU"); i != std::string_view::npos; i = header.find("CPU", i + 3)) cpus++;
      while (at != std::string::npos && at + 1 < text.size()) {
         size_t end = text.find('\n', at + 1);
         std::string line = text.substr(at + 1, end == std::string::npos ? std::string::npos : end - at - 1);
         at = end;
         char *p = line.data();
         while (*p == ' ') p++;
         char *colon = std::strchr(p, ':');
         if (colon == nullptr || !std::isdigit(uint8_t(*p))) continue;  // NMI, LOC, ERR...
         *colon = '\0';
         if (!IsNumber(p)) continue;
         Key cookie = IntKey(std::strtoll(p, nullptr, 10));
         char *rest = colon + 1;
         std::vector<Key> cpuKeys;
         for (uint32_t c = 0; c < cpus; c++) {
            char *next;
            unsigned long long count = std::strtoull(rest, &next, 10);
            if (next == rest) break;
            rest = next;
            Key keys[2] = {cookie, IntKey(c)};
            std::string r(irqcount::kSize, '\0');
            PutU64(r, irqcount::kCount, count);
            t_.AddRecord(KEL_NODE_hardware_interrupts_cookieList_PCPU, keys, KEL_STATUS_OK, std::move(r));
            cpuKeys.push_back(keys[1]);
         }
         t_.AddLevel("hardware/interrupts/cookieList/#/PCPU/#", std::span(&cookie, 1), KEL_STATUS_OK,
                     std::move(cpuKeys));
         // After the counts: the chip, the hardware IRQ and trigger
         // ("2-edge"), then the device names separated by ", ".
         std::vector<std::string> words;
         for (char *w = std::strtok(rest, " "); w != nullptr; w = std::strtok(nullptr, " ")) words.push_back(w);
         size_t first = 1;
         for (size_t i = 1; i < words.size(); i++)
            if (words[i].find('-') != std::string::npos) {
               first = i + 1;
               break;
            }
         std::string joined;
         for (size_t i = first; i < words.size(); i++) joined += (i > first ? " " : "") + words[i];
         std::vector<Key> names;
         for (size_t s = 0; s < joined.size();) {
            size_t comma = joined.find(", ", s);
            std::string name = joined.substr(s, comma == std::string::npos ? std::string::npos : comma - s);
            if (!name.empty()) names.push_back(TextKey(name));
            s = comma == std::string::npos ? joined.size() : comma + 2;
         }
         std::string usage(irqusage::kSize, '\0');
         usage[irqusage::kDeviceFlag] = char(names.empty() ? 0 : 1);
         t_.AddRecord(KEL_NODE_hardware_interrupts_cookieList_UsageStatus, std::span(&cookie, 1), KEL_STATUS_OK,
                      std::move(usage));
         t_.AddLevel("hardware/interrupts/cookieList/#/ORXDevices/$", std::span(&cookie, 1), KEL_STATUS_OK,
                     std::move(names));
         cookies.push_back(cookie);
      }
   }
   t_.AddLevel("hardware/interrupts/cookieList/#", {}, KEL_STATUS_OK, std::move(cookies));
   std::string cpu(cpuinfo::kSize, '\0');
   PutU32(cpu, cpuinfo::kNumCpus, cpus > 0 ? cpus : pcpus_);
   t_.AddRecord(KEL_NODE_hardware_cpu_cpuInfo, {}, KEL_STATUS_OK, std::move(cpu));
}

void Capturer::Acpi() {
   const char *folder = "/sys/firmware/acpi/tables";
   Dir d(opendir(folder));
   std::vector<Key> tables;
   if (d.dir == nullptr) {
      t_.Skip("ACPI: the machine has no ACPI tables in /sys/firmware/acpi/tables");
      t_.AddLevel("hardware/acpi/tables/#", {}, KEL_STATUS_OK, {});
      return;
   }
   // Names are a signature and, for a signature seen more than once, a
   // number from 1: order by signature, then number.
   std::vector<std::pair<std::string, long>> names;
   while (dirent *e = readdir(d.dir)) {
      struct stat st;
      if (e->d_name[0] == '.' || fstatat(dirfd(d.dir), e->d_name, &st, 0) != 0 || !S_ISREG(st.st_mode)) continue;
      std::string name = e->d_name;
      long number = name.size() > 4 ? std::strtol(name.c_str() + 4, nullptr, 10) : 0;
      names.push_back({name, number});
   }
   std::sort(names.begin(), names.end(), [](const auto &a, const auto &b) {
      int c = a.first.compare(0, 4, b.first, 0, 4);
      return c != 0 ? c < 0 : a.second < b.second;
   });
   int denied = 0;
   for (size_t i = 0; i < names.size(); i++) {
      Key table = IntKey(int64_t(i));
      tables.push_back(table);
      std::string bytes;
      if (!ReadAt(dirfd(d.dir), names[i].first.c_str(), &bytes)) {
         denied++;
         t_.AddLevel("hardware/acpi/tables/#/buffers/#", std::span(&table, 1), kDenied, {});
         continue;
      }
      std::vector<Key> buffers;
      size_t at = 0;
      do {
         size_t n = std::min<size_t>(bytes.size() - at, acpibuffer::kDataMax);
         std::string r(acpibuffer::kData, '\0');
         std::memcpy(r.data(), names[i].first.data(), std::min<size_t>(4, names[i].first.size()));
         PutU32(r, acpibuffer::kLength, uint32_t(n));
         r.append(bytes, at, n);
         Key keys[2] = {table, IntKey(int64_t(buffers.size()))};
         t_.AddRecord(KEL_NODE_hardware_acpi_tables_buffers, keys, KEL_STATUS_OK, std::move(r));
         buffers.push_back(keys[1]);
         at += n;
      } while (at < bytes.size());
      t_.AddLevel("hardware/acpi/tables/#/buffers/#", std::span(&table, 1), KEL_STATUS_OK, std::move(buffers));
   }
   if (denied > 0) t_.Skip("ACPI tables (permission denied; reading them needs root)", unsigned(denied));
   t_.AddLevel("hardware/acpi/tables/#", {}, KEL_STATUS_OK, std::move(tables));
}

void Capturer::System() {
   // Clock: the RTC when it can be read, else the system clock in UTC.
   struct tm now = {};
   bool haveRtc = false;
   if (Fd rtcFd(open("/dev/rtc0", O_RDONLY | O_CLOEXEC)); rtcFd.fd >= 0) {
      struct rtc_time rt = {};
      if (ioctl(rtcFd.fd, RTC_RD_TIME, &rt) == 0) {
         now.tm_hour = rt.tm_hour, now.tm_min = rt.tm_min, now.tm_sec = rt.tm_sec;
         now.tm_mday = rt.tm_mday, now.tm_mon = rt.tm_mon, now.tm_year = rt.tm_year;
         haveRtc = true;
      }
   }
   if (!haveRtc) {
      time_t t = time(nullptr);
      gmtime_r(&t, &now);
   }
   std::string clock(rtc::kSize, '\0');
   PutU32(clock, rtc::kHours, uint32_t(now.tm_hour));
   PutU32(clock, rtc::kMinutes, uint32_t(now.tm_min));
   PutU32(clock, rtc::kSeconds, uint32_t(now.tm_sec));
   PutU32(clock, rtc::kDay, uint32_t(now.tm_mday));
   PutU32(clock, rtc::kMonth, uint32_t(now.tm_mon + 1));
   PutU32(clock, rtc::kYear, uint32_t(now.tm_year + 1900));
   t_.AddRecord(KEL_NODE_hardware_chipset_rtc, {}, KEL_STATUS_OK, std::move(clock));

   // Version: uname, and the distribution's name from /etc/os-release.
   struct utsname u = {};
   uname(&u);
   std::string osRelease, pretty = "Linux";
   if (ReadFile("/etc/os-release", &osRelease)) {
      size_t at = osRelease.find("PRETTY_NAME=");
      if (at != std::string::npos) {
         size_t end = osRelease.find('\n', at);
         pretty = osRelease.substr(at + 12, end == std::string::npos ? std::string::npos : end - at - 12);
         if (pretty.size() >= 2 && pretty.front() == '"' && pretty.back() == '"') pretty = pretty.substr(1, pretty.size() - 2);
      }
   }
   std::string version(versioninfo::kSize, '\0');
   PutText(version, versioninfo::kProduct, versioninfo::kProductWidth, u.sysname);
   PutText(version, versioninfo::kVersion, versioninfo::kVersionWidth, u.release);
   PutText(version, versioninfo::kLevel, versioninfo::kLevelWidth, pretty);
   PutText(version, versioninfo::kUpdate, versioninfo::kUpdateWidth, "0");
   // The build number: "#12 SMP ..." in the kernel's version text.
   PutU32(version, versioninfo::kBuild, uint32_t(u.version[0] == '#' ? std::atoi(u.version + 1) : 0));
   t_.AddRecord(KEL_NODE_system_version, {}, KEL_STATUS_OK, std::move(version));

   // Boot: the kernel command line; no boot switches or option files on Linux.
   std::string cmdline;
   ReadFile("/proc/cmdline", &cmdline);
   std::string boot;
   PutText(boot, 0, bootcmdline::kSize, Trimmed(cmdline));
   t_.AddRecord(KEL_NODE_system_bootCmdLine, {}, KEL_STATUS_OK, std::move(boot));
   t_.AddRecord(KEL_NODE_system_bootOption, {}, KEL_STATUS_OK, std::string(bootoption::kSize, '\0'));
   t_.AddRecord(KEL_NODE_system_bootMAC, {}, KEL_STATUS_OK, std::string(bootmac::kSize, '\0'));
   t_.AddLevel("system/bootOptionFiles/$", {}, KEL_STATUS_OK, {});

   // Uptime, PCPUs and load.
   std::string text;
   std::string up(uptimeinfo::kSize, '\0');
   if (ReadFile("/proc/uptime", &text)) PutU32(up, uptimeinfo::kSeconds, uint32_t(std::strtod(text.c_str(), nullptr)));
   t_.AddRecord(KEL_NODE_system_ntpclock_upTime, {}, KEL_STATUS_OK, std::move(up));
   std::string count(numpcpus::kSize, '\0');
   PutU32(count, numpcpus::kCount, pcpus_);
   t_.AddRecord(KEL_NODE_sched_globalStats_numPcpus, {}, KEL_STATUS_OK, std::move(count));
   double load[3] = {};
   if (ReadFile("/proc/loadavg", &text)) std::sscanf(text.c_str(), "%lf %lf %lf", &load[0], &load[1], &load[2]);
   const KEL_Node *loadNodes[3] = {
      &KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory1MinInPct,
      &KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory5MinInPct,
      &KEL_NODE_sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory15MinInPct,
   };
   Key group = IntKey(0);
   for (int i = 0; i < 3; i++) {
      // The load in percent of one PCPU, summed over the PCPUs, so that
      // load / (100 x PCPUs) is the Linux load average over the machine.
      std::string r(loadhistory::kSize, '\0');
      PutU32(r, loadhistory::kLoadPct, uint32_t(std::lround(load[i] * 100.0 * pcpus_)));
      t_.AddRecord(*loadNodes[i], std::span(&group, 1), KEL_STATUS_OK, std::move(r));
   }
   t_.AddLevel("sched/groups/#", {}, KEL_STATUS_OK, {group});

   // Ramdisks: the mounted tmpfs and ramfs file systems.
   std::vector<Key> ramdisks;
   std::set<std::string> seen;
   if (ReadFile("/proc/self/mounts", &text)) {
      for (size_t at = 0; at < text.size();) {
         size_t end = text.find('\n', at);
         if (end == std::string::npos) end = text.size();
         std::string line = text.substr(at, end - at);
         at = end + 1;
         char source[256], point[1024], type[64];
         if (std::sscanf(line.c_str(), "%255s %1023s %63s", source, point, type) != 3) continue;
         if (std::strcmp(type, "tmpfs") != 0 && std::strcmp(type, "ramfs") != 0) continue;
         // Mount points escape blanks as \040; keep them as written.
         struct statfs fs;
         if (!seen.insert(point).second || statfs(point, &fs) != 0) continue;
         uint64_t total = uint64_t(fs.f_blocks) * uint64_t(fs.f_bsize);
         uint64_t used = uint64_t(fs.f_blocks - fs.f_bfree) * uint64_t(fs.f_bsize);
         uint64_t pages = (used + ramdiskstats::kPageSize - 1) / ramdiskstats::kPageSize;
         std::string r(ramdiskstats::kSize, '\0');
         PutU32(r, ramdiskstats::kMaxMiB, uint32_t(std::min<uint64_t>(total >> 20, 0xffffffff)));
         PutU32(r, ramdiskstats::kUsedPages, uint32_t(std::min<uint64_t>(pages, 0xffffffff)));
         PutU32(r, ramdiskstats::kPeakPages, uint32_t(std::min<uint64_t>(pages, 0xffffffff)));
         Key key = TextKey(point);
         t_.AddRecord(KEL_NODE_system_corafs_ramdisks_stats, std::span(&key, 1), KEL_STATUS_OK, std::move(r));
         ramdisks.push_back(std::move(key));
      }
   }
   t_.AddLevel("system/corafs/ramdisks/$", {}, KEL_STATUS_OK, std::move(ramdisks));
   t_.AddLevel("system/corafs/tardisks/$", {}, KEL_STATUS_OK, {});
}

std::string LevelKey(std::string_view levelPath, std::span<const Key> keys) {
   std::string out(levelPath);
   out += '\0';
   for (const Key &k : keys) AppendKey(out, k);
   return out;
}

}  // namespace

void LinuxTree::Capture() {
   struct utsname u = {};
   uname(&u);
   buildDate_ = std::string(u.release).substr(0, kBuildDateMax);
   Capturer c(*this);
   c.Interrupts();  // first: it counts the PCPUs
   c.Processes();
   c.Pci();
   c.Acpi();
   c.System();
}

void LinuxTree::AddLevel(std::string_view levelPath, std::span<const Key> keys, uint32_t status,
                         std::vector<Key> instances) {
   levels_[LevelKey(levelPath, keys)] = Listing{status, std::move(instances)};
}

void LinuxTree::AddRecord(KEL_Node node, std::span<const Key> keys, uint32_t status, std::string record) {
   // A read zero-fills what a stored record lacks, so trailing zeros need no room.
   size_t end = record.find_last_not_of('\0');
   record.resize(end == std::string::npos ? 0 : end + 1);
   records_[EncodeLookup(Op::Get, node, keys)] = Record{status, std::move(record)};
}

void LinuxTree::Skip(const std::string &why, unsigned count) {
   for (auto &[text, n] : skipped_)
      if (text == why) {
         n += count;
         return;
      }
   skipped_.push_back({why, count});
}

std::vector<std::string> LinuxTree::Skipped() const {
   std::vector<std::string> out;
   for (const auto &[text, n] : skipped_) out.push_back(std::to_string(n) + " x " + text);
   return out;
}

bool LinuxTree::Instances(std::string_view levelPath, std::span<const Key> keys, uint32_t *status,
                          std::vector<Key> *out) const {
   auto it = levels_.find(LevelKey(levelPath, keys));
   if (it == levels_.end()) return false;
   *status = it->second.status;
   *out = it->second.keys;
   return true;
}

bool LinuxTree::Read(KEL_Node node, std::span<const Key> keys, uint32_t *status, std::string *record) const {
   auto it = records_.find(EncodeLookup(Op::Get, node, keys));
   if (it == records_.end()) return false;
   *status = it->second.status;
   *record = it->second.data;
   return true;
}

bool LinuxCommandLine(int32_t pid, std::string *text) {
   char path[48];
   std::snprintf(path, sizeof path, "/proc/%d", pid);
   Fd dir(open(path, O_RDONLY | O_DIRECTORY | O_CLOEXEC));
   std::string raw, stat;
   Stat st;
   if (dir.fd < 0 || !ReadAt(dir.fd, "stat", &stat) || !ParseStat(stat, &st) || !ReadAt(dir.fd, "cmdline", &raw))
      return false;
   *text = CommandLineFrom(raw, st.comm);
   return true;
}

}  // namespace kelplat
