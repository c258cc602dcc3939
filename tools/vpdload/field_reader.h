// Reading one value of an inventory into the field it goes into, reporting every value that
// does not fit under its path (`chassis[3].dca1.pn`).
#ifndef TOOLS_VPDLOAD_FIELD_READER_H_
#define TOOLS_VPDLOAD_FIELD_READER_H_

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <nlohmann/json.hpp>
#include <string>

#include "inventory_schema.h"
#include "vpd_records.h"

namespace vpdload {

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

// Each reader returns what it could read; a value that does not fit is reported to the
// Problems and leaves its field empty or zero. The caller must not store anything once a
// problem was reported.
class FieldReader {
 public:
  explicit FieldReader(Problems* problems) : problems_(problems) {}

  // Adds "<path>: <what>"; an empty path names the whole inventory.
  void problem(const std::string& path, const std::string& what);

  // Reports a value that is not an object, and every key not in `keys`; true when `v` is an
  // object, so that its known members can still be checked.
  bool object(const nlohmann::json& v, const std::string& path,
              std::initializer_list<const char*> keys);
  // The member `key` of an object, or null when it is absent.
  static const nlohmann::json* member(const nlohmann::json& obj, const char* key);

  // An integer within `r`; false (reported) for any other value.
  bool integer(const nlohmann::json& v, const std::string& path, const IntRange& r,
               std::int64_t* out);
  // A text of at most `max` bytes, as a JSON string or {"hex": "..."}, without NUL.
  bool text(const nlohmann::json& v, const std::string& path, std::size_t max, std::string* out);
  // A location. `table_type` is the type a record's own location must have (filled in when
  // absent), or -1 for a neighbour, which may be of any type. Clears *ok on a problem.
  loc_id_t location(const nlohmann::json& v, const std::string& path, int table_type, bool* ok);
  mtms machine(const nlohmann::json& v, const std::string& path);
  fru_stanza fru(const nlohmann::json& v, const std::string& path);
  // The member "timestamp" of a record, when present.
  void timestamp(const nlohmann::json& record, const std::string& path,
                 char (&field)[kTimestampBytes]);

 private:
  bool outOfRange(const std::string& path, const std::string& value, const IntRange& r);
  bool deviceType(const nlohmann::json& v, const std::string& path, std::int64_t* type);

  Problems* problems_;
};

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_FIELD_READER_H_
