// lspci: every PCI function the kernel knows, one line each, in the order of
// the tree (segment, bus, slot, function), named from the PCI ID database;
// or, with -p, a table of IDs, interrupt routing, module and kernel name.
#include <getopt.h>

#include <cstdio>
#include <cstring>
#include <string_view>

#include "kel/pcirecords.h"
#include "keltools.h"
#include "pci/pciids.h"
#include "records.h"

namespace {

constexpr char kShortOptions[] = "pndevh";
constexpr option kLongOptions[] = {
   {"pciinfo", no_argument, nullptr, 'p'},
   {"nolookup", no_argument, nullptr, 'n'},
   {"dump", no_argument, nullptr, 'd'},
   {"extdump", no_argument, nullptr, 'e'},
   {"verbose", no_argument, nullptr, 'v'},
   {"help", no_argument, nullptr, 'h'},
   {nullptr, 0, nullptr, 0},
};
constexpr char kUsage[] =
   "lspci   -p --pciinfo   Print detailed info on all PCI devices\n"
   "        -n --nolookup  Don't look up PCI device names and info\n"
   "        -d --dump      Print hex dump of the standard config space\n"
   "        -e --extdump   Print hex dump of the extended config space\n"
   "        -v --verbose   Verbose information\n"
   "        -h --help      Print this help message\n";

// Option flags.
constexpr unsigned kNoLookup = 1;
constexpr unsigned kVerbose = 2;
constexpr unsigned kDetailed = 4;
constexpr unsigned kDump = 8;
constexpr unsigned kExtDump = 16;

constexpr char kDetailedHeader[] = "%-12s %-19s %-14s %-1s %-12s %-8s\n";

// The walk's levels are kPciLevels; the key list holds one key per level.
constexpr int kFunctionLevel = 4;

constexpr uint32_t kNoModule = 0xffffffff;

struct ModuleEntry {
   uint32_t id;
   char name[modulerecord::kNameWidth + 1];
};

// The module table: one entry per kernel module, closed by an entry with
// ID kNoModule.  Built at the first line that needs a module name and kept
// for the rest of the run; after a failure the next such line tries again.
using ModuleTable = MallocPtr<ModuleEntry>;

// Reads every module's ID and name.  Null after a failure, which it reports.
ModuleTable ListModules() {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("ListModules: Not enough memory\n", stderr);
      return nullptr;
   }
   ModuleTable table;
   size_t capacity = 0;
   size_t count = 0;
   bool noMemory = false;
   KEL_Status status = KEL_STATUS_OK;
   WalkResult walk = ForEachInstance(KEL_NODE_system_modules, keys.get(), [&](const KEL_Param *) {
      // Room for this module and the closing entry.
      if (!GrowArray(&table, &capacity, count + 2)) {
         noMemory = true;
         return false;
      }
      uint8_t rec[modulerecord::kSize];
      status = KEL_Get(KEL_NODE_system_modules_general, keys.get(), rec, sizeof rec);
      if (status != KEL_STATUS_OK) return false;
      table[count].id = ReadU32(rec, modulerecord::kId);
      std::string_view name = ReadText(rec, modulerecord::kName, modulerecord::kNameWidth);
      std::memcpy(table[count].name, name.data(), name.size());
      count++;
      return true;
   });
   switch (walk.end) {
   case WalkEnd::ListFailed:
      std::fprintf(stderr, "ListModules: error fetching orvik module list - 0x%x\n", walk.status);
      return nullptr;
   case WalkEnd::AppendFailed:
      std::fprintf(stderr, "ListModules: error requesting module info - 0x%x\n", 0);
      return nullptr;
   case WalkEnd::Stopped:
      if (noMemory)
         std::fputs("ListModules: Not enough memory\n", stderr);
      else
         std::fprintf(stderr, "ListModules: error fetching module info - 0x%x\n", status);
      return nullptr;
   case WalkEnd::Done:
      break;
   }
   // With no modules the table is the closing entry alone.
   if (!GrowArray(&table, &capacity, count + 1)) {
      std::fputs("ListModules: Not enough memory\n", stderr);
      return nullptr;
   }
   table[count].id = kNoModule;
   return table;
}

// The name of the module with this ID, or "error" when the table cannot be
// built or has no such module.
const char *ModuleName(ModuleTable &modules, uint32_t id) {
   if (!modules) modules = ListModules();
   if (!modules) return "error";
   for (const ModuleEntry *e = modules.get(); e->id != kNoModule; e++)
      if (e->id == id) return e->name;
   return "error";
}

// Sixteen bytes a line, each line led by the offset of its first byte:
// "%02x:" for the offset, " %02x" for each byte.  A line is formatted whole
// and written at once; the bytes are the same as byte-by-byte printing.
// Both configuration spaces are whole lines.
constexpr size_t kDumpLine = 16;

template <size_t N>
void HexDump(const uint8_t (&bytes)[N]) {
   static_assert(N % kDumpLine == 0);
   static constexpr char kHex[] = "0123456789abcdef";
   for (size_t row = 0; row < N; row += kDumpLine) {
      char line[16 + kDumpLine * 3 + 2];
      int n = std::snprintf(line, sizeof line, "%02x:", unsigned(row));
      for (size_t i = row; i < row + kDumpLine; i++) {
         line[n++] = ' ';
         line[n++] = kHex[bytes[i] >> 4];
         line[n++] = kHex[bytes[i] & 15];
      }
      line[n++] = '\n';
      std::fwrite(line, 1, size_t(n), stdout);
   }
}

// The fields of a PCI function record that lspci shows.
struct PciFunction {
   uint16_t vendor, device, subvendor, subdevice, classCode;
   uint8_t isaIrq, irq, vector, intPin, spawnedBus, irqFlags, modeFlags;
   uint32_t moduleId;
   std::string_view kernelName;  // points into the record
};

PciFunction DecodeFunction(const uint8_t *rec) {
   using namespace pcirecord;
   return PciFunction{ReadU16(rec, kVendor),    ReadU16(rec, kDevice),     ReadU16(rec, kSubvendor),
                      ReadU16(rec, kSubdevice), ReadU16(rec, kClassCode),  ReadU8(rec, kIsaIrq),
                      ReadU8(rec, kIrq),        ReadU8(rec, kVector),      ReadU8(rec, kIntPin),
                      ReadU8(rec, kSpawnedBus), ReadU8(rec, kIrqFlags),    ReadU8(rec, kModeFlags),
                      ReadU32(rec, kModuleId),  ReadText(rec, kDeviceName, kDeviceNameWidth)};
}

// What the walk carries down the levels, with room for one function's
// record and configuration spaces.
struct Walk {
   unsigned flags;
   KEL_ParamList *keys;  // segment, bus, slot, function of the current function
   ModuleTable modules;
   uint8_t rec[pcirecord::kSize];
   uint8_t config[pciconfigspace::kSize];
   uint8_t extConfig[pciextconfigspace::kSize];
};

uint32_t KeyAt(const KEL_ParamList *keys, uint32_t index) {
   const KEL_Param *param = KEL_ParamListGetParam(keys, index);
   return param ? uint32_t(KEL_ParamGetInt(param)) : 0;
}

void PrintAddress(const Walk &w) {
   std::printf("%04x:%02x:%02x.%x ", KeyAt(w.keys, 0), KeyAt(w.keys, 1), KeyAt(w.keys, 2), KeyAt(w.keys, 3));
}

// Class, vendor and device names, with numeric stand-ins for what the ID
// database does not know.
void PrintNames(const PciFunction &f, bool verbose) {
   char unknownClass[64];
   std::string_view className, subclassName;
   if (const PciClassEntry *cls = LookupPciClass(f.classCode)) {
      className = PciName(cls->className);
      subclassName = PciName(cls->subclassName);
   } else {
      std::snprintf(unknownClass, sizeof unknownClass, "Unknown class %.4x", f.classCode);
      className = unknownClass;
   }

   char vendorBuf[64], deviceBuf[128];
   std::string_view vendorName, deviceName;
   if (const PciDevEntry *dev = LookupPciDevice(f.vendor, f.device, f.subvendor, f.subdevice)) {
      vendorName = PciName(dev->vendorName);
      deviceName = PciName(dev->name);
   } else {
      if (const PciDevEntry *row = LookupPciDevice(f.vendor, 0xffff, 0xffff, 0xffff)) {
         vendorName = PciName(row->vendorName);
      } else {
         std::snprintf(vendorBuf, sizeof vendorBuf, "Vendor %.4x", f.vendor);
         vendorName = vendorBuf;
      }
      std::snprintf(deviceBuf, sizeof deviceBuf, "Device %.4x", f.device);
      deviceName = deviceBuf;
   }

   if (verbose) {
      std::printf("%.*s %.*s: ", int(className.size()), className.data(), int(subclassName.size()),
                  subclassName.data());
   } else {
      std::string_view shown = subclassName.empty() ? className : subclassName;
      std::printf("%.*s: ", int(shown.size()), shown.data());
   }
   std::printf("%.*s %.*s ", int(vendorName.size()), vendorName.data(), int(deviceName.size()),
               deviceName.data());
}

void PrintDefault(const Walk &w) {
   PciFunction f = DecodeFunction(w.rec);
   PrintAddress(w);
   if (w.flags & kNoLookup)
      std::printf("Class %.4x: %04x:%04x ", f.classCode, f.vendor, f.device);
   else
      PrintNames(f, w.flags & kVerbose);
   if (!f.kernelName.empty())
      std::printf("[%.*s]\n", int(f.kernelName.size()), f.kernelName.data());
   else
      std::putchar('\n');
   if ((w.flags & kVerbose) && !(w.flags & kNoLookup))
      std::printf("\t Class %.4x: %04x:%04x\n\n", f.classCode, f.vendor, f.device);
   if (w.flags & kDump) HexDump(w.config);
   if (w.flags & kExtDump) HexDump(w.extConfig);
}

void PrintDetailed(Walk &w) {
   PciFunction f = DecodeFunction(w.rec);
   char interrupt[16] = "";
   if (f.irqFlags & pcirecord::kIrqValid) {
      int pin = 'A' + f.intPin;
      if (f.vector == 0)
         std::snprintf(interrupt, sizeof interrupt, "%3d/   /     %c", f.isaIrq, pin);
      else if (f.irq == 0xff)
         std::snprintf(interrupt, sizeof interrupt, "%3d/   /0x%02x %c", f.isaIrq, f.vector, pin);
      else
         std::snprintf(interrupt, sizeof interrupt, "%3d/%3d/0x%02x %c", f.isaIrq, f.irq, f.vector, pin);
   }
   const char *mode = (f.modeFlags & 1) ? "C" : (f.modeFlags & 2) ? "V" : (f.modeFlags & 4) ? "P" : "U";
   const char *module = f.moduleId == 0 || f.moduleId == kNoModule ? "" : ModuleName(w.modules, f.moduleId);

   PrintAddress(w);
   std::printf("%04x:%04x %04x:%04x %-14s %-1s %-12s %.*s\n", f.vendor, f.device, f.subvendor, f.subdevice,
               interrupt, mode, module, int(f.kernelName.size()), f.kernelName.data());
   // A bridge's secondary bus stands under the interrupt column.
   if (f.irqFlags & pcirecord::kSpawnsBus) {
      char bus[8];
      std::snprintf(bus, sizeof bus, " %02x", f.spawnedBus);
      std::printf("%-12s %-19s %-14s\n", "", "", bus);
   }
}

// Reads one function (and the configuration spaces -d and -e ask for, also
// with -p, which prints no dump) and prints it.
int ShowFunction(Walk &w) {
   KEL_Status status =
      KEL_Get(KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigHeader, w.keys, w.rec, sizeof w.rec);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "ListPCI: error fetching PCI information 0x%x\n", status);
      return 1;
   }
   if (w.flags & kDump) {
      status = KEL_Get(KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigSpace, w.keys, w.config, sizeof w.config);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "ListPCI: error fetching PCI configuration space 0x%x\n", status);
         return 1;
      }
   }
   if (w.flags & kExtDump) {
      status = KEL_Get(KEL_NODE_hardware_pci_seg_bus_slot_func_pciExtConfigSpace, w.keys, w.extConfig,
                       sizeof w.extConfig);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "ListPCI: error fetching PCI configuration space 0x%x\n", status);
         return 1;
      }
   }
   if (w.flags & kDetailed)
      PrintDetailed(w);
   else
      PrintDefault(w);
   return 0;
}

// Lists one level under the keys gathered so far and walks each instance.
// Any failure ends the walk with status 1; a failed listing is a failure at
// every level.
int WalkLevel(Walk &w, int level) {
   if (level == kFunctionLevel) return ShowFunction(w);
   int result = 0;
   WalkResult walk = ForEachInstance(*kPciLevels[level].node, w.keys, [&](const KEL_Param *) {
      result = WalkLevel(w, level + 1);
      return result == 0;
   });
   switch (walk.end) {
   case WalkEnd::ListFailed:
      std::fprintf(stderr, "ListPCI: error fetching PCI %s list 0x%x\n", kPciLevels[level].name, walk.status);
      return 1;
   case WalkEnd::AppendFailed:
      return 1;  // AddParamToList has reported it
   case WalkEnd::Stopped:
      return result;
   case WalkEnd::Done:
      break;
   }
   return 0;
}

// Sets the option flags; false after printing the usage for -h or an
// option lspci does not know.
bool ParseOptions(int argc, char **argv, unsigned *flags) {
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      switch (c) {
      case 'p': *flags |= kDetailed; break;
      case 'n': *flags |= kNoLookup; break;
      case 'd': *flags |= kDump; break;
      case 'e': *flags |= kExtDump; break;
      case 'v': *flags |= kVerbose; break;
      default: std::fputs(kUsage, stderr); return false;
      }
   }
   return true;
}

}  // namespace

int ListPCI(int argc, char **argv) {
   // -h, like any option lspci does not know, ends the command with 1.
   unsigned flags = 0;
   if (!ParseOptions(argc, argv, &flags)) return 1;
   // The names are loaded whatever the options, as they always have been.
   // Only a corrupted ID file name or no memory for the file list ends the
   // command here; any other failure only takes the names away.
   if (!LoadPciIdTables()) return 1;
   if (flags & kDetailed) {
      std::printf(kDetailedHeader, "Segm:Bu:De.F", "Vend:Dvid Subv:Subd", "ISA/irq/Vect P", "M", "Module", "Name");
      std::printf(kDetailedHeader, "", "", "Spawned bus", "", "", "");
   }
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("ListPCI: Not enough memory\n", stderr);
      return 1;
   }
   Walk walk;
   walk.flags = flags;
   walk.keys = keys.get();
   return WalkLevel(walk, 0);
}
