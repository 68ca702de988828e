// A KEL tree made from the Linux machine the platform runs on: /proc, /sys
// and a few system calls, read once when Capture runs (docs/capture.md has
// the mapping).  It answers listings and reads as a tree would, so that
// kelcache can save it as a cache file and a later live mode can serve it
// call by call.
#ifndef PLATFORM_LINUXTREE_H
#define PLATFORM_LINUXTREE_H

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "cachefile.h"
#include "kel/kel.h"

namespace kelplat {

class LinuxTree {
public:
   // Reads every source once.  Whatever cannot be read is left out or stored
   // as a failing call; Skipped() says what and why.
   void Capture();

   // The keys of the instance level that ends levelPath ("world/#",
   // "userworld/cartel/#/fd/fds/#") below the given keys, in listing order,
   // and the status of the listing.  False when the tree has no such level
   // there.
   bool Instances(std::string_view levelPath, std::span<const Key> keys, uint32_t *status,
                  std::vector<Key> *out) const;
   // The record of node at keys and the status of its read; false when the
   // tree has none.
   bool Read(KEL_Node node, std::span<const Key> keys, uint32_t *status, std::string *record) const;

   // The build date a capture carries: the kernel release, cut to 20 characters.
   const std::string &BuildDate() const { return buildDate_; }
   // One line per kind of thing left out: "3 processes ended during the capture".
   std::vector<std::string> Skipped() const;

   // Used by the capture's parts (linuxtree.cpp) to store what they found.
   void AddLevel(std::string_view levelPath, std::span<const Key> keys, uint32_t status,
                 std::vector<Key> instances);
   void AddRecord(KEL_Node node, std::span<const Key> keys, uint32_t status, std::string record);
   void Skip(const std::string &why, unsigned count = 1);

private:
   struct Listing {
      uint32_t status;
      std::vector<Key> keys;
   };
   struct Record {
      uint32_t status;
      std::string data;
   };
   std::unordered_map<std::string, Listing> levels_;
   std::unordered_map<std::string, Record> records_;
   std::vector<std::pair<std::string, unsigned>> skipped_;
   std::string buildDate_;
};

// A process's command line as a capture stores it: the arguments of
// /proc/PID/cmdline joined by blanks, "[comm]" when there are none, cut to
// 1023 bytes.  False when the process cannot be read (it has ended).
bool LinuxCommandLine(int32_t pid, std::string *text);

}  // namespace kelplat

#endif
