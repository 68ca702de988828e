// What the command handlers share: the mode flag, the common services and
// the small owners of KEL lists and data objects.
#ifndef ORXKELTOOLS_KELTOOLS_H
#define ORXKELTOOLS_KELTOOLS_H

#include <cstddef>
#include <cstdint>
#include <memory>

#include "kel/kel.h"

// 1 when the tool reads a cache file, 0 in live mode; set by main only.
extern "C" uint8_t InvokedWithCache;

extern "C" [[noreturn]] void Panic(const char *fmt, ...) __attribute__((format(printf, 1, 2)));
extern "C" void Warning(const char *fmt, ...) __attribute__((format(printf, 1, 2)));

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
