// From JSON to records, checking every value against the field it goes into.
#include <cmath>
#include <cstdint>
#include <cstring>
#include <initializer_list>
#include <map>

#include "inventory_schema.h"
#include "json_input.h"
#include "text_bytes.h"
#include "vpd_types.h"

namespace vpdload {

using nlohmann::json;

void Problems::add(std::string text) {
  ++total;
  if (list.size() < kMaxKept) list.push_back(std::move(text));
}

namespace {

const char* const kTypeNames[] = {"NSB", "SMA", "ISB", "BPA", "DCA", "CHASSIS", "BOARD", "RISER"};

// An integer field: its range and how to name a value outside it.
struct IntRange {
  std::int64_t min;
  std::int64_t max;
  unsigned bits;               // width of the field, for the message
  const char* what = nullptr;  // when set: "16 is not <what> (0 to 15)"
};

constexpr IntRange bitField(unsigned bits) {
  return IntRange{0, (std::int64_t{1} << bits) - 1, bits};
}
constexpr IntRange kInt32{INT32_MIN, INT32_MAX, 32};
constexpr IntRange kSlot{0, chassisVPD::kRiserSlots - 1, 4, "a riser slot"};

// Keys of a FRU object, the significant bytes of each field and the setter.
struct FruField {
  const char* key;
  std::size_t chars;
  void (fru_stanza::*set)(const char*, int);
};
const FruField kFruFields[] = {
    {"ds", fru_stanza::kDsChars, &fru_stanza::setDS},
    {"pn", fru_stanza::kPnChars, &fru_stanza::setPN},
    {"ec", fru_stanza::kEcChars, &fru_stanza::setEC},
    {"fn", fru_stanza::kFnChars, &fru_stanza::setFN},
    {"sn", fru_stanza::kSnChars, &fru_stanza::setSN},
    {"cc", fru_stanza::kCcChars, &fru_stanza::setCC},
    {"yl", fru_stanza::kYlChars, &fru_stanza::setYL},
};

std::string upper(std::string s) {
  for (char& c : s) {
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
  }
  return s;
}

class Reader {
 public:
  explicit Reader(Problems* problems) : problems_(problems) {}

  void document(const json& doc, Inventory* inv) {
    if (!object(doc, "", {"sma", "chassis", "bpa"})) return;
    readTable(doc, "sma", SMA, &inv->sma);
    readTable(doc, "chassis", CHASSIS, &inv->chassis);
    readTable(doc, "bpa", BPA, &inv->bpa);
  }

 private:
  void problem(const std::string& path, const std::string& what) {
    problems_->add((path.empty() ? "inventory" : path) + ": " + what);
  }

  // Reports a value that is not an object, and every key not in `keys`; true when `v` is an
  // object, so that its known members can still be checked.
  bool object(const json& v, const std::string& path, std::initializer_list<const char*> keys) {
    if (!v.is_object()) {
      problem(path, "expected an object");
      return false;
    }
    for (auto it = v.begin(); it != v.end(); ++it) {
      bool known = false;
      for (const char* k : keys) known = known || it.key() == k;
      if (known) continue;
      std::string expected;
      for (const char* k : keys) expected += (expected.empty() ? "" : ", ") + std::string(k);
      problem(keyPath(path, it.key()), "unknown key; expected one of " + expected);
    }
    return true;
  }

  static const json* member(const json& obj, const char* key) {
    auto it = obj.find(key);
    return it == obj.end() ? nullptr : &*it;
  }

  bool integer(const json& v, const std::string& path, const IntRange& r, std::int64_t* out) {
    std::int64_t x;
    if (v.is_number_unsigned()) {
      std::uint64_t u = v.get<std::uint64_t>();
      if (u > static_cast<std::uint64_t>(r.max)) return outOfRange(path, std::to_string(u), r);
      x = static_cast<std::int64_t>(u);
    } else if (v.is_number_integer()) {
      x = v.get<std::int64_t>();
    } else if (v.is_number_float()) {
      double d = v.get<double>();
      if (std::isfinite(d) && std::floor(d) == d && std::fabs(d) >= 9.2e18) {
        return outOfRange(path, v.dump(), r);  // an integer too long for any field
      }
      problem(path, "expected an integer, not " + v.dump());
      return false;
    } else {
      problem(path, "expected an integer");
      return false;
    }
    if (x < r.min || x > r.max) return outOfRange(path, std::to_string(x), r);
    *out = x;
    return true;
  }

  bool outOfRange(const std::string& path, const std::string& value, const IntRange& r) {
    if (r.what != nullptr) {
      problem(path, value + " is not " + r.what + " (" + std::to_string(r.min) + " to " +
                        std::to_string(r.max) + ")");
    } else if (value[0] == '-' && r.min == 0) {
      problem(path, value + " is negative, at least 0");
    } else {
      bool low = value[0] == '-';
      problem(path,
              value + " does not fit " + std::to_string(r.bits) +
                  (r.bits == 1 ? " bit, " : " bits, ") +
                  (low ? "at least " + std::to_string(r.min) : "at most " + std::to_string(r.max)));
    }
    return false;
  }

  // A text of at most `max` bytes, as a JSON string or {"hex": "..."}.
  bool text(const json& v, const std::string& path, std::size_t max, std::string* out) {
    bool plain = v.is_string();
    if (plain) {
      *out = v.get<std::string>();
    } else if (v.is_object() && v.contains("hex")) {
      if (!object(v, path, {"hex"})) return false;
      const json& hex = v["hex"];
      std::string why;
      if (!hex.is_string()) {
        problem(keyPath(path, "hex"), "expected a string of hex digits");
        return false;
      }
      if (!fromHex(hex.get<std::string>(), out, &why)) {
        problem(keyPath(path, "hex"), why);
        return false;
      }
    } else {
      problem(path, "expected a string or a {\"hex\": \"...\"} object");
      return false;
    }
    if (out->find('\0') != std::string::npos) {
      problem(path, "contains a NUL character, which would end the text");
      return false;
    }
    if (out->size() > max) {
      bool ascii = plain;
      for (unsigned char c : *out) ascii = ascii && c < 0x80;
      problem(path, std::to_string(out->size()) + (ascii ? " characters" : " bytes") +
                        ", at most " + std::to_string(max));
      return false;
    }
    return true;
  }

  // A location. `table_type` is the type a record's own location must have, or -1 for a
  // neighbour, which may be of any type.
  loc_id_t location(const json& v, const std::string& path, int table_type, bool* ok) {
    loc_id_t loc(0);
    if (!object(v, path, {"frame", "cage", "chip", "type", "plane", "network"})) {
      *ok = false;
      return loc;
    }
    struct Part {
      const char* key;
      unsigned bits;
      void (loc_id_t::*set)(unsigned);
    };
    static const Part kParts[] = {
        {"frame", loc_id_t::kFrameWidth, &loc_id_t::setFrame},
        {"cage", loc_id_t::kUidWidth, &loc_id_t::setCage},
        {"chip", loc_id_t::kChipWidth, &loc_id_t::setChip},
        {"plane", loc_id_t::kPlaneWidth, &loc_id_t::setPlane},
        {"network", loc_id_t::kNetworkWidth, &loc_id_t::setNetwork},
    };
    for (const Part& p : kParts) {
      std::int64_t x = 0;
      const json* m = member(v, p.key);
      if (m == nullptr) continue;
      if (integer(*m, keyPath(path, p.key), bitField(p.bits), &x)) {
        (loc.*p.set)(static_cast<unsigned>(x));
      } else {
        *ok = false;
      }
    }
    const json* t = member(v, "type");
    std::int64_t type = table_type < 0 ? 0 : table_type;
    if (t != nullptr && !deviceType(*t, keyPath(path, "type"), &type)) {
      *ok = false;
    } else if (t != nullptr && table_type >= 0 && type != table_type) {
      problem(keyPath(path, "type"),
              typeText(type) + ", but records of this table are " + kTypeNames[table_type]);
      *ok = false;
    }
    loc.setType(static_cast<unsigned>(type));
    return loc;
  }

  static std::string typeText(std::int64_t type) {
    return typeName(static_cast<unsigned>(type))[0] != '\0' ? typeName(static_cast<unsigned>(type))
                                                            : "type " + std::to_string(type);
  }

  bool deviceType(const json& v, const std::string& path, std::int64_t* type) {
    if (!v.is_string()) return integer(v, path, bitField(loc_id_t::kTypeWidth), type);
    std::string name = upper(v.get<std::string>());
    for (std::int64_t i = 0; i < 8; ++i) {
      if (name == kTypeNames[i]) {
        *type = i;
        return true;
      }
    }
    problem(path, "unknown type " + quoted(v.get<std::string>()) +
                      " (names: NSB SMA ISB BPA DCA CHASSIS BOARD RISER, or a number 0 to 15)");
    return false;
  }

  mtms machine(const json& v, const std::string& path) {
    mtms m;
    if (!object(v, path, {"tm", "se"})) return m;
    std::string s;
    if (const json* tm = member(v, "tm")) {
      if (text(*tm, keyPath(path, "tm"), mtms::kTmChars, &s)) m.setTM(s.c_str(), mtms::kTmChars);
    }
    if (const json* se = member(v, "se")) {
      if (text(*se, keyPath(path, "se"), mtms::kSeChars, &s)) m.setSE(s.c_str(), mtms::kSeChars);
    }
    return m;
  }

  fru_stanza fru(const json& v, const std::string& path) {
    fru_stanza f;
    if (!object(v, path, {"ds", "pn", "ec", "fn", "sn", "cc", "yl"})) return f;
    for (const FruField& field : kFruFields) {
      const json* m = member(v, field.key);
      std::string s;
      if (m != nullptr && text(*m, keyPath(path, field.key), field.chars, &s)) {
        (f.*field.set)(s.c_str(), static_cast<int>(field.chars));
      }
    }
    return f;
  }

  void timestamp(const json& record, const std::string& path, char (&field)[kTimestampBytes]) {
    std::string s;
    const json* m = member(record, "timestamp");
    if (m != nullptr && text(*m, keyPath(path, "timestamp"), kTimestampBytes, &s)) {
      std::strncpy(field, s.c_str(), kTimestampBytes);
    }
  }

  // Up to three FRUs of one kind of a BPA side.
  void fruArray(const json& record, const std::string& path, const char* key,
                fru_stanza (&out)[bpaVPD::kUnitsPerKind]) {
    const json* m = member(record, key);
    if (m == nullptr) return;
    std::string p = keyPath(path, key);
    if (!m->is_array()) {
      problem(p, "expected an array");
      return;
    }
    if (m->size() > static_cast<std::size_t>(bpaVPD::kUnitsPerKind)) {
      problem(p, std::to_string(m->size()) + " entries, at most " +
                     std::to_string(bpaVPD::kUnitsPerKind));
      return;
    }
    for (std::size_t i = 0; i < m->size(); ++i) out[i] = fru((*m)[i], indexPath(p, i));
  }

  void riser(const json& v, const std::string& path, chassisVPD* rec,
             std::map<std::int64_t, std::string>* slots) {
    if (!object(v, path, {"slot", "fru", "nbr1", "port1", "nbr2", "port2"})) return;
    const json* s = member(v, "slot");
    std::int64_t slot = 0;
    if (s == nullptr) {
      problem(path, "no \"slot\": every riser names its slot, 0 to 15");
      return;
    }
    if (!integer(*s, keyPath(path, "slot"), kSlot, &slot)) return;
    auto seen = slots->emplace(slot, path);
    if (!seen.second) {
      problem(keyPath(path, "slot"),
              "slot " + std::to_string(slot) + " again (first at " + seen.first->second + ")");
      return;
    }
    riser_vpd_t& r = rec->riser[slot];
    bool ok = true;
    std::int64_t port = 0;
    if (const json* m = member(v, "fru")) r.riser_fru = fru(*m, keyPath(path, "fru"));
    if (const json* m = member(v, "nbr1")) r.nbr1 = location(*m, keyPath(path, "nbr1"), -1, &ok);
    if (const json* m = member(v, "nbr2")) r.nbr2 = location(*m, keyPath(path, "nbr2"), -1, &ok);
    if (const json* m = member(v, "port1");
        m && integer(*m, keyPath(path, "port1"), kInt32, &port)) {
      r.port1 = static_cast<int>(port);
    }
    if (const json* m = member(v, "port2");
        m && integer(*m, keyPath(path, "port2"), kInt32, &port)) {
      r.port2 = static_cast<int>(port);
    }
  }

  bool record(const json& v, const std::string& path, smaVPD* rec) {
    if (!object(v, path, {"loc", "fru", "cec", "neighbor", "timestamp"})) return false;
    bool loc_ok = true;
    rec->loc_id =
        location(member(v, "loc") ? v["loc"] : json::object(), keyPath(path, "loc"), SMA, &loc_ok);
    if (const json* m = member(v, "fru")) rec->sma_fru = fru(*m, keyPath(path, "fru"));
    if (const json* m = member(v, "cec")) rec->cec_mtms = machine(*m, keyPath(path, "cec"));
    bool ok = true;
    if (const json* m = member(v, "neighbor")) {
      rec->neighbor_id = location(*m, keyPath(path, "neighbor"), -1, &ok);
    }
    timestamp(v, path, rec->timestamp);
    return loc_ok;
  }

  bool record(const json& v, const std::string& path, chassisVPD* rec) {
    if (!object(v, path, {"loc", "mtms", "fru", "dca1", "dca2", "risers", "timestamp"})) {
      return false;
    }
    bool loc_ok = true;
    rec->loc_id = location(member(v, "loc") ? v["loc"] : json::object(), keyPath(path, "loc"),
                           CHASSIS, &loc_ok);
    if (const json* m = member(v, "mtms")) rec->sw_mtms = machine(*m, keyPath(path, "mtms"));
    if (const json* m = member(v, "fru")) rec->sw_fru = fru(*m, keyPath(path, "fru"));
    if (const json* m = member(v, "dca1")) rec->dca1_fru = fru(*m, keyPath(path, "dca1"));
    if (const json* m = member(v, "dca2")) rec->dca2_fru = fru(*m, keyPath(path, "dca2"));
    if (const json* m = member(v, "risers")) {
      std::string p = keyPath(path, "risers");
      std::map<std::int64_t, std::string> slots;
      if (!m->is_array()) problem(p, "expected an array");
      for (std::size_t i = 0; m->is_array() && i < m->size(); ++i) {
        riser((*m)[i], indexPath(p, i), rec, &slots);
      }
    }
    timestamp(v, path, rec->timestamp);
    return loc_ok;
  }

  bool record(const json& v, const std::string& path, bpaVPD* rec) {
    if (!object(v, path,
                {"loc", "timestamp", "mtms", "bpc1", "bpr1", "bpd1", "bpc2", "bpr2", "bpd2"})) {
      return false;
    }
    bool loc_ok = true;
    rec->loc_id =
        location(member(v, "loc") ? v["loc"] : json::object(), keyPath(path, "loc"), BPA, &loc_ok);
    timestamp(v, path, rec->timestamp);
    if (const json* m = member(v, "mtms")) rec->frame_mtms = machine(*m, keyPath(path, "mtms"));
    if (const json* m = member(v, "bpc1")) rec->bpc1_fru = fru(*m, keyPath(path, "bpc1"));
    fruArray(v, path, "bpr1", rec->bpr1_fru);
    fruArray(v, path, "bpd1", rec->bpd1_fru);
    if (const json* m = member(v, "bpc2")) rec->bpc2_fru = fru(*m, keyPath(path, "bpc2"));
    fruArray(v, path, "bpr2", rec->bpr2_fru);
    fruArray(v, path, "bpd2", rec->bpd2_fru);
    return loc_ok;
  }

  // The part of a location that identifies a stored record: a second record with the same
  // key would replace the first one in place.
  static std::uint32_t storageKey(loc_id_t loc, bool with_chip) {
    return loc_id_t(loc.getFrame(), loc.getCage(), with_chip ? loc.getChip() : 0, 0, 0, 0).toInt();
  }

  template <typename Record>
  void readTable(const json& doc, const char* name, int type, std::vector<Record>* out) {
    const json* table = member(doc, name);
    if (table == nullptr) return;
    if (!table->is_array()) {
      problem(name, "expected an array");
      return;
    }
    bool with_chip = type == SMA;
    std::map<std::uint32_t, std::size_t> first;
    out->reserve(table->size());
    for (std::size_t i = 0; i < table->size(); ++i) {
      std::string path = indexPath(name, i);
      out->emplace_back();
      if (!record((*table)[i], path, &out->back())) continue;
      loc_id_t loc = out->back().loc_id;
      auto seen = first.emplace(storageKey(loc, with_chip), i);
      if (seen.second) continue;
      std::string where =
          "frame " + std::to_string(loc.getFrame()) + ", cage " + std::to_string(loc.getCage());
      if (with_chip) where += ", chip " + std::to_string(loc.getChip());
      problem(keyPath(path, "loc"),
              where + " again (first at " + indexPath(name, seen.first->second) + ")");
    }
  }

  Problems* problems_;
};

}  // namespace

const char* typeName(unsigned type) { return type < 8 ? kTypeNames[type] : ""; }

Problems readInventory(const json& doc, Inventory* inv) {
  Problems problems;
  *inv = Inventory();
  Reader(&problems).document(doc, inv);
  return problems;
}

Problems parseInventory(const std::string& text, Inventory* inv) {
  json doc;
  std::string error;
  if (!parseJson(text, &doc, &error)) {
    Problems problems;
    problems.add(error);
    return problems;
  }
  return readInventory(doc, inv);
}

}  // namespace vpdload
