// libFuzzer target for the PCI ID loader: the input becomes an override
// file and pci.ids (split at the first byte 0xff), and each load is followed
// by lookups of every device row it made, through the index and the plain
// scan, and of every class-level and subclass-level row.
// The loader's messages are expected: run with -close_fd_mask=2.
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>

#include "pci/pciids.h"

namespace {

std::string gRoot;

void WriteFile(const std::string &path, const uint8_t *data, size_t size) {
   FILE *f = std::fopen(path.c_str(), "wb");
   if (f == nullptr) abort();
   if (size != 0 && std::fwrite(data, 1, size, f) != size) abort();
   std::fclose(f);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
   if (gRoot.empty()) {
      char dir[] = "/tmp/orxkel-fuzz-pciids-XXXXXX";
      if (mkdtemp(dir) == nullptr) abort();
      gRoot = dir;
      if (mkdir((gRoot + "/oem.pciids.d").c_str(), 0700) != 0) abort();
   }
   const uint8_t *split = static_cast<const uint8_t *>(std::memchr(data, 0xff, size));
   size_t first = split ? size_t(split - data) : 0;
   WriteFile(gRoot + "/oem.pciids.d/fuzz.ids", data, first);
   WriteFile(gRoot + "/pci.ids", data + first, size - first);

   LoadPciIdTablesFrom(gRoot.c_str());
   for (int i = 0; i < PciDevCount(); i++) {
      const PciDevEntry &r = PciDevRow(i);
      const PciDevEntry *indexed = LookupPciDevice(r.vendor, r.device, r.subvendor, r.subdevice);
      if (indexed != LookupPciDeviceByScan(r.vendor, r.device, r.subvendor, r.subdevice)) abort();
      if (indexed == nullptr || PciName(indexed->name).size() > 127 || PciName(indexed->vendorName).size() > 63)
         abort();
   }
   // Class-level and subclass-level rows are found by a lookup of their own
   // codes.  A prog-if row need not be: one that comes before any class
   // line stands under a class that no row names.
   for (int i = 0; i < PciClassCount(); i++) {
      const PciClassEntry &row = PciClassRow(i);
      if (row.progIf != 0xff) continue;
      const PciClassEntry *c = LookupPciClass(uint16_t(row.classId << 8 | row.subclassId));
      if (c == nullptr || c->classId != row.classId || c->progIf != 0xff || PciName(c->className).size() > 63)
         abort();
   }
   return 0;
}
