// The PCI ID database.
//
// The ID files are the ".ids" files of five override folders, in a fixed
// order, then pci.ids, read as one stream of lines.  The stream is read
// twice: first to count the device rows (up to the "ffff" line that ends
// the vendor section) and the class rows (after it), then to fill the two
// tables, each allocated once at its exact size.  Rows made from the
// override folders come first, and the lookups let them win over pci.ids.
//
// Memory is laid out for a run that reads a 1.4 MB pci.ids and then names a
// few hundred functions, on machines where the first touch of a page costs
// microseconds:
// - Both readings go through one small buffer.  Each file is also mapped,
//   and rows refer to their names by offset into the files taken end to
//   end, so a name is copied nowhere and only the pages of names actually
//   printed are ever touched.
// - Rows are 24 bytes, in memory whose pages are mapped by one call.
// - Device lookups go through an index from (vendor, device) to that pair's
//   rows in table order, built at the first lookup; it answers exactly as a
//   scan of the whole table would.
#include "pci/pciids.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
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

// PciText flags.
constexpr uint8_t kMadeUp = 1;     // in the store of synthesized names, not in a file
constexpr uint8_t kNotAvail = 2;   // begins with not_avail_prefix

// Memory mapped by MapZeroed or from a file; its owner unmaps it.
struct Unmapper {
   size_t bytes = 0;
   void operator()(const void *p) const { munmap(const_cast<void *>(p), bytes); }
};
template <class T>
using MappedArray = std::unique_ptr<T[], Unmapper>;

// count zero-filled elements whose pages are all mapped by one call.
// Taking them one page fault at a time costs several times as much on the
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
   MappedArray<PciDevEntry> dev;
   int ndevid = 0;
   MappedArray<PciClassEntry> cls;
   int nclass = 0;
   int lastOverrideIndex = -1;
   int keyRuns = 0;  // runs of rows with one (vendor, device): at least the number of pairs
   // The device index: open addressing over (vendor, device), each slot
   // holding the first row of its pair, and for each row the next row of
   // the same pair in table order.  Both hold row + 1, so that 0 is none.
   bool indexTried = false;
   MappedArray<int32_t> slots;
   uint32_t slotCount = 0;  // a power of two
   int slotShift = 0;       // 32 - log2(slotCount): the hash keeps the top bits
   MappedArray<int32_t> next;
};

Tables gIds;

void DropIndex() {
   gIds.slots.reset();
   gIds.next.reset();
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

// One entry of the file list.  A file is opened when the cursor first
// reaches it and stays open until the load ends, so that the second reading
// sees the same file.  Names are later read from its mapping; package
// updates replace ID files rather than rewrite them in place, so the
// mapping keeps the bytes that were parsed.
struct IdFile {
   char *path;
   bool opened;
   int fd;      // -1 once the file is in memory, or when it cannot be opened
   int source;  // in gIds.sources; -1 when the file gives no bytes
};

// The ID files of one load in reading order, with a cursor over their lines.
class FileList {
public:
   FileList() = default;
   ~FileList() {
      for (int i = 0; i < count_; i++) {
         if (files_[i].fd >= 0) close(files_[i].fd);
         std::free(files_[i].path);
      }
   }
   FileList(const FileList &) = delete;
   FileList &operator=(const FileList &) = delete;

   // Takes the read buffer; false after reporting that there is no memory.
   bool Init() {
      buffer_ = AllocArray<char>(kReadChunk);
      return buffer_ ? true : NoMemoryForFileList();
   }

   // False after reporting a path that is too long or no memory.
   bool Add(const char *path) {
      size_t len = std::strlen(path);
      if (len > kMaxFileName) return CorruptedFileName();
      if (!GrowArray(&files_, &capacity_, size_t(count_) + 1)) return NoMemoryForFileList();
      char *copy = static_cast<char *>(std::malloc(len + 1));
      if (copy == nullptr) return NoMemoryForFileList();
      std::memcpy(copy, path, len + 1);
      files_[count_++] = IdFile{copy, false, -1, -1};
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

   // The next line (piece) across all files, cut at its first NUL as a C
   // string would be; false after the last file.  The text stays valid
   // until the next call.
   bool NextLine(std::string_view *line) {
      while (current_ < count_) {
         if (!started_ && !StartFile()) {
            NextFile();
            continue;
         }
         started_ = true;
         if (length_ - pos_ < kLinePiece) Refill();
         if (pos_ == length_) {
            NextFile();
            continue;
         }
         const char *p = data_ + pos_;
         size_t n = length_ - pos_ < kLinePiece ? length_ - pos_ : kLinePiece;
         if (const void *newline = std::memchr(p, '\n', n)) n = size_t(static_cast<const char *>(newline) - p) + 1;
         pos_ += n;
         lineNumber_++;
         if (firstNul_ != nullptr && firstNul_ < p + n) {
            size_t cut = size_t(static_cast<const char *>(std::memchr(p, '\0', n)) - p);
            firstNul_ = static_cast<const char *>(std::memchr(data_ + pos_, '\0', length_ - pos_));
            n = cut;
         }
         *line = std::string_view(p, n);
         return true;
      }
      return false;
   }

   // Where a name read from the current line stands in the files taken end
   // to end.
   PciText TextOf(std::string_view name) const {
      uint32_t at = gIds.sources[files_[current_].source].base + uint32_t(offset_ + size_t(name.data() - data_));
      bool notAvail = name.size() >= kNotAvailLen && std::memcmp(name.data(), not_avail_prefix, kNotAvailLen) == 0;
      return PciText{at, uint8_t(name.size()), notAvail ? kNotAvail : uint8_t(0)};
   }

   const char *CurrentName() const { return files_[current_].path; }
   int LineNumber() const { return lineNumber_; }
   // pci.ids is always the last file: the loader tells it from the override
   // files by position alone.
   bool NotLast() const { return current_ < count_ - 1; }

   void Rewind() {
      current_ = 0;
      started_ = false;
      lineNumber_ = 0;
   }

private:
   // Opens the current file the first time; each reading then starts at its
   // first byte.  False for a file without bytes.
   bool StartFile() {
      IdFile &f = files_[current_];
      if (!f.opened) Open(f);
      if (f.source < 0) return false;
      const Source &s = gIds.sources[f.source];
      offset_ = 0;
      pos_ = 0;
      if (f.fd < 0) {
         data_ = s.bytes;
         length_ = s.size;
         unread_ = 0;
      } else {
         // A mapped file is read through the buffer; its mapping is touched
         // only where a name is printed.
         if (lseek(f.fd, 0, SEEK_SET) != 0) return false;
         data_ = buffer_.get();
         length_ = 0;
         unread_ = s.size;
      }
      firstNul_ = static_cast<const char *>(std::memchr(data_, '\0', length_));
      return true;
   }

   void Open(IdFile &f) {
      f.opened = true;
      int fd = open(f.path, O_RDONLY | O_CLOEXEC);
      if (fd < 0) return;
      struct stat st;
      if (fstat(fd, &st) == 0 && S_ISREG(st.st_mode) && st.st_size > 0 && uint64_t(st.st_size) <= UINT32_MAX) {
         size_t size = size_t(st.st_size);
         void *map = mmap(nullptr, size, PROT_READ, MAP_PRIVATE, fd, 0);
         if (map != MAP_FAILED) {
            if (gIds.sources.Add(static_cast<const char *>(map), size, true, &f.source)) {
               f.fd = fd;
               return;
            }
            munmap(map, size);
         }
      }
      size_t size;
      MallocPtr<char> bytes = ReadAll(fd, &size);
      close(fd);
      if (size > 0 && gIds.sources.Add(bytes.get(), size, false, &f.source)) (void)bytes.release();
   }

   // Keeps at least one whole piece ahead in the buffer while the file has
   // bytes left to read.  Reads stop at the size the file was mapped with.
   void Refill() {
      if (unread_ == 0) return;
      std::memmove(buffer_.get(), buffer_.get() + pos_, length_ - pos_);
      offset_ += pos_;
      length_ -= pos_;
      pos_ = 0;
      int fd = files_[current_].fd;
      while (length_ < kLinePiece && unread_ > 0) {
         size_t want = kReadChunk - length_ < unread_ ? kReadChunk - length_ : unread_;
         ssize_t n = read(fd, buffer_.get() + length_, want);
         if (n < 0 && errno == EINTR) continue;
         if (n <= 0) {
            unread_ = 0;
            break;
         }
         length_ += size_t(n);
         unread_ -= size_t(n);
      }
      firstNul_ = static_cast<const char *>(std::memchr(buffer_.get(), '\0', length_));
   }

   void NextFile() {
      current_++;
      started_ = false;
      lineNumber_ = 0;
   }

   MallocPtr<IdFile> files_;
   int count_ = 0;
   size_t capacity_ = 0;
   MallocPtr<char> buffer_;  // kReadChunk bytes
   // The cursor: the file, its line number, and its bytes at hand: data_
   // holds length_ bytes from file offset offset_, pos_ is the next one.
   int current_ = 0;
   int lineNumber_ = 0;
   bool started_ = false;
   const char *data_ = nullptr;
   size_t length_ = 0;
   size_t pos_ = 0;
   size_t offset_ = 0;
   size_t unread_ = 0;                // bytes of the file still to read
   const char *firstNul_ = nullptr;   // first NUL at hand, if any
};

char At(std::string_view s, size_t i) { return i < s.size() ? s[i] : '\0'; }

bool IsHexDigit(char c) {
   return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
}

bool IsBlank(char c) { return c == ' ' || c == '\t'; }

unsigned HexDigitValue(char c) {
   if (c <= '9') return unsigned(c - '0');
   return unsigned((c | 0x20) - 'a' + 10);
}

// Hexadecimal digits into 32 bits; like strtoul on the 32-bit host, a value
// too large for 32 bits gives 0xffffffff.
uint32_t HexValue(std::string_view digits) {
   uint64_t value = 0;
   for (char c : digits) {
      value = value * 16 + HexDigitValue(c);
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

// Comment and blank lines, skipped by every counting and device pass.
bool IsSkipped(std::string_view line) {
   char c = At(line, 0);
   return c == '#' || c == ' ' || c == '\n';
}

bool EndsVendorSection(std::string_view line) { return line.substr(0, 4) == "ffff"; }

int LeadingTabs(std::string_view line) {
   int tabs = 0;
   while (tabs < 3 && At(line, size_t(tabs)) == '\t') tabs++;
   return tabs;
}

// Pass 1: the device rows.  In pci.ids a vendor line makes a row too; in an
// override file it only names the vendor for the lines after it.
int CountDeviceRows(FileList &files) {
   int count = 0;
   std::string_view line;
   while (files.NextLine(&line)) {
      if (IsSkipped(line)) continue;
      if (EndsVendorSection(line)) break;
      int tabs = LeadingTabs(line);
      if ((!files.NotLast() && IsHexDigit(At(line, 0))) || tabs == 1 || tabs == 2) count++;
   }
   return count;
}

// Pass 2: the class rows, from after the "ffff" line to the end of input.
int CountClassRows(FileList &files) {
   int count = 0;
   std::string_view line;
   while (files.NextLine(&line)) {
      if (IsSkipped(line)) continue;
      if (At(line, 0) == '\t' || At(line, 0) == 'C') count++;
   }
   return count;
}

uint32_t DeviceKey(uint16_t vendor, uint16_t device) { return uint32_t(vendor) << 16 | device; }

// Rows beyond the counted size are counted but never written, so the count
// check can report them.
void AddDevRow(int *made, const PciDevEntry &row) {
   if (*made < gIds.ndevid) {
      if (*made == 0 || DeviceKey(row.vendor, row.device) !=
                           DeviceKey(gIds.dev[*made - 1].vendor, gIds.dev[*made - 1].device))
         gIds.keyRuns++;
      gIds.dev[*made] = row;
   }
   (*made)++;
}

void AddClassRow(int *made, const PciClassEntry &row) {
   if (*made < gIds.nclass) gIds.cls[*made] = row;
   (*made)++;
}

void ImproperlyFormatted(const FileList &files, int which) {
   std::fprintf(stderr, "%s: line %d improperly formatted(%d)\n", files.CurrentName(),
                files.LineNumber(), which);
}

// Pass 3: fills the device table.  The current vendor and device carry over
// from one file to the next, so an override file may begin with device
// lines for the vendor named last.  False for a failed build.
bool FillDeviceTable(FileList &files) {
   constexpr uint16_t kNone = 0xffff;
   const PciText empty{0, 0, 0};
   uint16_t vendorId = 0;
   PciText vendorName = empty;
   uint16_t deviceId = 0;
   int made = 0;
   std::string_view line;
   while (files.NextLine(&line)) {
      if (IsSkipped(line)) continue;
      if (EndsVendorSection(line)) break;
      int tabs = LeadingTabs(line);
      PciIdField field;
      if (tabs == 0) {
         vendorName = empty;
         if (!ParsePciIdLine(line, kVendorNameCap, &field)) {
            ImproperlyFormatted(files, 1);
            break;
         }
         vendorId = uint16_t(field.id);
         vendorName = files.TextOf(field.name);
         if (files.NotLast()) continue;
         AddDevRow(&made, PciDevEntry{vendorId, kNone, kNone, kNone, vendorName, empty});
      } else if (tabs == 1) {
         // The row keeps the ID written on the line even when the name is
         // missing.
         std::string_view text = line.substr(1);
         deviceId = uint16_t(LeadingHexId(text));
         PciText name;
         if (ParsePciIdLine(text, kDeviceNameCap, &field)) {
            name = files.TextOf(field.name);
         } else if (vendorName.len == 0) {
            std::fprintf(stderr, "%s: can't synthesize device name for line %d\n", files.CurrentName(),
                         files.LineNumber());
            break;
         } else {
            // A device line without a name is named after its vendor.
            char synthesized[kDeviceNameCap];
            std::string_view vendor = PciName(vendorName);
            std::snprintf(synthesized, sizeof synthesized, "%s%.*s device", not_avail_prefix,
                          int(vendor.size()), vendor.data());
            if (!StoreMadeUpName(synthesized, &name)) return false;
         }
         AddDevRow(&made, PciDevEntry{vendorId, deviceId, 0, 0, vendorName, name});
      } else if (tabs == 2) {
         if (!ParsePciIdLine(line.substr(2), 0, &field)) {
            ImproperlyFormatted(files, 3);
            break;
         }
         uint16_t subvendor = uint16_t(field.id);
         // The subsystem device ID is read from the eighth byte on, where it
         // stands after two tabs, four digits and a blank.  The blank after
         // the subsystem vendor ID counts as the end of the line, as it does
         // once a parse has put a NUL there.
         size_t separator = 2 + field.idEnd;
         std::string_view rest = line.size() > 7 ? line.substr(7) : std::string_view();
         if (separator >= 7) rest = rest.substr(0, separator - 7);
         if (!ParsePciIdLine(rest, kDeviceNameCap, &field)) {
            ImproperlyFormatted(files, 4);
            break;
         }
         if (vendorName.len == 0) {
            std::fprintf(stderr, "no vendor information for subvendor 0%04x: subsystem 0%04x", subvendor,
                         unsigned(uint16_t(field.id)));
            break;
         }
         AddDevRow(&made, PciDevEntry{vendorId, deviceId, subvendor, uint16_t(field.id), vendorName,
                                      files.TextOf(field.name)});
      } else {
         continue;  // three tabs: nothing in the vendor section uses them
      }
      if (files.NotLast()) gIds.lastOverrideIndex = made - 1;
   }
   if (made != gIds.ndevid) {
      std::fprintf(stderr, "parsing problem: devices %u ndevid %u\n", unsigned(made), unsigned(gIds.ndevid));
      return false;
   }
   return true;
}

// Pass 4: fills the class table from the line after the one that ended
// pass 3.  Within a class block the rows come as each prog-if row, then its
// subclass's own row, and after all subclasses the class-level row: the
// class lookup relies on that order.  False for a failed build.
bool FillClassTable(FileList &files) {
   enum class Block { None, Class, Subclass, ProgIf };
   Block block = Block::None;
   const PciText empty{0, 0, 0};
   uint8_t classId = 0, subclassId = 0;
   PciText className = empty, subclassName = empty;
   int made = 0;

   auto addSubclassRow = [&] {
      AddClassRow(&made, PciClassEntry{classId, subclassId, 0xff, className, subclassName, empty});
   };
   auto closeBlock = [&] {
      if (block == Block::Subclass || block == Block::ProgIf) addSubclassRow();
      if (block != Block::None) AddClassRow(&made, PciClassEntry{classId, 0xff, 0xff, className, empty, empty});
   };

   bool ended = false;  // by a malformed line rather than the end of input
   std::string_view line;
   PciIdField field;
   while (!ended && files.NextLine(&line)) {
      if (At(line, 0) == 'C') {
         closeBlock();
         if (!ParsePciIdLine(line.substr(1), kClassNameCap, &field)) {
            ImproperlyFormatted(files, 5);
            ended = true;
            continue;
         }
         classId = uint8_t(field.id);
         className = files.TextOf(field.name);
         block = Block::Class;
      } else if (LeadingTabs(line) >= 2) {
         if (!ParsePciIdLine(line.substr(2), kClassNameCap, &field)) {
            ImproperlyFormatted(files, 7);
            ended = true;
            continue;
         }
         AddClassRow(&made, PciClassEntry{classId, subclassId, uint8_t(field.id), className, subclassName,
                                          files.TextOf(field.name)});
         block = Block::ProgIf;
      } else if (LeadingTabs(line) == 1) {
         if (block == Block::Subclass || block == Block::ProgIf) addSubclassRow();
         if (!ParsePciIdLine(line.substr(1), kClassNameCap, &field)) {
            ImproperlyFormatted(files, 6);
            ended = true;
            continue;
         }
         subclassId = uint8_t(field.id);
         subclassName = files.TextOf(field.name);
         block = Block::Subclass;
      } else {
         // Any other line, comments included, closes nothing: the rows the
         // open block still owes are lost, and the count check notices.
         block = Block::None;
      }
   }
   if (!ended) closeBlock();
   if (made != gIds.nclass) {
      std::fprintf(stderr, "internal error: classes %u nclass %u\n", unsigned(made), unsigned(gIds.nclass));
      return false;
   }
   return true;
}

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

// The slot of a (vendor, device) pair: its own, or the empty one where it
// would go.
uint32_t ProbeSlot(uint32_t key) {
   uint32_t mask = gIds.slotCount - 1;
   uint32_t slot = (key * 0x9E3779B1u) >> gIds.slotShift;
   for (;;) {
      int32_t head = gIds.slots[slot];
      if (head == 0 || DeviceKey(gIds.dev[head - 1].vendor, gIds.dev[head - 1].device) == key) return slot;
      slot = (slot + 1) & mask;
   }
}

// Builds the index once, with at most two thirds of its slots used.
// Without memory for it the lookups scan instead.
void BuildDeviceIndex() {
   gIds.indexTried = true;
   uint32_t count = 16;
   int shift = 28;
   while (count < uint32_t(gIds.keyRuns) + uint32_t(gIds.keyRuns) / 2) {
      count *= 2;
      shift--;
   }
   gIds.slotCount = count;
   gIds.slotShift = shift;
   if (!MapZeroed(count, &gIds.slots) || !MapZeroed(size_t(gIds.ndevid), &gIds.next)) {
      DropIndex();
      gIds.indexTried = true;
      return;
   }
   // Walking backwards and pushing each row in front leaves every chain in
   // table order.
   for (int i = gIds.ndevid - 1; i >= 0; i--) {
      int32_t &head = gIds.slots[ProbeSlot(DeviceKey(gIds.dev[i].vendor, gIds.dev[i].device))];
      gIds.next[i] = head;
      head = i + 1;
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
   size_t i = 0;
   while (i < text.size() && IsBlank(text[i])) i++;
   if (!IsHexDigit(At(text, i))) return false;
   size_t start = i;
   // The ID ends at a blank; a newline does not end it, so a line with an
   // ID alone fails here.
   while (i < text.size() && !IsBlank(text[i])) i++;
   if (i == text.size()) return false;
   for (size_t j = start; j < i; j++)
      if (!IsHexDigit(text[j])) return false;
   field->id = HexValue(text.substr(start, i - start));
   field->idEnd = i;
   if (nameCapacity == 0) return true;
   i++;
   while (i < text.size() && IsBlank(text[i])) i++;
   if (i == text.size() || text[i] == '\n') return false;
   std::string_view name = text.substr(i);
   if (name.back() == '\n') name.remove_suffix(1);
   field->name = name.substr(0, nameCapacity - 1);
   return true;
}

bool LoadPciIdTables() { return LoadPciIdTablesFrom(kPciIdsRoot); }

bool LoadPciIdTablesFrom(const char *root) {
   DropTables();
   FileList files;
   if (!files.Init()) return false;
   for (const char *dir : kOverrideDirs) {
      char path[kMaxPathBuf];
      std::snprintf(path, sizeof path, "%s/%s", root, dir);
      if (!files.AddDirectory(path)) return false;
   }
   char idsPath[kMaxPathBuf];
   std::snprintf(idsPath, sizeof idsPath, "%s/pci.ids", root);
   if (!files.Add(idsPath)) return false;

   int ndevid = CountDeviceRows(files);
   if (ndevid == 0) std::fputs("no device entries in the pci ids files\nPerhaps, corrupted file?\n", stderr);
   int nclass = CountClassRows(files);
   if (nclass == 0) std::fprintf(stderr, "no class entries in %s\nPerhaps, corrupted file?\n", idsPath);

   // Exact-size tables, zero-filled; an empty one is no failure.
   bool devOk = MapZeroed(size_t(ndevid), &gIds.dev);
   if (devOk) gIds.ndevid = ndevid;
   bool clsOk = MapZeroed(size_t(nclass), &gIds.cls);
   if (clsOk) gIds.nclass = nclass;
   if (!devOk)
      std::fprintf(stderr, "couldn't allocate PciDevTable (%zu bytes)\n", size_t(ndevid) * sizeof(PciDevEntry));
   if (!clsOk)
      std::fprintf(stderr, "couldn't allocate PciClassCodeTable (%zu bytes)\n",
                   size_t(nclass) * sizeof(PciClassEntry));
   if (!devOk || !clsOk) {
      FailBuild();
      return true;
   }

   files.Rewind();
   if (!FillDeviceTable(files) || !FillClassTable(files)) FailBuild();
   return true;
}

const PciDevEntry *LookupPciDevice(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                   uint16_t subdevice) {
   if (gIds.ndevid <= 0) return nullptr;
   if (!gIds.indexTried) BuildDeviceIndex();
   if (gIds.slots == nullptr) return LookupPciDeviceByScan(vendor, device, subvendor, subdevice);
   DeviceChoice choice{subvendor, subdevice};
   for (int32_t link = gIds.slots[ProbeSlot(DeviceKey(vendor, device))]; link != 0; link = gIds.next[link - 1])
      if (choice.Offer(link - 1)) break;
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
