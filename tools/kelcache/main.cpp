// kelcache: turns a JSON snapshot of a KEL tree into a cache file, and a
// cache file back into JSON.
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include "kel/kel.h"
#include "nodetable.h"
#include "snapshot.h"

namespace {

constexpr char kUsage[] =
   "usage: kelcache build SNAPSHOT.json -o FILE   make a cache file from a snapshot\n"
   "       kelcache dump FILE                     write a cache file as a snapshot\n"
   "       kelcache --tool-build-date             the build date the tools carry\n"
   "       kelcache --tool-signature              the tree signature the tools expect\n"
   "       kelcache --help\n"
   "The snapshot format is described in docs/snapshot-format.md.\n";

int Usage(const std::string &problem) {
   std::cerr << "kelcache: " << problem << "\n" << kUsage;
   return 2;
}

bool ReadFile(const std::string &path, std::string *bytes) {
   std::ifstream in(path, std::ios::binary);
   if (!in) return false;
   std::ostringstream s;
   s << in.rdbuf();
   *bytes = std::move(s).str();
   return !in.bad();
}

// Writes beside the target and renames, so that a failed run leaves no half file.
bool WriteFile(const std::string &path, const std::string &bytes) {
   std::string tmp = path + ".tmp";
   {
      std::ofstream out(tmp, std::ios::binary | std::ios::trunc);
      if (!out || !out.write(bytes.data(), std::streamsize(bytes.size())) || !out.flush()) {
         std::remove(tmp.c_str());
         return false;
      }
   }
   if (std::rename(tmp.c_str(), path.c_str()) != 0) {
      int saved = errno;
      std::remove(tmp.c_str());
      errno = saved;
      return false;
   }
   return true;
}

int Build(const std::vector<std::string> &args) {
   std::string input, output;
   bool haveOutput = false;
   for (size_t i = 0; i < args.size(); i++) {
      if (args[i] == "-o") {
         if (i + 1 == args.size()) return Usage("-o needs a file name");
         output = args[++i];
         haveOutput = true;
      } else if (input.empty() && !args[i].empty() && args[i][0] != '-') {
         input = args[i];
      } else {
         return Usage("unexpected argument '" + args[i] + "'");
      }
   }
   if (input.empty() || !haveOutput) return Usage("build needs a snapshot and -o FILE");

   std::string json, bytes, error;
   if (!ReadFile(input, &json)) {
      std::cerr << "kelcache: " << input << ": " << std::strerror(errno) << "\n";
      return 1;
   }
   if (!BuildCache(json, &bytes, &error)) {
      std::cerr << "kelcache: " << error << "\n";
      return 1;
   }
   if (!WriteFile(output, bytes)) {
      std::cerr << "kelcache: " << output << ": " << std::strerror(errno) << "\n";
      return 1;
   }
   return 0;
}

int Dump(const std::vector<std::string> &args) {
   if (args.size() != 1) return Usage("dump needs exactly one cache file");
   std::string bytes, json, error;
   if (!ReadFile(args[0], &bytes)) {
      std::cerr << "kelcache: " << args[0] << ": " << ORX_ReturnStatusToString(KEL_STATUS_CACHE_OPEN) << " ("
                << std::strerror(errno) << ")\n";
      return 1;
   }
   if (!DumpCache(bytes, &json, &error)) {
      std::cerr << "kelcache: " << args[0] << ": " << error << "\n";
      return 1;
   }
   std::cout << json << std::flush;
   return std::cout ? 0 : 1;
}

}  // namespace

int main(int argc, char **argv) {
   std::vector<std::string> args(argv + 1, argv + argc);
   if (args.empty()) return Usage("no command given");
   std::string command = args[0];
   args.erase(args.begin());
   if (command == "--help" || command == "-h" || command == "help") {
      std::cout << kUsage;
      return 0;
   }
   if (command == "--tool-build-date" && args.empty()) {
      std::cout << kelplat::ToolBuildDate() << "\n";
      return 0;
   }
   if (command == "--tool-signature" && args.empty()) {
      char hex[3];
      for (uint8_t b : kelplat::ToolSignature()) {
         std::snprintf(hex, sizeof hex, "%02x", b);
         std::cout << hex;
      }
      std::cout << "\n";
      return 0;
   }
   if (command == "build") return Build(args);
   if (command == "dump") return Dump(args);
   return Usage("unknown command '" + command + "'");
}
