// The signal names pkill accepts, with the numbers of the Linux i386 signal
// set.  Names carry no SIG prefix and are compared case-sensitively; the
// table is searched in order and several numbers have two names (EMT and
// INFO are extra aliases of BUS and PWR).
#ifndef ORXKELTOOLS_WORLDS_SIGNALS_H
#define ORXKELTOOLS_WORLDS_SIGNALS_H

#include <span>
#include <string_view>

struct SignalName {
   std::string_view name;
   int number;
};

inline constexpr SignalName kSignalNames[] = {
   {"HUP", 1},     {"INT", 2},    {"QUIT", 3},  {"ILL", 4},     {"TRAP", 5},   {"ABRT", 6},
   {"IOT", 6},     {"BUS", 7},    {"EMT", 7},   {"FPE", 8},     {"KILL", 9},   {"USR1", 10},
   {"SEGV", 11},   {"USR2", 12},  {"PIPE", 13}, {"ALRM", 14},   {"TERM", 15},  {"STKFLT", 16},
   {"CLD", 17},    {"CHLD", 17},  {"CONT", 18}, {"STOP", 19},   {"TSTP", 20},  {"TTIN", 21},
   {"TTOU", 22},   {"URG", 23},   {"XCPU", 24}, {"XFSZ", 25},   {"VTALRM", 26}, {"PROF", 27},
   {"WINCH", 28},  {"POLL", 29},  {"IO", 29},   {"PWR", 30},    {"INFO", 30},  {"SYS", 31},
};

// The number of the first row of table named name, or 0 when no row is.
constexpr int SignalByName(std::string_view name, std::span<const SignalName> table = kSignalNames) {
   for (const SignalName &row : table)
      if (row.name == name) return row.number;
   return 0;
}

#endif
