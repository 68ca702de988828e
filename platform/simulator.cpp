// The simulator's own answers: the real-time clock it can set, and the
// in-memory root file system mapped onto a real directory tree.
#include "simulator.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "internal.h"
#include "kel/corafsrecords.h"
#include "kel/sysinforecords.h"

namespace kelplat {

namespace {

// --- Real-time clock -------------------------------------------------------
// The clock lives in a file beside the snapshot ("<snapshot>.rtc", the
// clock's record), so that a set is seen by the next run.

std::string RtcPath() { return std::string(SimulatorPath()) + ".rtc"; }

bool ReadRtc(uint8_t *record) {
   int fd = open(RtcPath().c_str(), O_RDONLY | O_CLOEXEC);
   if (fd < 0) return false;
   ssize_t n = read(fd, record, rtc::kSize);
   close(fd);
   return n == ssize_t(rtc::kSize);
}

bool WriteRtc(const uint8_t *record) {
   std::string path = RtcPath(), tmp = path + ".tmp";
   int fd = open(tmp.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
   if (fd < 0) return false;
   bool ok = write(fd, record, rtc::kSize) == ssize_t(rtc::kSize);
   ok = close(fd) == 0 && ok;
   return ok && rename(tmp.c_str(), path.c_str()) == 0;
}

bool LeapYear(int y) { return (y % 4 == 0 && y % 100 != 0) || y % 400 == 0; }

// The clock holds real dates only, as the kernel's would.
bool ValidDateTime(int month, int day, int year, int hours, int minutes, int seconds) {
   static constexpr int kDays[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
   if (year < 1970 || year > 9999 || month < 1 || month > 12) return false;
   int days = kDays[month - 1] + (month == 2 && LeapYear(year) ? 1 : 0);
   return day >= 1 && day <= days && hours >= 0 && hours <= 23 && minutes >= 0 && minutes <= 59 &&
          seconds >= 0 && seconds <= 59;
}

// --- In-memory root file system ---------------------------------------------
// The snapshot names a directory ("corafs.root") and rules ("corafs.rules")
// that charge its files to disks.  Files under that directory report device 1;
// their inode statistics are made from the real file and the first matching
// rule.
//
// Nothing is walked ahead of the tool: each path it names through
// OrxFs_Lstat is placed under the root when it is asked about, with no
// system call beyond its own lstat in the common case.  A directory found
// under the root is remembered by the path the tool named it with, so that
// its entries, named as that path, a slash and their own name, are placed
// from it.  Any other path is placed by going up from it through ".." by
// descriptor until the root or a remembered directory is met, never
// through a joined path: a file deep below a root with a long absolute path
// is placed like any other.

enum class RuleKind { Tardisk, Ramdisk, Foreign };

struct Rule {
   std::string prefix;  // relative to the root; empty matches everything
   RuleKind kind;
   std::string disk;
   uint32_t flags;
};

// A directory under the root: its path relative to the root, the rules that
// can match it or something below it (in rule order, so the first match
// among them is the first match of all), and whether its entries belong to
// the root's tree.  They do not below a foreign rule: what lies there stands
// for another file system.
struct KnownDir {
   std::string rel;
   std::vector<uint32_t> rules;
   bool entriesInside;
};

// What an inode statistics read answers from.
struct SimInode {
   int rule;  // index into rules, or -1 when none matches
   uint64_t size;
   std::string name;
};

// Finds directories by a path given as a string_view without copying it.
struct PathHash {
   using is_transparent = void;
   size_t operator()(std::string_view s) const { return std::hash<std::string_view>{}(s); }
};

struct Corafs {
   bool built = false;
   bool haveRoot = false;
   dev_t rootDev = 0;
   std::string rootName;  // the root as the snapshot names it
   std::vector<Rule> rules;
   KnownDir root;
   // Directories under the root by the path the tool named them with (no
   // trailing slash), and by inode, where the way up from a path ends.
   std::unordered_map<std::string, KnownDir, PathHash, std::equal_to<>> dirsByPath;
   std::unordered_map<ino_t, const KnownDir *> dirsByInode;
   // The directory of the last entry placed: a walk asks about the entries of
   // one directory one after another.
   std::string_view lastPath;
   const KnownDir *lastDir = nullptr;
   // Inodes the tool has been told are on the root's device.
   std::unordered_map<ino_t, SimInode> inodes;
   std::string rel;  // scratch: the path of the entry being placed
};

std::vector<Rule> ParseRules(std::string_view text) {
   // One rule a line: prefix, kind, disk name and flags, separated by tabs.
   std::vector<Rule> rules;
   while (!text.empty()) {
      size_t end = text.find('\n');
      std::string_view line = text.substr(0, end);
      text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);
      std::vector<std::string> f;
      size_t start = 0;
      while (true) {
         size_t tab = line.find('\t', start);
         f.emplace_back(line.substr(start, tab - start));
         if (tab == std::string_view::npos) break;
         start = tab + 1;
      }
      if (f.size() != 4) continue;
      RuleKind kind = f[1] == "tardisk" ? RuleKind::Tardisk
                      : f[1] == "ramdisk" ? RuleKind::Ramdisk
                                          : RuleKind::Foreign;
      rules.push_back({f[0], kind, f[2], uint32_t(std::strtoul(f[3].c_str(), nullptr, 0))});
   }
   return rules;
}

// A rule's prefix matches rel itself or a folder above it.
bool Matches(std::string_view prefix, std::string_view rel) {
   return prefix.empty() || rel == prefix ||
          (rel.size() > prefix.size() && rel.starts_with(prefix) && rel[prefix.size()] == '/');
}

// A rule's prefix lies strictly below the folder rel.
bool Below(std::string_view prefix, std::string_view rel) {
   if (rel.empty()) return !prefix.empty();
   return prefix.size() > rel.size() + 1 && prefix.starts_with(rel) && prefix[rel.size()] == '/';
}

int FirstMatch(const Corafs &fs, const std::vector<uint32_t> &candidates, std::string_view rel) {
   for (uint32_t i : candidates)
      if (Matches(fs.rules[i].prefix, rel)) return int(i);
   return -1;
}

bool IsForeign(const Corafs &fs, int rule) { return rule >= 0 && fs.rules[size_t(rule)].kind == RuleKind::Foreign; }

bool IsDotName(std::string_view name) { return name == "." || name == ".."; }

// The path as a directory key: without trailing slashes, "/" kept.
std::string_view DirKey(std::string_view path) {
   while (path.size() > 1 && path.back() == '/') path.remove_suffix(1);
   return path;
}

// Opens the root and notes its identity.  A relative root is taken relative
// to the folder of the snapshot file, opened by descriptor so that no joined
// path is needed.
void OpenRoot(Corafs &fs, const std::string &root) {
   int base = AT_FDCWD;
   if (root[0] != '/') {
      std::string_view snapshot = SimulatorPath();
      size_t slash = snapshot.rfind('/');
      std::string folder = slash == std::string_view::npos ? "." : std::string(snapshot.substr(0, slash + 1));
      base = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
      if (base < 0) return;
   }
   int dir = openat(base, root.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   if (base != AT_FDCWD) close(base);
   if (dir < 0) return;
   struct stat st;
   if (fstat(dir, &st) == 0) {
      fs.haveRoot = true;
      fs.rootDev = st.st_dev;
      fs.rootName = root;
      fs.root.rel.clear();
      for (uint32_t i = 0; i < fs.rules.size(); i++) fs.root.rules.push_back(i);
      // The root's own rule does not keep its entries out.
      fs.root.entriesInside = true;
      fs.dirsByInode[st.st_ino] = &fs.root;
   }
   close(dir);
}

Corafs &TheCorafs() {
   static Corafs fs;
   if (!fs.built) {
      fs.built = true;
      std::optional<std::string_view> root = TreeMeta("corafs.root");
      if (std::optional<std::string_view> rules = TreeMeta("corafs.rules")) fs.rules = ParseRules(*rules);
      if (root && !root->empty()) OpenRoot(fs, std::string(*root));
   }
   return fs;
}

// The remembered directory that path names as the part before its last
// slash, with the entry's own name; nullptr when there is none.
const KnownDir *ParentByPath(Corafs &fs, std::string_view path, std::string_view *name) {
   size_t slash = path.rfind('/');
   if (slash == std::string_view::npos) return nullptr;
   *name = path.substr(slash + 1);
   if (name->empty() || IsDotName(*name)) return nullptr;
   std::string_view dir = DirKey(path.substr(0, slash + 1));
   if (fs.lastDir != nullptr && dir == fs.lastPath) return fs.lastDir;
   auto it = fs.dirsByPath.find(dir);
   if (it == fs.dirsByPath.end()) return nullptr;
   fs.lastPath = it->first;
   fs.lastDir = &it->second;
   return fs.lastDir;
}

// The name under which the directory open at parent holds the inode, found
// as getcwd finds it: by the entries' inode numbers, and failing that (at a
// mount point they differ) by asking each entry.
bool NameIn(int parent, dev_t dev, ino_t ino, std::string *name) {
   int own = openat(parent, ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   if (own < 0) return false;
   DIR *d = fdopendir(own);
   if (d == nullptr) {
      close(own);
      return false;
   }
   bool found = false;
   for (int pass = 0; pass < 2 && !found; pass++) {
      if (pass == 1) rewinddir(d);
      while (const dirent *e = readdir(d)) {
         if (IsDotName(e->d_name) || (pass == 0 && e->d_ino != ino)) continue;
         struct stat st;
         if (fstatat(parent, e->d_name, &st, AT_SYMLINK_NOFOLLOW) == 0 && st.st_dev == dev && st.st_ino == ino) {
            *name = e->d_name;
            found = true;
            break;
         }
      }
   }
   closedir(d);
   return found;
}

// Places the inode that path names (st, from lstat) by going up from it
// through ".." until a remembered directory (the root at the latest) is
// met: *base is that directory and *rel the path relative to the root.  One
// or two folders are open at a time.  False when the way up leaves the
// root's device or reaches the top of the file system first.
bool PlaceByDescriptor(Corafs &fs, const char *path, const struct stat &st, std::string *rel,
                       const KnownDir **base) {
   std::vector<std::string> names;  // from the inode upwards
   int dir;
   if (S_ISDIR(st.st_mode)) {
      dir = open(path, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
   } else {
      // A non-directory is its folder's entry: the path's last name.
      std::string_view p(path);
      size_t slash = p.rfind('/');
      std::string folder = slash == std::string_view::npos ? "." : std::string(p.substr(0, slash + 1));
      names.emplace_back(p.substr(slash == std::string_view::npos ? 0 : slash + 1));
      dir = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   }
   if (dir < 0) return false;
   struct stat cur;
   bool placed = false;
   // A directory replaced since its lstat is not placed.
   if (fstat(dir, &cur) == 0 && (!S_ISDIR(st.st_mode) || (cur.st_dev == st.st_dev && cur.st_ino == st.st_ino))) {
      while (cur.st_dev == fs.rootDev) {
         auto known = fs.dirsByInode.find(cur.st_ino);
         if (known != fs.dirsByInode.end()) {
            *base = known->second;
            placed = true;
            break;
         }
         int parent = openat(dir, "..", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
         if (parent < 0) break;
         struct stat up;
         std::string name;
         bool top = fstat(parent, &up) != 0 || (up.st_dev == cur.st_dev && up.st_ino == cur.st_ino);
         bool named = !top && NameIn(parent, cur.st_dev, cur.st_ino, &name);
         close(dir);
         dir = parent;
         if (!named) break;
         names.push_back(std::move(name));
         cur = up;
      }
   }
   close(dir);
   if (!placed) return false;
   *rel = (*base)->rel;
   for (size_t i = names.size(); i-- > 0;) {
      if (!rel->empty()) *rel += '/';
      *rel += names[i];
   }
   return true;
}

// Places a path the tool asks about: true, with the index of its rule (-1
// for none), when it is in the root's tree.  Remembers what a later read of
// its inode statistics, and the placing of its entries, need.
bool Place(Corafs &fs, const char *path, const struct stat &st, int *rule) {
   std::string &rel = fs.rel;
   std::string_view name;
   const std::vector<uint32_t> *candidates;
   if (const KnownDir *parent = ParentByPath(fs, path, &name)) {
      if (!parent->entriesInside) return false;
      rel = parent->rel;
      if (!rel.empty()) rel += '/';
      rel += name;
      candidates = &parent->rules;
   } else {
      const KnownDir *base = nullptr;
      if (!PlaceByDescriptor(fs, path, st, &rel, &base)) return false;
      // Below the remembered directory, no folder above the entry may be foreign.
      if (rel.size() > base->rel.size() && !base->entriesInside) return false;
      for (size_t at = base->rel.size() + 1; at < rel.size(); at++)
         if (rel[at] == '/' && IsForeign(fs, FirstMatch(fs, fs.root.rules, std::string_view(rel).substr(0, at))))
            return false;
      candidates = &base->rules;
   }
   *rule = FirstMatch(fs, *candidates, rel);

   size_t slash = rel.rfind('/');
   std::string_view own = rel.empty() ? std::string_view(fs.rootName)
                                      : std::string_view(rel).substr(slash == std::string::npos ? 0 : slash + 1);
   fs.inodes.insert_or_assign(st.st_ino, SimInode{*rule, uint64_t(st.st_size), std::string(own)});

   if (S_ISDIR(st.st_mode)) {
      std::string_view key = DirKey(path);
      if (fs.dirsByPath.find(key) == fs.dirsByPath.end()) {
         KnownDir dir{rel, {}, rel.empty() || !IsForeign(fs, *rule)};
         for (uint32_t i : *candidates)
            if (Matches(fs.rules[i].prefix, rel) || Below(fs.rules[i].prefix, rel)) dir.rules.push_back(i);
         auto added = fs.dirsByPath.emplace(std::string(key), std::move(dir)).first;
         fs.dirsByInode.emplace(st.st_ino, &added->second);
      }
   }
   return true;
}

void PutText(uint8_t *record, size_t offset, size_t width, std::string_view text) {
   size_t n = std::min(text.size(), width - 1);
   std::memcpy(record + offset, text.data(), n);
}

KEL_Status InodeStats(uint64_t ino, uint8_t *record) {
   Corafs &fs = TheCorafs();
   auto it = fs.inodes.find(ino_t(ino));
   if (it == fs.inodes.end() || it->second.rule < 0) return KEL_STATUS_NOT_FOUND;
   const Rule &rule = fs.rules[size_t(it->second.rule)];
   if (rule.kind == RuleKind::Foreign) return KEL_STATUS_NOT_FOUND;
   std::memset(record, 0, inodestats::kSize);
   bool tardisk = rule.kind == RuleKind::Tardisk;
   StoreU32(record + inodestats::kFlags, rule.flags | (tardisk ? inodestats::kOnTardisk : 0u));
   StoreU32(record + inodestats::kSizeBytes, uint32_t(it->second.size));
   PutText(record, tardisk ? inodestats::kTardisk : inodestats::kRamdisk, inodestats::kDiskNameWidth, rule.disk);
   PutText(record, inodestats::kName, inodestats::kNameWidth, it->second.name);
   return KEL_STATUS_OK;
}

}  // namespace

bool SimulatorClock(const NodeInfo &node, void *buf, uint32_t size, KEL_Status *status) {
   uint8_t record[rtc::kSize];
   if (node.number != KEL_NODE_hardware_chipset_rtc || !ReadRtc(record)) return false;
   CopyRecord({reinterpret_cast<const char *>(record), sizeof record}, buf, size);
   *status = KEL_STATUS_OK;
   return true;
}

KEL_Status SimulatorInodeStats(const NodeInfo &node, const KEL_ParamList *keys, void *buf, uint32_t size) {
   const KEL_Param *key = KEL_ParamListGetParam(keys, 0);
   if (node.number != KEL_NODE_system_corafs_inodes_stats || key->kind == KEL_PARAM_STRING)
      return KEL_STATUS_NOT_FOUND;
   uint8_t record[inodestats::kSize];
   KEL_Status status = InodeStats(key->value, record);
   if (status == KEL_STATUS_OK) CopyRecord({reinterpret_cast<const char *>(record), sizeof record}, buf, size);
   return status;
}

KEL_Status SimulatorSet(const NodeInfo &node, const KEL_ParamList *input, void *buf, uint32_t size) {
   (void)buf;
   (void)size;
   if (node.number != KEL_NODE_hardware_chipset_rtc) return KEL_STATUS_NOT_SUPPORTED;
   // The request: month, day, year, hours, minutes, seconds.
   int32_t v[6];
   if (KEL_ParamListUsedCount(input) != 6) return KEL_STATUS_BAD_PARAM;
   for (uint32_t i = 0; i < 6; i++)
      if (KEL_ParamListGetInt32(input, i, &v[i]) != KEL_STATUS_OK) return KEL_STATUS_BAD_PARAM;
   if (!ValidDateTime(v[0], v[1], v[2], v[3], v[4], v[5])) return KEL_STATUS_BAD_TIME;
   uint8_t record[rtc::kSize] = {};
   StoreU32(record + rtc::kMonth, uint32_t(v[0]));
   StoreU32(record + rtc::kDay, uint32_t(v[1]));
   StoreU32(record + rtc::kYear, uint32_t(v[2]));
   StoreU32(record + rtc::kHours, uint32_t(v[3]));
   StoreU32(record + rtc::kMinutes, uint32_t(v[4]));
   StoreU32(record + rtc::kSeconds, uint32_t(v[5]));
   return WriteRtc(record) ? KEL_STATUS_OK : KEL_STATUS_FAILURE;
}

int SimulatorLstat(const char *path, struct stat *st) {
   int r = lstat(path, st);
   if (r != 0) return r;
   Corafs &fs = TheCorafs();
   int rule;
   if (!fs.haveRoot || st->st_dev != fs.rootDev || !Place(fs, path, *st, &rule)) {
      if (st->st_dev == 1) st->st_dev = 0;  // only the root's tree is device 1
      return 0;
   }
   st->st_dev = IsForeign(fs, rule) ? 2 : 1;
   return 0;
}

}  // namespace kelplat
