// Arbitrary bytes as the three table files: every lookup (checked against a plain scan of
// the same bytes), the SMA table's time, the dump of each table and the network VPD writers
// over the records found.
//
// Input: a 43-byte header, then the table bytes.
//   u8   flags: bit 7 set makes the tables of bits 0-2 (chassis, BPA, SMA) missing; bit 6
//        adds the network VPD writers; the whole byte is also handed to showVPD as a table
//        number
//   u32  chassis length, u32 BPA length (each modulo what is left); the SMA table is the rest
//   u32  frame, u32 cage, u32 adapter, u32 network: the lookups' arguments
//   17   an mtms image, the argument of the MTMS lookups
//   u8   which table (modulo 3) and record lend their location and MTMS to a second round
//        of lookups
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <list>
#include <string>

#include "bpa_netvpd.h"
#include "fuzz_check.h"
#include "fuzz_input.h"
#include "memory_tables.h"
#include "output_stream.h"
#include "switch_netvpd.h"
#include "vpdDB.h"

namespace {

using fuzzsupport::FuzzInput;

// The records of one table as a plain scan sees them: whole records only, in file order.
template <class Record>
struct Model {
  explicit Model(const std::string& b) : bytes(b) {}
  const std::string& bytes;
  std::size_t count() const { return bytes.size() / sizeof(Record); }
  Record at(std::size_t i) const {
    Record r;
    std::memcpy(static_cast<void*>(&r), bytes.data() + i * sizeof(Record), sizeof(Record));
    return r;
  }
};

template <class T>
bool sameBytes(const T& a, const T& b) {
  return std::memcmp(static_cast<const void*>(&a), static_cast<const void*>(&b), sizeof(T)) == 0;
}

struct Args {
  unsigned frame, cage, adapter, network;
  mtms key;
};

bool adapterHas(unsigned adapter, unsigned chip) {
  if (adapter == 1) return chip == 0 || chip == 1 || chip == 4 || chip == 5;
  if (adapter == 2) return chip == 2 || chip == 3 || chip == 6 || chip == 7;
  return false;
}

bool atFrameCage(loc_id_t l, unsigned frame, unsigned cage) {
  return l.getFrame() == frame && l.getCage() == cage;
}

// A list lookup appends copies of exactly the selected records, in order, after what the
// list held, and returns 0 when it selected any.
template <class Record, class Select>
void checkList(int rc, const std::list<Record>& got, const Record& sentinel,
               const Model<Record>& model, Select select) {
  auto it = got.begin();
  FUZZ_CHECK(it != got.end() && sameBytes(*it, sentinel));
  ++it;
  std::size_t selected = 0;
  for (std::size_t i = 0; i < model.count(); ++i) {
    Record r = model.at(i);
    if (!select(r)) continue;
    FUZZ_CHECK(it != got.end() && sameBytes(*it, r));
    ++it;
    ++selected;
  }
  FUZZ_CHECK(it == got.end());
  FUZZ_CHECK(rc == (selected > 0 ? 0 : 4));
}

// A single lookup assigns the first selected record (with the record's own assignment) and
// returns 0, or leaves the out-parameter alone and returns 4.
template <class Record, class Select>
void checkSingle(int rc, const Record& before, const Record& got, const Model<Record>& model,
                 Select select) {
  for (std::size_t i = 0; i < model.count(); ++i) {
    Record r = model.at(i);
    if (!select(r)) continue;
    Record expected = before;
    expected = r;
    FUZZ_CHECK(rc == 0 && sameBytes(got, expected));
    return;
  }
  FUZZ_CHECK(rc == 4 && sameBytes(got, before));
}

// A record to start an out-parameter from, with every byte set so that a lookup's writes show.
template <class Record>
Record patterned() {
  Record r;
  std::memset(static_cast<void*>(&r), 0xA5, sizeof r);
  return r;
}

void runLookups(vpdDB& db, const Args& a, const Model<chassisVPD>& chassis,
                const Model<bpaVPD>& bpa, const Model<smaVPD>& sma) {
  {
    std::list<smaVPD> got(1);
    int rc = db.getSMAvpd(a.frame, a.cage, a.adapter, got);
    checkList(rc, got, smaVPD(), sma, [&](const smaVPD& r) {
      return atFrameCage(r.loc_id, a.frame, a.cage) && adapterHas(a.adapter, r.loc_id.getChip());
    });
  }
  {
    bpaVPD before = patterned<bpaVPD>(), got = before;
    int rc = db.getBPAvpd(a.frame, a.cage, got);
    checkSingle(rc, before, got, bpa,
                [&](const bpaVPD& r) { return atFrameCage(r.loc_id, a.frame, a.cage); });
  }
  {
    chassisVPD before = patterned<chassisVPD>(), got = before;
    int rc = db.getSwitchvpd(a.frame, a.cage, got);
    checkSingle(rc, before, got, chassis,
                [&](const chassisVPD& r) { return atFrameCage(r.loc_id, a.frame, a.cage); });
  }
  {
    std::list<chassisVPD> got(1);
    int rc = db.getSwitchvpd(a.frame, got);
    checkList(rc, got, chassisVPD(), chassis,
              [&](const chassisVPD& r) { return r.loc_id.getFrame() == a.frame; });
  }
  {
    std::list<bpaVPD> got(1);
    int rc = db.getBPAvpdNW(a.network, got);
    checkList(rc, got, bpaVPD(), bpa,
              [&](const bpaVPD& r) { return r.loc_id.getNetwork() == a.network; });
  }
  {
    std::list<chassisVPD> got(1);
    int rc = db.getSwitchvpdNW(a.network, got);
    checkList(rc, got, chassisVPD(), chassis,
              [&](const chassisVPD& r) { return r.loc_id.getNetwork() == a.network; });
  }
  {
    bpaVPD before = patterned<bpaVPD>(), got = before;
    int rc = db.getBPAvpd(a.key, got);
    checkSingle(rc, before, got, bpa, [&](const bpaVPD& r) { return r.frame_mtms == a.key; });
  }
  {
    chassisVPD before = patterned<chassisVPD>(), got = before;
    int rc = db.getSwitchvpd(a.key, got);
    checkSingle(rc, before, got, chassis, [&](const chassisVPD& r) { return r.sw_mtms == a.key; });
  }
  {
    std::list<mtms> got(1);
    int rc = db.getSwitchmtms(a.frame, got);
    std::size_t selected = 0;
    auto it = std::next(got.begin());
    for (std::size_t i = 0; i < chassis.count(); ++i) {
      chassisVPD r = chassis.at(i);
      if (r.loc_id.getFrame() != a.frame) continue;
      FUZZ_CHECK(it != got.end() && sameBytes(*it, r.sw_mtms));
      ++it;
      ++selected;
    }
    FUZZ_CHECK(it == got.end() && rc == (selected > 0 ? 0 : 4));
  }
}

void checkCecList(vpdDB& db, const Model<smaVPD>& sma) {
  std::list<loc_id_t> ids;
  std::list<mtms> ms;
  int rc = db.getCECmtms(ids, ms);
  FUZZ_CHECK(rc == (sma.count() > 0 ? 0 : 4));
  FUZZ_CHECK(ids.size() == ms.size());
  auto id = ids.begin();
  auto m = ms.begin();
  for (std::size_t i = 0; i < sma.count(); ++i) {
    smaVPD r = sma.at(i);
    bool seen = false;
    for (std::size_t j = 0; j < i && !seen; ++j) {
      loc_id_t e = sma.at(j).loc_id;
      seen = atFrameCage(e, r.loc_id.getFrame(), r.loc_id.getCage());
    }
    if (seen) continue;
    FUZZ_CHECK(id != ids.end() && *id == r.loc_id && sameBytes(*m, r.cec_mtms));
    ++id;
    ++m;
  }
  FUZZ_CHECK(id == ids.end());
}

Args argsOf(loc_id_t l, const mtms& key, unsigned adapter) {
  return Args{l.getFrame(), l.getCage(), adapter, l.getNetwork(), key};
}

FILE* devNull() {
  static FILE* f = std::fopen("/dev/null", "w");
  return f;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  setenv("CHRONICLE_LOG", "/dev/null", 1);
  // The dump writes to standard output: send it away once for the whole run.
  std::fflush(stdout);
  if (std::freopen("/dev/null", "w", stdout) == nullptr) std::abort();
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  FuzzInput in(data, size);
  uint8_t flags = in.u8();
  uint32_t chassis_len = in.u32(), bpa_len = in.u32();
  Args given;
  given.frame = in.u32();
  given.cage = in.u32();
  given.adapter = in.u32();
  given.network = in.u32();
  std::string key = in.bytes(sizeof(mtms));
  std::memcpy(static_cast<void*>(&given.key), key.data(), key.size());
  uint8_t pick = in.u8();

  fuzzsupport::TableBytes t;
  t.chassis = in.bytes(chassis_len % (in.remaining() + 1));
  t.bpa = in.bytes(bpa_len % (in.remaining() + 1));
  t.sma = in.rest();
  if (flags & 0x80) {
    t.chassis_missing = flags & 1;
    t.bpa_missing = flags & 2;
    t.sma_missing = flags & 4;
  }
  t.mtime = static_cast<time_t>(given.frame);
  fuzzsupport::MemoryTables memory(t);

  bool opened = false;
  try {
    vpdDB db(fuzzsupport::kMemoryDataDir, 1);
    opened = true;
    Model<chassisVPD> chassis(t.chassis);
    Model<bpaVPD> bpa(t.bpa);
    Model<smaVPD> sma(t.sma);

    runLookups(db, given, chassis, bpa, sma);
    // Arguments that some record answers to: the picked record of one of the tables.
    switch (pick % 3) {
      case 0:
        if (chassis.count() > 0) {
          chassisVPD r = chassis.at(pick % chassis.count());
          runLookups(db, argsOf(r.loc_id, r.sw_mtms, 1 + (pick & 1)), chassis, bpa, sma);
        }
        break;
      case 1:
        if (bpa.count() > 0) {
          bpaVPD r = bpa.at(pick % bpa.count());
          runLookups(db, argsOf(r.loc_id, r.frame_mtms, 1 + (pick & 1)), chassis, bpa, sma);
        }
        break;
      default:
        if (sma.count() > 0) {
          smaVPD r = sma.at(pick % sma.count());
          unsigned adapter = r.loc_id.getChip() % 4 < 2 ? 1 : 2;
          runLookups(db, argsOf(r.loc_id, r.cec_mtms, adapter), chassis, bpa, sma);
        }
        break;
    }
    checkCecList(db, sma);

    long ts = -5;
    FUZZ_CHECK(db.getCECtimestamp(ts) == 0 && ts == static_cast<long>(t.mtime));

    for (int table : {int{CHASSIS_TABLE}, int{SMA_TABLE}, int{BPA_TABLE}, int{flags}}) {
      FUZZ_CHECK(db.showVPD(static_cast<table_t>(table)) == 0);
    }

    // The network VPD of the picked chassis and its frame's BPA, as a network request
    // writes them; the cable lines look their far ends up in the same tables. Half of the
    // inputs only, as it costs as much as everything above.
    dorvex::setOutStream(devNull());
    if ((flags & 0x40) && chassis.count() > 0) {
      chassisVPD sw = chassis.at(pick % chassis.count());
      bpaVPD frame_bpa;
      db.getBPAvpd(sw.loc_id.getFrame(), 255, frame_bpa);
      FUZZ_CHECK(dorvex::outputnetvpdSW(db, sw, frame_bpa) == 0);
    }
    if ((flags & 0x40) && bpa.count() > 0) {
      FUZZ_CHECK(dorvex::outputnetvpdBPA(bpa.at(pick % bpa.count())) == 0);
    }
    dorvex::setOutStream(nullptr);
  } catch (int e) {
    // Only a missing table may keep the database from opening, and it throws the int 1.
    FUZZ_CHECK(!opened && e == 1);
    FUZZ_CHECK(t.chassis_missing || t.bpa_missing || t.sma_missing);
  }
  FUZZ_CHECK(fuzzsupport::MemoryTables::openCount() == 0);
  return 0;
}
