// Feeds arbitrary text to the JSON snapshot reader.  What it accepts must
// dump and build again to the same cache file.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "snapshot.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
   std::string json(reinterpret_cast<const char *>(data), size);
   std::string cache, error;
   if (!BuildCache(json, &cache, &error)) return 0;
   std::string dumped, again;
   if (!DumpCache(cache, &dumped, &error)) std::abort();
   if (!BuildCache(dumped, &again, &error) || again != cache) std::abort();
   return 0;
}
