// kelcache at scale: the cache writer's streamed file, its index of keys,
// and the dump written as it is made.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

#include "cachefile.h"
#include "kel/kel.h"
#include "nodetable.h"
#include "snapshot.h"

using namespace kelplat;

namespace {

Key Int(uint64_t v) { return Key{KEL_PARAM_INT, v, {}}; }

std::string Lookup(uint64_t id) {
   Key k = Int(id);
   return EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k, 1));
}

// A temporary file, removed at the end of the test.
class TempFile {
public:
   TempFile() : path_(::testing::TempDir() + "orxkel-stream-XXXXXX") { fd_ = mkstemp(path_.data()); }
   ~TempFile() {
      if (fd_ >= 0) close(fd_);
      unlink(path_.c_str());
   }
   int fd() const { return fd_; }
   std::string Bytes() const {
      std::ifstream in(path_, std::ios::binary);
      std::ostringstream all;
      all << in.rdbuf();
      return all.str();
   }

private:
   std::string path_;
   int fd_;
};

std::string MustBuild(const std::string &json) {
   std::string bytes, error;
   EXPECT_TRUE(BuildCache(json, &bytes, &error)) << error;
   return bytes;
}

std::string BuildError(const std::string &json) {
   std::string bytes, error;
   EXPECT_FALSE(BuildCache(json, &bytes, &error)) << json;
   return error;
}

std::string MustDump(const std::string &bytes) {
   std::string json, error;
   EXPECT_TRUE(DumpCache(bytes, &json, &error)) << error;
   return json;
}

// Entries of every size around the checksum's 8-byte words, and one larger
// than the writer's buffer, so that pieces of every length reach the file.
void AddAssortedEntries(CacheWriter &w) {
   for (uint64_t i = 0; i < 3000; i++) ASSERT_TRUE(w.Add(Lookup(i), uint32_t(i % 3), std::string(i % 23, char('a' + i % 26))));
   Key big = Int(1u << 20);
   ASSERT_TRUE(w.Add(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&big, 1)), 0, std::string(600000, 'x')));
}

}  // namespace

TEST(CacheWriterStream, WritesTheBytesFinishMakes) {
   CacheWriter w;
   AddAssortedEntries(w);
   const std::string whole = w.Finish(ToolSignature(), "Dec 7 2026");
   TempFile file;
   ASSERT_TRUE(w.WriteTo(file.fd(), ToolSignature(), "Dec 7 2026"));
   const std::string written = file.Bytes();
   ASSERT_EQ(written.size(), whole.size());
   EXPECT_TRUE(written == whole);
   CacheReader r;
   EXPECT_EQ(r.Attach(written, 0), KEL_STATUS_OK);
   EXPECT_EQ(r.EntryCount(), 3001u);
}

TEST(CacheWriterStream, AFailedWriteKeepsItsErrno) {
   CacheWriter w;
   AddAssortedEntries(w);
   int full = open("/dev/full", O_WRONLY | O_CLOEXEC);
   if (full < 0) GTEST_SKIP() << "no /dev/full on this machine";
   errno = 0;
   EXPECT_FALSE(w.WriteTo(full, ToolSignature(), "x"));
   EXPECT_EQ(errno, ENOSPC);
   close(full);
}

// The index finds a key given again however far it has grown, and tells
// apart keys that share their first bytes or differ only in length.
TEST(CacheWriterStream, RepeatedKeysAreFoundAmongMany) {
   CacheWriter w;
   for (uint64_t i = 0; i < 20000; i++) ASSERT_TRUE(w.Add(Lookup(i), 0, ""));
   EXPECT_FALSE(w.Add(Lookup(0), 0, "other data"));
   EXPECT_FALSE(w.Add(Lookup(19999), 1, ""));
   std::string longer = Lookup(5) + "x";
   EXPECT_TRUE(w.Add(longer, 0, ""));
   EXPECT_FALSE(w.Add(longer, 0, ""));
   EXPECT_TRUE(w.Add(Lookup(5).substr(0, 5), 0, ""));
   EXPECT_EQ(w.size(), 20002u);
}

// An entry made twice is refused at the member that makes it the second
// time, whichever part of the snapshot comes first.
TEST(KelcacheStream, AnEntryMadeTwiceNamesTheSecondMember) {
   const std::string version = R"("version": {"product": "Orvik", "build": 42})";
   // Many entries of an unknown operation first, so that the index has grown.
   std::string raw = R"("rawEntries": [)";
   for (int i = 0; i < 2000; i++) {
      char key[16];
      std::snprintf(key, sizeof key, "58%04x", i);
      raw += std::string("{\"key\": \"") + key + "\"}, ";
   }
   raw += R"({"key": "471d00"}])";
   EXPECT_EQ(BuildError("{\"tree\": {\"system\": {" + version + "}}, " + raw + "}"),
             "/rawEntries/2000: makes an entry that another member made already");
   EXPECT_EQ(BuildError("{" + raw + ", \"tree\": {\"system\": {" + version + "}}}"),
             "/tree/system/version: makes an entry that another member made already");
}

// Instances with no listing come in the order of their keys as stored (the
// value's bytes from the lowest): 0, 256, 1, 257, 2.  An instance reached
// only by a listing below it comes before those reached by reads.
TEST(KelcacheStream, UnlistedInstancesComeInTheOrderOfTheirEntries) {
   std::string json = R"({"tree": {"sched": {"Vcpus": {)";
   for (int id = 0; id <= 300; id++)
      json += (id ? ", " : "") + ("\"" + std::to_string(id) + "\": {\"stats\": {\"stateTimes\": {\"usedTime\": 1}}}");
   json += R"(}}, "userworld": {"cartel": {"$noListing": true, "3": {"cmdline": "x"}, "5": {"child": {}}}}}})";
   std::string dumped = MustDump(MustBuild(json));
   size_t at0 = dumped.find("\"0\": {"), at256 = dumped.find("\"256\": {"), at1 = dumped.find("\"1\": {"),
          at257 = dumped.find("\"257\": {"), at2 = dumped.find("\"2\": {");
   ASSERT_NE(at2, std::string::npos);
   EXPECT_LT(at0, at256);
   EXPECT_LT(at256, at1);
   EXPECT_LT(at1, at257);
   EXPECT_LT(at257, at2);
   size_t cartels = dumped.find("\"cartel\": {");
   EXPECT_LT(dumped.find("\"5\": {", cartels), dumped.find("\"3\": {", cartels));
   EXPECT_EQ(MustBuild(dumped), MustBuild(json));
}

// The dump written to a file as it is made is the text DumpCache returns,
// also when it is many times the size of what is gathered before a write.
TEST(KelcacheStream, DumpToAFileWritesTheSameText) {
   std::string json = R"({"tree": {"world": {)";
   for (int id = 1; id <= 3000; id++)
      json += (id > 1 ? ", " : "") + ("\"" + std::to_string(id) + "\": {\"name\": \"world-" + std::to_string(id) + "\"}");
   json += "}}}";
   const std::string bytes = MustBuild(json);
   const std::string text = MustDump(bytes);
   ASSERT_GT(text.size(), 100000u);
   FILE *out = std::tmpfile();
   ASSERT_NE(out, nullptr);
   std::string error;
   ASSERT_TRUE(DumpCacheTo(bytes, out, &error)) << error;
   std::rewind(out);
   std::string written;
   char chunk[65536];
   for (size_t n; (n = std::fread(chunk, 1, sizeof chunk, out)) > 0;) written.append(chunk, n);
   std::fclose(out);
   EXPECT_TRUE(written == text);

   FILE *full = std::fopen("/dev/full", "w");
   if (full == nullptr) GTEST_SKIP() << "no /dev/full on this machine";
   EXPECT_TRUE(DumpCacheTo(bytes, full, &error));
   EXPECT_TRUE(std::fflush(full) != 0 || std::ferror(full));
   EXPECT_EQ(errno, ENOSPC);
   std::fclose(full);
}
