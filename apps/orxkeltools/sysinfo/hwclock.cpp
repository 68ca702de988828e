// hwclock: shows the hardware real-time clock, which keeps UTC, or sets its
// time and/or date through the KEL tree.
#include <getopt.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>

#include "kel/sysinforecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr char kShortOptions[] = "t:d:";
constexpr struct option kLongOptions[] = {
   {"time", required_argument, nullptr, 't'},
   {"date", required_argument, nullptr, 'd'},
   {"help", no_argument, nullptr, 'h'},
   {nullptr, 0, nullptr, 0},
};
constexpr char kUsage[] =
   "hwclock     -d --date <date>         Set date\n"
   "            -t --time <time>         Set time\n"
   "\n"
   "Valid date format: MM/DD/YYYY\n"
   "Valid time format: HH:MM:SS\n";

// A field of the new setting that no option supplied.
constexpr int32_t kNotGiven = -1;

// The new setting, in the order of the set request.
enum Field { kMonth, kDay, kYear, kHours, kMinutes, kSeconds, kFieldCount };
// Where each field of the setting stands in the clock's record.
constexpr size_t kRecordOffset[kFieldCount] = {rtc::kMonth, rtc::kDay, rtc::kYear,
                                               rtc::kHours, rtc::kMinutes, rtc::kSeconds};

// Writes the usage text; the handler then ends with status 1.
int Usage() {
   std::fputs(kUsage, stderr);
   return 1;
}

// Reads three decimal integers separated by sep into out, as
// sscanf("%d<sep>%d<sep>%d") does; text after the third is ignored.  A number
// beyond the range of int makes the text malformed rather than undefined.
bool ReadThree(const char *text, char sep, int32_t *out) {
   const char *p = text;
   for (int i = 0; i < 3; i++) {
      if (i > 0) {
         if (*p != sep) return false;
         p++;
      }
      char *end;
      errno = 0;
      long value = std::strtol(p, &end, 10);
      if (end == p || errno == ERANGE || value < INT32_MIN || value > INT32_MAX) return false;
      out[i] = int32_t(value);
      p = end;
   }
   return true;
}

// Sends the setting; KEL_Set takes it as six 64-bit integers whose upper
// halves are 0.
KEL_Status SetClock(const int32_t *setting) {
   ParamListPtr request(KEL_ParamListCreate(0, 6));
   if (!request) return KEL_STATUS_NO_MEMORY;
   for (int f = 0; f < kFieldCount; f++) {
      KEL_Status status = KEL_ParamListAddInt(request.get(), uint64_t(uint32_t(setting[f])));
      if (status != KEL_STATUS_OK) return status;
   }
   return KEL_Set(KEL_NODE_hardware_chipset_rtc, nullptr, request.get(), nullptr, 0);
}

}  // namespace

int HwclockMain(int argc, char **argv) {
   const char *timeText = nullptr, *dateText = nullptr;
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      if (c == 't')
         timeText = optarg;
      else if (c == 'd')
         dateText = optarg;
      else
         return Usage();
   }

   int32_t setting[kFieldCount] = {kNotGiven, kNotGiven, kNotGiven, kNotGiven, kNotGiven, kNotGiven};
   if (timeText != nullptr && !ReadThree(timeText, ':', &setting[kHours])) {
      std::printf("Invalid time format: %s\n", timeText);
      return 1;
   }
   if (dateText != nullptr && !ReadThree(dateText, '/', &setting[kMonth])) {
      std::printf("Invalid date format: %s\n", dateText);
      return 1;
   }

   // The clock is read to show it and for every field left unset, so a -1
   // given with both options also keeps the clock's current value.
   bool show = timeText == nullptr && dateText == nullptr;
   bool needClock = show;
   for (int32_t value : setting) needClock = needClock || value == kNotGiven;
   uint8_t current[rtc::kSize];
   if (needClock) {
      KEL_Status status = KEL_Get(KEL_NODE_hardware_chipset_rtc, nullptr, current, sizeof current);
      if (status != KEL_STATUS_OK) {
         std::fprintf(stderr, "Failed to read the hardware clock: %s\n", ORX_ReturnStatusToString(status));
         return 1;
      }
   }

   if (show) {
      std::printf("%.2d:%.2d:%.2d   %.2d/%.2d/%.4d   UTC\n", ReadI32(current, rtc::kHours),
                  ReadI32(current, rtc::kMinutes), ReadI32(current, rtc::kSeconds), ReadI32(current, rtc::kMonth),
                  ReadI32(current, rtc::kDay), ReadI32(current, rtc::kYear));
      return 0;
   }

   for (int f = 0; f < kFieldCount; f++)
      if (setting[f] == kNotGiven) setting[f] = ReadI32(current, kRecordOffset[f]);
   KEL_Status status = SetClock(setting);
   if (status != KEL_STATUS_OK) {
      std::printf("KEL_Set error: 0x%x\n", status);
      return 1;
   }
   std::printf("Clock updated.\nTime: %.2d:%.2d:%.2d   Date: %.2d/%.2d/%.2d   UTC\n", setting[kHours],
               setting[kMinutes], setting[kSeconds], setting[kMonth], setting[kDay], setting[kYear]);
   return 0;
}
