// Readers for records laid out by byte offset, little-endian.  Records are
// never cast to structs, so the code is right on 32- and 64-bit builds.
#ifndef ORXKELTOOLS_RECORDS_H
#define ORXKELTOOLS_RECORDS_H

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

inline uint8_t ReadU8(const uint8_t *rec, size_t off) { return rec[off]; }

inline uint16_t ReadU16(const uint8_t *rec, size_t off) {
   return uint16_t(rec[off] | rec[off + 1] << 8);
}

inline uint32_t ReadU32(const uint8_t *rec, size_t off) {
   return uint32_t(rec[off]) | uint32_t(rec[off + 1]) << 8 | uint32_t(rec[off + 2]) << 16 |
          uint32_t(rec[off + 3]) << 24;
}

inline int32_t ReadI32(const uint8_t *rec, size_t off) { return int32_t(ReadU32(rec, off)); }

inline uint64_t ReadU64(const uint8_t *rec, size_t off) {
   return ReadU32(rec, off) | uint64_t(ReadU32(rec, off + 4)) << 32;
}

// A text field of at most width bytes: up to its NUL, or the whole field when
// the terminator is missing.
inline std::string_view ReadText(const uint8_t *rec, size_t off, size_t width) {
   const char *p = reinterpret_cast<const char *>(rec + off);
   const void *nul = std::memchr(p, '\0', width);
   return {p, nul ? size_t(static_cast<const char *>(nul) - p) : width};
}

// Writers for the records the tool sends (data-call requests, test input).
inline void PutU32(uint8_t *rec, size_t off, uint32_t value) {
   for (int i = 0; i < 4; i++) rec[off + i] = uint8_t(value >> 8 * i);
}

inline void PutU64(uint8_t *rec, size_t off, uint64_t value) {
   PutU32(rec, off, uint32_t(value));
   PutU32(rec, off + 4, uint32_t(value >> 32));
}

#endif
