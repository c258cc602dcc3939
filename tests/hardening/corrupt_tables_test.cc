// dorvex on damaged tables: every request form over tables cut at many lengths and over
// tables with bytes changed at random (seeded). Each run must end by itself, with status 0,
// 1 or 2 (the tables, the dump tool and the console configuration are all there, so 3, 4
// and 5 have no cause), write nothing to standard error (where a sanitizer would report),
// and print a dump whose shape follows from the table lengths alone.
#include <gtest/gtest.h>
#include <sys/time.h>

#include <algorithm>
#include <cstdint>
#include <random>
#include <string>
#include <vector>

#include "bounded_run.h"
#include "sample_installation.h"
#include "test_support.h"

namespace {

using hardening::BoundedResult;
using testsupport::TempDir;

// Every table gets this modification time, so that the change poll's answer depends on the
// bytes alone.
constexpr time_t kTableTime = 1765000000;
// Far above any honest run, even under the sanitizers on a loaded machine.
constexpr int kLimitSeconds = 60;

struct Tables {
  std::string chassis, bpa, sma;
};

// One table of Tables, with its record size and dump lines per record.
struct TableRef {
  const char* name;
  std::string Tables::*bytes;
  std::size_t record_size;
};
const TableRef kTables[] = {
    {"chassis", &Tables::chassis, sizeof(chassisVPD)},
    {"bpa", &Tables::bpa, sizeof(bpaVPD)},
    {"sma", &Tables::sma, sizeof(smaVPD)},
};

Tables sampleTables() {
  return Tables{sample::tableBytes(sample::chassisRecords()),
                sample::tableBytes(sample::bpaRecords()), sample::tableBytes(sample::smaRecords())};
}

// Lines of "dorvex -y all" for tables of these lengths: the three headings and a fixed
// number of lines per whole record (no printed field can hold a newline).
std::size_t dumpLines(const Tables& t) {
  return 3 + 76 * (t.chassis.size() / sizeof(chassisVPD)) + 20 * (t.bpa.size() / sizeof(bpaVPD)) +
         6 * (t.sma.size() / sizeof(smaVPD));
}

std::string describe(const std::vector<std::string>& args) {
  std::string s = "dorvex";
  for (const std::string& a : args) s += " " + a;
  return s;
}

// An install root with the sample's dump tool and console configuration.
class Root {
 public:
  Root() {
    testsupport::makeDirs(dir_ / "data");
    testsupport::makeDirs(dir_ / "bin");
    testsupport::makeDirs(dir_ / "etc");
    testsupport::writeFile(dir_ / "etc/hwserver.json", sample::hwserverJson());
    testsupport::writeFile(dir_ / "etc/rackprobe.dump", sample::rackprobeDump());
    testsupport::writeFile(dir_ / "bin/rackprobe",
                           "#!/bin/sh\n"
                           "[ \"$1 $2 $#\" = \"dump -d 2\" ] || exit 2\n"
                           "exec cat \"$(dirname \"$0\")/../etc/rackprobe.dump\"\n",
                           0755);
  }

  void setTables(const Tables& t) {
    write("chassis_vpd.db", t.chassis);
    write("bpa_vpd.db", t.bpa);
    write("sma_vpd.db", t.sma);
  }

  BoundedResult run(const std::vector<std::string>& args) {
    std::vector<std::string> argv = {DORVEX_BIN};
    argv.insert(argv.end(), args.begin(), args.end());
    return hardening::runBounded(argv, {{"OLV_ROOT", dir_.path()}, {"CHRONICLE_LOG", "/dev/null"}},
                                 kLimitSeconds);
  }

 private:
  void write(const char* name, const std::string& bytes) {
    std::string path = dir_ / ("data/" + std::string(name));
    testsupport::writeFile(path, bytes);
    timeval times[2] = {{kTableTime, 0}, {kTableTime, 0}};
    ASSERT_EQ(utimes(path.c_str(), times), 0) << path;
  }

  TempDir dir_;
};

// Runs every request form once over the tables now in place and checks what every run
// must do whatever the bytes. Returns the results in request order.
std::vector<BoundedResult> runAll(Root& root, const Tables& tables, const std::string& label) {
  std::vector<BoundedResult> results;
  for (const std::vector<std::string>& args : sample::requestArguments()) {
    BoundedResult r = root.run(args);
    std::string what = label + ": " + describe(args);
    EXPECT_FALSE(r.timed_out) << what << " did not end within " << kLimitSeconds << "s";
    EXPECT_TRUE(r.status >= 0 && r.status <= 2) << what << " ended with status " << r.status;
    EXPECT_EQ(r.err, "") << what;
    if (args == std::vector<std::string>{"-y", "all"}) {
      EXPECT_EQ(r.status, 0) << what;
      EXPECT_EQ(testsupport::lines(r.out).size(), dumpLines(tables)) << what;
    }
    results.push_back(r);
  }
  return results;
}

// Without damage every request finds what it asks for: the cases below start from tables
// that give each request form something to read.
TEST(CorruptTables, SampleAnswersEveryRequest) {
  Root root;
  Tables tables = sampleTables();
  root.setTables(tables);
  std::vector<BoundedResult> results = runAll(root, tables, "sample");
  std::vector<std::vector<std::string>> requests = sample::requestArguments();
  for (std::size_t i = 0; i < results.size(); ++i) {
    EXPECT_EQ(results[i].status, 0) << describe(requests[i]);
    EXPECT_NE(results[i].out, "") << describe(requests[i]);
  }
}

// A table cut inside a record answers every request exactly as the same table cut at the
// record boundary before it: a partial record is never read. Cuts at no record, one record,
// all records but one and all records of the table, each with one seeded cut inside the
// next record.
void checkTruncations(const TableRef& t) {
  std::mt19937 rng(20261206);
  Root root;
  Tables full = sampleTables();
  std::size_t records = (full.*t.bytes).size() / t.record_size;
  std::vector<std::size_t> cuts = {0, 1, records - 1, records};
  cuts.erase(std::unique(cuts.begin(), cuts.end()), cuts.end());
  std::vector<std::vector<std::string>> requests = sample::requestArguments();
  for (std::size_t k : cuts) {
    Tables cut = full;
    (cut.*t.bytes).resize(k * t.record_size);
    root.setTables(cut);
    std::string label = std::string(t.name) + " cut to " + std::to_string(k) + " records";
    std::vector<BoundedResult> whole = runAll(root, cut, label);
    if (k == records) continue;

    std::size_t extra = std::uniform_int_distribution<std::size_t>(1, t.record_size - 1)(rng);
    Tables partial = full;
    (partial.*t.bytes).resize(k * t.record_size + extra);
    root.setTables(partial);
    label = std::string(t.name) + " cut at byte " + std::to_string(k * t.record_size + extra);
    std::vector<BoundedResult> got = runAll(root, partial, label);
    for (std::size_t i = 0; i < got.size(); ++i) {
      EXPECT_EQ(got[i].out, whole[i].out) << label << ": " << describe(requests[i]);
      EXPECT_EQ(got[i].status, whole[i].status) << label << ": " << describe(requests[i]);
    }
  }
}

TEST(CorruptTables, TruncatedChassisTableReadsOnlyWholeRecords) { checkTruncations(kTables[0]); }
TEST(CorruptTables, TruncatedBpaTableReadsOnlyWholeRecords) { checkTruncations(kTables[1]); }
TEST(CorruptTables, TruncatedSmaTableReadsOnlyWholeRecords) { checkTruncations(kTables[2]); }

// A few bytes changed anywhere; half of the changes land in a location word, where they
// change which requests select which records.
TEST(CorruptTables, ChangedBytesEndCleanly) {
  std::mt19937 rng(6122026);
  Root root;
  constexpr int kRounds = 12;
  for (int round = 0; round < kRounds; ++round) {
    Tables tables = sampleTables();
    int changes = std::uniform_int_distribution<int>(1, 8)(rng);
    std::string label = "round " + std::to_string(round) + ":";
    for (int c = 0; c < changes; ++c) {
      const TableRef& t = kTables[std::uniform_int_distribution<int>(0, 2)(rng)];
      std::string& bytes = tables.*t.bytes;
      std::size_t pos = std::uniform_int_distribution<std::size_t>(0, bytes.size() - 1)(rng);
      if (rng() % 2 == 0) pos = pos / t.record_size * t.record_size + rng() % 4;
      unsigned char old_byte = static_cast<unsigned char>(bytes[pos]);
      unsigned char new_byte =
          static_cast<unsigned char>(old_byte ^ std::uniform_int_distribution<int>(1, 255)(rng));
      bytes[pos] = static_cast<char>(new_byte);
      label +=
          " " + std::string(t.name) + "[" + std::to_string(pos) + "]=" + std::to_string(new_byte);
    }
    root.setTables(tables);
    std::vector<BoundedResult> first = runAll(root, tables, label);
    // What a run prints depends on the bytes alone: a second dump is the same.
    BoundedResult again = root.run({"-y", "all"});
    EXPECT_EQ(again.out, first.back().out) << label;
  }
}

// Tables of the sample's lengths whose every byte is the same: all zero (records of no
// location), all 0xFF (every field at its maximum, no text terminated) and all blanks.
TEST(CorruptTables, UniformTablesEndCleanly) {
  const struct {
    const char* name;
    char fill;
  } kCases[] = {{"zero", '\0'}, {"all ones", '\xff'}, {"blanks", ' '}};
  Root root;
  for (const auto& c : kCases) {
    Tables tables = sampleTables();
    for (const TableRef& t : kTables) {
      std::string& bytes = tables.*t.bytes;
      std::fill(bytes.begin(), bytes.end(), c.fill);
    }
    root.setTables(tables);
    runAll(root, tables, c.name);
  }
}

}  // namespace
