// Reading an integer key back as a 32-bit number: what fits comes back, the
// rest is a bad entry rather than its low 32 bits.
#include <gtest/gtest.h>

#include <cstdint>
#include <memory>

#include "kel/kel.h"

namespace {

struct ListDeleter {
   void operator()(KEL_ParamList *list) const { KEL_ParamListDestroy(list); }
};
using List = std::unique_ptr<KEL_ParamList, ListDeleter>;

struct Fits {
   uint64_t key;
   int32_t value;
};

// Unsigned 32-bit numbers read as their signed form; negative numbers may
// also be stored sign-extended to 64 bits.
constexpr Fits kFits[] = {
   {0, 0},
   {1, 1},
   {0x7fff'ffff, INT32_MAX},
   {0x8000'0000, INT32_MIN},
   {0xffff'ffff, -1},
   {0xffff'ffff'ffff'ffff, -1},
   {uint64_t(int64_t(-5)), -5},
   {0xffff'ffff'8000'0000, INT32_MIN},
};

// Neither a 32-bit number nor a sign-extended negative one.
constexpr uint64_t kBeyond[] = {
   0x1'0000'0000,           // 2^32
   0x1'0000'0001,           // 2^32 + 1: cut to 32 bits it would be 1
   0x1'0000'0005,
   0x7fff'ffff'0000'0000,
   0x8000'0000'0000'0000,   // 2^63
   0xffff'ffff'7fff'ffff,   // INT32_MIN - 1
   0xffff'fffe'ffff'ffff,   // -2^32 - 1: cut to 32 bits it would be -1
   0x8000'0000'0000'0001,
};

TEST(ParamListGetInt32, NumbersThatFitComeBack) {
   for (const Fits &row : kFits) {
      List list(KEL_ParamListCreate(1, 1));
      ASSERT_TRUE(list);
      ASSERT_EQ(KEL_ParamListAddInt(list.get(), row.key), KEL_STATUS_OK);
      int32_t out = 12345;
      EXPECT_EQ(KEL_ParamListGetInt32(list.get(), 0, &out), KEL_STATUS_OK) << std::hex << row.key;
      EXPECT_EQ(out, row.value) << std::hex << row.key;
   }
}

TEST(ParamListGetInt32, WiderNumbersAreBadEntriesAndLeaveTheOutputAlone) {
   for (uint64_t key : kBeyond) {
      List list(KEL_ParamListCreate(1, 1));
      ASSERT_TRUE(list);
      ASSERT_EQ(KEL_ParamListAddInt(list.get(), key), KEL_STATUS_OK);
      int32_t out = 12345;
      EXPECT_EQ(KEL_ParamListGetInt32(list.get(), 0, &out), KEL_STATUS_BAD_PARAM) << std::hex << key;
      EXPECT_EQ(out, 12345) << std::hex << key;
      // The full value is still there for the 64-bit getter.
      uint64_t wide = 0;
      EXPECT_EQ(KEL_ParamListGetUInt64(list.get(), 0, &wide), KEL_STATUS_OK);
      EXPECT_EQ(wide, key);
   }
}

}  // namespace
