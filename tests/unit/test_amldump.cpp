// Which ACPI table signatures amldump accepts as file names.
#include <gtest/gtest.h>

#include <string>
#include <string_view>

#include "pci/amldump.h"

namespace {

using namespace std::string_view_literals;

struct SignatureCase {
   std::string_view signature;
   bool safe;
};

constexpr SignatureCase kSignatures[] = {
   {"DSDT", true},
   {"SSDT", true},
   {"A", true},
   {"a b~", true},        // a blank and '~' are printable ASCII
   {"x\\y.", true},       // so is a backslash, shown escaped in messages only
   {"..x", true},         // dots are unsafe only as the whole name
   {"x-", true},          // '-' only leading
   {"", false},
   {".", false},
   {"..", false},
   {"/", false},
   {"/tmp", false},
   {"../x", false},
   {"a/b", false},
   {"-", false},
   {"-rf", false},
   {"\x1b[2J", false},    // ESC: a terminal escape
   {"a\nb", false},
   {"a\tb", false},
   {"\x01" "abc", false},
   {"abc\x7f", false},    // DEL
   {"\xc3\xa9", false},   // beyond ASCII
   {"ab\xff", false},
   {"a\0b"sv, false},     // NUL inside the text
};

TEST(AmldumpSignature, SafeOnlyWhenPrintableAndNamingAFileHere) {
   for (const SignatureCase &c : kSignatures) {
      SCOPED_TRACE(testing::PrintToString(std::string(c.signature)));
      EXPECT_EQ(SafeSignature(c.signature), c.safe);
   }
}

}  // namespace
