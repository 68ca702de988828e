// Records about the CPUs, interrupts and ACPI tables, read by irqinfo and
// amldump and written by the platform's tree sources.  Fields are
// little-endian and read by byte offset.
#ifndef KEL_HWRECORDS_H
#define KEL_HWRECORDS_H

#include <cstddef>
#include <cstdint>

#include "kel/kel.h"

// CPU information record (KEL_NODE_hardware_cpu_cpuInfo, 36 bytes):
//   16 number of physical CPUs  u32
namespace cpuinfo {
constexpr uint32_t kSize = 36;
constexpr size_t kNumCpus = 16;
}  // namespace cpuinfo
static_assert(cpuinfo::kSize == KEL_RECORD_SIZE_hardware_cpu_cpuInfo);

// Interrupt usage record (KEL_NODE_hardware_interrupts_cookieList_UsageStatus,
// 12 bytes):
//    8 device flag  u8   zero: the kernel's own device, shown as "<ORX device>"
namespace irqusage {
constexpr uint32_t kSize = 12;
constexpr size_t kDeviceFlag = 8;
}  // namespace irqusage
static_assert(irqusage::kSize == KEL_RECORD_SIZE_hardware_interrupts_cookieList_UsageStatus);

// Per-CPU count record (KEL_NODE_hardware_interrupts_cookieList_PCPU, 8 bytes):
//    0 interrupts on that CPU  u64
namespace irqcount {
constexpr uint32_t kSize = 8;
constexpr size_t kCount = 0;
}  // namespace irqcount
static_assert(irqcount::kSize == KEL_RECORD_SIZE_hardware_interrupts_cookieList_PCPU);

// Table buffer record (KEL_NODE_hardware_acpi_tables_buffers, 131084 bytes):
//
//    0 table signature, 4 characters
//    4 set to NUL here, so that bytes 0..4 are the signature as a text
//    5 length of this buffer's data  u32 (not aligned)
//    9 the data: its first "length" bytes are the next piece of the table
namespace acpibuffer {
constexpr uint32_t kSize = 131084;
constexpr size_t kSignature = 0;
constexpr size_t kSignatureEnd = 4;
constexpr size_t kLength = 5;
constexpr size_t kData = 9;
constexpr uint32_t kDataMax = kSize - kData;
}  // namespace acpibuffer
static_assert(acpibuffer::kSize == KEL_RECORD_SIZE_hardware_acpi_tables_buffers);

#endif
