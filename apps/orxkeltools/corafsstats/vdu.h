// vdu's walker, printer and their small parts, shared with the unit tests.
#ifndef ORXKELTOOLS_CORAFSSTATS_VDU_H
#define ORXKELTOOLS_CORAFSSTATS_VDU_H

#include <cstddef>
#include <cstdint>

namespace vdu {

// The totals of one disk.  Byte sums are 64-bit so that trees of 4 GiB and
// more are not shown wrapped.
struct Bucket {
   uint32_t inodes;
   uint64_t bytes;
   uint32_t kind;  // 0 tardisk, 1 ramdisk
   char name[32];  // at most 31 characters and a NUL
};

struct Settings {
   uint32_t maxDepth = 1;  // entries deeper than this are counted, not printed
   bool human = false;
   bool countEmpty = false;  // count non-directories of size 0
};

// Paths handed to the file system stay below this length, terminator included.
constexpr size_t kPathBufferSize = 4096;

// Charges the entry at path (and all below it) to table, which has room for
// count buckets; prints the reports down to the maximum depth, in post-order.
// Returns how many buckets it filled, 0 when the entry is not counted.
uint32_t Walk(const Settings &settings, const char *path, uint32_t depth, Bucket *table,
              uint32_t count);

// Adds child to the bucket of its disk among the first *used of table, or
// takes the next free one; reports when the table is full.
void MergeBucket(Bucket *table, uint32_t *used, uint32_t count, const Bucket &child);

// Writes into buffer (kPathBufferSize bytes) the text that child paths of
// the directory at path start with, NUL-terminated, and returns its length;
// 0 (after the message) when the path is too long to build on.
size_t DirectoryPrefix(const char *path, char *buffer);

void PrintStats(const Settings &settings, const char *path, const Bucket *table, uint32_t used,
                bool showInodes);

}  // namespace vdu

#endif
