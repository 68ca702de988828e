// Snapshot values shared by both directions: JSON paths, integers, statuses,
// hex bytes and instance key names.
#ifndef KELCACHE_VALUES_H
#define KELCACHE_VALUES_H

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include <nlohmann/json.hpp>

#include "cachefile.h"

namespace kelcache {

// Member order matters (it is the listing order), so objects keep it.
using Json = nlohmann::ordered_json;

// A mistake in a snapshot, at a JSON path ("/tree/world/1/info").
struct SnapshotError {
   std::string path;
   std::string what;
};
[[noreturn]] void Fail(const std::string &path, std::string what);

// JSON pointer of a member or an array element below path.
std::string MemberPath(const std::string &path, std::string_view member);
std::string ElementPath(const std::string &path, size_t index);

// Integer widths a snapshot value may be checked against.  I32 takes
// -2^31 .. 2^32-1, so that 0xffffffff can be written; Key64 takes
// -2^63 .. 2^64-1 (stored as two's complement).
enum class IntType { U8, U16, U32, U64, I32, Key64 };
const char *IntTypeName(IntType type);

// Parses "123", "-5" or "0x1f"; nothing when it is not such a text or does
// not fit Key64.  The result is the 64-bit two's complement.
std::optional<uint64_t> ParseIntText(std::string_view text, IntType type = IntType::Key64);
// A JSON number or integer text, range-checked; fails at path otherwise.
uint64_t ReadInt(const Json &value, IntType type, const std::string &path);
// A status: a number, an integer text or a name such as "NOT_FOUND".
uint32_t ReadStatus(const Json &value, const std::string &path);
std::string FormatStatus(uint32_t status);  // "0xbad0003"

const std::string &ReadText(const Json &value, const std::string &path);
bool ReadBool(const Json &value, const std::string &path);
// Hex digits, two a byte; blanks and ':' between them are ignored.
std::string ReadHex(const Json &value, const std::string &path);
std::string ToHex(std::string_view bytes);

bool ValidUtf8(std::string_view text);

// Instance keys as member names.  At an integer level a name is a decimal or
// 0x-hex integer, at a text level the text itself.  Explicit forms work at
// any level: "$int:N", "$text:S" and "$kind:K:N" (an entry of kind K).
kelplat::Key ParseKeyName(std::string_view name, int levelKind, const std::string &path);
// The member name for a key, or nothing when no name gives it back.
std::optional<std::string> KeyName(const kelplat::Key &key, int levelKind);

}  // namespace kelcache

#endif
