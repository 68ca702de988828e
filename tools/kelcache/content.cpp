// The JSON form of data contents (boot option files).
#include "content.h"

#include <algorithm>

#include "kel/kel.h"

namespace kelcache {

namespace {

constexpr uint64_t kMaxContentSize = 64u << 20;
// Contents at least this long are dumped as a repeated pattern when they are one.
constexpr size_t kPatternMinSize = 64u << 10;
constexpr size_t kPatternMaxPeriod = 4096;

// The shortest period of a long content, when it has a short one.
std::optional<size_t> Period(std::string_view content) {
   if (content.size() < kPatternMinSize) return std::nullopt;
   for (size_t p = 1; p <= kPatternMaxPeriod; p++)
      if (content.compare(p, std::string_view::npos, content.substr(0, content.size() - p)) == 0) return p;
   return std::nullopt;
}

}  // namespace

DataEntry EncodeData(const Json &value, const std::string &path, bool allowUnlisted) {
   DataEntry out;
   std::string content;
   uint32_t readStatus = KEL_STATUS_OK, chunkLimit = kUnlimitedChunk;
   if (value.is_string()) {
      content = value.get<std::string>();
   } else if (value.is_object()) {
      const Json *pattern = nullptr, *length = nullptr;
      std::string patternPath, lengthPath, contentMember;
      for (auto it = value.begin(); it != value.end(); ++it) {
         const std::string &name = it.key();
         std::string p = MemberPath(path, name);
         if (name == "text" || name == "hex" || name == "pattern") {
            if (!contentMember.empty()) Fail(p, "give only one of text, hex and pattern");
            contentMember = name;
            if (name == "text") {
               content = ReadText(*it, p);
            } else if (name == "hex") {
               content = ReadHex(*it, p);
            } else {
               pattern = &*it;
               patternPath = p;
            }
         } else if (name == "length") {
            length = &*it;
            lengthPath = p;
         } else if (name == "chunkLimit") {
            chunkLimit = uint32_t(ReadInt(*it, IntType::U32, p));
         } else if (name == "status") {
            out.status = ReadStatus(*it, p);
         } else if (name == "readStatus") {
            readStatus = ReadStatus(*it, p);
         } else if (name == "$unlisted" && allowUnlisted) {
            continue;
         } else {
            Fail(p, "no such member");
         }
      }
      if (length != nullptr && pattern == nullptr) Fail(lengthPath, "a length goes with a pattern");
      if (pattern != nullptr) {
         if (length == nullptr) Fail(patternPath, "a pattern needs a length");
         const std::string &unit = ReadText(*pattern, patternPath);
         uint64_t n = ReadInt(*length, IntType::U32, lengthPath);
         if (n > kMaxContentSize) Fail(lengthPath, "contents are at most 64 MiB");
         if (unit.empty() && n > 0) Fail(patternPath, "an empty pattern cannot fill a length");
         content.reserve(n);
         while (content.size() < n) content.append(unit, 0, std::min<size_t>(unit.size(), n - content.size()));
      }
   } else {
      Fail(path, "expected a text or an object");
   }
   kelplat::AppendU32(out.data, readStatus);
   kelplat::AppendU32(out.data, chunkLimit);
   out.data += content;
   return out;
}

std::optional<Json> DumpData(uint32_t status, std::string_view data, bool asObject) {
   if (data.size() < 8) return std::nullopt;
   const auto *p = reinterpret_cast<const uint8_t *>(data.data());
   uint32_t readStatus = kelplat::LoadU32(p), chunkLimit = kelplat::LoadU32(p + 4);
   std::string_view content = data.substr(8);
   std::optional<size_t> period = Period(content);
   if (period && !ValidUtf8(content.substr(0, *period))) period.reset();
   bool text = ValidUtf8(content);

   Json j;
   if (!asObject && status == 0 && readStatus == 0 && chunkLimit == kUnlimitedChunk && text && !period) {
      j = std::string(content);
   } else {
      j = Json::object();
      if (status != 0) j["status"] = FormatStatus(status);
      if (readStatus != 0) j["readStatus"] = FormatStatus(readStatus);
      if (chunkLimit != kUnlimitedChunk) j["chunkLimit"] = chunkLimit;
      if (period) {
         j["pattern"] = std::string(content.substr(0, *period));
         j["length"] = content.size();
      } else if (!text) {
         j["hex"] = ToHex(content);
      } else if (!content.empty()) {
         j["text"] = std::string(content);
      }
   }
   try {
      DataEntry back = EncodeData(j, "", false);
      if (back.status == status && back.data == data) return j;
   } catch (const SnapshotError &) {
   }
   return std::nullopt;
}

}  // namespace kelcache
