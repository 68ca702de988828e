// Feeds arbitrary bytes to the cache reader as a cache file: every entry,
// listing and lookup must stay within the bytes, whatever they hold.
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "cachefile.h"

using namespace kelplat;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
   std::string_view bytes(reinterpret_cast<const char *>(data), size);
   // Opened as the tool opens a cache (header and table bounds only), every
   // lookup of every stored key stays within the bytes.
   CacheReader quick;
   if (quick.Attach(bytes, kCacheQuickOpen) == KEL_STATUS_OK) {
      for (uint32_t i = 0; i < quick.SlotCount() && i < 4096; i++) {
         std::string_view key;
         CacheHit hit;
         uint32_t tag;
         if (!quick.SlotAt(i, &key, &hit, &tag)) continue;
         CacheHit again;
         quick.Lookup(key, &again);
      }
      quick.Verify(KEL_CACHE_NO_CHECKSUM);
   }
   CacheReader reader;
   // The checksum would turn away nearly every input before the slots are read.
   if (reader.Attach(bytes, KEL_CACHE_NO_CHECKSUM) != KEL_STATUS_OK) return 0;
   reader.BuildDate();
   std::vector<Key> keys;
   for (uint32_t i = 0; i < reader.EntryCount() && i < 4096; i++) {
      std::string_view key;
      CacheHit hit;
      if (!reader.EntryAt(i, &key, &hit)) continue;
      DecodeList(hit.data, &keys);
      size_t pos = 3;
      Key k;
      while (pos < key.size() && DecodeKey(key, &pos, &k)) {
      }
      CacheHit again;
      reader.Lookup(key, &again);
      reader.Lookup(std::string(key) + "x", &again);
   }
   return 0;
}
