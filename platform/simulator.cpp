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

namespace kelplat {

namespace {

// --- Real-time clock -------------------------------------------------------
// The clock lives in a file beside the snapshot ("<snapshot>.rtc", the
// 32-byte record), so that a set is seen by the next run.

constexpr uint32_t kRtcSize = 32;

std::string RtcPath() { return std::string(SimulatorPath()) + ".rtc"; }

bool ReadRtc(uint8_t *record) {
   int fd = open(RtcPath().c_str(), O_RDONLY | O_CLOEXEC);
   if (fd < 0) return false;
   ssize_t n = read(fd, record, kRtcSize);
   close(fd);
   return n == ssize_t(kRtcSize);
}

bool WriteRtc(const uint8_t *record) {
   std::string path = RtcPath(), tmp = path + ".tmp";
   int fd = open(tmp.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
   if (fd < 0) return false;
   bool ok = write(fd, record, kRtcSize) == ssize_t(kRtcSize);
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

// Walks the root once, recording every inode on its device.  A foreign rule
// stops the walk there: what lies below stands for another file system.
void Index(Corafs &fs, const std::string &root) {
   struct stat st;
   if (lstat(root.c_str(), &st) != 0) return;
   fs.haveRoot = true;
   fs.rootDev = st.st_dev;
   std::vector<std::string> pending{""};
   fs.inodes[st.st_ino] = {MatchRule(fs.rules, ""), uint64_t(st.st_size), root};
   while (!pending.empty()) {
      std::string rel = std::move(pending.back());
      pending.pop_back();
      std::string dir = rel.empty() ? root : root + "/" + rel;
      DIR *d = opendir(dir.c_str());
      if (d == nullptr) continue;
      while (struct dirent *e = readdir(d)) {
         if (std::strcmp(e->d_name, ".") == 0 || std::strcmp(e->d_name, "..") == 0) continue;
         std::string childRel = rel.empty() ? e->d_name : rel + "/" + e->d_name;
         std::string child = root + "/" + childRel;
         if (lstat(child.c_str(), &st) != 0 || st.st_dev != fs.rootDev) continue;
         int rule = MatchRule(fs.rules, childRel);
         fs.inodes.emplace(st.st_ino, SimInode{rule, uint64_t(st.st_size), e->d_name});
         bool foreign = rule >= 0 && fs.rules[size_t(rule)].kind == RuleKind::Foreign;
         if (S_ISDIR(st.st_mode) && !foreign) pending.push_back(childRel);
      }
      closedir(d);
   }
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
   // Inode stats record: flags at 4, link state at 20, size at 28, tardisk
   // name at 32, ramdisk name at 160, file name at 288.
   std::memset(record, 0, 544);
   bool tardisk = rule.kind == RuleKind::Tardisk;
   StoreU32(record + 4, rule.flags | (tardisk ? 1u : 0u));
   StoreU32(record + 28, uint32_t(it->second.size));
   PutText(record, tardisk ? 32 : 160, 128, rule.disk);
   PutText(record, 288, 256, it->second.name);
   return KEL_STATUS_OK;
}

}  // namespace

bool SimulatorClock(const NodeInfo &node, void *buf, uint32_t size, KEL_Status *status) {
   uint8_t record[kRtcSize];
   if (node.number != KEL_NODE_hardware_chipset_rtc || !ReadRtc(record)) return false;
   CopyRecord({reinterpret_cast<const char *>(record), sizeof record}, buf, size);
   *status = KEL_STATUS_OK;
   return true;
}

KEL_Status SimulatorInodeStats(const NodeInfo &node, const KEL_ParamList *keys, void *buf, uint32_t size) {
   const KEL_Param *key = KEL_ParamListGetParam(keys, 0);
   if (node.number != KEL_NODE_system_corafs_inodes_stats || key->kind == KEL_PARAM_STRING)
      return KEL_STATUS_NOT_FOUND;
   uint8_t record[544];
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
   uint8_t record[kRtcSize] = {};
   const int32_t fields[6] = {v[3], v[4], v[5], v[1], v[0], v[2]};  // record order
   for (int i = 0; i < 6; i++) StoreU32(record + 4 * i, uint32_t(fields[i]));
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
