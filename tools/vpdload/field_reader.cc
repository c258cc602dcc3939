#include "field_reader.h"

#include <cmath>
#include <cstring>

#include "json_input.h"
#include "text_bytes.h"

namespace vpdload {

using nlohmann::json;

namespace {

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

std::string typeText(std::int64_t type) {
  return typeName(static_cast<unsigned>(type))[0] != '\0' ? typeName(static_cast<unsigned>(type))
                                                          : "type " + std::to_string(type);
}

}  // namespace

void FieldReader::problem(const std::string& path, const std::string& what) {
  problems_->add((path.empty() ? "inventory" : path) + ": " + what);
}

bool FieldReader::object(const json& v, const std::string& path,
                         std::initializer_list<const char*> keys) {
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

const json* FieldReader::member(const json& obj, const char* key) {
  auto it = obj.find(key);
  return it == obj.end() ? nullptr : &*it;
}

bool FieldReader::integer(const json& v, const std::string& path, const IntRange& r,
                          std::int64_t* out) {
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

bool FieldReader::outOfRange(const std::string& path, const std::string& value, const IntRange& r) {
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

bool FieldReader::text(const json& v, const std::string& path, std::size_t max, std::string* out) {
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
    problem(path, std::to_string(out->size()) + (ascii ? " characters" : " bytes") + ", at most " +
                      std::to_string(max));
    return false;
  }
  return true;
}

loc_id_t FieldReader::location(const json& v, const std::string& path, int table_type, bool* ok) {
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
    problem(keyPath(path, "type"), typeText(type) + ", but records of this table are " +
                                       typeName(static_cast<unsigned>(table_type)));
    *ok = false;
  }
  loc.setType(static_cast<unsigned>(type));
  return loc;
}

bool FieldReader::deviceType(const json& v, const std::string& path, std::int64_t* type) {
  if (!v.is_string()) return integer(v, path, bitField(loc_id_t::kTypeWidth), type);
  std::string name = upper(v.get<std::string>());
  for (std::int64_t i = 0; i < 8; ++i) {
    if (name == typeName(static_cast<unsigned>(i))) {
      *type = i;
      return true;
    }
  }
  problem(path, "unknown type " + quoted(v.get<std::string>()) +
                    " (names: NSB SMA ISB BPA DCA CHASSIS BOARD RISER, or a number 0 to 15)");
  return false;
}

mtms FieldReader::machine(const json& v, const std::string& path) {
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

fru_stanza FieldReader::fru(const json& v, const std::string& path) {
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

void FieldReader::timestamp(const json& record, const std::string& path,
                            char (&field)[kTimestampBytes]) {
  std::string s;
  const json* m = member(record, "timestamp");
  if (m != nullptr && text(*m, keyPath(path, "timestamp"), kTimestampBytes, &s)) {
    std::strncpy(field, s.c_str(), kTimestampBytes);
  }
}

}  // namespace vpdload
