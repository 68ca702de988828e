// Cache file encoding, writing and checked reading.
#include "cachefile.h"

#include <errno.h>
#include <fcntl.h>
#include <poll.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>

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

bool AppendParamLookup(std::string &out, Op op, KEL_Node node, const KEL_ParamList *keys) {
   // The size first, so that the bytes are written in place: the buffer
   // keeps its room from one call to the next.
   size_t size = 3;
   if (keys != nullptr) {
      for (const KEL_Param &p : keys->entries) {
         if (p.kind > 0xff) return false;
         if (p.kind != KEL_PARAM_STRING) {
            size += 9;
         } else {
            if (p.text == nullptr) return false;
            size += 5 + std::strlen(p.text);
         }
      }
   }
   out.resize(size);
   auto *w = reinterpret_cast<uint8_t *>(out.data());
   *w++ = uint8_t(op);
   *w++ = uint8_t(node & 0xff);
   *w++ = uint8_t(node >> 8);
   if (keys == nullptr) return true;
   for (const KEL_Param &p : keys->entries) {
      *w++ = uint8_t(p.kind);
      if (p.kind == KEL_PARAM_STRING) {
         size_t n = std::strlen(p.text);
         StoreU32(w, uint32_t(n));
         std::memcpy(w + 4, p.text, n);
         w += 4 + n;
      } else {
         StoreU64(w, p.value);
         w += 8;
      }
   }
   return true;
}

std::optional<std::string> EncodeParamLookup(Op op, KEL_Node node, const KEL_ParamList *keys) {
   std::string out;
   if (!AppendParamLookup(out, op, node, keys)) return std::nullopt;
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

uint32_t HeaderCheck(const uint8_t *header) {
   return uint32_t(Checksum(header + kHeaderCheckStart, kHeaderCheckOffset - kHeaderCheckStart));
}

static bool KeyLess(std::string_view a, std::string_view b) {
   size_t n = std::min(a.size(), b.size());
   int c = n ? std::memcmp(a.data(), b.data(), n) : 0;
   return c < 0 || (c == 0 && a.size() < b.size());
}

// The slot count for n entries: a power of two with at least a third of
// the slots empty, so that probes stay short and always end.
static uint64_t SlotCountFor(size_t n) {
   uint64_t s = 2;
   while (s < uint64_t(n) + uint64_t(n) / 2 + 1) s *= 2;
   return s;
}

// Checksum() over bytes given in pieces of any length, for a total length
// known from the start.
class StreamChecksum {
public:
   explicit StreamChecksum(uint64_t total) : h_(0x9e3779b97f4a7c15ULL ^ total) {}
   void Update(const uint8_t *p, size_t n) {
      if (pendingLen_ > 0) {
         size_t take = std::min(n, 8 - pendingLen_);
         std::memcpy(pending_ + pendingLen_, p, take);
         pendingLen_ += take;
         p += take;
         n -= take;
         if (pendingLen_ < 8) return;
         Word(pending_);
         pendingLen_ = 0;
      }
      for (; n >= 8; p += 8, n -= 8) Word(p);
      std::memcpy(pending_, p, n);
      pendingLen_ = n;
   }
   uint64_t Final() const {
      uint64_t h = h_;
      for (size_t i = 0; i < pendingLen_; i++) h = (h ^ pending_[i]) * 0x100000001b3ULL;
      h ^= h >> 33;
      return h * 0xc4ceb9fe1a85ec53ULL;
   }

private:
   void Word(const uint8_t *p) {
      h_ = (h_ ^ LoadU64(p)) * 0xff51afd7ed558ccdULL;
      h_ ^= h_ >> 29;
   }
   uint64_t h_;
   uint8_t pending_[8];
   size_t pendingLen_ = 0;
};

uint8_t *CacheWriter::Allocate(size_t n) {
   if (n > freeLen_) {
      // A large entry gets a block of its own; the current block stays in use.
      if (n > kByteBlock / 4) {
         byteBlocks_.emplace_back(new uint8_t[n]);
         return byteBlocks_.back().get();
      }
      byteBlocks_.emplace_back(new uint8_t[kByteBlock]);
      free_ = byteBlocks_.back().get();
      freeLen_ = kByteBlock;
   }
   uint8_t *at = free_;
   free_ += n;
   freeLen_ -= n;
   return at;
}

void TagIndex::Grow() {
   std::vector<uint64_t> grown(std::max<size_t>(slots_.size() * 2, 1024), 0);
   const size_t mask = grown.size() - 1;
   for (uint64_t v : slots_) {
      if (v == 0) continue;
      size_t i = Home(uint32_t(v >> 32), mask);
      while (grown[i] != 0) i = (i + 1) & mask;
      grown[i] = v;
   }
   slots_ = std::move(grown);
}

void TagIndex::Insert(uint32_t tag, uint32_t number) {
   if ((used_ + 1) * 4 > slots_.size() * 3) Grow();
   const size_t mask = slots_.size() - 1;
   size_t i = Home(tag, mask);
   while (slots_[i] != 0) i = (i + 1) & mask;
   slots_[i] = uint64_t(tag) << 32 | number;
   used_++;
}

bool CacheWriter::Add(std::string_view lookup, uint32_t status, std::string_view data) {
   const uint32_t tag = uint32_t(KeyHash(lookup) >> 32);
   auto sameKey = [&](uint32_t number) {
      const Entry &e = At(number - 1);
      return e.keyLen == lookup.size() && std::memcmp(e.bytes + kEntryHeadSize, lookup.data(), lookup.size()) == 0;
   };
   if (index_.Find(tag, sameKey) != 0) return false;
   if ((count_ & (kEntryBlock - 1)) == 0) entryBlocks_.emplace_back(new Entry[kEntryBlock]);
   const size_t size = kEntryHeadSize + lookup.size() + data.size();
   uint8_t *bytes = Allocate(size);
   StoreU32(bytes, status);
   if (!lookup.empty()) std::memcpy(bytes + kEntryHeadSize, lookup.data(), lookup.size());
   if (!data.empty()) std::memcpy(bytes + kEntryHeadSize + lookup.size(), data.data(), data.size());
   entryBlocks_.back()[count_ & (kEntryBlock - 1)] = {bytes, uint32_t(lookup.size()), uint32_t(data.size()), tag,
                                                      uint32_t(HomeHash(lookup))};
   index_.Insert(tag, uint32_t(count_ + 1));
   count_++;
   totalBytes_ += size;
   return true;
}

// Makes the file through sink: sink.Append(bytes, n) gives the entries'
// bytes in file order, from the end of the slot table on; sink.Place(offset,
// bytes, n) then gives the slot table and last the header, whose checksum is
// sink.Checksum() of all that follows the header.  Entries take slots in the
// order of their keys, so that the table is the same for the same entries
// whatever order they were added in.  The entries go out before the table,
// so that each is read once, in slot order, and the table filled in as they
// go.
template <class Sink>
void CacheWriter::Stream(Sink &sink, std::span<const uint8_t, 16> signature, std::string_view buildDate) const {
   // The order of the keys: by their first eight bytes (read big-endian, so
   // that the numbers compare as the bytes do), then by the whole keys.
   struct Sorted {
      uint64_t prefix;
      uint32_t entry, home;
   };
   std::vector<Sorted> sorted(count_);
   for (size_t n = 0; n < count_; n++) {
      const Entry &e = At(n);
      uint8_t first[8] = {};
      std::memcpy(first, e.bytes + kEntryHeadSize, std::min<size_t>(e.keyLen, 8));
      uint64_t prefix = 0;
      for (uint8_t b : first) prefix = prefix << 8 | b;
      sorted[n] = {prefix, uint32_t(n), e.home};
   }
   auto keyOf = [this](uint32_t n) {
      const Entry &e = At(n);
      return std::string_view(reinterpret_cast<const char *>(e.bytes) + kEntryHeadSize, e.keyLen);
   };
   std::sort(sorted.begin(), sorted.end(), [&](const Sorted &a, const Sorted &b) {
      if (a.prefix != b.prefix) return a.prefix < b.prefix;
      return KeyLess(keyOf(a.entry), keyOf(b.entry));
   });

   // The slot table as the file holds it.  Until the entries go out, a
   // taken slot holds its entry's number + 1 where its offset goes.
   const uint64_t slots = SlotCountFor(count_);
   std::vector<uint8_t> table(slots * kSlotSize, 0);
   for (const Sorted &s : sorted) {
      uint64_t i = s.home & (slots - 1);
      while (LoadU32(&table[i * kSlotSize + 4]) != 0) i = (i + 1) & (slots - 1);
      StoreU32(&table[i * kSlotSize + 4], s.entry + 1);
   }
   sorted = {};

   const uint64_t entryArea = kHeaderSize + slots * kSlotSize;
   uint64_t at = entryArea;
   for (uint64_t i = 0; i < slots; i++) {
      uint8_t *slot = &table[i * kSlotSize];
      uint32_t taken = LoadU32(slot + 4);
      if (taken == 0) continue;
      const Entry &e = At(taken - 1);
      StoreU32(slot, e.tag);
      StoreU32(slot + 4, uint32_t(at));
      StoreU32(slot + 8, e.keyLen);
      StoreU32(slot + 12, e.dataLen);
      sink.Append(e.bytes, kEntryHeadSize + e.keyLen + e.dataLen);
      at += kEntryHeadSize + e.keyLen + e.dataLen;
   }
   sink.Place(kHeaderSize, table.data(), table.size());
   table = {};

   uint8_t head[kHeaderSize] = {};
   std::memcpy(head, kCacheMagic, 8);
   StoreU32(head + 8, kCacheVersion);
   StoreU32(head + 12, 0);
   std::memcpy(head + 16, signature.data(), 16);
   std::string_view date = buildDate.substr(0, kBuildDateMax);
   if (!date.empty()) std::memcpy(head + 32, date.data(), date.size());
   StoreU32(head + 56, uint32_t(count_));
   StoreU32(head + 60, uint32_t(kHeaderSize));
   StoreU64(head + 64, at);
   StoreU64(head + 72, sink.Checksum());
   StoreU32(head + 80, uint32_t(slots));
   StoreU32(head + 84, uint32_t(entryArea));
   StoreU32(head + 88, 0);
   StoreU32(head + kHeaderCheckOffset, HeaderCheck(head));
   sink.Place(0, head, kHeaderSize);
}

// The size of the file for these entries.
static uint64_t FileSize(size_t count, uint64_t entryBytes) {
   return kHeaderSize + SlotCountFor(count) * kSlotSize + entryBytes;
}

std::string CacheWriter::Finish(std::span<const uint8_t, 16> signature, std::string_view buildDate) const {
   struct ToText {
      std::string out;
      size_t end;  // where the next entry goes
      void Append(const uint8_t *p, size_t n) {
         std::memcpy(out.data() + end, p, n);
         end += n;
      }
      void Place(uint64_t offset, const uint8_t *p, size_t n) { std::memcpy(out.data() + offset, p, n); }
      uint64_t Checksum() const {
         return kelplat::Checksum(reinterpret_cast<const uint8_t *>(out.data()) + kHeaderSize, out.size() - kHeaderSize);
      }
   } text{std::string(FileSize(count_, totalBytes_), '\0'), kHeaderSize + SlotCountFor(count_) * kSlotSize};
   Stream(text, signature, buildDate);
   return std::move(text.out);
}

// Writes all of bytes to fd at offset; false with errno set.
static bool WriteAllAt(int fd, const uint8_t *p, size_t n, uint64_t offset) {
   while (n > 0) {
      ssize_t done = pwrite(fd, p, n, off_t(offset));
      if (done < 0 && errno == EINTR) continue;
      if (done == 0) errno = EIO;
      if (done <= 0) return false;
      p += done;
      n -= size_t(done);
      offset += uint64_t(done);
   }
   return true;
}

bool CacheWriter::WriteTo(int fd, std::span<const uint8_t, 16> signature, std::string_view buildDate) const {
   const uint64_t total = FileSize(count_, totalBytes_);
   if (total > kMaxCacheFileSize) {
      errno = EFBIG;
      return false;
   }
   // Entries gather in the buffer and go out a buffer at a time; a piece
   // larger than the buffer goes out directly.  The checksum is taken from
   // the file once all but the header is there, read back through the same
   // buffer.  After the first failure nothing more is written.
   struct ToFile {
      int fd;
      uint64_t total;
      std::vector<uint8_t> buf;
      uint64_t end;  // where the buffer's bytes go
      size_t used = 0;
      bool ok = true;
      int error = 0;
      void Fail() {
         if (ok) error = errno;
         ok = false;
      }
      bool Flush() {
         if (ok && used > 0 && !WriteAllAt(fd, buf.data(), used, end)) Fail();
         end += used;
         used = 0;
         return ok;
      }
      void Append(const uint8_t *p, size_t n) {
         if (!ok) return;
         if (n > buf.size() - used && !Flush()) return;
         if (n >= buf.size()) {
            if (!WriteAllAt(fd, p, n, end)) Fail();
            end += n;
            return;
         }
         std::memcpy(buf.data() + used, p, n);
         used += n;
      }
      void Place(uint64_t offset, const uint8_t *p, size_t n) {
         if (Flush() && !WriteAllAt(fd, p, n, offset)) Fail();
      }
      uint64_t Checksum() {
         StreamChecksum sum(total - kHeaderSize);
         for (uint64_t at = kHeaderSize; ok && at < total;) {
            ssize_t got = pread(fd, buf.data(), size_t(std::min<uint64_t>(buf.size(), total - at)), off_t(at));
            if (got < 0 && errno == EINTR) continue;
            if (got == 0) errno = EIO;
            if (got <= 0) {
               Fail();
               break;
            }
            sum.Update(buf.data(), size_t(got));
            at += uint64_t(got);
         }
         return sum.Final();
      }
   } file{fd, total, std::vector<uint8_t>(size_t(1) << 18), kHeaderSize + SlotCountFor(count_) * kSlotSize};
   Stream(file, signature, buildDate);
   if (!file.ok) errno = file.error;
   return file.ok;
}

CacheReader::~CacheReader() { Close(); }

void CacheReader::Close() {
   if (map_ != nullptr) munmap(map_, mapSize_);
   std::free(owned_);
   owned_ = nullptr;
   map_ = nullptr;
   mapSize_ = 0;
   bytes_ = {};
   count_ = 0;
   slots_ = 0;
   order_.clear();
   ordered_ = false;
}

// Whether bytes look like a JSON snapshot: the first byte that is not a
// blank opens an object.
static bool LooksLikeJson(const uint8_t *p, size_t n) {
   size_t i = 0;
   if (n >= 3 && p[0] == 0xef && p[1] == 0xbb && p[2] == 0xbf) i = 3;  // a UTF-8 byte order mark
   while (i < n && (p[i] == ' ' || p[i] == '\t' || p[i] == '\n' || p[i] == '\r')) i++;
   return i < n && p[i] == '{';
}

// The checks of the fixed header against the size of the bytes it heads
// (at least kHeaderSize): format, version, the size the header claims, the
// header check, and where the slot table and the key area lie.
static KEL_Status CheckHeader(const uint8_t *p, uint64_t size) {
   if (std::memcmp(p, kCacheMagic, 7) != 0)
      return LooksLikeJson(p, kHeaderSize) ? KEL_STATUS_CACHE_JSON : KEL_STATUS_CACHE_FORMAT;
   if (p[7] != uint8_t(kCacheMagic[7]) || LoadU32(p + 8) != kCacheVersion) return KEL_STATUS_CACHE_VERSION;
   uint64_t total = LoadU64(p + 64);
   // Offsets are 32 bits: a larger file is damage, refused before any byte
   // past the header is read.
   if (total > kMaxCacheFileSize) return KEL_STATUS_CACHE_CORRUPT;
   if (total > size) return KEL_STATUS_CACHE_TRUNCATED;
   if (total != size) return KEL_STATUS_CACHE_CORRUPT;
   if (LoadU32(p + kHeaderCheckOffset) != HeaderCheck(p)) return KEL_STATUS_CACHE_CORRUPT;
   uint64_t count = LoadU32(p + 56), index = LoadU32(p + 60), slots = LoadU32(p + 80);
   uint64_t keyArea = LoadU32(p + 84);
   if (index != kHeaderSize || slots < 2 || (slots & (slots - 1)) != 0 || count >= slots ||
       keyArea != index + slots * kSlotSize || keyArea > total)
      return KEL_STATUS_CACHE_CORRUPT;
   return KEL_STATUS_OK;
}

// The status for a file that cannot be opened, from errno.
static KEL_Status OpenError(int error) {
   switch (error) {
   case ENOENT:
   case ENOTDIR: return KEL_STATUS_CACHE_NO_FILE;
   case EACCES:
   case EPERM: return KEL_STATUS_CACHE_DENIED;
   case EISDIR: return KEL_STATUS_CACHE_FOLDER;
   default: return KEL_STATUS_CACHE_OPEN;
   }
}

// Reads from a non-blocking pipe: waits only while a writer holds it open.
static ssize_t ReadSome(int fd, char *buf, size_t n) {
   for (;;) {
      ssize_t got = read(fd, buf, n);
      if (got >= 0) return got;
      if (errno == EINTR) continue;
      if (errno != EAGAIN && errno != EWOULDBLOCK) return -1;
      struct pollfd p = {fd, POLLIN, 0};
      if (poll(&p, 1, -1) < 0 && errno != EINTR) return -1;
   }
}

// A pipe is read whole: the header first, then exactly the size it claims
// (at most what 32-bit offsets reach).  A pipe without a writer ends at
// once: a non-blocking read then reports the end of the stream.
KEL_Status CacheReader::ReadPipe(int fd) {
   uint8_t header[kHeaderSize];
   size_t have = 0;
   while (have < kHeaderSize) {
      ssize_t got = ReadSome(fd, reinterpret_cast<char *>(header) + have, kHeaderSize - have);
      if (got < 0) return KEL_STATUS_CACHE_OPEN;
      if (got == 0) break;
      have += size_t(got);
   }
   if (have == 0) return KEL_STATUS_CACHE_EMPTY_PIPE;
   if (have < kHeaderSize) {
      if (std::memcmp(header, kCacheMagic, std::min(have, sizeof kCacheMagic)) == 0)
         return KEL_STATUS_CACHE_TRUNCATED;
      return LooksLikeJson(header, have) ? KEL_STATUS_CACHE_JSON : KEL_STATUS_CACHE_FORMAT;
   }
   uint64_t total = LoadU64(header + 64);
   // Checked against the size it claims, so that only the size checks can
   // fail on what the stream has not given yet.
   KEL_Status status = CheckHeader(header, std::max<uint64_t>(total, kHeaderSize));
   if (status != KEL_STATUS_OK) return status;
   if (total > SIZE_MAX) return KEL_STATUS_NO_MEMORY;
   char *buf = static_cast<char *>(std::malloc(size_t(total)));
   if (buf == nullptr) return KEL_STATUS_NO_MEMORY;
   std::memcpy(buf, header, kHeaderSize);
   size_t at = kHeaderSize;
   while (at < total) {
      ssize_t got = ReadSome(fd, buf + at, size_t(total) - at);
      if (got <= 0) {
         std::free(buf);
         return got == 0 ? KEL_STATUS_CACHE_TRUNCATED : KEL_STATUS_CACHE_OPEN;
      }
      at += size_t(got);
   }
   char extra;
   if (ReadSome(fd, &extra, 1) != 0) {  // more than the header claims
      std::free(buf);
      return KEL_STATUS_CACHE_CORRUPT;
   }
   owned_ = buf;
   bytes_ = {buf, size_t(total)};
   return KEL_STATUS_OK;
}

KEL_Status CacheReader::Open(const char *path, int flags) {
   Close();
   // Opening never waits (a FIFO without a writer would block a plain open).
   int fd = open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY);
   if (fd < 0) return OpenError(errno);
   struct stat st;
   if (fstat(fd, &st) != 0) {
      close(fd);
      return KEL_STATUS_CACHE_OPEN;
   }
   if (S_ISFIFO(st.st_mode)) {
      KEL_Status status = ReadPipe(fd);
      close(fd);
      if (status == KEL_STATUS_OK) status = Attach(bytes_, flags);
      if (status != KEL_STATUS_OK) Close();
      return status;
   }
   if (!S_ISREG(st.st_mode)) {
      close(fd);
      return S_ISDIR(st.st_mode) ? KEL_STATUS_CACHE_FOLDER : KEL_STATUS_CACHE_NOT_REGULAR;
   }
   uint64_t fileSize = uint64_t(st.st_size);
   if (fileSize == 0) {
      close(fd);
      return KEL_STATUS_CACHE_FORMAT;
   }
   // The header decides first, so that a file larger than the format allows
   // (or than a 32-bit size_t holds) is never mapped.
   uint8_t header[kHeaderSize];
   size_t want = size_t(std::min<uint64_t>(fileSize, kHeaderSize));
   if (pread(fd, header, want, 0) != ssize_t(want)) {
      close(fd);
      return KEL_STATUS_CACHE_OPEN;
   }
   if (want < kHeaderSize) {
      close(fd);
      if (LooksLikeJson(header, want)) return KEL_STATUS_CACHE_JSON;
      return std::memcmp(header, kCacheMagic, std::min(want, sizeof kCacheMagic)) == 0
                ? KEL_STATUS_CACHE_TRUNCATED
                : KEL_STATUS_CACHE_FORMAT;
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
   if (bytes.size() < kHeaderSize) {
      if (LooksLikeJson(p, bytes.size())) return KEL_STATUS_CACHE_JSON;
      return bytes.size() == 0 || std::memcmp(p, kCacheMagic, std::min(bytes.size(), sizeof kCacheMagic)) != 0
                ? KEL_STATUS_CACHE_FORMAT
                : KEL_STATUS_CACHE_TRUNCATED;
   }
   KEL_Status status = CheckHeader(p, bytes.size());
   if (status != KEL_STATUS_OK) return status;
   bytes_ = bytes;
   count_ = LoadU32(p + 56);
   slots_ = LoadU32(p + 80);
   order_.clear();
   ordered_ = false;
   if (!(flags & kCacheQuickOpen)) status = Verify(flags);
   if (status != KEL_STATUS_OK) {
      bytes_ = {};
      count_ = slots_ = 0;
   }
   return status;
}

KEL_Status CacheReader::Verify(int flags) const {
   const auto *p = reinterpret_cast<const uint8_t *>(bytes_.data());
   if (bytes_.size() < kHeaderSize) return KEL_STATUS_CACHE_TRUNCATED;
   if (!(flags & KEL_CACHE_NO_CHECKSUM) &&
       Checksum(p + kHeaderSize, bytes_.size() - kHeaderSize) != LoadU64(p + 72))
      return KEL_STATUS_CACHE_CORRUPT;
   uint32_t used = 0;
   for (uint32_t i = 0; i < slots_; i++) {
      std::string_view key;
      CacheHit hit;
      uint32_t tag;
      if (SlotAt(i, &key, &hit, &tag)) {
         used++;
         CacheHit found;
         // Found, and found at this very slot (a second slot with the same
         // key would be shadowed by the first).
         if (key.size() < 3 || tag != uint32_t(KeyHash(key) >> 32) || Lookup(key, &found) != KEL_STATUS_OK ||
             found.data.data() != hit.data.data() || found.status != hit.status)
            return KEL_STATUS_CACHE_CORRUPT;
      } else if (LoadU32(p + kHeaderSize + size_t(i) * kSlotSize + 8) != 0) {
         return KEL_STATUS_CACHE_CORRUPT;  // a slot whose key or data lies outside the file
      }
   }
   return used == count_ ? KEL_STATUS_OK : KEL_STATUS_CACHE_CORRUPT;
}

// The entry a slot names, checked against the bytes: false when the slot is
// empty or names bytes outside them.
static bool EntryOfSlot(std::string_view bytes, const uint8_t *s, std::string_view *key, CacheHit *hit) {
   uint32_t at = LoadU32(s + 4), keyLen = LoadU32(s + 8), dataLen = LoadU32(s + 12);
   if (keyLen == 0 || at > bytes.size() ||
       bytes.size() - at < uint64_t(kEntryHeadSize) + keyLen + dataLen)
      return false;
   hit->status = LoadU32(reinterpret_cast<const uint8_t *>(bytes.data()) + at);
   *key = bytes.substr(at + kEntryHeadSize, keyLen);
   hit->data = bytes.substr(at + kEntryHeadSize + keyLen, dataLen);
   return true;
}

bool CacheReader::SlotAt(uint32_t i, std::string_view *key, CacheHit *hit, uint32_t *tag) const {
   if (i >= slots_) return false;
   const auto *s = reinterpret_cast<const uint8_t *>(bytes_.data()) + kHeaderSize + size_t(i) * kSlotSize;
   if (!EntryOfSlot(bytes_, s, key, hit)) return false;
   *tag = LoadU32(s);
   return true;
}

bool CacheReader::EntryAt(uint32_t i, std::string_view *key, CacheHit *hit) const {
   if (!ordered_) {
      // The occupied slots, in the order of their keys.
      order_.clear();
      std::vector<std::string_view> keys(slots_);
      for (uint32_t s = 0; s < slots_; s++) {
         CacheHit h;
         uint32_t tag;
         if (SlotAt(s, &keys[s], &h, &tag)) order_.push_back(s);
      }
      std::sort(order_.begin(), order_.end(), [&keys](uint32_t a, uint32_t b) { return KeyLess(keys[a], keys[b]); });
      ordered_ = true;
   }
   uint32_t tag;
   return i < count_ && i < order_.size() && SlotAt(order_[i], key, hit, &tag);
}

KEL_Status CacheReader::Lookup(std::string_view key, CacheHit *hit) const {
   if (slots_ == 0) return KEL_STATUS_NOT_FOUND;
   const uint32_t tag = uint32_t(KeyHash(key) >> 32), mask = slots_ - 1;
   const auto *base = reinterpret_cast<const uint8_t *>(bytes_.data()) + kHeaderSize;
   uint32_t i = uint32_t(HomeHash(key)) & mask;
   for (uint32_t probes = 0; probes < slots_; probes++, i = (i + 1) & mask) {
      const uint8_t *s = base + size_t(i) * kSlotSize;
      uint32_t keyLen = LoadU32(s + 8);
      if (keyLen == 0) return KEL_STATUS_NOT_FOUND;
      if (LoadU32(s) != tag || keyLen != key.size()) continue;
      std::string_view stored;
      if (!EntryOfSlot(bytes_, s, &stored, hit)) return KEL_STATUS_CACHE_CORRUPT;
      if (std::memcmp(stored.data(), key.data(), keyLen) == 0) return KEL_STATUS_OK;
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
