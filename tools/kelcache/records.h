// Record field tables, and the JSON form of records.
#ifndef KELCACHE_RECORDS_H
#define KELCACHE_RECORDS_H

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "nodetable.h"
#include "values.h"

namespace kelcache {

enum class FieldType : uint8_t { U8, U16, U32, U64, I32, Text, Hex, Mac };

struct Field {
   std::string_view name;
   uint32_t offset;
   FieldType type;
   uint32_t width = 0;  // Text and Hex only; the others have their type's size
};

enum RecordFlags : uint32_t {
   kWholeText = 1,   // one text fills the buffer; a plain JSON string may stand for the record
   kAcpiBuffer = 2,  // "length" defaults to the size of "data" (or "text") when one is given
   kInodeStats = 4,  // "unlinked": true is short for "linkState": -4
};

struct RecordDef {
   KEL_Node node;
   std::span<const Field> fields;
   uint32_t flags = 0;
};

// The field table of a readable node, or null.
const RecordDef *FindRecord(KEL_Node node);

// A record as stored: read status, bytes, and the answer to KEL_Set when given.
struct RecordEntry {
   uint32_t status = 0;
   std::string data;
   std::optional<uint32_t> setStatus;
};

// The record at path.  "$unlisted" is skipped when allowUnlisted.
RecordEntry EncodeRecord(const kelplat::NodeInfo &node, const Json &value, const std::string &path,
                         bool allowUnlisted);
// The JSON that encodes back to exactly this entry, or nothing when there is
// none.  asObject: never a plain string.
std::optional<Json> DumpRecord(const kelplat::NodeInfo &node, const RecordEntry &entry, bool asObject);

}  // namespace kelcache

#endif
