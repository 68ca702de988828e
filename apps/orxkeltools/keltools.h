// What the command handlers share: the mode flag, the common services and
// the small owners of KEL lists and data objects.
#ifndef ORXKELTOOLS_KELTOOLS_H
#define ORXKELTOOLS_KELTOOLS_H

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <memory>

#include "kel/kel.h"

// 1 when the tool reads a cache file, 0 in live mode; set by main only.
extern "C" uint8_t InvokedWithCache;

extern "C" [[noreturn]] void Panic(const char *fmt, ...) __attribute__((format(printf, 1, 2)));
extern "C" void Warning(const char *fmt, ...) __attribute__((format(printf, 1, 2)));

// Records that writing the command's output failed with errno err (for
// output written with write() rather than stdio).  At exit the tool reports
// the first such error once and ends with the command's failure status.
void NoteOutputError(int err);

void SizeToString(uint64_t bytes, char *buf, size_t size);
KEL_Status GetInstanceList(KEL_Node node, const KEL_ParamList *keys, KEL_ParamList **list);
int AddParamToList(const KEL_Param *param, KEL_ParamList *list);

// Owners that release a KEL list or data object on every path.
struct ParamListDeleter {
   void operator()(KEL_ParamList *list) const { KEL_ParamListDestroy(list); }
};
using ParamListPtr = std::unique_ptr<KEL_ParamList, ParamListDeleter>;

struct KELDataDeleter {
   void operator()(KELData *data) const { KELData_Destroy(data); }
};
using KELDataPtr = std::unique_ptr<KELData, KELDataDeleter>;

// GetInstanceList into an owner; the owner stays empty when the call fails.
inline KEL_Status GetInstanceList(KEL_Node node, const KEL_ParamList *keys, ParamListPtr *list) {
   KEL_ParamList *raw = nullptr;
   KEL_Status status = GetInstanceList(node, keys, &raw);
   list->reset(raw);
   return status;
}

// A key appended to a key list for as long as the owner lives: the key is
// removed again when the owner goes out of scope, so appends and removals
// stay paired on every path.  ok() tells whether the append worked.
class ScopedKey {
public:
   // Copies an instance-list entry; AddParamToList reports a failure.
   ScopedKey(KEL_ParamList *keys, const KEL_Param *key) : keys_(keys), added_(AddParamToList(key, keys) != 0) {}
   // Appends an integer key; a failure is left to the caller to report,
   // with status().
   ScopedKey(KEL_ParamList *keys, uint64_t key)
      : keys_(keys), status_(KEL_ParamListAddInt(keys, key)), added_(status_ == KEL_STATUS_OK) {}
   ScopedKey(const ScopedKey &) = delete;
   ScopedKey &operator=(const ScopedKey &) = delete;
   ~ScopedKey() {
      if (added_) KEL_ParamListRemoveLastParam(keys_);
   }
   bool ok() const { return added_; }
   // The status of an integer key's append (a copied key's failure has
   // been reported by AddParamToList).
   KEL_Status status() const { return status_; }

private:
   KEL_ParamList *keys_;
   KEL_Status status_ = KEL_STATUS_OK;
   bool added_;
};

// How a walk over a node's instances ended.  The messages stay with the
// callers, since their texts differ.
enum class WalkEnd {
   Done,          // every instance was visited
   Stopped,       // the visitor asked to stop
   ListFailed,    // listing the node failed; status says why
   AppendFailed,  // a key could not be appended (AddParamToList reported it)
};

struct WalkResult {
   WalkEnd end;
   KEL_Status status;  // the listing's status
};

// Lists the instances of node under keys and calls visit(key) for each, in
// listing order, with that instance's key appended to keys for the call.
// visit returns true to go on.  keys may hold fewer keys than node has
// levels (none for a top-level node); it is as it was when the walk returns.
template <class Visit>
WalkResult ForEachInstance(KEL_Node node, KEL_ParamList *keys, Visit &&visit) {
   ParamListPtr list;
   KEL_Status status = GetInstanceList(node, keys, &list);
   if (status != KEL_STATUS_OK) return {WalkEnd::ListFailed, status};
   uint32_t n = KEL_ParamListUsedCount(list.get());
   for (uint32_t i = 0; i < n; i++) {
      const KEL_Param *key = KEL_ParamListGetParam(list.get(), i);
      ScopedKey pushed(keys, key);
      if (!pushed.ok()) return {WalkEnd::AppendFailed, status};
      if (!visit(key)) return {WalkEnd::Stopped, status};
   }
   return {WalkEnd::Done, status};
}

// A failed KEL status as a process exit status, for the commands that end
// with the status itself: the system keeps only the low 8 bits, so a status
// whose low 8 bits are 0 ends with 1 instead of passing for success.
inline int KelExitStatus(KEL_Status status) {
   if (status == KEL_STATUS_OK) return 0;
   return (status & 0xff) != 0 ? int(status & 0xff) : 1;
}

// Memory in the commands: tables come from the malloc family and are held by
// a MallocPtr; a failed allocation is a returned failure, never an exception
// (see docs/architecture.md).
struct FreeDeleter {
   void operator()(void *p) const { std::free(p); }
};
template <class T>
using MallocPtr = std::unique_ptr<T[], FreeDeleter>;

// A zeroed array of count elements (at least one, so that an empty table is
// still a valid pointer); empty on overflow or exhaustion.
template <class T>
MallocPtr<T> AllocArray(size_t count) {
   return MallocPtr<T>(static_cast<T *>(std::calloc(count > 0 ? count : 1, sizeof(T))));
}

// Grows *array to hold at least want elements, doubling so that appends
// cost amortised constant time; the new elements are left unset, so the
// pages behind them are not touched until they are written.  For arrays
// whose elements are written whole before they are read.  False (and the
// array untouched) on overflow or exhaustion.
template <class T>
bool GrowArrayRaw(MallocPtr<T> *array, size_t *capacity, size_t want) {
   if (want <= *capacity) return true;
   size_t grown = *capacity < 8 ? 8 : *capacity;
   while (grown < want) {
      if (grown > SIZE_MAX / 2) return false;
      grown *= 2;
   }
   if (grown > SIZE_MAX / sizeof(T)) return false;
   void *bigger = std::realloc(array->get(), grown * sizeof(T));
   if (bigger == nullptr) return false;
   (void)array->release();
   array->reset(static_cast<T *>(bigger));
   *capacity = grown;
   return true;
}

// GrowArrayRaw with the new elements zeroed.
template <class T>
bool GrowArray(MallocPtr<T> *array, size_t *capacity, size_t want) {
   size_t before = *capacity;
   if (!GrowArrayRaw(array, capacity, want)) return false;
   if (*capacity > before)
      std::memset(static_cast<void *>(array->get() + before), 0, (*capacity - before) * sizeof(T));
   return true;
}

// The command handlers, in command table order.
int ListPCI(int argc, char **argv);
int PsMain(int argc, char **argv);
int HwclockMain(int argc, char **argv);
int HalvexMain(int argc, char **argv);
int InterruptInfo(int argc, char **argv);
int BootOptionMain(int argc, char **argv);
int AmldumpMain(int argc, char **argv);
int PciInfoMain(int argc, char **argv);
int PidofMain(int argc, char **argv);
int UserspaceofMain(int argc, char **argv);
int VduMain(int argc, char **argv);
int LsofMain(int argc, char **argv);
int VdfMain(int argc, char **argv);
int PkillMain(int argc, char **argv);
int PgrepMain(int argc, char **argv);
int UptimeMain(int argc, char **argv);

#endif
