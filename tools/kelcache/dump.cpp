// Cache file bytes to snapshot JSON.
//
// Entries are first gathered into a tree of places mirroring the snapshot's
// "tree"; that tree is then written out, listed instances in listing order
// and the others in the order of their keys.  An entry that the tree cannot
// give back byte for byte goes to "rawEntries".
//
// A place is a small record in one array that names its entries by slot and
// its instance key by where the key lies in the file, and the text goes out
// as it is made, so that memory stays near the size of the file.  Entries
// are placed in the order of their slots, in which the entries of one
// instance lie side by side; each place keeps the rank (in key order) of the
// first entry that reached it, which orders the instances as if the entries
// had been placed in key order.
#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <unordered_map>

#include "byteset.h"
#include "content.h"
#include "nodetree.h"
#include "records.h"
#include "snapshot.h"
#include "values.h"

namespace kelcache {

namespace {

using kelplat::Key;
using kelplat::NodeInfo;
using kelplat::Op;

constexpr uint32_t kNone = 0xffffffff;
constexpr uint32_t kFixed = 0xffffffff;  // the kind of a place at a fixed name
// Objects of at most this many instances are searched in order when written.
constexpr size_t kFewInstances = 16;

struct Entry {
   std::string_view key;
   uint32_t status = 0;
   std::string_view data;
};

// An entry's key taken apart.  Each instance key is a view of the key's
// bytes as stored: its kind, then a value or a length and a text.
struct Lookup {
   Op op;
   KEL_Node node;
   std::vector<std::string_view> keys;
};

// Takes key apart into *l, reusing its storage; false when the instance
// keys run past the end (as kelplat::DecodeKey finds).
bool DecodeLookup(std::string_view key, Lookup *l) {
   if (key.size() < 3) return false;
   const auto *p = reinterpret_cast<const uint8_t *>(key.data());
   l->op = Op(p[0]);
   l->node = KEL_Node(p[1] | p[2] << 8);
   l->keys.clear();
   for (size_t pos = 3; pos < key.size();) {
      size_t start = pos, rest = key.size() - pos - 1;
      if (p[pos] == KEL_PARAM_STRING) {
         if (rest < 4 || rest - 4 < kelplat::LoadU32(p + pos + 1)) return false;
         pos += 5 + kelplat::LoadU32(p + pos + 1);
      } else {
         if (rest < 8) return false;
         pos += 9;
      }
      l->keys.push_back(key.substr(start, pos - start));
   }
   return true;
}

// Whether an instance key as stored has a member name: every key but a
// text that is not UTF-8 (the one case KeyName refuses).
bool Nameable(std::string_view encoded) {
   return uint8_t(encoded[0]) != KEL_PARAM_STRING || ValidUtf8(encoded.substr(5));
}
bool Nameable(const Key &key) { return key.kind != KEL_PARAM_STRING || ValidUtf8(key.text); }

// The length of a key as stored: its kind, then a value or a length and a text.
size_t EncodedSize(const Key &key) { return key.kind == KEL_PARAM_STRING ? 5 + key.text.size() : 9; }

// The simulator's rules text as JSON, when the JSON builds it back exactly.
std::optional<Json> DumpRules(std::string_view text) {
   Json rules = Json::array();
   if (text.empty()) return rules;
   while (true) {
      size_t end = text.find('\n');
      std::string_view line = text.substr(0, end);
      std::vector<std::string_view> f;
      for (size_t start = 0;;) {
         size_t tab = line.find('\t', start);
         f.push_back(line.substr(start, tab - start));
         if (tab == std::string_view::npos) break;
         start = tab + 1;
      }
      if (f.size() != 4 || (f[1] != "tardisk" && f[1] != "ramdisk" && f[1] != "foreign") ||
          !ValidUtf8(f[0]) || !ValidUtf8(f[2]))
         return std::nullopt;
      std::optional<uint64_t> flags = ParseIntText(f[3], IntType::U32);
      if (!flags || std::to_string(*flags) != f[3]) return std::nullopt;
      Json rule = Json::object();
      rule["path"] = std::string(f[0]);
      rule["kind"] = std::string(f[1]);
      rule["disk"] = std::string(f[2]);
      rule["flags"] = *flags;
      rules.push_back(rule);
      if (end == std::string_view::npos) return rules;
      text.remove_prefix(end + 1);
   }
}

Json MarkUnlisted(const Json &value) {
   Json out = Json::object();
   out["$unlisted"] = true;
   for (auto it = value.begin(); it != value.end(); ++it) out[it.key()] = *it;
   return out;
}

// The text being written: gathered in a string, and passed on to a file
// (when there is one) whenever it holds a good deal.  After a failed write
// nothing more is written; error keeps its errno.
class TextOut {
public:
   explicit TextOut(FILE *file) : file_(file) {}
   std::string text;
   int error = 0;

   void MaybePass() {
      if (file_ != nullptr && text.size() >= kPassAt) Pass();
   }
   void Pass() {
      if (file_ == nullptr) return;
      if (error == 0 && !text.empty() && std::fwrite(text.data(), 1, text.size(), file_) != text.size())
         error = errno != 0 ? errno : EIO;
      text.clear();
   }

private:
   static constexpr size_t kPassAt = size_t(1) << 16;
   FILE *file_;
};

// Appends value as dump(2) prints it, nested depth levels deep: its lines
// after the first take the indentation of that depth (a string in JSON
// holds no raw line feed, so each line feed starts a line).
void AppendJson(std::string &out, const Json &value, int depth) {
   std::string text = value.dump(2);
   size_t start = 0;
   for (size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1) {
      out.append(text, start, end + 1 - start);
      out.append(size_t(depth) * 2, ' ');
   }
   out.append(text, start, std::string::npos);
}

// Appends a member name as a JSON string: as it is when it needs no
// escapes (printable ASCII without quotes or backslashes), else as
// nlohmann writes it.
void AppendName(std::string &out, std::string_view name) {
   bool plain = std::all_of(name.begin(), name.end(),
                            [](char c) { return c >= 0x20 && c < 0x7f && c != '"' && c != '\\'; });
   if (!plain) {
      out += Json(std::string(name)).dump();
      return;
   }
   out += '"';
   out += name;
   out += '"';
}

// An object written member by member in the layout of dump(2), so that a
// dump of any size is never held as a document; its members are appended
// without a search (the callers give each name once).
class ObjectWriter {
public:
   ObjectWriter(TextOut &out, int depth) : out_(out), depth_(depth) {}
   // Starts a member; its value follows at depth + 1.
   void Member(std::string_view name) {
      out_.MaybePass();
      std::string &text = out_.text;
      text += any_ ? ",\n" : "{\n";
      any_ = true;
      text.append(size_t(depth_ + 1) * 2, ' ');
      AppendName(text, name);
      text += ": ";
   }
   void Member(std::string_view name, const Json &value) {
      Member(name);
      AppendJson(out_.text, value, depth_ + 1);
   }
   void End() {
      std::string &text = out_.text;
      if (!any_) {
         text += "{}";
         return;
      }
      text += '\n';
      text.append(size_t(depth_) * 2, ' ');
      text += '}';
   }

private:
   TextOut &out_;
   int depth_;
   bool any_ = false;
};

// What was found at one position for one set of instance keys: the root, a
// fixed name or an instance.  Children are a list, the last made first;
// instances are also found through a hash.
struct Place {
   union {
      uint32_t firstChild = 0;  // 0: none (the root is nobody's child)
      uint32_t dataLen;         // a record or content (which has no children): its data's length
   };
   uint32_t nextSibling = 0;
   uint32_t parent = 0;
   // The first entry to reach this place: listings before reads, each in
   // key order.
   uint32_t rank = kNone;
   // A record or content: where its entry lies in the file, so that writing
   // it reads no slot; an object of instances: the slot of its listing.
   uint32_t entry = kNone;
   // A fixed name: kFixed, and its position as value.  An instance: its
   // key's kind, and its value or (a text) where the text lies in the file
   // (offset << 32 | length), so that most keys compare without the file.
   uint32_t kind = kFixed;
   uint64_t value = 0;
};

class Dumper {
public:
   explicit Dumper(const kelplat::CacheReader &reader);
   // Writes the snapshot to out, or returns false with *status set when the
   // file is damaged (before anything is written).
   bool Run(TextOut &out, KEL_Status *status);

private:
   Entry EntryOfSlot(uint32_t slot) const;
   bool RankEntries();
   bool PlaceListing(const Entry &e, const Lookup &l, uint32_t slot, uint32_t rank);
   bool PlaceRead(const Entry &e, const Lookup &l, uint32_t rank);
   // The entry of a record or content, whose key is keyLen bytes long.
   Entry StoredAt(const Place &p, size_t keyLen) const;
   bool PlaceSet(const Entry &e, const Lookup &l, uint32_t slot);
   bool PlaceMeta(const Entry &e, const Lookup &l);
   static bool Representable(const std::vector<std::string_view> &keys);
   // The place at pos for keys; created, and its rank and those of the
   // places above it lowered to rank, unless rank is kNone.
   uint32_t Reach(int pos, const std::vector<std::string_view> &keys, uint32_t rank);
   uint32_t FixedChild(uint32_t place, int pos) const;
   uint32_t Instance(uint32_t parent, std::string_view key) const;
   // A place at a fixed position, or for an instance key as stored (a view
   // of the file's bytes).
   uint32_t AddPlace(uint32_t parent, int pos);
   uint32_t AddPlace(uint32_t parent, std::string_view key);
   // Whether place p is the instance with this key as stored.
   bool IsInstance(const Place &p, std::string_view key) const;
   Key KeyOf(const Place &p) const;
   // keyLen: the length of the keys of entries at pos (3 and the instance
   // keys above).
   void Emit(int pos, uint32_t place, bool unlisted, TextOut &out, int depth, size_t keyLen);

   const kelplat::CacheReader &reader_;
   const char *base_;  // the file's first byte
   const NodeTree &tree_ = TheNodeTree();
   std::vector<std::vector<int>> chains_;  // NodeTree::Chain of each position
   // Entry j (the entry of the j-th occupied slot): its place in key order.
   std::vector<uint32_t> rank_;
   std::vector<Place> places_;  // the root first
   // Instances by the tag of their parent and key: their places (never
   // the root, so never 0).
   kelplat::TagIndex index_;
   std::unordered_map<uint32_t, uint32_t> sets_;  // a record's place: the slot of its set answer
   std::vector<bool> done_;                       // instances written as listed
   // The places the last Reach below each top-level name passed, by depth:
   // entries in slot order mostly share their instance keys with one of the
   // entries just before (a world's name and record, then its processor's
   // statistics, then its cartel's).
   struct Step {
      int pos;
      std::string_view key;  // empty at a fixed name
      uint32_t place;
   };
   std::vector<std::vector<Step>> lastWays_;  // by position
   RecordCodec records_;                          // scratch space
   std::vector<Key> listed_;                      // scratch space
   ByteSet unique_;                               // scratch space
   Json simulator_ = Json::object();
};

Dumper::Dumper(const kelplat::CacheReader &reader)
   : reader_(reader), base_(reader.Bytes().data()), chains_(tree_.positions.size()),
     lastWays_(tree_.positions.size()) {
   for (size_t i = 0; i < chains_.size(); i++) chains_[i] = tree_.Chain(int(i));
}

Entry Dumper::EntryOfSlot(uint32_t slot) const {
   Entry e;
   kelplat::CacheHit hit;
   uint32_t tag;
   if (reader_.SlotAt(slot, &e.key, &hit, &tag)) {
      e.status = hit.status;
      e.data = hit.data;
   }
   return e;
}

// The rank of each entry in the order of the keys, as a built file has
// them whatever order its slots have.  Sorted by the keys' first sixteen
// bytes (read big-endian, so that they compare as the bytes do; enough to
// tell most keys apart without reading them again), then by the whole keys.  False when the slots do not hold exactly the entries the
// header counts, all with different keys.
bool Dumper::RankEntries() {
   struct Sorted {
      uint64_t prefix[2];
      uint32_t slot, entry;
      bool SamePrefix(const Sorted &o) const { return prefix[0] == o.prefix[0] && prefix[1] == o.prefix[1]; }
      bool PrefixLess(const Sorted &o) const {
         return prefix[0] != o.prefix[0] ? prefix[0] < o.prefix[0] : prefix[1] < o.prefix[1];
      }
   };
   std::vector<Sorted> sorted;
   sorted.reserve(reader_.EntryCount());
   for (uint32_t i = 0; i < reader_.SlotCount(); i++) {
      std::string_view key;
      kelplat::CacheHit hit;
      uint32_t tag;
      if (!reader_.SlotAt(i, &key, &hit, &tag)) continue;
      Sorted item{{0, 0}, i, uint32_t(sorted.size())};
      for (size_t b = 0; b < 16; b++) item.prefix[b / 8] = item.prefix[b / 8] << 8 | (b < key.size() ? uint8_t(key[b]) : 0);
      sorted.push_back(item);
   }
   if (sorted.size() != reader_.EntryCount()) return false;
   auto keyOf = [this](uint32_t slot) { return EntryOfSlot(slot).key; };
   std::sort(sorted.begin(), sorted.end(), [&](const Sorted &a, const Sorted &b) {
      return !a.SamePrefix(b) ? a.PrefixLess(b) : keyOf(a.slot) < keyOf(b.slot);
   });
   rank_.resize(sorted.size());
   for (size_t i = 0; i < sorted.size(); i++) {
      if (i > 0 && sorted[i].SamePrefix(sorted[i - 1]) && keyOf(sorted[i].slot) == keyOf(sorted[i - 1].slot))
         return false;
      rank_[sorted[i].entry] = uint32_t(i);
   }
   return true;
}

bool Dumper::Run(TextOut &out, KEL_Status *status) {
   if (!RankEntries()) {
      *status = KEL_STATUS_CACHE_CORRUPT;
      return false;
   }
   const uint32_t count = uint32_t(rank_.size());
   // Places: about one for each entry and a few more; reserved room costs
   // nothing until used.
   places_.reserve(size_t(count) * 2 + 1);
   places_.emplace_back();  // the root

   // Listings and reads in one pass over the slots (a listing ranks before
   // every read); then sets, which join the read of the same record; then
   // the simulator's settings, in key order.  What is not placed is left
   // for "rawEntries", in key order.
   struct Later {
      uint32_t rank, slot;
      bool operator<(const Later &o) const { return rank < o.rank; }
   };
   std::vector<Later> sets, metas, left;
   Lookup l;
   for (uint32_t slot = 0, j = 0; slot < reader_.SlotCount(); slot++) {
      const Entry e = EntryOfSlot(slot);
      if (e.key.empty()) continue;  // an empty slot
      const uint32_t rank = rank_[j++];
      bool placed = false;
      if (DecodeLookup(e.key, &l)) {
         if (l.op == Op::List) {
            placed = PlaceListing(e, l, slot, rank);
         } else if (l.op == Op::Get || l.op == Op::Data) {
            placed = PlaceRead(e, l, count + rank);
         } else if (l.op == Op::Set || l.op == Op::Meta) {
            (l.op == Op::Set ? sets : metas).push_back({rank, slot});
            continue;
         }
      }
      if (!placed) left.push_back({rank, slot});
   }
   rank_ = {};
   std::sort(metas.begin(), metas.end());
   for (const std::vector<Later> *later : {&sets, &metas}) {
      for (const Later &m : *later) {
         const Entry e = EntryOfSlot(m.slot);
         DecodeLookup(e.key, &l);
         if (!(l.op == Op::Set ? PlaceSet(e, l, m.slot) : PlaceMeta(e, l))) left.push_back(m);
      }
   }
   done_.assign(places_.size(), false);

   ObjectWriter doc(out, 0);
   std::string date = reader_.BuildDate();
   if (!ValidUtf8(date))
      for (char &c : date)
         if (uint8_t(c) >= 0x80) c = '?';
   doc.Member("buildDate", date);
   doc.Member("signature", ToHex({reinterpret_cast<const char *>(reader_.Signature().data()), 16}));
   if (!simulator_.empty()) doc.Member("simulator", simulator_);
   doc.Member("tree");
   Emit(0, 0, false, out, 1, 3);
   // The entries left out, in key order.
   std::sort(left.begin(), left.end());
   Json raw = Json::array();
   for (const Later &unplaced : left) {
      const Entry e = EntryOfSlot(unplaced.slot);
      Json r = Json::object();
      r["key"] = ToHex(e.key);
      if (e.status != KEL_STATUS_OK) r["status"] = FormatStatus(e.status);
      if (!e.data.empty()) r["data"] = ToHex(e.data);
      raw.push_back(r);
   }
   if (!raw.empty()) doc.Member("rawEntries", raw);
   doc.End();
   out.text += '\n';
   out.Pass();
   return true;
}

bool Dumper::PlaceListing(const Entry &e, const Lookup &l, uint32_t slot, uint32_t rank) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || !kelplat::EndsWithLevel(node->path) ||
       l.keys.size() + 1 != node->levels)
      return false;
   if (!kelplat::DecodeList(e.data, &listed_)) return false;
   // Every listed key needs a member name, and each is listed once.
   unique_.Clear();
   std::string encoded;
   for (const Key &k : listed_) {
      encoded.clear();
      kelplat::AppendKey(encoded, k);
      if (!Nameable(k) || !unique_.Insert(encoded).second) return false;
   }
   int levelObject = tree_.at(tree_.nodePosition[l.node]).parent;
   if (!Representable(l.keys)) return false;
   places_[Reach(levelObject, l.keys, rank)].entry = slot;
   return true;
}

bool Dumper::PlaceRead(const Entry &e, const Lookup &l, uint32_t rank) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || l.keys.size() != node->levels) return false;
   if (l.op == Op::Data) {
      if (!(node->flags & kelplat::KEL_NF_DATA) || !DumpData(e.status, e.data, true)) return false;
   } else {
      if (node->recordSize == 0 || (node->flags & kelplat::KEL_NF_DATA)) return false;
      if (!records_.Dump(*node, {e.status, e.data, {}}, true)) return false;
   }
   if (!Representable(l.keys)) return false;
   Place &place = places_[Reach(tree_.nodePosition[l.node], l.keys, rank)];
   place.entry = uint32_t(e.key.data() - base_ - kelplat::kEntryHeadSize);
   place.dataLen = uint32_t(e.data.size());
   return true;
}

// A set answer rides on the read of the same record.
bool Dumper::PlaceSet(const Entry &e, const Lookup &l, uint32_t slot) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || !(node->flags & kelplat::KEL_NF_SET) || node->recordSize == 0 ||
       (node->flags & kelplat::KEL_NF_DATA) || !e.data.empty() || l.keys.size() != node->levels ||
       !Representable(l.keys))
      return false;
   uint32_t place = Reach(tree_.nodePosition[l.node], l.keys, kNone);
   if (place == kNone || places_[place].entry == kNone) return false;
   sets_[place] = slot;
   return true;
}

bool Dumper::PlaceMeta(const Entry &e, const Lookup &l) {
   if (l.node != 0 || l.keys.size() != 1 || uint8_t(l.keys[0][0]) != KEL_PARAM_STRING || e.status != KEL_STATUS_OK)
      return false;
   std::string_view name = l.keys[0].substr(5);
   if (name == "corafs.root" && ValidUtf8(e.data)) {
      simulator_["corafsRoot"] = std::string(e.data);
      return true;
   }
   if (name == "signal.any" && (e.data == "1" || e.data == "0")) {
      simulator_["signalAnyProcess"] = e.data == "1";
      return true;
   }
   if (name == "corafs.rules") {
      if (std::optional<Json> rules = DumpRules(e.data)) {
         simulator_["corafsRules"] = *rules;
         return true;
      }
   }
   return false;
}

// Whether every instance key on the way has a member name.
bool Dumper::Representable(const std::vector<std::string_view> &keys) {
   return std::all_of(keys.begin(), keys.end(), [](std::string_view k) { return Nameable(k); });
}

uint32_t Dumper::FixedChild(uint32_t place, int pos) const {
   for (uint32_t c = places_[place].firstChild; c != 0; c = places_[c].nextSibling)
      if (places_[c].kind == kFixed && places_[c].value == uint64_t(pos)) return c;
   return kNone;
}

// The tag of an instance: the hash of its parent and key.
static uint32_t InstanceTag(uint32_t parent, std::string_view key) {
   return uint32_t((kelplat::KeyHash(key) ^ (uint64_t(parent) * 0x9e3779b97f4a7c15ULL)) >> 32);
}
uint32_t Dumper::Instance(uint32_t parent, std::string_view key) const {
   uint32_t n = index_.Find(InstanceTag(parent, key), [&](uint32_t place) {
      const Place &p = places_[place];
      return p.parent == parent && IsInstance(p, key);
   });
   return n != 0 ? n : kNone;
}

bool Dumper::IsInstance(const Place &p, std::string_view key) const {
   const auto *k = reinterpret_cast<const uint8_t *>(key.data());
   if (p.kind != k[0]) return false;
   if (p.kind != KEL_PARAM_STRING) return p.value == kelplat::LoadU64(k + 1);
   return std::string_view(base_ + (p.value >> 32), uint32_t(p.value)) == key.substr(5);
}

Key Dumper::KeyOf(const Place &p) const {
   if (p.kind != KEL_PARAM_STRING) return Key{p.kind, p.value, {}};
   return Key{p.kind, 0, std::string(base_ + (p.value >> 32), uint32_t(p.value))};
}

// A new place, first in its parent's list.
uint32_t Dumper::AddPlace(uint32_t parent, int pos) {
   uint32_t n = uint32_t(places_.size());
   Place p;
   p.parent = parent;
   p.value = uint64_t(pos);
   p.nextSibling = places_[parent].firstChild;
   places_.push_back(p);
   places_[parent].firstChild = n;
   return n;
}

// An instance also goes into the index.
uint32_t Dumper::AddPlace(uint32_t parent, std::string_view key) {
   uint32_t n = uint32_t(places_.size());
   Place p;
   p.parent = parent;
   p.kind = uint8_t(key[0]);
   if (p.kind == KEL_PARAM_STRING)
      p.value = uint64_t(key.data() + 5 - base_) << 32 | (key.size() - 5);
   else
      p.value = kelplat::LoadU64(reinterpret_cast<const uint8_t *>(key.data()) + 1);
   p.nextSibling = places_[parent].firstChild;
   places_.push_back(p);
   places_[parent].firstChild = n;
   index_.Insert(InstanceTag(parent, key), n);
   return n;
}

uint32_t Dumper::Reach(int pos, const std::vector<std::string_view> &keys, uint32_t rank) {
   const bool create = rank != kNone;
   const std::vector<int> &chain = chains_[size_t(pos)];
   if (chain.empty()) return 0;
   std::vector<Step> &lastWay = lastWays_[size_t(chain[0])];
   uint32_t place = 0;
   size_t k = 0, depth = 0;
   bool known = true;  // so far the way of the last call
   for (int c : chain) {
      const bool fixed = tree_.at(c).levelKind < 0;
      std::string_view key = fixed ? std::string_view() : keys[k++];
      uint32_t child;
      known = known && depth < lastWay.size() && lastWay[depth].pos == c && lastWay[depth].key == key;
      if (known) {
         child = lastWay[depth].place;
      } else {
         lastWay.resize(depth);
         child = fixed ? FixedChild(place, c) : Instance(place, key);
         if (child == kNone && create) child = fixed ? AddPlace(place, c) : AddPlace(place, key);
         if (child == kNone) return kNone;
         lastWay.push_back({c, key, child});
      }
      if (create) places_[child].rank = std::min(places_[child].rank, rank);
      place = child;
      depth++;
   }
   return place;
}

// Writes the JSON at a position, depth levels deep; place is kNone for a
// listed instance with nothing stored below it.
Entry Dumper::StoredAt(const Place &p, size_t keyLen) const {
   Entry e;
   e.status = kelplat::LoadU32(reinterpret_cast<const uint8_t *>(base_) + p.entry);
   e.data = std::string_view(base_ + p.entry + kelplat::kEntryHeadSize + keyLen, p.dataLen);
   return e;
}

void Dumper::Emit(int pos, uint32_t place, bool unlisted, TextOut &out, int depth, size_t keyLen) {
   const Position &at = tree_.at(pos);
   const Place *p = place == kNone ? nullptr : &places_[place];
   if (at.node != nullptr && (at.node->flags & kelplat::KEL_NF_DATA)) {
      Json j = nullptr;
      if (p != nullptr && p->entry != kNone) {
         const Entry e = StoredAt(*p, keyLen);
         j = DumpData(e.status, e.data, unlisted).value_or(nullptr);
      }
      AppendJson(out.text, unlisted ? MarkUnlisted(j) : j, depth);
      return;
   }
   if (at.node != nullptr && at.node->recordSize > 0) {
      Json j = nullptr;
      if (p != nullptr && p->entry != kNone) {
         const Entry e = StoredAt(*p, keyLen);
         RecordEntry r{e.status, e.data, {}};
         if (auto set = sets_.find(place); set != sets_.end()) r.setStatus = EntryOfSlot(set->second).status;
         j = records_.Dump(*at.node, r, unlisted).value_or(nullptr);
      }
      AppendJson(out.text, unlisted ? MarkUnlisted(j) : j, depth);
      return;
   }
   ObjectWriter object(out, depth);
   if (unlisted) object.Member("$unlisted", true);
   if (p == nullptr) return object.End();
   int level = tree_.LevelChild(pos);
   if (level < 0) {
      for (int c : at.children)
         if (uint32_t child = FixedChild(place, c); child != kNone) {
            object.Member(tree_.at(c).name);
            Emit(c, child, false, out, depth + 1, keyLen);
         }
      return object.End();
   }
   int kind = tree_.at(level).levelKind;
   const bool listing = p->entry != kNone;
   std::vector<Key> listed;
   if (listing) {
      const Entry e = EntryOfSlot(p->entry);
      if (e.status != KEL_STATUS_OK) object.Member("$listStatus", FormatStatus(e.status));
      kelplat::DecodeList(e.data, &listed);
   } else if (tree_.at(level).node != nullptr) {
      object.Member("$noListing", true);
   }
   // The instances as made, and the listed ones' places, found all at once
   // before any is written: among the few instances of a small object, else
   // through the index, in lookups that do not wait for one another.
   std::vector<uint32_t> made;
   for (uint32_t c = p->firstChild; c != 0; c = places_[c].nextSibling) made.push_back(c);
   std::vector<uint32_t> children(listed.size());
   std::string encoded;
   for (size_t i = 0; i < listed.size(); i++) {
      encoded.clear();
      kelplat::AppendKey(encoded, listed[i]);
      if (made.size() > kFewInstances) {
         children[i] = Instance(place, encoded);
         continue;
      }
      auto it = std::find_if(made.begin(), made.end(), [&](uint32_t c) { return IsInstance(places_[c], encoded); });
      children[i] = it == made.end() ? kNone : *it;
   }
   for (size_t i = 0; i < listed.size(); i++) {
      object.Member(*KeyName(listed[i], kind));
      Emit(level, children[i], false, out, depth + 1, keyLen + EncodedSize(listed[i]));
      if (children[i] != kNone) done_[children[i]] = true;
   }
   // The others in the order of their ranks (read once each, so that the
   // sort touches no place).
   std::vector<std::pair<uint32_t, uint32_t>> others;  // rank, place
   for (uint32_t c : made)
      if (!done_[c]) others.emplace_back(places_[c].rank, c);
   std::sort(others.begin(), others.end());
   for (const auto &[rank, c] : others) {
      const Key k = KeyOf(places_[c]);
      object.Member(*KeyName(k, kind));
      Emit(level, c, listing, out, depth + 1, keyLen + EncodedSize(k));
   }
   object.End();
}

}  // namespace

}  // namespace kelcache

namespace {

// The dump of cacheBytes into out; false with *error when the file is
// damaged (nothing is written then) or the dump fails.
bool DumpInto(std::string_view cacheBytes, kelcache::TextOut &out, std::string *error) {
   using namespace kelcache;
   std::string message;
   try {
      KEL_Status status = KEL_STATUS_OK;
      if (!TheNodeTree().error.empty()) {
         message = "node table: " + TheNodeTree().error;
      } else if (kelplat::CacheReader reader; (status = reader.Attach(cacheBytes, 0)) != KEL_STATUS_OK) {
         message = ORX_ReturnStatusToString(status);
      } else if (!Dumper(reader).Run(out, &status)) {
         message = ORX_ReturnStatusToString(status);
      } else {
         return true;
      }
   } catch (const Json::exception &e) {
      message = e.what();
   } catch (const std::bad_alloc &) {
      message = "out of memory";
   } catch (const std::exception &e) {
      message = std::string("internal error: ") + e.what();
   }
   if (error != nullptr) *error = message;
   return false;
}

}  // namespace

bool DumpCache(std::string_view cacheBytes, std::string *jsonText, std::string *error) {
   kelcache::TextOut out(nullptr);
   if (!DumpInto(cacheBytes, out, error)) return false;
   if (jsonText != nullptr) *jsonText = std::move(out.text);
   return true;
}

bool DumpCacheTo(std::string_view cacheBytes, FILE *file, std::string *error) {
   kelcache::TextOut out(file);
   bool ok = DumpInto(cacheBytes, out, error);
   if (out.error != 0) errno = out.error;
   return ok;
}
