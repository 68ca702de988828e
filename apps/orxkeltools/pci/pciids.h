// The PCI ID database: vendor, device, subsystem and class names for lspci,
// read from the ID files under /usr/share/hwdata on every run.
#ifndef ORXKELTOOLS_PCI_PCIIDS_H
#define ORXKELTOOLS_PCI_PCIIDS_H

#include <cstddef>
#include <cstdint>
#include <string_view>

// "Name not available for ": the start of every synthesized device name.
extern "C" const char not_avail_prefix[];

// The folder the tool reads its ID files from.
inline constexpr char kPciIdsRoot[] = "/usr/share/hwdata";

// A name of the tables: where it starts in the ID files taken end to end
// (or in the store of synthesized names) and how long it is.  Names are cut
// to 63 or 127 characters, so the length fits in a byte.  Packed, so that a
// device row takes 20 bytes rather than 24: the pages of the device table
// cost as much to take as the ID files cost to parse.
struct [[gnu::packed]] PciText {
   uint32_t at;
   uint8_t len;
   uint8_t flags;
};

// One row of the device table.  A vendor row has device, subvendor and
// subdevice 0xffff and an empty name; a device row has subvendor 0; any
// other row is a subsystem row.
struct PciDevEntry {
   uint16_t vendor;
   uint16_t device;
   uint16_t subvendor;
   uint16_t subdevice;
   PciText vendorName;
   PciText name;
};
static_assert(sizeof(PciDevEntry) == 20);

// One row of the class table.  A class-level row has subclassId and progIf
// 0xff; a subclass-level row has progIf 0xff.
struct PciClassEntry {
   uint8_t classId;
   uint8_t subclassId;
   uint8_t progIf;
   PciText className;
   PciText subclassName;
   PciText progIfName;
};

// The text of a name of the last load, valid until the next load.
std::string_view PciName(PciText text);

// Builds both tables from the ID files of kPciIdsRoot.  Problems are
// reported on standard error.  False only for a corrupted file name or no
// memory for the file list, which end lspci with status 1; any other
// failure leaves both tables empty and lspci goes on without names.
bool LoadPciIdTables();

// The same from another folder (for tests).  Drops the tables of an earlier
// load first.
bool LoadPciIdTablesFrom(const char *root);

// The row that names this function, or null.  With device, subvendor and
// subdevice all 0xffff it finds the vendor row.
const PciDevEntry *LookupPciDevice(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                   uint16_t subdevice);

// The same answer from a plain scan of every row in table order: the
// reference that LookupPciDevice's index is tested against.
const PciDevEntry *LookupPciDeviceByScan(uint16_t vendor, uint16_t device, uint16_t subvendor,
                                         uint16_t subdevice);

// The subclass row (or, for an unknown subclass, the class-level row) of a
// class code whose high byte is the base class and low byte the subclass.
const PciClassEntry *LookupPciClass(uint16_t classCode);

// The tables as loaded, for tests and the benchmark.
int PciDevCount();
const PciDevEntry &PciDevRow(int index);
int PciClassCount();
const PciClassEntry &PciClassRow(int index);
// Index of the last row made from an override directory file, -1 if none.
int PciLastOverrideIndex();

// One ID, blanks and a name split off a line of an ID file.  idEnd is the
// offset of the blank after the ID in the text given.
struct PciIdField {
   uint32_t id;
   size_t idEnd;
   std::string_view name;
};

// Splits text into a hexadecimal ID and, unless nameCapacity is 0, a name
// cut to nameCapacity - 1 characters.  False when the text has no ID
// followed by a blank or, when a name is wanted, no name.
bool ParsePciIdLine(std::string_view text, size_t nameCapacity, PciIdField *field);

#endif
