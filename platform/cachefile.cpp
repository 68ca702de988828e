// Cache file encoding, writing and checked reading.
#include "cachefile.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>

#include "internal.h"

namespace kelplat {

void AppendU32(std::string &out, uint32_t v) {
   uint8_t b[4];
   StoreU32(b, v);
   out.append(reinterpret_cast<const char *>(b), 4);
}

void AppendU64(std::string &out, uint64_t v) {
   uint8_t b[8];
   StoreU64(b, v);
   out.append(reinterpret_cast<const char *>(b), 8);
}

void AppendKey(std::string &out, const Key &key) {
   out.push_back(char(uint8_t(key.kind)));
   if (key.kind == KEL_PARAM_STRING) {
      AppendU32(out, uint32_t(key.text.size()));
      out += key.text;
   } else {
      AppendU64(out, key.value);
   }
}

static std::string LookupPrefix(Op op, KEL_Node node) {
   std::string out;
   out.push_back(char(op));
   out.push_back(char(node & 0xff));
   out.push_back(char(node >> 8));
   return out;
}

std::string EncodeLookup(Op op, KEL_Node node, std::span<const Key> keys) {
   std::string out = LookupPrefix(op, node);
   for (const Key &k : keys) AppendKey(out, k);
   return out;
}

std::optional<std::string> EncodeParamLookup(Op op, KEL_Node node, const KEL_ParamList *keys) {
   std::string out = LookupPrefix(op, node);
   if (keys == nullptr) return out;
   for (const KEL_Param &p : keys->entries) {
      if (p.kind > 0xff) return std::nullopt;
      Key k;
      k.kind = p.kind;
      if (p.kind == KEL_PARAM_STRING) {
         if (p.text == nullptr) return std::nullopt;
         k.text = p.text;
      } else {
         k.value = p.value;
      }
      AppendKey(out, k);
   }
   return out;
}

bool DecodeKey(std::string_view bytes, size_t *pos, Key *key) {
   const auto *p = reinterpret_cast<const uint8_t *>(bytes.data());
   size_t at = *pos;
   if (at >= bytes.size()) return false;
   key->kind = p[at++];
   key->text.clear();
   key->value = 0;
   if (key->kind == KEL_PARAM_STRING) {
      if (bytes.size() - at < 4) return false;
      uint32_t len = LoadU32(p + at);
      at += 4;
      if (bytes.size() - at < len) return false;
      key->text.assign(bytes.data() + at, len);
      at += len;
   } else {
      if (bytes.size() - at < 8) return false;
      key->value = LoadU64(p + at);
      at += 8;
   }
   *pos = at;
   return true;
}

bool DecodeList(std::string_view bytes, std::vector<Key> *keys) {
   if (bytes.size() < 4) return false;
   uint32_t count = LoadU32(reinterpret_cast<const uint8_t *>(bytes.data()));
   // Each key takes at least 5 bytes (an empty text), so a count beyond that
   // is damage; it also bounds what is reserved below.
   if (count > (bytes.size() - 4) / 5) return false;
   keys->clear();
   keys->reserve(count);
   size_t pos = 4;
   for (uint32_t i = 0; i < count; i++) {
      Key k;
      if (!DecodeKey(bytes, &pos, &k)) return false;
      keys->push_back(std::move(k));
   }
   return pos == bytes.size();
}

std::string EncodeList(std::span<const Key> keys) {
   std::string out;
   AppendU32(out, uint32_t(keys.size()));
   for (const Key &k : keys) AppendKey(out, k);
   return out;
}

uint64_t Checksum(const uint8_t *p, size_t n) {
   uint64_t h = 0x9e3779b97f4a7c15ULL ^ n;
   while (n >= 8) {
      h = (h ^ LoadU64(p)) * 0xff51afd7ed558ccdULL;
      h ^= h >> 29;
      p += 8;
      n -= 8;
   }
   for (size_t i = 0; i < n; i++) h = (h ^ p[i]) * 0x100000001b3ULL;
   h ^= h >> 33;
   return h * 0xc4ceb9fe1a85ec53ULL;
}

static bool KeyLess(std::string_view a, std::string_view b) {
   size_t n = std::min(a.size(), b.size());
   int c = n ? std::memcmp(a.data(), b.data(), n) : 0;
   return c < 0 || (c == 0 && a.size() < b.size());
}

bool CacheWriter::Add(std::string lookup, uint32_t status, std::string data) {
   if (!keys_.insert(lookup).second) return false;
   entries_.push_back({std::move(lookup), status, std::move(data)});
   return true;
}

std::string CacheWriter::Finish(std::span<const uint8_t, 16> signature,
                                std::string_view buildDate) const {
   std::vector<const Entry *> sorted;
   for (const Entry &e : entries_) sorted.push_back(&e);
   std::sort(sorted.begin(), sorted.end(),
             [](const Entry *a, const Entry *b) { return KeyLess(a->key, b->key); });

   std::string out(kHeaderSize + sorted.size() * kIndexEntrySize, '\0');
   auto *head = reinterpret_cast<uint8_t *>(out.data());
   std::vector<uint32_t> keyOff, dataOff;
   for (const Entry *e : sorted) {
      keyOff.push_back(uint32_t(out.size()));
      out += e->key;
   }
   for (const Entry *e : sorted) {
      dataOff.push_back(uint32_t(out.size()));
      out += e->data;
   }
   head = reinterpret_cast<uint8_t *>(out.data());
   std::memcpy(head, kCacheMagic, 8);
   StoreU32(head + 8, kCacheVersion);
   StoreU32(head + 12, 0);
   std::memcpy(head + 16, signature.data(), 16);
   std::string_view date = buildDate.substr(0, kBuildDateMax);
   std::memcpy(head + 32, date.data(), date.size());
   StoreU32(head + 56, uint32_t(sorted.size()));
   StoreU32(head + 60, uint32_t(kHeaderSize));
   StoreU64(head + 64, out.size());
   for (size_t i = 0; i < sorted.size(); i++) {
      uint8_t *ix = head + kHeaderSize + i * kIndexEntrySize;
      StoreU32(ix, keyOff[i]);
      StoreU32(ix + 4, uint32_t(sorted[i]->key.size()));
      StoreU32(ix + 8, sorted[i]->status);
      StoreU32(ix + 12, dataOff[i]);
      StoreU32(ix + 16, uint32_t(sorted[i]->data.size()));
   }
   StoreU64(head + 72, Checksum(head + kHeaderSize, out.size() - kHeaderSize));
   return out;
}

CacheReader::~CacheReader() { Close(); }

void CacheReader::Close() {
   if (map_ != nullptr) munmap(map_, mapSize_);
   map_ = nullptr;
   mapSize_ = 0;
   bytes_ = {};
   count_ = 0;
}

// The checks of the fixed header against the size of the bytes it heads
// (at least kHeaderSize): format, version, the size the header claims and
// where the index lies.
static KEL_Status CheckHeader(const uint8_t *p, uint64_t size) {
   if (std::memcmp(p, kCacheMagic, 7) != 0) return KEL_STATUS_CACHE_FORMAT;
   if (p[7] != uint8_t(kCacheMagic[7]) || LoadU32(p + 8) != kCacheVersion) return KEL_STATUS_CACHE_VERSION;
   uint64_t total = LoadU64(p + 64);
   // Offsets are 32 bits: a larger file is damage, refused before any byte
   // past the header is read (its checksum alone would take minutes).
   if (total > kMaxCacheFileSize) return KEL_STATUS_CACHE_CORRUPT;
   if (total > size) return KEL_STATUS_CACHE_TRUNCATED;
   if (total != size) return KEL_STATUS_CACHE_CORRUPT;
   uint32_t count = LoadU32(p + 56);
   uint32_t index = LoadU32(p + 60);
   if (index < kHeaderSize || index > total || (total - index) / kIndexEntrySize < count)
      return KEL_STATUS_CACHE_CORRUPT;
   return KEL_STATUS_OK;
}

KEL_Status CacheReader::Open(const char *path, int flags) {
   Close();
   // Opening never waits (a FIFO without a writer would block a plain
   // open); what is not a regular file is refused right after.
   int fd = open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY);
   if (fd < 0) return KEL_STATUS_CACHE_OPEN;
   struct stat st;
   if (fstat(fd, &st) != 0 || !S_ISREG(st.st_mode)) {
      close(fd);
      return KEL_STATUS_CACHE_OPEN;
   }
   uint64_t fileSize = uint64_t(st.st_size);
   if (fileSize < kHeaderSize) {
      close(fd);
      return fileSize == 0 ? KEL_STATUS_CACHE_FORMAT : KEL_STATUS_CACHE_TRUNCATED;
   }
   // The header decides first, so that a file larger than the format allows
   // (or than a 32-bit size_t holds) is never mapped.
   uint8_t header[kHeaderSize];
   if (pread(fd, header, kHeaderSize, 0) != ssize_t(kHeaderSize)) {
      close(fd);
      return KEL_STATUS_CACHE_OPEN;
   }
   KEL_Status status = CheckHeader(header, fileSize);
   if (status != KEL_STATUS_OK) {
      close(fd);
      return status;
   }
   void *map = mmap(nullptr, size_t(fileSize), PROT_READ, MAP_PRIVATE, fd, 0);
   close(fd);
   if (map == MAP_FAILED) return KEL_STATUS_CACHE_OPEN;
   map_ = map;
   mapSize_ = size_t(fileSize);
   status = Attach({static_cast<const char *>(map), mapSize_}, flags);
   if (status != KEL_STATUS_OK) Close();
   return status;
}

KEL_Status CacheReader::Attach(std::string_view bytes, int flags) {
   const auto *p = reinterpret_cast<const uint8_t *>(bytes.data());
   if (bytes.size() < kHeaderSize) return KEL_STATUS_CACHE_TRUNCATED;
   KEL_Status status = CheckHeader(p, bytes.size());
   if (status != KEL_STATUS_OK) return status;
   if (!(flags & KEL_CACHE_NO_CHECKSUM) &&
       Checksum(p + kHeaderSize, bytes.size() - kHeaderSize) != LoadU64(p + 72))
      return KEL_STATUS_CACHE_CORRUPT;
   bytes_ = bytes;
   count_ = LoadU32(p + 56);
   indexOffset_ = LoadU32(p + 60);
   return KEL_STATUS_OK;
}

bool CacheReader::EntryAt(uint32_t i, std::string_view *key, CacheHit *hit) const {
   if (i >= count_) return false;
   const auto *ix = reinterpret_cast<const uint8_t *>(bytes_.data()) + indexOffset_ +
                    size_t(i) * kIndexEntrySize;
   uint32_t keyOff = LoadU32(ix), keyLen = LoadU32(ix + 4);
   uint32_t dataOff = LoadU32(ix + 12), dataLen = LoadU32(ix + 16);
   if (keyOff > bytes_.size() || bytes_.size() - keyOff < keyLen) return false;
   if (dataOff > bytes_.size() || bytes_.size() - dataOff < dataLen) return false;
   *key = bytes_.substr(keyOff, keyLen);
   hit->status = LoadU32(ix + 8);
   hit->data = bytes_.substr(dataOff, dataLen);
   return true;
}

KEL_Status CacheReader::Lookup(std::string_view key, CacheHit *hit) const {
   uint32_t lo = 0, hi = count_;
   while (lo < hi) {
      uint32_t mid = lo + (hi - lo) / 2;
      std::string_view k;
      CacheHit h;
      if (!EntryAt(mid, &k, &h)) return KEL_STATUS_CACHE_CORRUPT;
      if (KeyLess(k, key)) {
         lo = mid + 1;
      } else if (KeyLess(key, k)) {
         hi = mid;
      } else {
         *hit = h;
         return KEL_STATUS_OK;
      }
   }
   return KEL_STATUS_NOT_FOUND;
}

std::span<const uint8_t, 16> CacheReader::Signature() const {
   return std::span<const uint8_t, 16>(reinterpret_cast<const uint8_t *>(bytes_.data()) + 16, 16);
}

std::string CacheReader::BuildDate() const {
   std::string_view raw = bytes_.substr(32, 24);
   return std::string(raw.substr(0, std::min(raw.find('\0'), kBuildDateMax)));
}

}  // namespace kelplat
