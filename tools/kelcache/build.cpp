// Snapshot JSON to cache file bytes.
#include <algorithm>
#include <array>
#include <memory>
#include <unordered_set>

#include "byteset.h"
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

   // Starts a value whose own JSON path is base.
   void Begin(std::string base) { base_ = std::move(base); }
   // Whether no object or array is open: the value begun is complete.
   bool Idle() const { return frames_.empty(); }

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
   static constexpr size_t kLinearMembers = 16;

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
      std::string path = base_;
      for (const Frame &f : frames_) {
         if (f.container->is_array())
            path = ElementPath(path, f.container->size() - 1);
         else
            path = MemberPath(path, f.container->get_ref<const Json::object_t &>().back().first);
      }
      return path;
   }

   std::vector<Frame> frames_;
   std::string base_;
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

// What a snapshot may make: 256 MiB, or sixteen times its own size when
// that is more (a host of a million worlds makes a file of about 900 MB
// from 650 MB of JSON), so that a small snapshot of long patterns cannot
// take gigabytes of memory; never as much as 4 GiB, the most a cache file's
// offsets reach.
uint64_t CacheSizeLimit(uint64_t textSize) {
   constexpr uint64_t kFloor = 256u << 20, kCeiling = uint64_t(4095) << 20;
   return std::min(std::max(kFloor, textSize * 16), kCeiling);
}

// {} (or an object of "$unlisted" alone) as the value of an instance.
bool IsEmptyInstance(const Json &value) {
   return value.is_object() && (value.empty() || (value.size() == 1 && value.contains("$unlisted")));
}

std::array<uint8_t, 16> DefaultSignature() {
   std::array<uint8_t, 16> signature;
   std::copy(kelplat::ToolSignature().begin(), kelplat::ToolSignature().end(), signature.begin());
   return signature;
}

Key MetaKey(std::string_view name) { return Key{KEL_PARAM_STRING, 0, std::string(name)}; }

class Builder {
public:
   // Entries go to cache->writer; the header's fields to the others.
   Builder(SnapshotCache &cache, uint64_t textSize) : cache_(cache), limit_(CacheSizeLimit(textSize)) {
      cache_.signature = DefaultSignature();
      cache_.buildDate = "unknown";
   }
   // A member of the snapshot's top level; "tree" is walked by Walk.
   void TopMember(const std::string &name, Json &value);

   // The value at a position: a record, a data content, an object of
   // instances, or an object of fixed names.  null stores nothing.
   // instance: the value is a member of an object of instances, so it may
   // carry "$unlisted".
   void Walk(int pos, Json &value, const std::string &path, bool instance);
   // Whether Walk takes an object at pos member by member (a level or fixed
   // names), rather than as a record or a data content.
   bool TakesMembers(int pos) const {
      const Position &at = tree_.at(pos);
      return at.node == nullptr || (!(at.node->flags & kelplat::KEL_NF_DATA) && at.node->recordSize == 0);
   }
   // The position of a fixed member of an object at pos.
   int FixedMember(int pos, std::string_view name, const std::string &path) const {
      int child = tree_.FixedChild(pos, name);
      if (child < 0) Fail(path, "no such node");
      return child;
   }

   // An object of instances, walked member by member: its member names are
   // the keys, in listing order.
   struct Level {
      int level;
      const kelplat::NodeInfo *lister;  // the node that lists them, if any
      std::optional<uint32_t> listStatus;
      bool noListing = false;
      std::vector<Key> listed;
      ByteSet seen;  // encoded keys
   };
   // The level below pos, or nothing when pos has fixed names.
   std::optional<Level> StartLevel(int pos) const {
      int level = tree_.LevelChild(pos);
      if (level < 0) return std::nullopt;
      return Level{level, tree_.at(level).node, {}, false, {}, {}};
   }
   // One member; its value is released once stored, so that the cache grows
   // into the memory the document gives up.
   void LevelMember(Level &level, const std::string &name, Json &value, const std::string &path);
   void EndLevel(const Level &level, const std::string &path);

private:
   void Add(std::string_view lookup, uint32_t status, std::string_view data, const std::string &path) {
      // Each record and content is capped; so is their sum, so that no
      // snapshot makes a file of gigabytes.
      total_ += lookup.size() + data.size();
      if (total_ > limit_)
         Fail(path, "makes the cache file larger than " + std::to_string(limit_ >> 20) + " MiB");
      if (!cache_.writer.Add(lookup, status, data))
         Fail(path, "makes an entry that another member made already");
   }
   void Simulator(const Json &value, const std::string &path);
   void RawEntries(const Json &value, const std::string &path);

   const NodeTree &tree_ = TheNodeTree();
   SnapshotCache &cache_;
   RecordCodec records_;
   std::vector<Key> keys_;  // the instance keys down to the current position
   uint64_t total_ = 0;
   const uint64_t limit_;
};

void Builder::TopMember(const std::string &name, Json &value) {
   std::string p = MemberPath("", name);
   if (name == "buildDate") {
      std::string date = ReadText(value, p);
      if (date.size() > kelplat::kBuildDateMax) Fail(p, "longer than 20 characters");
      if (date.find('\0') != std::string::npos) Fail(p, "contains a NUL");
      cache_.buildDate = std::move(date);
   } else if (name == "signature") {
      std::string bytes = ReadHex(value, p);
      if (bytes.size() != cache_.signature.size()) Fail(p, "expected 32 hex digits");
      std::copy(bytes.begin(), bytes.end(), cache_.signature.begin());
   } else if (name == "tree") {
      Walk(0, value, p, false);
   } else if (name == "simulator") {
      Simulator(value, p);
   } else if (name == "rawEntries") {
      RawEntries(value, p);
   } else {
      Fail(p, "unknown member");
   }
}

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
      RecordEntry r = records_.Encode(*at.node, value, path, instance);
      Add(kelplat::EncodeLookup(Op::Get, at.node->number, keys_), r.status, r.data, path);
      if (r.setStatus) Add(kelplat::EncodeLookup(Op::Set, at.node->number, keys_), *r.setStatus, "", path);
      return;
   }
   if (!value.is_object())
      Fail(path, at.children.empty() ? "expected {} or null: instances here are only listed"
                                     : "expected an object, not " + std::string(value.type_name()));
   if (std::optional<Level> level = StartLevel(pos)) {
      for (auto it = value.begin(); it != value.end(); ++it)
         LevelMember(*level, it.key(), *it, MemberPath(path, it.key()));
      EndLevel(*level, path);
      return;
   }
   for (auto it = value.begin(); it != value.end(); ++it) {
      if (instance && it.key() == "$unlisted") continue;
      std::string p = MemberPath(path, it.key());
      Walk(FixedMember(pos, it.key(), p), *it, p, false);
   }
}

void Builder::LevelMember(Level &l, const std::string &name, Json &value, const std::string &p) {
   bool control = name == "$listStatus" || name == "$noListing";
   bool unlisted = !control && value.is_object() && value.contains("$unlisted");
   if ((control || unlisted) && l.lister == nullptr)
      Fail(unlisted ? MemberPath(p, "$unlisted") : p, "the instances here are not listed");
   if (name == "$listStatus") {
      l.listStatus = ReadStatus(value, p);
      return;
   }
   if (name == "$noListing") {
      l.noListing = ReadBool(value, p);
      return;
   }
   Key key = ParseKeyName(name, tree_.at(l.level).levelKind, p);
   std::string encoded;
   kelplat::AppendKey(encoded, key);
   if (!l.seen.Insert(encoded).second) Fail(p, "the same instance key as an earlier member");
   if (unlisted) unlisted = ReadBool(value.at("$unlisted"), MemberPath(p, "$unlisted"));
   if (!unlisted) l.listed.push_back(key);
   keys_.push_back(std::move(key));
   Walk(l.level, value, p, true);
   value = nullptr;
   keys_.pop_back();
}

void Builder::EndLevel(const Level &l, const std::string &path) {
   if (l.noListing && l.listStatus) Fail(path, "$listStatus and $noListing exclude each other");
   if (l.lister != nullptr && !l.noListing)
      Add(kelplat::EncodeLookup(Op::List, l.lister->number, keys_), l.listStatus.value_or(KEL_STATUS_OK),
          kelplat::EncodeList(l.listed), path);
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
      } else if (it.key() == "signalAnyProcess") {
         text = ReadBool(*it, p) ? "1" : "0";
      } else {
         Fail(p, "unknown member");
      }
      Key key = MetaKey(it.key() == "corafsRoot"         ? "corafs.root"
                        : it.key() == "signalAnyProcess" ? "signal.any"
                                                         : "corafs.rules");
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

// Reads the snapshot and walks it as it is read.  The objects above the
// instances (the top level, "tree", its fixed names and the objects of
// instances) are taken member by member, and only one member's value at a
// time is held as a document, so that memory stays near the size of the
// text.  Mistakes come out as after a whole read: a syntax error or a member
// given twice comes before any mistake the walk finds, so the walk's first
// mistake waits until the text has been read to its end.
class StreamingReader {
public:
   explicit StreamingReader(Builder &builder) : builder_(builder) {}

   // Once the parser has read the whole text: the walk's first mistake.
   void Finish() {
      if (failed_) throw firstError_;
   }

   bool null() { return Forward([&] { value_.null(); }); }
   bool boolean(bool v) { return Forward([&] { value_.boolean(v); }); }
   bool number_integer(Json::number_integer_t v) { return Forward([&] { value_.number_integer(v); }); }
   bool number_unsigned(Json::number_unsigned_t v) { return Forward([&] { value_.number_unsigned(v); }); }
   bool number_float(Json::number_float_t v, const std::string &s) {
      return Forward([&] { value_.number_float(v, s); });
   }
   bool string(std::string &v) { return Forward([&] { value_.string(v); }); }
   bool binary(Json::binary_t &v) { return Forward([&] { value_.binary(v); }); }
   bool start_array(size_t n) { return Forward([&] { value_.start_array(n); }); }
   bool end_array() { return Forward([&] { value_.end_array(); }); }
   bool start_object(size_t n) {
      if (value_.Idle() && OpenFrame()) return true;
      return Forward([&] { value_.start_object(n); });
   }
   bool key(std::string &name);
   bool end_object();
   template <class Exception>
   bool parse_error(size_t, const std::string &, const Exception &e) {
      throw e;
   }

private:
   enum class Kind { Top, Fixed, Level };
   // An object taken member by member.
   struct Frame {
      Kind kind;
      int pos;           // its position (Fixed, Level)
      std::string path;  // its JSON path
      std::optional<Builder::Level> level;
      ByteSet names;  // for a member given twice
      std::string key, memberPath;  // the member being read
      int child = -1;                // its position (Fixed)
   };

   // Passes an event to the document of the current member's value, and that
   // value to the walk once it is complete.
   template <class Event>
   bool Forward(Event event) {
      if (value_.Idle()) value_.Begin(frames_.empty() ? std::string() : frames_.back().memberPath);
      event();
      if (value_.Idle()) Deliver();
      return true;
   }
   // A step of the walk; after its first mistake the text is only read.
   template <class Step>
   void Walk(Step step) {
      if (failed_) return;
      try {
         step();
      } catch (SnapshotError &e) {
         failed_ = true;
         firstError_ = std::move(e);
      }
   }
   bool OpenFrame();
   void Deliver();

   Builder &builder_;
   DocumentBuilder value_;
   std::vector<Frame> frames_;
   bool failed_ = false;
   SnapshotError firstError_;
};

// Starts taking an object member by member when the walk would do so.
bool StreamingReader::OpenFrame() {
   if (failed_) return false;
   if (frames_.empty()) {
      frames_.push_back({Kind::Top, -1, ""});
      return true;
   }
   const Frame &f = frames_.back();
   int pos;
   if (f.kind == Kind::Top && f.key == "tree")
      pos = 0;
   else if (f.kind == Kind::Fixed)
      pos = f.child;
   else
      return false;
   if (!builder_.TakesMembers(pos)) return false;
   Frame object{Kind::Fixed, pos, f.memberPath};
   object.level = builder_.StartLevel(pos);
   if (object.level) object.kind = Kind::Level;
   frames_.push_back(std::move(object));
   return true;
}

bool StreamingReader::key(std::string &name) {
   if (!value_.Idle()) return value_.key(name);
   Frame &f = frames_.back();
   if (!f.names.Insert(name).second) Fail(MemberPath(f.path, name), "member given twice");
   f.key = std::move(name);
   f.memberPath = MemberPath(f.path, f.key);
   if (f.kind == Kind::Fixed) Walk([&] { f.child = builder_.FixedMember(f.pos, f.key, f.memberPath); });
   return true;
}

bool StreamingReader::end_object() {
   if (!value_.Idle()) return Forward([&] { value_.end_object(); });
   Frame &f = frames_.back();
   if (f.level) Walk([&] { builder_.EndLevel(*f.level, f.path); });
   frames_.pop_back();
   return true;
}

void StreamingReader::Deliver() {
   Json value = std::move(value_.root);
   value_.root = nullptr;
   if (frames_.empty()) return Walk([] { Fail("", "expected an object"); });
   Frame &f = frames_.back();
   Walk([&] {
      switch (f.kind) {
      case Kind::Top: builder_.TopMember(f.key, value); break;
      case Kind::Fixed: builder_.Walk(f.child, value, f.memberPath, false); break;
      case Kind::Level: builder_.LevelMember(*f.level, f.key, value, f.memberPath); break;
      }
   });
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

bool ReadSnapshot(const std::string &jsonText, SnapshotCache *cache, std::string *error) {
   using namespace kelcache;
   std::string message;
   try {
      if (!TheNodeTree().error.empty()) {
         message = "node table: " + TheNodeTree().error;
      } else {
         Builder builder(*cache, jsonText.size());
         StreamingReader reader(builder);
         Json::sax_parse(jsonText, &reader);
         reader.Finish();
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

bool BuildCache(const std::string &jsonText, std::string *cacheBytes, std::string *error) {
   SnapshotCache cache;
   if (!ReadSnapshot(jsonText, &cache, error)) return false;
   try {
      std::string bytes = cache.writer.Finish(cache.signature, cache.buildDate);
      if (cacheBytes != nullptr) *cacheBytes = std::move(bytes);
      return true;
   } catch (const std::bad_alloc &) {
      if (error != nullptr) *error = "out of memory";
      return false;
   }
}
