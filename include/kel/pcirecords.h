// The PCI function record and configuration spaces, read by lspci and
// pci-info.
#ifndef KEL_PCIRECORDS_H
#define KEL_PCIRECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

// The levels above a PCI function, in key order, with the word messages use
// for each: segment, bus, slot, function.
struct PciLevel {
   const KEL_Node *node;
   const char *name;
};
inline constexpr PciLevel kPciLevels[] = {
   {&KEL_NODE_hardware_pci_seg, "seg"},
   {&KEL_NODE_hardware_pci_seg_bus, "bus"},
   {&KEL_NODE_hardware_pci_seg_bus_slot, "slot"},
   {&KEL_NODE_hardware_pci_seg_bus_slot_func, "func"},
};

// PCI function record (KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigHeader,
// 128 bytes, packed, little-endian):
//
//    0 vendor       u16     12 ISA IRQ      u8     17 IRQ flags    u8
//    2 device       u16     13 IRQ          u8     18 mode flags   u8
//    4 subvendor    u16     14 vector       u8     19 module ID    u32
//    6 subdevice    u16     15 pin (0 = A)  u8     23 device name  text[33]
//    8 class code   u16     16 spawned bus  u8     56 phys. slot   u32
//
// IRQ 0xff and vector 0 mean none.  IRQ flags: bit 0 the interrupt fields
// are valid, bit 1 the function spawns a bus.  Module ID 0 and 0xffffffff
// mean none.
namespace pcirecord {
constexpr uint32_t kSize = 128;
constexpr size_t kVendor = 0;
constexpr size_t kDevice = 2;
constexpr size_t kSubvendor = 4;
constexpr size_t kSubdevice = 6;
constexpr size_t kClassCode = 8;
constexpr size_t kIsaIrq = 12;
constexpr size_t kIrq = 13;
constexpr size_t kVector = 14;
constexpr size_t kIntPin = 15;
constexpr size_t kSpawnedBus = 16;
constexpr size_t kIrqFlags = 17;
constexpr size_t kModeFlags = 18;
constexpr size_t kModuleId = 19;
constexpr size_t kDeviceName = 23;
constexpr size_t kDeviceNameWidth = 33;
constexpr size_t kPhysSlot = 56;

constexpr uint8_t kIrqValid = 0x01;
constexpr uint8_t kSpawnsBus = 0x02;
}  // namespace pcirecord
static_assert(pcirecord::kSize == KEL_RECORD_SIZE_hardware_pci_seg_bus_slot_func_pciConfigHeader);

// Standard configuration space (KEL_NODE_hardware_pci_seg_bus_slot_func_pciConfigSpace,
// 256 bytes): the function's raw bytes, shown as they are.
namespace pciconfigspace {
constexpr uint32_t kSize = 256;
}  // namespace pciconfigspace
static_assert(pciconfigspace::kSize == KEL_RECORD_SIZE_hardware_pci_seg_bus_slot_func_pciConfigSpace);

// Extended configuration space
// (KEL_NODE_hardware_pci_seg_bus_slot_func_pciExtConfigSpace, 4096 bytes):
// the function's raw bytes, shown as they are.
namespace pciextconfigspace {
constexpr uint32_t kSize = 4096;
}  // namespace pciextconfigspace
static_assert(pciextconfigspace::kSize == KEL_RECORD_SIZE_hardware_pci_seg_bus_slot_func_pciExtConfigSpace);

// Module record (KEL_NODE_system_modules_general, 700 bytes):
//
//      0 name       text (only its first 32 bytes are used)
//    288 module ID  u32
namespace modulerecord {
constexpr uint32_t kSize = 700;
constexpr size_t kName = 0;
constexpr size_t kNameWidth = 32;
constexpr size_t kId = 288;
}  // namespace modulerecord
static_assert(modulerecord::kSize == KEL_RECORD_SIZE_system_modules_general);

#endif
