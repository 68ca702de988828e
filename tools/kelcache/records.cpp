// Record field tables, and the JSON form of records.
#include "records.h"

#include <algorithm>
#include <vector>

#include "kel/kel.h"

namespace kelcache {

namespace {

// Node numbers and record sizes as constants, for the table check below.
namespace node {
#define KEL_NODE_DEF(name, number, path, size, flags) constexpr KEL_Node name = number;
#include "kel/nodes.def"
#undef KEL_NODE_DEF
}  // namespace node

struct NodeSize {
   KEL_Node number;
   uint32_t size;
};
constexpr NodeSize kNodeSizes[] = {
#define KEL_NODE_DEF(name, number, path, size, flags) {number, size},
#include "kel/nodes.def"
#undef KEL_NODE_DEF
};

using enum FieldType;

constexpr Field kWorldName[] = {{"text", 0, Text, 128}};
constexpr Field kWorldInfo[] = {
   {"worldId", 0, U32},         {"groupId", 4, I32},   {"userspaceId", 8, I32},
   {"cartelId", 12, U32},       {"parentCartelId", 16, U32},
   {"processGroupId", 20, I32}, {"sessionId", 24, I32}, {"type", 28, U32},
   {"securityDomain", 45, I32},
};
constexpr Field kSummaryStats[] = {{"runState", 4, U32}, {"waitState", 8, U32}};
constexpr Field kAffinity[] = {{"text", 0, Text, 2304}};
constexpr Field kStateTimes[] = {{"usedTime", 8, U64}};
constexpr Field kCmdline[] = {{"text", 0, Text, 1024}};
constexpr Field kChild[] = {{"state", 4, U32}};
constexpr Field kFd[] = {{"type", 4, Text, 96}, {"description", 100, Text, 1984}};
constexpr Field kMmap[] = {
   {"length", 8, U32}, {"kind", 16, U32}, {"prot", 20, U32},
   {"fd", 24, I32},    {"description", 28, Text, 2008},
};
constexpr Field kPciHeader[] = {
   {"vendor", 0, U16},     {"device", 2, U16},    {"subvendor", 4, U16},
   {"subdevice", 6, U16},  {"classCode", 8, U16}, {"isaIrq", 12, U8},
   {"irq", 13, U8},        {"vector", 14, U8},    {"intPin", 15, U8},
   {"spawnedBus", 16, U8}, {"irqFlags", 17, U8},  {"modeFlags", 18, U8},
   {"moduleId", 19, U32},  {"deviceName", 23, Text, 33}, {"physSlot", 56, U32},
};
constexpr Field kPciConfigSpace[] = {{"bytes", 0, Hex, 256}};
constexpr Field kPciExtConfigSpace[] = {{"bytes", 0, Hex, 4096}};
constexpr Field kModule[] = {{"name", 0, Text, 32}, {"id", 288, U32}};
constexpr Field kCpuInfo[] = {{"numCpus", 16, U32}};
constexpr Field kUsageStatus[] = {{"deviceFlag", 8, U8}};
constexpr Field kPcpuCount[] = {{"count", 0, U64}};
constexpr Field kAcpiTable[] = {
   {"signature", 0, Text, 4}, {"length", 5, U32}, {"data", 9, Hex, 131075}};
constexpr Field kRtc[] = {
   {"hours", 0, I32}, {"minutes", 4, I32}, {"seconds", 8, I32},
   {"day", 12, I32},  {"month", 16, I32},  {"year", 20, I32},
};
constexpr Field kVersion[] = {
   {"product", 0, Text, 32},        {"version", 32, Text, 64}, {"releaseLevel", 96, Text, 64},
   {"update", 160, Text, 132},      {"build", 292, I32},
};
constexpr Field kBootOption[] = {{"audit", 0, U8}, {"fsck", 1, U8}, {"rollback", 2, U8}};
constexpr Field kBootCmdLine[] = {{"text", 0, Text, 4096}};
constexpr Field kBootMac[] = {{"pxe", 0, U8}, {"mac", 1, Mac, 6}};
constexpr Field kTardisk[] = {{"size", 0, U32}, {"bootModule", 8, U8}};
constexpr Field kRamdisk[] = {
   {"minMiB", 0, U32}, {"maxMiB", 4, U32}, {"usedPages", 8, U32}, {"peakPages", 12, U32}};
constexpr Field kInode[] = {
   {"flags", 4, U32},            {"linkState", 20, I32},         {"size", 28, U32},
   {"tardisk", 32, Text, 128},   {"ramdisk", 160, Text, 128},    {"name", 288, Text, 256},
};
constexpr Field kUpTime[] = {{"seconds", 0, U32}};
constexpr Field kNumPcpus[] = {{"numPcpus", 4, U32}};
constexpr Field kLoadHistory[] = {{"loadPct", 4, U32}};

constexpr RecordDef kRecords[] = {
   {node::world_name, kWorldName, kWholeText},
   {node::world_info, kWorldInfo},
   {node::sched_Vcpus_stats_summaryStats, kSummaryStats},
   {node::sched_Vcpus_stats_affinity, kAffinity, kWholeText},
   {node::sched_Vcpus_stats_stateTimes, kStateTimes},
   {node::userworld_cartel_cmdline, kCmdline, kWholeText},
   {node::userworld_cartel_child, kChild},
   {node::userworld_cartel_fd_fds, kFd},
   {node::userworld_cartel_mem_mmaps, kMmap},
   {node::hardware_pci_seg_bus_slot_func_pciConfigHeader, kPciHeader},
   {node::hardware_pci_seg_bus_slot_func_pciConfigSpace, kPciConfigSpace},
   {node::hardware_pci_seg_bus_slot_func_pciExtConfigSpace, kPciExtConfigSpace},
   {node::system_modules_general, kModule},
   {node::hardware_cpu_cpuInfo, kCpuInfo},
   {node::hardware_interrupts_cookieList_UsageStatus, kUsageStatus},
   {node::hardware_interrupts_cookieList_PCPU, kPcpuCount},
   {node::hardware_acpi_tables_buffers, kAcpiTable, kAcpiBuffer},
   {node::hardware_chipset_rtc, kRtc},
   {node::system_version, kVersion},
   {node::system_bootOption, kBootOption},
   {node::system_bootCmdLine, kBootCmdLine, kWholeText},
   {node::system_bootMAC, kBootMac},
   {node::system_corafs_tardisks_stats, kTardisk},
   {node::system_corafs_ramdisks_stats, kRamdisk},
   {node::system_corafs_inodes_stats, kInode, kInodeStats},
   {node::system_ntpclock_upTime, kUpTime},
   {node::sched_globalStats_numPcpus, kNumPcpus},
   {node::sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory1MinInPct, kLoadHistory},
   {node::sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory5MinInPct, kLoadHistory},
   {node::sched_groups_stats_cpuStatsDir_cpuLoadHistory_cpuLoadHistory15MinInPct, kLoadHistory},
};

constexpr uint32_t FieldSize(const Field &f) {
   switch (f.type) {
   case U8: return 1;
   case U16: return 2;
   case U32:
   case I32: return 4;
   case U64: return 8;
   case Text:
   case Hex:
   case Mac: return f.width;
   }
   return 0;
}

// Every readable node has exactly one table, and every field lies inside its record.
constexpr bool TablesCoverNodes() {
   for (const NodeSize &n : kNodeSizes) {
      int tables = 0;
      for (const RecordDef &r : kRecords) {
         if (r.node != n.number) continue;
         tables++;
         for (const Field &f : r.fields)
            if (f.offset + FieldSize(f) > n.size) return false;
      }
      if (tables != (n.size > 0 ? 1 : 0)) return false;
   }
   return true;
}
static_assert(TablesCoverNodes(), "every readable node in nodes.def needs a field table here");

// Cap on a stored record's size, so that a snapshot cannot ask for gigabytes.
constexpr uint64_t kMaxRecordSize = 16u << 20;

const Field *FindField(const RecordDef &def, std::string_view name) {
   for (const Field &f : def.fields)
      if (f.name == name) return &f;
   return nullptr;
}

IntType IntTypeOf(FieldType type) {
   switch (type) {
   case U8: return IntType::U8;
   case U16: return IntType::U16;
   case U64: return IntType::U64;
   case I32: return IntType::I32;
   default: return IntType::U32;
   }
}

uint64_t GetUint(std::string_view buf, size_t offset, size_t size) {
   uint64_t v = 0;
   for (size_t i = 0; i < size; i++) v |= uint64_t(uint8_t(buf[offset + i])) << (8 * i);
   return v;
}

std::string_view TrimmedZeros(std::string_view bytes) {
   size_t end = bytes.find_last_not_of('\0');
   return bytes.substr(0, end == std::string_view::npos ? 0 : end + 1);
}

// The fields of a record buffer (at least the node's size).  Fields whose
// bytes JSON cannot carry (texts that are not UTF-8) are left out.
Json DecodeFields(const RecordDef &def, std::string_view buf) {
   Json out = Json::object();
   // Each field once: appended without the ordered object's search.
   Json::object_t &members = out.get_ref<Json::object_t &>();
   members.reserve(def.fields.size());
   for (const Field &f : def.fields) {
      std::string_view bytes = buf.substr(f.offset, FieldSize(f));
      auto put = [&](Json value) { members.emplace_back(std::string(f.name), std::move(value)); };
      switch (f.type) {
      case I32: put(int32_t(uint32_t(GetUint(buf, f.offset, 4)))); break;
      case Text: {
         std::string_view text = bytes.substr(0, bytes.find('\0'));
         if (ValidUtf8(text)) put(std::string(text));
         break;
      }
      case Hex: {
         if (def.flags & kAcpiBuffer) break;  // the table bytes: below, as long as "length" says
         std::string_view used = TrimmedZeros(bytes);
         if (!used.empty()) put(ToHex(used));
         break;
      }
      case Mac: {
         std::string hex = ToHex(bytes), text;
         for (size_t i = 0; i < hex.size(); i += 2) text += (i ? ":" : "") + hex.substr(i, 2);
         put(text);
         break;
      }
      default: put(GetUint(buf, f.offset, FieldSize(f)));
      }
   }
   if (def.flags & kAcpiBuffer) {
      // The table bytes are as many as the length says; a length past the
      // buffer is kept as given, with the bytes there are.
      uint64_t length = GetUint(buf, 5, 4);
      std::string_view rest = buf.substr(9);
      std::string_view table = length <= rest.size() ? rest.substr(0, length) : TrimmedZeros(rest);
      if (length == table.size()) out.erase("length");
      if (!table.empty()) out["data"] = ToHex(table);
   }
   return out;
}

}  // namespace

const RecordDef *FindRecord(KEL_Node number) {
   for (const RecordDef &r : kRecords)
      if (r.node == number) return &r;
   return nullptr;
}

void RecordCodec::Clear(size_t n) {
   std::fill(buf_.begin(), buf_.begin() + ptrdiff_t(std::min(dirty_, buf_.size())), '\0');
   dirty_ = 0;
   if (buf_.size() < n) buf_.resize(n, '\0');
}

void RecordCodec::PutUint(size_t offset, size_t size, uint64_t v) {
   Mark(offset + size);
   for (size_t i = 0; i < size; i++) buf_[offset + i] = char(uint8_t(v >> (8 * i)));
}

void RecordCodec::PutBytes(const Field &f, std::string_view bytes, const std::string &path) {
   if (bytes.size() > f.width)
      Fail(path, std::to_string(bytes.size()) + " bytes do not fit the field's " + std::to_string(f.width));
   Mark(f.offset + bytes.size());
   std::copy(bytes.begin(), bytes.end(), buf_.begin() + f.offset);
}

// Lays one field over the buffer.  A text writes its bytes and, when it is
// shorter than the field, one NUL: any other bytes come from "$raw".
void RecordCodec::PutField(const Field &f, const Json &value, const std::string &path) {
   switch (f.type) {
   case Text: {
      const std::string &text = ReadText(value, path);
      if (text.size() > f.width)
         Fail(path, "text of " + std::to_string(text.size()) + " bytes is longer than the field (" +
                       std::to_string(f.width) + " bytes)");
      Mark(f.offset + std::min<size_t>(text.size() + 1, f.width));
      std::copy(text.begin(), text.end(), buf_.begin() + f.offset);
      if (text.size() < f.width) buf_[f.offset + text.size()] = '\0';
      return;
   }
   case Hex:
   case Mac: PutBytes(f, ReadHex(value, path), path); return;
   default: PutUint(f.offset, FieldSize(f), ReadInt(value, IntTypeOf(f.type), path));
   }
}

std::string_view RecordCodec::Trimmed(size_t n) const {
   return TrimmedZeros(std::string_view(buf_).substr(0, std::min(n, dirty_)));
}

RecordEntry RecordCodec::Encode(const kelplat::NodeInfo &node, const Json &value, const std::string &path,
                                  bool allowUnlisted) {
   const RecordDef &def = *FindRecord(node.number);
   RecordEntry out;
   if (value.is_string() && (def.flags & kWholeText)) {
      Clear(node.recordSize);
      PutField(def.fields[0], value, path);
      out.data = Trimmed(node.recordSize);
      return out;
   }
   if (!value.is_object())
      Fail(path, def.flags & kWholeText ? "expected a text or an object of record fields"
                                        : "expected an object of record fields");

   std::vector<Given> &given = given_;
   given.clear();
   std::optional<uint64_t> size;
   std::string raw, rawPath;
   const Json *tableText = nullptr, *unlinked = nullptr;
   std::string tableTextPath, unlinkedPath;
   for (auto it = value.begin(); it != value.end(); ++it) {
      const std::string &name = it.key();
      std::string p = MemberPath(path, name);
      if (name == "$status") {
         out.status = ReadStatus(*it, p);
      } else if (name == "$setStatus") {
         if (!(node.flags & kelplat::KEL_NF_SET)) Fail(p, "this node cannot be set");
         out.setStatus = ReadStatus(*it, p);
      } else if (name == "$size") {
         size = ReadInt(*it, IntType::U32, p);
         if (*size > kMaxRecordSize) Fail(p, "records are at most 16 MiB");
      } else if (name == "$raw") {
         raw = ReadHex(*it, p);
         rawPath = p;
      } else if (name == "$unlisted" && allowUnlisted) {
         continue;  // the listing's business
      } else if (name.starts_with("$")) {
         Fail(p, "unknown control member");
      } else if (const Field *f = FindField(def, name)) {
         given.push_back({f, &*it, p});
      } else if ((def.flags & kAcpiBuffer) && name == "text") {
         tableText = &*it;
         tableTextPath = p;
      } else if ((def.flags & kInodeStats) && name == "unlinked") {
         unlinked = &*it;
         unlinkedPath = p;
      } else {
         Fail(p, "no such field");
      }
   }

   size_t stored = size.value_or(node.recordSize);
   if (raw.size() > stored)
      Fail(rawPath, std::to_string(raw.size()) + " bytes do not fit a record of " + std::to_string(stored) +
                       " bytes");
   Clear(std::max<size_t>(stored, node.recordSize));
   Mark(raw.size());
   std::copy(raw.begin(), raw.end(), buf_.begin());
   bool haveLength = false, haveLinkState = false;
   std::optional<size_t> tableSize;
   for (const Given &g : given) {
      haveLength |= g.field->name == "length";
      haveLinkState |= g.field->name == "linkState";
      if ((def.flags & kAcpiBuffer) && g.field->name == "data") {
         if (tableText != nullptr) Fail(tableTextPath, "give data or text, not both");
         std::string bytes = ReadHex(*g.value, g.path);
         PutBytes(*g.field, bytes, g.path);
         tableSize = bytes.size();
      } else {
         PutField(*g.field, *g.value, g.path);
      }
   }
   if (tableText != nullptr) {
      const std::string &text = ReadText(*tableText, tableTextPath);
      PutBytes(*FindField(def, "data"), text, tableTextPath);
      tableSize = text.size();
   }
   // Only table bytes given set the default length; "$raw" bytes stay as they are.
   if ((def.flags & kAcpiBuffer) && !haveLength && tableSize) PutUint(5, 4, *tableSize);
   if (unlinked != nullptr && ReadBool(*unlinked, unlinkedPath)) {
      if (haveLinkState) Fail(unlinkedPath, "give linkState or unlinked, not both");
      PutUint(20, 4, uint32_t(-4));
   }
   // The reader zero-fills short records, so without "$size" the zeros at
   // the end are left out.
   out.data = size ? std::string_view(buf_).substr(0, stored) : Trimmed(stored);
   return out;
}

bool RecordCodec::EncodesBack(const kelplat::NodeInfo &node, const Json &value, const RecordEntry &entry) {
   try {
      return Encode(node, value, "", false).data == entry.data;
   } catch (const SnapshotError &) {
      return false;
   }
}

std::optional<Json> RecordCodec::Dump(const kelplat::NodeInfo &node, const RecordEntry &entry, bool asObject) {
   const RecordDef &def = *FindRecord(node.number);
   // The stored bytes, zero-filled to the node's size: the buffer is kept
   // zero past the bytes the last record put there.
   const size_t size = std::max<size_t>(entry.data.size(), node.recordSize);
   std::fill(stored_.begin(), stored_.begin() + ptrdiff_t(std::min(storedUsed_, stored_.size())), '\0');
   if (stored_.size() < size) stored_.resize(size, '\0');
   std::copy(entry.data.begin(), entry.data.end(), stored_.begin());
   storedUsed_ = entry.data.size();
   std::string_view stored = std::string_view(stored_).substr(0, size);
   // A failing read usually stores no bytes; then it needs no fields either.
   Json fields = entry.data.empty() && entry.status != 0 ? Json::object() : DecodeFields(def, stored);

   if (!asObject && (def.flags & kWholeText) && entry.status == 0 && !entry.setStatus &&
       fields.contains("text") && EncodesBack(node, fields["text"], entry))
      return fields["text"];
   // The fields alone, then with the stored size, then over the raw bytes.
   // Without statuses the first is the fields as they are.
   if (entry.status == 0 && !entry.setStatus && EncodesBack(node, fields, entry)) return fields;
   for (int variant = entry.status == 0 && !entry.setStatus ? 1 : 0; variant < 4; variant++) {
      Json j = Json::object();
      if (entry.status != 0) j["$status"] = FormatStatus(entry.status);
      if (entry.setStatus) j["$setStatus"] = FormatStatus(*entry.setStatus);
      if (variant & 1) j["$size"] = entry.data.size();
      if (variant & 2) j["$raw"] = ToHex(TrimmedZeros(entry.data));
      for (auto it = fields.begin(); it != fields.end(); ++it) j[it.key()] = *it;
      if (EncodesBack(node, j, entry)) return j;
   }
   return std::nullopt;
}

}  // namespace kelcache
