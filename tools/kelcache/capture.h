// kelcache capture: this Linux machine's tree as a cache file or a snapshot.
#ifndef KELCACHE_CAPTURE_H
#define KELCACHE_CAPTURE_H

#include <span>
#include <string>

// Writes bytes to the file at path, or fails with *problem.
using WriteFileFn = bool (*)(const std::string &path, const std::string &bytes, std::string *problem);

// "capture [-o FILE] [--json]": reads the machine, then writes a cache file
// to FILE, or a snapshot to FILE or standard output.  Returns the exit status.
int RunCapture(std::span<char *const> args, WriteFileFn write);

#endif
