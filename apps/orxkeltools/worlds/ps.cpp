// ps: lists the kernel's worlds and the cartels they belong to, as a flat
// table or as one cartel tree per userspace.
//
// PsMain turns the options into a set of bits and hands it to WorldList,
// which gathers every world in one pass over the KEL tree into one node
// array (each world followed by its zombie children), registering the root
// cartel of each userspace on the way, links the tree when asked, prints,
// and releases everything.
#include <getopt.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include "keltools.h"
#include "numbers.h"
#include "records.h"
#include "worlds/psparents.h"
#include "kel/schedrecords.h"
#include "kel/worldrecords.h"

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

bool OutOfMemory() {
   std::fputs("WorldList: Not enough memory\n", stderr);
   return false;
}

// A text kept in the text pool.
struct TextRef {
   uint32_t offset;
   uint32_t length;
};

// Names, affinities and command lines of all nodes (the latter two only when
// their columns are printed), back to back in one buffer, so that a node
// stays small however long its texts are.  The pool stays within 4 GiB, so
// a 32-bit offset reaches every text.
struct TextPool {
   MallocPtr<char> bytes;
   size_t used = 0;
   size_t room = 0;

   bool Add(std::string_view text, TextRef *ref) {
      if (text.size() > UINT32_MAX - used || !GrowArrayRaw(&bytes, &room, used + text.size())) return false;
      if (!text.empty()) std::memcpy(bytes.get() + used, text.data(), text.size());
      *ref = {uint32_t(used), uint32_t(text.size())};
      used += text.size();
      return true;
   }

   std::string_view Get(TextRef ref) const {
      return ref.length == 0 ? std::string_view() : std::string_view(bytes.get() + ref.offset, ref.length);
   }
};

// One row: a kept world, or a zombie child of a cartel.  A world keeps the
// fields of its information record that the rows print or the tree links
// by; a zombie has only its IDs, userspace, process group and session.
// Links are indexes into the node array, -1 for none.
struct WorldNode {
   uint64_t usedTime;
   uint32_t worldId;
   uint32_t cartelId;
   uint32_t parentCartelId;
   uint32_t userspaceId;
   uint32_t typeBits;
   int32_t groupId;
   int32_t processGroupId;
   int32_t sessionId;
   int32_t securityDomain;
   TextRef name;
   TextRef affinity;
   TextRef cmdline;
   uint32_t runState;
   uint32_t waitState;
   bool schedValid;
   bool isZombie;
};

// A node's place in its cartel tree, kept apart from the node so that
// linking and drawing walk a small array.  Links are node indexes, -1 for
// none.
struct TreeLink {
   int32_t firstChild;
   int32_t nextSibling;
   int32_t nChildren;
   int32_t nThreads;
};

// What WorldList gathers: the nodes, their texts, the userspace roots and
// the counts the summary prints.  The printing only reads it.
struct WorldTable {
   uint32_t options = 0;
   TextPool texts;
   // Each kept world in instance order, directly followed by the zombies
   // it keeps; linked into trees on request.
   MallocPtr<WorldNode> nodes;
   size_t nodeRoom = 0;
   uint32_t nodeCount = 0;
   // The tree layout's links, one per node.
   MallocPtr<TreeLink> links;
   // The node of each userspace's root cartel, -1 for none (WorldList
   // fills the table before gathering).
   int32_t roots[kMaxUserspace + 1];
   // Roots whose userspace ID is beyond the table; each gets a warning
   // once the gathering has gone through.
   uint32_t rootsBeyondTable = 0;
   KEL_Status latest = KEL_STATUS_OK;
   int totalWorlds = 0;
   int keptWorlds = 0;
   int zombiesFound = 0;
   uint32_t largestWorldId = 0;
   uint32_t longestName = 0;
};

// Room for one more node at the end of the node array, to be written whole;
// nullptr when memory runs out or a 32-bit link could no longer reach it.
WorldNode *AppendNode(WorldTable &t) {
   if (t.nodeCount >= uint32_t(INT32_MAX) || !GrowArrayRaw(&t.nodes, &t.nodeRoom, size_t(t.nodeCount) + 1))
      return nullptr;
   return &t.nodes[t.nodeCount++];
}

// --- Gathering -------------------------------------------------------------

// A map from cartel ID to a number: a trie over the ID's eight hexadecimal
// digits, its nodes in one growable table, so that a lookup takes eight
// steps whatever the IDs are.  Node 0 is the root, so 0 also means "no node"
// (and, in the last level, "no number yet").
struct CartelIndex {
   struct Node {
      uint32_t next[16];
   };
   MallocPtr<Node> nodes;
   size_t room = 0;
   uint32_t used = 0;

   // The slot holding id's number, 0 until it is set; the nodes on the way
   // are made when missing.  nullptr when memory runs out.  The slot stays
   // valid until the next call.
   uint32_t *Slot(uint32_t id) {
      if (used == 0) {
         if (!GrowArray(&nodes, &room, 1)) return nullptr;
         used = 1;
      }
      uint32_t at = 0;
      for (int shift = 28; shift > 0; shift -= 4) {
         uint32_t digit = (id >> shift) & 0xf;
         if (nodes[at].next[digit] == 0) {
            if (!GrowArray(&nodes, &room, size_t(used) + 1)) return nullptr;
            nodes[at].next[digit] = used++;
         }
         at = nodes[at].next[digit];
      }
      return &nodes[at].next[id & 0xf];
   }
};

// The children of the cartels met so far.  A cartel's children are read at
// the first of its worlds; its other worlds take the listing's status and
// the zombies from here instead of reading them again.
struct CartelChildren {
   struct Entry {
      KEL_Status listStatus;
      uint32_t firstZombie;  // into zombieIds
      uint32_t zombieCount;
   };
   CartelIndex index;  // cartel ID -> entry number + 1
   MallocPtr<Entry> entries;
   size_t entryRoom = 0;
   uint32_t entryCount = 0;
   MallocPtr<int32_t> zombieIds;
   size_t zombieIdRoom = 0;
   uint32_t zombieIdCount = 0;
   // The key list of the children's listings and records, made for the
   // first cartel and reused: it holds the cartel ID, and the child ID
   // while that child's record is read.
   ParamListPtr keys;
};

bool NoZombieMemory() {
   std::fputs("failed to allocate array for zombies\n", stderr);
   return false;
}

// Lists the children of cartel C, reads each child's record and remembers
// the listing's status and the zombies among them as a new entry.  A failed
// listing yields no children.
bool ReadChildren(CartelChildren &seen, uint32_t cartel) {
   if (!seen.keys) {
      seen.keys.reset(KEL_ParamListCreate(1, 1));
      if (!seen.keys) {
         std::fputs("failed to alloc paramlist for children\n", stderr);
         return false;
      }
   }
   ScopedKey cartelKey(seen.keys.get(), uint64_t(cartel));
   if (!cartelKey.ok()) {
      std::fputs("failed to add int to child param list\n", stderr);
      return false;
   }
   ParamListPtr children;
   KEL_Status listStatus = GetInstanceList(KEL_NODE_userworld_cartel_child, seen.keys.get(), &children);

   uint32_t count = listStatus == KEL_STATUS_OK ? KEL_ParamListUsedCount(children.get()) : 0;
   if (!GrowArrayRaw(&seen.entries, &seen.entryRoom, size_t(seen.entryCount) + 1) ||
       (count > 0 && !GrowArrayRaw(&seen.zombieIds, &seen.zombieIdRoom, size_t(seen.zombieIdCount) + count)))
      return NoZombieMemory();
   CartelChildren::Entry entry{listStatus, seen.zombieIdCount, 0};
   for (uint32_t i = 0; i < count; i++) {
      int32_t childId;
      if (KEL_ParamListGetInt32(children.get(), i, &childId) != KEL_STATUS_OK) {
         std::fputs("failed to get child ID\n", stderr);
         return false;
      }
      ScopedKey childKey(seen.keys.get(), uint64_t(int64_t(childId)));
      if (!childKey.ok()) {
         std::fputs("failed to add child ID to list\n", stderr);
         return false;
      }
      uint8_t child[cartelchild::kSize];
      KEL_Status status = KEL_Get(KEL_NODE_userworld_cartel_child, seen.keys.get(), child, sizeof child);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "failed to get child info for child %d, status %s\n", childId,
                      ORX_ReturnStatusToString(status));
         return false;
      }
      if (ReadU32(child, cartelchild::kState) != cartelchild::kZombie) continue;
      seen.zombieIds[seen.zombieIdCount++] = childId;
      entry.zombieCount++;
   }
   seen.entries[seen.entryCount++] = entry;
   return true;
}

// The children of cartel C: read at the cartel's first world, taken from
// what was read for the others.  Either way the listing's status becomes the
// latest status.
bool FindChildren(WorldTable &t, CartelChildren &seen, uint32_t cartel, CartelChildren::Entry *found) {
   uint32_t *slot = seen.index.Slot(cartel);
   if (slot == nullptr) return NoZombieMemory();
   if (*slot == 0) {
      if (!ReadChildren(seen, cartel)) return false;
      *slot = seen.entryCount;
   }
   *found = seen.entries[*slot - 1];
   t.latest = found->listStatus;
   return true;
}

enum class Gathered { Kept, Skipped, Failed };

// Reads the world whose key is on keys into n.  A cartel's command line is
// read with the cartel ID on cartelKeys, an empty key list of its own.
Gathered ReadWorld(WorldTable &t, const KEL_ParamList *keys, KEL_ParamList *cartelKeys, WorldNode &n) {
   uint8_t name[kWorldNameSize], info[worldinfo::kSize];
   if (KEL_Get(KEL_NODE_world_name, keys, name, sizeof name) != KEL_STATUS_OK ||
       KEL_Get(KEL_NODE_world_info, keys, info, sizeof info) != KEL_STATUS_OK)
      return Gathered::Skipped;
   n.worldId = ReadU32(info, worldinfo::kWorldId);
   n.groupId = ReadI32(info, worldinfo::kGroupId);
   n.userspaceId = ReadU32(info, worldinfo::kUserspaceId);
   n.cartelId = ReadU32(info, worldinfo::kCartelId);
   n.parentCartelId = ReadU32(info, worldinfo::kParentCartelId);
   n.processGroupId = ReadI32(info, worldinfo::kProcessGroupId);
   n.sessionId = ReadI32(info, worldinfo::kSessionId);
   n.typeBits = ReadU32(info, worldinfo::kTypeBits);
   n.securityDomain = ReadI32(info, worldinfo::kSecurityDomain);

   uint8_t summary[summarystats::kSize], cpus[affinity::kSize], times[statetimes::kSize];
   if (KEL_Get(KEL_NODE_sched_Vcpus_stats_summaryStats, keys, summary, sizeof summary) == KEL_STATUS_OK &&
       KEL_Get(KEL_NODE_sched_Vcpus_stats_affinity, keys, cpus, sizeof cpus) == KEL_STATUS_OK) {
      if (KEL_Get(KEL_NODE_sched_Vcpus_stats_stateTimes, keys, times, sizeof times) != KEL_STATUS_OK)
         return Gathered::Skipped;
      n.schedValid = true;
   }

   uint32_t cartel = n.cartelId;
   if ((t.options & kOptUserworlds) && cartel == 0) return Gathered::Skipped;

   std::string_view nameText = ReadText(name, 0, sizeof name);
   t.longestName = std::max(t.longestName, uint32_t(nameText.size()));
   t.largestWorldId = std::max(t.largestWorldId, n.worldId);
   if (n.schedValid) {
      n.runState = ReadU32(summary, summarystats::kRunState);
      n.waitState = ReadU32(summary, summarystats::kWaitState);
      n.usedTime = ReadU64(times, statetimes::kUsedTime);
   }
   // The pool keeps only the texts of the columns asked for.
   bool keepAffinity = n.schedValid && (t.options & kOptState);
   if (!t.texts.Add(nameText, &n.name) ||
       (keepAffinity && !t.texts.Add(ReadText(cpus, affinity::kText, sizeof cpus), &n.affinity))) {
      OutOfMemory();
      return Gathered::Failed;
   }
   if (cartel == 0) return Gathered::Kept;

   ScopedKey cartelKey(cartelKeys, cartel);
   uint8_t cmdline[kCmdlineSize];
   // Appending to the list's reserved room fails only when memory runs out.
   KEL_Status status = cartelKey.ok()
                          ? KEL_Get(KEL_NODE_userworld_cartel_cmdline, cartelKeys, cmdline, sizeof cmdline)
                          : KEL_Status(KEL_STATUS_NO_MEMORY);
   t.latest = status;
   if (!(t.options & kOptCommand)) return Gathered::Kept;
   std::string_view text =
      status == KEL_STATUS_OK ? ReadText(cmdline, 0, sizeof cmdline) : std::string_view("<unavailable>");
   if (!t.texts.Add(text, &n.cmdline)) {
      OutOfMemory();
      return Gathered::Failed;
   }
   return Gathered::Kept;
}

// Keeps the world n that ReadWorld read: with -z the children of its cartel
// are looked up first, then n is appended to the node array, registered as
// its userspace's root when it is one, and followed by its zombies when it
// is the main world of its cartel (its world ID is the cartel ID).
bool KeepWorld(WorldTable &t, CartelChildren &seen, const WorldNode &n) {
   CartelChildren::Entry children{KEL_STATUS_OK, 0, 0};
   if ((t.options & kOptZombies) && n.cartelId != 0 && !FindChildren(t, seen, n.cartelId, &children)) return false;

   WorldNode *kept = AppendNode(t);
   if (kept == nullptr) {
      std::fputs("WorldList: malloc failed when allocating root tree node\n", stderr);
      return false;
   }
   *kept = n;
   t.keptWorlds++;
   if (n.userspaceId != 0 && n.parentCartelId == 0) {
      if (n.userspaceId > kMaxUserspace)
         t.rootsBeyondTable++;
      else
         t.roots[n.userspaceId] = int32_t(t.nodeCount - 1);
   }

   if (n.cartelId != n.worldId) return true;
   for (uint32_t i = 0; i < children.zombieCount; i++) {
      uint32_t childId = uint32_t(seen.zombieIds[children.firstZombie + i]);
      WorldNode *z = AppendNode(t);
      if (z == nullptr) return NoZombieMemory();
      *z = WorldNode{};
      z->isZombie = true;
      z->worldId = z->cartelId = childId;
      z->parentCartelId = n.cartelId;
      z->userspaceId = n.userspaceId;
      z->processGroupId = n.processGroupId;
      z->sessionId = n.sessionId;
      t.zombiesFound++;
   }
   return true;
}

// Reads every world (with -C, the main world of every cartel) into the node
// array.  False, with a message, when ps must stop.
bool GatherWorlds(WorldTable &t) {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   ParamListPtr cartelKeys(KEL_ParamListCreate(1, 1));
   if (!keys || !cartelKeys) return OutOfMemory();
   CartelChildren seen;
   KEL_Node listNode = (t.options & kOptCartels) ? KEL_NODE_userworld_cartel : KEL_NODE_world;
   WalkResult walk = ForEachInstance(listNode, keys.get(), [&](const KEL_Param *) {
      t.totalWorlds++;
      WorldNode n{};
      Gathered result = ReadWorld(t, keys.get(), cartelKeys.get(), n);
      if (result == Gathered::Kept && !KeepWorld(t, seen, n)) result = Gathered::Failed;
      return result != Gathered::Failed;
   });
   if (walk.end == WalkEnd::ListFailed)
      std::fprintf(stderr, "WorldList: error fetching world list 0x%x\n", walk.status);
   return walk.end == WalkEnd::Done;
}

// Links every cartel node into its parent's chain of children.  Going over
// the nodes backwards and putting each at the front of its parent's chain
// leaves every chain in node order.
bool LinkTree(WorldTable &t) {
   const WorldNode *nodes = t.nodes.get();
   MallocPtr<psparents::NodeIds> ids = AllocArray<psparents::NodeIds>(t.nodeCount);
   MallocPtr<int32_t> parents = AllocArray<int32_t>(t.nodeCount);
   t.links = AllocArray<TreeLink>(t.nodeCount);
   if (!ids || !parents || !t.links) return OutOfMemory();
   for (uint32_t i = 0; i < t.nodeCount; i++) ids[i] = {nodes[i].worldId, nodes[i].cartelId, nodes[i].parentCartelId};
   if (!psparents::FindParents(ids.get(), t.nodeCount, parents.get())) return OutOfMemory();

   TreeLink *links = t.links.get();
   for (uint32_t i = 0; i < t.nodeCount; i++) links[i] = {-1, -1, 0, 1};
   for (uint32_t i = t.nodeCount; i-- > 0;) {
      int32_t p = parents[i];
      if (p < 0) continue;
      TreeLink &parent = links[p];
      links[i].nextSibling = parent.firstChild;
      parent.firstChild = int32_t(i);
      parent.nChildren++;
      if (nodes[i].typeBits & kCloneWorld) parent.nThreads++;
   }
   return true;
}

// --- Printing --------------------------------------------------------------

// Where a node stands in the drawing of the trees.
struct DrawnNode {
   int32_t printedChildren;
   // Userspace of the tree that last drew this node, so a cycle is drawn once.
   uint32_t inTree;
};

// A node on the path from the root of the tree being drawn, and the next of
// its children to draw (-1 when all are done).
struct PathStep {
   int32_t node;
   int32_t nextChild;
};

// The printing's own state; the gathered table is only read.
struct Printer {
   const WorldTable &t;
   uint32_t requestedUserspace;
   int idWidth = 1;
   int deepest = 0;
   // Tree layout only: one entry per node, and the path from
   // the root to the node being drawn, which grows with the depth.
   MallocPtr<DrawnNode> drawn;
   MallocPtr<PathStep> path;
   size_t pathRoom = 0;
   uint32_t userspace = 0;
};

// Prints two spaces and id, the whole padded with spaces to width
// characters; a longer text is printed whole.
void PrintIdColumn(int width, int32_t id) { std::printf("  %-*d", std::max(width - 2, 0), id); }

void PrintPsHeader(const Printer &p) {
   uint32_t o = p.t.options;
   int w = p.idWidth, m = int(p.t.longestName);
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
// left on zombie rows and on rows without scheduler data.  link is the
// node's place in the tree (nullptr in the table layout, which has no -n or
// -N).
void PrintPsRow(const Printer &p, const WorldNode &n, const TreeLink *link) {
   const WorldTable &t = p.t;
   uint32_t o = t.options;
   int w = p.idWidth, m = int(t.longestName);
   bool zombie = n.isZombie;
   uint32_t cartel = n.cartelId;
   // The first three columns in one call.
   std::string_view name = zombie ? std::string_view("<zombie>") : t.texts.Get(n.name);
   if (cartel == 0)
      std::printf("%-*d%-*s  %-*.*s", std::max(w, 0), int32_t(n.worldId), w + 2, "  0", m, int(name.size()),
                  name.data());
   else
      std::printf("%-*d  %-*d  %-*.*s", std::max(w, 0), int32_t(n.worldId), std::max(w - 2, 0), int32_t(cartel), m,
                  int(name.size()), name.data());
   if ((o & kOptChildren) && (o & kOptTree) && !zombie) std::printf("  %-9d", link->nChildren);
   if ((o & kOptThreads) && (o & kOptTree) && !zombie) std::printf("  %-8d", link->nThreads);
   if ((o & kOptGid) && !zombie) PrintIdColumn(w, n.groupId);
   if (o & kOptSession) {
      if (cartel == 0) {
         std::printf("%-*s", w, "  0");
         std::printf("%-*s", w, "  0");
      } else {
         PrintIdColumn(w - 2, n.processGroupId);
         PrintIdColumn(w - 2, n.sessionId);
      }
   }
   if (o & kOptPcid) PrintIdColumn(w + 2, int32_t(n.parentCartelId));
   if ((o & kOptType) && !zombie) PrintType(o, n.typeBits);
   if (o & kOptState) {
      if (zombie || !n.schedValid) {
         std::fputs("                  ", stdout);
      } else {
         std::string_view cpu = t.texts.Get(n.affinity);
         std::printf("  %-6.6s", StateName(CpuSched_RunStateElements, CpuSched_NumRunStates, n.runState));
         std::printf("  %-6.6s", StateName(CpuSched_WaitStateElements, CpuSched_NumWaitStates, n.waitState));
         std::printf("  %-4.*s", int(cpu.size()), cpu.data());
      }
   }
   if ((o & kOptTime) && !zombie && n.schedValid)
      std::printf("  %5llu.%-6llu", static_cast<unsigned long long>(n.usedTime / 1000000),
                  static_cast<unsigned long long>(n.usedTime % 1000000));
   if ((o & kOptSecurity) && !zombie) std::printf("  %-14d", n.securityDomain);
   if ((o & kOptUserspace) && !zombie) std::printf("  %-9d", int32_t(n.userspaceId));
   if ((o & kOptCommand) && cartel != 0 && !zombie) {
      std::string_view cmd = t.texts.Get(n.cmdline);
      std::printf("  %.*s\n", int(cmd.size()), cmd.data());
      return;
   }
   std::putchar('\n');
}

// The tree prefix of a line, gathered and written in pieces of up to a few
// hundred bytes, so that a line costs a few writes however deep it is.
struct Prefix {
   char bytes[256];
   size_t used = 0;

   void Put(const char *text, size_t n) {
      if (sizeof bytes - used < n) Flush();
      std::memcpy(bytes + used, text, n);
      used += n;
   }
   // A glyph of the DEC Special Graphics set, shifted in and out around it.
   void Glyph(char letter) {
      const char shifted[] = {14, letter, 15};
      Put(shifted, sizeof shifted);
   }
   void Flush() {
      if (used > 0) std::fwrite(bytes, 1, used, stdout);
      used = 0;
   }
};

// Prints the line of node index at the given depth: its tree prefix and its
// row.  The first depth steps of the path are its ancestors, root first.
void PrintTreeLine(Printer &p, int32_t index, size_t depth) {
   const WorldNode &n = p.t.nodes[index];
   const TreeLink *links = p.t.links.get();
   p.drawn[index].inTree = p.userspace;
   p.deepest = std::max(p.deepest, int(depth));
   int32_t parent = depth > 0 ? p.path[depth - 1].node : -1;
   if (depth == 0) std::printf("%d\n", int32_t(n.userspaceId));
   Prefix prefix;
   if (parent >= 0) {
      prefix.Put("  ", 2);
      // One column per ancestor below the root: a line while the
      // ancestor's parent still has children to draw.
      for (size_t i = 1; i < depth; i++) {
         int32_t above = p.path[i - 1].node;
         if (links[above].nChildren > 1 && links[above].nChildren != p.drawn[above].printedChildren) {
            prefix.Glyph('x');
            prefix.Put(" ", 1);
         } else {
            prefix.Put("  ", 2);
         }
      }
   }
   bool last = links[index].nextSibling < 0 || parent < 0 || links[parent].nChildren <= 1;
   prefix.Glyph(last ? 'm' : 't');
   prefix.Glyph('q');
   prefix.Flush();
   PrintPsRow(p, n, &links[index]);
   if (parent >= 0) p.drawn[parent].printedChildren++;
}

// Draws the tree under root, depth first, each node before its children.
// The path is an explicit stack on the heap, so a tree of any depth is
// drawn whole; a child already drawn in this tree (a cycle in a damaged
// tree) is passed over.  False when memory for the path runs out.
bool PrintPsTree(Printer &p, int32_t root) {
   const TreeLink *links = p.t.links.get();
   size_t depth = 0;
   auto enter = [&](int32_t index) {
      PrintTreeLine(p, index, depth);
      if (links[index].firstChild < 0) return true;
      if (!GrowArray(&p.path, &p.pathRoom, depth + 1)) return false;
      p.path[depth++] = {index, links[index].firstChild};
      return true;
   };
   if (!enter(root)) return false;
   while (depth > 0) {
      PathStep &step = p.path[depth - 1];
      int32_t child = step.nextChild;
      if (child < 0) {
         depth--;
         continue;
      }
      step.nextChild = links[child].nextSibling;
      if (p.drawn[child].inTree == p.userspace)
         p.drawn[step.node].printedChildren++;
      else if (!enter(child))
         return false;
   }
   return true;
}

// Tells which userspaces are running when the requested one is not.
void ReportNotRunning(const Printer &p) {
   std::fprintf(stderr, "Requested userspace (%d) is not running.\n", int32_t(p.requestedUserspace));
   std::fputs("Available userspaces:\n ", stderr);
   for (uint32_t k = 1; k <= kMaxUserspace; k++) {
      if (p.t.roots[k] < 0) continue;
      std::fprintf(stderr, "%3d ", int(k));
      if (k > 1 && (k - 1) % 10 == 0) std::fputs("\n", stderr);
   }
   std::fputs("\n", stderr);
}

// Prints the table or the trees and the summary; false when the requested
// userspace is not running or memory runs out.
bool PrintWorlds(const WorldTable &t, uint32_t requestedUserspace) {
   uint32_t o = t.options;
   Printer p{t, requestedUserspace};
   uint32_t wanted = requestedUserspace;
   if ((o & kOptUserspace) && wanted != 0 && (wanted > kMaxUserspace || t.roots[wanted] < 0)) {
      ReportNotRunning(p);
      return false;
   }
   p.idWidth = std::snprintf(nullptr, 0, "%d", int32_t(t.largestWorldId));

   if (!(o & kOptTree)) {
      PrintPsHeader(p);
      for (uint32_t i = 0; i < t.nodeCount; i++) {
         const WorldNode &n = t.nodes[i];
         if ((o & kOptUserworlds) && n.cartelId == 0) continue;
         if (wanted != 0 && n.userspaceId != wanted) continue;
         PrintPsRow(p, n, nullptr);
      }
      std::fputs("\n", stdout);
   } else {
      p.drawn = AllocArray<DrawnNode>(t.nodeCount);
      if (!p.drawn) return OutOfMemory();
      std::printf("%c)0\n", 27);
      for (uint32_t k = 1; k <= kMaxUserspace; k++) {
         if (t.roots[k] < 0 || (wanted != 0 && k != wanted)) continue;
         PrintPsHeader(p);
         p.userspace = k;
         if (!PrintPsTree(p, t.roots[k])) {
            std::fflush(stdout);
            return OutOfMemory();
         }
         std::fputs("\n", stdout);
      }
   }

   if (o & kOptSummary) {
      int userspaces = int(std::count_if(std::begin(t.roots) + 1, std::end(t.roots), [](int32_t r) { return r >= 0; }));
      std::printf("Total worlds:         %d\n", t.totalWorlds);
      std::printf("Total printed worlds: %d\n", t.keptWorlds);
      if (o & kOptTree) std::printf("Deepest child:        %d\n", p.deepest + 1);
      if (o & kOptZombies) std::printf("Zombie worlds:        %d\n", t.zombiesFound);
      std::printf("Total userspaces:     %d\n", userspaces);
   }
   return true;
}

// Gathers the worlds, prints them and releases everything.  True when the
// latest KEL status is 0 and the printing went through.
bool WorldList(uint32_t options, uint32_t requestedUserspace) {
   WorldTable t;
   t.options = options;
   std::fill(std::begin(t.roots), std::end(t.roots), -1);
   if (!GatherWorlds(t)) return false;
   // A gathering that fails writes no warning about the roots.
   for (uint32_t i = 0; i < t.rootsBeyondTable; i++)
      std::fputs("Warning: maximum number of userspaces reached...\n", stderr);
   if ((options & kOptTree) && !LinkTree(t)) return false;
   bool printed = PrintWorlds(t, requestedUserspace);
   return printed && t.latest == KEL_STATUS_OK;
}

}  // namespace

namespace psparents {

// Candidate parents sorted by world ID and then position, so that a binary
// search finds the first node of a world ID in the nodes' own order.
bool FindParents(const NodeIds *nodes, uint32_t count, int32_t *parents) {
   struct Candidate {
      uint32_t worldId;
      int32_t node;
   };
   MallocPtr<Candidate> candidates = AllocArray<Candidate>(count);
   if (!candidates) return false;
   uint32_t used = 0;
   for (uint32_t i = 0; i < count; i++)
      if (nodes[i].cartelId != 0) candidates[used++] = {nodes[i].worldId, int32_t(i)};
   auto byWorldThenNode = [](const Candidate &a, const Candidate &b) {
      return a.worldId != b.worldId ? a.worldId < b.worldId : a.node < b.node;
   };
   Candidate *begin = candidates.get(), *end = begin + used;
   // Worlds are usually listed in ID order: then the candidates are sorted
   // already.
   if (!std::is_sorted(begin, end, byWorldThenNode)) std::sort(begin, end, byWorldThenNode);
   for (uint32_t i = 0; i < count; i++) {
      parents[i] = -1;
      if (nodes[i].cartelId == 0) continue;
      uint32_t wanted = nodes[i].parentCartelId;
      const Candidate *c = std::lower_bound(begin, end, Candidate{wanted, -1}, byWorldThenNode);
      if (c != end && c->worldId == wanted) parents[i] = c->node;
   }
   return true;
}

}  // namespace psparents

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
