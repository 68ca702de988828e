// The process tools' fixed data: pkill's signal names, and the 32-bit
// conversions of numeric arguments.
#include <gtest/gtest.h>

#include <iterator>

#include "numbers.h"
#include "worlds/signals.h"

namespace {

TEST(SignalNames, AllThirtySixRowsInOrder) {
   constexpr SignalName kExpected[] = {
      {"HUP", 1},   {"INT", 2},   {"QUIT", 3},   {"ILL", 4},   {"TRAP", 5},    {"ABRT", 6},
      {"IOT", 6},   {"BUS", 7},   {"EMT", 7},    {"FPE", 8},   {"KILL", 9},    {"USR1", 10},
      {"SEGV", 11}, {"USR2", 12}, {"PIPE", 13},  {"ALRM", 14}, {"TERM", 15},   {"STKFLT", 16},
      {"CLD", 17},  {"CHLD", 17}, {"CONT", 18},  {"STOP", 19}, {"TSTP", 20},   {"TTIN", 21},
      {"TTOU", 22}, {"URG", 23},  {"XCPU", 24},  {"XFSZ", 25}, {"VTALRM", 26}, {"PROF", 27},
      {"WINCH", 28}, {"POLL", 29}, {"IO", 29},   {"PWR", 30},  {"INFO", 30},   {"SYS", 31},
   };
   ASSERT_EQ(std::size(kSignalNames), std::size(kExpected));
   for (size_t i = 0; i < std::size(kExpected); i++) {
      EXPECT_EQ(kSignalNames[i].name, kExpected[i].name) << "row " << i + 1;
      EXPECT_EQ(kSignalNames[i].number, kExpected[i].number) << "row " << i + 1;
   }
}

TEST(SignalNames, ExactCaseSensitiveNamesWithoutPrefix) {
   EXPECT_EQ(SignalByName("KILL"), 9);
   EXPECT_EQ(SignalByName("EMT"), 7);
   EXPECT_EQ(SignalByName("INFO"), 30);
   EXPECT_EQ(SignalByName("kill"), 0);
   EXPECT_EQ(SignalByName("SIGKILL"), 0);
   EXPECT_EQ(SignalByName("KIL"), 0);
   EXPECT_EQ(SignalByName(""), 0);
}

TEST(Numbers, SignedClampsLikeA32BitLong) {
   EXPECT_EQ(StrtolInt32("42abc"), 42);
   EXPECT_EQ(StrtolInt32("abc"), 0);
   EXPECT_EQ(StrtolInt32("-7"), -7);
   // Cut to 32 bits this would be 9 (SIGKILL).
   EXPECT_EQ(StrtolInt32("4294967305"), INT32_MAX);
   EXPECT_EQ(StrtolInt32("-4294967305"), INT32_MIN);
}

TEST(Numbers, UnsignedWrapsAndClampsLikeA32BitLong) {
   EXPECT_EQ(StrtoulUInt32("12abc"), 12u);
   EXPECT_EQ(StrtoulUInt32(" +12"), 12u);
   EXPECT_EQ(StrtoulUInt32("abc"), 0u);
   EXPECT_EQ(StrtoulUInt32("--1"), 0u);
   EXPECT_EQ(StrtoulUInt32("-1"), UINT32_MAX);
   EXPECT_EQ(StrtoulUInt32("-4294967295"), 1u);
   EXPECT_EQ(StrtoulUInt32("4294967295"), UINT32_MAX);
   EXPECT_EQ(StrtoulUInt32("4294967308"), UINT32_MAX);
   EXPECT_EQ(StrtoulUInt32("-4294967308"), UINT32_MAX);
}

}  // namespace
