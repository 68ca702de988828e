// amldump: writes each ACPI table of the KEL tree to "<signature>.aml" in
// the current directory, never overwriting a file.
#include "pci/amldump.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <string_view>

#include "kel/hwrecords.h"
#include "keltools.h"
#include "records.h"

bool SafeSignature(std::string_view signature) {
   if (signature.empty() || signature == "." || signature == ".." || signature.front() == '-') return false;
   for (char ch : signature) {
      unsigned char c = static_cast<unsigned char>(ch);
      if (c == '/' || c < 0x20 || c > 0x7e) return false;
   }
   return true;
}

namespace {

// Never replace an existing file: the open fails instead.
constexpr int kOpenFlags = O_WRONLY | O_CREAT | O_EXCL | O_TRUNC;
constexpr mode_t kOpenMode = 0600;

// Counts the tables seen per signature.  ACPI tables are few, so a plain
// search of the signatures seen is enough.
class SignatureCounter {
public:
   // How many tables had this signature before (0 for the first), or -12
   // (the negated ENOMEM) when a new signature cannot be recorded.
   int32_t Next(std::string_view signature) {
      for (size_t i = 0; i < count_; i++)
         if (signature == seen_[i].signature) return seen_[i].count++;
      if (!GrowArray(&seen_, &capacity_, count_ + 1)) return -ENOMEM;
      Seen &added = seen_[count_++];
      signature.copy(added.signature, sizeof added.signature - 1);
      added.count = 1;
      return 0;
   }

private:
   struct Seen {
      char signature[5];  // NUL-terminated: GrowArray zeroes new rows
      int32_t count;
   };
   MallocPtr<Seen> seen_;
   size_t capacity_ = 0;
   size_t count_ = 0;
};

// Closes the table file on every path.
struct FileCloser {
   int fd = -1;
   ~FileCloser() {
      if (fd >= 0) close(fd);
   }
};

// Writes the signature for a message, other than printable bytes as \xNN.
void PrintSignature(std::string_view signature) {
   for (char ch : signature) {
      unsigned char c = static_cast<unsigned char>(ch);
      if (c >= 0x20 && c <= 0x7e && c != '\\')
         std::fputc(c, stderr);
      else
         std::fprintf(stderr, "\\x%02x", c);
   }
}

// Writes all of data to fd; false after reporting a failed write.
bool WriteAll(int fd, const uint8_t *data, size_t length) {
   while (length > 0) {
      ssize_t n = write(fd, data, length);
      if (n < 0) {
         std::perror("amldump: ");
         return false;
      }
      data += n;
      length -= size_t(n);
   }
   return true;
}

// Starts the table's file from its first buffer record: names it after the
// signature and opens it.  False after reporting a failure.
bool OpenTableFile(uint8_t *record, int32_t table, SignatureCounter *counter, FileCloser *file) {
   using namespace acpibuffer;
   record[kSignatureEnd] = 0;
   std::string_view signature = ReadText(record, kSignature, kSignatureEnd - kSignature);
   if (!SafeSignature(signature)) {
      std::fprintf(stderr, "amldump: table %d has the unsafe signature \"", table);
      PrintSignature(signature);
      std::fputs("\"; nothing written for it\n", stderr);
      return false;
   }
   int32_t seen = counter->Next(signature);
   char name[32];
   if (seen == 0)
      std::snprintf(name, sizeof name, "%.*s.aml", int(signature.size()), signature.data());
   else
      std::snprintf(name, sizeof name, "%.*s-%d.aml", int(signature.size()), signature.data(), seen);
   std::printf("Writing file %s\n", name);
   file->fd = open(name, kOpenFlags, kOpenMode);
   if (file->fd < 0) {
      std::perror("amldump: ");
      return false;
   }
   return true;
}

// Writes one table, its buffers 0..count-1 in order, to a file of its own.
// The table key is on the key list.  False on any failure.
bool DumpTable(KEL_ParamList *keys, int32_t table, uint32_t count, uint8_t *record,
               SignatureCounter *counter) {
   using namespace acpibuffer;
   FileCloser file;
   for (uint32_t j = 0; j < count; j++) {
      ScopedKey bufferKey(keys, uint64_t(j));
      if (!bufferKey.ok()) return false;
      if (KEL_Get(KEL_NODE_hardware_acpi_tables_buffers, keys, record, kSize) != KEL_STATUS_OK) return false;

      uint32_t length = ReadU32(record, kLength);
      if (length > kDataMax) {
         std::fprintf(stderr, "amldump: table %d buffer %u claims %u bytes, more than the %u a buffer holds\n",
                      table, j, length, kDataMax);
         return false;
      }
      if (j == 0 && !OpenTableFile(record, table, counter, &file)) return false;
      if (!WriteAll(file.fd, record + kData, length)) return false;
   }
   return true;
}

}  // namespace

int AmldumpMain(int, char **) {
   ParamListPtr tables;
   if (GetInstanceList(KEL_NODE_hardware_acpi_tables, nullptr, &tables) != KEL_STATUS_OK) return 1;
   uint32_t numTables = KEL_ParamListUsedCount(tables.get());
   if (numTables == 0) return 0;

   ParamListPtr keys(KEL_ParamListCreate(1, 2));
   if (!keys) return 1;

   // One record buffer serves every read of the run.
   static uint8_t record[acpibuffer::kSize];
   SignatureCounter counter;
   for (uint32_t i = 0; i < numTables; i++) {
      // A key that is no 32-bit number fails here, and so does the run.
      int32_t table;
      if (KEL_ParamListGetInt32(tables.get(), i, &table) != KEL_STATUS_OK) return 1;
      // The key goes back sign-extended to 64 bits.
      ScopedKey tableKey(keys.get(), uint64_t(int64_t(table)));
      if (!tableKey.ok()) return 1;

      // Only the number of buffers counts; they are read by index 0..m-1.
      ParamListPtr buffers;
      if (GetInstanceList(KEL_NODE_hardware_acpi_tables_buffers, keys.get(), &buffers) != KEL_STATUS_OK)
         return 1;
      uint32_t numBuffers = KEL_ParamListUsedCount(buffers.get());
      buffers.reset();

      if (numBuffers > 0 && !DumpTable(keys.get(), table, numBuffers, record, &counter)) return 1;
   }
   return 0;
}
