// halvex: the running kernel's product name, version, build and release level.
#include <getopt.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "keltools.h"
#include "records.h"

namespace {

constexpr char kShortOptions[] = "vhl";
constexpr struct option kLongOptions[] = {
   {"version", no_argument, nullptr, 'v'},
   {"level", no_argument, nullptr, 'l'},
   {"help", no_argument, nullptr, 'h'},
   {nullptr, 0, nullptr, 0},
};
constexpr char kHelp[] =
   "halvex      -v, --version         Get version information for orvik\n"
   "            -l, --level           Get release level information\n"
   "            -h, --help            Print this menu\n";

// Version record (312 bytes): product name at 0 (32 bytes), version at 32
// (64), release level at 96 (64), update at 160 (up to the build number),
// build number at 292 (signed 32-bit).
constexpr uint32_t kVersionSize = 312;
constexpr size_t kProductOff = 0, kProductWidth = 32;
constexpr size_t kVersionOff = 32, kVersionWidth = 64;
constexpr size_t kLevelOff = 96, kLevelWidth = 64;
constexpr size_t kUpdateOff = 160, kUpdateWidth = 132;
constexpr size_t kBuildOff = 292;

[[noreturn]] void Help() {
   std::fputs(kHelp, stderr);
   std::exit(1);
}

}  // namespace

int HalvexMain(int argc, char **argv) {
   if (argc < 2) {
      std::fputs("halvex: no option specified\n", stderr);
      Help();
   }
   bool version = false, level = false;
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      if (c == 'v')
         version = true;
      else if (c == 'l')
         level = true;
      else
         Help();
   }
   if (!version && !level) {
      std::fputs("halvex: Invalid arguments\n", stderr);
      Help();
   }

   uint8_t rec[kVersionSize];
   if (KEL_Get(KEL_NODE_system_version, nullptr, rec, sizeof rec) != KEL_STATUS_OK) return 1;
   std::string_view product = ReadText(rec, kProductOff, kProductWidth);
   std::string_view ver = ReadText(rec, kVersionOff, kVersionWidth);
   std::string_view relLevel = ReadText(rec, kLevelOff, kLevelWidth);
   std::string_view update = ReadText(rec, kUpdateOff, kUpdateWidth);

   if (version)
      std::printf("%.*s %.*s build-%.5d\n", int(product.size()), product.data(), int(ver.size()), ver.data(),
                  ReadI32(rec, kBuildOff));
   if (level) {
      // Only a leading "0" means no update; an empty text counts as an update.
      if (update.empty() || update[0] != '0') {
         std::printf("%.*s %.*s %s%.*s\n", int(product.size()), product.data(), int(ver.size()), ver.data(),
                     "Update ", int(update.size()), update.data());
      } else {
         std::string_view word = relLevel == "Release" ? "GA" : relLevel;
         std::printf("%.*s %.*s %.*s%s\n", int(product.size()), product.data(), int(ver.size()), ver.data(),
                     int(word.size()), word.data(), "");
      }
   }
   return 0;
}
