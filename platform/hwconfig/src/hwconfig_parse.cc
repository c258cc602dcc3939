// Validation of etc/hwserver.json. Every fault is reported with its place in the document
// ("consoles[1].tm") so that an administrator can fix the file without guessing. Unknown
// keys are faults too: a misspelt "bpa_vports" would otherwise leave a console silently
// without BPAs.
#include <cstdint>
#include <initializer_list>
#include <nlohmann/json.hpp>
#include <string>

#include "hwconfig.h"

namespace hwserver {
namespace {

using nlohmann::json;

// The JSON text of a value, for messages; strings come out quoted and escaped.
std::string shown(const json& value) {
  return value.dump(-1, ' ', false, json::error_handler_t::replace);
}

std::string member(const std::string& where, const char* key) {
  return where.empty() ? std::string(key) : where + "." + key;
}

std::string element(const std::string& where, size_t index) {
  return where + "[" + std::to_string(index) + "]";
}

// Collects the first fault; every check returns false once one is found.
class Checker {
 public:
  explicit Checker(std::string name) : name_(std::move(name)) {}

  bool fail(const std::string& where, const std::string& what) {
    error_ = name_ + ": " + (where.empty() ? "" : where + ": ") + what;
    return false;
  }
  const std::string& error() const { return error_; }

  bool expectType(const json& value, json::value_t type, const char* type_name,
                  const std::string& where) {
    if (value.type() == type) return true;
    return fail(where, std::string("expected ") + type_name + ", found " + value.type_name());
  }

  // An object whose keys all come from `known`; reports the first stranger.
  bool expectObject(const json& value, std::initializer_list<const char*> known,
                    const std::string& where) {
    if (!expectType(value, json::value_t::object, "an object", where)) return false;
    for (const auto& item : value.items()) {
      bool found = false;
      for (const char* key : known) found = found || item.key() == key;
      if (!found) return fail(where, "unknown key " + shown(json(item.key())));
    }
    return true;
  }

  // A member that must be present.
  const json* required(const json& object, const char* key, const std::string& where) {
    auto it = object.find(key);
    if (it != object.end()) return &*it;
    fail(where, std::string("missing key \"") + key + "\"");
    return nullptr;
  }

  // An array member that may be absent (null result, no fault) of at most max_entries.
  bool optionalArray(const json& object, const char* key, size_t max_entries,
                     const std::string& where, const json** array) {
    *array = nullptr;
    auto it = object.find(key);
    if (it == object.end()) return true;
    std::string here = member(where, key);
    if (!expectType(*it, json::value_t::array, "an array", here)) return false;
    if (it->size() > max_entries) {
      return fail(here,
                  std::to_string(it->size()) + " entries, at most " + std::to_string(max_entries));
    }
    *array = &*it;
    return true;
  }

  bool text(const json& value, size_t max_bytes, const std::string& where, std::string* out) {
    if (!expectType(value, json::value_t::string, "a string", where)) return false;
    const std::string& s = value.get_ref<const std::string&>();
    if (s.size() > max_bytes) {
      return fail(where,
                  std::to_string(s.size()) + " characters, at most " + std::to_string(max_bytes));
    }
    // A NUL would end the value early in the padded image, and a newline or other control
    // character would break the line-based output the value ends up in.
    for (char ch : s) {
      if (static_cast<unsigned char>(ch) < 0x20 || ch == 0x7f) {
        return fail(where, "contains a control character");
      }
    }
    *out = s;
    return true;
  }

  bool vport(const json& value, const std::string& where, uint32_t* out) {
    if (!value.is_number()) {
      return fail(where, std::string("expected a number, found ") + value.type_name());
    }
    if (!value.is_number_unsigned() || value.get<uint64_t>() > UINT32_MAX) {
      return fail(where, shown(value) + " is not a whole number from 0 to 4294967295");
    }
    *out = static_cast<uint32_t>(value.get<uint64_t>());
    return true;
  }

  // Four decimal octets 0-255 separated by dots; a leading zero is refused, as inet_pton
  // does, because other tools would read "010" as octal.
  bool ip(const json& value, const std::string& where, std::array<unsigned char, 4>* out) {
    if (!expectType(value, json::value_t::string, "a string", where)) return false;
    const std::string& s = value.get_ref<const std::string&>();
    size_t pos = 0;
    for (size_t octet = 0; octet < 4; ++octet) {
      if (octet > 0) {
        if (pos >= s.size() || s[pos] != '.') return badIp(value, where);
        ++pos;
      }
      size_t start = pos;
      unsigned number = 0;
      while (pos < s.size() && s[pos] >= '0' && s[pos] <= '9' && pos - start < 3) {
        number = number * 10 + static_cast<unsigned>(s[pos] - '0');
        ++pos;
      }
      size_t digits = pos - start;
      if (digits == 0 || number > 255 || (digits > 1 && s[start] == '0')) {
        return badIp(value, where);
      }
      (*out)[octet] = static_cast<unsigned char>(number);
    }
    if (pos != s.size()) return badIp(value, where);
    return true;
  }

 private:
  bool badIp(const json& value, const std::string& where) {
    return fail(where, shown(value) + " is not a dotted quad of four decimal octets 0-255");
  }

  std::string name_;
  std::string error_;
};

bool checkConsole(Checker& c, const json& value, const std::string& where, Console* out) {
  if (!c.expectObject(value, {"ip", "tm", "se", "bpa_vports"}, where)) return false;
  const json* ip = c.required(value, "ip", where);
  if (ip == nullptr || !c.ip(*ip, member(where, "ip"), &out->ip)) return false;
  const json* tm = c.required(value, "tm", where);
  if (tm == nullptr || !c.text(*tm, kTypeModelMax, member(where, "tm"), &out->tm)) return false;
  const json* se = c.required(value, "se", where);
  if (se == nullptr || !c.text(*se, kSerialMax, member(where, "se"), &out->se)) return false;
  const json* vports = nullptr;
  if (!c.optionalArray(value, "bpa_vports", kMaxListEntries, where, &vports)) return false;
  if (vports != nullptr) {
    std::string here = member(where, "bpa_vports");
    for (size_t i = 0; i < vports->size(); ++i) {
      uint32_t v = 0;
      if (!c.vport((*vports)[i], element(here, i), &v)) return false;
      out->bpa_vports.push_back(v);
    }
  }
  return true;
}

bool checkBpa(Checker& c, const json& value, const std::string& where, Bpa* out) {
  if (!c.expectObject(value, {"vport", "tm", "se"}, where)) return false;
  const json* vport = c.required(value, "vport", where);
  if (vport == nullptr || !c.vport(*vport, member(where, "vport"), &out->vport)) return false;
  const json* tm = c.required(value, "tm", where);
  if (tm == nullptr || !c.text(*tm, kTypeModelMax, member(where, "tm"), &out->tm)) return false;
  const json* se = c.required(value, "se", where);
  return se != nullptr && c.text(*se, kSerialMax, member(where, "se"), &out->se);
}

bool checkDocument(Checker& c, const json& doc, Config* out) {
  if (!c.expectObject(doc, {"consoles", "bpas"}, "")) return false;
  const json* consoles = nullptr;
  if (!c.optionalArray(doc, "consoles", kMaxListEntries, "", &consoles)) return false;
  for (size_t i = 0; consoles != nullptr && i < consoles->size(); ++i) {
    out->consoles.emplace_back();
    if (!checkConsole(c, (*consoles)[i], element("consoles", i), &out->consoles.back())) {
      return false;
    }
  }
  const json* bpas = nullptr;
  if (!c.optionalArray(doc, "bpas", SIZE_MAX, "", &bpas)) return false;
  for (size_t i = 0; bpas != nullptr && i < bpas->size(); ++i) {
    out->bpas.emplace_back();
    if (!checkBpa(c, (*bpas)[i], element("bpas", i), &out->bpas.back())) return false;
  }
  return true;
}

}  // namespace

LoadResult parse(const std::string& text, const std::string& name) {
  LoadResult result;
  json doc;
  try {
    doc = json::parse(text);
  } catch (const json::exception& e) {
    // Drop the library's "[json.exception.parse_error.101] " tag; keep line and column.
    std::string what = e.what();
    size_t tag_end = what.find("] ");
    if (what.rfind("[json.exception.", 0) == 0 && tag_end != std::string::npos) {
      what.erase(0, tag_end + 2);
    }
    result.error = name + ": not valid JSON: " + what;
    return result;
  }
  Checker checker(name);
  if (!checkDocument(checker, doc, &result.config)) {
    result.config = Config();
    result.error = checker.error();
    return result;
  }
  result.ok = true;
  return result;
}

}  // namespace hwserver
