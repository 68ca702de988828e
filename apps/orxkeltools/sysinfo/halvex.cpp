// halvex: the running kernel's product name, version, build and release level.
#include <getopt.h>

#include <cstdio>

#include "kel/sysinforecords.h"
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

// Writes the help text; the handler then ends with status 1.
int Help() {
   std::fputs(kHelp, stderr);
   return 1;
}

}  // namespace

int HalvexMain(int argc, char **argv) {
   if (argc < 2) {
      std::fputs("halvex: no option specified\n", stderr);
      return Help();
   }
   bool showVersion = false, showLevel = false;
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      if (c == 'v')
         showVersion = true;
      else if (c == 'l')
         showLevel = true;
      else
         return Help();
   }
   if (!showVersion && !showLevel) {
      std::fputs("halvex: Invalid arguments\n", stderr);
      return Help();
   }

   uint8_t rec[versioninfo::kSize];
   if (KEL_Get(KEL_NODE_system_version, nullptr, rec, sizeof rec) != KEL_STATUS_OK) return 1;
   std::string_view product = ReadText(rec, versioninfo::kProduct, versioninfo::kProductWidth);
   std::string_view ver = ReadText(rec, versioninfo::kVersion, versioninfo::kVersionWidth);
   std::string_view relLevel = ReadText(rec, versioninfo::kLevel, versioninfo::kLevelWidth);
   std::string_view update = ReadText(rec, versioninfo::kUpdate, versioninfo::kUpdateWidth);

   if (showVersion)
      std::printf("%.*s %.*s build-%.5d\n", int(product.size()), product.data(), int(ver.size()), ver.data(),
                  ReadI32(rec, versioninfo::kBuild));
   if (showLevel) {
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
