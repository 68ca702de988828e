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
#include <string>
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

enum class RuleKind { Tardisk, Ramdisk, Foreign };

struct Rule {
   std::string prefix;  // relative to the root; empty matches everything
   RuleKind kind;
   std::string disk;
   uint32_t flags;
};

struct SimInode {
   int rule;  // index into rules, or -1 when none matches
   uint64_t size;
   std::string name;
};

struct Corafs {
   bool built = false;
   bool haveRoot = false;
   dev_t rootDev = 0;
   std::vector<Rule> rules;
   std::unordered_map<ino_t, SimInode> inodes;
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

int MatchRule(const std::vector<Rule> &rules, const std::string &rel) {
   for (size_t i = 0; i < rules.size(); i++) {
      const std::string &p = rules[i].prefix;
      if (p.empty() || rel == p || (rel.size() > p.size() && rel.compare(0, p.size(), p) == 0 &&
                                    rel[p.size()] == '/'))
         return int(i);
   }
   return -1;
}

// One directory of the index walk: where its path relative to the root
// ends, the subdirectories still to enter, and its identity, so that the
// way back up through ".." is checked.
struct Level {
   size_t relLength;
   std::vector<std::string> subdirs;
   size_t next;
   dev_t dev;
   ino_t ino;
};

// Records the entries of the directory open at dir, whose path relative to
// the root is rel, and notes the subdirectories to enter.  A foreign rule
// stops the walk there: what lies below stands for another file system.
void IndexEntries(Corafs &fs, int dir, const std::string &rel, Level *level) {
   // readdir needs a descriptor of its own; dir stays open for fstatat.
   int own = openat(dir, ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   if (own < 0) return;
   DIR *d = fdopendir(own);
   if (d == nullptr) {
      close(own);
      return;
   }
   while (struct dirent *e = readdir(d)) {
      if (std::strcmp(e->d_name, ".") == 0 || std::strcmp(e->d_name, "..") == 0) continue;
      struct stat st;
      if (fstatat(dir, e->d_name, &st, AT_SYMLINK_NOFOLLOW) != 0 || st.st_dev != fs.rootDev) continue;
      std::string childRel = rel.empty() ? std::string(e->d_name) : rel + "/" + e->d_name;
      int rule = MatchRule(fs.rules, childRel);
      fs.inodes.emplace(st.st_ino, SimInode{rule, uint64_t(st.st_size), e->d_name});
      bool foreign = rule >= 0 && fs.rules[size_t(rule)].kind == RuleKind::Foreign;
      if (S_ISDIR(st.st_mode) && !foreign) level->subdirs.emplace_back(e->d_name);
   }
   closedir(d);
}

// Walks the root once, recording every inode on its device.  The walk goes
// from directory to directory by descriptor (openat, fstatat, and ".." on
// the way back), never through a joined path, so that no depth of the tree
// is out of reach of the system's path limit; one directory is open at a
// time.  Should the tree change under the walk so that ".." no longer leads
// back, the walk ends with what it has recorded.
void Index(Corafs &fs, const std::string &root) {
   int dir = open(root.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
   struct stat st;
   if (dir < 0) return;
   if (fstat(dir, &st) != 0) {
      close(dir);
      return;
   }
   fs.haveRoot = true;
   fs.rootDev = st.st_dev;
   fs.inodes[st.st_ino] = {MatchRule(fs.rules, ""), uint64_t(st.st_size), root};
   std::string rel;  // the current directory's path relative to the root
   std::vector<Level> levels;
   levels.push_back({0, {}, 0, st.st_dev, st.st_ino});
   IndexEntries(fs, dir, rel, &levels.back());
   while (!levels.empty()) {
      Level &top = levels.back();
      if (top.next < top.subdirs.size()) {
         const std::string &name = top.subdirs[top.next++];
         int child = openat(dir, name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
         if (child < 0) continue;
         if (fstat(child, &st) != 0 || st.st_dev != fs.rootDev) {
            close(child);
            continue;
         }
         rel.resize(top.relLength);
         if (!rel.empty()) rel += '/';
         rel += name;
         close(dir);
         dir = child;
         levels.push_back({rel.size(), {}, 0, st.st_dev, st.st_ino});
         IndexEntries(fs, dir, rel, &levels.back());
         continue;
      }
      levels.pop_back();
      if (levels.empty()) break;
      int parent = openat(dir, "..", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
      close(dir);
      dir = parent;
      if (dir < 0) return;
      if (fstat(dir, &st) != 0 || st.st_dev != levels.back().dev || st.st_ino != levels.back().ino) break;
   }
   close(dir);
}

Corafs &TheCorafs() {
   static Corafs fs;
   if (!fs.built) {
      fs.built = true;
      std::optional<std::string_view> root = TreeMeta("corafs.root");
      if (std::optional<std::string_view> rules = TreeMeta("corafs.rules")) fs.rules = ParseRules(*rules);
      if (root && !root->empty()) Index(fs, std::string(*root));
   }
   return fs;
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
   auto it = fs.haveRoot && st->st_dev == fs.rootDev ? fs.inodes.find(st->st_ino) : fs.inodes.end();
   if (it == fs.inodes.end()) {
      if (st->st_dev == 1) st->st_dev = 0;  // only the root's tree is device 1
      return 0;
   }
   int rule = it->second.rule;
   st->st_dev = rule >= 0 && fs.rules[size_t(rule)].kind == RuleKind::Foreign ? 2 : 1;
   return 0;
}

}  // namespace kelplat
