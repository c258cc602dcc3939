// The inventory's JSON form: checking it and turning it into records, and back.
//
// {"sma":     [ {"loc": LOC, "fru": FRU, "cec": MTMS, "neighbor": LOC, "timestamp": TEXT} ],
//  "chassis": [ {"loc": LOC, "mtms": MTMS, "fru": FRU, "dca1": FRU, "dca2": FRU,
//                "risers": [ {"slot": 0-15, "fru": FRU, "nbr1": LOC, "port1": INT32,
//                             "nbr2": LOC, "port2": INT32} ],
//                "timestamp": TEXT} ],
//  "bpa":     [ {"loc": LOC, "timestamp": TEXT, "mtms": MTMS, "bpc1": FRU,
//                "bpr1": [FRU x 0-3], "bpd1": [FRU x 0-3], "bpc2": FRU, "bpr2": [...],
//                "bpd2": [...]} ]}
// LOC  = {"frame": 0-4095, "cage": 0-255, "chip": 0-15, "type": NAME or 0-15, "plane": 0-1,
//         "network": 0-7}
// MTMS = {"tm": TEXT <= 8, "se": TEXT <= 7}
// FRU  = {"ds": <= 30, "pn", "ec", "fn", "sn": <= 12, "cc": <= 4, "yl": <= 15}
// TEXT = a JSON string, or {"hex": "..."} for bytes that are not UTF-8; lengths in bytes.
//
// Every member may be left out (empty text, zero number, empty FRU). A record's own
// loc.type is its table's type (SMA, CHASSIS, BPA) or left out; neighbours may be any type.
// Unknown keys, a key given twice, a riser slot given twice and a location given twice in
// one table (which would make one record silently replace another) are errors.
#ifndef TOOLS_VPDLOAD_INVENTORY_SCHEMA_H_
#define TOOLS_VPDLOAD_INVENTORY_SCHEMA_H_

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "inventory.h"

namespace vpdload {

// What is wrong with an inventory: each entry names the value and the fault, e.g.
// `chassis[3].dca1.pn: 13 characters, at most 12`.
struct Problems {
  static constexpr std::size_t kMaxKept = 20;  // entries kept in `list`
  std::vector<std::string> list;
  std::size_t total = 0;  // every problem found, kept or not

  bool empty() const { return total == 0; }
  void add(std::string text);
};

// Checks the whole JSON text of an inventory and fills `inv` with its records in array
// order. On any problem `inv` is left in an unspecified state and must not be stored.
Problems parseInventory(const std::string& text, Inventory* inv);

// The inventory that parseInventory turns back into exactly these records: texts up to
// their first NUL, empty members left out, texts that are not UTF-8 as {"hex": ...}.
nlohmann::ordered_json inventoryToJson(const Inventory& inv);

// The JSON text written by export: two-space indentation, objects and arrays of plain
// values on one line, a final newline.
std::string formatJson(const nlohmann::ordered_json& doc);

// formatJson(inventoryToJson(inv)), built one record at a time: a large export never holds
// the whole document as JSON values.
std::string inventoryText(const Inventory& inv);

// Names of the device types 0 to 7 (NSB ... RISER); "" for a number without a name.
const char* typeName(unsigned type);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_INVENTORY_SCHEMA_H_
