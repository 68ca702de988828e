// kelcache: snapshots to cache files and back.
#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <fstream>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include "cachefile.h"
#include "kel/kel.h"
#include "nodetable.h"
#include "snapshot.h"

using namespace kelplat;

namespace {

Key Int(uint64_t v) { return Key{KEL_PARAM_INT, v, {}}; }
Key Text(std::string t) { return Key{KEL_PARAM_STRING, 0, std::move(t)}; }

std::string MustBuild(const std::string &json) {
   std::string bytes, error;
   EXPECT_TRUE(BuildCache(json, &bytes, &error)) << error;
   return bytes;
}

std::string MustDump(std::string_view bytes) {
   std::string json, error;
   EXPECT_TRUE(DumpCache(bytes, &json, &error)) << error;
   return json;
}

std::string BuildError(const std::string &json) {
   std::string bytes, error;
   EXPECT_FALSE(BuildCache(json, &bytes, &error)) << json;
   return error;
}

// A built snapshot, open for lookups.
class Built {
public:
   explicit Built(const std::string &json) : bytes_(MustBuild(json)) {
      EXPECT_EQ(reader_.Attach(bytes_, 0), KEL_STATUS_OK);
   }
   std::optional<CacheHit> Find(Op op, KEL_Node node, const std::vector<Key> &keys = {}) const {
      CacheHit hit;
      if (reader_.Lookup(EncodeLookup(op, node, keys), &hit) != KEL_STATUS_OK) return std::nullopt;
      return hit;
   }
   std::vector<Key> Listing(KEL_Node node, const std::vector<Key> &keys = {}) const {
      std::vector<Key> out;
      std::optional<CacheHit> hit = Find(Op::List, node, keys);
      EXPECT_TRUE(hit && DecodeList(hit->data, &out));
      return out;
   }
   const std::string &bytes() const { return bytes_; }
   const CacheReader &reader() const { return reader_; }

private:
   std::string bytes_;
   CacheReader reader_;
};

// The record as a read of the node's size sees it (short records zero-filled).
std::string Record(const Built &b, KEL_Node node, const std::vector<Key> &keys = {}) {
   std::optional<CacheHit> hit = b.Find(Op::Get, node, keys);
   EXPECT_TRUE(hit.has_value());
   std::string rec(hit ? hit->data : "");
   rec.resize(std::max<size_t>(rec.size(), FindNode(node)->recordSize), '\0');
   return rec;
}

uint32_t U32At(const std::string &rec, size_t off) {
   return LoadU32(reinterpret_cast<const uint8_t *>(rec.data()) + off);
}

void ExpectRoundTrip(const std::string &json) {
   std::string first = MustBuild(json);
   std::string dumped = MustDump(first);
   EXPECT_EQ(MustBuild(dumped), first) << dumped;
   EXPECT_EQ(MustDump(MustBuild(dumped)), dumped);
}

// Touches each feature of the format once.
constexpr char kSmall[] = R"({
  "buildDate": "Nov 30 2026",
  "signature": "00112233445566778899aabbccddeeff",
  "simulator": {"corafsRoot": "/srv/root",
                "corafsRules": [{"path": "bin", "kind": "tardisk", "disk": "core.tgz", "flags": 4}]},
  "tree": {
    "world": {
      "7": {"name": "netpoll-0", "info": {"worldId": 7, "groupId": -1, "type": "0x21", "securityDomain": 5}},
      "1": {"name": {"$size": 3, "text": "idle0"}},
      "-1": {"$unlisted": true, "info": {"$status": "NO_CARTEL"}},
      "0x20": {"info": {"$raw": "01020304", "sessionId": 9}}
    },
    "userworld": {"cartel": {"$listStatus": "0xbad0062", "1001": {
      "cmdline": "/bin/sh /opt/job.sh",
      "child": {"1002": {"state": 1}, "1003": {"$unlisted": true, "state": 0}},
      "fd": {"fds": {"$noListing": true, "0": {"type": "CHAR", "description": "/dev/null"}}}}}},
    "sched": {"Vcpus": {"7": {"stats": {"affinity": "2", "stateTimes": {"usedTime": 1500000}}}}},
    "hardware": {
      "chipset": {"rtc": {"$setStatus": "BAD_TIME", "year": 2026, "month": 11}},
      "interrupts": {"cookieList": {"48": {"ORXDevices": {"pnic0": {}, "$int:5": null}}}},
      "acpi": {"tables": {"0": {"buffers": {"0": {"signature": "SSDT", "text": "abc"}}}}}
    },
    "system": {
      "bootMAC": {"pxe": 1, "mac": "00:1b:21:4a:6c:10"},
      "corafs": {"tardisks": {"$text:$odd": {}, "core.tgz": {"stats": {"size": 4096}}},
                 "inodes": {"9": {"stats": {"unlinked": true, "name": "gone"}}}},
      "bootOptionFiles": {
        "boot.cfg": {"content": "kernel=a\nmodules=b\n"},
        "big.cfg": {"content": {"pattern": "0123456789\n", "length": 100000, "chunkLimit": 4096}},
        "bad.cfg": {"content": {"status": "NOT_FOUND", "readStatus": 1, "hex": "00ff"}}
      }
    }
  },
  "rawEntries": [{"key": "4ce703", "data": "ffffffff"}]
})";

}  // namespace

TEST(Kelcache, RoundTripIsByteIdentical) { ExpectRoundTrip(kSmall); }

// Levels of many instances: the listing keeps the order given (here
// descending), the dump writes it back in that order, and a key given twice
// far apart is still found.
TEST(Kelcache, LargeLevelsKeepTheirOrder) {
   constexpr uint64_t kWorlds = 3000;
   std::string json = R"({"tree": {"world": {)";
   for (uint64_t id = kWorlds; id > 0; id--)
      json += (id == kWorlds ? "" : ", ") + ("\"" + std::to_string(id) + "\": {\"name\": \"w" + std::to_string(id) + "\"}");
   Built b(json + "}}}");
   std::vector<Key> listed = b.Listing(KEL_NODE_world);
   ASSERT_EQ(listed.size(), kWorlds);
   for (uint64_t i = 0; i < kWorlds; i++) EXPECT_EQ(listed[i].value, kWorlds - i);
   std::string dumped = MustDump(b.bytes());
   EXPECT_LT(dumped.find("\"3000\": {"), dumped.find("\"1\": {"));
   ExpectRoundTrip(json + "}}}");
   EXPECT_EQ(BuildError(json + R"(, "0xbb8": {}}}})"), "/tree/world/0xbb8: the same instance key as an earlier member");
   EXPECT_EQ(BuildError(json + R"(, "1500": {}}}})"), "/tree/world/1500: member given twice");
}

TEST(Kelcache, ExampleHostBuildsAndRoundTrips) {
   std::ifstream in(std::string(ORXKEL_SOURCE_DIR) + "/examples/host.json");
   std::stringstream json;
   json << in.rdbuf();
   ASSERT_FALSE(json.str().empty());
   ExpectRoundTrip(json.str());
}

TEST(Kelcache, HeaderCarriesSignatureAndBuildDate) {
   Built b(kSmall);
   EXPECT_EQ(b.reader().BuildDate(), "Nov 30 2026");
   EXPECT_EQ(b.reader().Signature()[0], 0x00);
   EXPECT_EQ(b.reader().Signature()[15], 0xff);
   // Without them: the tool's own signature, and "unknown".
   Built d(R"({"tree": {}})");
   EXPECT_TRUE(std::equal(ToolSignature().begin(), ToolSignature().end(), d.reader().Signature().begin()));
   EXPECT_EQ(d.reader().BuildDate(), "unknown");
   EXPECT_EQ(d.reader().EntryCount(), 0u);
}

TEST(Kelcache, FieldsLandAtTheirOffsets) {
   Built b(kSmall);
   std::string info = Record(b, KEL_NODE_world_info, {Int(7)});
   EXPECT_EQ(U32At(info, 0), 7u);
   EXPECT_EQ(U32At(info, 4), 0xffffffffu);   // groupId -1
   EXPECT_EQ(U32At(info, 28), 0x21u);        // type given as hex text
   EXPECT_EQ(U32At(info, 45), 5u);           // securityDomain, unaligned
   EXPECT_EQ(info.find_first_not_of('\0', 49), std::string::npos);

   std::string rtc = Record(b, KEL_NODE_hardware_chipset_rtc);
   EXPECT_EQ(U32At(rtc, 16), 11u);
   EXPECT_EQ(U32At(rtc, 20), 2026u);

   std::string mac = Record(b, KEL_NODE_system_bootMAC);
   EXPECT_EQ(mac.substr(0, 7), std::string("\x01\x00\x1b\x21\x4a\x6c\x10", 7));

   // An ACPI buffer's length defaults to the table bytes given.
   std::string acpi = Record(b, KEL_NODE_hardware_acpi_tables_buffers, {Int(0), Int(0)});
   EXPECT_EQ(acpi.substr(0, 4), "SSDT");
   EXPECT_EQ(U32At(acpi, 5), 3u);
   EXPECT_EQ(acpi.substr(9, 3), "abc");

   std::string inode = Record(b, KEL_NODE_system_corafs_inodes_stats, {Int(9)});
   EXPECT_EQ(int32_t(U32At(inode, 20)), -4);
   EXPECT_EQ(inode.substr(288, 5), std::string("gone\0", 5));
}

TEST(Kelcache, RecordsAreStoredWithoutTrailingZeros) {
   Built b(kSmall);
   // 128-byte name records hold just their text; the reader zero-fills.
   EXPECT_EQ(b.Find(Op::Get, KEL_NODE_world_name, {Int(7)})->data, "netpoll-0");
   EXPECT_EQ(b.Find(Op::Get, KEL_NODE_userworld_cartel_cmdline, {Int(1001)})->data, "/bin/sh /opt/job.sh");
   // "$size" keeps the stored length exactly, even cutting the text.
   EXPECT_EQ(b.Find(Op::Get, KEL_NODE_world_name, {Int(1)})->data, "idl");
   // Fields overlay "$raw".
   std::string info(b.Find(Op::Get, KEL_NODE_world_info, {Int(0x20)})->data);
   EXPECT_EQ(info.substr(0, 4), "\x01\x02\x03\x04");
   EXPECT_EQ(info.size(), 25u);  // ends with sessionId's only non-zero byte
   EXPECT_EQ(info[24], 9);
}

TEST(Kelcache, StoredSizeAndRawComeBackInTheDump) {
   std::string json = MustDump(MustBuild(R"({"tree": {"world": {
      "1": {"name": {"$size": 200, "text": "long"}},
      "2": {"name": {"$raw": "41424300ff"}},
      "3": {"name": "exactly-four", "info": {"$size": 2}}}}})"));
   EXPECT_NE(json.find(R"("$size": 200)"), std::string::npos) << json;
   EXPECT_NE(json.find(R"("$raw": "41424300ff")"), std::string::npos) << json;
   EXPECT_NE(json.find(R"("$size": 2)"), std::string::npos) << json;
   EXPECT_NE(json.find(R"("name": "exactly-four")"), std::string::npos) << json;
}

TEST(Kelcache, TextsMayFillTheirFieldWithoutNul) {
   std::string full(128, 'w');
   Built b(R"({"tree": {"world": {"1": {"name": ")" + full + R"("}}}})");
   EXPECT_EQ(b.Find(Op::Get, KEL_NODE_world_name, {Int(1)})->data, full);
   EXPECT_NE(MustDump(b.bytes()).find(full), std::string::npos);
   EXPECT_NE(BuildError(R"({"tree": {"world": {"1": {"name": ")" + full + R"(w"}}}})").find("129 bytes"),
             std::string::npos);
}

TEST(Kelcache, ListingsFollowMemberOrderAndKeyForms) {
   Built b(kSmall);
   EXPECT_EQ(b.Listing(KEL_NODE_world), (std::vector<Key>{Int(7), Int(1), Int(0x20)}));
   EXPECT_EQ(b.Listing(KEL_NODE_system_corafs_tardisks), (std::vector<Key>{Text("$odd"), Text("core.tgz")}));
   EXPECT_EQ(b.Listing(KEL_NODE_hardware_interrupts_cookieList_ORXDevices, {Int(48)}),
             (std::vector<Key>{Text("pnic0"), Int(5)}));
   // "-1" is the two's complement key; unlisted, it is still readable.
   std::optional<CacheHit> hidden = b.Find(Op::Get, KEL_NODE_world_info, {Int(~0ULL)});
   ASSERT_TRUE(hidden);
   EXPECT_EQ(hidden->status, uint32_t(KEL_STATUS_NO_CARTEL));
   // A level with no listing node (sched/Vcpus) stores reads only.
   EXPECT_TRUE(b.Find(Op::Get, KEL_NODE_sched_Vcpus_stats_affinity, {Int(7)}));
}

TEST(Kelcache, FailingListingsAndMissingOnes) {
   Built b(kSmall);
   std::optional<CacheHit> cartels = b.Find(Op::List, KEL_NODE_userworld_cartel);
   ASSERT_TRUE(cartels);
   EXPECT_EQ(cartels->status, uint32_t(KEL_STATUS_NO_CARTEL));
   EXPECT_TRUE(b.Find(Op::Get, KEL_NODE_userworld_cartel_cmdline, {Int(1001)}));
   EXPECT_EQ(b.Listing(KEL_NODE_userworld_cartel_child, {Int(1001)}), std::vector<Key>{Int(1002)});
   EXPECT_TRUE(b.Find(Op::Get, KEL_NODE_userworld_cartel_child, {Int(1001), Int(1003)}));
   // "$noListing": reads without a listing entry.
   EXPECT_FALSE(b.Find(Op::List, KEL_NODE_userworld_cartel_fd_fds, {Int(1001)}));
   EXPECT_TRUE(b.Find(Op::Get, KEL_NODE_userworld_cartel_fd_fds, {Int(1001), Int(0)}));
   // An empty object of instances is an empty listing; a missing one is no entry.
   Built e(R"({"tree": {"world": {}}})");
   EXPECT_TRUE(e.Listing(KEL_NODE_world).empty());
   EXPECT_FALSE(e.Find(Op::List, KEL_NODE_userworld_cartel));
}

TEST(Kelcache, DataContents) {
   Built b(kSmall);
   auto data = [&](const char *file) { return *b.Find(Op::Data, KEL_NODE_system_bootOptionFiles_content, {Text(file)}); };
   CacheHit plain = data("boot.cfg");
   EXPECT_EQ(plain.status, 0u);
   EXPECT_EQ(plain.data, std::string("\0\0\0\0\xff\xff\xff\xff", 8) + "kernel=a\nmodules=b\n");

   CacheHit big = data("big.cfg");
   ASSERT_EQ(big.data.size(), 8u + 100000u);
   EXPECT_EQ(U32At(std::string(big.data.substr(4, 4)), 0), 4096u);
   EXPECT_EQ(big.data.substr(8, 12), "0123456789\n0");
   EXPECT_EQ(big.data.substr(big.data.size() - 11), "\n0123456789");  // cut at the length

   CacheHit bad = data("bad.cfg");
   EXPECT_EQ(bad.status, uint32_t(KEL_STATUS_NOT_FOUND));
   EXPECT_EQ(bad.data, std::string("\x01\0\0\0\xff\xff\xff\xff\x00\xff", 10));

   // A long repeated content dumps as its pattern, not as 100000 bytes.
   std::string json = MustDump(b.bytes());
   EXPECT_NE(json.find(R"("pattern": "0123456789\n")"), std::string::npos);
   EXPECT_LT(json.size(), 20000u);
}

TEST(Kelcache, ThePlatformReadsWhatWasBuilt) {
   std::string path = ::testing::TempDir() + "kelcache-" + std::to_string(getpid()) + ".cache";
   std::ofstream(path, std::ios::binary) << MustBuild(kSmall);
   ASSERT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_OK);

   KEL_ParamList *keys = KEL_ParamListCreate(1, 1);
   KEL_ParamListAddInt(keys, 7);
   char name[128];
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, keys, name, sizeof name), KEL_STATUS_OK);
   EXPECT_STREQ(name, "netpoll-0");
   KEL_ParamListDestroy(keys);

   KEL_ParamList *input = KEL_ParamListCreate(0, 6);
   for (uint64_t v : {11, 30, 2026, 12, 0, 0}) KEL_ParamListAddInt(input, v);
   EXPECT_EQ(KEL_Set(KEL_NODE_hardware_chipset_rtc, nullptr, input, nullptr, 0), KEL_STATUS_BAD_TIME);
   KEL_ParamListDestroy(input);

   KEL_ParamList *file = KEL_ParamListCreate(1, 1);
   KEL_ParamListAddString(file, "big.cfg");
   uint32_t length = 0;
   EXPECT_EQ(KEL_GetDataLength(KEL_NODE_system_bootOptionFiles_content, file, &length), KEL_STATUS_OK);
   EXPECT_EQ(length, 100000u);
   uint8_t request[8];
   StoreU32(request, 0);
   StoreU32(request + 4, 65536);
   KELData *in = KELData_Create(8, request, 8), *out = KELData_Create(65536, nullptr, 0);
   EXPECT_EQ(KEL_SetData(KEL_NODE_system_bootOptionFiles_content, file, in, out), KEL_STATUS_OK);
   EXPECT_EQ(reinterpret_cast<const uint32_t *>(out)[1], 4096u);  // the chunk limit
   KELData_Destroy(in);
   KELData_Destroy(out);
   KEL_ParamListDestroy(file);
   unlink(path.c_str());
}

TEST(Kelcache, ErrorsNameTheirJsonPath) {
   const struct {
      std::string json;
      std::string error;
   } kCases[] = {
      {R"({"tree": {"world": {"12": {"info": {"worldId": 4294967296}}}}})",
       "/tree/world/12/info/worldId: 4294967296 does not fit u32"},
      {R"({"tree": {"world": {"12": {"info": {"groupId": "0x100000000"}}}}})", "/tree/world/12/info/groupId: 0x100000000 does not fit i32"},
      {R"({"tree": {"world": {"abc": {}}}})", "/tree/world/abc: not an integer key"},
      {R"({"tree": {"world": {"1": {"foo": 1}}}})", "/tree/world/1/foo: no such node"},
      {R"({"tree": {"world": {"1": {"info": {"foo": 1}}}}})", "/tree/world/1/info/foo: no such field"},
      {R"({"tree": {"world": {"1": {"info": "x"}}}})", "/tree/world/1/info: expected an object"},
      {R"({"tree": {"world": {"1": {"info": {"worldId": true}}}}})", "/tree/world/1/info/worldId: expected an integer"},
      {R"({"tree": {"world": {"1": {}, "0x1": {}}}})", "/tree/world/0x1: the same instance key"},
      {R"({"tree": {"world": {"1": {}, "1": {}}}})", "/tree/world/1: member given twice"},
      {R"({"tree": {"world": {"1": {}, "2": {}, "3": {}, "4": {}, "5": {}, "6": {}, "7": {}, "8": {}, "9": {}, "10": {}, "3": {}}}})",
       "/tree/world/3: member given twice"},
      {R"({"rawEntries": [{"key": "4c0100"}, {"key": "4c0100", "data": "00", "key": "4c0200"}]})",
       "/rawEntries/1/key: member given twice"},
      {R"({"tree": {"world": {"$bogus": {}}}})", "/tree/world/$bogus: unknown control member"},
      {R"({"tree": {"sched": {"Vcpus": {"$listStatus": 1}}}})", "/tree/sched/Vcpus/$listStatus: the instances here are not listed"},
      {R"({"tree": {"world": {"$listStatus": "soon"}}})", "/tree/world/$listStatus: \"soon\" is not a status"},
      {R"({"tree": {"world": {"1": {"info": {"$raw": "0g"}}}}})", "/tree/world/1/info/$raw: bad hex digit"},
      {R"({"tree": {"world": {"1": {"info": {"$raw": "000"}}}}})", "/tree/world/1/info/$raw: odd number of hex digits"},
      {R"({"tree": {"world": {"1": {"info": {"$raw": ")" + std::string(146, '0') + R"("}}}}})",
       "/tree/world/1/info/$raw: 73 bytes do not fit a record of 72 bytes"},
      {R"({"tree": {"world": {"1": {"info": {"$setStatus": 1}}}}})", "/tree/world/1/info/$setStatus: this node cannot be set"},
      {R"({"tree": {"system": {"version": {"product": ")" + std::string(33, 'p') + R"("}}}})",
       "/tree/system/version/product: text of 33 bytes"},
      {R"({"tree": {"system": {"bootMAC": {"mac": "00:11:22:33:44:55:66"}}}})", "/tree/system/bootMAC/mac: 7 bytes"},
      {R"({"tree": {"system": {"bootOptionFiles": {"a": {"content": {"length": 3}}}}}})",
       "/tree/system/bootOptionFiles/a/content/length: a length goes with a pattern"},
      {R"({"tree": {"system": {"bootOptionFiles": {"a": {"content": 5}}}}})",
       "/tree/system/bootOptionFiles/a/content: expected a text or an object"},
      {R"({"tree": {"hardware": {"interrupts": {"cookieList": {"1": {"ORXDevices": {"a": 1}}}}}}})",
       "/tree/hardware/interrupts/cookieList/1/ORXDevices/a: expected {} or null"},
      {R"({"buildDate": "123456789012345678901"})", "/buildDate: longer than 20 characters"},
      {R"({"signature": "0011"})", "/signature: expected 32 hex digits"},
      {R"({"simulator": {"corafsRules": [{"kind": "tape"}]}})", "/simulator/corafsRules/0/kind: expected tardisk"},
      {R"({"rawEntries": [{"key": "4c0100"}, {"key": "4c0100"}]})", "/rawEntries/1: makes an entry that another"},
      {R"({"colour": 1})", "/colour: unknown member"},
      {R"({"tree": {"world": )", "malformed JSON: parse error at line 1"},
      {R"([1])", "/: expected an object"},
      // A syntax error or a member given twice anywhere comes before a mistake of the content.
      {R"({"colour": 1, "tree": {"world": {"1": {"foo": 1}}})", "malformed JSON: parse error at line 1"},
      {R"({"tree": {"world": {"1": {"foo": 1}, "2": {}, "2": {}}}})", "/tree/world/2: member given twice"},
      {R"({"tree": {"world": {"1": {"foo": 1}}}, "tree": 1})", "/tree: member given twice"},
      {R"({"tree": {"world": {"1": {"foo": 1}, "2": {"info": {"worldId": 1, "worldId": 2}}}}})",
       "/tree/world/2/info/worldId: member given twice"},
      {R"({"tree": {"world": {"1": {"foo": 1}, "2": {"info": {"foo": 1}}}}})", "/tree/world/1/foo: no such node"},
   };
   for (const auto &c : kCases) {
      std::string error = BuildError(c.json);
      EXPECT_EQ(error.rfind(c.error, 0), 0u) << "got: " << error << "\nwanted: " << c.error;
   }
}

TEST(Kelcache, DamagedFilesAreReportedByStatus) {
   std::string bytes = MustBuild(kSmall), json, error;
   EXPECT_FALSE(DumpCache(bytes.substr(0, 40), &json, &error));
   EXPECT_EQ(error, ORX_ReturnStatusToString(KEL_STATUS_CACHE_TRUNCATED));
   std::string flipped = bytes;
   flipped[flipped.size() - 1] ^= 1;
   EXPECT_FALSE(DumpCache(flipped, &json, &error));
   EXPECT_EQ(error, ORX_ReturnStatusToString(KEL_STATUS_CACHE_CORRUPT));
   EXPECT_FALSE(DumpCache(std::string(100, 'x'), &json, &error));
   EXPECT_EQ(error, ORX_ReturnStatusToString(KEL_STATUS_CACHE_FORMAT));
}

// Files not made by kelcache: what the tree cannot say goes to rawEntries,
// and the dump still builds back to the same bytes.
TEST(Kelcache, HandMadeFilesRoundTripThroughRawEntries) {
   CacheWriter w;
   Key k1 = Int(1), bad = Text(std::string("\xff\xfe", 2));
   w.Add(EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k1, 1)), 0, "idle0");  // no world listing
   w.Add(EncodeLookup(Op::List, KEL_NODE_userworld_cartel, {}), 0, "\x05");            // a damaged listing
   w.Add(EncodeLookup(Op::Get, KEL_NODE_world_info, {}), 0, "");                        // too few keys
   w.Add(EncodeLookup(Op::Get, 999, {}), KEL_STATUS_FAILURE, "x");                      // no such node
   w.Add(EncodeLookup(Op::List, KEL_NODE_system_corafs_tardisks, {}), 0, EncodeList(std::span(&bad, 1)));
   w.Add(EncodeLookup(Op::Set, KEL_NODE_hardware_chipset_rtc, {}), 0, "");              // a set without a read
   std::string bytes = w.Finish(ToolSignature(), "Dec 1 2026");

   std::string json = MustDump(bytes);
   EXPECT_NE(json.find(R"("$noListing": true)"), std::string::npos) << json;
   EXPECT_NE(json.find(R"("rawEntries")"), std::string::npos) << json;
   EXPECT_EQ(MustBuild(json), bytes) << json;
}

// At every node whose last level is an instance, an instance given as {}
// (or with "$unlisted" alone) is listed but has nothing to read; one with a
// field, even a zero, is stored.
TEST(Kelcache, EmptyInstancesAreListedButHaveNothingToRead) {
   const std::string json = R"({"tree": {
      "userworld": {"cartel": {"9": {"child": {"5": {}, "6": {"state": 0}, "7": {"$unlisted": true}},
                                     "fd": {"fds": {"3": {}}},
                                     "mem": {"mmaps": {"4096": {}}}}}},
      "hardware": {"interrupts": {"cookieList": {"48": {"PCPU": {"0": {}, "1": {"count": 0}}}}},
                   "acpi": {"tables": {"0": {"buffers": {"2": {}}}}}}}})";
   Built b(json);
   const struct {
      KEL_Node node;
      std::vector<Key> keys;  // the listing's keys; the instance is the last
      Key instance;
      bool stored;
   } kCases[] = {
      {KEL_NODE_userworld_cartel_child, {Int(9)}, Int(5), false},
      {KEL_NODE_userworld_cartel_child, {Int(9)}, Int(6), true},
      {KEL_NODE_userworld_cartel_fd_fds, {Int(9)}, Int(3), false},
      {KEL_NODE_userworld_cartel_mem_mmaps, {Int(9)}, Int(4096), false},
      {KEL_NODE_hardware_interrupts_cookieList_PCPU, {Int(48)}, Int(0), false},
      {KEL_NODE_hardware_interrupts_cookieList_PCPU, {Int(48)}, Int(1), true},
      {KEL_NODE_hardware_acpi_tables_buffers, {Int(0)}, Int(2), false},
   };
   for (const auto &c : kCases) {
      std::vector<Key> listed = b.Listing(c.node, c.keys);
      EXPECT_NE(std::find(listed.begin(), listed.end(), c.instance), listed.end()) << c.node;
      std::vector<Key> full = c.keys;
      full.push_back(c.instance);
      EXPECT_EQ(b.Find(Op::Get, c.node, full).has_value(), c.stored) << c.node << " " << c.instance.value;
   }
   // Unlisted and empty: neither listed nor readable.
   EXPECT_EQ(b.Listing(KEL_NODE_userworld_cartel_child, {Int(9)}), (std::vector<Key>{Int(5), Int(6)}));
   EXPECT_FALSE(b.Find(Op::Get, KEL_NODE_userworld_cartel_child, {Int(9), Int(7)}));

   // Through the platform the read answers Not found.
   std::string path = ::testing::TempDir() + "kelcache-empty-" + std::to_string(getpid()) + ".cache";
   std::ofstream(path, std::ios::binary) << b.bytes();
   ASSERT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_OK);
   KEL_ParamList *keys = KEL_ParamListCreate(1, 1);
   KEL_ParamListAddInt(keys, 9);
   KEL_ParamListAddInt(keys, 3);
   char fd[2084];
   EXPECT_EQ(KEL_Get(KEL_NODE_userworld_cartel_fd_fds, keys, fd, sizeof fd), KEL_STATUS_NOT_FOUND);
   KEL_ParamListDestroy(keys);
   unlink(path.c_str());

   // The dump writes such an instance as null, and builds back the same.
   std::string dumped = MustDump(b.bytes());
   EXPECT_NE(dumped.find(R"("3": null)"), std::string::npos) << dumped;
   ExpectRoundTrip(json);
}

// An ACPI buffer's length defaults to the table bytes given ("data" or
// "text"); without them the bytes of "$raw" stay as they are.
TEST(Kelcache, AcpiLengthDefaultsOnlyToTableBytesGiven) {
   const std::string json = R"({"tree": {"hardware": {"acpi": {"tables": {"0": {"buffers": {
      "0": {"$raw": "53534454000700000041424344454647"},
      "1": {"$raw": "53534454000700000041", "signature": "DSDT"},
      "2": {"$raw": "53534454000700000041", "data": "5859"},
      "3": {"$raw": "53534454000700000041", "text": "xyz", "length": 9}}}}}}}})";
   Built b(json);
   auto record = [&](uint64_t i) { return Record(b, KEL_NODE_hardware_acpi_tables_buffers, {Int(0), Int(i)}); };
   EXPECT_EQ(U32At(record(0), 5), 7u);
   EXPECT_EQ(record(0).substr(9, 7), "ABCDEFG");
   EXPECT_EQ(U32At(record(1), 5), 7u);
   EXPECT_EQ(record(1).substr(0, 4), "DSDT");
   EXPECT_EQ(U32At(record(2), 5), 2u);
   EXPECT_EQ(record(2).substr(9, 2), "XY");
   EXPECT_EQ(U32At(record(3), 5), 9u);
   ExpectRoundTrip(json);
}
