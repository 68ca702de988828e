// ps: lists the kernel's worlds and the cartels they belong to, as a flat
// table or as one cartel tree per userspace.
//
// PsMain turns the options into a set of bits and hands it to WorldList,
// which gathers every world in one pass over the KEL tree, lays the nodes
// out in allNodes (each world followed by its zombie children), registers
// the root cartel of each userspace, links the tree when asked, prints, and
// releases everything.
#include <getopt.h>

#include <algorithm>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string_view>

#include "keltools.h"
#include "numbers.h"
#include "records.h"
#include "worlds/worldinfo.h"

namespace {

// Option bits; WorldList and the printing test them.
constexpr uint32_t kOptGid = 0x1;
constexpr uint32_t kOptPcid = 0x2;
constexpr uint32_t kOptType = 0x4;
constexpr uint32_t kOptState = 0x8;
constexpr uint32_t kOptTime = 0x10;
constexpr uint32_t kOptVerbose = 0x20;
constexpr uint32_t kOptCommand = 0x40;
constexpr uint32_t kOptUserworlds = 0x80;
constexpr uint32_t kOptSession = 0x100;
constexpr uint32_t kOptCartels = 0x200;
constexpr uint32_t kOptSecurity = 0x400;
constexpr uint32_t kOptUserspace = 0x800;
constexpr uint32_t kOptTree = 0x1000;
constexpr uint32_t kOptSummary = 0x2000;
constexpr uint32_t kOptChildren = 0x4000;
constexpr uint32_t kOptThreads = 0x8000;
constexpr uint32_t kOptZombies = 0x10000;

constexpr char kShortOptions[] = "CnNPTcghijJstuvZU::z";

constexpr option kLongOptions[] = {
   {"help", no_argument, nullptr, 'h'},
   {"tree", no_argument, nullptr, 'J'},
   {nullptr, 0, nullptr, 0},
};

struct OptionBits {
   int letter;
   uint32_t bits;
};

// The bits each option sets, in usage order.  The tree layout brings the
// userworld filter and the zombies with it.
constexpr OptionBits kOptionBits[] = {
   {'C', kOptCartels},
   {'P', kOptPcid},
   {'T', kOptTime},
   {'c', kOptCommand},
   {'g', kOptSession},
   {'i', kOptSummary},
   {'j', kOptGid},
   {'n', kOptChildren},
   {'N', kOptThreads},
   {'s', kOptState},
   {'t', kOptType},
   {'u', kOptUserworlds},
   {'U', kOptUserspace},
   {'v', kOptVerbose},
   {'Z', kOptSecurity},
   {'z', kOptZombies},
   {'J', kOptTree | kOptUserworlds | kOptZombies},
};

constexpr char kUsage[] =
   "ps\n"
   "    -C           Display only cartels\n"
   "    -P           Display PCID\n"
   "    -T           Display used time\n"
   "    -c           Display verbose command line\n"
   "    -g           Display session ID and process group\n"
   "    -i           Display summary information\n"
   "    -j           Display GID\n"
   "    -n           Display nChildren (only with --tree)\n"
   "    -N           Display nThreads  (only with --tree)\n"
   "    -s           Display state\n"
   "    -t           Display type\n"
   "    -u           Display only userworlds\n"
   "    -U [N]       Display [only] userspace ID\n"
   "    -v           Display non truncated values\n"
   "    -Z           Display the security domain\n"
   "    -z           Display zombie cartels\n"
   "    -J or --tree Display userworlds in a tree layout\n";

struct TypeName {
   uint32_t bit;
   const char *longName;
   char letter;
};

constexpr TypeName kTypeNames[] = {
   {0x1, "System", 'S'}, {0x2, "Idle", 'I'},   {0x4, "User", 'U'},  {0x8, "VMM", 'V'},
   {0x10, "Helper", 'H'}, {0x20, "Clone", 'X'}, {0x40, "Test", 'T'}, {0x100, "Assistant", 'A'},
};

// World type bit of a clone world: it counts as a thread of its parent.
constexpr uint32_t kCloneWorld = 0x20;

// Userspace IDs with a root table entry run from 1 to this.
constexpr uint32_t kMaxUserspace = 127;

// Trees are drawn this many levels deep at most, so that a damaged tree
// (a chain of a million cartels) cannot exhaust the stack or flood the
// terminal with indentation.
constexpr int kMaxTreeDepth = 1024;

// Record sizes and the offsets read from them:
//
//   scheduler summary (248):  4 run-state number u32, 8 wait-state number u32
//   affinity (2304):          0 a text, printed in the CPU column
//   state times (120):        8 used time u64, microseconds
//   cartel child (28):        4 child state u32 (1: zombie)
constexpr uint32_t kSummarySize = 248;
constexpr size_t kRunState = 4;
constexpr size_t kWaitState = 8;
constexpr uint32_t kAffinitySize = 2304;
constexpr uint32_t kStateTimesSize = 120;
constexpr size_t kUsedTime = 8;
constexpr uint32_t kChildSize = 28;
constexpr size_t kChildState = 4;
constexpr uint32_t kChildZombie = 1;

struct FreeDeleter {
   void operator()(void *p) const { std::free(p); }
};
template <class T>
using MallocPtr = std::unique_ptr<T[], FreeDeleter>;

// A text kept in the text pool.
struct TextRef {
   size_t offset;
   uint32_t length;
};

// Names, affinities and command lines of all nodes, back to back in one
// buffer, so that a node stays small however long its texts are.
struct TextPool {
   MallocPtr<char> bytes;
   size_t used = 0;
   size_t room = 0;

   bool Add(std::string_view text, TextRef *ref) {
      if (text.size() > room - used) {
         size_t want = std::max(used + text.size(), 2 * room + 4096);
         void *grown = std::realloc(bytes.get(), want);
         if (grown == nullptr) return false;
         (void)bytes.release();
         bytes.reset(static_cast<char *>(grown));
         room = want;
      }
      if (!text.empty()) std::memcpy(bytes.get() + used, text.data(), text.size());
      *ref = {used, uint32_t(text.size())};
      used += text.size();
      return true;
   }

   std::string_view Get(TextRef ref) const {
      return ref.length == 0 ? std::string_view() : std::string_view(bytes.get() + ref.offset, ref.length);
   }
};

// One row: a kept world, or a zombie child of a cartel.  Links are indexes
// into allNodes, -1 for none.
struct WorldNode {
   bool schedValid;
   bool isZombie;
   uint8_t info[worldinfo::kSize];
   TextRef name;
   TextRef affinity;
   TextRef cmdline;
   uint32_t runState;
   uint32_t waitState;
   uint64_t usedTime;
   int32_t nChildren;
   int32_t nThreads;
   int32_t printedChildren;
   int32_t parent;
   int32_t firstChild;
   int32_t lastChild;
   int32_t nextSibling;
   // This world's zombies: zombieCount entries of the zombie array from zombieFirst.
   uint32_t zombieFirst;
   int32_t zombieCount;
   // Userspace of the tree that last drew this node, so a cycle is drawn once.
   uint32_t drawnInTree;
};

WorldNode NewNode() {
   WorldNode n{};
   n.parent = n.firstChild = n.lastChild = n.nextSibling = -1;
   return n;
}

uint32_t WorldId(const WorldNode &n) { return ReadU32(n.info, worldinfo::kWorldId); }
uint32_t CartelId(const WorldNode &n) { return ReadU32(n.info, worldinfo::kCartelId); }
uint32_t ParentCartelId(const WorldNode &n) { return ReadU32(n.info, worldinfo::kParentCartelId); }
uint32_t UserspaceId(const WorldNode &n) { return ReadU32(n.info, worldinfo::kUserspaceId); }
uint32_t TypeBits(const WorldNode &n) { return ReadU32(n.info, worldinfo::kTypeBits); }

void StoreU32(uint8_t *rec, size_t off, uint32_t value) {
   for (int i = 0; i < 4; i++) rec[off + i] = uint8_t(value >> (8 * i));
}

// Everything WorldList gathers, and what the printing adds to it.
struct Gathering {
   uint32_t options = 0;
   uint32_t requestedUserspace = 0;
   TextPool texts;
   MallocPtr<WorldNode> gathered;
   MallocPtr<WorldNode> zombies;
   uint32_t zombieRoom = 0;
   MallocPtr<WorldNode> allNodes;
   uint32_t allCount = 0;
   int32_t roots[kMaxUserspace + 1];
   KEL_Status latest = KEL_STATUS_OK;
   int totalWorlds = 0;
   int keptWorlds = 0;
   int zombiesFound = 0;
   uint32_t largestWorldId = 0;
   uint32_t longestName = 0;
   // Printing.
   int idWidth = 1;
   int deepest = 0;
   bool treeCut = false;
};

bool OutOfMemory() {
   std::fputs("WorldList: Not enough memory\n", stderr);
   return false;
}

// --- Gathering -------------------------------------------------------------

// Makes room in the zombie array for count more zombies.
bool ReserveZombies(Gathering &g, uint32_t count) {
   uint32_t used = uint32_t(g.zombiesFound);
   if (count <= g.zombieRoom - used) return true;
   size_t want = std::max<size_t>(size_t(used) + count, 2 * size_t(g.zombieRoom));
   if (want > UINT32_MAX || want > SIZE_MAX / sizeof(WorldNode)) return false;
   void *grown = std::realloc(g.zombies.get(), want * sizeof(WorldNode));
   if (grown == nullptr) return false;
   (void)g.zombies.release();
   g.zombies.reset(static_cast<WorldNode *>(grown));
   g.zombieRoom = uint32_t(want);
   return true;
}

// Reads the children of cartel C and keeps those that are zombies as nodes
// of world w, when w is the cartel's main world.  Every world of the cartel
// reads the children; only the main world records them.
bool GatherZombies(Gathering &g, WorldNode &w, uint32_t cartel) {
   ParamListPtr childKeys(KEL_ParamListCreate(1, 1));
   if (!childKeys) {
      std::fputs("failed to alloc paramlist for children\n", stderr);
      return false;
   }
   if (KEL_ParamListAddInt(childKeys.get(), cartel) != KEL_STATUS_OK) {
      std::fputs("failed to add int to child param list\n", stderr);
      return false;
   }
   KEL_ParamList *listed = nullptr;
   g.latest = GetInstanceList(KEL_NODE_userworld_cartel_child, childKeys.get(), &listed);
   // A failed listing yields no children.
   ParamListPtr children(g.latest == KEL_STATUS_OK ? listed : nullptr);
   childKeys.reset();

   uint32_t count = KEL_ParamListUsedCount(children.get());
   if (count > 0 && !ReserveZombies(g, count)) {
      std::fputs("failed to allocate array for zombies\n", stderr);
      return false;
   }
   w.zombieFirst = uint32_t(g.zombiesFound);
   bool mainWorld = cartel == WorldId(w);
   for (uint32_t i = 0; i < count; i++) {
      int32_t childId;
      if (KEL_ParamListGetInt32(children.get(), i, &childId) != KEL_STATUS_OK) {
         std::fputs("failed to get child ID\n", stderr);
         return false;
      }
      ParamListPtr keys(KEL_ParamListCreate(1, 1));
      if (!keys) {
         std::fputs("failed to create children list\n", stderr);
         return false;
      }
      if (KEL_ParamListAddInt(keys.get(), cartel) != KEL_STATUS_OK) {
         std::fputs("failed to add cartel ID to list\n", stderr);
         return false;
      }
      if (KEL_ParamListAddInt(keys.get(), uint64_t(int64_t(childId))) != KEL_STATUS_OK) {
         std::fputs("failed to add child ID to list\n", stderr);
         return false;
      }
      uint8_t child[kChildSize];
      KEL_Status status = KEL_Get(KEL_NODE_userworld_cartel_child, keys.get(), child, sizeof child);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "failed to get child info for child %d, status %s\n", childId,
                      ORX_ReturnStatusToString(status));
         return false;
      }
      if (ReadU32(child, kChildState) != kChildZombie || !mainWorld) continue;
      WorldNode z = NewNode();
      z.isZombie = true;
      StoreU32(z.info, worldinfo::kWorldId, uint32_t(childId));
      StoreU32(z.info, worldinfo::kCartelId, uint32_t(childId));
      StoreU32(z.info, worldinfo::kParentCartelId, cartel);
      std::memcpy(z.info + worldinfo::kUserspaceId, w.info + worldinfo::kUserspaceId, 4);
      std::memcpy(z.info + worldinfo::kProcessGroupId, w.info + worldinfo::kProcessGroupId, 4);
      std::memcpy(z.info + worldinfo::kSessionId, w.info + worldinfo::kSessionId, 4);
      g.zombies[g.zombiesFound++] = z;
      w.zombieCount++;
   }
   return true;
}

enum class Gathered { Kept, Skipped, Failed };

// Reads the world whose key is on the key list into n.
Gathered ReadWorld(Gathering &g, KEL_ParamList *keys, WorldNode &n) {
   uint8_t name[kWorldNameSize];
   if (KEL_Get(KEL_NODE_world_name, keys, name, sizeof name) != KEL_STATUS_OK ||
       KEL_Get(KEL_NODE_world_info, keys, n.info, sizeof n.info) != KEL_STATUS_OK)
      return Gathered::Skipped;

   uint8_t summary[kSummarySize], affinity[kAffinitySize], times[kStateTimesSize];
   if (KEL_Get(KEL_NODE_sched_Vcpus_stats_summaryStats, keys, summary, sizeof summary) == KEL_STATUS_OK &&
       KEL_Get(KEL_NODE_sched_Vcpus_stats_affinity, keys, affinity, sizeof affinity) == KEL_STATUS_OK) {
      if (KEL_Get(KEL_NODE_sched_Vcpus_stats_stateTimes, keys, times, sizeof times) != KEL_STATUS_OK)
         return Gathered::Skipped;
      n.schedValid = true;
   }

   uint32_t cartel = CartelId(n);
   if ((g.options & kOptUserworlds) && cartel == 0) return Gathered::Skipped;

   std::string_view nameText = ReadText(name, 0, sizeof name);
   g.longestName = std::max(g.longestName, uint32_t(nameText.size()));
   g.largestWorldId = std::max(g.largestWorldId, WorldId(n));
   if (n.schedValid) {
      n.runState = ReadU32(summary, kRunState);
      n.waitState = ReadU32(summary, kWaitState);
      n.usedTime = ReadU64(times, kUsedTime);
   }
   if (!g.texts.Add(nameText, &n.name) ||
       (n.schedValid && !g.texts.Add(ReadText(affinity, 0, sizeof affinity), &n.affinity))) {
      OutOfMemory();
      return Gathered::Failed;
   }

   if (cartel != 0) {
      // The command line is read under the cartel ID in place of the world key.
      KEL_ParamListRemoveLastParam(keys);
      KEL_Status status = KEL_ParamListAddInt(keys, cartel);
      uint8_t cmdline[kCmdlineSize];
      if (status == KEL_STATUS_OK)
         status = KEL_Get(KEL_NODE_userworld_cartel_cmdline, keys, cmdline, sizeof cmdline);
      g.latest = status;
      std::string_view text =
         status == KEL_STATUS_OK ? ReadText(cmdline, 0, sizeof cmdline) : std::string_view("<unavailable>");
      if (!g.texts.Add(text, &n.cmdline)) {
         OutOfMemory();
         return Gathered::Failed;
      }
      if ((g.options & kOptZombies) && !GatherZombies(g, n, cartel)) return Gathered::Failed;
   }
   return Gathered::Kept;
}

// Lays out allNodes (each kept world followed by its zombies) and registers
// the root cartel of every userspace.
bool BuildAllNodes(Gathering &g) {
   size_t count = size_t(g.keptWorlds) + size_t(g.zombiesFound);
   g.allNodes.reset(static_cast<WorldNode *>(std::calloc(std::max<size_t>(count, 1), sizeof(WorldNode))));
   if (!g.allNodes) {
      std::fputs("WorldList: malloc failed when allocating allNodes list\n", stderr);
      return false;
   }
   std::fill(std::begin(g.roots), std::end(g.roots), -1);
   uint32_t n = 0;
   for (int i = 0; i < g.keptWorlds; i++) {
      const WorldNode &w = g.gathered[i];
      g.allNodes[n] = w;
      uint32_t userspace = UserspaceId(w);
      if (userspace != 0 && ParentCartelId(w) == 0) {
         if (userspace > kMaxUserspace)
            std::fputs("Warning: maximum number of userspaces reached...\n", stderr);
         else
            g.roots[userspace] = int32_t(n);
      }
      n++;
      for (int z = 0; z < w.zombieCount; z++) g.allNodes[n++] = g.zombies[w.zombieFirst + z];
   }
   g.allCount = n;
   return true;
}

struct ParentEntry {
   uint32_t worldId;
   int32_t index;
};

// Links every cartel node under the first node in allNodes whose cartel ID
// is not 0 and whose world ID is the node's parent cartel ID.  Those
// candidates are sorted by world ID and then position, so a binary search
// finds that first node.
bool LinkTree(Gathering &g) {
   WorldNode *nodes = g.allNodes.get();
   MallocPtr<ParentEntry> parents(
      static_cast<ParentEntry *>(std::calloc(std::max<size_t>(g.allCount, 1), sizeof(ParentEntry))));
   if (!parents) return OutOfMemory();
   uint32_t candidates = 0;
   for (uint32_t i = 0; i < g.allCount; i++)
      if (CartelId(nodes[i]) != 0) parents[candidates++] = {WorldId(nodes[i]), int32_t(i)};
   auto byWorldThenIndex = [](const ParentEntry &a, const ParentEntry &b) {
      return a.worldId != b.worldId ? a.worldId < b.worldId : a.index < b.index;
   };
   ParentEntry *begin = parents.get(), *end = parents.get() + candidates;
   std::sort(begin, end, byWorldThenIndex);

   for (uint32_t i = 0; i < g.allCount; i++) {
      WorldNode &child = nodes[i];
      if (CartelId(child) == 0) continue;
      ParentEntry *p = std::lower_bound(begin, end, ParentEntry{ParentCartelId(child), -1}, byWorldThenIndex);
      if (p == end || p->worldId != ParentCartelId(child)) continue;
      WorldNode &parent = nodes[p->index];
      if (parent.firstChild < 0)
         parent.firstChild = int32_t(i);
      else
         nodes[parent.lastChild].nextSibling = int32_t(i);
      parent.lastChild = int32_t(i);
      parent.nChildren++;
      child.parent = p->index;
      if (TypeBits(child) & kCloneWorld) parent.nThreads++;
   }
   return true;
}

// --- Printing --------------------------------------------------------------

// Prints a formatted text followed by spaces up to width characters; a
// longer text is printed whole.
__attribute__((format(printf, 2, 3))) void PrintPadded(int width, const char *fmt, ...) {
   char text[64];
   va_list ap;
   va_start(ap, fmt);
   std::vsnprintf(text, sizeof text, fmt, ap);
   va_end(ap);
   std::printf("%-*s", std::max(width, 0), text);
}

void PrintPsHeader(const Gathering &g) {
   uint32_t o = g.options;
   int w = g.idWidth, m = int(g.longestName);
   if (o & kOptTree) std::fputs("  ", stdout);
   std::printf("%-*s", w, "WID");
   std::printf("%-*s", w + 2, "  CID");
   std::printf("%-*s", m + 2, "  WorldName");
   if (o & kOptChildren) std::fputs("  nChildren", stdout);
   if (o & kOptThreads) std::fputs("  nThreads", stdout);
   if (o & kOptGid) std::printf("%-*s", w + 1, "  GID");
   if (o & kOptSession) {
      std::printf("%-*s", w + 1, "  PGID");
      std::printf("%-*s", w + 1, "  SID");
   }
   if (o & kOptPcid) std::printf("%-*s", w + 2, "  PCID");
   if (o & kOptType) std::fputs("  Type  ", stdout);
   if (o & kOptState) std::fputs("  State   Wait    CPU ", stdout);
   if (o & kOptTime) std::fputs("  Time        ", stdout);
   if (o & kOptSecurity) std::fputs("  SecurityDomain", stdout);
   if (o & kOptUserspace) std::fputs("  UserSpace", stdout);
   if (o & kOptCommand) std::fputs("  Command", stdout);
   std::fputs("\n", stdout);
}

// The Type column: letters (or long names with -v) of the set bits, lowest
// first; a bit without a name, or no bit at all, ends the walk with "Invalid".
void PrintType(uint32_t options, uint32_t bits) {
   bool verbose = options & kOptVerbose;
   int letters = 0;
   std::fputs("  ", stdout);
   if (bits == 0) std::fputs("Invalid", stdout);
   for (uint32_t rest = bits; rest != 0;) {
      uint32_t bit = rest & (~rest + 1);
      rest &= rest - 1;
      const TypeName *name = nullptr;
      for (const TypeName &t : kTypeNames)
         if (t.bit == bit) name = &t;
      if (name == nullptr) {
         std::fputs("Invalid", stdout);
         break;
      }
      letters++;
      if (!verbose) {
         std::putchar(name->letter);
         continue;
      }
      std::fputs(name->longName, stdout);
      if (rest != 0) std::putchar(',');
   }
   if (verbose)
      std::fputs("  ", stdout);
   else
      std::printf("%*s", std::max(6 - letters, 0), "");
}

// A state name from the platform's table; a number beyond it has none.
const char *StateName(const CpuSched_StateElement *table, uint32_t count, uint32_t state) {
   return state < count && table[state].name != nullptr ? table[state].name : "";
}

// One row.  The row's ID paddings differ from the header's on purpose, and
// a column whose condition fails prints nothing, so later columns shift
// left on zombie rows and on rows without scheduler data.
void PrintPsRow(const Gathering &g, const WorldNode &n) {
   uint32_t o = g.options;
   int w = g.idWidth, m = int(g.longestName);
   bool zombie = n.isZombie;
   uint32_t cartel = CartelId(n);
   PrintPadded(w, "%d", int32_t(WorldId(n)));
   if (cartel == 0)
      std::printf("%-*s", w + 2, "  0");
   else
      PrintPadded(w, "  %d", int32_t(cartel));
   if (zombie) {
      std::printf("%-*s", m + 2, "  <zombie>");
   } else {
      std::string_view name = g.texts.Get(n.name);
      std::printf("  %-*.*s", m, int(name.size()), name.data());
   }
   if ((o & kOptChildren) && (o & kOptTree) && !zombie) std::printf("  %-9d", n.nChildren);
   if ((o & kOptThreads) && (o & kOptTree) && !zombie) std::printf("  %-8d", n.nThreads);
   if ((o & kOptGid) && !zombie) PrintPadded(w, "  %d", ReadI32(n.info, worldinfo::kGroupId));
   if (o & kOptSession) {
      if (cartel == 0) {
         std::printf("%-*s", w, "  0");
         std::printf("%-*s", w, "  0");
      } else {
         PrintPadded(w - 2, "  %d", ReadI32(n.info, worldinfo::kProcessGroupId));
         PrintPadded(w - 2, "  %d", ReadI32(n.info, worldinfo::kSessionId));
      }
   }
   if (o & kOptPcid) PrintPadded(w + 2, "  %d", int32_t(ParentCartelId(n)));
   if ((o & kOptType) && !zombie) PrintType(o, TypeBits(n));
   if (o & kOptState) {
      if (zombie || !n.schedValid) {
         std::fputs("                  ", stdout);
      } else {
         std::string_view cpu = g.texts.Get(n.affinity);
         std::printf("  %-6.6s", StateName(CpuSched_RunStateElements, CpuSched_NumRunStates, n.runState));
         std::printf("  %-6.6s", StateName(CpuSched_WaitStateElements, CpuSched_NumWaitStates, n.waitState));
         std::printf("  %-4.*s", int(cpu.size()), cpu.data());
      }
   }
   if ((o & kOptTime) && !zombie && n.schedValid)
      std::printf("  %5llu.%-6llu", static_cast<unsigned long long>(n.usedTime / 1000000),
                  static_cast<unsigned long long>(n.usedTime % 1000000));
   if ((o & kOptSecurity) && !zombie) std::printf("  %-14d", ReadI32(n.info, worldinfo::kSecurityDomain));
   if ((o & kOptUserspace) && !zombie) std::printf("  %-9d", int32_t(UserspaceId(n)));
   if ((o & kOptCommand) && cartel != 0 && !zombie) {
      std::string_view cmd = g.texts.Get(n.cmdline);
      std::printf("  %.*s", int(cmd.size()), cmd.data());
   }
   std::fputs("\n", stdout);
}

// A glyph of the DEC Special Graphics set, shifted in and out around it.
void Glyph(char letter) { std::printf("%c%c%c", 14, letter, 15); }

// The tree being drawn: the path from its root to the node being drawn.
struct TreeDrawing {
   Gathering &g;
   uint32_t userspace;
   int32_t path[kMaxTreeDepth];
};

// Draws one node and, depth first, its children.  The path holds the node's
// ancestors, so the drawing never follows parent links upwards; a child
// already drawn in this tree (a cycle in a damaged tree) is not drawn again.
void PrintPsTree(TreeDrawing &d, int32_t index, int depth) {
   WorldNode *nodes = d.g.allNodes.get();
   WorldNode &n = nodes[index];
   n.drawnInTree = d.userspace;
   d.g.deepest = std::max(d.g.deepest, depth);
   WorldNode *parent = depth > 0 ? &nodes[d.path[depth - 1]] : nullptr;
   if (depth == 0) std::printf("%d\n", int32_t(UserspaceId(n)));
   if (parent != nullptr) {
      std::fputs("  ", stdout);
      // One column per ancestor below the root: a line while the
      // ancestor's parent still has children to draw.
      for (int i = 1; i < depth; i++) {
         const WorldNode &above = nodes[d.path[i - 1]];
         if (above.nChildren > 1 && above.nChildren != above.printedChildren) {
            Glyph('x');
            std::putchar(' ');
         } else {
            std::fputs("  ", stdout);
         }
      }
   }
   bool last = n.nextSibling < 0 || parent == nullptr || parent->nChildren <= 1;
   Glyph(last ? 'm' : 't');
   Glyph('q');
   PrintPsRow(d.g, n);
   if (parent != nullptr) parent->printedChildren++;
   if (n.firstChild < 0) return;
   if (depth + 1 >= kMaxTreeDepth) {
      d.g.treeCut = true;
      return;
   }
   d.path[depth] = index;
   for (int32_t c = n.firstChild; c >= 0; c = nodes[c].nextSibling) {
      if (nodes[c].drawnInTree == d.userspace)
         n.printedChildren++;
      else
         PrintPsTree(d, c, depth + 1);
   }
}

// Tells which userspaces are running when the requested one is not.
void ReportNotRunning(const Gathering &g) {
   std::fprintf(stderr, "Requested userspace (%d) is not running.\n", int32_t(g.requestedUserspace));
   std::fputs("Available userspaces:\n ", stderr);
   for (uint32_t k = 1; k <= kMaxUserspace; k++) {
      if (g.roots[k] < 0) continue;
      std::fprintf(stderr, "%3d ", int(k));
      if (k > 1 && (k - 1) % 10 == 0) std::fputs("\n", stderr);
   }
   std::fputs("\n", stderr);
}

// Prints the table or the trees and the summary; false when the requested
// userspace is not running or a tree was too deep to draw whole.
bool PrintWorlds(Gathering &g) {
   uint32_t o = g.options;
   uint32_t wanted = g.requestedUserspace;
   if ((o & kOptUserspace) && wanted != 0 && (wanted > kMaxUserspace || g.roots[wanted] < 0)) {
      ReportNotRunning(g);
      return false;
   }
   g.idWidth = std::snprintf(nullptr, 0, "%d", int32_t(g.largestWorldId));

   if (!(o & kOptTree)) {
      PrintPsHeader(g);
      for (uint32_t i = 0; i < g.allCount; i++) {
         const WorldNode &n = g.allNodes[i];
         if ((o & kOptUserworlds) && CartelId(n) == 0) continue;
         if (wanted != 0 && UserspaceId(n) != wanted) continue;
         PrintPsRow(g, n);
      }
      std::fputs("\n", stdout);
   } else {
      std::printf("%c)0\n", 27);
      TreeDrawing drawing{g, 0, {}};
      for (uint32_t k = 1; k <= kMaxUserspace; k++) {
         if (g.roots[k] < 0 || (wanted != 0 && k != wanted)) continue;
         PrintPsHeader(g);
         drawing.userspace = k;
         PrintPsTree(drawing, g.roots[k], 0);
         std::fputs("\n", stdout);
      }
   }

   if (o & kOptSummary) {
      int userspaces = int(std::count_if(std::begin(g.roots) + 1, std::end(g.roots), [](int32_t r) { return r >= 0; }));
      std::printf("Total worlds:         %d\n", g.totalWorlds);
      std::printf("Total printed worlds: %d\n", g.keptWorlds);
      if (o & kOptTree) std::printf("Deepest child:        %d\n", g.deepest + 1);
      if (o & kOptZombies) std::printf("Zombie worlds:        %d\n", g.zombiesFound);
      std::printf("Total userspaces:     %d\n", userspaces);
   }
   if (g.treeCut) {
      std::fflush(stdout);
      std::fprintf(stderr, "ps: cartel trees deeper than %d levels are cut\n", kMaxTreeDepth);
      return false;
   }
   return true;
}

// Gathers the worlds, prints them and releases everything.  True when the
// latest KEL status is 0 and the printing went through.
bool WorldList(uint32_t options, uint32_t requestedUserspace) {
   Gathering g;
   g.options = options;
   g.requestedUserspace = requestedUserspace;

   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) return OutOfMemory();
   ParamListPtr worlds;
   KEL_Node listNode = (options & kOptCartels) ? KEL_NODE_userworld_cartel : KEL_NODE_world;
   g.latest = GetInstanceList(listNode, nullptr, &worlds);
   if (g.latest != KEL_STATUS_OK) {
      std::fprintf(stderr, "WorldList: error fetching world list 0x%x\n", g.latest);
      return false;
   }

   uint32_t count = KEL_ParamListUsedCount(worlds.get());
   if (count > 0) {
      g.gathered.reset(static_cast<WorldNode *>(std::calloc(count, sizeof(WorldNode))));
      if (!g.gathered) {
         std::fputs("WorldList: malloc failed when allocating root tree node\n", stderr);
         return false;
      }
   }
   for (uint32_t i = 0; i < count; i++) {
      WorldNode n = NewNode();
      n.nThreads = 1;
      if (!AddParamToList(KEL_ParamListGetParam(worlds.get(), i), keys.get())) return false;
      g.totalWorlds++;
      Gathered result = ReadWorld(g, keys.get(), n);
      if (result == Gathered::Failed) return false;
      if (result == Gathered::Kept) g.gathered[g.keptWorlds++] = n;
      KEL_ParamListRemoveLastParam(keys.get());
   }

   if (!BuildAllNodes(g)) return false;
   if ((options & kOptTree) && !LinkTree(g)) return false;
   bool printed = PrintWorlds(g);
   return printed && g.latest == KEL_STATUS_OK;
}

}  // namespace

int PsMain(int argc, char **argv) {
   uint32_t options = 0;
   uint32_t requestedUserspace = 0;
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      if (c == 'h') {
         std::fputs(kUsage, stderr);
         return 0;
      }
      if (c == '?') {
         std::fputs(kUsage, stderr);
         return 1;
      }
      const OptionBits *found = nullptr;
      for (const OptionBits &b : kOptionBits)
         if (b.letter == c) found = &b;
      if (found == nullptr) {
         std::fprintf(stderr, "ps: getopt failed? (%c)\n", c);
         return 1;
      }
      options |= found->bits;
      if (c == 'U' && optarg != nullptr) requestedUserspace = StrtoulUInt32(optarg);
   }
   if (optind < argc) {
      std::fputs("ps: no non-option arguments\n", stderr);
      std::fputs(kUsage, stderr);
      return 1;
   }
   if ((options & kOptChildren) && !(options & kOptTree)) {
      std::fputs("nChildren needs --tree\n", stderr);
      return 1;
   }
   if ((options & kOptThreads) && !(options & kOptTree)) {
      std::fputs("nThreads needs --tree\n", stderr);
      return 1;
   }
   return WorldList(options, requestedUserspace) ? 0 : 1;
}
