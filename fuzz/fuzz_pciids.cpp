// libFuzzer target for the PCI ID loader: the input becomes two override
// files, in the first and the last override folder, and pci.ids (split at
// the first two bytes 0xff), read in one pass with the device rows' vendor
// and device carried from file to file.  Each load is followed by lookups,
// through the index and the plain scan, of every device row it made (as
// it stands, as a bare device, its vendor row and a neighbouring device),
// and of every class-level and subclass-level row.
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
      if (mkdir((gRoot + "/fallback.pciids.d").c_str(), 0700) != 0) abort();
   }
   // A part ends before a byte 0xff, which the next part starts with;
   // without one, the parts before pci.ids are empty.
   auto split = [&](size_t from) {
      const void *at = from < size ? std::memchr(data + from, 0xff, size - from) : nullptr;
      return at ? size_t(static_cast<const uint8_t *>(at) - data) : size;
   };
   size_t ends[2];
   ends[0] = split(0);
   ends[1] = ends[0] < size ? split(ends[0] + 1) : size;
   if (ends[1] == size) ends[1] = ends[0];
   if (ends[0] == size) ends[0] = ends[1] = 0;
   WriteFile(gRoot + "/oem.pciids.d/fuzz.ids", data, ends[0]);
   WriteFile(gRoot + "/fallback.pciids.d/fuzz.ids", data + ends[0], ends[1] - ends[0]);
   WriteFile(gRoot + "/pci.ids", data + ends[1], size - ends[1]);

   LoadPciIdTablesFrom(gRoot.c_str());
   if (PciDevCount() > 0 && PciLastOverrideIndex() >= PciDevCount()) abort();
   auto lookUp = [](uint16_t vendor, uint16_t device, uint16_t subvendor, uint16_t subdevice) {
      const PciDevEntry *indexed = LookupPciDevice(vendor, device, subvendor, subdevice);
      if (indexed != LookupPciDeviceByScan(vendor, device, subvendor, subdevice)) abort();
      if (indexed != nullptr && (indexed->vendor != vendor || indexed->device != device)) abort();
      return indexed;
   };
   for (int i = 0; i < PciDevCount(); i++) {
      const PciDevEntry &r = PciDevRow(i);
      const PciDevEntry *found = lookUp(r.vendor, r.device, r.subvendor, r.subdevice);
      if (found == nullptr || PciName(found->name).size() > 127 || PciName(found->vendorName).size() > 63)
         abort();
      lookUp(r.vendor, r.device, 0, 0);
      lookUp(r.vendor, 0xffff, 0xffff, 0xffff);
      lookUp(r.vendor, uint16_t(r.device ^ 1), r.subvendor, r.subdevice);
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
