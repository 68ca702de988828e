// The cartel walk of pgrep and pkill.
#include "worlds/cartelwalk.h"

#include <cstdio>
#include <cstring>

#include "kel/worldrecords.h"

PatternResult CompilePattern(const char *command, const char *text, PatternPtr *pattern) {
   auto *re = static_cast<regex_t *>(std::malloc(sizeof(regex_t)));
   if (re == nullptr) return PatternResult::NoMemory;
   int error = regcomp(re, text, REG_EXTENDED | REG_NOSUB);
   if (error != 0) {
      char reason[256];
      regerror(error, re, reason, sizeof reason);
      std::fprintf(stderr, "%s: %s\n", command, reason);
      std::free(re);
      return PatternResult::BadPattern;
   }
   pattern->reset(re);
   return PatternResult::Compiled;
}

KEL_Status WalkCartels(const regex_t &pattern, bool full, CartelVisitor visit, void *context) {
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys) return KEL_STATUS_NO_MEMORY;
   ParamListPtr cartels;
   KEL_Status status = GetInstanceList(KEL_NODE_userworld_cartel, nullptr, &cartels);
   if (status != KEL_STATUS_OK) return status;

   // The visitors read the cartel ID from entry i of the cartel list itself,
   // so the walk keeps the list rather than going through ForEachInstance.
   // One byte beyond the record keeps a command line that fills it terminated.
   char cmdline[kCmdlineSize + 1];
   uint32_t n = KEL_ParamListUsedCount(cartels.get());
   for (uint32_t i = 0; i < n; i++) {
      ScopedKey cartel(keys.get(), KEL_ParamListGetParam(cartels.get(), i));
      if (!cartel.ok()) return KEL_STATUS_FAILURE;
      status = KEL_Get(KEL_NODE_userworld_cartel_cmdline, keys.get(), cmdline, kCmdlineSize);
      if (status == KEL_STATUS_NO_CARTEL) continue;
      if (status != KEL_STATUS_OK) return status;

      cmdline[kCmdlineSize] = '\0';
      if (!full) {
         if (char *space = std::strchr(cmdline, ' ')) *space = '\0';
      }
      CartelSeen seen{cartels.get(), i, cmdline, regexec(&pattern, cmdline, 0, nullptr, 0) == 0};
      status = visit(seen, context);
      if (status != KEL_STATUS_OK) return status;
   }
   return KEL_STATUS_OK;
}
