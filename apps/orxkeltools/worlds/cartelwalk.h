// The walk that pgrep and pkill share: each cartel's command line, in the
// order of the cartel list, tested against one POSIX extended expression.
#ifndef ORXKELTOOLS_WORLDS_CARTELWALK_H
#define ORXKELTOOLS_WORLDS_CARTELWALK_H

#include <regex.h>

#include <cstdint>
#include <cstdlib>
#include <memory>

#include "keltools.h"

// A compiled pattern, taken with malloc and released with its expression.
struct PatternDeleter {
   void operator()(regex_t *re) const {
      regfree(re);
      std::free(re);
   }
};
using PatternPtr = std::unique_ptr<regex_t, PatternDeleter>;

enum class PatternResult { Compiled, NoMemory, BadPattern };

// Compiles text (REG_EXTENDED | REG_NOSUB) into *pattern.  A pattern that
// does not compile is reported on standard error as "<command>: <reason>".
PatternResult CompilePattern(const char *command, const char *text, PatternPtr *pattern);

// One cartel as the walk sees it.  Entry index of cartels is its key, whose
// value is the cartel ID.
struct CartelSeen {
   const KEL_ParamList *cartels;
   uint32_t index;
   const char *text;  // the match text: the first word, or the whole line
   bool matches;
};

// Called for every cartel whose command line was read; a non-zero status
// ends the walk with that status.
using CartelVisitor = KEL_Status (*)(const CartelSeen &seen, void *context);

// Walks a fresh cartel list.  Cartels gone since the listing (their command
// line reads 0xbad0062) are passed over.  Returns 0, or the status that
// ended the walk: 0xbad0014 when the key list cannot be made, the listing's
// status, 0xbad0001 for a key that cannot be appended, the status of a
// failed command-line read, or the visitor's.
KEL_Status WalkCartels(const regex_t &pattern, bool full, CartelVisitor visit, void *context);

#endif
