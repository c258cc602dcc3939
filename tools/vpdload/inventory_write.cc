// From records back to the inventory's JSON form, leaving out what is empty so that an
// exported inventory stays readable; reading it back gives the same records.
#include <cstdint>
#include <cstdio>

#include "inventory_schema.h"
#include "text_bytes.h"

namespace vpdload {

using nlohmann::ordered_json;

namespace {

// A text field as JSON: a string when the bytes are UTF-8, otherwise {"hex": "..."}.
ordered_json text(const std::string& bytes) {
  if (isUtf8(bytes)) return bytes;
  ordered_json hex = ordered_json::object();
  hex["hex"] = toHex(bytes);
  return hex;
}

void putText(ordered_json& obj, const char* key, const std::string& bytes) {
  if (!bytes.empty()) obj[key] = text(bytes);
}

ordered_json location(loc_id_t loc) {
  ordered_json j = ordered_json::object();
  j["frame"] = loc.getFrame();
  j["cage"] = loc.getCage();
  j["chip"] = loc.getChip();
  if (typeName(loc.getType())[0] != '\0') {
    j["type"] = typeName(loc.getType());
  } else {
    j["type"] = loc.getType();
  }
  j["plane"] = loc.getPlane();
  j["network"] = loc.getNetwork();
  return j;
}

ordered_json machine(const mtms& m) {
  ordered_json j = ordered_json::object();
  putText(j, "tm", m.getTM());
  putText(j, "se", m.getSE());
  return j;
}

ordered_json fru(const fru_stanza& f) {
  ordered_json j = ordered_json::object();
  putText(j, "ds", f.getDS());
  putText(j, "pn", f.getPN());
  putText(j, "ec", f.getEC());
  putText(j, "fn", f.getFN());
  putText(j, "sn", f.getSN());
  putText(j, "cc", f.getCC());
  putText(j, "yl", f.getYL());
  return j;
}

// Members whose JSON form is empty are left out; reading restores them as empty.
void putObject(ordered_json& obj, const char* key, ordered_json value) {
  if (!value.empty()) obj[key] = std::move(value);
}

void putLocation(ordered_json& obj, const char* key, loc_id_t loc) {
  if (loc.toInt() != 0) obj[key] = location(loc);
}

void putInt(ordered_json& obj, const char* key, int value) {
  if (value != 0) obj[key] = value;
}

// A BPA's regulators or distributors: trailing empty units are left out.
void putUnits(ordered_json& obj, const char* key,
              const fru_stanza (&units)[bpaVPD::kUnitsPerKind]) {
  ordered_json a = ordered_json::array();
  for (const fru_stanza& f : units) a.push_back(fru(f));
  while (!a.empty() && a.back().empty()) a.erase(a.size() - 1);
  if (!a.empty()) obj[key] = std::move(a);
}

ordered_json record(const smaVPD& r) {
  ordered_json j = ordered_json::object();
  j["loc"] = location(r.loc_id);
  putObject(j, "fru", fru(r.sma_fru));
  putObject(j, "cec", machine(r.cec_mtms));
  putLocation(j, "neighbor", r.neighbor_id);
  putText(j, "timestamp", r.getTimestamp());
  return j;
}

ordered_json record(const chassisVPD& r) {
  ordered_json j = ordered_json::object();
  j["loc"] = location(r.loc_id);
  putObject(j, "mtms", machine(r.sw_mtms));
  putObject(j, "fru", fru(r.sw_fru));
  putObject(j, "dca1", fru(r.dca1_fru));
  putObject(j, "dca2", fru(r.dca2_fru));
  ordered_json risers = ordered_json::array();
  for (int slot = 0; slot < chassisVPD::kRiserSlots; ++slot) {
    const riser_vpd_t& s = r.riser[slot];
    ordered_json one = ordered_json::object();
    putObject(one, "fru", fru(s.riser_fru));
    putLocation(one, "nbr1", s.nbr1);
    putInt(one, "port1", s.port1);
    putLocation(one, "nbr2", s.nbr2);
    putInt(one, "port2", s.port2);
    if (one.empty()) continue;
    ordered_json with_slot = ordered_json::object();
    with_slot["slot"] = slot;
    with_slot.update(one);
    risers.push_back(std::move(with_slot));
  }
  if (!risers.empty()) j["risers"] = std::move(risers);
  putText(j, "timestamp", r.getTimestamp());
  return j;
}

ordered_json record(const bpaVPD& r) {
  ordered_json j = ordered_json::object();
  j["loc"] = location(r.loc_id);
  putText(j, "timestamp", r.getTimestamp());
  putObject(j, "mtms", machine(r.frame_mtms));
  putObject(j, "bpc1", fru(r.bpc1_fru));
  putUnits(j, "bpr1", r.bpr1_fru);
  putUnits(j, "bpd1", r.bpd1_fru);
  putObject(j, "bpc2", fru(r.bpc2_fru));
  putUnits(j, "bpr2", r.bpr2_fru);
  putUnits(j, "bpd2", r.bpd2_fru);
  return j;
}

template <typename Record>
ordered_json table(const std::vector<Record>& records) {
  ordered_json a = ordered_json::array();
  for (const Record& r : records) a.push_back(record(r));
  return a;
}

bool plain(const ordered_json& v) { return v.is_primitive(); }

// Containers of plain values fit on one line; `{"hex": ...}` texts count as plain.
bool oneLine(const ordered_json& v) {
  if (!v.is_structured()) return true;
  for (const auto& child : v) {
    bool hex_text = child.is_object() && child.size() == 1 && child.contains("hex");
    if (!plain(child) && !hex_text) return false;
  }
  return true;
}

// A plain value as JSON text, escaped as the library would escape it (texts are UTF-8 by
// now). Written by hand: going through dump() for every value made large exports slow.
void appendString(const std::string& s, std::string* out) {
  *out += '"';
  for (char c : s) {
    switch (c) {
      case '"':
        *out += "\\\"";
        break;
      case '\\':
        *out += "\\\\";
        break;
      case '\b':
        *out += "\\b";
        break;
      case '\f':
        *out += "\\f";
        break;
      case '\n':
        *out += "\\n";
        break;
      case '\r':
        *out += "\\r";
        break;
      case '\t':
        *out += "\\t";
        break;
      default:
        if (static_cast<unsigned char>(c) < 0x20) {
          char esc[8];
          std::snprintf(esc, sizeof esc, "\\u%04x", static_cast<unsigned>(c));
          *out += esc;
        } else {
          *out += c;
        }
    }
  }
  *out += '"';
}

void appendPlain(const ordered_json& v, std::string* out) {
  switch (v.type()) {
    case ordered_json::value_t::string:
      appendString(v.get_ref<const std::string&>(), out);
      break;
    case ordered_json::value_t::number_integer:
      *out += std::to_string(v.get<std::int64_t>());
      break;
    case ordered_json::value_t::number_unsigned:
      *out += std::to_string(v.get<std::uint64_t>());
      break;
    default:
      *out += v.dump(-1, ' ', false, ordered_json::error_handler_t::strict);
  }
}

void appendKey(const std::string& key, std::string* out) {
  appendString(key, out);
  *out += ": ";
}

// One line: `{"frame": 1, "cage": 2}`.
void formatInline(const ordered_json& v, std::string* out) {
  if (!v.is_structured() || v.empty()) {
    appendPlain(v, out);
    return;
  }
  bool obj = v.is_object();
  *out += obj ? "{" : "[";
  bool first = true;
  for (auto it = v.begin(); it != v.end(); ++it) {
    *out += first ? "" : ", ";
    first = false;
    if (obj) appendKey(it.key(), out);
    formatInline(*it, out);
  }
  *out += obj ? "}" : "]";
}

void format(const ordered_json& v, int indent, std::string* out) {
  if (oneLine(v)) {
    formatInline(v, out);
    return;
  }
  bool obj = v.is_object();
  std::string pad(static_cast<std::size_t>(indent + 2), ' ');
  *out += obj ? "{\n" : "[\n";
  bool first = true;
  for (auto it = v.begin(); it != v.end(); ++it) {
    *out += first ? "" : ",\n";
    first = false;
    *out += pad;
    if (obj) appendKey(it.key(), out);
    format(*it, indent + 2, out);
  }
  *out += "\n" + std::string(static_cast<std::size_t>(indent), ' ') + (obj ? "}" : "]");
}

}  // namespace

ordered_json inventoryToJson(const Inventory& inv) {
  ordered_json doc = ordered_json::object();
  doc["sma"] = table(inv.sma);
  doc["chassis"] = table(inv.chassis);
  doc["bpa"] = table(inv.bpa);
  return doc;
}

std::string formatJson(const ordered_json& doc) {
  std::string out;
  format(doc, 0, &out);
  out += "\n";
  return out;
}

namespace {

// One table of the document, record by record, laid out as format() lays out the whole.
template <typename Record>
void appendTable(const char* key, const std::vector<Record>& records, std::string* out) {
  *out += "  ";
  appendKey(key, out);
  if (records.empty()) {
    *out += "[]";
    return;
  }
  *out += "[\n";
  for (std::size_t i = 0; i < records.size(); ++i) {
    *out += i ? ",\n    " : "    ";
    format(record(records[i]), 4, out);
  }
  *out += "\n  ]";
}

}  // namespace

std::string inventoryText(const Inventory& inv) {
  std::string out = "{\n";
  appendTable("sma", inv.sma, &out);
  out += ",\n";
  appendTable("chassis", inv.chassis, &out);
  out += ",\n";
  appendTable("bpa", inv.bpa, &out);
  out += "\n}\n";
  return out;
}

}  // namespace vpdload
