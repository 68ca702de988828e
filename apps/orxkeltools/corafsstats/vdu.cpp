// vdu: disk usage of the in-memory root file system.  Walks a directory
// tree, charges each inode's size to the tardisk or ramdisk holding it and
// prints the totals per disk for every entry down to a chosen depth; or
// lists the unlinked files (-u).
#include "corafsstats/vdu.h"

#include <dirent.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include "kel/corafsrecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr char kOptions[] = "ad:hsiu";
constexpr char kUsage[] =
   "Gather stats about corafs\n"
   "corafsdu [filepath]\n"
   "   -h       multiple instead of bytes\n"
   "   -d depth reports for each element up to that depth (default 1)\n"
   "   -a       equivalent to unlimited depth\n"
   "   -s       equivalent to zero depth\n"
   "   -u       display stats for unlinked files\n";

constexpr uint32_t kUnlimitedDepth = 0x100000;

constexpr uint32_t kTardisk = 0, kRamdisk = 1;
constexpr const char *kKindNames[] = {"tardisk", "ramdisk"};

// The device number the in-memory root file system reports.
constexpr dev_t kCorafsDevice = 1;

// What vdu says when a table or a buffer of its walk cannot be allocated.
constexpr char kNoMemory[] = "unable to allocate memory for stats";

KEL_Status ReadInodeStats(uint64_t inode, uint8_t *record) {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) return KEL_STATUS_NO_MEMORY;
   KEL_Status status = KEL_ParamListAddInt(keys.get(), inode);
   if (status != KEL_STATUS_OK) return status;
   return KEL_Get(KEL_NODE_system_corafs_inodes_stats, keys.get(), record, inodestats::kSize);
}

// Fills the entry's own bucket from its inode stats; false (after the
// message) when they cannot be read.  *size is the record's size field.
bool ReadOwnBucket(const char *path, uint64_t inode, vdu::Bucket *own, uint32_t *size) {
   uint8_t record[inodestats::kSize];
   KEL_Status status = ReadInodeStats(inode, record);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "KEL_Get error for '%s' (%s)\n", path, ORX_ReturnStatusToString(status));
      return false;
   }
   uint32_t flags = ReadU32(record, inodestats::kFlags);
   *size = ReadU32(record, inodestats::kSizeBytes);
   bool tardisk = flags & inodestats::kOnTardisk;
   std::string_view disk =
      ReadText(record, tardisk ? inodestats::kTardisk : inodestats::kRamdisk, inodestats::kDiskNameWidth);
   size_t n = std::min(disk.size(), sizeof own->name - 1);
   std::memcpy(own->name, disk.data(), n);
   own->name[n] = '\0';
   own->kind = tardisk ? kTardisk : kRamdisk;
   own->bytes = flags & inodestats::kNotCharged ? 0 : *size;
   own->inodes = 1;
   return true;
}

// The names of a directory's entries in readdir order, one after another,
// each with its NUL.
struct EntryNames {
   MallocPtr<char> text;
   size_t capacity = 0;
   size_t length = 0;
};

// Reads the names of the directory at path; false when it cannot be opened
// or (after the message) when its names cannot be held.  Reading them all
// first keeps one directory open at a time, so deep trees do not run out of
// file descriptors.
bool ReadEntryNames(const char *path, EntryNames *names) {
   DIR *dir = opendir(path);
   if (dir == nullptr) return false;
   bool held = true;
   while (const dirent *e = readdir(dir)) {
      size_t size = std::strlen(e->d_name) + 1;
      if (!GrowArray(&names->text, &names->capacity, names->length + size)) {
         std::fputs(kNoMemory, stderr);
         held = false;
         break;
      }
      std::memcpy(names->text.get() + names->length, e->d_name, size);
      names->length += size;
   }
   closedir(dir);
   return held;
}

bool IsDotOrDotDot(std::string_view name) { return name == "." || name == ".."; }

// A size in its column: the SizeToString text in 5 columns, or the bytes in 12.
void PrintSizeColumn(bool human, uint64_t bytes) {
   if (human) {
      char text[16];
      SizeToString(bytes, text, sizeof text);
      std::printf("%5s", text);
   } else {
      std::printf("%12llu", static_cast<unsigned long long>(bytes));
   }
}

// Lists the unlinked files and their total.  Returns the status of the last
// KEL operation: a failed read of the last inode counts, earlier ones do not.
KEL_Status ReportUnlinked(bool human) {
   ParamListPtr inodes;
   KEL_Status status = GetInstanceList(KEL_NODE_system_corafs_inodes, nullptr, &inodes);
   if (status != KEL_STATUS_OK) return status;
   uint32_t total = KEL_ParamListUsedCount(inodes.get());
   if (total == 0) {
      std::printf("No unlinked files.\n");
      return KEL_STATUS_OK;
   }
   uint64_t bytes = 0;
   size_t found = 0;
   for (uint32_t i = 0; i < total; i++) {
      uint64_t inode;
      status = KEL_ParamListGetUInt64(inodes.get(), i, &inode);
      if (status != KEL_STATUS_OK) break;
      ParamListPtr keys(KEL_ParamListCreate(1, 1));
      if (!keys) {
         status = KEL_STATUS_NO_MEMORY;
         break;
      }
      status = KEL_ParamListAddInt(keys.get(), inode);
      if (status != KEL_STATUS_OK) break;
      uint8_t record[inodestats::kSize];
      status = KEL_Get(KEL_NODE_system_corafs_inodes_stats, keys.get(), record, inodestats::kSize);
      // An inode that cannot be read is passed over.
      if (status != KEL_STATUS_OK || ReadU32(record, inodestats::kLinkState) != inodestats::kUnlinked) continue;
      if (found++ == 0) std::printf("Unlinked files:\n");
      uint32_t size = ReadU32(record, inodestats::kSizeBytes);
      bytes += size;
      std::string_view name = ReadText(record, inodestats::kName, inodestats::kNameWidth);
      std::printf("%38.*s: ", int(name.size()), name.data());
      PrintSizeColumn(human, size);
      std::printf("\n");
   }
   if (found == 0) {
      std::printf("No unlinked files.\n");
   } else {
      std::printf("Total unlinked files: %zu\n", found);
      std::printf("Size of unlinked files: ");
      if (human) {
         char text[16];
         SizeToString(bytes, text, sizeof text);
         std::printf(" %s\n", text);
      } else {
         std::printf(" %llu\n", static_cast<unsigned long long>(bytes));
      }
   }
   return status;
}

// How many disks there are: tardisks plus ramdisks; a list that cannot be
// read counts none.
uint32_t CountDisks() {
   uint32_t count = 0;
   for (KEL_Node node : {KEL_NODE_system_corafs_tardisks, KEL_NODE_system_corafs_ramdisks}) {
      ParamListPtr list;
      if (GetInstanceList(node, nullptr, &list) != KEL_STATUS_OK) continue;
      count += KEL_ParamListUsedCount(list.get());
   }
   return count;
}

}  // namespace

namespace vdu {

void MergeBucket(Bucket *table, uint32_t *used, uint32_t count, const Bucket &child) {
   for (uint32_t i = 0; i < *used; i++) {
      if (table[i].kind == child.kind && std::strcmp(table[i].name, child.name) == 0) {
         table[i].bytes += child.bytes;
         table[i].inodes += child.inodes;
         return;
      }
   }
   if (*used < count) {
      table[(*used)++] = child;
      return;
   }
   std::fprintf(stderr, "Not enough dustats buckets\n");
}

size_t DirectoryPrefix(const char *path, char *buffer) {
   size_t length = std::strlen(path);
   if (length > kPathBufferSize - 1) {
      std::fprintf(stderr, "path too long for '%s' (%d)\n", path, int(length));
      return 0;
   }
   if (length == 0) {
      std::memcpy(buffer, "/", 2);
      return 1;
   }
   std::memcpy(buffer, path, length + 1);
   if (path[length - 1] == '/') return length;
   if (length + 1 == kPathBufferSize) {
      std::fprintf(stderr, "path too long for '%s' (%d)\n", path, int(kPathBufferSize));
      return 0;
   }
   buffer[length] = '/';
   buffer[length + 1] = '\0';
   return length + 1;
}

void PrintStats(const Settings &settings, const char *path, const Bucket *table, uint32_t used,
                bool showInodes) {
   std::printf("For '%s':\n", path);
   for (uint32_t i = 0; i < used; i++) {
      char label[48];
      std::snprintf(label, sizeof label, "%s %s", kKindNames[table[i].kind & 1], table[i].name);
      std::printf("%38s: ", label);
      PrintSizeColumn(settings.human, table[i].bytes);
      if (showInodes) std::printf("\t\t(%5u inodes)", table[i].inodes);
      std::printf("\n");
   }
}

uint32_t Walk(const Settings &settings, const char *path, uint32_t depth, Bucket *table,
              uint32_t count) {
   struct stat st;
   if (OrxFs_Lstat(path, &st) != 0 || st.st_dev != kCorafsDevice) return 0;
   Bucket own;
   uint32_t size;
   if (!ReadOwnBucket(path, st.st_ino, &own, &size)) return 0;
   if (count == 0) {
      std::fprintf(stderr, "No bucket space for '%s'\n", path);
      return 0;
   }
   table[0] = own;

   if (!S_ISDIR(st.st_mode)) {
      if (size == 0 && !settings.countEmpty) return 0;
      if (depth <= settings.maxDepth) PrintStats(settings, path, table, 1, false);
      return 1;
   }

   EntryNames names;
   if (!ReadEntryNames(path, &names)) return 0;
   // Each level has its own path buffer: the child paths of this directory.
   MallocPtr<char> childPath = AllocArray<char>(kPathBufferSize);
   if (!childPath) {
      std::fputs(kNoMemory, stderr);
      return 0;
   }
   const size_t prefixLength = DirectoryPrefix(path, childPath.get());
   if (prefixLength == 0) return 0;
   uint32_t used = 1;
   for (size_t at = 0; at < names.length;) {
      const char *name = names.text.get() + at;
      const size_t nameLength = std::strlen(name);
      at += nameLength + 1;
      if (prefixLength + nameLength + 1 > kPathBufferSize - 1) {
         std::fprintf(stderr, "path too long for '%s' '%s' (%d)\n", path, name, int(prefixLength + nameLength));
         continue;
      }
      if (IsDotOrDotDot(name)) continue;
      std::memcpy(childPath.get() + prefixLength, name, nameLength + 1);
      MallocPtr<Bucket> child = AllocArray<Bucket>(count);
      if (!child) {
         std::fputs(kNoMemory, stderr);
         continue;
      }
      uint32_t filled = Walk(settings, childPath.get(), depth + 1, child.get(), count);
      for (uint32_t i = 0; i < filled; i++) MergeBucket(table, &used, count, child[i]);
   }
   if (depth <= settings.maxDepth) PrintStats(settings, path, table, used, true);
   return used;
}

}  // namespace vdu

int VduMain(int argc, char **argv) {
   if (InvokedWithCache) {
      std::fprintf(stderr, "Using KEL cache is unsupported\n");
      return 1;
   }

   vdu::Settings settings;
   bool unlinked = false;
   int opt;
   while ((opt = getopt(argc, argv, kOptions)) != -1) {
      switch (opt) {
      case 'a': settings.maxDepth = kUnlimitedDepth; break;
      case 'd': settings.maxDepth = uint32_t(std::strtol(optarg, nullptr, 10)); break;
      case 's': settings.maxDepth = 0; break;
      case 'h': settings.human = true; break;
      case 'i': settings.countEmpty = true; break;
      case 'u': unlinked = true; break;
      default: std::fputs(kUsage, stderr); return 1;
      }
   }
   if (argc - optind > 1) {
      std::fputs(kUsage, stderr);
      return 1;
   }
   const char *start = optind < argc ? argv[optind] : ".";

   if (unlinked) return ReportUnlinked(settings.human) == KEL_STATUS_OK ? 0 : 1;

   uint32_t count = CountDisks();
   MallocPtr<vdu::Bucket> table = AllocArray<vdu::Bucket>(count);
   if (!table) return -12;
   vdu::Walk(settings, start, 0, table.get(), count);
   return 0;
}
