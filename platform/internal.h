// Platform internals shared between its sources.
#ifndef PLATFORM_INTERNAL_H
#define PLATFORM_INTERNAL_H

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "kel/kel.h"

// A parameter list entry.  The kind is the first 32-bit word, as callers rely on.
struct KEL_Param {
   uint32_t kind;
   uint32_t reserved;
   uint64_t value;
   char *text;  // set for KEL_PARAM_STRING entries; held by the list's text chunks
};

// The texts of a list's entries live in chunks that never move, so a text
// pointer stays valid for the list's life; appending a text costs no
// allocation of its own, and removing the last entry gives its bytes back.
struct KEL_TextChunk {
   char *bytes;  // malloc
   size_t used;
   size_t size;
};

struct KEL_ParamList {
   std::vector<KEL_Param> entries;
   std::vector<KEL_TextChunk> chunks;
};

// Data object: word 0 the capacity, word 1 the number of bytes held.
struct KELData {
   uint32_t capacity;
   uint32_t length;
   uint8_t *bytes;
};

namespace kelplat {
// Appends an entry of any kind (used for keys read back from a cache file).
KEL_Status ParamListAppend(KEL_ParamList *list, uint32_t kind, uint64_t value, const char *text,
                           size_t textLength);

// The loaded tree (kel.cpp), for the simulator's answers (simulator.cpp).
// Fills exactly size bytes: a shorter record is zero-filled, a longer one cut.
void CopyRecord(std::string_view stored, void *buf, uint32_t size);
// A setting stored with the tree ("corafs.root"), or nothing.
std::optional<std::string_view> TreeMeta(std::string_view name);
// The snapshot ORXKEL_SIMULATOR names, or null when it names none.
const char *SimulatorPath();
// Whether the calls run against the simulator.
bool InSimulator();
// How many lookups the tree has answered in this process: lets tests show
// that a command reads each entry once, however the cache is laid out.
uint64_t TreeLookupCount();

}  // namespace kelplat

#endif
