// pci-info: the IRQ, the physical slot or the raw configuration space of one
// PCI function, for scripts: bare numbers without newlines and raw bytes.
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <iterator>
#include <utility>

#include "keltools.h"
#include "numbers.h"
#include "kel/pcirecords.h"
#include "records.h"

namespace {

constexpr char kOptions[] = "n:b:s:f:hiceS";
constexpr char kUsage[] =
   "pci-info\n"
   "  -n <segment>      device segment (default: 0)\n"
   "  -b <bus>          device bus\n"
   "  -s <slot>         device slot\n"
   "  -f <function>     device function\n"
   "  -h                help\n"
   "  -i                print IRQ vector\n"
   "  -c                print PCI config space\n"
   "  -e                print PCI extended config space\n"
   "  -S                print physical slot\n";

// Actions; they run in this order whatever the order of the options.
constexpr unsigned kPrintIrq = 1;
constexpr unsigned kPrintConfig = 2;
constexpr unsigned kPrintExtConfig = 4;
constexpr unsigned kPrintSlot = 8;

struct Address {
   int32_t seg = 0;
   int32_t bus = -1;
   int32_t slot = -1;
   int32_t func = -1;
};

// Finds the function's segment, bus, slot and function keys level by level
// and returns them as a new key list.  Only a number that is not there is
// reported here; the callers report the rest.
KEL_Status GetDevice(const Address &a, ParamListPtr *device) {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("Failed to allocate param list (size = 1)\n", stderr);
      return KEL_STATUS_NO_RESOURCES;
   }
   const int32_t wanted[] = {a.seg, a.bus, a.slot, a.func};
   for (size_t l = 0; l < std::size(kPciLevels); l++) {
      const PciLevel &level = kPciLevels[l];
      ParamListPtr list;
      KEL_Status status = GetInstanceList(*level.node, l == 0 ? nullptr : keys.get(), &list);
      if (status != KEL_STATUS_OK) return status;
      const KEL_Param *found = nullptr;
      uint32_t count = KEL_ParamListUsedCount(list.get());
      for (uint32_t i = 0; i < count && found == nullptr; i++) {
         const KEL_Param *param = KEL_ParamListGetParam(list.get(), i);
         if (param && int32_t(KEL_ParamGetInt(param)) == wanted[l]) found = param;
      }
      if (found == nullptr) {
         std::fprintf(stderr, "%s: invalid %s %d\n", "GetDevice", level.name, wanted[l]);
         return KEL_STATUS_BAD_PARAM;
      }
      if (!AddParamToList(found, keys.get())) return KEL_STATUS_FAILURE;
   }
   *device = std::move(keys);
   return KEL_STATUS_OK;
}

// The pattern GetPCIInfo, PrintConfigSpace and PrintExtConfigSpace share:
// find the function, then read one of its nodes into buf.
bool ReadFunctionNode(const char *who, const Address &a, KEL_Node node, uint8_t *buf, uint32_t size) {
   ParamListPtr keys;
   if (GetDevice(a, &keys) != KEL_STATUS_OK) {
      std::fprintf(stderr, "%s: invalid device: %d:%d.%d\n", who, a.bus, a.slot, a.func);
      return false;
   }
   KEL_Status status = KEL_Get(node, keys.get(), buf, size);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "%s: error fetching PCI information 0x%x\n", who, status);
      return false;
   }
   return true;
}

bool GetPCIInfo(const Address &a, uint8_t (&rec)[pcirecord::kSize]) {
   return ReadFunctionNode("GetPCIInfo", a, KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigHeader, rec,
                           sizeof rec);
}

// Writes the raw bytes to descriptor 1, past the stdio buffer: text printed
// before them is still buffered and comes after.  A short write goes on
// with the rest.  False when the output failed; the error is noted for the
// report at exit.
bool WriteRaw(const uint8_t *bytes, size_t size) {
   while (size > 0) {
      ssize_t n = write(1, bytes, size);
      if (n < 0 && errno == EINTR) continue;
      if (n <= 0) {
         NoteOutputError(n < 0 ? errno : EIO);
         return false;
      }
      bytes += n;
      size -= size_t(n);
   }
   return true;
}

// What PrintConfigSpace and PrintExtConfigSpace did.
enum class Printed { Done, NotRead, OutputFailed };

Printed PrintSpace(const char *who, const Address &a, KEL_Node node, uint8_t *space, uint32_t size) {
   if (!ReadFunctionNode(who, a, node, space, size)) return Printed::NotRead;
   return WriteRaw(space, size) ? Printed::Done : Printed::OutputFailed;
}

Printed PrintConfigSpace(const Address &a) {
   uint8_t space[pciconfigspace::kSize];
   return PrintSpace("PrintConfigSpace", a, KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigSpace, space,
                     sizeof space);
}

Printed PrintExtConfigSpace(const Address &a) {
   uint8_t space[pciextconfigspace::kSize];
   return PrintSpace("PrintExtConfigSpace", a, KEL_NODE_hardware_pci_seg_bus_slot_func_pciExtConfigSpace,
                     space, sizeof space);
}

}  // namespace

int PciInfoMain(int argc, char **argv) {
   Address a;
   unsigned actions = 0;
   int c;
   while ((c = getopt(argc, argv, kOptions)) != -1) {
      switch (c) {
      case 'n': a.seg = StrtolInt32(optarg); break;
      case 'b': a.bus = StrtolInt32(optarg); break;
      case 's': a.slot = StrtolInt32(optarg); break;
      case 'f': a.func = StrtolInt32(optarg); break;
      case 'h': std::fputs(kUsage, stderr); return 0;
      case 'i': actions |= kPrintIrq; break;
      case 'c': actions |= kPrintConfig; break;
      case 'e': actions |= kPrintExtConfig; break;
      case 'S': actions |= kPrintSlot; break;
      default: std::fputs(kUsage, stderr); return 1;
      }
   }
   if (actions == 0) {
      std::fputs(kUsage, stderr);
      return 1;
   }

   // Once an action was asked for the status is 0: a script tells a failure
   // by the missing output.  Only output that cannot be written fails the
   // command; nothing more is written then.
   uint8_t rec[pcirecord::kSize];
   if ((actions & kPrintIrq) && GetPCIInfo(a, rec)) std::printf("%3d", ReadU8(rec, pcirecord::kIrq));
   if ((actions & kPrintConfig) && PrintConfigSpace(a) == Printed::OutputFailed) return 1;
   if ((actions & kPrintExtConfig) && PrintExtConfigSpace(a) == Printed::OutputFailed) return 1;
   if ((actions & kPrintSlot) && GetPCIInfo(a, rec)) std::printf("%3d", ReadI32(rec, pcirecord::kPhysSlot));
   return 0;
}
