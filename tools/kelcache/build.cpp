// Snapshot JSON to cache file bytes.
#include <array>
#include <memory>
#include <unordered_set>

#include "content.h"
#include "nodetree.h"
#include "records.h"
#include "snapshot.h"
#include "values.h"

namespace kelcache {

namespace {

using kelplat::Key;
using kelplat::Op;

// Builds the document from the parser's events.  Members are appended in
// the order given (the listing order) without the ordered object's linear
// search; a member name given twice in one object is refused (the plain
// parser would silently keep one of them) through a hash of member indices
// once an object has more than a few members.
class DocumentBuilder {
public:
   Json root;

   bool null() { return Put(nullptr); }
   bool boolean(bool v) { return Put(v); }
   bool number_integer(Json::number_integer_t v) { return Put(v); }
   bool number_unsigned(Json::number_unsigned_t v) { return Put(v); }
   bool number_float(Json::number_float_t v, const std::string &) { return Put(v); }
   bool string(std::string &v) { return Put(std::move(v)); }
   bool binary(Json::binary_t &v) { return Put(Json::binary(std::move(v))); }
   bool start_object(size_t) {
      frames_.push_back({Put(Json::object())});
      return true;
   }
   bool start_array(size_t) {
      frames_.push_back({Put(Json::array())});
      return true;
   }
   bool key(std::string &name);
   bool end_object() { return Pop(); }
   bool end_array() { return Pop(); }
   template <class Exception>
   bool parse_error(size_t, const std::string &, const Exception &e) {
      throw e;
   }

private:
   // The name of member i (the ordered object hides the vector's operator[]).
   static const std::string &Name(const Json::object_t &members, size_t i) {
      return members.begin()[ptrdiff_t(i)].first;
   }
   // Member indices of one object, hashed and compared by name.
   struct IndexHash {
      const Json::object_t *members;
      size_t operator()(size_t i) const { return std::hash<std::string>()(Name(*members, i)); }
   };
   struct IndexEqual {
      const Json::object_t *members;
      bool operator()(size_t a, size_t b) const { return Name(*members, a) == Name(*members, b); }
   };
   using IndexSet = std::unordered_set<size_t, IndexHash, IndexEqual>;
   static constexpr size_t kLinearMembers = 8;

   struct Frame {
      Json *container;
      std::unique_ptr<IndexSet> index;  // made when the object outgrows kLinearMembers
   };

   // Places a value: the root, the next array element, or the value of the
   // member whose name came last.
   Json *Put(Json &&value) {
      if (frames_.empty()) {
         root = std::move(value);
         return &root;
      }
      Json &c = *frames_.back().container;
      if (c.is_array()) {
         c.get_ref<Json::array_t &>().push_back(std::move(value));
         return &c.get_ref<Json::array_t &>().back();
      }
      Json &slot = c.get_ref<Json::object_t &>().back().second;
      slot = std::move(value);
      return &slot;
   }
   bool Pop() {
      frames_.pop_back();
      return true;
   }
   // The JSON path of the member being added to the innermost object.
   std::string CurrentPath() const {
      std::string path;
      for (const Frame &f : frames_) {
         if (f.container->is_array())
            path = ElementPath(path, f.container->size() - 1);
         else
            path = MemberPath(path, f.container->get_ref<const Json::object_t &>().back().first);
      }
      return path;
   }

   std::vector<Frame> frames_;
};

bool DocumentBuilder::key(std::string &name) {
   Frame &f = frames_.back();
   Json::object_t &members = f.container->get_ref<Json::object_t &>();
   // The vector's own emplace_back: the ordered object's emplace searches.
   members.emplace_back(std::move(name), nullptr);
   size_t added = members.size() - 1;
   bool repeated = false;
   if (f.index) {
      repeated = !f.index->insert(added).second;
   } else {
      for (size_t i = 0; i < added && !repeated; i++) repeated = Name(members, i) == Name(members, added);
      if (!repeated && members.size() > kLinearMembers) {
         f.index = std::make_unique<IndexSet>(members.size() * 2, IndexHash{&members}, IndexEqual{&members});
         for (size_t i = 0; i < members.size(); i++) f.index->insert(i);
      }
   }
   if (repeated) Fail(CurrentPath(), "member given twice");
   return true;
}

Json Parse(const std::string &text) {
   DocumentBuilder builder;
   Json::sax_parse(text, &builder);
   return std::move(builder.root);
}

constexpr uint64_t kMaxCacheSize = 256u << 20;

// {} (or an object of "$unlisted" alone) as the value of an instance.
bool IsEmptyInstance(const Json &value) {
   return value.is_object() && (value.empty() || (value.size() == 1 && value.contains("$unlisted")));
}

Key MetaKey(std::string_view name) { return Key{KEL_PARAM_STRING, 0, std::string(name)}; }

class Builder {
public:
   // Walks the document; each instance's value is released once stored, so
   // that the cache grows into the memory the document gives up.
   std::string Run(Json &doc);

private:
   void Add(std::string lookup, uint32_t status, std::string data, const std::string &path) {
      // Each record and content is capped; so is their sum, so that no
      // snapshot makes a file of gigabytes.
      total_ += lookup.size() + data.size();
      if (total_ > kMaxCacheSize) Fail(path, "makes the cache file larger than 256 MiB");
      // Records are made at their node's full size and then trimmed; the
      // stored entry keeps only the bytes, not the spare capacity.
      if (data.capacity() > data.size() + 64) data.shrink_to_fit();
      if (!writer_.Add(std::move(lookup), status, std::move(data)))
         Fail(path, "makes an entry that another member made already");
   }
   void Walk(int pos, Json &value, const std::string &path, bool instance);
   void WalkLevel(int pos, Json &value, const std::string &path);
   void Simulator(const Json &value, const std::string &path);
   void RawEntries(const Json &value, const std::string &path);

   const NodeTree &tree_ = TheNodeTree();
   kelplat::CacheWriter writer_;
   std::vector<Key> keys_;  // the instance keys down to the current position
   uint64_t total_ = 0;
};

std::string Builder::Run(Json &doc) {
   if (!doc.is_object()) Fail("", "expected an object");
   std::string date = "unknown";
   std::array<uint8_t, 16> signature;
   std::copy(kelplat::ToolSignature().begin(), kelplat::ToolSignature().end(), signature.begin());
   for (auto it = doc.begin(); it != doc.end(); ++it) {
      std::string p = MemberPath("", it.key());
      if (it.key() == "buildDate") {
         date = ReadText(*it, p);
         if (date.size() > kelplat::kBuildDateMax) Fail(p, "longer than 20 characters");
         if (date.find('\0') != std::string::npos) Fail(p, "contains a NUL");
      } else if (it.key() == "signature") {
         std::string bytes = ReadHex(*it, p);
         if (bytes.size() != signature.size()) Fail(p, "expected 32 hex digits");
         std::copy(bytes.begin(), bytes.end(), signature.begin());
      } else if (it.key() == "tree") {
         Walk(0, *it, p, false);
      } else if (it.key() == "simulator") {
         Simulator(*it, p);
      } else if (it.key() == "rawEntries") {
         RawEntries(*it, p);
      } else {
         Fail(p, "unknown member");
      }
   }
   return writer_.Finish(signature, date);
}

// The value at a position: a record, a data content, an object of instances,
// or an object of fixed names.  null stores nothing.  instance: the value
// is a member of an object of instances, so it may carry "$unlisted".
void Builder::Walk(int pos, Json &value, const std::string &path, bool instance) {
   if (value.is_null()) return;
   const Position &at = tree_.at(pos);
   if (at.node != nullptr && (at.node->flags & kelplat::KEL_NF_DATA)) {
      DataEntry d = EncodeData(value, path, instance);
      Add(kelplat::EncodeLookup(Op::Data, at.node->number, keys_), d.status, std::move(d.data), path);
      return;
   }
   if (at.node != nullptr && at.node->recordSize > 0) {
      // A listed instance given as {} has nothing to read: its read answers
      // Not found, as one given as null.
      if (instance && IsEmptyInstance(value)) return;
      RecordEntry r = EncodeRecord(*at.node, value, path, instance);
      Add(kelplat::EncodeLookup(Op::Get, at.node->number, keys_), r.status, std::move(r.data), path);
      if (r.setStatus) Add(kelplat::EncodeLookup(Op::Set, at.node->number, keys_), *r.setStatus, "", path);
      return;
   }
   if (!value.is_object())
      Fail(path, at.children.empty() ? "expected {} or null: instances here are only listed"
                                     : "expected an object, not " + std::string(value.type_name()));
   if (tree_.LevelChild(pos) >= 0) {
      WalkLevel(pos, value, path);
      return;
   }
   for (auto it = value.begin(); it != value.end(); ++it) {
      if (instance && it.key() == "$unlisted") continue;
      std::string p = MemberPath(path, it.key());
      int child = tree_.FixedChild(pos, it.key());
      if (child < 0) Fail(p, "no such node");
      Walk(child, *it, p, false);
   }
}

// An object of instances: its member names are the keys, in listing order.
void Builder::WalkLevel(int pos, Json &value, const std::string &path) {
   int level = tree_.LevelChild(pos);
   const kelplat::NodeInfo *lister = tree_.at(level).node;  // the node that lists them, if any
   std::optional<uint32_t> listStatus;
   bool noListing = false;
   std::vector<Key> listed;
   std::unordered_set<std::string> seen;
   for (auto it = value.begin(); it != value.end(); ++it) {
      const std::string &name = it.key();
      std::string p = MemberPath(path, name);
      bool control = name == "$listStatus" || name == "$noListing";
      bool unlisted = !control && it->is_object() && it->contains("$unlisted");
      if ((control || unlisted) && lister == nullptr)
         Fail(unlisted ? MemberPath(p, "$unlisted") : p, "the instances here are not listed");
      if (name == "$listStatus") {
         listStatus = ReadStatus(*it, p);
         continue;
      }
      if (name == "$noListing") {
         noListing = ReadBool(*it, p);
         continue;
      }
      Key key = ParseKeyName(name, tree_.at(level).levelKind, p);
      std::string encoded;
      kelplat::AppendKey(encoded, key);
      if (!seen.insert(encoded).second) Fail(p, "the same instance key as an earlier member");
      if (unlisted) unlisted = ReadBool(it->at("$unlisted"), MemberPath(p, "$unlisted"));
      if (!unlisted) listed.push_back(key);
      keys_.push_back(std::move(key));
      Walk(level, *it, p, true);
      *it = nullptr;
      keys_.pop_back();
   }
   if (noListing && listStatus) Fail(path, "$listStatus and $noListing exclude each other");
   if (lister != nullptr && !noListing)
      Add(kelplat::EncodeLookup(Op::List, lister->number, keys_), listStatus.value_or(KEL_STATUS_OK),
          kelplat::EncodeList(listed), path);
}

// Settings for the simulator, stored as meta entries.
void Builder::Simulator(const Json &value, const std::string &path) {
   if (!value.is_object()) Fail(path, "expected an object");
   for (auto it = value.begin(); it != value.end(); ++it) {
      std::string p = MemberPath(path, it.key());
      std::string text;
      if (it.key() == "corafsRoot") {
         text = ReadText(*it, p);
      } else if (it.key() == "corafsRules") {
         if (!it->is_array()) Fail(p, "expected an array of rules");
         // One line a rule: path, kind, disk and flags, separated by tabs.
         for (size_t i = 0; i < it->size(); i++) {
            const Json &rule = (*it)[i];
            std::string rp = ElementPath(p, i);
            if (!rule.is_object()) Fail(rp, "expected an object");
            std::string fields[4] = {"", "", "", "0"};
            for (auto m = rule.begin(); m != rule.end(); ++m) {
               std::string mp = MemberPath(rp, m.key());
               if (m.key() == "path" || m.key() == "kind" || m.key() == "disk") {
                  const std::string &t = ReadText(*m, mp);
                  if (t.find_first_of("\t\n") != std::string::npos) Fail(mp, "contains a tab or line feed");
                  fields[m.key() == "path" ? 0 : m.key() == "kind" ? 1 : 2] = t;
               } else if (m.key() == "flags") {
                  fields[3] = std::to_string(ReadInt(*m, IntType::U32, mp));
               } else {
                  Fail(mp, "no such member");
               }
            }
            if (fields[1] != "tardisk" && fields[1] != "ramdisk" && fields[1] != "foreign")
               Fail(MemberPath(rp, "kind"), "expected tardisk, ramdisk or foreign");
            if (i > 0) text += '\n';
            text += fields[0] + '\t' + fields[1] + '\t' + fields[2] + '\t' + fields[3];
         }
      } else {
         Fail(p, "unknown member");
      }
      Key key = MetaKey(it.key() == "corafsRoot" ? "corafs.root" : "corafs.rules");
      Add(kelplat::EncodeLookup(Op::Meta, 0, std::span<const Key>(&key, 1)), KEL_STATUS_OK, text, p);
   }
}

// Entries given as bytes, for what the tree cannot say (damaged listings,
// unknown nodes).
void Builder::RawEntries(const Json &value, const std::string &path) {
   if (!value.is_array()) Fail(path, "expected an array of entries");
   for (size_t i = 0; i < value.size(); i++) {
      std::string p = ElementPath(path, i);
      const Json &entry = value[i];
      if (!entry.is_object() || !entry.contains("key")) Fail(p, "expected an object with a key");
      std::string key, data;
      uint32_t status = KEL_STATUS_OK;
      for (auto m = entry.begin(); m != entry.end(); ++m) {
         std::string mp = MemberPath(p, m.key());
         if (m.key() == "key")
            key = ReadHex(*m, mp);
         else if (m.key() == "status")
            status = ReadStatus(*m, mp);
         else if (m.key() == "data")
            data = ReadHex(*m, mp);
         else
            Fail(mp, "no such member");
      }
      Add(std::move(key), status, std::move(data), p);
   }
}

std::string WithoutTag(std::string_view what) {
   // nlohmann's messages start with "[json.exception.<kind>.<id>] ".
   if (what.starts_with("[json.exception.")) {
      size_t end = what.find("] ");
      if (end != std::string_view::npos) what.remove_prefix(end + 2);
   }
   return std::string(what);
}

}  // namespace

}  // namespace kelcache

bool BuildCache(const std::string &jsonText, std::string *cacheBytes, std::string *error) {
   using namespace kelcache;
   std::string message;
   try {
      if (!TheNodeTree().error.empty()) {
         message = "node table: " + TheNodeTree().error;
      } else {
         Json doc = Parse(jsonText);
         std::string bytes = Builder().Run(doc);
         if (cacheBytes != nullptr) *cacheBytes = std::move(bytes);
         return true;
      }
   } catch (const SnapshotError &e) {
      message = (e.path.empty() ? "/" : e.path) + ": " + e.what;
   } catch (const Json::parse_error &e) {
      message = "malformed JSON: " + WithoutTag(e.what());
   } catch (const Json::exception &e) {
      message = WithoutTag(e.what());
   } catch (const std::bad_alloc &) {
      message = "out of memory";
   } catch (const std::exception &e) {
      message = std::string("internal error: ") + e.what();
   }
   if (error != nullptr) *error = message;
   return false;
}
