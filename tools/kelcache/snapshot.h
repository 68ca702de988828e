// JSON snapshots of a KEL tree, and cache files made from them (see
// docs/snapshot-format.md).
#ifndef KELCACHE_SNAPSHOT_H
#define KELCACHE_SNAPSHOT_H

#include <string>
#include <string_view>

// Makes the bytes of a cache file from a snapshot.  On a mistake, *error
// names the JSON path and what is wrong ("/tree/world/abc: not an integer
// key") and the result is false.
bool BuildCache(const std::string &jsonText, std::string *cacheBytes, std::string *error);

// Writes a cache file as a snapshot (pretty JSON, two-space indent, ending in
// a line feed) that builds back to the same entries: to the same bytes for a
// file BuildCache made.  A damaged file makes *error the text of its cache
// status ("Corrupt cache file").
bool DumpCache(std::string_view cacheBytes, std::string *jsonText, std::string *error);

#endif
