// bootOption: how the host was booted.  Each option selects one item; the
// items are printed in a fixed order, each with a label, or bare with -r.
#include <getopt.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <string_view>

#include "kel/corafsrecords.h"
#include "kel/sysinforecords.h"
#include "keltools.h"
#include "records.h"

namespace {

constexpr char kShortOptions[] = "afhiruwRpkmobc:C";
constexpr struct option kLongOptions[] = {
   {"raw", no_argument, nullptr, 'r'},
   {"all", no_argument, nullptr, 'a'},
   {"fsck", no_argument, nullptr, 'f'},
   {"help", no_argument, nullptr, 'h'},
   {"audit", no_argument, nullptr, 'i'},
   {"rollback", no_argument, nullptr, 'R'},
   {"pxeboot", no_argument, nullptr, 'p'},
   {"kernel", no_argument, nullptr, 'k'},
   {"modules", no_argument, nullptr, 'm'},
   {"options", no_argument, nullptr, 'o'},
   {"bootOptionFiles", no_argument, nullptr, 'b'},
   {"bootOptionContent", required_argument, nullptr, 'c'},
   // The name the help text shows for -c.
   {"bootOptionFileContent", required_argument, nullptr, 'c'},
   {"bootOptionFilesContent", no_argument, nullptr, 'C'},
   {nullptr, 0, nullptr, 0},
};
constexpr std::string_view kHelp =
   "bootOption\n"
   "  -r --raw                      Print w/o annotation\n"
   "  -a --all                      Print f,i,u,w,R boot options\n"
   "  -f --fsck                     FS Check Mode\n"
   "  -i --audit                    Audit Mode\n"
   "  -R --rollback                 Booted after a rollback\n"
   "  -p --pxeboot                  Booted via (g)PXE\n"
   "  -k --kernel                   Kernel used to boot\n"
   "  -m --modules                  List of modules used to boot\n"
   "  -o --options                  List of boot options used to boot\n"
   "  -b --bootOptionFiles          List of boot option files to boot\n"
   "  -c --bootOptionFileContent    Content of a boot option file used to boot\n"
   "  -C --bootOptionFilesContent   Content of all boot option files used to boot\n";

// Contents are read at most 3 MiB at a time.
constexpr uint32_t kMaxChunk = 0x300000;

struct Request {
   bool fsck = false, audit = false, rollback = false, pxe = false;
   bool kernel = false, modules = false, options = false, files = false;
   bool allContents = false, raw = false;
   const char *contentName = nullptr;  // -c: the last one given
};

// Writes the help text; the handler then ends with status 1.
int Help() {
   std::fwrite(kHelp.data(), 1, kHelp.size(), stderr);
   return 1;
}

// Prints the label unless the output is raw.
void Label(const Request &req, const char *label) {
   if (!req.raw) std::fputs(label, stdout);
}

KEL_Status ListBootOptionFiles(ParamListPtr *files) {
   KEL_ParamList *list = nullptr;
   KEL_Status status = KEL_GetInstanceListAllocHint(KEL_NODE_system_bootOptionFiles, nullptr, 0, &list);
   files->reset(list);
   return status;
}

// Reads one chunk of a file's content into out, the chunk request sent as
// a data object of its own.
KEL_Status ReadChunk(const KEL_ParamList *keys, uint32_t offset, uint32_t chunk, KELData *out) {
   uint8_t request[chunkrequest::kSize];
   PutU32(request, chunkrequest::kOffset, offset);
   PutU32(request, chunkrequest::kCount, chunk);
   KELDataPtr in(KELData_Create(chunkrequest::kSize, request, sizeof request));
   if (!in) return KEL_STATUS_NO_MEMORY;
   return KEL_SetData(KEL_NODE_system_bootOptionFiles_content, keys, in.get(), out);
}

// Prints the content of one boot option file, line feeds turned into spaces
// so that it stays on one line.  Returns 0 or 1.
int PrintContent(const char *name, bool raw) {
   if (InvokedWithCache) {
      std::fputs("Using KEL cache is unsupported\n", stderr);
      return 1;
   }
   ParamListPtr keys(KEL_ParamListCreate(1, 1));
   if (!keys || KEL_ParamListAddString(keys.get(), name) != KEL_STATUS_OK) return 1;
   uint32_t length;
   if (KEL_GetDataLength(KEL_NODE_system_bootOptionFiles_content, keys.get(), &length) != KEL_STATUS_OK) {
      std::printf("Invalid boot option file name %s\n", name);
      return 1;
   }
   if (!raw) std::printf("Boot Option File Content %s : ", name);

   const uint32_t chunk = std::min(length, kMaxChunk);
   uint64_t offset = 0;
   while (offset < length) {
      // One byte more than the chunk, for the NUL put after the text.
      KELDataPtr out(KELData_Create(chunk + 1, nullptr, 0));
      if (!out) return 1;
      if (ReadChunk(keys.get(), uint32_t(offset), chunk, out.get()) != KEL_STATUS_OK) return 1;
      // A data object's second 32-bit word is the number of bytes it holds.
      uint32_t count;
      std::memcpy(&count, reinterpret_cast<const char *>(out.get()) + 4, sizeof count);
      if (count == 0) {
         // Nothing more comes back before the end: asking again would loop for ever.
         std::fflush(stdout);
         std::fprintf(stderr, "Boot option file %s: no data at byte %llu of %u\n", name,
                      static_cast<unsigned long long>(offset), length);
         return 1;
      }
      count = std::min(count, chunk);  // never more than the buffer holds
      char *text = static_cast<char *>(KELData_GetData(out.get()));
      text[count] = '\0';
      std::replace(text, text + count, '\n', ' ');
      std::printf("%s", text);
      offset += count;
   }
   return 0;
}

// One boot-mode switch, shown as a decimal number after its label.
void PrintSwitch(const Request &req, const char *label, uint8_t value) {
   Label(req, label);
   std::printf("%d\n", value);
}

}  // namespace

int BootOptionMain(int argc, char **argv) {
   if (argc < 2) {
      std::fputs("bootOption: no option specified\n", stderr);
      return Help();
   }
   Request req;
   int c;
   while ((c = getopt_long(argc, argv, kShortOptions, kLongOptions, nullptr)) != -1) {
      switch (c) {
      case 'r': req.raw = true; break;
      case 'a': req.fsck = req.audit = req.rollback = true; break;
      case 'f': req.fsck = true; break;
      case 'i': req.audit = true; break;
      case 'R': req.rollback = true; break;
      case 'p': req.pxe = true; break;
      case 'k': req.kernel = true; break;
      case 'm': req.modules = true; break;
      case 'o': req.options = true; break;
      case 'b': req.files = true; break;
      case 'c': req.contentName = optarg; break;
      case 'C': req.allContents = true; break;
      default: return Help();  // -h, -u, -w and unrecognised options
      }
   }

   if (req.fsck || req.audit || req.rollback) {
      uint8_t rec[bootoption::kSize];
      if (KEL_Get(KEL_NODE_system_bootOption, nullptr, rec, sizeof rec) != KEL_STATUS_OK) return 1;
      if (req.fsck) PrintSwitch(req, "FS Check : ", ReadU8(rec, bootoption::kFsck));
      if (req.audit) PrintSwitch(req, "Audit Mode : ", ReadU8(rec, bootoption::kAudit));
      if (req.rollback) PrintSwitch(req, "Booted after rollback : ", ReadU8(rec, bootoption::kRollback));
   }

   // The command line "<kernel> <options>", split at its first space.
   uint8_t cmdLine[bootcmdline::kSize];
   std::string_view kernel, options;
   if (req.pxe || req.kernel || req.options) {
      if (KEL_Get(KEL_NODE_system_bootCmdLine, nullptr, cmdLine, sizeof cmdLine) != KEL_STATUS_OK) return 1;
      if (req.pxe) {
         uint8_t mac[bootmac::kSize];
         if (KEL_Get(KEL_NODE_system_bootMAC, nullptr, mac, sizeof mac) != KEL_STATUS_OK) return 1;
         PrintSwitch(req, "Booted via (g)PXE : ", ReadU8(mac, bootmac::kPxe) != 0 ? 1 : 0);
      }
      kernel = ReadText(cmdLine, 0, sizeof cmdLine);
      size_t space = kernel.find(' ');
      if (space != std::string_view::npos) {
         options = kernel.substr(space + 1);
         kernel = kernel.substr(0, space);
      }
   }
   if (req.kernel) {
      Label(req, "Kernel : ");
      std::printf("%.*s\n", int(kernel.size()), kernel.data());
   }

   if (req.allContents) {
      ParamListPtr files;
      if (ListBootOptionFiles(&files) != KEL_STATUS_OK) return 1;
      for (uint32_t i = 0, n = KEL_ParamListUsedCount(files.get()); i < n; i++) {
         const char *name;
         if (KEL_ParamListGetString(files.get(), i, &name) != KEL_STATUS_OK) return 1;
         if (PrintContent(name, req.raw) != 0) return 1;
         std::fputs(req.raw ? " " : "\n", stdout);
      }
   }

   if (req.options) {
      Label(req, "Options : ");
      std::printf("%.*s\n", int(options.size()), options.data());
   }

   if (req.modules) {
      Label(req, "Modules : ");
      // A tardisk whose name or stats cannot be read fails the item.
      ParamListPtr keys(KEL_ParamListCreate(1, 1));
      if (!keys) return 1;
      WalkResult walk = ForEachInstance(KEL_NODE_system_corafs_tardisks, keys.get(), [&](const KEL_Param *key) {
         const char *name = KEL_ParamGetString(key);
         uint8_t stats[tardiskstats::kSize];
         if (name == nullptr ||
             KEL_Get(KEL_NODE_system_corafs_tardisks_stats, keys.get(), stats, sizeof stats) != KEL_STATUS_OK)
            return false;
         if (ReadU8(stats, tardiskstats::kBootModule) != 0) std::printf("%s ", name);
         return true;
      });
      if (walk.end != WalkEnd::Done) return 1;
      std::fputs("\n", stdout);
   }

   if (req.files) {
      ParamListPtr files;
      if (ListBootOptionFiles(&files) != KEL_STATUS_OK) return 1;
      Label(req, "Boot Option Files : ");
      for (uint32_t i = 0, n = KEL_ParamListUsedCount(files.get()); i < n; i++) {
         const char *name;
         if (KEL_ParamListGetString(files.get(), i, &name) != KEL_STATUS_OK) return 1;
         std::printf("%s ", name);
      }
      std::fputs("\n", stdout);
   }

   if (req.contentName != nullptr) {
      if (PrintContent(req.contentName, req.raw) != 0) return 1;
      std::fputs("\n", stdout);
   }
   return 0;
}
