// Snapshot JSON to cache file bytes.
#include <array>
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

// Parses the text, refusing a member name given twice in one object (the
// parser would silently keep one of them).
Json Parse(const std::string &text) {
   struct Frame {
      bool array;
      size_t index = 0;
      std::string key;
      std::unordered_set<std::string> seen;
   };
   std::vector<Frame> frames;
   auto containerPath = [&] {
      std::string path;
      for (size_t i = 0; i + 1 < frames.size(); i++)
         path = frames[i].array ? ElementPath(path, frames[i].index) : MemberPath(path, frames[i].key);
      return path;
   };
   auto elementDone = [&] {
      if (!frames.empty() && frames.back().array) frames.back().index++;
   };
   Json::parser_callback_t callback = [&](int, Json::parse_event_t event, Json &parsed) {
      switch (event) {
      case Json::parse_event_t::object_start: frames.push_back({false}); break;
      case Json::parse_event_t::array_start: frames.push_back({true}); break;
      case Json::parse_event_t::key: {
         Frame &f = frames.back();
         f.key = parsed.get<std::string>();
         if (!f.seen.insert(f.key).second) Fail(MemberPath(containerPath(), f.key), "member given twice");
         break;
      }
      case Json::parse_event_t::object_end:
      case Json::parse_event_t::array_end:
         frames.pop_back();
         elementDone();
         break;
      case Json::parse_event_t::value: elementDone(); break;
      }
      return true;
   };
   return Json::parse(text, callback);
}

constexpr uint64_t kMaxCacheSize = 256u << 20;

// {} (or an object of "$unlisted" alone) as the value of an instance.
bool IsEmptyInstance(const Json &value) {
   return value.is_object() && (value.empty() || (value.size() == 1 && value.contains("$unlisted")));
}

Key MetaKey(std::string_view name) { return Key{KEL_PARAM_STRING, 0, std::string(name)}; }

class Builder {
public:
   std::string Run(const Json &doc);

private:
   void Add(std::string lookup, uint32_t status, std::string data, const std::string &path) {
      // Each record and content is capped; so is their sum, so that no
      // snapshot makes a file of gigabytes.
      total_ += lookup.size() + data.size();
      if (total_ > kMaxCacheSize) Fail(path, "makes the cache file larger than 256 MiB");
      if (!writer_.Add(std::move(lookup), status, std::move(data)))
         Fail(path, "makes an entry that another member made already");
   }
   void Walk(int pos, const Json &value, const std::string &path, bool instance);
   void WalkLevel(int pos, const Json &value, const std::string &path);
   void Simulator(const Json &value, const std::string &path);
   void RawEntries(const Json &value, const std::string &path);

   const NodeTree &tree_ = TheNodeTree();
   kelplat::CacheWriter writer_;
   std::vector<Key> keys_;  // the instance keys down to the current position
   uint64_t total_ = 0;
};

std::string Builder::Run(const Json &doc) {
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
void Builder::Walk(int pos, const Json &value, const std::string &path, bool instance) {
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
void Builder::WalkLevel(int pos, const Json &value, const std::string &path) {
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
