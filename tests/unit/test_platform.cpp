// The platform library: parameter lists, statuses, reads over cache files,
// the simulator's set and data calls, and the cache reader on damaged files.
#include <gtest/gtest.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstring>
#include <fstream>
#include <random>
#include <string>
#include <vector>

#include "cachefile.h"
#include "internal.h"
#include "kel/kel.h"
#include "nodetable.h"

using namespace kelplat;

namespace {

struct ListDeleter {
   void operator()(KEL_ParamList *l) const { KEL_ParamListDestroy(l); }
};
using List = std::unique_ptr<KEL_ParamList, ListDeleter>;

List Keys(std::initializer_list<uint64_t> values) {
   List l(KEL_ParamListCreate(1, 1));
   for (uint64_t v : values) KEL_ParamListAddInt(l.get(), v);
   return l;
}

Key IntKey(uint64_t v) { return Key{KEL_PARAM_INT, v, {}}; }
Key TextKey(std::string t) { return Key{KEL_PARAM_STRING, 0, std::move(t)}; }

std::string TempPath(const char *tag) {
   std::string path = ::testing::TempDir() + "orxkel-" + tag + "-" + std::to_string(getpid());
   return path;
}

void WriteFile(const std::string &path, const std::string &bytes) {
   std::ofstream(path, std::ios::binary) << bytes;
}

// A small tree: two worlds (one with a short and one with a long stored
// name), a failing read, a failing listing and boot option file contents.
std::string SmallCache(std::string_view date = "Nov 3 2026") {
   CacheWriter w;
   Key k1 = IntKey(1), k2 = IntKey(7), k9 = IntKey(9);
   std::vector<Key> worlds{k2, k1};
   w.Add(EncodeLookup(Op::List, KEL_NODE_world, {}), 0, EncodeList(worlds));
   w.Add(EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k1, 1)), 0, "idle0");
   w.Add(EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k2, 1)), 0, std::string(200, 'x'));
   w.Add(EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k9, 1)), KEL_STATUS_NO_CARTEL, "");
   w.Add(EncodeLookup(Op::List, KEL_NODE_userworld_cartel, {}), KEL_STATUS_FAILURE, "");
   Key file = TextKey("boot.cfg");
   std::string data;
   AppendU32(data, 0);
   AppendU32(data, 4);  // at most 4 bytes a call
   data += "kernel=a\nmodules=b\n";
   w.Add(EncodeLookup(Op::Data, KEL_NODE_system_bootOptionFiles_content, std::span(&file, 1)), 0, data);
   w.Add(EncodeLookup(Op::Get, KEL_NODE_hardware_chipset_rtc, {}), 0, std::string(32, '\0'));
   return w.Finish(ToolSignature(), date);
}

class CacheTest : public ::testing::Test {
protected:
   void SetUp() override {
      path_ = TempPath("cache");
      WriteFile(path_, SmallCache());
      ASSERT_EQ(KEL_UseCache(path_.c_str(), 0), KEL_STATUS_OK);
   }
   void TearDown() override { unlink(path_.c_str()); }
   std::string path_;
};

}  // namespace

TEST(ParamList, KeepsIntegersTextsAndOrder) {
   List l(KEL_ParamListCreate(1, 1));
   ASSERT_TRUE(l);
   EXPECT_EQ(KEL_ParamListAddInt(l.get(), 0x1'0000'0005ULL), KEL_STATUS_OK);
   EXPECT_EQ(KEL_ParamListAddString(l.get(), "tardisk-a"), KEL_STATUS_OK);
   EXPECT_EQ(KEL_ParamListAddInt(l.get(), uint64_t(-3)), KEL_STATUS_OK);
   ASSERT_EQ(KEL_ParamListUsedCount(l.get()), 3u);

   uint32_t kind;
   std::memcpy(&kind, KEL_ParamListGetParam(l.get(), 1), sizeof kind);
   EXPECT_EQ(kind, uint32_t(KEL_PARAM_STRING));
   EXPECT_EQ(KEL_ParamGetInt(KEL_ParamListGetParam(l.get(), 0)), 0x1'0000'0005LL);
   EXPECT_STREQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 1)), "tardisk-a");
   EXPECT_EQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 0)), nullptr);

   int32_t i32;
   uint64_t u64;
   const char *text;
   EXPECT_EQ(KEL_ParamListGetInt32(l.get(), 0, &i32), KEL_STATUS_BAD_PARAM);  // beyond 32 bits
   EXPECT_EQ(KEL_ParamListGetInt32(l.get(), 2, &i32), KEL_STATUS_OK);
   EXPECT_EQ(i32, -3);
   EXPECT_EQ(KEL_ParamListGetUInt64(l.get(), 0, &u64), KEL_STATUS_OK);
   EXPECT_EQ(u64, 0x1'0000'0005ULL);
   EXPECT_EQ(KEL_ParamListGetString(l.get(), 1, &text), KEL_STATUS_OK);
   EXPECT_STREQ(text, "tardisk-a");
   EXPECT_NE(KEL_ParamListGetString(l.get(), 0, &text), KEL_STATUS_OK);
   EXPECT_NE(KEL_ParamListGetInt32(l.get(), 1, &i32), KEL_STATUS_OK);
   EXPECT_NE(KEL_ParamListGetInt32(l.get(), 3, &i32), KEL_STATUS_OK);
   EXPECT_EQ(KEL_ParamListGetParam(l.get(), 3), nullptr);

   KEL_ParamListRemoveLastParam(l.get());
   KEL_ParamListRemoveLastParam(l.get());
   EXPECT_EQ(KEL_ParamListUsedCount(l.get()), 1u);
   KEL_ParamListRemoveLastParam(l.get());
   KEL_ParamListRemoveLastParam(l.get());  // popping an empty list is harmless
   EXPECT_EQ(KEL_ParamListUsedCount(l.get()), 0u);
}

TEST(KELData, HoldsCapacityAndCountInItsFirstWords) {
   KELData *d = KELData_Create(8, "abcd", 4);
   ASSERT_NE(d, nullptr);
   uint32_t words[2];
   std::memcpy(words, d, sizeof words);
   EXPECT_EQ(words[0], 8u);
   EXPECT_EQ(words[1], 4u);
   EXPECT_EQ(std::memcmp(KELData_GetData(d), "abcd", 4), 0);
   KELData_Destroy(d);
   EXPECT_EQ(KELData_Create(2, "abcd", 4), nullptr);
}

TEST(Status, FixedStatusesHaveTextsAndUnknownOnesAGenericOne) {
   EXPECT_STREQ(ORX_ReturnStatusToString(0), "Success");
   for (KEL_Status s : {0xbad0001u, 0xbad0007u, 0xbad0014u, 0xbad0017u, 0xbad0062u})
      EXPECT_EQ(std::string(ORX_ReturnStatusToString(s)).find("Unknown"), std::string::npos) << std::hex << s;
   EXPECT_STREQ(ORX_ReturnStatusToString(0x1234), "Unknown status 0x1234");
}

TEST(NodeTable, NumbersPathsAndLevels) {
   EXPECT_EQ(Nodes().size(), 45u);
   const NodeInfo *fds = FindNode(KEL_NODE_userworld_cartel_fd_fds);
   ASSERT_NE(fds, nullptr);
   EXPECT_EQ(fds->path, "userworld/cartel/#/fd/fds/#");
   EXPECT_EQ(LevelCount(fds->path), 2u);
   EXPECT_TRUE(EndsWithLevel(fds->path));
   EXPECT_EQ(LevelKind(FindNode(KEL_NODE_system_corafs_tardisks_stats)->path, 0), KEL_PARAM_STRING);
   EXPECT_EQ(FindNode(0), nullptr);
   EXPECT_EQ(FindNode(46), nullptr);
   EXPECT_EQ(CpuSched_RunStateElements[1].name, std::string("RUN"));
   EXPECT_GT(CpuSched_NumWaitStates, 0u);
}

TEST_F(CacheTest, ReadsAreExactShorterRecordsZeroFilledLongerOnesCut) {
   char buf[128];
   std::memset(buf, 0x55, sizeof buf);
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, Keys({1}).get(), buf, sizeof buf), KEL_STATUS_OK);
   EXPECT_STREQ(buf, "idle0");
   for (size_t i = 5; i < sizeof buf; i++) ASSERT_EQ(buf[i], 0) << i;

   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, Keys({7}).get(), buf, sizeof buf), KEL_STATUS_OK);
   EXPECT_EQ(std::string(buf, sizeof buf), std::string(128, 'x'));
}

TEST_F(CacheTest, StoredFailuresAndMissingEntries) {
   char buf[128];
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, Keys({9}).get(), buf, sizeof buf), KEL_STATUS_NO_CARTEL);
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, Keys({8}).get(), buf, sizeof buf), KEL_STATUS_NOT_FOUND);
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, nullptr, buf, sizeof buf), KEL_STATUS_BAD_KEY_COUNT);
   EXPECT_EQ(KEL_Get(999, nullptr, buf, sizeof buf), KEL_STATUS_INVALID_NODE);
   KEL_ParamList *list = nullptr;
   EXPECT_EQ(KEL_GetInstanceListAlloc(KEL_NODE_userworld_cartel, nullptr, &list), KEL_STATUS_FAILURE);
   EXPECT_EQ(list, nullptr);
   EXPECT_EQ(KEL_GetInstanceListAlloc(KEL_NODE_world_name, nullptr, &list), KEL_STATUS_NOT_A_LIST);
}

TEST_F(CacheTest, ListingsKeepTheirOrder) {
   KEL_ParamList *raw = nullptr;
   ASSERT_EQ(KEL_GetInstanceListAlloc(KEL_NODE_world, nullptr, &raw), KEL_STATUS_OK);
   List list(raw);
   ASSERT_EQ(KEL_ParamListUsedCount(list.get()), 2u);
   EXPECT_EQ(KEL_ParamGetInt(KEL_ParamListGetParam(list.get(), 0)), 7);
   EXPECT_EQ(KEL_ParamGetInt(KEL_ParamListGetParam(list.get(), 1)), 1);
   ASSERT_EQ(KEL_GetInstanceListAllocHint(KEL_NODE_world, nullptr, 0, &raw), KEL_STATUS_OK);
   KEL_ParamListDestroy(raw);
}

TEST(CacheFormat, ListingsOfShortTextKeysDecode) {
   std::vector<Key> keys{TextKey("a"), TextKey(""), TextKey("tmp")};
   std::vector<Key> back;
   ASSERT_TRUE(DecodeList(EncodeList(keys), &back));
   EXPECT_EQ(back, keys);
}

TEST_F(CacheTest, SignatureAndBuildDate) {
   char date[21];
   const char *mine = nullptr;
   EXPECT_EQ(KEL_CheckSig(date, sizeof date, &mine), 0);
   EXPECT_STREQ(date, "Nov 3 2026");
   EXPECT_STREQ(mine, ToolBuildDate());

   std::string other = SmallCache("a date far too long for the field");
   other[16] ^= 1;  // another signature: neither checksum nor header check covers it
   WriteFile(path_, other);
   ASSERT_EQ(KEL_UseCache(path_.c_str(), 0), KEL_STATUS_OK);
   EXPECT_NE(KEL_CheckSig(date, sizeof date, &mine), 0);
   EXPECT_STREQ(date, "a date far too long ");
}

TEST_F(CacheTest, SetIsRefusedInCacheMode) {
   List input(KEL_ParamListCreate(0, 6));
   for (int v : {2, 3, 2026, 7, 5, 9}) KEL_ParamListAddInt(input.get(), uint64_t(v));
   EXPECT_EQ(KEL_Set(KEL_NODE_hardware_chipset_rtc, nullptr, input.get(), nullptr, 0), KEL_STATUS_READ_ONLY);
   EXPECT_EQ(KEL_Set(KEL_NODE_system_version, nullptr, input.get(), nullptr, 0), KEL_STATUS_NOT_SUPPORTED);
}

TEST_F(CacheTest, DataCallsReadContentInChunks) {
   List keys(KEL_ParamListCreate(1, 1));
   KEL_ParamListAddString(keys.get(), "boot.cfg");
   uint32_t length = 0;
   ASSERT_EQ(KEL_GetDataLength(KEL_NODE_system_bootOptionFiles_content, keys.get(), &length), KEL_STATUS_OK);
   EXPECT_EQ(length, 19u);
   std::string got;
   for (uint32_t offset = 0; offset < length;) {
      uint8_t req[8];
      StoreU32(req, offset);
      StoreU32(req + 4, 16);
      KELData *in = KELData_Create(8, req, 8);
      KELData *out = KELData_Create(17, nullptr, 0);
      ASSERT_EQ(KEL_SetData(KEL_NODE_system_bootOptionFiles_content, keys.get(), in, out), KEL_STATUS_OK);
      uint32_t count;
      std::memcpy(&count, reinterpret_cast<const char *>(out) + 4, 4);
      ASSERT_LE(count, 4u);  // the stored chunk limit
      ASSERT_GT(count, 0u);
      got.append(static_cast<char *>(KELData_GetData(out)), count);
      offset += count;
      KELData_Destroy(in);
      KELData_Destroy(out);
   }
   EXPECT_EQ(got, "kernel=a\nmodules=b\n");
}

TEST(CacheReader, EveryTruncationFailsWithAStatus) {
   std::string bytes = SmallCache();
   for (size_t n = 0; n < bytes.size(); n++) {
      CacheReader r;
      EXPECT_NE(r.Attach(std::string_view(bytes.data(), n), 0), KEL_STATUS_OK) << n;
   }
   std::string path = TempPath("trunc");
   WriteFile(path, bytes.substr(0, bytes.size() / 2));
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_CACHE_TRUNCATED);
   WriteFile(path, "");
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_CACHE_FORMAT);
   unlink(path.c_str());
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_CACHE_NO_FILE);
   EXPECT_EQ(KEL_UseCache("/", 0), KEL_STATUS_CACHE_FOLDER);
   EXPECT_EQ(KEL_UseCache("/dev/null", 0), KEL_STATUS_CACHE_NOT_REGULAR);
   WriteFile(path, "  {\"buildDate\": \"Nov 3 2026\", \"tree\": {}}\n");
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_CACHE_JSON);
   unlink(path.c_str());
   char buf[8];
   EXPECT_EQ(KEL_Get(KEL_NODE_system_bootOption, nullptr, buf, 4), KEL_STATUS_NO_TREE);
}

TEST(CacheReader, ByteFlipsAreCaughtOrHarmless) {
   const std::string good = SmallCache();
   std::mt19937 rng(42);
   for (int round = 0; round < 3000; round++) {
      std::string bytes = good;
      int flips = 1 + int(rng() % 4);
      for (int i = 0; i < flips; i++) bytes[rng() % bytes.size()] ^= char(1 + rng() % 255);
      CacheReader checked;
      // With the checksum, any change after the header is refused.
      if (checked.Attach(bytes, 0) == KEL_STATUS_OK) {
         EXPECT_EQ(bytes.substr(kHeaderSize), good.substr(kHeaderSize));
      }
      // Opened quickly (no pass over the data), every lookup stays within
      // the bytes, and verification catches what the checksum catches.
      CacheReader quick;
      if (quick.Attach(bytes, kCacheQuickOpen) == KEL_STATUS_OK) {
         for (uint32_t i = 0; i < quick.SlotCount(); i++) {
            std::string_view key;
            CacheHit hit;
            uint32_t tag;
            if (!quick.SlotAt(i, &key, &hit, &tag)) continue;
            CacheHit again;
            quick.Lookup(key, &again);
         }
         if (quick.Verify(0) == KEL_STATUS_OK) {
            EXPECT_EQ(bytes.substr(kHeaderSize), good.substr(kHeaderSize));
         }
      }
      // Without the checksum, every lookup and entry stays within the bytes.
      CacheReader unchecked;
      if (unchecked.Attach(bytes, KEL_CACHE_NO_CHECKSUM) != KEL_STATUS_OK) continue;
      for (uint32_t i = 0; i < unchecked.EntryCount(); i++) {
         std::string_view key;
         CacheHit hit;
         if (!unchecked.EntryAt(i, &key, &hit)) continue;
         std::vector<Key> keys;
         DecodeList(hit.data, &keys);
         CacheHit again;
         unchecked.Lookup(key, &again);
      }
   }
}

TEST(CacheReader, LookupOnAHundredThousandEntries) {
   CacheWriter w;
   for (uint64_t i = 0; i < 100000; i++) {
      Key k = IntKey(i * 3);
      w.Add(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&k, 1)), 0, std::to_string(i));
   }
   std::string bytes = w.Finish(ToolSignature(), "x");
   CacheReader r;
   ASSERT_EQ(r.Attach(bytes, 0), KEL_STATUS_OK);
   for (uint64_t i : {0ULL, 1ULL, 54321ULL, 99999ULL}) {
      Key k = IntKey(i * 3);
      CacheHit hit;
      ASSERT_EQ(r.Lookup(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&k, 1)), &hit), KEL_STATUS_OK);
      EXPECT_EQ(hit.data, std::to_string(i));
      k = IntKey(i * 3 + 1);
      EXPECT_EQ(r.Lookup(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&k, 1)), &hit), KEL_STATUS_NOT_FOUND);
   }
}

TEST(Simulator, SetsTheClockAndRefusesImpossibleDates) {
   std::string path = TempPath("sim");
   WriteFile(path, SmallCache());
   unlink((path + ".rtc").c_str());
   setenv("ORXKEL_SIMULATOR", path.c_str(), 1);
   ASSERT_TRUE(HostType_OSIsSimulator());
   OrxSyscall_Init(1, 0, 0);
   char date[21];
   const char *mine;
   EXPECT_EQ(KEL_CheckSig(date, sizeof date, &mine), 0);

   auto set = [](std::initializer_list<int> v) {
      List input(KEL_ParamListCreate(0, 6));
      for (int x : v) KEL_ParamListAddInt(input.get(), uint64_t(uint32_t(x)));
      return KEL_Set(KEL_NODE_hardware_chipset_rtc, nullptr, input.get(), nullptr, 0);
   };
   EXPECT_EQ(set({2, 29, 2025, 10, 0, 0}), KEL_STATUS_BAD_TIME);  // not a leap year
   EXPECT_EQ(set({13, 1, 2026, 10, 0, 0}), KEL_STATUS_BAD_TIME);
   EXPECT_EQ(set({1, 1, 2026, 24, 0, 0}), KEL_STATUS_BAD_TIME);
   EXPECT_EQ(set({2, 29, 2028, 23, 59, 58}), KEL_STATUS_OK);

   uint8_t rec[32];
   ASSERT_EQ(KEL_Get(KEL_NODE_hardware_chipset_rtc, nullptr, rec, sizeof rec), KEL_STATUS_OK);
   const uint32_t want[6] = {23, 59, 58, 29, 2, 2028};  // hours, minutes, seconds, day, month, year
   for (int i = 0; i < 6; i++) EXPECT_EQ(LoadU32(rec + 4 * i), want[i]) << i;

   unsetenv("ORXKEL_SIMULATOR");
   unlink((path + ".rtc").c_str());
   unlink(path.c_str());
}

// Offsets are 32 bits, so a header claiming a file of 4 GiB or more is
// damage, refused from the header alone.
TEST(CacheReader, SizesBeyondThirtyTwoBitOffsetsAreRefusedAtOnce) {
   std::string bytes = SmallCache();
   auto claim = [&](uint64_t total) {
      std::string b = bytes;
      StoreU64(reinterpret_cast<uint8_t *>(b.data()) + 64, total);
      CacheReader r;
      return r.Attach(b, 0);
   };
   EXPECT_EQ(claim(bytes.size() + 1), KEL_STATUS_CACHE_TRUNCATED);
   EXPECT_EQ(claim(uint64_t(1) << 32), KEL_STATUS_CACHE_CORRUPT);
   EXPECT_EQ(claim(~uint64_t(0)), KEL_STATUS_CACHE_CORRUPT);

   // A sparse file of 4 GiB and 4 KiB whose header claims exactly its size:
   // refused without reading it.
   std::string path = TempPath("huge");
   std::string header = bytes.substr(0, kHeaderSize);
   const uint64_t huge = (uint64_t(1) << 32) + 4096;
   StoreU64(reinterpret_cast<uint8_t *>(header.data()) + 64, huge);
   WriteFile(path, header);
   if (truncate(path.c_str(), off_t(huge)) != 0) {
      unlink(path.c_str());
      GTEST_SKIP() << "this file system cannot hold a sparse file of 4 GiB";
   }
   auto start = std::chrono::steady_clock::now();
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_CACHE_CORRUPT);
   EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(1));
   unlink(path.c_str());
}

// Opening checks the header and where the tables lie, not the data: a
// damaged data byte passes opening and is caught by the full verification.
TEST(CacheReader, QuickOpenLeavesTheDataToVerification) {
   std::string bytes = SmallCache();
   bytes[bytes.size() - 3] ^= 0x40;
   CacheReader quick;
   ASSERT_EQ(quick.Attach(bytes, kCacheQuickOpen), KEL_STATUS_OK);
   EXPECT_EQ(quick.Verify(0), KEL_STATUS_CACHE_CORRUPT);
   CacheReader full;
   EXPECT_EQ(full.Attach(bytes, 0), KEL_STATUS_CACHE_CORRUPT);

   // Any change to the fields that place the tables is refused at opening.
   for (size_t at = kHeaderCheckStart; at < kHeaderSize; at++) {
      if (at >= 64 && at < 72) continue;  // the size: truncated or corrupt, tested apart
      std::string b = SmallCache();
      b[at] ^= 1;
      CacheReader r;
      EXPECT_EQ(r.Attach(b, kCacheQuickOpen), KEL_STATUS_CACHE_CORRUPT) << at;
   }
   // A file of the previous format version gets the version status.
   std::string old = SmallCache();
   StoreU32(reinterpret_cast<uint8_t *>(old.data()) + 8, 1);
   CacheReader r;
   EXPECT_EQ(r.Attach(old, kCacheQuickOpen), KEL_STATUS_CACHE_VERSION);
}

// Every entry is found through the slot table, and the entries come back
// in key order whatever slots they hash to.
TEST(CacheReader, EntriesInKeyOrder) {
   CacheWriter w;
   for (uint64_t i = 0; i < 1000; i++) {
      Key k = IntKey(i * 7919 % 1000);
      w.Add(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&k, 1)), 0, std::to_string(i));
   }
   std::string bytes = w.Finish(ToolSignature(), "x");
   CacheReader r;
   ASSERT_EQ(r.Attach(bytes, 0), KEL_STATUS_OK);
   ASSERT_EQ(r.EntryCount(), 1000u);
   std::string previous;
   for (uint32_t i = 0; i < r.EntryCount(); i++) {
      std::string_view key;
      CacheHit hit;
      ASSERT_TRUE(r.EntryAt(i, &key, &hit));
      EXPECT_LT(previous, std::string(key));
      previous = key;
   }
}

// A pipe is read whole; a FIFO that nobody writes to ends at once.
TEST(CacheReader, PipesAreReadWhole) {
   std::string fifo = TempPath("fifo");
   unlink(fifo.c_str());
   ASSERT_EQ(mkfifo(fifo.c_str(), 0600), 0);
   auto start = std::chrono::steady_clock::now();
   EXPECT_EQ(KEL_UseCache(fifo.c_str(), 0), KEL_STATUS_CACHE_EMPTY_PIPE);
   EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(2));
   unlink(fifo.c_str());

   // Through /dev/fd/N of a pipe whose writer is this process: the whole
   // file, then the end of the stream.
   auto throughPipe = [](const std::string &bytes) {
      int fds[2];
      EXPECT_EQ(pipe(fds), 0);
      pid_t child = fork();
      if (child == 0) {
         close(fds[0]);
         for (size_t at = 0; at < bytes.size();) {
            ssize_t n = write(fds[1], bytes.data() + at, std::min<size_t>(bytes.size() - at, 100));
            if (n <= 0) _exit(1);
            at += size_t(n);
         }
         _exit(0);
      }
      close(fds[1]);
      std::string path = "/dev/fd/" + std::to_string(fds[0]);
      KEL_Status status = KEL_UseCache(path.c_str(), 0);
      close(fds[0]);
      int wstatus;
      waitpid(child, &wstatus, 0);
      return status;
   };
   EXPECT_EQ(throughPipe(SmallCache()), KEL_STATUS_OK);
   char name[8];
   List keys = Keys({1});
   EXPECT_EQ(KEL_Get(KEL_NODE_world_name, keys.get(), name, sizeof name), KEL_STATUS_OK);
   EXPECT_STREQ(name, "idle0");
   std::string cut = SmallCache();
   EXPECT_EQ(throughPipe(cut.substr(0, cut.size() - 1)), KEL_STATUS_CACHE_TRUNCATED);
   EXPECT_EQ(throughPipe(cut + "x"), KEL_STATUS_CACHE_CORRUPT);
   EXPECT_EQ(throughPipe("{\"tree\": {}}"), KEL_STATUS_CACHE_JSON);
   // A header claiming more than 32-bit offsets reach: refused from the header.
   std::string huge = SmallCache();
   StoreU64(reinterpret_cast<uint8_t *>(huge.data()) + 64, uint64_t(1) << 32);
   EXPECT_EQ(throughPipe(huge), KEL_STATUS_CACHE_CORRUPT);
}

// Texts of a list live in chunks that never move: a text read early stays
// valid while thousands more are appended, and removing the last entries
// gives their room back for the next ones.
TEST(ParamListTexts, StayInPlaceAcrossGrowth) {
   List l(KEL_ParamListCreate(1, 1));
   ASSERT_EQ(KEL_ParamListAddString(l.get(), "first"), KEL_STATUS_OK);
   const char *first = KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 0));
   std::string big(5000, 'b');  // larger than a chunk
   for (int i = 0; i < 5000; i++)
      ASSERT_EQ(KEL_ParamListAddString(l.get(), i == 2500 ? big.c_str() : std::to_string(i).c_str()), KEL_STATUS_OK);
   EXPECT_STREQ(first, "first");
   EXPECT_EQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 2501)), big);
   EXPECT_STREQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 5000)), "4999");
   for (int i = 0; i < 10; i++) KEL_ParamListRemoveLastParam(l.get());
   ASSERT_EQ(KEL_ParamListAddString(l.get(), "again"), KEL_STATUS_OK);
   EXPECT_STREQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 4991)), "again");
   EXPECT_STREQ(KEL_ParamGetString(KEL_ParamListGetParam(l.get(), 4990)), "4989");
   EXPECT_STREQ(first, "first");
   // A walk's key list: the same text key added and removed over and over
   // takes no more room.
   List keys(KEL_ParamListCreate(1, 1));
   KEL_ParamListAddInt(keys.get(), 1);
   for (int i = 0; i < 100000; i++) {
      ASSERT_EQ(KEL_ParamListAddString(keys.get(), "boot.cfg"), KEL_STATUS_OK);
      KEL_ParamListRemoveLastParam(keys.get());
   }
   EXPECT_LE(keys->chunks.size(), 1u);
}
