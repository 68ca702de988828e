// Cache file bytes to snapshot JSON.
//
// Entries are first gathered into a tree of places mirroring the snapshot's
// "tree"; that tree is then written out, listed instances in listing order.
// An entry that the tree cannot give back byte for byte goes to "rawEntries".
#include <algorithm>
#include <memory>
#include <unordered_map>
#include <unordered_set>

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

struct Entry {
   std::string_view key;
   uint32_t status;
   std::string_view data;
};

// An entry's key taken apart.
struct Lookup {
   Op op;
   KEL_Node node;
   std::vector<Key> keys;
};

std::optional<Lookup> DecodeLookup(std::string_view key) {
   if (key.size() < 3) return std::nullopt;
   Lookup l{Op(uint8_t(key[0])), KEL_Node(uint8_t(key[1]) | uint8_t(key[2]) << 8), {}};
   size_t pos = 3;
   while (pos < key.size()) {
      Key k;
      if (!kelplat::DecodeKey(key, &pos, &k)) return std::nullopt;
      l.keys.push_back(std::move(k));
   }
   return l;
}

std::string Encoded(const Key &key) {
   std::string out;
   kelplat::AppendKey(out, key);
   return out;
}

// What was found at one position for one set of instance keys.  A place is
// made for each instance and each fixed name below one, so it is kept small:
// what only an object of instances has lives apart.
struct Place;
struct LevelPlace {
   std::vector<std::pair<Key, std::unique_ptr<Place>>> instances;  // in order of appearance
   std::unordered_map<std::string, size_t> index;                 // by encoded key
   const Entry *listing = nullptr;
   std::vector<Key> listed;
};
struct Place {
   std::vector<std::pair<int, std::unique_ptr<Place>>> fixed;  // by child position; a node has few
   std::unique_ptr<LevelPlace> level;
   const Entry *get = nullptr, *data = nullptr, *set = nullptr;

   Place *Fixed(int pos) const {
      for (const auto &[p, child] : fixed)
         if (p == pos) return child.get();
      return nullptr;
   }
   LevelPlace &Level() {
      if (!level) level = std::make_unique<LevelPlace>();
      return *level;
   }
};

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

// Appends value as dump(2) prints it, nested depth levels deep: its lines
// after the first take the indentation of that depth (a string in JSON
// holds no raw line feed, so each line feed starts a line).
void AppendJson(std::string &out, const Json &value, int depth) {
   std::string text = value.dump(2);
   for (char c : text) {
      out += c;
      if (c == '\n') out.append(size_t(depth) * 2, ' ');
   }
}

// An object written member by member in the layout of dump(2), so that a
// dump of any size is never held as a document; its members are appended
// without a search (the callers give each name once).
class ObjectWriter {
public:
   ObjectWriter(std::string &out, int depth) : out_(out), depth_(depth) {}
   // Starts a member; its value follows at depth + 1.
   void Member(std::string_view name) {
      out_ += any_ ? ",\n" : "{\n";
      any_ = true;
      out_.append(size_t(depth_ + 1) * 2, ' ');
      out_ += Json(std::string(name)).dump();
      out_ += ": ";
   }
   void Member(std::string_view name, const Json &value) {
      Member(name);
      AppendJson(out_, value, depth_ + 1);
   }
   void End() {
      if (!any_) {
         out_ += "{}";
         return;
      }
      out_ += '\n';
      out_.append(size_t(depth_) * 2, ' ');
      out_ += '}';
   }

private:
   std::string &out_;
   int depth_;
   bool any_ = false;
};

class Dumper {
public:
   // Writes the snapshot to out, or returns false with *status set when the
   // file is damaged.
   bool Run(const kelplat::CacheReader &reader, std::string &out, KEL_Status *status);

private:
   bool PlaceListing(const Entry &e, const Lookup &l);
   bool PlaceRead(const Entry &e, const Lookup &l);
   bool PlaceSet(const Entry &e, const Lookup &l);
   bool PlaceMeta(const Entry &e, const Lookup &l);
   bool Representable(int pos, const std::vector<Key> &keys) const;
   Place *Reach(int pos, const std::vector<Key> &keys, bool create);
   void Emit(int pos, const Place *place, bool unlisted, std::string &out, int depth) const;

   const NodeTree &tree_ = TheNodeTree();
   mutable RecordEncoder records_;  // scratch space
   Place root_;
   Json simulator_ = Json::object();
};

bool Dumper::Run(const kelplat::CacheReader &reader, std::string &out, KEL_Status *status) {
   std::vector<Entry> entries(reader.EntryCount());
   std::unordered_set<std::string_view> seen;
   for (uint32_t i = 0; i < entries.size(); i++) {
      kelplat::CacheHit hit;
      if (!reader.EntryAt(i, &entries[i].key, &hit) || !seen.insert(entries[i].key).second) {
         *status = KEL_STATUS_CACHE_CORRUPT;
         return false;
      }
      entries[i].status = hit.status;
      entries[i].data = hit.data;
   }
   // In key order, as a built file has them, whatever order this file's index has.
   std::sort(entries.begin(), entries.end(), [](const Entry &a, const Entry &b) { return a.key < b.key; });

   // Listings first, so that reads know which instances are listed; sets
   // last, as they join the read of the same record.  An entry's key is
   // decoded in the phase of its operation only, so that the decoded keys of
   // all entries are never held at once.
   auto phaseOf = [](std::string_view key) {
      switch (key.empty() ? Op(0) : Op(uint8_t(key[0]))) {
      case Op::List:
      case Op::Meta: return 0;
      case Op::Get:
      case Op::Data: return 1;
      case Op::Set: return 2;
      default: return -1;  // an unknown operation stays raw
      }
   };
   std::vector<bool> placed(entries.size());
   for (int phase = 0; phase < 3; phase++) {
      for (size_t i = 0; i < entries.size(); i++) {
         const Entry &e = entries[i];
         if (phaseOf(e.key) != phase) continue;
         std::optional<Lookup> l = DecodeLookup(e.key);
         if (!l) continue;
         switch (l->op) {
         case Op::List: placed[i] = PlaceListing(e, *l); break;
         case Op::Meta: placed[i] = PlaceMeta(e, *l); break;
         case Op::Get:
         case Op::Data: placed[i] = PlaceRead(e, *l); break;
         case Op::Set: placed[i] = PlaceSet(e, *l); break;
         default: break;
         }
      }
   }

   ObjectWriter doc(out, 0);
   std::string date = reader.BuildDate();
   if (!ValidUtf8(date))
      for (char &c : date)
         if (uint8_t(c) >= 0x80) c = '?';
   doc.Member("buildDate", date);
   doc.Member("signature", ToHex({reinterpret_cast<const char *>(reader.Signature().data()), 16}));
   if (!simulator_.empty()) doc.Member("simulator", simulator_);
   doc.Member("tree");
   Emit(0, &root_, false, out, 1);
   Json raw = Json::array();
   for (size_t i = 0; i < entries.size(); i++) {
      if (placed[i]) continue;
      Json r = Json::object();
      r["key"] = ToHex(entries[i].key);
      if (entries[i].status != KEL_STATUS_OK) r["status"] = FormatStatus(entries[i].status);
      if (!entries[i].data.empty()) r["data"] = ToHex(entries[i].data);
      raw.push_back(r);
   }
   if (!raw.empty()) doc.Member("rawEntries", raw);
   doc.End();
   out += '\n';
   return true;
}

bool Dumper::PlaceListing(const Entry &e, const Lookup &l) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || !kelplat::EndsWithLevel(node->path) ||
       l.keys.size() + 1 != kelplat::LevelCount(node->path))
      return false;
   std::vector<Key> listed;
   if (!kelplat::DecodeList(e.data, &listed)) return false;
   int pos = tree_.nodePosition[l.node];
   std::unordered_set<std::string> unique;
   for (const Key &k : listed)
      if (!KeyName(k, tree_.at(pos).levelKind) || !unique.insert(Encoded(k)).second) return false;
   int levelObject = tree_.at(pos).parent;
   if (!Representable(levelObject, l.keys)) return false;
   Place *place = Reach(levelObject, l.keys, true);
   place->Level().listing = &e;
   place->Level().listed = std::move(listed);
   return true;
}

bool Dumper::PlaceRead(const Entry &e, const Lookup &l) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || l.keys.size() != kelplat::LevelCount(node->path)) return false;
   int pos = tree_.nodePosition[l.node];
   if (l.op == Op::Data) {
      if (!(node->flags & kelplat::KEL_NF_DATA) || !DumpData(e.status, e.data, true)) return false;
   } else {
      if (node->recordSize == 0 || (node->flags & kelplat::KEL_NF_DATA)) return false;
      if (!DumpRecord(*node, {e.status, e.data, {}}, true, records_)) return false;
   }
   if (!Representable(pos, l.keys)) return false;
   Place *place = Reach(pos, l.keys, true);
   (l.op == Op::Data ? place->data : place->get) = &e;
   return true;
}

// A set answer rides on the read of the same record.
bool Dumper::PlaceSet(const Entry &e, const Lookup &l) {
   const NodeInfo *node = kelplat::FindNode(l.node);
   if (node == nullptr || !(node->flags & kelplat::KEL_NF_SET) || !e.data.empty() ||
       l.keys.size() != kelplat::LevelCount(node->path) || !Representable(tree_.nodePosition[l.node], l.keys))
      return false;
   Place *place = Reach(tree_.nodePosition[l.node], l.keys, false);
   if (place == nullptr || place->get == nullptr) return false;
   place->set = &e;
   return true;
}

bool Dumper::PlaceMeta(const Entry &e, const Lookup &l) {
   if (l.node != 0 || l.keys.size() != 1 || l.keys[0].kind != KEL_PARAM_STRING || e.status != KEL_STATUS_OK)
      return false;
   const std::string &name = l.keys[0].text;
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

// Whether every instance key on the way to pos has a member name.
bool Dumper::Representable(int pos, const std::vector<Key> &keys) const {
   size_t k = 0;
   for (int c : tree_.Chain(pos))
      if (tree_.at(c).levelKind >= 0 && !KeyName(keys[k++], tree_.at(c).levelKind)) return false;
   return true;
}

Place *Dumper::Reach(int pos, const std::vector<Key> &keys, bool create) {
   Place *place = &root_;
   size_t k = 0;
   for (int c : tree_.Chain(pos)) {
      if (tree_.at(c).levelKind < 0) {
         Place *child = place->Fixed(c);
         if (child == nullptr) {
            if (!create) return nullptr;
            child = place->fixed.emplace_back(c, std::make_unique<Place>()).second.get();
         }
         place = child;
         continue;
      }
      if (!create && !place->level) return nullptr;
      LevelPlace &level = place->Level();
      const Key &key = keys[k++];
      auto it = level.index.find(Encoded(key));
      if (it == level.index.end()) {
         if (!create) return nullptr;
         it = level.index.emplace(Encoded(key), level.instances.size()).first;
         level.instances.emplace_back(key, std::make_unique<Place>());
      }
      place = level.instances[it->second].second.get();
   }
   return place;
}

// Writes the JSON at a position, depth levels deep; place is null for a
// listed instance with nothing stored below it.
void Dumper::Emit(int pos, const Place *place, bool unlisted, std::string &out, int depth) const {
   const Position &at = tree_.at(pos);
   if (at.node != nullptr && (at.node->flags & kelplat::KEL_NF_DATA)) {
      Json j = nullptr;
      if (place != nullptr && place->data != nullptr)
         j = DumpData(place->data->status, place->data->data, unlisted).value_or(nullptr);
      AppendJson(out, unlisted ? MarkUnlisted(j) : j, depth);
      return;
   }
   if (at.node != nullptr && at.node->recordSize > 0) {
      Json j = nullptr;
      if (place != nullptr && place->get != nullptr) {
         RecordEntry r{place->get->status, place->get->data, {}};
         if (place->set != nullptr) r.setStatus = place->set->status;
         j = DumpRecord(*at.node, r, unlisted, records_).value_or(nullptr);
      }
      AppendJson(out, unlisted ? MarkUnlisted(j) : j, depth);
      return;
   }
   ObjectWriter object(out, depth);
   if (unlisted) object.Member("$unlisted", true);
   if (place == nullptr) return object.End();
   int level = tree_.LevelChild(pos);
   if (level < 0) {
      for (int c : at.children)
         if (const Place *child = place->Fixed(c)) {
            object.Member(tree_.at(c).name);
            Emit(c, child, false, out, depth + 1);
         }
      return object.End();
   }
   int kind = tree_.at(level).levelKind;
   static const LevelPlace kNoInstances;
   const LevelPlace &lv = place->level ? *place->level : kNoInstances;
   if (lv.listing != nullptr && lv.listing->status != KEL_STATUS_OK)
      object.Member("$listStatus", FormatStatus(lv.listing->status));
   if (lv.listing == nullptr && tree_.at(level).node != nullptr) object.Member("$noListing", true);
   std::unordered_set<std::string> done;
   for (const Key &k : lv.listed) {
      auto it = lv.index.find(Encoded(k));
      const Place *child = it == lv.index.end() ? nullptr : lv.instances[it->second].second.get();
      object.Member(*KeyName(k, kind));
      Emit(level, child, false, out, depth + 1);
      done.insert(Encoded(k));
   }
   for (const auto &[k, child] : lv.instances)
      if (!done.contains(Encoded(k))) {
         object.Member(*KeyName(k, kind));
         Emit(level, child.get(), lv.listing != nullptr, out, depth + 1);
      }
   object.End();
}

}  // namespace

}  // namespace kelcache

bool DumpCache(std::string_view cacheBytes, std::string *jsonText, std::string *error) {
   using namespace kelcache;
   std::string message;
   try {
      KEL_Status status = KEL_STATUS_OK;
      if (!TheNodeTree().error.empty()) {
         message = "node table: " + TheNodeTree().error;
      } else if (kelplat::CacheReader reader; (status = reader.Attach(cacheBytes, 0)) != KEL_STATUS_OK) {
         message = ORX_ReturnStatusToString(status);
      } else if (std::string text; !Dumper().Run(reader, text, &status)) {
         message = ORX_ReturnStatusToString(status);
      } else {
         if (jsonText != nullptr) *jsonText = std::move(text);
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
