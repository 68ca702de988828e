// Status texts and the scheduler's state-name tables.
#include <cstdio>

#include "kel/kel.h"

namespace {

struct StatusText {
   KEL_Status status;
   const char *text;
};

constexpr StatusText kStatusTexts[] = {
   {KEL_STATUS_OK, "Success"},
   {KEL_STATUS_FAILURE, "Failure"},
   {KEL_STATUS_NOT_FOUND, "Not found"},
   {KEL_STATUS_BAD_PARAM, "Bad parameter"},
   {KEL_STATUS_NOT_SUPPORTED, "Not supported"},
   {KEL_STATUS_READ_ONLY, "Read only"},
   {KEL_STATUS_NO_MEMORY, "Out of memory"},
   {KEL_STATUS_NO_RESOURCES, "Out of resources"},
   {KEL_STATUS_INVALID_NODE, "Invalid KEL node"},
   {KEL_STATUS_BAD_KEY_COUNT, "Wrong number of instance keys"},
   {KEL_STATUS_NOT_A_LIST, "Node has no instances"},
   {KEL_STATUS_NO_TREE, "KEL tree not available"},
   {KEL_STATUS_CACHE_OPEN, "Cannot open cache file"},
   {KEL_STATUS_CACHE_FORMAT, "Not a KEL cache file"},
   {KEL_STATUS_CACHE_VERSION, "Unsupported cache file version"},
   {KEL_STATUS_CACHE_CORRUPT, "Corrupt cache file"},
   {KEL_STATUS_CACHE_TRUNCATED, "Truncated cache file"},
   {KEL_STATUS_CACHE_NO_FILE, "No such file"},
   {KEL_STATUS_CACHE_DENIED, "Permission denied"},
   {KEL_STATUS_CACHE_FOLDER, "Is a folder, not a cache file"},
   {KEL_STATUS_CACHE_NOT_REGULAR, "Not a regular file or a pipe"},
   {KEL_STATUS_CACHE_JSON, "A JSON snapshot, not a cache file (build one with: kelcache build SNAPSHOT -o FILE)"},
   {KEL_STATUS_CACHE_EMPTY_PIPE, "Nothing was written to the pipe"},
   {KEL_STATUS_BAD_TIME, "Invalid date or time"},
   {KEL_STATUS_NO_CARTEL, "No such cartel"},
};

}  // namespace

extern "C" {

const char *ORX_ReturnStatusToString(KEL_Status status) {
   for (const StatusText &s : kStatusTexts)
      if (s.status == status) return s.text;
   // Unknown statuses get a generic text; the buffer is reused by the next call.
   static char unknown[40];
   std::snprintf(unknown, sizeof unknown, "Unknown status 0x%x", status);
   return unknown;
}

const CpuSched_StateElement CpuSched_RunStateElements[] = {
   {0, 0, "ZOMBIE"},  {1, 0, "RUN"},     {2, 0, "READY"},   {3, 0, "WAIT"},
   {4, 0, "WAITB"},   {5, 0, "SLEEP"},   {6, 0, "MIGRATING"}, {7, 0, "CORUN"},
   {8, 0, "HALTED"},  {9, 0, "NEW"},
};
const uint32_t CpuSched_NumRunStates =
   sizeof CpuSched_RunStateElements / sizeof CpuSched_RunStateElements[0];

const CpuSched_StateElement CpuSched_WaitStateElements[] = {
   {0, 0, "NONE"},    {1, 0, "IDLE"},    {2, 0, "LOCK"},    {3, 0, "SEMA"},
   {4, 0, "EVENT"},   {5, 0, "RPC"},     {6, 0, "IO"},      {7, 0, "SWAPIN"},
   {8, 0, "TIMER"},   {9, 0, "REQUEST"}, {10, 0, "SIGNAL"}, {11, 0, "CHILD"},
};
const uint32_t CpuSched_NumWaitStates =
   sizeof CpuSched_WaitStateElements / sizeof CpuSched_WaitStateElements[0];

}  // extern "C"
