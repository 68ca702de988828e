// Record field tables, and the JSON form of records.
#ifndef KELCACHE_RECORDS_H
#define KELCACHE_RECORDS_H

#include <algorithm>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

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
   std::string_view data;
   std::optional<uint32_t> setStatus;
};

// Lays records out in one buffer kept from record to record, so that a
// record costs the bytes its fields fill, not its node's full size (a file
// descriptor's record is 2 KiB, mostly zeros that are trimmed away), and
// finds the JSON form of stored records with the same buffers.
class RecordCodec {
public:
   // The record at path.  "$unlisted" is skipped when allowUnlisted.  Its
   // data views this codec's buffer until the next call.
   RecordEntry Encode(const kelplat::NodeInfo &node, const Json &value, const std::string &path,
                      bool allowUnlisted);
   // The JSON that encodes back to exactly this entry, or nothing when there
   // is none.  asObject: never a plain string.
   std::optional<Json> Dump(const kelplat::NodeInfo &node, const RecordEntry &entry, bool asObject);

private:
   // Room for n bytes, all zero.
   void Clear(size_t n);
   void Mark(size_t end) { dirty_ = std::max(dirty_, end); }
   void PutUint(size_t offset, size_t size, uint64_t v);
   void PutBytes(const Field &f, std::string_view bytes, const std::string &path);
   void PutField(const Field &f, const Json &value, const std::string &path);
   // The first n bytes without the zeros that end them.
   std::string_view Trimmed(size_t n) const;
   bool EncodesBack(const kelplat::NodeInfo &node, const Json &value, const RecordEntry &entry);

   // A field given in the record's object.
   struct Given {
      const Field *field;
      const Json *value;
      std::string path;
   };
   std::vector<Given> given_;
   std::string buf_;
   size_t dirty_ = 0;  // every byte from here on is zero
   std::string stored_;     // a stored record, zero-filled to its node's size
   size_t storedUsed_ = 0;  // every byte of stored_ from here on is zero
};

}  // namespace kelcache

#endif
