// The KEL calls: node table, backends (none, cache file, simulator) and the
// reads, listings, sets and data calls over them.
#include <errno.h>
#include <sys/stat.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>
#include <stdexcept>

#include "cachefile.h"
#include "internal.h"
#include "nodetable.h"
#include "simulator.h"

using namespace kelplat;

#define KEL_NODE_DEF(name, number, path, size, flags) const KEL_Node KEL_NODE_##name = number;
extern "C" {
#include "kel/nodes.def"
}
#undef KEL_NODE_DEF

namespace kelplat {

namespace {

constexpr NodeInfo kNodes[] = {
#define KEL_NODE_DEF(name, number, path, size, flags) {#name, number, path, size, flags, LevelCount(path)},
#include "kel/nodes.def"
#undef KEL_NODE_DEF
};

constexpr bool NumbersFollowOrder() {
   for (size_t i = 0; i < std::size(kNodes); i++)
      if (kNodes[i].number != i + 1) return false;
   return true;
}
static_assert(NumbersFollowOrder(), "node numbers must run 1, 2, 3, ... in table order");

constexpr int HexValue(char c) {
   if (c >= '0' && c <= '9') return c - '0';
   if (c >= 'a' && c <= 'f') return c - 'a' + 10;
   return 0;
}

struct ToolSig {
   uint8_t bytes[16];
   constexpr ToolSig() : bytes{} {
      constexpr const char *hex = ORXKEL_TREE_SIGNATURE;
      for (int i = 0; i < 16; i++) bytes[i] = uint8_t(HexValue(hex[2 * i]) << 4 | HexValue(hex[2 * i + 1]));
   }
};
constexpr ToolSig kToolSig;

enum class Backend { None, Cache, Simulator };

// The tree the calls read: chosen once by KEL_UseCache or OrxSyscall_Init.
struct Tree {
   Backend backend = Backend::None;
   bool loaded = false;
   CacheReader reader;
   // The lookup key of the current call, kept so that its storage is reused.
   std::string lookup;
};

// Set up before main runs, so that a call needs no guard to reach it (no
// call is made while static objects are being set up).
Tree gTree;

Tree &TheTree() { return gTree; }

uint32_t KeyCount(const KEL_ParamList *keys) { return KEL_ParamListUsedCount(keys); }

// No exception leaves a KEL call: running out of memory inside one is its
// status.
template <class F>
KEL_Status NoThrow(F call) {
   try {
      return call();
   } catch (const std::bad_alloc &) {
      return KEL_STATUS_NO_MEMORY;
   } catch (const std::length_error &) {
      return KEL_STATUS_NO_MEMORY;
   }
}

}  // namespace

std::span<const NodeInfo> Nodes() { return kNodes; }

const NodeInfo *FindNode(KEL_Node number) {
   if (number == 0 || number > std::size(kNodes)) return nullptr;
   return &kNodes[number - 1];
}

int LevelKind(std::string_view path, unsigned level) {
   for (char c : path) {
      if (c != '#' && c != '$') continue;
      if (level-- == 0) return c == '$' ? KEL_PARAM_STRING : KEL_PARAM_INT;
   }
   return -1;
}

bool EndsWithLevel(std::string_view path) {
   return !path.empty() && (path.back() == '#' || path.back() == '$');
}

std::span<const uint8_t, 16> ToolSignature() { return std::span<const uint8_t, 16>(kToolSig.bytes); }

const char *ToolBuildDate() { return ORXKEL_BUILD_DATE; }

static uint64_t gLookups = 0;

uint64_t TreeLookupCount() { return gLookups; }

static bool TreeLookup(Op op, KEL_Node node, const KEL_ParamList *keys, CacheHit *hit, KEL_Status *status) {
   Tree &t = TheTree();
   gLookups++;
   if (!t.loaded) {
      *status = KEL_STATUS_NO_TREE;
      return false;
   }
   bool encoded = false;
   *status = NoThrow([&] {
      encoded = AppendParamLookup(t.lookup, op, node, keys);
      return KEL_STATUS_OK;
   });
   if (*status != KEL_STATUS_OK) return false;
   if (!encoded) {
      *status = KEL_STATUS_BAD_PARAM;
      return false;
   }
   *status = t.reader.Lookup(t.lookup, hit);
   return *status == KEL_STATUS_OK;
}

void CopyRecord(std::string_view stored, void *buf, uint32_t size) {
   size_t n = std::min<size_t>(stored.size(), size);
   if (n > 0) std::memcpy(buf, stored.data(), n);
   if (n < size) std::memset(static_cast<char *>(buf) + n, 0, size - n);
}

std::optional<std::string_view> TreeMeta(std::string_view name) {
   Tree &t = TheTree();
   if (!t.loaded) return std::nullopt;
   Key key{KEL_PARAM_STRING, 0, std::string(name)};
   CacheHit hit;
   if (t.reader.Lookup(EncodeLookup(Op::Meta, 0, std::span<const Key>(&key, 1)), &hit) != KEL_STATUS_OK ||
       hit.status != KEL_STATUS_OK)
      return std::nullopt;
   return hit.data;
}

bool InSimulator() { return TheTree().backend == Backend::Simulator; }

const char *SimulatorPath() {
   const char *path = std::getenv("ORXKEL_SIMULATOR");
   return path != nullptr && *path != '\0' ? path : nullptr;
}

// A listing payload (a count, then the keys) as a new parameter list.
static KEL_Status ListFromStored(std::string_view bytes, KEL_ParamList **list) {
   const auto *p = reinterpret_cast<const uint8_t *>(bytes.data());
   if (bytes.size() < 4) return KEL_STATUS_CACHE_CORRUPT;
   uint32_t count = LoadU32(p);
   // Each key takes at least 5 bytes (an empty text): a larger count is damage.
   if (count > (bytes.size() - 4) / 5) return KEL_STATUS_CACHE_CORRUPT;
   KEL_ParamList *out = KEL_ParamListCreate(1, int(std::min<uint32_t>(count, 1 << 20)));
   if (out == nullptr) return KEL_STATUS_NO_MEMORY;
   size_t at = 4;
   KEL_Status status = KEL_STATUS_OK;
   for (uint32_t i = 0; i < count && status == KEL_STATUS_OK; i++) {
      if (at >= bytes.size()) {
         status = KEL_STATUS_CACHE_CORRUPT;
         break;
      }
      uint32_t kind = p[at++];
      if (kind == KEL_PARAM_STRING) {
         if (bytes.size() - at < 4 || bytes.size() - at - 4 < LoadU32(p + at)) {
            status = KEL_STATUS_CACHE_CORRUPT;
            break;
         }
         uint32_t len = LoadU32(p + at);
         status = ParamListAppend(out, kind, 0, bytes.data() + at + 4, len);
         at += 4 + size_t(len);
      } else {
         if (bytes.size() - at < 8) {
            status = KEL_STATUS_CACHE_CORRUPT;
            break;
         }
         status = ParamListAppend(out, kind, LoadU64(p + at), nullptr, 0);
         at += 8;
      }
   }
   if (status == KEL_STATUS_OK && at != bytes.size()) status = KEL_STATUS_CACHE_CORRUPT;
   if (status != KEL_STATUS_OK) {
      KEL_ParamListDestroy(out);
      return status;
   }
   *list = out;
   return KEL_STATUS_OK;
}

}  // namespace kelplat

extern "C" {

int HostType_OSIsORX(void) { return 0; }

int HostType_OSIsSimulator(void) { return SimulatorPath() != nullptr; }

int OrxSyscall_Init(int channel, int flags, int reserved) {
   (void)channel;
   (void)flags;
   (void)reserved;
   Tree &t = TheTree();
   const char *path = SimulatorPath();
   if (path == nullptr) return -1;
   t.backend = Backend::Simulator;
   KEL_Status status = NoThrow([&] { return t.reader.Open(path, kCacheQuickOpen); });
   t.loaded = status == KEL_STATUS_OK;
   // The signature check that follows can only say "unavailable": this line
   // says which file and why.
   if (!t.loaded)
      std::fprintf(stderr, "Couldn't load simulator snapshot %s: %s\n", path, ORX_ReturnStatusToString(status));
   return t.loaded ? 0 : -1;
}

KEL_Status KEL_UseCache(const char *path, int flags) {
   Tree &t = TheTree();
   if (path == nullptr) return KEL_STATUS_BAD_PARAM;
   KEL_Status status = NoThrow([&] { return t.reader.Open(path, flags | kCacheQuickOpen); });
   t.loaded = status == KEL_STATUS_OK;
   t.backend = t.loaded ? Backend::Cache : Backend::None;
   return status;
}

int KEL_CheckSig(char *buf, size_t len, const char **mine) {
   Tree &t = TheTree();
   if (mine != nullptr) *mine = ToolBuildDate();
   char stored[kBuildDateMax + 1] = "";
   std::string_view date;
   int mismatch = 0;
   if (t.loaded) {
      std::string_view raw = t.reader.Bytes().substr(32, kBuildDateMax);
      raw = raw.substr(0, std::min(raw.find('\0'), raw.size()));
      if (!raw.empty()) std::memcpy(stored, raw.data(), raw.size());
      date = {stored, raw.size()};
      mismatch = !std::equal(ToolSignature().begin(), ToolSignature().end(), t.reader.Signature().begin());
   } else if (t.backend == Backend::Simulator) {
      // A simulator whose snapshot cannot be read has no kernel to match.
      date = "unavailable";
      mismatch = 1;
   }
   if (buf != nullptr && len > 0) {
      size_t n = std::min(date.size(), len - 1);
      if (n > 0) std::memcpy(buf, date.data(), n);
      buf[n] = '\0';
   }
   return mismatch;
}

KEL_Status KEL_Get(KEL_Node node, const KEL_ParamList *keys, void *buf, uint32_t size) {
   const NodeInfo *info = FindNode(node);
   if (info == nullptr) return KEL_STATUS_INVALID_NODE;
   if (buf == nullptr && size > 0) return KEL_STATUS_BAD_PARAM;
   if (KeyCount(keys) != info->levels) return KEL_STATUS_BAD_KEY_COUNT;
   KEL_Status status;
   if (InSimulator()) {
      bool answered = false;
      KEL_Status thrown = NoThrow([&] {
         answered = SimulatorClock(*info, buf, size, &status);
         return KEL_STATUS_OK;
      });
      if (thrown != KEL_STATUS_OK) return thrown;
      if (answered) return status;
   }
   CacheHit hit;
   if (!TreeLookup(Op::Get, node, keys, &hit, &status)) {
      // A record stored in the snapshot wins; the simulator answers the rest.
      if (status == KEL_STATUS_NOT_FOUND && InSimulator()) return NoThrow([&] { return SimulatorInodeStats(*info, keys, buf, size); });
      return status;
   }
   if (hit.status != KEL_STATUS_OK) return hit.status;
   CopyRecord(hit.data, buf, size);
   return KEL_STATUS_OK;
}

KEL_Status KEL_Set(KEL_Node node, const KEL_ParamList *keys, const KEL_ParamList *input, void *buf,
                   uint32_t size) {
   const NodeInfo *info = FindNode(node);
   if (info == nullptr) return KEL_STATUS_INVALID_NODE;
   if (KeyCount(keys) != info->levels) return KEL_STATUS_BAD_KEY_COUNT;
   if (!(info->flags & KEL_NF_SET)) return KEL_STATUS_NOT_SUPPORTED;
   // A stored answer wins, so that a snapshot can make any set fail.
   KEL_Status status;
   CacheHit hit;
   if (TreeLookup(Op::Set, node, keys, &hit, &status)) return hit.status;
   if (status != KEL_STATUS_NOT_FOUND) return status;
   if (!InSimulator()) return KEL_STATUS_READ_ONLY;
   return NoThrow([&] { return SimulatorSet(*info, input, buf, size); });
}

KEL_Status KEL_GetInstanceListAlloc(KEL_Node node, const KEL_ParamList *keys, KEL_ParamList **list) {
   const NodeInfo *info = FindNode(node);
   if (info == nullptr) return KEL_STATUS_INVALID_NODE;
   if (list == nullptr) return KEL_STATUS_BAD_PARAM;
   if (!EndsWithLevel(info->path)) return KEL_STATUS_NOT_A_LIST;
   if (KeyCount(keys) + 1 != info->levels) return KEL_STATUS_BAD_KEY_COUNT;
   KEL_Status status;
   CacheHit hit;
   if (!TreeLookup(Op::List, node, keys, &hit, &status)) return status;
   if (hit.status != KEL_STATUS_OK) return hit.status;
   return NoThrow([&] { return ListFromStored(hit.data, list); });
}

KEL_Status KEL_GetInstanceListAllocHint(KEL_Node node, const KEL_ParamList *keys, uint32_t hint,
                                        KEL_ParamList **list) {
   (void)hint;
   return KEL_GetInstanceListAlloc(node, keys, list);
}

// Splits a stored data entry into its read status, chunk limit and content.
static KEL_Status LookupData(KEL_Node node, const KEL_ParamList *keys, uint32_t *readStatus,
                             uint32_t *chunkLimit, std::string_view *content) {
   const NodeInfo *info = FindNode(node);
   if (info == nullptr) return KEL_STATUS_INVALID_NODE;
   if (!(info->flags & KEL_NF_DATA)) return KEL_STATUS_NOT_SUPPORTED;
   if (KeyCount(keys) != info->levels) return KEL_STATUS_BAD_KEY_COUNT;
   KEL_Status status;
   CacheHit hit;
   if (!TreeLookup(Op::Data, node, keys, &hit, &status)) return status;
   if (hit.status != KEL_STATUS_OK) return hit.status;
   if (hit.data.size() < 8) return KEL_STATUS_CACHE_CORRUPT;
   const auto *p = reinterpret_cast<const uint8_t *>(hit.data.data());
   *readStatus = LoadU32(p);
   *chunkLimit = LoadU32(p + 4);
   *content = hit.data.substr(8);
   return KEL_STATUS_OK;
}

KEL_Status KEL_GetDataLength(KEL_Node node, const KEL_ParamList *keys, uint32_t *length) {
   uint32_t readStatus, chunkLimit;
   std::string_view content;
   if (length == nullptr) return KEL_STATUS_BAD_PARAM;
   KEL_Status status = LookupData(node, keys, &readStatus, &chunkLimit, &content);
   if (status == KEL_STATUS_OK) *length = uint32_t(content.size());
   return status;
}

KEL_Status KEL_SetData(KEL_Node node, const KEL_ParamList *keys, const KELData *in, KELData *out) {
   uint32_t readStatus, chunkLimit;
   std::string_view content;
   if (in == nullptr || out == nullptr || in->length < 8) return KEL_STATUS_BAD_PARAM;
   KEL_Status status = LookupData(node, keys, &readStatus, &chunkLimit, &content);
   if (status != KEL_STATUS_OK) return status;
   if (readStatus != KEL_STATUS_OK) return readStatus;
   // The input is a chunk request: the offset of the first byte and the count wanted.
   uint32_t offset = LoadU32(in->bytes), want = LoadU32(in->bytes + 4);
   size_t n = offset < content.size() ? content.size() - offset : 0;
   n = std::min<size_t>({n, want, out->capacity});
   n = std::min<size_t>(n, chunkLimit);
   if (n > 0) std::memcpy(out->bytes, content.data() + offset, n);
   out->length = uint32_t(n);
   return KEL_STATUS_OK;
}

int OrxFs_Lstat(const char *path, struct stat *st) {
   if (!InSimulator()) return lstat(path, st);
   try {
      return SimulatorLstat(path, st);
   } catch (const std::exception &) {  // out of memory, as lstat reports it
      errno = ENOMEM;
      return -1;
   }
}

}  // extern "C"
