/*
 * The KEL interface: what the commands call to read and write the kernel's
 * information tree, live, through the simulator, or from a cache file.
 *
 * Every call reports failure through a returned status (0 is success) or a
 * null result; nothing here throws.  Lists and data objects returned to the
 * caller belong to it and are released with their destroy calls.
 */
#ifndef KEL_KEL_H
#define KEL_KEL_H

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef uint32_t KEL_Status;
typedef uint16_t KEL_Node;

/* Statuses the platform returns; ORX_ReturnStatusToString gives their texts. */
enum {
   KEL_STATUS_OK = 0,
   KEL_STATUS_FAILURE = 0xbad0001,
   KEL_STATUS_NOT_FOUND = 0xbad0003,
   KEL_STATUS_BAD_PARAM = 0xbad0007,
   KEL_STATUS_NOT_SUPPORTED = 0xbad000b,
   KEL_STATUS_READ_ONLY = 0xbad000c,
   KEL_STATUS_NO_MEMORY = 0xbad0014,
   KEL_STATUS_NO_RESOURCES = 0xbad0017,
   KEL_STATUS_INVALID_NODE = 0xbad0020,
   KEL_STATUS_BAD_KEY_COUNT = 0xbad0021,
   KEL_STATUS_NOT_A_LIST = 0xbad0022,
   KEL_STATUS_NO_TREE = 0xbad0030,
   KEL_STATUS_CACHE_OPEN = 0xbad0031,
   KEL_STATUS_CACHE_FORMAT = 0xbad0032,
   KEL_STATUS_CACHE_VERSION = 0xbad0033,
   KEL_STATUS_CACHE_CORRUPT = 0xbad0034,
   KEL_STATUS_CACHE_TRUNCATED = 0xbad0035,
   KEL_STATUS_CACHE_NO_FILE = 0xbad0036,
   KEL_STATUS_CACHE_DENIED = 0xbad0037,
   KEL_STATUS_CACHE_FOLDER = 0xbad0038,
   KEL_STATUS_CACHE_NOT_REGULAR = 0xbad0039,
   KEL_STATUS_CACHE_JSON = 0xbad003a,
   KEL_STATUS_CACHE_EMPTY_PIPE = 0xbad003b,
   KEL_STATUS_BAD_TIME = 0xbad0040,
   KEL_STATUS_NO_CARTEL = 0xbad0062,
};

/* Node objects: KEL_NODE_<path with underscores>, one per entry of nodes.def. */
#define KEL_NODE_DEF(name, number, path, size, flags) extern const KEL_Node KEL_NODE_##name;
#include "kel/nodes.def"
#undef KEL_NODE_DEF

/*
 * Record sizes, KEL_RECORD_SIZE_<name>, so that a reader can check at compile
 * time that its layout has the size the node table gives.
 */
enum {
#define KEL_NODE_DEF(name, number, path, size, flags) KEL_RECORD_SIZE_##name = size,
#include "kel/nodes.def"
#undef KEL_NODE_DEF
};

/*
 * Parameter lists hold keys (and the inputs of KEL_Set).  An entry's first
 * 32-bit word is its kind: KEL_PARAM_INT (a 64-bit integer) or
 * KEL_PARAM_STRING (a text).
 */
typedef struct KEL_ParamList KEL_ParamList;
typedef struct KEL_Param KEL_Param;
enum { KEL_PARAM_INT = 0, KEL_PARAM_STRING = 1 };

KEL_ParamList *KEL_ParamListCreate(int kind, int capacity);
KEL_Status KEL_ParamListAddInt(KEL_ParamList *list, uint64_t value);
KEL_Status KEL_ParamListAddString(KEL_ParamList *list, const char *text);
uint32_t KEL_ParamListUsedCount(const KEL_ParamList *list);
void KEL_ParamListRemoveLastParam(KEL_ParamList *list);
void KEL_ParamListDestroy(KEL_ParamList *list);
/* Entry index of the list, or null past its end; valid until the list changes. */
const KEL_Param *KEL_ParamListGetParam(const KEL_ParamList *list, uint32_t index);
int64_t KEL_ParamGetInt(const KEL_Param *param);
/* The entry's text, or null for an entry that carries none. */
const char *KEL_ParamGetString(const KEL_Param *param);
KEL_Status KEL_ParamListGetInt32(const KEL_ParamList *list, uint32_t index, int32_t *out);
KEL_Status KEL_ParamListGetUInt64(const KEL_ParamList *list, uint32_t index, uint64_t *out);
KEL_Status KEL_ParamListGetString(const KEL_ParamList *list, uint32_t index, const char **out);

/*
 * Data objects carry variable-length input and output of the data calls.
 * Layout: word 0 the capacity, word 1 the number of bytes held.
 */
typedef struct KELData KELData;
KELData *KELData_Create(uint32_t capacity, const void *bytes, uint32_t length);
void *KELData_GetData(KELData *data);
void KELData_Destroy(KELData *data);

/* Where the tool runs. */
int HostType_OSIsORX(void);
int HostType_OSIsSimulator(void);
int OrxSyscall_Init(int channel, int flags, int reserved);

/* Read from a cache file (or a pipe, read whole) from now on.  Opening checks
 * the header and the tables' bounds only, so flags are 0; KEL_CACHE_NO_CHECKSUM
 * is accepted and changes nothing (`kelcache verify` checks the checksum). */
enum { KEL_CACHE_NO_CHECKSUM = 1 };
KEL_Status KEL_UseCache(const char *path, int flags);

/*
 * Compare the tree's signature with the tool's.  Writes the tree's build date
 * into buf (at most len bytes, NUL-terminated when it fits) and points *mine
 * at the tool's build date.  Non-zero on mismatch.
 */
int KEL_CheckSig(char *buf, size_t len, const char **mine);

KEL_Status KEL_Get(KEL_Node node, const KEL_ParamList *keys, void *buf, uint32_t size);
KEL_Status KEL_Set(KEL_Node node, const KEL_ParamList *keys, const KEL_ParamList *input,
                   void *buf, uint32_t size);
KEL_Status KEL_GetInstanceListAlloc(KEL_Node node, const KEL_ParamList *keys, KEL_ParamList **list);
KEL_Status KEL_GetInstanceListAllocHint(KEL_Node node, const KEL_ParamList *keys, uint32_t hint,
                                        KEL_ParamList **list);
KEL_Status KEL_GetDataLength(KEL_Node node, const KEL_ParamList *keys, uint32_t *length);
KEL_Status KEL_SetData(KEL_Node node, const KEL_ParamList *keys, const KELData *in, KELData *out);

const char *ORX_ReturnStatusToString(KEL_Status status);

/*
 * Scheduler state names, indexed by the run-state and wait-state numbers of
 * the scheduler summary.  The counts let a caller detect a number beyond a
 * table.
 */
typedef struct CpuSched_StateElement {
   uint32_t id;
   uint32_t flags;
   const char *name;
} CpuSched_StateElement;
extern const CpuSched_StateElement CpuSched_RunStateElements[];
extern const uint32_t CpuSched_NumRunStates;
extern const CpuSched_StateElement CpuSched_WaitStateElements[];
extern const uint32_t CpuSched_NumWaitStates;

/*
 * lstat for paths of the in-memory root file system.  On the host this is
 * lstat itself; the simulator reports the device of the directory that stands
 * for that file system as device 1 (see docs/simulator.md).
 */
struct stat;
int OrxFs_Lstat(const char *path, struct stat *st);

/*
 * Sends signal sig to process pid, as kill does: 0, or -1 with errno set.
 * While ORXKEL_SIGNAL_RECORD names a file, nothing is signalled: each call
 * appends "pid sig" and a newline to that file instead (see
 * docs/simulator.md).
 */
int OrxProc_Signal(int32_t pid, int sig);

#ifdef __cplusplus
}
#endif

#endif
