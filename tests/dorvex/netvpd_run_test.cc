// What a network VPD run remembers between the chassis it writes: the far ends of cable
// lines and the frame BPAs that were found (nothing that was not), and the consoles that
// reach each BPA.
#include "netvpd_run.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <cstring>
#include <random>
#include <string>
#include <vector>

#include "console_discovery.h"
#include "installation.h"
#include "switch_netvpd.h"

namespace dorvextest {
namespace {

chassisVPD chassisAt(unsigned frame, unsigned cage, const char* tm, const char* se) {
  chassisVPD c;
  c.loc_id = location(frame, cage, 0, CHASSIS);
  c.sw_mtms = mtms(tm, se);
  return c;
}

smaVPD smaAt(unsigned frame, unsigned cage, unsigned chip, const char* tm, const char* se) {
  smaVPD s;
  s.loc_id = location(frame, cage, chip, SMA);
  s.cec_mtms = mtms(tm, se);
  return s;
}

// Appends a record as it lies in memory: the only way to store a second record with a key
// that putVPD would replace.
template <class Record>
void appendRecord(const std::string& table, const Record& record) {
  FILE* f = std::fopen(table.c_str(), "ab");
  ASSERT_NE(f, nullptr) << table;
  ASSERT_EQ(std::fwrite(&record, sizeof record, 1, f), 1u) << table;
  std::fclose(f);
}

std::string fileText(const std::string& path) {
  return testsupport::fileExists(path) ? testsupport::readFile(path) : "";
}

int countOf(const std::string& text, const std::string& what) {
  int n = 0;
  for (auto at = text.find(what); at != std::string::npos; at = text.find(what, at + 1)) ++n;
  return n;
}

TEST(NetvpdRun, RemembersOnlyTheFarEndsThatWereFound) {
  Installation inst;
  inst.add(chassisAt(2, 4, "7045-SW4", "FIRST01"));
  inst.add(chassisAt(0, 0, "7045-SW4", "ORIGIN0"));
  inst.add(smaAt(5, 2, 2, "9119-595", "ADAPTR2"));  // adapter 2 only
  inst.add(smaAt(5, 3, 4, "9119-595", "CEC0001"));  // adapter 1, first in table order
  inst.add(smaAt(5, 3, 0, "9119-595", "CEC0002"));
  inst.writeTables();
  appendRecord(inst.path("data/chassis_vpd.db"), chassisAt(2, 4, "7045-SW4", "SECOND2"));
  chassisVPD junk = chassisAt(3, 1, "", "");
  std::memcpy(junk.sw_mtms.tm, "7045\0XYZ", 8);  // bytes after the terminator never show
  std::memcpy(junk.sw_mtms.se, "AB\0CDEF", 7);
  appendRecord(inst.path("data/chassis_vpd.db"), junk);
  bpaVPD bpa;
  bpa.loc_id = location(2, 255, 0, BPA);
  bpa.frame_mtms = mtms("9458-100", "BPAONE1");
  appendRecord(inst.path("data/bpa_vpd.db"), bpa);
  bpa.frame_mtms = mtms("9458-100", "BPATWO2");
  appendRecord(inst.path("data/bpa_vpd.db"), bpa);
  vpdDB db(inst.path("data"), 1);
  const std::string trace_file = inst.path("writer-trace.log");

  enum Kind { kChassis, kCec, kBpa };
  struct {
    const char* name;
    Kind kind;
    unsigned frame, cage;
    const char* found;  // the MTMS text, or null for "not found"
  } cases[] = {
      {"first of two chassis", kChassis, 2, 4, "7045-SW4*FIRST01"},
      {"chassis at frame 0, cage 0", kChassis, 0, 0, "7045-SW4*ORIGIN0"},
      {"bytes after a terminator", kChassis, 3, 1, "7045*AB"},
      {"missing chassis", kChassis, 7, 7, nullptr},
      {"chassis at a CEC's place", kChassis, 5, 3, nullptr},
      {"first SMA record of adapter 1", kCec, 5, 3, "9119-595*CEC0001"},
      {"CEC with adapter 2 only", kCec, 5, 2, nullptr},
      {"missing CEC", kCec, 9, 9, nullptr},
      {"CEC at a chassis's place", kCec, 2, 4, nullptr},
      {"first of two BPAs", kBpa, 2, 255, "9458-100*BPAONE1"},
      {"missing BPA", kBpa, 3, 255, nullptr},
      {"BPA at a chassis's place", kBpa, 2, 4, nullptr},
  };
  for (const auto& c : cases) {
    std::string before = fileText(trace_file);
    dorvex::NetvpdRun run(db);
    const mtms* first = nullptr;
    for (int call = 1; call <= 3; ++call) {
      if (c.kind == kBpa) {
        EXPECT_EQ(run.bpaMtmsAt(c.frame, c.cage).text(), c.found ? c.found : "*")
            << c.name << ", call " << call;
        continue;
      }
      const mtms* m =
          c.kind == kCec ? run.farCec(c.frame, c.cage) : run.farChassis(c.frame, c.cage);
      if (c.found == nullptr) {
        EXPECT_EQ(m, nullptr) << c.name << ", call " << call;
        continue;
      }
      ASSERT_NE(m, nullptr) << c.name << ", call " << call;
      EXPECT_EQ(m->text(), c.found) << c.name << ", call " << call;
      if (call == 1) first = m;
      EXPECT_EQ(m, first) << c.name << ": a found far end is looked up once";
    }
    std::string traced = fileText(trace_file).substr(before.size());
    EXPECT_EQ(countOf(traced, "is not"), c.found == nullptr ? 3 : 0)
        << c.name << ": every lookup that finds nothing traces\n"
        << traced;
  }
}

// A second run over other tables (as in a second request of the same process) learns its
// far ends afresh.
TEST(NetvpdRun, EachRunAnswersFromItsOwnTables) {
  Installation one, two;
  one.add(chassisAt(2, 4, "7045-SW4", "TABLE01"));
  one.add(smaAt(5, 2, 0, "9119-595", "CECONE1"));
  one.writeTables();
  two.add(chassisAt(2, 4, "7045-SW4", "TABLE02"));
  two.add(smaAt(5, 2, 0, "9119-595", "CECTWO2"));
  two.writeTables();
  vpdDB db_one(one.path("data"), 1), db_two(two.path("data"), 1);

  struct {
    vpdDB* db;
    loc_id_t far;
    const char* line;
  } cases[] = {
      {&db_one, location(2, 4, 0, NSB),
       "*CB \"U7045-SW4SELF001-P1-C1-T1\" \"U7045-SW4TABLE01-P1-C9-T1\"\n"},
      {&db_two, location(2, 4, 0, NSB),
       "*CB \"U7045-SW4SELF001-P1-C1-T1\" \"U7045-SW4TABLE02-P1-C9-T1\"\n"},
      {&db_one, location(5, 2, 0, SMA),
       "*CB \"U7045-SW4SELF001-P1-C1-T1\" \"U9119-595CECONE1-P1-H1Q3\"\n"},
      {&db_two, location(5, 2, 0, SMA),
       "*CB \"U7045-SW4SELF001-P1-C1-T1\" \"U9119-595CECTWO2-P1-H1Q3\"\n"},
  };
  for (const auto& c : cases) {
    dorvex::NetvpdRun run(*c.db);
    for (int call = 1; call <= 2; ++call) {
      OutputCapture out;
      dorvex::outputCBinfo(run, mtms("7045-SW4", "SELF001"), c.far, 0, 0, 1);
      EXPECT_EQ(out.text(), c.line) << "call " << call;
    }
  }
}

// A random MTMS from few characters, often cut short by a NUL with other bytes after it, so
// that many differ in their bytes and still compare equal.
mtms nearlyEqualMtms(std::mt19937& rng) {
  mtms m;
  std::memcpy(m.tm, "AAAAAAAAx", sizeof m.tm);  // no terminator within the width
  std::memcpy(m.se, "1111111y", sizeof m.se);
  m.tm[rng() % 2] = 'B';
  m.se[0] = "12"[rng() % 2];
  auto cut = [&](char* field, std::size_t width) {  // a NUL, and other bytes behind it
    std::size_t at = rng() % width;
    field[at] = '\0';
    for (std::size_t i = at + 1; i <= width; ++i) field[i] = "AB1"[rng() % 3];
  };
  if (rng() % 2 == 0) cut(m.tm, mtms::kTmChars);
  if (rng() % 2 == 0) cut(m.se, mtms::kSeChars);
  return m;
}

// All 17 bytes, where assignment would copy only up to each field's NUL.
void setRaw(mtms& to, const mtms& from) {
  std::memcpy(static_cast<void*>(&to), static_cast<const void*>(&from), sizeof to);
}

std::vector<std::string> texts(const std::vector<mtms>& list) {
  std::vector<std::string> t;
  for (const mtms& m : list) t.push_back(m.getTM() + "/" + m.getSE());
  return t;
}

// The consoles that reach a BPA are those a comparison with every BPA of every console
// finds, in that order, whether asked first in a run or later.
TEST(NetvpdRun, ConsolesReachingABpaAreThoseOfAFullComparison) {
  Installation inst;
  inst.writeTables();
  vpdDB db(inst.path("data"), 1);
  std::mt19937 rng(20240612);
  for (int round = 0; round < 50; ++round) {
    dorvex::zev.assign(rng() % 4, dorvex::zev_info_t());
    std::vector<mtms> asked;
    for (dorvex::zev_info_t& console : dorvex::zev) {
      setRaw(console.zevmtms, nearlyEqualMtms(rng));
      console.bpa.resize(rng() % 6);
      for (dorvex::bpa_info_t& bpa : console.bpa) {
        setRaw(bpa.bpamtms, nearlyEqualMtms(rng));
        asked.push_back(bpa.bpamtms);
      }
    }
    for (int i = 0; i < 4; ++i) asked.push_back(nearlyEqualMtms(rng));  // maybe listed nowhere

    dorvex::NetvpdRun run(db);
    for (std::size_t q = 0; q < asked.size(); ++q) {
      std::vector<mtms> expected;
      for (const dorvex::zev_info_t& console : dorvex::zev) {
        for (const dorvex::bpa_info_t& bpa : console.bpa) {
          if (bpa.bpamtms == asked[q]) expected.push_back(console.zevmtms);
        }
      }
      ASSERT_EQ(texts(run.consolesReaching(asked[q])), texts(expected))
          << "round " << round << ", query " << q;
      dorvex::NetvpdRun fresh(db);
      ASSERT_EQ(texts(fresh.consolesReaching(asked[q])), texts(expected))
          << "round " << round << ", query " << q << " as a run's first";
    }
  }
  dorvex::zev.clear();
}

// End to end: a far chassis that is missing is looked up, and traced, for each of its cable
// lines; one that is present shows on every line that reaches it.
TEST(NetvpdRun, EveryCableLineToAMissingChassisTraces) {
  Installation inst;
  chassisVPD a = chassisAt(2, 3, "7045-SW4", "0C0FFEE");
  for (int slot = 0; slot < 16; ++slot) {
    a.riser[slot].riser_fru = fru("Riser", "21P4001", "", "21P4002", "", "", "P1-C");
    a.riser[slot].nbr1 = location(7, 7, 0, NSB);  // no such chassis
    a.riser[slot].nbr2 = location(2, 4, 0, ISB);
  }
  inst.add(a);
  inst.add(chassisAt(2, 4, "7045-SW4", "0C0FFEF"));
  bpaVPD bpa;  // the frame's BPA, so that the cable lines are all there is to trace
  bpa.loc_id = location(2, 255, 0, BPA);
  inst.add(bpa);
  inst.setDump("2 3 SW_CHIP 0 0 1\n2 4 SW_CHIP 0 0 1\n");
  testsupport::RunResult r = inst.run({"-y", "netvpd", "-n", "1"});
  EXPECT_EQ(r.status, 0);
  EXPECT_EQ(countOf(r.out, "*CB "), 30);
  EXPECT_EQ(countOf(r.out, "-T1\" \"U-P1-C9-T1\"\n"), 15) << r.out;
  EXPECT_EQ(countOf(r.out, "-T2\" \"U7045-SW40C0FFEF-P1-C9-T1\"\n"), 15) << r.out;
  std::string traces = inst.traces();
  EXPECT_EQ(countOf(traces, "\tThe specified frame 7, cage 7 is not find in the chassisTable\n"),
            15)
      << traces;
  EXPECT_EQ(countOf(traces, "\n"), 15) << traces;
}

}  // namespace
}  // namespace dorvextest
