// The indexed lookups against a plain scan of the same bytes: generated tables with
// duplicate keys, empty records and a partial trailing record.
#include <cstring>
#include <random>

#include "table_io.h"
#include "table_snapshot.h"
#include "vpd_test_util.h"

namespace {

using vpdtest::bytesOf;

// The plain reference: every whole record in file order.
template <class Record>
std::vector<Record> wholeRecords(const std::string& bytes) {
  std::vector<Record> out;
  for (std::size_t off = 0; off + sizeof(Record) <= bytes.size(); off += sizeof(Record)) {
    Record r;
    std::memcpy(static_cast<void*>(&r), bytes.data() + off, sizeof r);
    out.push_back(r);
  }
  return out;
}

template <class Record>
std::string generate(std::mt19937& rng, int count, unsigned type) {
  std::string bytes;
  std::uniform_int_distribution<unsigned> small(0, 3), chip(0, 15), net(0, 7), pick(0, 9);
  const char* tms[] = {"TM-A", "TM-B", "TM-C"};
  for (int i = 0; i < count; ++i) {
    Record r;
    if (pick(rng) != 0) {  // one record in ten stays all zero: a hole
      // Half the records continue the previous one's frame and cage, as a producer stores
      // a device's records together; the others land anywhere, so keys recur apart.
      unsigned frame = small(rng), cage = small(rng);
      if (pick(rng) < 5 && i > 0) {
        loc_id_t prev;
        std::memcpy(static_cast<void*>(&prev), bytes.data() + bytes.size() - sizeof(Record),
                    sizeof prev);
        frame = prev.getFrame();
        cage = prev.getCage();
      }
      r.loc_id = loc_id_t(frame, cage, chip(rng), type, small(rng) & 1, net(rng));
      mtms m(tms[small(rng) % 3], std::to_string(small(rng)).c_str());
      std::memcpy(reinterpret_cast<char*>(&r) + (type == SMA   ? 108
                                                 : type == BPA ? 32
                                                               : 4),
                  &m, sizeof m);
      std::string ts = "rec" + std::to_string(i);
      r.setTimestamp(ts.c_str());
    }
    bytes += bytesOf(r);
  }
  return bytes + std::string(sizeof(Record) / 2, 'p');  // partial trailing record
}

std::string key(const smaVPD& r) { return std::string(r.timestamp, 28); }
std::string key(const chassisVPD& r) { return std::string(r.timestamp, 28); }
std::string key(const bpaVPD& r) { return std::string(r.timestamp, 28); }
template <class T>
std::vector<std::string> keys(const std::list<T>& l) {
  std::vector<std::string> out;
  for (const T& e : l) out.push_back(key(e));
  return out;
}

void* noMap(int, size_t) { return nullptr; }
bool offered() { return true; }

// The ways a table gets into memory; all must give the same answers.
enum class Snapshot { kMapped, kReadWhereMappingFails, kCopiedIntoHugePages };

class IndexModelTest : public vpdtest::VpdTest, public ::testing::WithParamInterface<Snapshot> {
 protected:
  void SetUp() override {
    vpdtest::VpdTest::SetUp();
    saved_ops_ = vpd::fileOps();
    saved_policy_ = vpd::snapshotPolicy();
    vpd::snapshotPolicy().copy_from_bytes = SIZE_MAX;
    if (GetParam() == Snapshot::kReadWhereMappingFails) vpd::fileOps().map = noMap;
    if (GetParam() == Snapshot::kCopiedIntoHugePages) {
      vpd::snapshotPolicy().copy_from_bytes = 0;
      vpd::snapshotPolicy().huge_pages_offered = offered;
    }
  }
  void TearDown() override {
    vpd::fileOps() = saved_ops_;
    vpd::snapshotPolicy() = saved_policy_;
    vpdtest::VpdTest::TearDown();
  }
  vpd::FileOps saved_ops_;
  vpd::SnapshotPolicy saved_policy_;
};

INSTANTIATE_TEST_SUITE_P(EveryWayIn, IndexModelTest,
                         ::testing::Values(Snapshot::kMapped, Snapshot::kReadWhereMappingFails,
                                           Snapshot::kCopiedIntoHugePages));

TEST_P(IndexModelTest, IndexedLookupsAgreeWithAPlainScan) {
  for (unsigned seed = 1; seed <= 6; ++seed) {
    std::mt19937 rng(seed);
    std::string sma = generate<smaVPD>(rng, 200, SMA);
    std::string chassis = generate<chassisVPD>(rng, 60, CHASSIS);
    std::string bpa = generate<bpaVPD>(rng, 60, BPA);
    writeTables(chassis, bpa, sma);
    auto S = wholeRecords<smaVPD>(sma);
    auto C = wholeRecords<chassisVPD>(chassis);
    auto B = wholeRecords<bpaVPD>(bpa);
    vpdDB db(dataDir(), 1);

    for (unsigned f = 0; f <= 4; ++f) {
      for (unsigned c = 0; c <= 4; ++c) {
        for (unsigned adapter = 0; adapter <= 3; ++adapter) {
          std::list<smaVPD> got;
          int rc = db.getSMAvpd(f, c, adapter, got);
          std::vector<std::string> want;
          for (const smaVPD& r : S) {
            unsigned chip = r.loc_id.getChip();
            bool in = adapter == 1   ? (chip == 0 || chip == 1 || chip == 4 || chip == 5)
                      : adapter == 2 ? (chip == 2 || chip == 3 || chip == 6 || chip == 7)
                                     : false;
            if (r.loc_id.getFrame() == f && r.loc_id.getCage() == c && in) want.push_back(key(r));
          }
          EXPECT_EQ(keys(got), want)
              << "seed " << seed << " sma " << f << "," << c << "," << adapter;
          EXPECT_EQ(rc, want.empty() ? 4 : 0);
        }
        chassisVPD cs;
        int rc = db.getSwitchvpd(f, c, cs);
        const chassisVPD* first = nullptr;
        for (const chassisVPD& r : C) {
          if (r.loc_id.getFrame() == f && r.loc_id.getCage() == c) {
            first = &r;
            break;
          }
        }
        EXPECT_EQ(rc, first ? 0 : 4) << "seed " << seed;
        if (first) {
          EXPECT_EQ(key(cs), key(*first)) << "seed " << seed << " chassis " << f << "," << c;
        }
        bpaVPD bs;
        rc = db.getBPAvpd(f, c, bs);
        const bpaVPD* bfirst = nullptr;
        for (const bpaVPD& r : B) {
          if (r.loc_id.getFrame() == f && r.loc_id.getCage() == c) {
            bfirst = &r;
            break;
          }
        }
        EXPECT_EQ(rc, bfirst ? 0 : 4);
        if (bfirst) {
          EXPECT_EQ(key(bs), key(*bfirst)) << "seed " << seed << " bpa " << f << "," << c;
        }
      }
      std::list<chassisVPD> by_frame;
      db.getSwitchvpd(f, by_frame);
      std::vector<std::string> want;
      for (const chassisVPD& r : C)
        if (r.loc_id.getFrame() == f) want.push_back(key(r));
      EXPECT_EQ(keys(by_frame), want) << "seed " << seed << " frame " << f;
    }
    for (unsigned n = 0; n <= 8; ++n) {
      std::list<chassisVPD> cn;
      std::list<bpaVPD> bn;
      db.getSwitchvpdNW(n, cn);
      db.getBPAvpdNW(n, bn);
      std::vector<std::string> wc, wb;
      for (const chassisVPD& r : C)
        if (r.loc_id.getNetwork() == n) wc.push_back(key(r));
      for (const bpaVPD& r : B)
        if (r.loc_id.getNetwork() == n) wb.push_back(key(r));
      EXPECT_EQ(keys(cn), wc) << "seed " << seed << " network " << n;
      EXPECT_EQ(keys(bn), wb) << "seed " << seed << " network " << n;
    }
    for (const char* tm : {"TM-A", "TM-B", "TM-C", ""}) {
      for (const char* se : {"0", "1", "2", "3", ""}) {
        mtms m(tm, se);
        chassisVPD cs;
        bpaVPD bs;
        int rc = db.getSwitchvpd(m, cs);
        const chassisVPD* cf = nullptr;
        for (const chassisVPD& r : C)
          if (r.sw_mtms == m) {
            cf = &r;
            break;
          }
        EXPECT_EQ(rc, cf ? 0 : 4);
        if (cf) {
          EXPECT_EQ(key(cs), key(*cf)) << "seed " << seed << " " << tm << "*" << se;
        }
        rc = db.getBPAvpd(m, bs);
        const bpaVPD* bf = nullptr;
        for (const bpaVPD& r : B)
          if (r.frame_mtms == m) {
            bf = &r;
            break;
          }
        EXPECT_EQ(rc, bf ? 0 : 4);
        if (bf) {
          EXPECT_EQ(key(bs), key(*bf)) << "seed " << seed << " " << tm << "*" << se;
        }
      }
    }
    std::list<loc_id_t> ids;
    std::list<mtms> ms;
    db.getCECmtms(ids, ms);
    std::vector<uint32_t> want_ids;
    std::vector<std::string> want_ms;
    for (const smaVPD& r : S) {
      bool seen = false;
      for (uint32_t w : want_ids) {
        loc_id_t l(w);
        if (l.getFrame() == r.loc_id.getFrame() && l.getCage() == r.loc_id.getCage()) seen = true;
      }
      if (!seen) {
        want_ids.push_back(r.loc_id.toInt());
        want_ms.push_back(r.cec_mtms.text());
      }
    }
    std::vector<uint32_t> got_ids;
    for (loc_id_t l : ids) got_ids.push_back(l.toInt());
    std::vector<std::string> got_ms;
    for (const mtms& m : ms) got_ms.push_back(m.text());
    EXPECT_EQ(got_ids, want_ids) << "seed " << seed;
    EXPECT_EQ(got_ms, want_ms) << "seed " << seed;
  }
}

// The store against a std::map model: write N records with repeated keys, then check the
// table holds exactly the model's records in first-insertion order.
TEST_P(IndexModelTest, StoreAgreesWithAMapModel) {
  std::mt19937 rng(42);
  std::uniform_int_distribution<unsigned> small(0, 6), chip(0, 15);
  vpdDB db(dataDir());
  std::vector<uint32_t> order;             // keys in first-insertion order
  std::map<uint32_t, std::string> latest;  // key -> record bytes
  for (int i = 0; i < 2000; ++i) {
    smaVPD r = vpdtest::makeSma(small(rng), small(rng), chip(rng));
    std::string ts = "n" + std::to_string(i);
    r.setTimestamp(ts.c_str());
    uint32_t k = r.loc_id.toInt() & 0x00ffffff;
    if (!latest.count(k)) order.push_back(k);
    latest[k] = bytesOf(r);
    ASSERT_EQ(db.putVPD(r.loc_id, &r), 0);
  }
  std::string expect;
  for (uint32_t k : order) expect += latest[k];
  EXPECT_EQ(testsupport::readFile(table("sma_vpd.db")), expect);
  EXPECT_TRUE(takeTraces().empty());
}

}  // namespace
