// The PCI ID database.
//
// The ID files are the ".ids" files of five override folders, in a fixed
// order, then pci.ids, read as one stream of lines.  The input is read twice:
// first to count the device rows (up to the "ffff" line that ends the vendor
// section) and the class rows (after it), then to fill the two tables, each
// allocated once at its exact size.  Rows made from the override folders come
// first, and the lookups let them win over pci.ids.
//
// The bytes of every file are kept in one text store for the rest of the
// run, and rows refer to their names by offset and length into it, so
// filling a table copies no names.  Device lookups go through an index from
// (vendor, device) to that pair's rows in table order, built at the first
// lookup; it answers exactly as a scan of the whole table would.
#include "pci/pciids.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>

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
constexpr size_t kMaxFileName = 255;
constexpr size_t kMaxPathBuf = 4097;
constexpr size_t kVendorNameCap = 64;
constexpr size_t kDeviceNameCap = 128;
constexpr size_t kClassNameCap = 64;

// The tables of the last load.  Both counts are 0 when there are none.
struct IndexSlot {
   uint32_t key;  // vendor << 16 | device
   int32_t head;  // first row of the key, -1 for an empty slot
};

struct Tables {
   char *text = nullptr;  // the text store: file bytes and synthesized names
   size_t textSize = 0;
   size_t textCapacity = 0;
   PciDevEntry *dev = nullptr;
   int ndevid = 0;
   PciClassEntry *cls = nullptr;
   int nclass = 0;
   int lastOverrideIndex = -1;
   // The device index: open addressing over (vendor, device), and for each
   // row the next row of the same pair in table order (-1 at the end).
   bool indexTried = false;
   IndexSlot *slots = nullptr;
   uint32_t slotMask = 0;
   int32_t *next = nullptr;
};

Tables gIds;

void DropIndex() {
   std::free(gIds.slots);
   std::free(gIds.next);
   gIds.slots = nullptr;
   gIds.next = nullptr;
   gIds.slotMask = 0;
   gIds.indexTried = false;
}

void DropTables() {
   DropIndex();
   std::free(gIds.dev);
   std::free(gIds.cls);
   std::free(gIds.text);
   gIds = Tables{};
}

// Makes room for at least extra more bytes in the text store.  Offsets are
// 32-bit, so the store stays below 4 GiB.
bool ReserveText(size_t extra) {
   if (gIds.textCapacity - gIds.textSize >= extra) return true;
   size_t want = gIds.textSize + extra;
   if (want < gIds.textSize || want > UINT32_MAX) return false;
   size_t capacity = gIds.textCapacity ? gIds.textCapacity * 2 : 4096;
   if (capacity < want) capacity = want;
   if (capacity > UINT32_MAX) capacity = UINT32_MAX;
   char *grown = static_cast<char *>(std::realloc(gIds.text, capacity));
   if (grown == nullptr) return false;
   gIds.text = grown;
   gIds.textCapacity = capacity;
   return true;
}

bool StoreText(std::string_view s, PciText *text) {
   if (!ReserveText(s.size())) return false;
   std::memcpy(gIds.text + gIds.textSize, s.data(), s.size());
   *text = PciText{uint32_t(gIds.textSize), uint8_t(s.size())};
   gIds.textSize += s.size();
   return true;
}

// A name that lies in the text store already (it came from a line).
PciText TextOf(std::string_view s) {
   return PciText{uint32_t(s.data() - gIds.text), uint8_t(s.size())};
}

// Appends the whole content of an ID file to the text store.  A file that
// cannot be opened gives no bytes; a read error ends the file there, as end
// of file would.
void ReadIdFile(const char *path, size_t *at, size_t *size) {
   *at = gIds.textSize;
   *size = 0;
   int fd = open(path, O_RDONLY | O_CLOEXEC);
   if (fd < 0) return;
   struct stat st;
   size_t hint = fstat(fd, &st) == 0 && S_ISREG(st.st_mode) ? size_t(st.st_size) : 0;
   // One byte beyond the expected size lets the read that sees the end fit.
   if (ReserveText(hint + 1)) {
      for (;;) {
         if (gIds.textCapacity == gIds.textSize && !ReserveText(65536)) break;
         ssize_t n = read(fd, gIds.text + gIds.textSize, gIds.textCapacity - gIds.textSize);
         if (n < 0 && errno == EINTR) continue;
         if (n <= 0) break;
         gIds.textSize += size_t(n);
      }
   }
   close(fd);
   *size = gIds.textSize - *at;
}

[[noreturn]] void CorruptedFileName() {
   std::fputs("Found corrupted file name\n", stderr);
   std::exit(1);
}

[[noreturn]] void NoMemoryForFileList() {
   std::fputs("Not enough memory for file list\n", stderr);
   std::exit(1);
}

// The ID files of one load in reading order, with a cursor over their lines.
// Each file's bytes are read into the text store when the cursor first
// reaches it; the second reading uses them again.
struct IdFile {
   char *path;
   bool read;
   size_t at;    // where its bytes start in the text store
   size_t size;  // how many there are
};

class FileList {
public:
   FileList() {
      files_ = static_cast<IdFile *>(std::malloc(capacity_ * sizeof(IdFile)));
      if (files_ == nullptr) NoMemoryForFileList();
   }
   ~FileList() {
      for (int i = 0; i < count_; i++) std::free(files_[i].path);
      std::free(files_);
   }
   FileList(const FileList &) = delete;
   FileList &operator=(const FileList &) = delete;

   void Add(const char *path) {
      size_t len = std::strlen(path);
      if (len > kMaxFileName) CorruptedFileName();
      if (count_ == capacity_) {
         auto *grown = static_cast<IdFile *>(std::realloc(files_, 2 * capacity_ * sizeof(IdFile)));
         if (grown == nullptr) NoMemoryForFileList();
         files_ = grown;
         capacity_ *= 2;
      }
      char *copy = static_cast<char *>(std::malloc(len + 1));
      if (copy == nullptr) NoMemoryForFileList();
      std::memcpy(copy, path, len + 1);
      files_[count_++] = IdFile{copy, false, 0, 0};
   }

   // Adds the files of dir whose names end in ".ids", in the order the
   // folder lists them.  A folder that cannot be opened adds nothing.
   void AddDirectory(const char *dir) {
      DIR *d = opendir(dir);
      if (d == nullptr) return;
      while (const dirent *entry = readdir(d)) {
         size_t len = strnlen(entry->d_name, kMaxFileName + 1);
         if (len > kMaxFileName) CorruptedFileName();
         if (len <= 4 || std::memcmp(entry->d_name + len - 4, ".ids", 4) != 0) continue;
         char path[kMaxPathBuf];
         int n = std::snprintf(path, sizeof path, "%s/%s", dir, entry->d_name);
         if (n < 0 || size_t(n) >= sizeof path) CorruptedFileName();
         Add(path);
      }
      closedir(d);
   }

   // The next line (piece) across all files, cut at its first NUL as a C
   // string would be; false after the last file.
   bool NextLine(std::string_view *line) {
      while (current_ < count_) {
         IdFile &f = files_[current_];
         if (!f.read) {
            ReadIdFile(f.path, &f.at, &f.size);
            f.read = true;
         }
         if (offset_ < f.size) {
            const char *p = gIds.text + f.at + offset_;
            size_t n = f.size - offset_ < kLinePiece ? f.size - offset_ : kLinePiece;
            const void *newline = std::memchr(p, '\n', n);
            if (newline) n = size_t(static_cast<const char *>(newline) - p) + 1;
            offset_ += n;
            lineNumber_++;
            const void *nul = std::memchr(p, '\0', n);
            *line = std::string_view(p, nul ? size_t(static_cast<const char *>(nul) - p) : n);
            return true;
         }
         current_++;
         offset_ = 0;
         lineNumber_ = 0;
      }
      return false;
   }

   const char *CurrentName() const { return files_[current_].path; }
   int LineNumber() const { return lineNumber_; }
   // pci.ids is always the last file: the loader tells it from the override
   // files by position alone.
   bool NotLast() const { return current_ < count_ - 1; }

   void Rewind() {
      current_ = 0;
      offset_ = 0;
      lineNumber_ = 0;
   }

private:
   IdFile *files_ = nullptr;
   int count_ = 0;
   int capacity_ = 8;
   int current_ = 0;
   size_t offset_ = 0;  // next byte of the current file
   int lineNumber_ = 0;
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

bool IsSynthesized(PciText name) {
   return name.len >= kNotAvailLen && std::memcmp(gIds.text + name.at, not_avail_prefix, kNotAvailLen) == 0;
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

// Rows beyond the counted size are counted but never written, so the count
// check can report them.
void AddDevRow(int *made, const PciDevEntry &row) {
   if (*made < gIds.ndevid) gIds.dev[*made] = row;
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
   uint16_t vendorId = 0;
   PciText vendorName{0, 0};
   uint16_t deviceId = 0;
   int made = 0;
   std::string_view line;
   while (files.NextLine(&line)) {
      if (IsSkipped(line)) continue;
      if (EndsVendorSection(line)) break;
      int tabs = LeadingTabs(line);
      PciIdField field;
      if (tabs == 0) {
         vendorName = PciText{0, 0};
         if (!ParsePciIdLine(line, kVendorNameCap, &field)) {
            ImproperlyFormatted(files, 1);
            break;
         }
         vendorId = uint16_t(field.id);
         vendorName = TextOf(field.name);
         if (files.NotLast()) continue;
         AddDevRow(&made, PciDevEntry{vendorId, kNone, kNone, kNone, vendorName, PciText{0, 0}});
      } else if (tabs == 1) {
         // The row keeps the ID written on the line even when the name is
         // missing.  Read it now: storing a synthesized name may move the
         // line's bytes.
         std::string_view text = line.substr(1);
         deviceId = uint16_t(LeadingHexId(text));
         PciText name;
         if (ParsePciIdLine(text, kDeviceNameCap, &field)) {
            name = TextOf(field.name);
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
            if (!StoreText(synthesized, &name)) return false;
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
         // once the first parse has put a NUL there.
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
                                      TextOf(field.name)});
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
   uint8_t classId = 0, subclassId = 0;
   PciText className{0, 0}, subclassName{0, 0};
   const PciText empty{0, 0};
   int made = 0;

   auto addSubclassRow = [&] {
      AddClassRow(&made, PciClassEntry{classId, subclassId, 0xff, className, subclassName, empty});
   };
   auto closeBlock = [&] {
      if (block == Block::Subclass || block == Block::ProgIf) addSubclassRow();
      if (block != Block::None)
         AddClassRow(&made, PciClassEntry{classId, 0xff, 0xff, className, empty, empty});
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
         className = TextOf(field.name);
         block = Block::Class;
      } else if (LeadingTabs(line) >= 2) {
         if (!ParsePciIdLine(line.substr(2), kClassNameCap, &field)) {
            ImproperlyFormatted(files, 7);
            ended = true;
            continue;
         }
         AddClassRow(&made, PciClassEntry{classId, subclassId, uint8_t(field.id), className, subclassName,
                                          TextOf(field.name)});
         block = Block::ProgIf;
      } else if (LeadingTabs(line) == 1) {
         if (block == Block::Subclass || block == Block::ProgIf) addSubclassRow();
         if (!ParsePciIdLine(line.substr(1), kClassNameCap, &field)) {
            ImproperlyFormatted(files, 6);
            ended = true;
            continue;
         }
         subclassId = uint8_t(field.id);
         subclassName = TextOf(field.name);
         block = Block::Subclass;
      } else {
         // Any other line, comments included, closes nothing: a subclass
         // still waiting for its own row loses it, and the count check
         // below notices.
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

   // True when the answer is final; it is then the candidate.
   bool Offer(int index) {
      const PciDevEntry &row = gIds.dev[index];
      bool isOverride = index <= gIds.lastOverrideIndex;
      if (row.subvendor == 0) {
         if (candidate == nullptr || (IsSynthesized(candidate->name) && !IsSynthesized(row.name))) {
            candidate = &row;
            candidateOverride = isOverride;
         }
         return false;
      }
      if (row.subvendor != subvendor || row.subdevice != subdevice) return false;
      if (isOverride || candidate == nullptr || !candidateOverride || IsSynthesized(candidate->name))
         candidate = &row;
      return true;
   }
};

uint32_t DeviceKey(uint16_t vendor, uint16_t device) { return uint32_t(vendor) << 16 | device; }

uint32_t ProbeSlot(uint32_t key) {
   uint32_t slot = (key * 0x9E3779B1u) >> 7 & gIds.slotMask;
   while (gIds.slots[slot].head >= 0 && gIds.slots[slot].key != key) slot = (slot + 1) & gIds.slotMask;
   return slot;
}

// Builds the index once.  Without memory for it the lookups scan instead.
void BuildDeviceIndex() {
   gIds.indexTried = true;
   size_t capacity = 16;
   while (capacity < 2 * size_t(gIds.ndevid)) capacity *= 2;
   gIds.slots = static_cast<IndexSlot *>(std::malloc(capacity * sizeof(IndexSlot)));
   gIds.next = static_cast<int32_t *>(std::malloc(size_t(gIds.ndevid) * sizeof(int32_t)));
   if (gIds.slots == nullptr || gIds.next == nullptr) {
      DropIndex();
      gIds.indexTried = true;
      return;
   }
   std::memset(gIds.slots, 0xff, capacity * sizeof(IndexSlot));
   gIds.slotMask = uint32_t(capacity - 1);
   // Walking backwards and pushing each row in front leaves every chain in
   // table order.
   for (int i = gIds.ndevid - 1; i >= 0; i--) {
      uint32_t key = DeviceKey(gIds.dev[i].vendor, gIds.dev[i].device);
      IndexSlot &slot = gIds.slots[ProbeSlot(key)];
      gIds.next[i] = slot.head;
      slot.key = key;
      slot.head = i;
   }
}

}  // namespace

std::string_view PciName(PciText text) {
   if (gIds.text == nullptr) return {};
   return std::string_view(gIds.text + text.at, text.len);
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

void LoadPciIdTables() { LoadPciIdTablesFrom(kPciIdsRoot); }

void LoadPciIdTablesFrom(const char *root) {
   DropTables();
   FileList files;
   for (const char *dir : kOverrideDirs) {
      char path[kMaxPathBuf];
      std::snprintf(path, sizeof path, "%s/%s", root, dir);
      files.AddDirectory(path);
   }
   char idsPath[kMaxPathBuf];
   std::snprintf(idsPath, sizeof idsPath, "%s/pci.ids", root);
   files.Add(idsPath);

   int ndevid = CountDeviceRows(files);
   if (ndevid == 0) std::fputs("no device entries in the pci ids files\nPerhaps, corrupted file?\n", stderr);
   int nclass = CountClassRows(files);
   if (nclass == 0) std::fprintf(stderr, "no class entries in %s\nPerhaps, corrupted file?\n", idsPath);

   // Exact-size tables, zero-filled; an empty one is no failure.
   gIds.dev = static_cast<PciDevEntry *>(std::calloc(size_t(ndevid) + 1, sizeof(PciDevEntry)));
   gIds.cls = static_cast<PciClassEntry *>(std::calloc(size_t(nclass) + 1, sizeof(PciClassEntry)));
   if (gIds.dev == nullptr)
      std::fprintf(stderr, "couldn't allocate PciDevTable (%zu bytes)\n", size_t(ndevid) * sizeof(PciDevEntry));
   if (gIds.cls == nullptr)
      std::fprintf(stderr, "couldn't allocate PciClassCodeTable (%zu bytes)\n",
                   size_t(nclass) * sizeof(PciClassEntry));
   if (gIds.dev == nullptr || gIds.cls == nullptr) {
      FailBuild();
      return;
   }
   gIds.ndevid = ndevid;
   gIds.nclass = nclass;

   files.Rewind();
   if (!FillDeviceTable(files) || !FillClassTable(files)) FailBuild();
}

const PciDevEntry *LookupPciDevice(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                   uint16_t subdevice) {
   if (gIds.ndevid <= 0) return nullptr;
   if (!gIds.indexTried) BuildDeviceIndex();
   if (gIds.slots == nullptr) return LookupPciDeviceByScan(vendor, device, subvendor, subdevice);
   DeviceChoice choice{subvendor, subdevice};
   for (int i = gIds.slots[ProbeSlot(DeviceKey(vendor, device))].head; i >= 0; i = gIds.next[i])
      if (choice.Offer(i)) break;
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
