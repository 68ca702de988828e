// JSON snapshots of a KEL tree, and cache files made from them (see
// docs/snapshot-format.md).
#ifndef KELCACHE_SNAPSHOT_H
#define KELCACHE_SNAPSHOT_H

#include <array>
#include <cstdint>
#include <cstdio>
#include <string>
#include <string_view>

#include "cachefile.h"

// A snapshot read into cache entries, with what the file's header takes
// from it.
struct SnapshotCache {
   kelplat::CacheWriter writer;
   std::array<uint8_t, 16> signature{};
   std::string buildDate;
};

// Reads a snapshot into *cache, so that the caller may let go of the text
// before the file is written (CacheWriter::WriteTo).  Mistakes as for
// BuildCache.
bool ReadSnapshot(const std::string &jsonText, SnapshotCache *cache, std::string *error);

// Makes the bytes of a cache file from a snapshot.  On a mistake, *error
// names the JSON path and what is wrong ("/tree/world/abc: not an integer
// key") and the result is false.
bool BuildCache(const std::string &jsonText, std::string *cacheBytes, std::string *error);

// Writes a cache file as a snapshot (pretty JSON, two-space indent, ending in
// a line feed) that builds back to the same entries: to the same bytes for a
// file BuildCache made.  A damaged file makes *error the text of its cache
// status ("Corrupt cache file").
bool DumpCache(std::string_view cacheBytes, std::string *jsonText, std::string *error);
// The same, written to file as it is made.  A damaged file is found before
// anything is written.  A failed write does not stop the dump: the file's
// error flag tells, and errno is that write's.
bool DumpCacheTo(std::string_view cacheBytes, FILE *file, std::string *error);

#endif
