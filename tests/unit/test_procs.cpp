// The process tools' fixed data: pkill's signal names, and the 32-bit
// conversions of numeric arguments.
#include <gtest/gtest.h>

#include "numbers.h"
#include "worlds/signals.h"

namespace {

// Numbers with two names: both names give the same number.
TEST(SignalNames, AliasesShareTheirNumber) {
   struct Alias {
      const char *name;
      const char *alias;
      int number;
   };
   constexpr Alias kAliases[] = {
      {"ABRT", "IOT", 6}, {"BUS", "EMT", 7}, {"CHLD", "CLD", 17}, {"IO", "POLL", 29}, {"PWR", "INFO", 30},
   };
   for (const Alias &a : kAliases) {
      EXPECT_EQ(SignalByName(a.name), a.number) << a.name;
      EXPECT_EQ(SignalByName(a.alias), a.number) << a.alias;
   }
}

TEST(SignalNames, TheFirstRowWithTheNameWins) {
   constexpr SignalName kTable[] = {{"HUP", 1}, {"TERM", 15}, {"TERM", 9}, {"HUP", 2}};
   EXPECT_EQ(SignalByName("TERM", kTable), 15);
   EXPECT_EQ(SignalByName("HUP", kTable), 1);
   EXPECT_EQ(SignalByName("KILL", kTable), 0);
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
