// The PCI ID loader on ID folders built for each test, its messages, the
// lookup precedence, and the index against the plain scan.
#include <gtest/gtest.h>
#include <stdlib.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <random>
#include <string>
#include <thread>

#include "pci/pciids.h"

namespace {

// pci.ids needs a class section to load without a warning.
const std::string kClasses =
   "ffff  Illegal Vendor ID\n"
   "C 02  Network controller\n"
   "\t00  Ethernet controller\n";

class PciIds : public ::testing::Test {
protected:
   void SetUp() override {
      char dir[] = "/tmp/orxkel-pciids-XXXXXX";
      ASSERT_NE(mkdtemp(dir), nullptr);
      root_ = dir;
   }
   void TearDown() override { std::filesystem::remove_all(root_); }

   void Write(const std::string &path, const std::string &bytes) {
      std::filesystem::path full = root_ + "/" + path;
      std::filesystem::create_directories(full.parent_path());
      std::ofstream(full, std::ios::binary) << bytes;
   }

   // Loads from the test's folder and returns what the loader wrote to
   // standard error.
   std::string Load() {
      ::testing::internal::CaptureStderr();
      LoadPciIdTablesFrom(root_.c_str());
      return ::testing::internal::GetCapturedStderr();
   }

   std::string root_;
};

// "vendor name|device name" of the row a lookup chooses, or "none".  Every
// lookup also checks that the index and the plain scan agree.
std::string Names(uint16_t vendor, uint16_t device, uint16_t subvendor = 0, uint16_t subdevice = 0) {
   const PciDevEntry *row = LookupPciDevice(vendor, device, subvendor, subdevice);
   EXPECT_EQ(row, LookupPciDeviceByScan(vendor, device, subvendor, subdevice));
   if (row == nullptr) return "none";
   return std::string(PciName(row->vendorName)) + "|" + std::string(PciName(row->name));
}

std::string ClassNames(uint16_t classCode) {
   const PciClassEntry *row = LookupPciClass(classCode);
   if (row == nullptr) return "none";
   return std::string(PciName(row->className)) + "|" + std::string(PciName(row->subclassName));
}

}  // namespace

TEST(ParsePciIdLine, SplitsIdBlanksAndName) {
   PciIdField f;
   ASSERT_TRUE(ParsePciIdLine(" \t1aF4  \tSome name \n", 128, &f));
   EXPECT_EQ(f.id, 0x1af4u);
   EXPECT_EQ(f.idEnd, 6u);
   EXPECT_EQ(f.name, "Some name ");
   ASSERT_TRUE(ParsePciIdLine("12 x", 0, &f));
   EXPECT_EQ(f.id, 0x12u);
   // An ID alone, with or without blanks after it, has no name; a newline
   // does not end an ID.
   EXPECT_FALSE(ParsePciIdLine("1234\n", 128, &f));
   EXPECT_FALSE(ParsePciIdLine("1234 \t\n", 128, &f));
   EXPECT_FALSE(ParsePciIdLine("1234", 0, &f));
   EXPECT_FALSE(ParsePciIdLine("x234 name\n", 128, &f));
   EXPECT_FALSE(ParsePciIdLine("12x4 name\n", 128, &f));
   ASSERT_TRUE(ParsePciIdLine("123456789 n\n", 128, &f));
   EXPECT_EQ(f.id, 0xffffffffu);
}

TEST_F(PciIds, OverrideDeviceLineBeatsPciIds) {
   Write("pci.ids", "1af4  Red Hat, Inc.\n\t1041  Virtio network\n\t\t1af4 1100  QEMU virtio NIC\n" + kClasses);
   Write("ihv.pciids.d/nic.ids", "1af4  Orvik Vendor\n\t1041  Orvik NIC\n");
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(PciDevCount(), 4);
   EXPECT_EQ(PciLastOverrideIndex(), 0);
   EXPECT_EQ(Names(0x1af4, 0x1041), "Orvik Vendor|Orvik NIC");
   // Also against an exact subsystem row of pci.ids.
   EXPECT_EQ(Names(0x1af4, 0x1041, 0x1af4, 0x1100), "Orvik Vendor|Orvik NIC");
   // The vendor row comes from pci.ids only.
   EXPECT_EQ(Names(0x1af4, 0xffff, 0xffff, 0xffff), "Red Hat, Inc.|");
}

TEST_F(PciIds, ExactOverrideSubsystemRowWinsAtOnce) {
   Write("pci.ids", "8086  Intel\n\t10d3  82574L\n" + kClasses);
   Write("oem.pciids.d/a.ids", "8086  Intel\n\t10d3  OEM NIC\n\t\t15d9 0001  OEM board NIC\n");
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(Names(0x8086, 0x10d3, 0x15d9, 0x0001), "Intel|OEM board NIC");
   EXPECT_EQ(Names(0x8086, 0x10d3, 0x15d9, 0x0002), "Intel|OEM NIC");
}

TEST_F(PciIds, PciIdsExactSubsystemRowBeatsItsDeviceRow) {
   Write("pci.ids", "8086  Intel\n\t10d3  82574L\n\t\t8086 a01f  Gigabit CT\n" + kClasses);
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(Names(0x8086, 0x10d3, 0x8086, 0xa01f), "Intel|Gigabit CT");
   EXPECT_EQ(Names(0x8086, 0x10d3, 0x8086, 0xa020), "Intel|82574L");
   EXPECT_EQ(Names(0x8086, 0x10d4), "none");
   EXPECT_EQ(Names(0x8087, 0x10d3), "none");
}

TEST_F(PciIds, FirstInFileOrderAmongEquals) {
   Write("pci.ids", "10de  NVIDIA\n\t1234  First\n\t1234  Second\n" + kClasses);
   Write("oem.pciids.d/a.ids", "abcd  A\n\t0001  From oem\n");
   Write("fallback.pciids.d/b.ids", "abcd  B\n\t0001  From fallback\n");
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(Names(0x10de, 0x1234), "NVIDIA|First");
   EXPECT_EQ(Names(0xabcd, 0x0001), "A|From oem");
   EXPECT_EQ(PciLastOverrideIndex(), 1);
}

TEST_F(PciIds, SynthesizedNameGivesWayToRealOne) {
   Write("pci.ids", "1af4  Red Hat, Inc.\n\t1041  Virtio network\n\t\t1af4 1100  QEMU NIC\n" + kClasses);
   // A device line with an ID alone, with and without trailing blanks.
   Write("driver.pciids.d/d.ids", "1af4  Orvik\n\t1041\n\t1042 \t\n");
   ASSERT_EQ(Load(), "");
   const PciDevEntry &row = PciDevRow(1);
   EXPECT_EQ(row.device, 0x1042);
   EXPECT_EQ(PciName(row.name), "Name not available for Orvik device");
   EXPECT_EQ(Names(0x1af4, 0x1041), "Red Hat, Inc.|Virtio network");
   EXPECT_EQ(Names(0x1af4, 0x1041, 0x1af4, 0x1100), "Red Hat, Inc.|QEMU NIC");
   EXPECT_EQ(Names(0x1af4, 0x1042), "Orvik|Name not available for Orvik device");
}

TEST_F(PciIds, OverrideFileUsesTheVendorReadBeforeIt) {
   Write("pci.ids", "1af4  Red Hat, Inc.\n\t1041  Virtio network\n" + kClasses);
   Write("oem.pciids.d/a.ids", "1b36  Orvik Labs\n\t0001  Bridge\n");
   Write("ihv.pciids.d/b.ids", "\t0002  Continued bridge\n\t\t1b36 0003  Sub\n");
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(Names(0x1b36, 0x0002), "Orvik Labs|Continued bridge");
   EXPECT_EQ(Names(0x1b36, 0x0002, 0x1b36, 0x0003), "Orvik Labs|Sub");
}

TEST_F(PciIds, DeviceLineBeforeAnyVendorCannotBeSynthesized) {
   Write("pci.ids", "1af4  Red Hat, Inc.\n" + kClasses);
   Write("oem.pciids.d/a.ids", "# header\n\t0001\n");
   EXPECT_EQ(Load(),
             root_ + "/oem.pciids.d/a.ids: can't synthesize device name for line 2\n"
                     "parsing problem: devices 0 ndevid 2\n"
                     "Failed to build PCI tables\n");
   EXPECT_EQ(PciDevCount(), 0);
   EXPECT_EQ(PciClassCount(), 0);
   EXPECT_EQ(Names(0x1af4, 0xffff, 0xffff, 0xffff), "none");
}

TEST_F(PciIds, SubsystemLineBeforeAnyVendor) {
   Write("pci.ids", "1af4  Red Hat, Inc.\n" + kClasses);
   Write("oem.pciids.d/a.ids", "\t\t1af4 1100  Sub\n");
   EXPECT_EQ(Load(),
             "no vendor information for subvendor 01af4: subsystem 01100"
             "parsing problem: devices 0 ndevid 2\n"
             "Failed to build PCI tables\n");
}

TEST_F(PciIds, ImproperlyFormattedDeviceSectionLines) {
   struct Case {
      const char *lines;
      const char *message;
   };
   const Case cases[] = {
      {"zz01  Bad vendor\n", "line 2 improperly formatted(1)\n"},
      {"1234\n", "line 2 improperly formatted(1)\n"},
      {"\t\tzz01 0001  Bad subvendor\n", "line 2 improperly formatted(3)\n"},
      {"\t\t1af4 zz01  Bad subdevice\n", "line 2 improperly formatted(4)\n"},
      {"\t\t1af4 0001\n", "line 2 improperly formatted(4)\n"},
   };
   for (const Case &c : cases) {
      SCOPED_TRACE(c.lines);
      // A counted row after the bad line makes the count check fail.
      Write("pci.ids", std::string("1af4  Red Hat, Inc.\n") + c.lines + "\t0001  After\n" + kClasses);
      std::string err = Load();
      EXPECT_EQ(err.substr(0, err.find(':')), root_ + "/pci.ids");
      EXPECT_NE(err.find(c.message), std::string::npos) << err;
      EXPECT_NE(err.find("parsing problem: devices 1 ndevid"), std::string::npos) << err;
      EXPECT_EQ(err.substr(err.size() - 27), "Failed to build PCI tables\n");
      EXPECT_EQ(PciDevCount(), 0);
   }
}

TEST_F(PciIds, ImproperlyFormattedClassSectionLines) {
   struct Case {
      const char *lines;
      const char *message;
   };
   const Case cases[] = {
      {"C zz  Bad class\n", "pci.ids: line 5 improperly formatted(5)\n"},
      {"\tzz  Bad subclass\n", "pci.ids: line 5 improperly formatted(6)\n"},
      {"\t\tzz  Bad prog-if\n", "pci.ids: line 5 improperly formatted(7)\n"},
   };
   for (const Case &c : cases) {
      SCOPED_TRACE(c.lines);
      Write("pci.ids", std::string("1af4  Red Hat, Inc.\nffff  Illegal\nC 01  Storage\n\t00  SCSI\n") + c.lines +
                          "C 02  Network controller\n");
      std::string err = Load();
      EXPECT_EQ(err.substr(0, err.find('\n') + 1), root_ + "/" + c.message);
      EXPECT_NE(err.find("internal error: classes "), std::string::npos) << err;
      EXPECT_EQ(err.substr(err.size() - 27), "Failed to build PCI tables\n");
      EXPECT_EQ(PciClassCount(), 0);
   }
}

TEST_F(PciIds, ClassTableOrderAndLookup) {
   Write("pci.ids",
         "1af4  Red Hat, Inc.\nffff  Illegal\n"
         "C 01  Mass storage controller\n\t01  IDE interface\n\t\t00  ISA Compatibility mode-only controller\n"
         "\t06  SATA controller\n"
         "C 0c  Serial bus controller\n\t03  USB controller\n\t\t30  XHCI\n");
   ASSERT_EQ(Load(), "");
   ASSERT_EQ(PciClassCount(), 7);
   // Prog-if rows, then their subclass's row; the class-level row last.
   const uint8_t order[][3] = {{1, 1, 0},       {1, 1, 0xff},    {1, 6, 0xff},    {1, 0xff, 0xff},
                               {0xc, 3, 0x30},  {0xc, 3, 0xff},  {0xc, 0xff, 0xff}};
   for (int i = 0; i < 7; i++) {
      EXPECT_EQ(PciClassRow(i).classId, order[i][0]) << i;
      EXPECT_EQ(PciClassRow(i).subclassId, order[i][1]) << i;
      EXPECT_EQ(PciClassRow(i).progIf, order[i][2]) << i;
   }
   EXPECT_EQ(ClassNames(0x0106), "Mass storage controller|SATA controller");
   EXPECT_EQ(ClassNames(0x0c03), "Serial bus controller|USB controller");
   EXPECT_EQ(ClassNames(0x0180), "Mass storage controller|");
   EXPECT_EQ(ClassNames(0x0200), "none");
}

TEST_F(PciIds, CommentInsideClassBlockDropsItsOpenRows) {
   // The comment leaves class 08 with neither its subclass row nor its
   // class-level row.
   Write("pci.ids", "1af4  Red Hat, Inc.\nffff  Illegal\nC 08  Generic\n\t99  Timing Card\n# note\nC 09  Input\n");
   EXPECT_EQ(Load(), "internal error: classes 1 nclass 3\nFailed to build PCI tables\n");
   // Followed by a prog-if line, the same comment does no harm.
   Write("pci.ids",
         "1af4  Red Hat, Inc.\nffff  Illegal\nC 08  Generic\n\t99  Timing Card\n# note\n\t\t01  TAP\nC 09  Input\n");
   EXPECT_EQ(Load(), "");
   EXPECT_EQ(ClassNames(0x0899), "Generic|Timing Card");
}

TEST_F(PciIds, ProgIfLineBeforeAnyClassLineKeepsAnUnreachableRow) {
   // The row counts, so the build succeeds, but it stands under class 0 and
   // subclass 0, which no class-level or subclass-level row names (the
   // comment after it closes no block).
   Write("pci.ids", "1af4  Red Hat, Inc.\nffff  Illegal\n\t\t01  Orphan\n# note\n" + kClasses.substr(kClasses.find('C')));
   ASSERT_EQ(Load(), "");
   ASSERT_EQ(PciClassCount(), 3);
   EXPECT_EQ(PciClassRow(0).progIf, 1);
   EXPECT_EQ(ClassNames(0x0000), "none");
   EXPECT_EQ(ClassNames(0x0200), "Network controller|Ethernet controller");
}

TEST_F(PciIds, LongLinesArriveInPieces) {
   // 255 bytes: a tab, the ID, two blanks and 248 letters; the rest of the
   // line is a device line of its own.
   std::string first = "\t0001  " + std::string(248, 'n');
   Write("pci.ids", "1af4  Red Hat, Inc.\n" + first + "\t0002  Second piece\n# c\nzz\n" + kClasses);
   // The bad vendor line is line 5: the long line counted as two.
   EXPECT_EQ(Load(), root_ + "/pci.ids: line 5 improperly formatted(1)\n");
   EXPECT_EQ(PciDevCount(), 3);
   EXPECT_EQ(Names(0x1af4, 0x0001), "Red Hat, Inc.|" + std::string(127 - 0, 'n'));
   EXPECT_EQ(Names(0x1af4, 0x0002), "Red Hat, Inc.|Second piece");
}

TEST_F(PciIds, LongLinesAcrossReadChunks) {
   // 1000 lines of 301 bytes: a device line cut after 255 bytes, and its
   // continuation, a comment.
   std::string ids = "1af4  Red Hat, Inc.\n";
   for (int i = 0; i < 1000; i++) {
      char id[8];
      std::snprintf(id, sizeof id, "%04x", i);
      ids += "\t" + std::string(id) + "  " + std::string(248, char('a' + i % 26)) + "#" +
             std::string(44, 'c') + "\n";
   }
   Write("pci.ids", ids + kClasses);
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(PciDevCount(), 1001);
   for (int i : {0, 217, 218, 435, 999})
      EXPECT_EQ(Names(0x1af4, uint16_t(i)), "Red Hat, Inc.|" + std::string(127, char('a' + i % 26))) << i;
}

TEST_F(PciIds, ANulEndsItsLine) {
   // What follows a NUL up to the end of the line is never seen; a file may
   // end without a newline.
   Write("pci.ids", std::string("1af4  Red\0 Hat\n\t0001  Dev\0ice\n\t0002  Last", 41));
   EXPECT_EQ(Load(), "no class entries in " + root_ + "/pci.ids\nPerhaps, corrupted file?\n");
   EXPECT_EQ(Names(0x1af4, 0x0001), "Red|Dev");
   EXPECT_EQ(Names(0x1af4, 0x0002), "Red|Last");
}

TEST_F(PciIds, ReportsOfTheFillingFollowTheCountWarnings) {
   // The malformed vendor line makes no row, so the build succeeds; its
   // report still comes after the warning about the missing classes.
   Write("pci.ids", "1af4  Red Hat, Inc.\nzz\n");
   EXPECT_EQ(Load(), "no class entries in " + root_ + "/pci.ids\nPerhaps, corrupted file?\n" + root_ +
                        "/pci.ids: line 2 improperly formatted(1)\n");
   EXPECT_EQ(PciDevCount(), 1);
   // Once the device rows fall short, the class section is not reported on.
   Write("pci.ids", "1af4  Red Hat, Inc.\n\t\t1af4 zz01  Bad\n\t0001  After\nffff  Illegal\nC zz  Bad class\n");
   EXPECT_EQ(Load(), root_ + "/pci.ids: line 2 improperly formatted(4)\n"
                             "parsing problem: devices 1 ndevid 3\n"
                             "Failed to build PCI tables\n");
}

TEST_F(PciIds, ClassRowsStartAfterTheLineThatEndedTheDeviceRows) {
   // A malformed vendor line that makes no row ends the device rows early;
   // the class rows start on the next line, so three-tab lines of the
   // vendor section become prog-if rows and the "ffff" line closes no block.
   const std::string head = "1af4  Red Hat, Inc.\n\t1041  Virtio\nzz bad\n";
   Write("pci.ids", head + "\t\t\t01  Three tabs\nffff  Illegal\nC 02  Network\n\t00  Ethernet\n");
   EXPECT_EQ(Load(), root_ + "/pci.ids: line 3 improperly formatted(1)\n"
                             "internal error: classes 3 nclass 2\n"
                             "Failed to build PCI tables\n");
   // Two such rows, and a comment that loses two more in the class section,
   // make the counts agree: the build succeeds with those rows.
   Write("pci.ids", head + "\t\t\t01  First\n\t\t\t02  Second\nffff  Illegal\nC 02  Network\n\t00  Ethernet\n"
                           "# note\nC 03  Display\n");
   EXPECT_EQ(Load(), root_ + "/pci.ids: line 3 improperly formatted(1)\n");
   ASSERT_EQ(PciClassCount(), 3);
   EXPECT_EQ(PciClassRow(1).progIf, 2);
   EXPECT_EQ(PciName(PciClassRow(1).progIfName), "Second");
   EXPECT_EQ(ClassNames(0x0200), "none");
   EXPECT_EQ(ClassNames(0x0300), "Display|");
   EXPECT_EQ(Names(0x1af4, 0x1041), "Red Hat, Inc.|Virtio");
}

TEST_F(PciIds, IndexAnswersAsTheScanOnGeneratedTables) {
   // Tables of a few thousand rows over few vendors and devices, so that
   // each pair comes in several runs, in several files, among rows from
   // override files and pci.ids, real and synthesized names, and subsystem
   // rows that do and do not match.  Every lookup is compared with the
   // plain scan of the table in file order.
   std::mt19937 random(14);
   auto pick = [&](int n) { return int(random() % unsigned(n)); };
   auto hex4 = [](int v) {
      char id[8];
      std::snprintf(id, sizeof id, "%04x", v);
      return std::string(id);
   };
   auto idFile = [&](int lines, bool vendorRows) {
      std::string text;
      for (int i = 0; i < lines; i++) {
         int kind = pick(10);
         if (kind == 0 || i == 0)
            text += hex4(0x1000 + pick(4)) + "  Vendor " + std::to_string(pick(100)) + "\n";
         else if (kind < 4)
            text += "\t" + hex4(pick(6)) + (pick(4) == 0 ? std::string("\n") : "  Device " + std::to_string(i) + "\n");
         else if (vendorRows || kind < 9)
            text += "\t\t" + hex4(0x1000 + pick(3)) + " " + hex4(pick(3)) + "  Sub " + std::to_string(i) + "\n";
      }
      return text;
   };
   for (int round = 0; round < 4; round++) {
      SCOPED_TRACE(round);
      std::filesystem::remove_all(root_);
      Write("pci.ids", idFile(3000, true) + kClasses);
      if (round > 0) Write("oem.pciids.d/a.ids", idFile(300 * round, false));
      if (round > 1) Write("fallback.pciids.d/b.ids", idFile(500, false));
      ASSERT_EQ(Load(), "");
      ASSERT_GT(PciDevCount(), 2048);  // more than one chunk of rows
      for (int vendor = 0x1000; vendor < 0x1005; vendor++) {
         for (int device = 0; device < 7; device++) {
            for (int sub = 0; sub < 12; sub++) {
               uint16_t subvendor = sub < 9 ? uint16_t(0x1000 + sub / 3) : 0;
               uint16_t subdevice = uint16_t(sub % 3);
               ASSERT_EQ(LookupPciDevice(uint16_t(vendor), uint16_t(device), subvendor, subdevice),
                         LookupPciDeviceByScan(uint16_t(vendor), uint16_t(device), subvendor, subdevice))
                  << vendor << " " << device << " " << sub;
            }
         }
         ASSERT_EQ(LookupPciDevice(uint16_t(vendor), 0xffff, 0xffff, 0xffff),
                   LookupPciDeviceByScan(uint16_t(vendor), 0xffff, 0xffff, 0xffff));
      }
   }
}

TEST_F(PciIds, AFileThatCannotBeMappedIsReadIntoMemory) {
   std::string path = root_ + "/pci.ids";
   ASSERT_EQ(mkfifo(path.c_str(), 0600), 0);
   std::thread writer([&] { std::ofstream(path) << "1af4  Red Hat, Inc.\n\t1041  Virtio network\n" + kClasses; });
   std::string err = Load();
   writer.join();
   EXPECT_EQ(err, "");
   EXPECT_EQ(Names(0x1af4, 0x1041), "Red Hat, Inc.|Virtio network");
   EXPECT_EQ(ClassNames(0x0200), "Network controller|Ethernet controller");
}

TEST_F(PciIds, NamesAreCut) {
   std::string v70(70, 'v'), d140(140, 'd'), s140(140, 's'), c70(70, 'c'), k70(70, 'k');
   Write("pci.ids", "1af4  " + v70 + "\n\t0001  " + d140 + "\n\t\t1af4 0002  " + s140 + "\nffff  Illegal\nC 02  " +
                       c70 + "\n\t80  " + k70 + "\n");
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(Names(0x1af4, 0x0001), std::string(63, 'v') + "|" + std::string(127, 'd'));
   EXPECT_EQ(Names(0x1af4, 0x0001, 0x1af4, 0x0002), std::string(63, 'v') + "|" + std::string(127, 's'));
   EXPECT_EQ(ClassNames(0x0280), std::string(63, 'c') + "|" + std::string(63, 'k'));
}

TEST_F(PciIds, IdsOfMoreThanFourDigitsAndThreeTabLines) {
   Write("pci.ids", "11af4  Long vendor\n\t\t\t0001  ignored\n\t21041  Long device\n" + kClasses);
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(PciDevCount(), 2);
   EXPECT_EQ(Names(0x1af4, 0x1041), "Long vendor|Long device");
}

TEST_F(PciIds, OnlyNamesEndingInDotIdsAreRead) {
   Write("pci.ids", kClasses);
   Write("oem.pciids.d/good.ids", "1111  Good\n\t0001  Read\n");
   Write("oem.pciids.d/upper.IDS", "2222  Upper\n\t0001  Not read\n");
   Write("oem.pciids.d/.ids", "3333  Dot\n\t0001  Not read\n");
   Write("oem.pciids.d/ids", "4444  Bare\n\t0001  Not read\n");
   Write("oem.pciids.d/x.ids.bak", "5555  Backup\n\t0001  Not read\n");
   Write("default.pciids.d/a.ids/keep", "");  // a folder named like an ID file gives no lines
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(PciDevCount(), 1);
   EXPECT_EQ(Names(0x1111, 0x0001), "Good|Read");
}

TEST_F(PciIds, MissingPciIds) {
   Write("oem.pciids.d/a.ids", "1af4  Orvik\n\t0001  Device\n\t\t1af4 0002  Sub\n");
   EXPECT_EQ(Load(), "no class entries in " + root_ + "/pci.ids\nPerhaps, corrupted file?\n");
   EXPECT_EQ(PciDevCount(), 2);
   EXPECT_EQ(PciClassCount(), 0);
   EXPECT_EQ(Names(0x1af4, 0x0001), "Orvik|Device");
   EXPECT_EQ(Names(0x1af4, 0xffff, 0xffff, 0xffff), "none");
   EXPECT_EQ(ClassNames(0x0200), "none");
}

TEST_F(PciIds, NoIdFileAtAll) {
   EXPECT_EQ(Load(), "no device entries in the pci ids files\nPerhaps, corrupted file?\n"
                     "no class entries in " + root_ + "/pci.ids\nPerhaps, corrupted file?\n");
   EXPECT_EQ(PciDevCount(), 0);
   EXPECT_EQ(PciClassCount(), 0);
   EXPECT_EQ(Names(0x1af4, 0x0001), "none");
}

TEST_F(PciIds, FfffInADirectoryFileEndsTheDevicePasses) {
   // pci.ids is then read by the class passes only: its vendor line is
   // passed over there and makes no row.
   Write("oem.pciids.d/a.ids", "1af4  Orvik\n\t0001  Device\nffff  End\n");
   Write("pci.ids", "8086  Intel\n" + kClasses);
   ASSERT_EQ(Load(), "");
   EXPECT_EQ(PciDevCount(), 1);
   EXPECT_EQ(Names(0x8086, 0xffff, 0xffff, 0xffff), "none");
   EXPECT_EQ(ClassNames(0x0200), "Network controller|Ethernet controller");
}

TEST_F(PciIds, ACorruptedFileNameFailsTheLoad) {
   Write("pci.ids", kClasses);
   // The folder's path and the name come to more than 255 characters.
   Write("oem.pciids.d/" + std::string(250 - root_.size(), 'x') + ".ids", "");
   ::testing::internal::CaptureStderr();
   EXPECT_FALSE(LoadPciIdTablesFrom(root_.c_str()));
   EXPECT_EQ(::testing::internal::GetCapturedStderr(), "Found corrupted file name\n");
   EXPECT_EQ(PciDevCount(), 0);
   EXPECT_EQ(PciClassCount(), 0);
}

TEST(PciIdsReal, DebianPciIdsLoadsWithoutAMessage) {
   ::testing::internal::CaptureStderr();
   LoadPciIdTables();
   ASSERT_EQ(::testing::internal::GetCapturedStderr(), "");
   EXPECT_GT(PciDevCount(), 30000);
   EXPECT_EQ(PciLastOverrideIndex(), -1);
   EXPECT_EQ(Names(0x1af4, 0x1041), "Red Hat, Inc.|Virtio 1.0 network device");
   EXPECT_EQ(ClassNames(0x0200), "Network controller|Ethernet controller");
   EXPECT_EQ(ClassNames(0x0c03), "Serial bus controller|USB controller");
}

TEST(PciIdsReal, IndexAnswersAsTheScan) {
   LoadPciIdTables();
   int n = PciDevCount();
   ASSERT_GT(n, 0);
   // Every 29th row (a scan per query makes all of them too slow), asked
   // for as it stands, as a bare device, and for a neighbour.
   for (int i = 0; i < n; i += 29) {
      const PciDevEntry &r = PciDevRow(i);
      ASSERT_EQ(LookupPciDevice(r.vendor, r.device, r.subvendor, r.subdevice),
                LookupPciDeviceByScan(r.vendor, r.device, r.subvendor, r.subdevice))
         << i;
      ASSERT_EQ(LookupPciDevice(r.vendor, r.device, 0, 0), LookupPciDeviceByScan(r.vendor, r.device, 0, 0)) << i;
      ASSERT_EQ(LookupPciDevice(r.vendor, r.device ^ 1, r.subdevice, r.subvendor),
                LookupPciDeviceByScan(r.vendor, r.device ^ 1, r.subdevice, r.subvendor))
         << i;
   }
}
