// vdu's path building, bucket merging and printing: the rules the
// end-to-end cases cannot reach (paths the file system refuses, the root
// directory, the empty path, running out of buckets in a chosen order).
#include <gtest/gtest.h>

#include <cstdio>
#include <cstring>
#include <string>

#include "corafsstats/vdu.h"

namespace {

vdu::Bucket Make(uint32_t kind, const char *name, uint64_t bytes, uint32_t inodes = 1) {
   vdu::Bucket b{};
   b.kind = kind;
   std::strncpy(b.name, name, sizeof b.name - 1);
   b.bytes = bytes;
   b.inodes = inodes;
   return b;
}

std::string Prefix(const std::string &path, bool *ok, std::string *messages) {
   char buffer[vdu::kPathBufferSize];
   testing::internal::CaptureStderr();
   size_t length = vdu::DirectoryPrefix(path.c_str(), buffer);
   *messages = testing::internal::GetCapturedStderr();
   *ok = length != 0;
   if (!*ok) return "";
   EXPECT_EQ(std::strlen(buffer), length);
   return std::string(buffer, length);
}

}  // namespace

TEST(VduPath, SlashIsAddedOnlyWhereMissing) {
   bool ok;
   std::string messages;
   EXPECT_EQ(Prefix("/", &ok, &messages), "/");
   EXPECT_TRUE(ok);
   EXPECT_EQ(Prefix(".", &ok, &messages), "./");
   EXPECT_EQ(Prefix("dir/", &ok, &messages), "dir/");
   EXPECT_EQ(Prefix("a/b", &ok, &messages), "a/b/");
   EXPECT_EQ(Prefix("", &ok, &messages), "/");
   EXPECT_TRUE(ok);
   EXPECT_EQ(messages, "");
}

TEST(VduPath, LimitsOfTheDirectoryPath) {
   bool ok;
   std::string messages;
   // 4094 bytes and the slash fit the 4096-byte buffer with its terminator.
   std::string path(4094, 'a');
   EXPECT_EQ(Prefix(path, &ok, &messages), path + "/");
   EXPECT_TRUE(ok);
   // 4095 bytes fit only when they already end in a slash.
   path = std::string(4094, 'a') + "/";
   EXPECT_EQ(Prefix(path, &ok, &messages), path);
   EXPECT_TRUE(ok);
   path = std::string(4095, 'a');
   Prefix(path, &ok, &messages);
   EXPECT_FALSE(ok);
   EXPECT_EQ(messages, "path too long for '" + path + "' (4096)\n");
   // Beyond 4095 bytes the length itself is reported.
   path = std::string(5000, 'b') + "/";
   Prefix(path, &ok, &messages);
   EXPECT_FALSE(ok);
   EXPECT_EQ(messages, "path too long for '" + path + "' (5001)\n");
}

TEST(VduMerge, SameDiskAddsUpOthersKeepTheOrderFirstMet) {
   vdu::Bucket table[4] = {Make(1, "root", 10)};
   uint32_t used = 1;
   vdu::MergeBucket(table, &used, 4, Make(0, "tools", 5000));
   vdu::MergeBucket(table, &used, 4, Make(1, "root", 7, 2));
   vdu::MergeBucket(table, &used, 4, Make(0, "root", 3));  // same name, other kind
   vdu::MergeBucket(table, &used, 4, Make(0, "tools", 4000000000u, 3));
   ASSERT_EQ(used, 3u);
   EXPECT_EQ(table[0].kind, 1u);
   EXPECT_STREQ(table[0].name, "root");
   EXPECT_EQ(table[0].bytes, 17u);
   EXPECT_EQ(table[0].inodes, 3u);
   EXPECT_STREQ(table[1].name, "tools");
   EXPECT_EQ(table[1].bytes, 4000005000u);  // past 2^32 would have wrapped in 32 bits
   EXPECT_EQ(table[1].inodes, 4u);
   EXPECT_EQ(table[2].kind, 0u);
   EXPECT_STREQ(table[2].name, "root");
}

TEST(VduMerge, FullTableDropsNewDisksButStillAddsKnownOnes) {
   vdu::Bucket table[2] = {Make(1, "a", 1)};
   uint32_t used = 1;
   testing::internal::CaptureStderr();
   vdu::MergeBucket(table, &used, 2, Make(1, "b", 2));
   vdu::MergeBucket(table, &used, 2, Make(1, "c", 4));
   vdu::MergeBucket(table, &used, 2, Make(1, "b", 8));
   vdu::MergeBucket(table, &used, 2, Make(0, "d", 16));
   EXPECT_EQ(testing::internal::GetCapturedStderr(),
             "Not enough dustats buckets\nNot enough dustats buckets\n");
   ASSERT_EQ(used, 2u);
   EXPECT_EQ(table[0].bytes, 1u);
   EXPECT_EQ(table[1].bytes, 10u);
}

TEST(VduMerge, NoRoomAtAll) {
   vdu::Bucket none[1];
   uint32_t used = 0;
   testing::internal::CaptureStderr();
   vdu::MergeBucket(none, &used, 0, Make(1, "a", 1));
   EXPECT_EQ(testing::internal::GetCapturedStderr(), "Not enough dustats buckets\n");
   EXPECT_EQ(used, 0u);
}

TEST(VduPrint, LongestNamesAndSumsBeyondThirtyTwoBits) {
   std::string longest(31, 'n');
   vdu::Bucket table[2] = {Make(1, longest.c_str(), 6442450944u, 2), Make(0, "t", 1023)};
   vdu::Settings settings;
   testing::internal::CaptureStdout();
   vdu::PrintStats(settings, "x", table, 2, true);
   settings.human = true;
   vdu::PrintStats(settings, "x", table, 2, false);
   std::string out = testing::internal::GetCapturedStdout();
   EXPECT_EQ(out,
             "For 'x':\n"
             "ramdisk " + longest + ":   6442450944\t\t(    2 inodes)\n"
             "                             tardisk t:         1023\t\t(    1 inodes)\n"
             "For 'x':\n"
             "ramdisk " + longest + ": 6144M\n"
             "                             tardisk t: 1023B\n");
}
