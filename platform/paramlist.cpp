// Parameter lists and data objects.
#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <new>

#include "internal.h"

namespace kelplat {

// Room for n bytes in the list's last text chunk, or a new chunk.
static char *TextRoom(KEL_ParamList *list, size_t n) {
   constexpr size_t kChunkSize = 4096;
   if (list->chunks.empty() || list->chunks.back().size - list->chunks.back().used < n) {
      size_t size = std::max(n, kChunkSize);
      char *bytes = static_cast<char *>(std::malloc(size));
      if (bytes == nullptr) return nullptr;
      try {
         list->chunks.push_back({bytes, 0, size});
      } catch (const std::exception &) {
         std::free(bytes);
         return nullptr;
      }
   }
   KEL_TextChunk &c = list->chunks.back();
   char *at = c.bytes + c.used;
   c.used += n;
   return at;
}

KEL_Status ParamListAppend(KEL_ParamList *list, uint32_t kind, uint64_t value, const char *text,
                           size_t textLength) {
   if (list == nullptr) return KEL_STATUS_BAD_PARAM;
   if (textLength >= SIZE_MAX - 1) return KEL_STATUS_NO_MEMORY;
   KEL_Param p{kind, 0, value, nullptr};
   if (text != nullptr) {
      p.text = TextRoom(list, textLength + 1);
      if (p.text == nullptr) return KEL_STATUS_NO_MEMORY;
      std::memcpy(p.text, text, textLength);
      p.text[textLength] = '\0';
   }
   try {
      list->entries.push_back(p);
   } catch (const std::exception &) {
      if (p.text != nullptr) list->chunks.back().used -= textLength + 1;
      return KEL_STATUS_NO_MEMORY;
   }
   return KEL_STATUS_OK;
}

}  // namespace kelplat

extern "C" {

KEL_ParamList *KEL_ParamListCreate(int kind, int capacity) {
   (void)kind;
   auto *list = new (std::nothrow) KEL_ParamList;
   if (list == nullptr) return nullptr;
   try {
      if (capacity > 0) list->entries.reserve(size_t(capacity));
   } catch (const std::exception &) {
      delete list;
      return nullptr;
   }
   return list;
}

KEL_Status KEL_ParamListAddInt(KEL_ParamList *list, uint64_t value) {
   return kelplat::ParamListAppend(list, KEL_PARAM_INT, value, nullptr, 0);
}

KEL_Status KEL_ParamListAddString(KEL_ParamList *list, const char *text) {
   if (text == nullptr) return KEL_STATUS_BAD_PARAM;
   return kelplat::ParamListAppend(list, KEL_PARAM_STRING, 0, text, std::strlen(text));
}

uint32_t KEL_ParamListUsedCount(const KEL_ParamList *list) {
   return list == nullptr ? 0 : uint32_t(list->entries.size());
}

void KEL_ParamListRemoveLastParam(KEL_ParamList *list) {
   if (list == nullptr || list->entries.empty()) return;
   // The last entry's text is the last one in the last chunk: give it back.
   if (const char *text = list->entries.back().text; text != nullptr && !list->chunks.empty()) {
      KEL_TextChunk &c = list->chunks.back();
      if (text >= c.bytes && text < c.bytes + c.used) c.used = size_t(text - c.bytes);
   }
   list->entries.pop_back();
}

void KEL_ParamListDestroy(KEL_ParamList *list) {
   if (list == nullptr) return;
   for (KEL_TextChunk &c : list->chunks) std::free(c.bytes);
   delete list;
}

const KEL_Param *KEL_ParamListGetParam(const KEL_ParamList *list, uint32_t index) {
   if (list == nullptr || index >= list->entries.size()) return nullptr;
   return &list->entries[index];
}

int64_t KEL_ParamGetInt(const KEL_Param *param) {
   return param == nullptr ? 0 : int64_t(param->value);
}

const char *KEL_ParamGetString(const KEL_Param *param) {
   return param == nullptr ? nullptr : param->text;
}

// A 32-bit number is stored either as itself (signed or unsigned: 0xffffffff
// reads as -1) or sign-extended to 64 bits when it is negative.  Any other
// value has no 32-bit form: cutting it to its low 32 bits would turn an
// absurd key into a plausible one (4294967297 into process 1), so it is a
// bad entry.
KEL_Status KEL_ParamListGetInt32(const KEL_ParamList *list, uint32_t index, int32_t *out) {
   const KEL_Param *p = KEL_ParamListGetParam(list, index);
   if (p == nullptr || out == nullptr) return KEL_STATUS_BAD_PARAM;
   if (p->kind == KEL_PARAM_STRING) return KEL_STATUS_BAD_PARAM;
   if (p->value <= UINT32_MAX)
      *out = int32_t(uint32_t(p->value));
   else if (int64_t(p->value) >= INT32_MIN && int64_t(p->value) < 0)
      *out = int32_t(int64_t(p->value));
   else
      return KEL_STATUS_BAD_PARAM;
   return KEL_STATUS_OK;
}

KEL_Status KEL_ParamListGetUInt64(const KEL_ParamList *list, uint32_t index, uint64_t *out) {
   const KEL_Param *p = KEL_ParamListGetParam(list, index);
   if (p == nullptr || out == nullptr) return KEL_STATUS_BAD_PARAM;
   if (p->kind == KEL_PARAM_STRING) return KEL_STATUS_BAD_PARAM;
   *out = p->value;
   return KEL_STATUS_OK;
}

KEL_Status KEL_ParamListGetString(const KEL_ParamList *list, uint32_t index, const char **out) {
   const KEL_Param *p = KEL_ParamListGetParam(list, index);
   if (p == nullptr || out == nullptr || p->text == nullptr) return KEL_STATUS_BAD_PARAM;
   *out = p->text;
   return KEL_STATUS_OK;
}

KELData *KELData_Create(uint32_t capacity, const void *bytes, uint32_t length) {
   if (length > capacity || (length > 0 && bytes == nullptr)) return nullptr;
   auto *data = static_cast<KELData *>(std::calloc(1, sizeof(KELData)));
   if (data == nullptr) return nullptr;
   data->bytes = static_cast<uint8_t *>(std::malloc(capacity ? capacity : 1));
   if (data->bytes == nullptr) {
      std::free(data);
      return nullptr;
   }
   data->capacity = capacity;
   data->length = length;
   if (length > 0) std::memcpy(data->bytes, bytes, length);
   return data;
}

void *KELData_GetData(KELData *data) { return data == nullptr ? nullptr : data->bytes; }

void KELData_Destroy(KELData *data) {
   if (data == nullptr) return;
   std::free(data->bytes);
   std::free(data);
}

}  // extern "C"
