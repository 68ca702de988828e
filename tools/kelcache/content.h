// The JSON form of data contents (boot option files).
#ifndef KELCACHE_CONTENT_H
#define KELCACHE_CONTENT_H

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "values.h"

namespace kelcache {

// A data node's content as stored: the status of KEL_GetDataLength and the
// payload (read status, chunk limit, content).
struct DataEntry {
   uint32_t status = 0;
   std::string data;
};
constexpr uint32_t kUnlimitedChunk = 0xffffffff;

DataEntry EncodeData(const Json &value, const std::string &path, bool allowUnlisted);
std::optional<Json> DumpData(uint32_t status, std::string_view data, bool asObject);

}  // namespace kelcache

#endif
