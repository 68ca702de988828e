// Cache files: a saved KEL tree, mmap'd and indexed.
//
// Layout (all integers little-endian):
//
//   0   8  magic "ORXKELC1"
//   8   4  format version (3)
//  12   4  flags (0)
//  16  16  tree signature
//  32  24  kernel build date, NUL-padded (at most 20 characters)
//  56   4  entry count N
//  60   4  slot table offset (96)
//  64   8  total file size (at most 4 GiB - 1: offsets are 32 bits)
//  72   8  checksum of bytes 96 .. total size
//  80   4  slot count S (a power of two, more than N)
//  84   4  offset of the first entry byte (96 + 16 * S)
//  88   4  reserved (0)
//  92   4  check of bytes 56 .. 92, the fields that place everything else
//  96      slot table: S slots of 16 bytes, a hash table with linear probing:
//            0 hash tag (high 32 bits of the whole key's 64-bit hash),
//            4 entry offset, 8 key length (0: an empty slot), 12 data length
//          then, per entry in slot order, its status (4 bytes), its key
//          bytes and its data bytes, so that a lookup touches the slot and
//          one place in the file.
//
// A lookup starts at slot (home hash & (S - 1)), the home hash being that of
// the instance keys alone, and walks on to the first empty slot: the
// entries of one instance share a first slot and so lie side by side, in
// the slot table and in the file; four slots fill a cache line.  Opening
// checks the header and that the slot table and entry area lie within the
// file (no pass over the data); every offset and length a slot holds is
// checked when the slot is used.  A full verification (checksum, every slot
// in bounds, every key found where its hash leads) is kept for
// `kelcache verify` and `kelcache dump`.
//
// A key is: operation (1 byte), node number (2 bytes), then each instance
// key as kind (1 byte) and either a 64-bit value (kind other than 1) or a
// 32-bit length and the text bytes (kind 1).
//
// Operations and their data:
//   'G' read:     the stored record (shorter than asked: zero-filled; longer: cut)
//   'L' listing:  a 32-bit count, then the keys in listing order
//   'S' set:      no data; the status is what KEL_Set answers
//   'D' data:     32-bit read status, 32-bit chunk limit (most bytes one
//                 KEL_SetData returns; 0xffffffff for no limit), the content;
//                 the entry's status is what KEL_GetDataLength answers
//   'M' meta:     node 0, one text key naming the setting; data is its text
// A non-zero status makes the call fail with it.
#ifndef PLATFORM_CACHEFILE_H
#define PLATFORM_CACHEFILE_H

#include <cstdint>
#include <algorithm>
#include <cstring>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "kel/kel.h"

namespace kelplat {

enum class Op : uint8_t { Get = 'G', List = 'L', Set = 'S', Data = 'D', Meta = 'M' };

constexpr char kCacheMagic[8] = {'O', 'R', 'X', 'K', 'E', 'L', 'C', '1'};
constexpr uint32_t kCacheVersion = 3;
constexpr size_t kHeaderSize = 96;
constexpr size_t kSlotSize = 16;
// An entry starts with its status.
constexpr size_t kEntryHeadSize = 4;
// The header fields that the header check covers.
constexpr size_t kHeaderCheckStart = 56, kHeaderCheckOffset = 92;
constexpr size_t kBuildDateMax = 20;
// Every byte of a file lies at an offset that 32 bits can name.
constexpr uint64_t kMaxCacheFileSize = 0xffffffff;

inline uint32_t LoadU32(const uint8_t *p) {
   return uint32_t(p[0]) | uint32_t(p[1]) << 8 | uint32_t(p[2]) << 16 | uint32_t(p[3]) << 24;
}
inline uint64_t LoadU64(const uint8_t *p) { return LoadU32(p) | uint64_t(LoadU32(p + 4)) << 32; }
inline void StoreU32(uint8_t *p, uint32_t v) {
   for (int i = 0; i < 4; i++) p[i] = uint8_t(v >> (8 * i));
}
inline void StoreU64(uint8_t *p, uint64_t v) {
   StoreU32(p, uint32_t(v));
   StoreU32(p + 4, uint32_t(v >> 32));
}
void AppendU32(std::string &out, uint32_t v);
void AppendU64(std::string &out, uint64_t v);

// One instance key as stored: kind 1 carries text, any other kind a value.
struct Key {
   uint32_t kind = KEL_PARAM_INT;
   uint64_t value = 0;
   std::string text;
   bool operator==(const Key &) const = default;
};

void AppendKey(std::string &out, const Key &key);
// Appends the lookup key of a parameter list to out (cleared first), reusing
// its storage; false when an entry cannot be encoded.
bool AppendParamLookup(std::string &out, Op op, KEL_Node node, const KEL_ParamList *keys);
std::string EncodeLookup(Op op, KEL_Node node, std::span<const Key> keys);
// The lookup key for a parameter list, or nothing when an entry cannot be encoded.
std::optional<std::string> EncodeParamLookup(Op op, KEL_Node node, const KEL_ParamList *keys);
// Decodes one key at *pos of bytes; false when it runs past the end.
bool DecodeKey(std::string_view bytes, size_t *pos, Key *key);
// Decodes a listing payload; false when malformed.
bool DecodeList(std::string_view bytes, std::vector<Key> *keys);
std::string EncodeList(std::span<const Key> keys);

uint64_t Checksum(const uint8_t *p, size_t n);
// The hash of a whole lookup key: its high 32 bits are a slot's tag.
inline uint64_t KeyHash(std::string_view key) {
   return Checksum(reinterpret_cast<const uint8_t *>(key.data()), key.size());
}
// Instances whose last key is an integer are placed in blocks: the
// instances whose last keys differ only in their low four bits (and share
// any keys before) take one run of kHomeBlock * kHomeSpacing slots, chosen
// by hashing the rest, each instance kHomeSpacing slots after the one
// before.  Worlds, cartels and their children are listed in ID order, so a
// walk over them reads one stretch of the table and of the file for sixteen
// instances, not sixteen random places.
constexpr uint64_t kHomeBlock = 16, kHomeSpacing = 16;

// The hash that picks a key's first slot: that of its instance keys alone
// (after the operation and node), so that every read and listing of one
// instance (a world's name, record and statistics, the cartel of the same
// number) lies in neighbouring slots, and their bytes side by side.
inline uint64_t HomeHash(std::string_view key) {
   const auto *p = reinterpret_cast<const uint8_t *>(key.data());
   const size_t n = key.size(), start = std::min<size_t>(n, 3);
   auto whole = [&] { return Checksum(p + start, n - start); };
   // Find the last instance key; a key that does not parse is hashed whole.
   size_t at = start, last = n;
   while (at < n) {
      last = at;
      size_t rest = n - at;
      if (p[at] == KEL_PARAM_STRING) {
         if (rest < 5 || rest - 5 < LoadU32(p + at + 1)) return whole();
         at += 5 + LoadU32(p + at + 1);
      } else {
         if (rest < 9) return whole();
         at += 9;
      }
   }
   if (last == n || p[last] == KEL_PARAM_STRING) return whole();
   uint64_t value = LoadU64(p + last + 1);
   uint64_t h = Checksum(p + start, last - start) ^ ((value / kHomeBlock) * 0x9e3779b97f4a7c15ULL);
   h = (h ^ (h >> 32)) * 0xd6e8feb86659fd93ULL;
   h ^= h >> 32;
   return h + (value % kHomeBlock) * kHomeSpacing;
}
// The check stored at kHeaderCheckOffset of a header.
uint32_t HeaderCheck(const uint8_t *header);

// Flags of CacheReader::Open and Attach beyond KEL_CACHE_NO_CHECKSUM.
// Without kCacheQuickOpen the whole file is verified; with it only what
// opening needs, in time independent of the file's size.
constexpr int kCacheQuickOpen = 0x100;

// A hash table of numbers (1 or more) filed under 32-bit tags, to find a
// repeated key without keeping a copy of it: the caller compares the
// candidates a tag leads to.  Linear probing, at most three quarters full.
class TagIndex {
public:
   // The first number filed under tag for which same(number) holds, or 0.
   template <class Same>
   uint32_t Find(uint32_t tag, Same same) const {
      if (slots_.empty()) return 0;
      const size_t mask = slots_.size() - 1;
      for (size_t i = Home(tag, mask); slots_[i] != 0; i = (i + 1) & mask)
         if (uint32_t(slots_[i] >> 32) == tag && same(uint32_t(slots_[i]))) return uint32_t(slots_[i]);
      return 0;
   }
   void Insert(uint32_t tag, uint32_t number);

private:
   // A tag's first slot: its bits spread over the table.
   static size_t Home(uint32_t tag, size_t mask) { return size_t(uint32_t(tag * 0x9e3779b1u)) & mask; }
   void Grow();
   std::vector<uint64_t> slots_;  // (tag << 32) | number, 0 for an empty slot
   size_t used_ = 0;
};

// Builds a cache file.  Entries are kept as the file stores them (status,
// key, data) back to back in large blocks, with a small fixed-size record
// each; a key added twice is found through a TagIndex of entry numbers
// tagged with the key's hash, so no key is copied twice.  The
// file is made only at the end: WriteTo streams it to a file through a
// modest buffer, so that its bytes are never all in memory at once; Finish
// makes it as one string.
class CacheWriter {
public:
   CacheWriter() = default;
   CacheWriter(const CacheWriter &) = delete;
   CacheWriter &operator=(const CacheWriter &) = delete;

   // False when the same lookup key was added before.
   bool Add(std::string_view lookup, uint32_t status, std::string_view data);
   // The file bytes; the build date is cut to kBuildDateMax characters.
   std::string Finish(std::span<const uint8_t, 16> signature, std::string_view buildDate) const;
   // Writes the same bytes to fd, a new regular file open for reading and
   // writing: the entries through a modest buffer, then the slot table, then
   // the header (which holds the checksum of the rest, read back from the
   // file).  False with errno set when a write fails or the file would
   // outgrow 32-bit offsets.
   bool WriteTo(int fd, std::span<const uint8_t, 16> signature, std::string_view buildDate) const;
   size_t size() const { return count_; }

private:
   // One entry: where its bytes lie, their lengths, and its hashes (the tag
   // a slot stores, and the hash that picks its first slot).
   struct Entry {
      const uint8_t *bytes;  // status, key, data
      uint32_t keyLen, dataLen;
      uint32_t tag, home;
   };
   static constexpr size_t kEntryBlockBits = 16;
   static constexpr size_t kEntryBlock = size_t(1) << kEntryBlockBits;
   static constexpr size_t kByteBlock = size_t(1) << 20;

   const Entry &At(size_t i) const { return entryBlocks_[i >> kEntryBlockBits][i & (kEntryBlock - 1)]; }
   uint8_t *Allocate(size_t n);
   template <class Sink>
   void Stream(Sink &sink, std::span<const uint8_t, 16> signature, std::string_view buildDate) const;

   // Entries in blocks of kEntryBlock, so that growing never copies them.
   std::vector<std::unique_ptr<Entry[]>> entryBlocks_;
   size_t count_ = 0;
   // The entry bytes: blocks of kByteBlock, a larger entry in a block of its own.
   std::vector<std::unique_ptr<uint8_t[]>> byteBlocks_;
   uint8_t *free_ = nullptr;
   size_t freeLen_ = 0;
   // Entry number + 1 by the tag of its key.
   TagIndex index_;
   uint64_t totalBytes_ = 0;  // of all entries, as the file stores them
};

// One looked-up entry of an open cache.
struct CacheHit {
   uint32_t status;
   std::string_view data;
};

// Reads a cache file (mapped, or bytes owned elsewhere).  Every offset is
// checked before use; a bad one makes the lookup fail with
// KEL_STATUS_CACHE_CORRUPT.
class CacheReader {
public:
   CacheReader() = default;
   CacheReader(const CacheReader &) = delete;
   CacheReader &operator=(const CacheReader &) = delete;
   ~CacheReader();

   // Maps a regular file, or reads a pipe whole into memory.
   KEL_Status Open(const char *path, int flags);
   // Checks the bytes as Open does; the caller keeps them alive.
   KEL_Status Attach(std::string_view bytes, int flags);
   // The full verification of the attached bytes: checksum (unless
   // KEL_CACHE_NO_CHECKSUM), every slot in bounds, every key found where
   // its hash leads, exactly N entries.
   KEL_Status Verify(int flags) const;

   // Status NOT_FOUND when absent, CACHE_CORRUPT when the index is damaged.
   KEL_Status Lookup(std::string_view key, CacheHit *hit) const;

   std::span<const uint8_t, 16> Signature() const;
   std::string BuildDate() const;
   uint32_t EntryCount() const { return count_; }
   uint32_t SlotCount() const { return slots_; }
   // Entry i in key order: its key, status and data; false when damaged
   // (also when the slot table holds fewer than N entries).
   bool EntryAt(uint32_t i, std::string_view *key, CacheHit *hit) const;
   // Slot i: false when empty or damaged.
   bool SlotAt(uint32_t i, std::string_view *key, CacheHit *hit, uint32_t *tag) const;
   std::string_view Bytes() const { return bytes_; }

private:
   void Close();
   KEL_Status ReadPipe(int fd);
   std::string_view bytes_;
   void *map_ = nullptr;
   size_t mapSize_ = 0;
   char *owned_ = nullptr;  // the bytes read from a pipe (malloc)
   uint32_t count_ = 0;
   uint32_t slots_ = 0;
   // The occupied slots in key order, built at the first EntryAt.
   mutable std::vector<uint32_t> order_;
   mutable bool ordered_ = false;
};

}  // namespace kelplat

#endif
