// irqinfo: one row per interrupt cookie with its count on each physical CPU
// and the devices that use it.
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string_view>

#include "kel/hwrecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr const char kUsage[] = "irqinfo:      List interrupt information\n";

// The most CPUs the table has columns for.  A tree that claims more is
// refused before anything is printed, so that a hostile count cannot keep
// the command reading counts for hours.
constexpr uint32_t kMaxCpus = 4096;

// The devices column: a 64-byte buffer, so at most 63 characters.
constexpr size_t kDevicesMax = 63;

// Appends to the devices text, cutting it at kDevicesMax characters.
struct DevicesText {
   char text[kDevicesMax + 1] = "";
   size_t length = 0;

   void Append(std::string_view part) {
      size_t n = part.size() < kDevicesMax - length ? part.size() : kDevicesMax - length;
      std::memcpy(text + length, part.data(), n);
      length += n;
      text[length] = '\0';
   }
   bool Full() const { return length == kDevicesMax; }
};

// Joins "ORX <name>" for each device, ", " between them; a key that carries
// no text is shown as "ORX device".
void JoinDevices(const KEL_ParamList *devices, DevicesText *out) {
   uint32_t count = KEL_ParamListUsedCount(devices);
   for (uint32_t i = 0; i < count && !out->Full(); i++) {
      const char *name = KEL_ParamGetString(KEL_ParamListGetParam(devices, i));
      if (i > 0) out->Append(", ");
      out->Append("ORX ");
      out->Append(name != nullptr ? name : "device");
   }
}

// Prints one CPU's count, or ten blanks when it cannot be read (one fewer
// than a count takes, so the row's later columns shift left: kept as the
// tool has always printed it).  False when the CPU index cannot be added.
bool PrintCpuCount(KEL_ParamList *keys, uint32_t cpu) {
   ScopedKey cpuKey(keys, uint64_t(cpu));
   if (!cpuKey.ok()) {
      std::fprintf(stderr, "Couldn't add param to list: %#x", cpuKey.status());
      return false;
   }
   uint8_t record[irqcount::kSize];
   if (KEL_Get(KEL_NODE_hardware_interrupts_cookieList_PCPU, keys, record, sizeof record) == KEL_STATUS_OK)
      std::printf("%10llu ", static_cast<unsigned long long>(ReadU64(record, irqcount::kCount)));
   else
      std::printf("%10s", "");
   return true;
}

// Prints the row of one cookie; the cookie key is on the key list meanwhile.
// False after a failure has been reported.
bool PrintCookieRow(const KEL_Param *cookie, KEL_ParamList *keys, uint32_t numCpus) {
   ScopedKey cookieKey(keys, cookie);
   if (!cookieKey.ok()) {
      std::fprintf(stderr, "InterruptInfo: error requesting interrupt info - 0x%x\n", 0);
      return false;
   }
   unsigned long long cookieValue = static_cast<unsigned long long>(KEL_ParamGetInt(cookie));

   uint8_t usage[irqusage::kSize];
   if (KEL_Get(KEL_NODE_hardware_interrupts_cookieList_UsageStatus, keys, usage, sizeof usage) !=
       KEL_STATUS_OK) {
      std::fprintf(stderr, "InterruptInfo: error fetching interrupt info - 0x%llx\n", cookieValue);
      return false;
   }

   std::printf("0x%04llx:", cookieValue);
   for (uint32_t cpu = 0; cpu < numCpus; cpu++)
      if (!PrintCpuCount(keys, cpu)) return false;

   ParamListPtr devices;
   KEL_Status status = GetInstanceList(KEL_NODE_hardware_interrupts_cookieList_ORXDevices, keys, &devices);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "InterruptInfo: error fetching interrupt device list - 0x%x\n", status);
      return false;
   }

   // The device list is read even when the flag hides it.
   DevicesText text;
   if (ReadU8(usage, irqusage::kDeviceFlag) == 0)
      text.Append("<ORX device>");
   else
      JoinDevices(devices.get(), &text);
   devices.reset();

   std::printf("%s\n", text.text);
   return true;
}

}  // namespace

int InterruptInfo(int argc, char **) {
   if (argc > 1) {
      std::fputs(kUsage, stderr);
      return 1;
   }

   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) {
      std::fputs("InterruptInfo: Not enough memory\n", stderr);
      return 1;
   }

   uint8_t cpuInfo[cpuinfo::kSize];
   KEL_Status status = KEL_Get(KEL_NODE_hardware_cpu_cpuInfo, nullptr, cpuInfo, sizeof cpuInfo);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "InterruptInfo: error fetching number of CPUs - 0x%x\n", status);
      return 1;
   }
   uint32_t numCpus = ReadU32(cpuInfo, cpuinfo::kNumCpus);
   if (numCpus > kMaxCpus) {
      std::fprintf(stderr, "InterruptInfo: too many CPUs - %u (at most %u)\n", numCpus, kMaxCpus);
      return 1;
   }

   ParamListPtr cookies;
   status = GetInstanceList(KEL_NODE_hardware_interrupts_cookieList, nullptr, &cookies);
   if (status != KEL_STATUS_OK) {
      std::fprintf(stderr, "InterruptInfo: error fetching interrupt list - 0x%x\n", status);
      return 1;
   }

   std::fputs("Cookie ", stdout);
   for (uint32_t cpu = 0; cpu < numCpus; cpu++) std::printf("   PCPU %2u ", cpu);
   std::putchar('\n');

   uint32_t count = KEL_ParamListUsedCount(cookies.get());
   for (uint32_t i = 0; i < count; i++)
      if (!PrintCookieRow(KEL_ParamListGetParam(cookies.get(), i), keys.get(), numCpus)) return 1;
   return 0;
}
