// From JSON to records: the records and tables of an inventory, built from the fields that
// FieldReader reads.
#include <cstdint>
#include <map>
#include <type_traits>

#include "field_reader.h"
#include "inventory_schema.h"
#include "json_input.h"
#include "vpd_types.h"

namespace vpdload {

using nlohmann::json;

void Problems::add(std::string text) {
  ++total;
  if (list.size() < kMaxKept) list.push_back(std::move(text));
}

namespace {

const char* const kTypeNames[] = {"NSB", "SMA", "ISB", "BPA", "DCA", "CHASSIS", "BOARD", "RISER"};
constexpr IntRange kSlot{0, chassisVPD::kRiserSlots - 1, 4, "a riser slot"};

// The records of the three tables. Each record() returns true when the record's own location
// could be read, so that it can take part in the check for a location given twice.
class RecordReader : public FieldReader {
 public:
  explicit RecordReader(Problems* problems, Inventory* inv) : FieldReader(problems), inv_(inv) {}

  // One element of a table's array, as it is read.
  void element(const std::string& table, std::size_t index, const json& v) {
    if (table == "sma") {
      readRecord(v, "sma", index, &inv_->sma, &sma_seen_);
    } else if (table == "chassis") {
      readRecord(v, "chassis", index, &inv_->chassis, &chassis_seen_);
    } else if (table == "bpa") {
      readRecord(v, "bpa", index, &inv_->bpa, &bpa_seen_);
    }
  }

  // The document's frame, once every element has been read: its members and their kinds.
  void frame(const json& doc) {
    if (!object(doc, "", {"sma", "chassis", "bpa"})) return;
    for (const char* name : {"sma", "chassis", "bpa"}) {
      const json* table = member(doc, name);
      if (table != nullptr && !table->is_array()) problem(name, "expected an array");
    }
  }

 private:
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
    bool ok = true;  // a neighbour's problems are reported; nothing else depends on them
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
    bool ok = true;  // as for riser neighbours
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

  // Storage keys already read, with the index of the record that had each first.
  using Seen = std::map<std::uint32_t, std::size_t>;

  template <typename Record>
  void readRecord(const json& v, const char* name, std::size_t i, std::vector<Record>* out,
                  Seen* first) {
    std::string path = indexPath(name, i);
    out->emplace_back();
    if (!record(v, path, &out->back())) return;
    loc_id_t loc = out->back().loc_id;
    const bool with_chip = std::is_same<Record, smaVPD>::value;
    auto seen = first->emplace(storageKey(loc, with_chip), i);
    if (seen.second) return;
    std::string where =
        "frame " + std::to_string(loc.getFrame()) + ", cage " + std::to_string(loc.getCage());
    if (with_chip) where += ", chip " + std::to_string(loc.getChip());
    problem(keyPath(path, "loc"),
            where + " again (first at " + indexPath(name, seen.first->second) + ")");
  }

  Inventory* inv_;
  Seen sma_seen_, chassis_seen_, bpa_seen_;
};

}  // namespace

const char* typeName(unsigned type) { return type < 8 ? kTypeNames[type] : ""; }

// The records are read as the parser meets them, so that a large inventory is never held
// whole as JSON values.
Problems parseInventory(const std::string& text, Inventory* inv) {
  Problems problems;
  *inv = Inventory();
  RecordReader reader(&problems, inv);
  json frame;
  std::string error;
  bool parsed =
      parseJson(text, &frame, &error,
                [&reader](const std::string& table, std::size_t index, const json& element) {
                  reader.element(table, index, element);
                });
  if (!parsed) {
    Problems malformed;  // what the records had wrong before the fault no longer matters
    malformed.add(error);
    return malformed;
  }
  // The document's own faults come first, as they are the ones to mend first.
  Problems all;
  RecordReader(&all, inv).frame(frame);
  for (std::string& p : problems.list) all.add(std::move(p));
  all.total += problems.total - problems.list.size();
  return all;
}

}  // namespace vpdload
