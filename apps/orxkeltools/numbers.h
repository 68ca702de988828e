// Decimal arguments converted the way the tool's 32-bit C library converts
// them, so that a build with 64-bit longs gives the same numbers: a value
// out of range is clamped instead of being cut to its low 32 bits (which
// could turn an absurd signal argument into a real signal number).
#ifndef ORXKELTOOLS_NUMBERS_H
#define ORXKELTOOLS_NUMBERS_H

#include <cctype>
#include <cerrno>
#include <cstdint>
#include <cstdlib>

// strtol(text, nullptr, 10) of a 32-bit long.
inline int32_t StrtolInt32(const char *text) {
   long long value = std::strtoll(text, nullptr, 10);
   if (value > INT32_MAX) return INT32_MAX;
   if (value < INT32_MIN) return INT32_MIN;
   return int32_t(value);
}

// strtoul(text, nullptr, 10) of a 32-bit unsigned long: a minus sign negates
// modulo 2^32, a magnitude beyond 32 bits gives the largest value.
inline uint32_t StrtoulUInt32(const char *text) {
   const char *p = text;
   while (std::isspace(static_cast<unsigned char>(*p))) p++;
   bool negative = *p == '-';
   if (*p == '-' || *p == '+') p++;
   if (!std::isdigit(static_cast<unsigned char>(*p))) return 0;
   errno = 0;
   unsigned long long magnitude = std::strtoull(p, nullptr, 10);
   if (errno == ERANGE || magnitude > UINT32_MAX) return UINT32_MAX;
   return negative ? uint32_t(0u - uint32_t(magnitude)) : uint32_t(magnitude);
}

#endif
