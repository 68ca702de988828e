// Snapshot values shared by both directions.
#include "values.h"

#include <cstdio>

#include "kel/kel.h"

namespace kelcache {

using kelplat::Key;

namespace {

struct StatusName {
   std::string_view name;
   uint32_t status;
};

// Names a snapshot may give instead of status numbers.
constexpr StatusName kStatusNames[] = {
   {"OK", KEL_STATUS_OK},
   {"FAILURE", KEL_STATUS_FAILURE},
   {"NOT_FOUND", KEL_STATUS_NOT_FOUND},
   {"BAD_PARAM", KEL_STATUS_BAD_PARAM},
   {"NOT_SUPPORTED", KEL_STATUS_NOT_SUPPORTED},
   {"READ_ONLY", KEL_STATUS_READ_ONLY},
   {"NO_MEMORY", KEL_STATUS_NO_MEMORY},
   {"NO_RESOURCES", KEL_STATUS_NO_RESOURCES},
   {"INVALID_NODE", KEL_STATUS_INVALID_NODE},
   {"BAD_KEY_COUNT", KEL_STATUS_BAD_KEY_COUNT},
   {"NOT_A_LIST", KEL_STATUS_NOT_A_LIST},
   {"NO_TREE", KEL_STATUS_NO_TREE},
   {"CACHE_OPEN", KEL_STATUS_CACHE_OPEN},
   {"CACHE_FORMAT", KEL_STATUS_CACHE_FORMAT},
   {"CACHE_VERSION", KEL_STATUS_CACHE_VERSION},
   {"CACHE_CORRUPT", KEL_STATUS_CACHE_CORRUPT},
   {"CACHE_TRUNCATED", KEL_STATUS_CACHE_TRUNCATED},
   {"BAD_TIME", KEL_STATUS_BAD_TIME},
   {"NO_CARTEL", KEL_STATUS_NO_CARTEL},
};

struct Integer {
   bool negative = false;
   uint64_t magnitude = 0;
};

int HexDigit(char c) {
   if (c >= '0' && c <= '9') return c - '0';
   if (c >= 'a' && c <= 'f') return c - 'a' + 10;
   if (c >= 'A' && c <= 'F') return c - 'A' + 10;
   return -1;
}

// "-"? then "0x" and hex digits, or decimal digits; nothing past 64 bits.
std::optional<Integer> ParseInteger(std::string_view text) {
   Integer n;
   if (!text.empty() && text[0] == '-') {
      n.negative = true;
      text.remove_prefix(1);
   }
   unsigned base = 10;
   if (text.size() > 2 && text[0] == '0' && (text[1] == 'x' || text[1] == 'X')) {
      base = 16;
      text.remove_prefix(2);
   }
   if (text.empty()) return std::nullopt;
   for (char c : text) {
      int d = HexDigit(c);
      if (d < 0 || unsigned(d) >= base) return std::nullopt;
      if (n.magnitude > (UINT64_MAX - unsigned(d)) / base) return std::nullopt;
      n.magnitude = n.magnitude * base + unsigned(d);
   }
   return n;
}

bool Fits(const Integer &n, IntType type) {
   switch (type) {
   case IntType::U8: return !n.negative && n.magnitude <= UINT8_MAX;
   case IntType::U16: return !n.negative && n.magnitude <= UINT16_MAX;
   case IntType::U32: return !n.negative && n.magnitude <= UINT32_MAX;
   case IntType::U64: return !n.negative;
   case IntType::I32: return n.negative ? n.magnitude <= 0x80000000u : n.magnitude <= UINT32_MAX;
   case IntType::Key64: return !n.negative || n.magnitude <= 0x8000000000000000u;
   }
   return false;
}

uint64_t Bits(const Integer &n) { return n.negative ? ~n.magnitude + 1 : n.magnitude; }

// Appends a member name to a JSON pointer, '~' and '/' escaped.
void AppendEscapedMember(std::string &out, std::string_view member) {
   for (size_t special; (special = member.find_first_of("~/")) != std::string_view::npos;) {
      out.append(member.substr(0, special));
      out += member[special] == '~' ? "~0" : "~1";
      member.remove_prefix(special + 1);
   }
   out.append(member);
}

std::string FormatKeyInt(uint64_t value) {
   // Values with the top bit set read better as negative numbers ("-1").
   if (value >> 63) return "-" + std::to_string(~value + 1);
   return std::to_string(value);
}

}  // namespace

void Fail(const std::string &path, std::string what) { throw SnapshotError{path, std::move(what)}; }

std::string MemberPath(const std::string &path, std::string_view member) {
   std::string out;
   out.reserve(path.size() + 1 + member.size());
   out += path;
   out += '/';
   AppendEscapedMember(out, member);
   return out;
}

std::string ElementPath(const std::string &path, size_t index) {
   return path + "/" + std::to_string(index);
}

const char *IntTypeName(IntType type) {
   switch (type) {
   case IntType::U8: return "u8";
   case IntType::U16: return "u16";
   case IntType::U32: return "u32";
   case IntType::U64: return "u64";
   case IntType::I32: return "i32";
   case IntType::Key64: return "64 bits";
   }
   return "?";
}

std::optional<uint64_t> ParseIntText(std::string_view text, IntType type) {
   std::optional<Integer> n = ParseInteger(text);
   if (!n || !Fits(*n, type)) return std::nullopt;
   return Bits(*n);
}

uint64_t ReadInt(const Json &value, IntType type, const std::string &path) {
   Integer n;
   if (value.is_number_unsigned()) {
      n.magnitude = value.get<uint64_t>();
   } else if (value.is_number_integer()) {
      int64_t v = value.get<int64_t>();
      n = {v < 0, v < 0 ? ~uint64_t(v) + 1 : uint64_t(v)};
   } else if (value.is_string()) {
      const std::string &text = value.get_ref<const std::string &>();
      std::optional<Integer> parsed = ParseInteger(text);
      if (!parsed) Fail(path, "\"" + text + "\" is not an integer");
      n = *parsed;
   } else {
      Fail(path, "expected an integer, not " + (value.is_number() ? value.dump() : value.type_name()));
   }
   // The value as given: the text of a string, else the number as written.
   if (!Fits(n, type))
      Fail(path, (value.is_string() ? value.get_ref<const std::string &>() : value.dump()) + " does not fit " +
                    IntTypeName(type));
   return Bits(n);
}

uint32_t ReadStatus(const Json &value, const std::string &path) {
   if (value.is_string()) {
      const std::string &text = value.get_ref<const std::string &>();
      for (const StatusName &s : kStatusNames)
         if (s.name == text) return s.status;
      if (!ParseInteger(text)) Fail(path, "\"" + text + "\" is not a status");
   }
   return uint32_t(ReadInt(value, IntType::U32, path));
}

std::string FormatStatus(uint32_t status) {
   char buf[16];
   std::snprintf(buf, sizeof buf, "0x%x", status);
   return buf;
}

const std::string &ReadText(const Json &value, const std::string &path) {
   if (!value.is_string()) Fail(path, "expected a text, not " + std::string(value.type_name()));
   return value.get_ref<const std::string &>();
}

bool ReadBool(const Json &value, const std::string &path) {
   if (!value.is_boolean()) Fail(path, "expected true or false, not " + std::string(value.type_name()));
   return value.get<bool>();
}

std::string ReadHex(const Json &value, const std::string &path) {
   const std::string &text = ReadText(value, path);
   std::string out;
   int high = -1;
   for (char c : text) {
      if (c == ' ' || c == '\t' || c == '\n' || c == ':') continue;
      int d = HexDigit(c);
      if (d < 0) Fail(path, std::string("bad hex digit '") + c + "'");
      if (high < 0) {
         high = d;
      } else {
         out.push_back(char(high << 4 | d));
         high = -1;
      }
   }
   if (high >= 0) Fail(path, "odd number of hex digits");
   return out;
}

std::string ToHex(std::string_view bytes) {
   static constexpr char kDigits[] = "0123456789abcdef";
   std::string out;
   out.reserve(bytes.size() * 2);
   for (unsigned char c : bytes) {
      out.push_back(kDigits[c >> 4]);
      out.push_back(kDigits[c & 15]);
   }
   return out;
}

bool ValidUtf8(std::string_view text) {
   // Well-formed UTF-8 only: no overlong forms, surrogates or values past U+10FFFF.
   size_t i = 0;
   while (i < text.size()) {
      auto c = uint8_t(text[i]);
      if (c < 0x80) {
         i++;
         continue;
      }
      size_t n;
      uint32_t cp;
      if (c >= 0xc2 && c <= 0xdf) {
         n = 1;
         cp = c & 0x1f;
      } else if (c >= 0xe0 && c <= 0xef) {
         n = 2;
         cp = c & 0x0f;
      } else if (c >= 0xf0 && c <= 0xf4) {
         n = 3;
         cp = c & 0x07;
      } else {
         return false;
      }
      if (text.size() - i <= n) return false;
      for (size_t k = 1; k <= n; k++) {
         auto b = uint8_t(text[i + k]);
         if ((b & 0xc0) != 0x80) return false;
         cp = cp << 6 | (b & 0x3f);
      }
      if ((n == 2 && cp < 0x800) || (n == 3 && (cp < 0x10000 || cp > 0x10ffff)) ||
          (cp >= 0xd800 && cp <= 0xdfff))
         return false;
      i += n + 1;
   }
   return true;
}

Key ParseKeyName(std::string_view name, int levelKind, const std::string &path) {
   auto intKey = [&](std::string_view text) {
      std::optional<uint64_t> v = ParseIntText(text);
      if (!v) Fail(path, "not an integer key");
      return Key{KEL_PARAM_INT, *v, {}};
   };
   if (name.starts_with("$int:")) return intKey(name.substr(5));
   if (name.starts_with("$text:")) return Key{KEL_PARAM_STRING, 0, std::string(name.substr(6))};
   if (name.starts_with("$kind:")) {
      std::string_view rest = name.substr(6);
      size_t colon = rest.find(':');
      std::optional<uint64_t> kind =
         colon == std::string_view::npos ? std::nullopt : ParseIntText(rest.substr(0, colon), IntType::U8);
      if (!kind) Fail(path, "expected $kind:K:N with K from 0 to 255");
      if (*kind == KEL_PARAM_STRING) Fail(path, "kind 1 is a text key: write $text:...");
      Key key = intKey(rest.substr(colon + 1));
      key.kind = uint32_t(*kind);
      return key;
   }
   if (name.starts_with("$")) Fail(path, "unknown control member");
   if (levelKind == KEL_PARAM_INT) return intKey(name);
   return Key{KEL_PARAM_STRING, 0, std::string(name)};
}

std::optional<std::string> KeyName(const Key &key, int levelKind) {
   if (key.kind == KEL_PARAM_INT) {
      std::string n = FormatKeyInt(key.value);
      return levelKind == KEL_PARAM_INT ? n : "$int:" + n;
   }
   if (key.kind == KEL_PARAM_STRING) {
      if (!ValidUtf8(key.text)) return std::nullopt;
      bool bare = levelKind == KEL_PARAM_STRING && !key.text.starts_with("$");
      return bare ? key.text : "$text:" + key.text;
   }
   return "$kind:" + std::to_string(key.kind) + ":" + FormatKeyInt(key.value);
}

}  // namespace kelcache
