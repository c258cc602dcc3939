// Every lookup: selection, first match, list order, partial trailing record, empty table,
// and the exact trace texts and levels.
#include <cstring>
#include <functional>
#include <sstream>

#include "vpd_test_util.h"

namespace {

using vpdtest::bytesOf;
using vpdtest::makeBpa;
using vpdtest::makeChassis;
using vpdtest::makeSma;

std::string describe(loc_id_t l) {
  std::ostringstream s;
  s << l.getFrame() << "." << l.getCage() << "." << l.getChip() << "n" << l.getNetwork();
  return s.str();
}
std::string describe(const smaVPD& r) { return describe(r.loc_id) + ":" + r.cec_mtms.text(); }
std::string describe(const chassisVPD& r) { return describe(r.loc_id) + ":" + r.sw_mtms.text(); }
std::string describe(const bpaVPD& r) { return describe(r.loc_id) + ":" + r.frame_mtms.text(); }
std::string describe(const mtms& m) { return m.text(); }
template <class T>
std::string describe(const std::list<T>& list) {
  std::string out;
  for (const T& e : list) out += (out.empty() ? "" : " ") + describe(e);
  return out;
}

// A list lookup's result starts with one element already there, which must stay in front.
template <class T>
std::list<T> seeded(const T& first) {
  return std::list<T>{first};
}

smaVPD seedSma() { return makeSma(99, 99, 0, "SEED", "SEED", "SEED"); }
chassisVPD seedChassis() { return makeChassis(99, 99, "SEED", "SEED"); }
bpaVPD seedBpa() { return makeBpa(99, 99, "SEED", "SEED"); }

struct Case {
  const char* name;
  std::string chassis, bpa, sma;                  // table bytes
  std::function<std::string(vpdDB&, int&)> call;  // runs the lookup, describes its output
  int result;
  std::string output;
  std::vector<std::string> traces;
};

class LookupTest : public vpdtest::VpdTest {
 protected:
  void runCases(const std::vector<Case>& cases) {
    for (const Case& c : cases) {
      writeTables(c.chassis, c.bpa, c.sma);
      takeTraces();
      vpdDB db(dataDir(), 1);
      int result = -99;
      std::string output = c.call(db, result);
      EXPECT_EQ(result, c.result) << c.name;
      EXPECT_EQ(output, c.output) << c.name;
      EXPECT_EQ(takeTraces(), c.traces) << c.name;
      // A second call scans from the start again and behaves the same.
      int again = -99;
      c.call(db, again);
      EXPECT_EQ(again, c.result) << c.name << " (second call)";
    }
  }
};

std::string smaTable(std::initializer_list<smaVPD> rs) {
  std::string s;
  for (const smaVPD& r : rs) s += bytesOf(r);
  return s;
}
std::string chassisTable(std::initializer_list<chassisVPD> rs) {
  std::string s;
  for (const chassisVPD& r : rs) s += bytesOf(r);
  return s;
}
std::string bpaTable(std::initializer_list<bpaVPD> rs) {
  std::string s;
  for (const bpaVPD& r : rs) s += bytesOf(r);
  return s;
}

std::function<std::string(vpdDB&, int&)> smaLookup(unsigned f, unsigned c, unsigned adapter) {
  return [=](vpdDB& db, int& rc) {
    std::list<smaVPD> l = seeded(seedSma());
    rc = db.getSMAvpd(f, c, adapter, l);
    return describe(l);
  };
}

TEST_F(LookupTest, SmaRecordsOfAnAdapter) {
  smaVPD c1 = makeSma(1, 0, 1, "P", "CEC-A"), c5 = makeSma(1, 0, 5, "P", "CEC-B");
  smaVPD c2 = makeSma(1, 0, 2, "P", "CEC-C"), other = makeSma(1, 1, 0, "P", "OTHER");
  const std::string seed = describe(seedSma());
  const std::string nf = "1|getSMAvpd|The specified frame 1, cage 0 is not in the smaTbl";
  runCases({
      {"empty", "", "", "", smaLookup(1, 0, 1), 4, seed, {"1|getSMAvpd|The sma table is empty"}},
      {"short",
       "",
       "",
       std::string(159, 'x'),
       smaLookup(1, 0, 1),
       4,
       seed,
       {"1|getSMAvpd|The sma table is empty"}},
      {"adapter 1",
       "",
       "",
       smaTable({c1, other, c2, c5}),
       smaLookup(1, 0, 1),
       0,
       seed + " " + describe(c1) + " " + describe(c5),
       {}},
      {"adapter 2",
       "",
       "",
       smaTable({c1, other, c2, c5}),
       smaLookup(1, 0, 2),
       0,
       seed + " " + describe(c2),
       {}},
      {"adapter 2 none", "", "", smaTable({c1, c5}), smaLookup(1, 0, 2), 4, seed, {nf}},
      {"adapter 0", "", "", smaTable({c1, c2}), smaLookup(1, 0, 0), 4, seed, {nf}},
      {"adapter 3", "", "", smaTable({c1, c2}), smaLookup(1, 0, 3), 4, seed, {nf}},
      {"partial record not examined",
       "",
       "",
       smaTable({other}) + bytesOf(c1).substr(0, 159),
       smaLookup(1, 0, 1),
       4,
       seed,
       {nf}},
      {"whole records before partial",
       "",
       "",
       smaTable({c1}) + "xyz",
       smaLookup(1, 0, 1),
       0,
       seed + " " + describe(c1),
       {}},
      {"frame beyond range",
       "",
       "",
       smaTable({c1}),
       smaLookup(4294967295u, 0, 1),
       4,
       seed,
       {"1|getSMAvpd|The specified frame -1, cage 0 is not in the smaTbl"}},
      {"cage beyond range",
       "",
       "",
       smaTable({c1}),
       smaLookup(1, 256, 1),
       4,
       seed,
       {"1|getSMAvpd|The specified frame 1, cage 256 is not in the smaTbl"}},
  });
}

template <class Record, class Fn>
std::function<std::string(vpdDB&, int&)> single(Record seed, Fn fn) {
  return [=](vpdDB& db, int& rc) {
    Record out = seed;
    rc = fn(db, out);
    return describe(out);
  };
}

TEST_F(LookupTest, FirstRecordAtFrameAndCage) {
  bpaVPD b1 = makeBpa(2, 255, "FIRST"), b2 = makeBpa(2, 255, "SECOND"), b3 = makeBpa(2, 1);
  chassisVPD s1 = makeChassis(2, 3, "FIRST"), s2 = makeChassis(2, 3, "SECOND");
  chassisVPD s3 = makeChassis(2, 4);
  auto bpa = [](unsigned f, unsigned c) {
    return single(seedBpa(), [=](vpdDB& db, bpaVPD& o) { return db.getBPAvpd(f, c, o); });
  };
  auto sw = [](unsigned f, unsigned c) {
    return single(seedChassis(),
                  [=](vpdDB& db, chassisVPD& o) { return db.getSwitchvpd(f, c, o); });
  };
  runCases({
      {"bpa first of two", "", bpaTable({b3, b1, b2}), "", bpa(2, 255), 0, describe(b1), {}},
      {"bpa not found",
       "",
       bpaTable({b3}),
       "",
       bpa(2, 255),
       4,
       describe(seedBpa()),
       {"1|getBPAvpd|The specified frame 2, cage 255 is not find in the bpaTbl"}},
      {"bpa empty",
       "",
       "",
       "",
       bpa(2, 255),
       4,
       describe(seedBpa()),
       {"1|getBPAvpd|The bpa table is empty"}},
      {"bpa partial",
       "",
       bpaTable({b3}) + bytesOf(b1).substr(0, 1000),
       "",
       bpa(2, 255),
       4,
       describe(seedBpa()),
       {"1|getBPAvpd|The specified frame 2, cage 255 is not find in the bpaTbl"}},
      {"switch first of two", chassisTable({s3, s1, s2}), "", "", sw(2, 3), 0, describe(s1), {}},
      {"switch not found",
       chassisTable({s3}),
       "",
       "",
       sw(4095, 255),
       4,
       describe(seedChassis()),
       {"1|getSwitchvpd|The specified frame 4095, cage 255 is not find in the chassisTable"}},
      {"switch empty",
       "",
       "",
       "",
       sw(2, 3),
       4,
       describe(seedChassis()),
       {"1|getSwitchvpd|The switch chassis table is empty"}},
  });
}

TEST_F(LookupTest, ListsByFrameAndByNetwork) {
  chassisVPD a = makeChassis(4, 1, "A", "1", 0), b = makeChassis(5, 1, "B", "2", 1);
  chassisVPD c = makeChassis(4, 2, "C", "3", 0), d = makeChassis(4, 3, "A", "1", 2);
  bpaVPD p = makeBpa(1, 255, "P", "1", 0), q = makeBpa(2, 255, "Q", "2", 1);
  bpaVPD r = makeBpa(3, 255, "R", "3", 0);
  const std::string chassis = chassisTable({a, b, c, d});
  auto byFrame = [](unsigned f) {
    return [=](vpdDB& db, int& rc) {
      std::list<chassisVPD> l = seeded(seedChassis());
      rc = db.getSwitchvpd(f, l);
      return describe(l);
    };
  };
  auto swNet = [](unsigned n) {
    return [=](vpdDB& db, int& rc) {
      std::list<chassisVPD> l = seeded(seedChassis());
      rc = db.getSwitchvpdNW(n, l);
      return describe(l);
    };
  };
  auto bpaNet = [](unsigned n) {
    return [=](vpdDB& db, int& rc) {
      std::list<bpaVPD> l = seeded(seedBpa());
      rc = db.getBPAvpdNW(n, l);
      return describe(l);
    };
  };
  auto mtmsOf = [](unsigned f) {
    return [=](vpdDB& db, int& rc) {
      std::list<mtms> l = seeded(mtms("SEED", "SEED"));
      rc = db.getSwitchmtms(f, l);
      return describe(l);
    };
  };
  const std::string sc = describe(seedChassis()), sb = describe(seedBpa());
  runCases({
      {"frame 4",
       chassis,
       "",
       "",
       byFrame(4),
       0,
       sc + " " + describe(a) + " " + describe(c) + " " + describe(d),
       {}},
      {"frame 6",
       chassis,
       "",
       "",
       byFrame(6),
       4,
       sc,
       {"1|getSwitchvpd|The specified frame 6 is not find in the chassisTable"}},
      {"frame empty",
       "",
       "",
       "",
       byFrame(4),
       4,
       sc,
       {"1|getSwitchvpd|The switch chassis table is empty"}},
      {"switch network 0",
       chassis,
       "",
       "",
       swNet(0),
       0,
       sc + " " + describe(a) + " " + describe(c),
       {}},
      {"switch network 8",
       chassis,
       "",
       "",
       swNet(8),
       4,
       sc,
       {"1|getSwitchvpdNW|The specified network 8 is not find in the chassisTable"}},
      {"switch network empty",
       "",
       "",
       "",
       swNet(0),
       4,
       sc,
       {"1|getSwitchvpdNW|The switch chassis table is empty"}},
      {"bpa network 0",
       "",
       bpaTable({p, q, r}),
       "",
       bpaNet(0),
       0,
       sb + " " + describe(p) + " " + describe(r),
       {}},
      {"bpa network 7",
       "",
       bpaTable({p, q, r}),
       "",
       bpaNet(7),
       4,
       sb,
       {"1|getBPAvpdNW|The specified network 7 is not find in the bpaTbl"}},
      {"bpa network empty",
       "",
       "",
       "",
       bpaNet(0),
       4,
       sb,
       {"1|getBPAvpdNW|The bpa table is empty "}},
      {"switch mtms of frame 4", chassis, "", "", mtmsOf(4), 0, "SEED*SEED A*1 C*3 A*1", {}},
      {"switch mtms of frame 9",
       chassis,
       "",
       "",
       mtmsOf(9),
       4,
       "SEED*SEED",
       {"1|getSwitchmtms|The specified frame 9 is not in the chassis table"}},
      {"switch mtms empty",
       "",
       "",
       "",
       mtmsOf(9),
       4,
       "SEED*SEED",
       {"1|getSwitchmtms|The switch chassis table is empty"}},
  });
}

TEST_F(LookupTest, ByMtms) {
  bpaVPD b1 = makeBpa(1, 255, "9458-100", "02A1B2C"), b2 = makeBpa(2, 255, "9458-100", "02A1B2C");
  bpaVPD b3 = makeBpa(3, 255, "9458", "1");
  chassisVPD s1 = makeChassis(1, 1, "7045-SW4", "20SWTCH"),
             s2 = makeChassis(2, 1, "7045-SW4", "20SWTCH");
  auto bpa = [](mtms key) {
    return single(seedBpa(), [=](vpdDB& db, bpaVPD& o) { return db.getBPAvpd(key, o); });
  };
  auto sw = [](mtms key) {
    return single(seedChassis(), [=](vpdDB& db, chassisVPD& o) { return db.getSwitchvpd(key, o); });
  };
  mtms nine;  // nine non-NUL characters in tm: only eight take part
  std::memcpy(nine.tm, "9458-100X", 9);
  std::memcpy(nine.se, "02A1B2C", 8);
  mtms after_nul("9458", "1");
  std::memcpy(after_nul.se + 2, "ZZ", 2);  // differs only after the serial's NUL
  runCases({
      {"bpa first of two",
       "",
       bpaTable({b3, b1, b2}),
       "",
       bpa(mtms("9458-100", "02A1B2C")),
       0,
       describe(b1),
       {}},
      {"bpa nine characters", "", bpaTable({b1}), "", bpa(nine), 0, describe(b1), {}},
      {"bpa shorter tm does not match longer",
       "",
       bpaTable({b1}),
       "",
       bpa(mtms("9458", "02A1B2C")),
       4,
       describe(seedBpa()),
       {"1|getBPAvpd|The specified mtms is not find in the bpaTbl"}},
      {"bpa equal up to NUL", "", bpaTable({b1, b3}), "", bpa(after_nul), 0, describe(b3), {}},
      {"bpa empty",
       "",
       "",
       "",
       bpa(mtms("9458-100", "02A1B2C")),
       4,
       describe(seedBpa()),
       {"1|getBPAvpd|The bpa table is empty"}},
      {"switch first of two",
       chassisTable({s1, s2}),
       "",
       "",
       sw(mtms("7045-SW4", "20SWTCH")),
       0,
       describe(s1),
       {}},
      {"switch not found",
       chassisTable({s1}),
       "",
       "",
       sw(mtms("7045-SW4", "0")),
       4,
       describe(seedChassis()),
       {"1|getSwitchvpd|The specified switch mtms not find in the chassisTable"}},
      {"switch empty",
       "",
       "",
       "",
       sw(mtms("7045-SW4", "20SWTCH")),
       4,
       describe(seedChassis()),
       {"1|getSwitchvpd|The switch chassis table is empty "}},
  });
}

TEST_F(LookupTest, CecList) {
  auto cecs = [](vpdDB& db, int& rc) {
    std::list<loc_id_t> ids;
    std::list<mtms> ms;
    rc = db.getCECmtms(ids, ms);
    EXPECT_EQ(ids.size(), ms.size());
    std::string out;
    auto m = ms.begin();
    for (loc_id_t id : ids) out += (out.empty() ? "" : " ") + describe(id) + ":" + (m++)->text();
    return out;
  };
  smaVPD a = makeSma(1, 0, 3, "P", "CEC-1A"), a2 = makeSma(1, 0, 5, "P", "CEC-1B");
  smaVPD b = makeSma(2, 0, 0, "P", "CEC-2"), c = makeSma(1, 1, 0, "P", "CEC-3");
  runCases({
      {"first occurrence order",
       "",
       "",
       smaTable({a, a2, b, a2}),
       cecs,
       0,
       "1.0.3n1:CEC-1A*10ABCDE 2.0.0n1:CEC-2*10ABCDE",
       {}},
      {"cages differ",
       "",
       "",
       smaTable({a, c}),
       cecs,
       0,
       "1.0.3n1:CEC-1A*10ABCDE 1.1.0n1:CEC-3*10ABCDE",
       {}},
      {"one record", "", "", smaTable({b}), cecs, 0, "2.0.0n1:CEC-2*10ABCDE", {}},
      {"partial adds nothing",
       "",
       "",
       smaTable({b}) + bytesOf(c).substr(0, 100),
       cecs,
       0,
       "2.0.0n1:CEC-2*10ABCDE",
       {}},
      {"empty", "", "", "", cecs, 4, "", {"1|getCECmtms|The sma table is empty"}},
  });
}

TEST_F(LookupTest, AssignedCopyIsBoundedListCopyIsWhole) {
  chassisVPD full;
  std::memset(static_cast<void*>(&full), 'W', sizeof full);
  full.loc_id = loc_id_t(1, 1, 0, CHASSIS, 0, 0);
  writeTables(bytesOf(full), "", "");
  vpdDB db(dataDir(), 1);
  chassisVPD single;
  std::memset(static_cast<void*>(&single), 'k', sizeof single);
  ASSERT_EQ(db.getSwitchvpd(1, 1, single), 0);
  EXPECT_EQ(std::string(single.sw_mtms.tm, 9), "WWWWWWWWk");
  EXPECT_EQ(std::string(single.sw_fru.ds + 29, 2), "Wk");
  EXPECT_EQ(std::string(single.timestamp, 28), std::string(28, 'W'));
  std::list<chassisVPD> list;
  ASSERT_EQ(db.getSwitchvpd(1u, list), 0);
  // Every field byte is kept (the padding at 333 is not a field).
  std::string got = bytesOf(list.front()), want = bytesOf(full);
  EXPECT_EQ(got.substr(0, 333), want.substr(0, 333));
  EXPECT_EQ(got.substr(336), want.substr(336));
}

}  // namespace
