// A set of byte strings that numbers them in the order they were added:
// member names of one object, encoded instance keys of one level.
#ifndef KELCACHE_BYTESET_H
#define KELCACHE_BYTESET_H

#include <cstdint>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "cachefile.h"

namespace kelcache {

// The strings lie back to back in one text, so that a set of a hundred
// thousand names makes a few allocations, not one per name.  A few strings
// are searched in order; past kLinear an open-addressing table of string
// numbers, tagged with each string's hash, finds them.
class ByteSet {
public:
   size_t size() const { return ends_.size(); }
   // Empties the set, keeping its storage.
   void Clear() {
      text_.clear();
      ends_.clear();
      table_.clear();
   }
   std::string_view at(uint32_t i) const {
      uint32_t start = i == 0 ? 0 : ends_[i - 1];
      return std::string_view(text_).substr(start, ends_[i] - start);
   }
   // The number of bytes, added now unless it was there already; second is
   // true when it was added now.
   std::pair<uint32_t, bool> Insert(std::string_view bytes) {
      uint32_t hash = Hash(bytes);
      if (std::optional<uint32_t> i = Find(bytes, hash)) return {*i, false};
      uint32_t n = uint32_t(ends_.size());
      text_.append(bytes);
      ends_.push_back(uint32_t(text_.size()));
      if (!table_.empty()) {
         if ((n + 1) * 4 > table_.size() * 3)
            Rehash(table_.size() * 2);
         else
            Place(hash, n);
      } else if (n + 1 > kLinear) {
         Rehash(64);
      }
      return {n, true};
   }
   std::optional<uint32_t> Find(std::string_view bytes) const { return Find(bytes, Hash(bytes)); }

private:
   static constexpr size_t kLinear = 8;

   static uint32_t Hash(std::string_view bytes) { return uint32_t(kelplat::KeyHash(bytes) >> 32); }
   std::optional<uint32_t> Find(std::string_view bytes, uint32_t hash) const {
      if (table_.empty()) {
         for (uint32_t i = 0; i < ends_.size(); i++)
            if (at(i) == bytes) return i;
         return std::nullopt;
      }
      const size_t mask = table_.size() - 1;
      for (size_t i = hash & mask; table_[i] != 0; i = (i + 1) & mask) {
         uint32_t n = uint32_t(table_[i]) - 1;
         if (uint32_t(table_[i] >> 32) == hash && at(n) == bytes) return n;
      }
      return std::nullopt;
   }
   void Place(uint32_t hash, uint32_t n) {
      const size_t mask = table_.size() - 1;
      size_t i = hash & mask;
      while (table_[i] != 0) i = (i + 1) & mask;
      table_[i] = uint64_t(hash) << 32 | (n + 1);
   }
   void Rehash(size_t slots) {
      table_.assign(slots, 0);
      for (uint32_t n = 0; n < ends_.size(); n++) Place(Hash(at(n)), n);
   }

   std::string text_;
   std::vector<uint32_t> ends_;   // where string i ends in text_
   std::vector<uint64_t> table_;  // (hash << 32) | (number + 1); 0: empty
};

}  // namespace kelcache

#endif
