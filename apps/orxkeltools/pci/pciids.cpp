// The PCI ID database.
//
// The ID files are the ".ids" files of five override folders, in a fixed
// order, then pci.ids, read as one stream of lines.  The tables are those
// two readings of that stream would make: one that counts the device rows
// (up to the "ffff" line that ends the vendor section) and the class rows
// (after it), and one that fills the tables and reports the first
// malformed line of each section.  Here the stream is read once, and each
// line is handed to every reading it belongs to:
// - the counts and the filling of the device table run side by side up to
//   the "ffff" line;
// - the filling of the class table starts on the line after the one that
//   ended the device filling, which is the "ffff" line unless a malformed
//   line ended it sooner;
// - the reports of the filling are kept back and printed after the count
//   warnings, in the order two readings would print them.
// Rows made from the override folders come first, and the lookups let them
// win over pci.ids.
//
// Memory is laid out for a run that reads a 1.4 MB pci.ids and then names a
// few hundred functions, on machines where the first touch of a page costs
// microseconds:
// - Each file is mapped with its pages and read in place; rows refer to
//   their names by offset into the files taken end to end, so a name is
//   copied nowhere.
// - Device rows are 20 bytes, in one mapping whose pages are all mapped by
//   one call, at a size guessed from the bytes of the files.
// - Device lookups go through an index from (vendor, device) to that pair's
//   rows in table order, built at the first lookup; it answers exactly as a
//   scan of the whole table would.
// - The process ends without unmapping any of it.
#include "pci/pciids.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>

#include "keltools.h"

extern "C" const char not_avail_prefix[] = "Name not available for ";

namespace {

constexpr size_t kNotAvailLen = sizeof not_avail_prefix - 1;

// The override folders, in reading order, before pci.ids.
constexpr const char *kOverrideDirs[] = {
   "oem.pciids.d", "ihv.pciids.d", "default.pciids.d", "driver.pciids.d", "fallback.pciids.d",
};

// Lines are handed out in pieces of at most 255 bytes, as fgets with a
// 256-byte buffer would: a longer line arrives as several lines.
constexpr size_t kLinePiece = 255;
constexpr size_t kReadChunk = 65536;
constexpr size_t kMaxFileName = 255;
constexpr size_t kMaxPathBuf = 4097;
constexpr size_t kVendorNameCap = 64;
constexpr size_t kDeviceNameCap = 128;
constexpr size_t kClassNameCap = 64;
// Room for a report: a path of at most 255 characters and a short text.
constexpr size_t kReportSize = 512;
// Bytes of ID files per device row, a little under what pci.ids has, so
// that the device table taken at the start nearly always holds every row.
constexpr size_t kBytesPerRowGuess = 36;

// PciText flags.
constexpr uint8_t kMadeUp = 1;     // in the store of synthesized names, not in a file
constexpr uint8_t kNotAvail = 2;   // begins with not_avail_prefix

// The value of each hexadecimal digit; kNotHex for every other byte.
constexpr uint8_t kNotHex = 0xff;
constexpr std::array<uint8_t, 256> kHexValue = [] {
   std::array<uint8_t, 256> table{};
   for (int c = 0; c < 256; c++) {
      if (c >= '0' && c <= '9')
         table[c] = uint8_t(c - '0');
      else if (c >= 'a' && c <= 'f')
         table[c] = uint8_t(c - 'a' + 10);
      else if (c >= 'A' && c <= 'F')
         table[c] = uint8_t(c - 'A' + 10);
      else
         table[c] = kNotHex;
   }
   return table;
}();

uint8_t HexDigit(char c) { return kHexValue[static_cast<unsigned char>(c)]; }
bool IsHexDigit(char c) { return HexDigit(c) != kNotHex; }
bool IsBlank(char c) { return c == ' ' || c == '\t'; }
char At(std::string_view s, size_t i) { return i < s.size() ? s[i] : '\0'; }

// Memory mapped by MapZeroed or from a file; its owner unmaps it.
struct Unmapper {
   size_t bytes = 0;
   void operator()(const void *p) const { munmap(const_cast<void *>(p), bytes); }
};
template <class T>
using MappedArray = std::unique_ptr<T[], Unmapper>;

// count zero-filled elements whose pages are all mapped by one call.
// Taking them one page fault at a time costs about twice as much on the
// machines measured.  A count of 0 gives an empty owner and counts as
// success.
template <class T>
bool MapZeroed(size_t count, MappedArray<T> *array) {
   array->reset();
   if (count == 0) return true;
   if (count > SIZE_MAX / sizeof(T)) return false;
   size_t bytes = count * sizeof(T);
   void *p = mmap(nullptr, bytes, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS | MAP_POPULATE, -1, 0);
   if (p == MAP_FAILED) return false;
   *array = MappedArray<T>(static_cast<T *>(p), Unmapper{bytes});
   return true;
}

// A table that grows a row at a time while the ID files are read: its size
// is known only at their end.  It is one mapping, sized before the reading
// from the bytes to be read and mapped with its pages in one call.  Should
// the rows outgrow it, the mapping moves to a larger one (its pages move
// with it, nothing is copied) whose new pages are taken as they are
// written.
template <class T>
class RowTable {
public:
   RowTable() = default;
   RowTable(const RowTable &) = delete;
   RowTable &operator=(const RowTable &) = delete;
   RowTable &operator=(RowTable &&other) noexcept {
      if (this != &other) {
         Release();
         rows_ = other.rows_;
         capacity_ = other.capacity_;
         count_ = other.count_;
         other.rows_ = nullptr;
         other.capacity_ = 0;
         other.count_ = 0;
      }
      return *this;
   }
   ~RowTable() { Release(); }

   // Room for count rows, zero-filled; false when there is no memory.
   bool Reserve(size_t count) {
      if (count <= capacity_) return true;
      if (count > SIZE_MAX / sizeof(T)) return false;
      void *p = rows_ == nullptr ? mmap(nullptr, count * sizeof(T), PROT_READ | PROT_WRITE,
                                        MAP_PRIVATE | MAP_ANONYMOUS | MAP_POPULATE, -1, 0)
                                 : mremap(rows_, capacity_ * sizeof(T), count * sizeof(T), MREMAP_MAYMOVE);
      if (p == MAP_FAILED) return false;
      rows_ = static_cast<T *>(p);
      capacity_ = count;
      return true;
   }

   // False (and nothing added) when there is no memory for it.
   bool Append(const T &row) {
      if (size_t(count_) == capacity_ && (count_ == INT32_MAX || !Reserve(capacity_ + capacity_ / 2 + 1024)))
         return false;
      rows_[count_++] = row;
      return true;
   }

   const T &operator[](int index) const { return rows_[index]; }

private:
   void Release() {
      if (rows_ != nullptr) munmap(rows_, capacity_ * sizeof(T));
      rows_ = nullptr;
      capacity_ = 0;
      count_ = 0;
   }

   T *rows_ = nullptr;
   size_t capacity_ = 0;
   int count_ = 0;
};

// The bytes of one ID file for the tables' lifetime: mapped from the file,
// or, for a file that cannot be mapped, read into memory.  Offsets of names
// run over all files end to end; base is where this one starts.
struct Source {
   const char *bytes;
   size_t size;
   uint32_t base;
   bool mapped;
};

// The sources of one load.  It owns their bytes: a mapping is unmapped and
// memory read from a file freed when the table is cleared or replaced.
class SourceTable {
public:
   SourceTable() = default;
   SourceTable(const SourceTable &) = delete;
   SourceTable &operator=(const SourceTable &) = delete;
   SourceTable &operator=(SourceTable &&other) noexcept {
      if (this != &other) {
         Release();
         rows_ = std::move(other.rows_);
         capacity_ = other.capacity_;
         count_ = other.count_;
         end_ = other.end_;
         other.capacity_ = 0;
         other.count_ = 0;
         other.end_ = 0;
      }
      return *this;
   }
   ~SourceTable() { Release(); }

   // Takes over a file's bytes as the next source; false (and the bytes
   // left to the caller) when the offsets would pass 4 GiB or there is no
   // memory.
   bool Add(const char *bytes, size_t size, bool mapped, int *index) {
      if (size > UINT32_MAX - end_) return false;
      if (!GrowArray(&rows_, &capacity_, size_t(count_) + 1)) return false;
      rows_[count_] = Source{bytes, size, end_, mapped};
      end_ += uint32_t(size);
      *index = count_++;
      return true;
   }

   int Count() const { return count_; }
   const Source &operator[](int index) const { return rows_[index]; }

private:
   void Release() {
      for (int i = 0; i < count_; i++) {
         const Source &s = rows_[i];
         if (s.mapped)
            munmap(const_cast<char *>(s.bytes), s.size);
         else
            std::free(const_cast<char *>(s.bytes));
      }
      count_ = 0;
   }

   MallocPtr<Source> rows_;
   size_t capacity_ = 0;
   int count_ = 0;
   uint32_t end_ = 0;  // offset after the last source's bytes
};

// The tables of the last load, each held by its owner.  Both counts are 0
// when there are none.
struct Tables {
   SourceTable sources;
   MallocPtr<char> madeUp;  // synthesized names
   size_t madeUpSize = 0;
   size_t madeUpCapacity = 0;
   RowTable<PciDevEntry> dev;
   int ndevid = 0;
   MallocPtr<PciClassEntry> cls;
   size_t clsCapacity = 0;
   int nclass = 0;
   int lastOverrideIndex = -1;
   int keyRuns = 0;  // runs of rows with one (vendor, device): at least the number of pairs
   // The device index: open addressing over the runs, each slot holding the
   // first row of a run + 1 (0 is an empty slot).
   bool indexTried = false;
   MappedArray<int32_t> slots;
   uint32_t slotCount = 0;  // a power of two
   int slotShift = 0;       // 32 - log2(slotCount): the hash keeps the top bits
};

// The tables of the last load.  A new load drops those of the one before;
// at the end of the process they are left to the kernel, which takes back a
// process's memory at once: unmapping them one piece at a time costs more
// than the whole load on the machines measured, since each call flushes the
// address translations of every processor the process ran on.
union TablesForLife {
   TablesForLife() : tables() {}
   ~TablesForLife() {}
   Tables tables;
};
TablesForLife gLife;
Tables &gIds = gLife.tables;

void DropIndex() {
   gIds.slots.reset();
   gIds.slotCount = 0;
   gIds.indexTried = false;
}

void DropTables() { gIds = Tables{}; }

// Keeps a synthesized name; false when there is no memory or its offset
// would pass 4 GiB.
bool StoreMadeUpName(std::string_view name, PciText *text) {
   if (name.size() > UINT32_MAX - gIds.madeUpSize) return false;
   if (!GrowArray(&gIds.madeUp, &gIds.madeUpCapacity, gIds.madeUpSize + name.size())) return false;
   std::memcpy(gIds.madeUp.get() + gIds.madeUpSize, name.data(), name.size());
   *text = PciText{uint32_t(gIds.madeUpSize), uint8_t(name.size()), kMadeUp | kNotAvail};
   gIds.madeUpSize += name.size();
   return true;
}

// Reads what is left of a descriptor into memory; what was read before an
// error is kept, as end of file would.
MallocPtr<char> ReadAll(int fd, size_t *size) {
   MallocPtr<char> bytes;
   size_t used = 0, capacity = 0;
   for (;;) {
      if (used == capacity && !GrowArray(&bytes, &capacity, used + kReadChunk)) break;
      ssize_t n = read(fd, bytes.get() + used, capacity - used);
      if (n < 0 && errno == EINTR) continue;
      if (n <= 0) break;
      used += size_t(n);
   }
   *size = used;
   return bytes;
}

// The bytes of an ID file as the next source: -1 for a file that cannot be
// opened or has no bytes, which gives no lines.  A regular file is mapped
// with its pages, since every byte is read; anything else (a FIFO, say) is
// read whole.  Names are later read from the mapping: package updates
// replace ID files rather than rewrite them in place, so the mapping keeps
// the bytes that were parsed.
int OpenSource(const char *path) {
   int fd = open(path, O_RDONLY | O_CLOEXEC);
   if (fd < 0) return -1;
   int index = -1;
   struct stat st;
   if (fstat(fd, &st) == 0 && S_ISREG(st.st_mode) && st.st_size > 0 && uint64_t(st.st_size) <= UINT32_MAX) {
      size_t size = size_t(st.st_size);
      void *map = mmap(nullptr, size, PROT_READ, MAP_PRIVATE | MAP_POPULATE, fd, 0);
      if (map != MAP_FAILED) {
         if (gIds.sources.Add(static_cast<const char *>(map), size, true, &index)) {
            close(fd);
            return index;
         }
         munmap(map, size);
      }
   }
   size_t size;
   MallocPtr<char> bytes = ReadAll(fd, &size);
   close(fd);
   if (size > 0 && gIds.sources.Add(bytes.get(), size, false, &index)) (void)bytes.release();
   return index;
}

// The lines of one source, in pieces of at most kLinePiece bytes, each cut
// at its first NUL as a C string would be.
class LineReader {
public:
   explicit LineReader(const Source &s)
      : at_(s.bytes), end_(s.bytes + s.size), nul_(static_cast<const char *>(std::memchr(s.bytes, '\0', s.size))) {}

   bool Next(std::string_view *line) {
      if (at_ == end_) return false;
      const char *start = at_;
      size_t n = size_t(end_ - at_) < kLinePiece ? size_t(end_ - at_) : kLinePiece;
      if (const void *newline = std::memchr(start, '\n', n)) n = size_t(static_cast<const char *>(newline) - start) + 1;
      at_ += n;
      if (nul_ != nullptr && nul_ < at_) {
         n = size_t(nul_ - start);
         nul_ = static_cast<const char *>(std::memchr(at_, '\0', size_t(end_ - at_)));
      }
      *line = std::string_view(start, n);
      return true;
   }

private:
   const char *at_;
   const char *end_;
   const char *nul_;  // the first NUL from at_ on, if any
};

// The two problems that end lspci: both are reported here, and the load
// then fails all the way up.
bool CorruptedFileName() {
   std::fputs("Found corrupted file name\n", stderr);
   return false;
}

bool NoMemoryForFileList() {
   std::fputs("Not enough memory for file list\n", stderr);
   return false;
}

// One entry of the file list: its path, and its bytes once opened.
struct IdFile {
   char *path;
   int source;  // in gIds.sources; -1 when the file gives no bytes
};

// The ID files of one load, in reading order.
class FileList {
public:
   FileList() = default;
   ~FileList() {
      for (int i = 0; i < count_; i++) std::free(files_[i].path);
   }
   FileList(const FileList &) = delete;
   FileList &operator=(const FileList &) = delete;

   // False after reporting a path that is too long or no memory.
   bool Add(const char *path) {
      size_t len = std::strlen(path);
      if (len > kMaxFileName) return CorruptedFileName();
      if (!GrowArray(&files_, &capacity_, size_t(count_) + 1)) return NoMemoryForFileList();
      char *copy = static_cast<char *>(std::malloc(len + 1));
      if (copy == nullptr) return NoMemoryForFileList();
      std::memcpy(copy, path, len + 1);
      files_[count_++] = IdFile{copy, -1};
      return true;
   }

   // Adds the files of dir whose names end in ".ids", in the order the
   // folder lists them.  A folder that cannot be opened adds nothing.  False
   // after reporting a name or path that is too long, or no memory.
   bool AddDirectory(const char *dir) {
      std::unique_ptr<DIR, int (*)(DIR *)> d(opendir(dir), closedir);
      if (d == nullptr) return true;
      while (const dirent *entry = readdir(d.get())) {
         size_t len = strnlen(entry->d_name, kMaxFileName + 1);
         if (len > kMaxFileName) return CorruptedFileName();
         if (len <= 4 || std::memcmp(entry->d_name + len - 4, ".ids", 4) != 0) continue;
         char path[kMaxPathBuf];
         int n = std::snprintf(path, sizeof path, "%s/%s", dir, entry->d_name);
         if (n < 0 || size_t(n) >= sizeof path) return CorruptedFileName();
         if (!Add(path)) return false;
      }
      return true;
   }

   // Opens every file, in order; returns the number of bytes they hold.
   size_t OpenAll() {
      size_t bytes = 0;
      for (int i = 0; i < count_; i++) {
         files_[i].source = OpenSource(files_[i].path);
         if (files_[i].source >= 0) bytes += gIds.sources[files_[i].source].size;
      }
      return bytes;
   }

   int Count() const { return count_; }
   const IdFile &operator[](int index) const { return files_[index]; }

private:
   MallocPtr<IdFile> files_;
   int count_ = 0;
   size_t capacity_ = 0;
};

// Hexadecimal digits into 32 bits; like strtoul on the 32-bit host, a value
// too large for 32 bits gives 0xffffffff.
uint32_t HexValue(std::string_view digits) {
   uint64_t value = 0;
   for (char c : digits) {
      value = value * 16 + HexDigit(c);
      if (value > UINT32_MAX) return UINT32_MAX;
   }
   return uint32_t(value);
}

// The ID a line holds even when it has no name or a broken ID field: its
// leading hexadecimal digits after the blanks, 0 when there are none.
uint32_t LeadingHexId(std::string_view text) {
   size_t i = 0;
   while (i < text.size() && IsBlank(text[i])) i++;
   size_t start = i;
   while (i < text.size() && IsHexDigit(text[i])) i++;
   return HexValue(text.substr(start, i - start));
}

// ParsePciIdLine, inlined into the loader's loop, which calls it for nearly
// every line with a constant capacity.
[[gnu::always_inline]] inline bool SplitIdLine(std::string_view text, size_t nameCapacity, PciIdField *field) {
   const char *p = text.data();
   const char *end = p + text.size();
   while (p < end && IsBlank(*p)) p++;
   // The ID is the hexadecimal digits up to a blank.  Text that ends first
   // or any other byte in the ID fails; a newline does not end an ID, so a
   // line with an ID alone fails here.
   const char *start = p;
   uint64_t value = 0;
   // Nearly every ID starts with four digits: take them at once.
   if (end - p > 4 && (HexDigit(p[0]) | HexDigit(p[1]) | HexDigit(p[2]) | HexDigit(p[3])) < 16) {
      value = unsigned(HexDigit(p[0])) << 12 | unsigned(HexDigit(p[1])) << 8 | unsigned(HexDigit(p[2])) << 4 |
              HexDigit(p[3]);
      p += 4;
   }
   for (; p < end && IsHexDigit(*p); p++)
      if (value <= UINT32_MAX) value = value * 16 + HexDigit(*p);
   if (p == start || p == end || !IsBlank(*p)) return false;
   field->id = value > UINT32_MAX ? UINT32_MAX : uint32_t(value);
   field->idEnd = size_t(p - text.data());
   if (nameCapacity == 0) return true;
   p++;
   while (p < end && IsBlank(*p)) p++;
   if (p == end || *p == '\n') return false;
   size_t len = size_t(end - p);
   if (end[-1] == '\n') len--;
   field->name = std::string_view(p, len < nameCapacity - 1 ? len : nameCapacity - 1);
   return true;
}

// Four hexadecimal digits at p: their value, or -1.
[[gnu::always_inline]] inline int Hex4(const char *p) {
   unsigned a = HexDigit(p[0]), b = HexDigit(p[1]), c = HexDigit(p[2]), d = HexDigit(p[3]);
   return (a | b | c | d) < 16 ? int(a << 12 | b << 8 | c << 4 | d) : -1;
}

// The name of a line that follows blanks from offset at on, without the
// line's newline and cut to capacity - 1 characters; false when there is
// none.
[[gnu::always_inline]] inline bool NameFrom(std::string_view line, size_t at, size_t capacity, std::string_view *name) {
   size_t end = line.size();
   while (at < end && IsBlank(line[at])) at++;
   if (at == end || line[at] == '\n') return false;
   if (line[end - 1] == '\n') end--;
   *name = line.substr(at, end - at < capacity - 1 ? end - at : capacity - 1);
   return true;
}

// Comment and blank lines, skipped by every counting and device pass.
bool IsSkipped(std::string_view line) {
   char c = At(line, 0);
   return c == '#' || c == ' ' || c == '\n';
}

bool EndsVendorSection(std::string_view line) { return line.size() >= 4 && std::memcmp(line.data(), "ffff", 4) == 0; }

int LeadingTabs(std::string_view line) {
   int tabs = 0;
   while (tabs < 3 && At(line, size_t(tabs)) == '\t') tabs++;
   return tabs;
}

uint32_t DeviceKey(uint16_t vendor, uint16_t device) { return uint32_t(vendor) << 16 | device; }
uint32_t DeviceKey(const PciDevEntry &row) { return DeviceKey(row.vendor, row.device); }

// Formats a report of the filling, to be printed once the counts are known.
[[gnu::format(printf, 2, 3)]] void Keep(char (&report)[kReportSize], const char *format, ...) {
   va_list args;
   va_start(args, format);
   std::vsnprintf(report, sizeof report, format, args);
   va_end(args);
}

// One reading of the ID files that does the work of the counting and the
// filling passes together.  Lines come in through Line(), file by file;
// Finish() ends the input and Commit() reports and keeps the tables.
class Loader {
public:
   // The file whose lines come next: its path, whether it is the last of
   // the list (pci.ids is told from the override files by position alone),
   // and its bytes.
   void StartFile(const char *path, bool last, const Source &source) {
      path_ = path;
      last_ = last;
      source_ = &source;
      lineNumber_ = 0;
   }

   void Line(std::string_view line) {
      lineNumber_++;
      if (inVendorSection_) {
         if (IsSkipped(line)) {
            if (deviceFill_) return;
         } else if (EndsVendorSection(line)) {
            inVendorSection_ = false;
            if (deviceFill_) {
               EndDeviceFill(true);
               return;
            }
         } else {
            int tabs = LeadingTabs(line);
            if ((last_ && IsHexDigit(At(line, 0))) || tabs == 1 || tabs == 2) ndevid_++;
            if (deviceFill_) {
               if (!DeviceLine(line, tabs)) EndDeviceFill(!noMemory_);
               return;
            }
         }
      } else if (!IsSkipped(line) && (At(line, 0) == '\t' || At(line, 0) == 'C')) {
         nclass_++;
      }
      // The device filling has ended: the line belongs to the class filling.
      // Once rows the device filling did not make are counted, the build
      // fails there and the class filling would never run.
      if (classFill_ && devMade_ < ndevid_) classFill_ = false;
      if (classFill_ && !ClassLine(line)) classFill_ = false;
   }

   void Finish() {
      if (deviceFill_) EndDeviceFill(true);
      if (classFill_) CloseBlock();
   }

   // Prints what the two readings would print, in their order, and keeps
   // the tables or drops them.  False for a failed build.
   bool Commit(const char *idsPath) {
      if (ndevid_ == 0) std::fputs("no device entries in the pci ids files\nPerhaps, corrupted file?\n", stderr);
      if (nclass_ == 0) std::fprintf(stderr, "no class entries in %s\nPerhaps, corrupted file?\n", idsPath);
      if (noDevMemory_)
         std::fprintf(stderr, "couldn't allocate PciDevTable (%zu bytes)\n", size_t(ndevid_) * sizeof(PciDevEntry));
      if (noClassMemory_)
         std::fprintf(stderr, "couldn't allocate PciClassCodeTable (%zu bytes)\n",
                      size_t(nclass_) * sizeof(PciClassEntry));
      if (noMemory_) return false;
      std::fputs(deviceReport_, stderr);
      if (devMade_ != ndevid_) {
         std::fprintf(stderr, "parsing problem: devices %u ndevid %u\n", unsigned(devMade_), unsigned(ndevid_));
         return false;
      }
      std::fputs(classReport_, stderr);
      if (classMade_ != nclass_) {
         std::fprintf(stderr, "internal error: classes %u nclass %u\n", unsigned(classMade_), unsigned(nclass_));
         return false;
      }
      gIds.ndevid = ndevid_;
      gIds.nclass = nclass_;
      return true;
   }

private:
   enum class Block { None, Class, Subclass, ProgIf };

   // The device filling ends at the "ffff" line, at a malformed line or
   // with the input; the class filling starts on the next line unless
   // memory ran out.
   void EndDeviceFill(bool startClassFill) {
      deviceFill_ = false;
      classFill_ = startClassFill;
   }

   // Where a name read from the current line stands in the files taken end
   // to end.
   PciText TextOf(std::string_view name) const {
      uint32_t at = source_->base + uint32_t(name.data() - source_->bytes);
      bool notAvail = name.size() >= kNotAvailLen && name[0] == not_avail_prefix[0] &&
                      std::memcmp(name.data(), not_avail_prefix, kNotAvailLen) == 0;
      return PciText{at, uint8_t(name.size()), notAvail ? kNotAvail : uint8_t(0)};
   }

   bool AddDevRow(const PciDevEntry &row) {
      if (!gIds.dev.Append(row)) {
         noDevMemory_ = noMemory_ = true;
         return false;
      }
      if (devMade_ == 0 || DeviceKey(row) != lastKey_) gIds.keyRuns++;
      lastKey_ = DeviceKey(row);
      if (!last_) gIds.lastOverrideIndex = devMade_;
      devMade_++;
      return true;
   }

   // Lines in the usual shape, four digits and a blank for each ID and then
   // a name, are split here at fixed places, as the general parse would
   // split them; false leaves the line to the general parse.
   bool UsualDeviceLine(std::string_view line, int tabs, bool *more) {
      constexpr uint16_t kNone = 0xffff;
      std::string_view name;
      if (tabs == 0) {
         int vendor = line.size() > 5 && IsBlank(line[4]) ? Hex4(line.data()) : -1;
         if (vendor < 0 || !NameFrom(line, 5, kVendorNameCap, &name)) return false;
         vendorId_ = uint16_t(vendor);
         vendorName_ = TextOf(name);
         *more = !last_ || AddDevRow(PciDevEntry{vendorId_, kNone, kNone, kNone, vendorName_, PciText{0, 0, 0}});
         return true;
      }
      if (tabs == 1) {
         int device = line.size() > 6 && IsBlank(line[5]) ? Hex4(line.data() + 1) : -1;
         if (device < 0 || !NameFrom(line, 6, kDeviceNameCap, &name)) return false;
         deviceId_ = uint16_t(device);
         *more = AddDevRow(PciDevEntry{vendorId_, deviceId_, 0, 0, vendorName_, TextOf(name)});
         return true;
      }
      if (tabs == 2 && vendorName_.len != 0 && line.size() > 12 && IsBlank(line[6]) && IsBlank(line[11])) {
         int subvendor = Hex4(line.data() + 2), subdevice = Hex4(line.data() + 7);
         if (subvendor < 0 || subdevice < 0 || !NameFrom(line, 12, kDeviceNameCap, &name)) return false;
         *more = AddDevRow(PciDevEntry{vendorId_, deviceId_, uint16_t(subvendor), uint16_t(subdevice), vendorName_,
                                       TextOf(name)});
         return true;
      }
      return false;
   }

   void ImproperlyFormatted(char (&report)[kReportSize], int which) {
      Keep(report, "%s: line %d improperly formatted(%d)\n", path_, lineNumber_, which);
   }

   // One line of the vendor section, with its leading tabs counted; false
   // when it ends the device filling.  The current vendor and device carry
   // over from one file to the next, so an override file may begin with
   // device lines for the vendor named last.
   bool DeviceLine(std::string_view line, int tabs) {
      constexpr uint16_t kNone = 0xffff;
      const PciText empty{0, 0, 0};
      bool more;
      if (UsualDeviceLine(line, tabs, &more)) return more;
      PciIdField field;
      if (tabs == 0) {
         vendorName_ = empty;
         if (!SplitIdLine(line, kVendorNameCap, &field)) {
            ImproperlyFormatted(deviceReport_, 1);
            return false;
         }
         vendorId_ = uint16_t(field.id);
         vendorName_ = TextOf(field.name);
         // In pci.ids a vendor line makes a row too; in an override file it
         // only names the vendor for the lines after it.
         return !last_ || AddDevRow(PciDevEntry{vendorId_, kNone, kNone, kNone, vendorName_, empty});
      }
      if (tabs == 1) {
         // The row keeps the ID written on the line even when the name is
         // missing.
         std::string_view text = line.substr(1);
         PciText name;
         if (SplitIdLine(text, kDeviceNameCap, &field)) {
            deviceId_ = uint16_t(field.id);
            name = TextOf(field.name);
         } else if (vendorName_.len == 0) {
            Keep(deviceReport_, "%s: can't synthesize device name for line %d\n", path_, lineNumber_);
            return false;
         } else {
            // A device line without a name is named after its vendor.
            deviceId_ = uint16_t(LeadingHexId(text));
            char synthesized[kDeviceNameCap];
            std::string_view vendor = PciName(vendorName_);
            std::snprintf(synthesized, sizeof synthesized, "%s%.*s device", not_avail_prefix,
                          int(vendor.size()), vendor.data());
            if (!StoreMadeUpName(synthesized, &name)) {
               noMemory_ = true;
               return false;
            }
         }
         return AddDevRow(PciDevEntry{vendorId_, deviceId_, 0, 0, vendorName_, name});
      }
      if (tabs == 2) {
         if (!SplitIdLine(line.substr(2), 0, &field)) {
            ImproperlyFormatted(deviceReport_, 3);
            return false;
         }
         uint16_t subvendor = uint16_t(field.id);
         // The subsystem device ID is read from the eighth byte on, where it
         // stands after two tabs, four digits and a blank.  The blank after
         // the subsystem vendor ID counts as the end of the line, as it does
         // once a parse has put a NUL there.
         size_t separator = 2 + field.idEnd;
         std::string_view rest = line.size() > 7 ? line.substr(7) : std::string_view();
         if (separator >= 7) rest = rest.substr(0, separator - 7);
         if (!SplitIdLine(rest, kDeviceNameCap, &field)) {
            ImproperlyFormatted(deviceReport_, 4);
            return false;
         }
         if (vendorName_.len == 0) {
            Keep(deviceReport_, "no vendor information for subvendor 0%04x: subsystem 0%04x", subvendor,
                 unsigned(uint16_t(field.id)));
            return false;
         }
         return AddDevRow(PciDevEntry{vendorId_, deviceId_, subvendor, uint16_t(field.id), vendorName_,
                                      TextOf(field.name)});
      }
      return true;  // three tabs: nothing in the vendor section uses them
   }

   void AddClassRow(const PciClassEntry &row) {
      if (!noClassMemory_ && GrowArray(&gIds.cls, &gIds.clsCapacity, size_t(classMade_) + 1))
         gIds.cls[classMade_] = row;
      else
         noClassMemory_ = noMemory_ = true;
      classMade_++;
   }

   void AddSubclassRow() {
      AddClassRow(PciClassEntry{classId_, subclassId_, 0xff, className_, subclassName_, PciText{0, 0, 0}});
   }

   // Adds the rows the open block still owes.
   void CloseBlock() {
      if (block_ == Block::Subclass || block_ == Block::ProgIf) AddSubclassRow();
      if (block_ != Block::None)
         AddClassRow(PciClassEntry{classId_, 0xff, 0xff, className_, PciText{0, 0, 0}, PciText{0, 0, 0}});
   }

   // One line for the class table; false when a malformed line ends the
   // filling.  Within a class block the rows come as each prog-if row, then
   // its subclass's own row, and after all subclasses the class-level row:
   // the class lookup relies on that order.
   bool ClassLine(std::string_view line) {
      PciIdField field;
      int tabs = LeadingTabs(line);
      if (At(line, 0) == 'C') {
         CloseBlock();
         if (!SplitIdLine(line.substr(1), kClassNameCap, &field)) {
            ImproperlyFormatted(classReport_, 5);
            return false;
         }
         classId_ = uint8_t(field.id);
         className_ = TextOf(field.name);
         block_ = Block::Class;
      } else if (tabs >= 2) {
         if (!SplitIdLine(line.substr(2), kClassNameCap, &field)) {
            ImproperlyFormatted(classReport_, 7);
            return false;
         }
         AddClassRow(PciClassEntry{classId_, subclassId_, uint8_t(field.id), className_, subclassName_,
                                   TextOf(field.name)});
         block_ = Block::ProgIf;
      } else if (tabs == 1) {
         if (block_ == Block::Subclass || block_ == Block::ProgIf) AddSubclassRow();
         if (!SplitIdLine(line.substr(1), kClassNameCap, &field)) {
            ImproperlyFormatted(classReport_, 6);
            return false;
         }
         subclassId_ = uint8_t(field.id);
         subclassName_ = TextOf(field.name);
         block_ = Block::Subclass;
      } else {
         // Any other line, comments included, closes nothing: the rows the
         // open block still owes are lost, and the count check notices.
         block_ = Block::None;
      }
      return true;
   }

   // The current file and line.
   const char *path_ = nullptr;
   bool last_ = false;
   const Source *source_ = nullptr;
   int lineNumber_ = 0;

   // The counts.
   bool inVendorSection_ = true;  // before the "ffff" line
   int ndevid_ = 0;
   int nclass_ = 0;

   // The device filling.
   bool deviceFill_ = true;
   int devMade_ = 0;
   uint32_t lastKey_ = 0;
   uint16_t vendorId_ = 0;
   PciText vendorName_{0, 0, 0};
   uint16_t deviceId_ = 0;
   char deviceReport_[kReportSize] = "";

   // The class filling.
   bool classFill_ = false;  // a malformed line ends it with its block left open
   int classMade_ = 0;
   Block block_ = Block::None;
   uint8_t classId_ = 0;
   uint8_t subclassId_ = 0;
   PciText className_{0, 0, 0};
   PciText subclassName_{0, 0, 0};
   char classReport_[kReportSize] = "";

   // Memory that could not be had: for the device table, the class table,
   // or any of them (a synthesized name included).
   bool noDevMemory_ = false;
   bool noClassMemory_ = false;
   bool noMemory_ = false;
};

void FailBuild() {
   DropTables();
   std::fputs("Failed to build PCI tables\n", stderr);
}

// Chooses among the rows of one (vendor, device), offered in table order:
// a row from an override file beats one from pci.ids, the first of equal
// standing wins, and a synthesized name gives way to a real one.
struct DeviceChoice {
   uint16_t subvendor;
   uint16_t subdevice;
   const PciDevEntry *candidate = nullptr;
   bool candidateOverride = false;

   static bool NotAvail(const PciDevEntry &row) { return row.name.flags & kNotAvail; }

   // True when the answer is final; it is then the candidate.
   bool Offer(int index) {
      const PciDevEntry &row = gIds.dev[index];
      bool isOverride = index <= gIds.lastOverrideIndex;
      if (row.subvendor == 0) {
         if (candidate == nullptr || (NotAvail(*candidate) && !NotAvail(row))) {
            candidate = &row;
            candidateOverride = isOverride;
         }
         return false;
      }
      if (row.subvendor != subvendor || row.subdevice != subdevice) return false;
      if (isOverride || candidate == nullptr || !candidateOverride || NotAvail(*candidate)) candidate = &row;
      return true;
   }
};

uint32_t HomeSlot(uint32_t key) { return (key * 0x9E3779B1u) >> gIds.slotShift; }

// Builds the index once, with at most two thirds of its slots used: one
// entry per run of rows with the same (vendor, device).  With linear probing
// and no removals, the runs of one pair are met along the probe sequence in
// the order they were entered, which is table order.  Without memory for
// the index the lookups scan instead.
void BuildDeviceIndex() {
   gIds.indexTried = true;
   uint32_t count = 16;
   int shift = 28;
   while (count < uint32_t(gIds.keyRuns) + uint32_t(gIds.keyRuns) / 2) {
      count *= 2;
      shift--;
   }
   if (!MapZeroed(count, &gIds.slots)) {
      DropIndex();
      gIds.indexTried = true;
      return;
   }
   gIds.slotCount = count;
   gIds.slotShift = shift;
   uint32_t lastKey = 0;
   uint32_t mask = count - 1;
   for (int i = 0; i < gIds.ndevid; i++) {
      uint32_t key = DeviceKey(gIds.dev[i]);
      if (i > 0 && key == lastKey) continue;
      lastKey = key;
      uint32_t slot = HomeSlot(key);
      while (gIds.slots[slot] != 0) slot = (slot + 1) & mask;
      gIds.slots[slot] = i + 1;
   }
}

}  // namespace

std::string_view PciName(PciText text) {
   if (text.len == 0) return {};
   if (text.flags & kMadeUp) return std::string_view(gIds.madeUp.get() + text.at, text.len);
   for (int i = gIds.sources.Count() - 1; i >= 0; i--) {
      const Source &s = gIds.sources[i];
      if (text.at >= s.base) return std::string_view(s.bytes + (text.at - s.base), text.len);
   }
   return {};
}

bool ParsePciIdLine(std::string_view text, size_t nameCapacity, PciIdField *field) {
   return SplitIdLine(text, nameCapacity, field);
}

bool LoadPciIdTables() { return LoadPciIdTablesFrom(kPciIdsRoot); }

bool LoadPciIdTablesFrom(const char *root) {
   DropTables();
   FileList files;
   for (const char *dir : kOverrideDirs) {
      char path[kMaxPathBuf];
      std::snprintf(path, sizeof path, "%s/%s", root, dir);
      if (!files.AddDirectory(path)) return false;
   }
   char idsPath[kMaxPathBuf];
   std::snprintf(idsPath, sizeof idsPath, "%s/pci.ids", root);
   if (!files.Add(idsPath)) return false;

   // The device table is taken at the size the bytes to come suggest: a
   // row's line in pci.ids averages about 38 bytes.  A failure here is only
   // a guess gone wrong; the table then grows as rows come.
   size_t bytes = files.OpenAll();
   (void)gIds.dev.Reserve(bytes / kBytesPerRowGuess + 16);
   Loader loader;
   for (int i = 0; i < files.Count(); i++) {
      if (files[i].source < 0) continue;
      const Source &source = gIds.sources[files[i].source];
      loader.StartFile(files[i].path, i == files.Count() - 1, source);
      LineReader lines(source);
      std::string_view line;
      while (lines.Next(&line)) loader.Line(line);
   }
   loader.Finish();
   if (!loader.Commit(idsPath)) FailBuild();
   return true;
}

const PciDevEntry *LookupPciDevice(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                   uint16_t subdevice) {
   if (gIds.ndevid <= 0) return nullptr;
   if (!gIds.indexTried) BuildDeviceIndex();
   if (gIds.slots == nullptr) return LookupPciDeviceByScan(vendor, device, subvendor, subdevice);
   DeviceChoice choice{subvendor, subdevice};
   uint32_t key = DeviceKey(vendor, device);
   uint32_t mask = gIds.slotCount - 1;
   for (uint32_t slot = HomeSlot(key); gIds.slots[slot] != 0; slot = (slot + 1) & mask) {
      int row = gIds.slots[slot] - 1;
      if (DeviceKey(gIds.dev[row]) != key) continue;
      for (; row < gIds.ndevid && DeviceKey(gIds.dev[row]) == key; row++)
         if (choice.Offer(row)) return choice.candidate;
   }
   return choice.candidate;
}

const PciDevEntry *LookupPciDeviceByScan(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                         uint16_t subdevice) {
   DeviceChoice choice{subvendor, subdevice};
   for (int i = 0; i < gIds.ndevid; i++) {
      if (gIds.dev[i].vendor != vendor || gIds.dev[i].device != device) continue;
      if (choice.Offer(i)) break;
   }
   return choice.candidate;
}

const PciClassEntry *LookupPciClass(uint16_t classCode) {
   uint8_t classId = uint8_t(classCode >> 8);
   uint8_t subclassId = uint8_t(classCode);
   for (int i = 0; i < gIds.nclass; i++) {
      const PciClassEntry &row = gIds.cls[i];
      if (row.classId == classId && row.progIf == 0xff &&
          (row.subclassId == subclassId || row.subclassId == 0xff))
         return &row;
   }
   return nullptr;
}

int PciDevCount() { return gIds.ndevid; }
const PciDevEntry &PciDevRow(int index) { return gIds.dev[index]; }
int PciClassCount() { return gIds.nclass; }
const PciClassEntry &PciClassRow(int index) { return gIds.cls[index]; }
int PciLastOverrideIndex() { return gIds.lastOverrideIndex; }
