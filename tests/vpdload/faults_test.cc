// Imports under stress: readers during imports, imports killed at random moments, writes
// that fail, and producers that meet each other.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/file.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <random>
#include <string>
#include <thread>
#include <vector>

#include "test_support.h"
#include "vpdload_test_util.h"

namespace {

using testsupport::RunResult;
using testsupport::TempDir;
using vpdloadtest::importText;
using vpdloadtest::makeInventory;
using vpdloadtest::oldTables;
using vpdloadtest::sameFiles;
using vpdloadtest::snapshot;
using vpdloadtest::stagingLeftovers;
using vpdloadtest::tables;
using vpdloadtest::vpdload;
using Tables = std::map<std::string, std::string>;

bool startsWith(const std::string& s, const std::string& prefix) {
  return s.compare(0, prefix.size(), prefix) == 0;
}
bool endsWith(const std::string& s, const std::string& suffix) {
  return s.size() >= suffix.size() &&
         s.compare(s.size() - suffix.size(), suffix.size(), suffix) == 0;
}

// Two inventories of one installation with different content in every table, and the tables
// each of them makes on its own.
struct TwoGenerations {
  std::string json[2];
  std::string file[2];
  Tables ref[2];

  TwoGenerations(const TempDir& tmp, int sma, int chassis, int bpa) {
    json[0] = makeInventory(sma, chassis, bpa, "GENA");
    json[1] = makeInventory(sma * 3 / 4, chassis * 3 / 4, bpa, "GENB");
    for (int g = 0; g < 2; ++g) {
      file[g] = tmp / ("gen" + std::to_string(g) + ".json");
      std::string dir = tmp / ("ref" + std::to_string(g));
      EXPECT_EQ(importText(dir, json[g], file[g]).status, 0);
      ref[g] = tables(dir);
    }
  }
  // Which generation each table is: 0, 1, or -1 for neither (and "missing" when absent).
  std::string which(const Tables& t) const {
    std::string out;
    for (const auto& kv : t) {
      int g = kv.second == ref[0].at(kv.first) ? 0 : kv.second == ref[1].at(kv.first) ? 1 : -1;
      out += kv.first + "=" + std::to_string(g) + " ";
    }
    return out;
  }
};

bool isGeneration(const TwoGenerations& gens, const std::string& table, const std::string& bytes) {
  return bytes == gens.ref[0].at(table) || bytes == gens.ref[1].at(table);
}

TEST(VpdloadFaults, ReadersSeeAWholeGenerationOfEveryTableDuringImports) {
  TempDir tmp;
  TwoGenerations gens(tmp, 2000, 120, 3);
  // One request per table, so that each answer comes from one table file.
  const std::vector<std::vector<std::string>> requests = {
      {"-y", "switch", "-f", "1"},            // every chassis of frame 1
      {"-y", "bpa", "-f", "2", "-c", "255"},  // one BPA
      {"-y", "cec", "-t", "0"},               // every CEC: the change poll
  };
  auto answer = [&](const std::string& root, const std::vector<std::string>& req) {
    std::vector<std::string> argv{DORVEX_BIN};
    argv.insert(argv.end(), req.begin(), req.end());
    RunResult r = testsupport::run(argv, {{"OLV_ROOT", root}, {"CHRONICLE_LOG", "/dev/null"}});
    // The change poll begins with the table's time, which differs from run to run.
    if (req.back() == "0") r.out = r.out.substr(r.out.find('\n') + 1);
    return r;
  };
  std::vector<std::string> expected[2];
  for (int g = 0; g < 2; ++g) {
    std::string root = tmp / ("root" + std::to_string(g));
    ASSERT_EQ(importText(root + "/data", gens.json[g], gens.file[g]).status, 0);
    for (const auto& req : requests) {
      RunResult r = answer(root, req);
      ASSERT_EQ(r.status, 0) << r.err;
      expected[g].push_back(r.out);
    }
    ASSERT_NE(expected[g].back(), "");
  }
  for (std::size_t i = 0; i < requests.size(); ++i) ASSERT_NE(expected[0][i], expected[1][i]);

  std::string root = tmp / "live";
  ASSERT_EQ(importText(root + "/data", gens.json[0], gens.file[0]).status, 0);
  std::atomic<bool> writing{true};
  std::thread writer([&] {
    for (int i = 1; i <= 10; ++i) {
      RunResult r = vpdload({"import", "--data", root + "/data", gens.file[i % 2]});
      EXPECT_EQ(r.status, 0) << r.err;
    }
    writing = false;
  });
  int reads = 0, seen[2] = {0, 0};
  while (writing || reads < 3) {
    const std::size_t i = static_cast<std::size_t>(reads) % requests.size();
    RunResult r = answer(root, requests[i]);
    ++reads;
    ASSERT_EQ(r.status, 0) << "read " << reads << ": " << r.err;
    bool is0 = r.out == expected[0][i], is1 = r.out == expected[1][i];
    EXPECT_TRUE(is0 || is1) << "read " << reads << " of request " << i << " belongs to neither";
    ++seen[is0 ? 0 : 1];
  }
  writer.join();
  std::printf("%d reads during the imports: %d old, %d new generation\n", reads, seen[0], seen[1]);
}

TEST(VpdloadFaults, AnImportKilledAtAnyMomentLeavesWholeTables) {
  TempDir tmp;
  TwoGenerations gens(tmp, 2500, 60, 10);
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, gens.json[0], gens.file[0]).status, 0);
  // How long one import takes here, to spread the kills over it.
  auto start = std::chrono::steady_clock::now();
  ASSERT_EQ(vpdload({"import", "--data", data, gens.file[1]}).status, 0);
  auto span = std::chrono::duration_cast<std::chrono::microseconds>(
                  std::chrono::steady_clock::now() - start)
                  .count();

  std::mt19937 random(20240506);
  std::uniform_int_distribution<long> delay(0, span + span / 4);
  int killed = 0;
  for (int i = 0; i < 24; ++i) {
    pid_t pid = vpdloadtest::spawnQuiet(
        {vpdloadtest::vpdloadPath(), "import", "--data", data, gens.file[i % 2]});
    ASSERT_GT(pid, 0);
    std::this_thread::sleep_for(std::chrono::microseconds(delay(random)));
    ::kill(pid, SIGKILL);
    int status = vpdloadtest::waitChild(pid);
    killed += status == 128 + SIGKILL;
    ASSERT_TRUE(status == 0 || status == 128 + SIGKILL) << status;
    for (const auto& t : tables(data)) {
      ASSERT_TRUE(isGeneration(gens, t.first, t.second))
          << "after kill " << i << ": live " << t.first << " is torn; " << gens.which(tables(data));
    }
    for (const auto& t : oldTables(data)) {
      ASSERT_TRUE(isGeneration(gens, t.first, t.second))
          << "after kill " << i << ": " << t.first << ".old is torn";
    }
  }
  EXPECT_GT(killed, 6) << "too few kills landed inside an import to prove anything";

  RunResult r = vpdload({"import", "--data", data, gens.file[0]});
  ASSERT_EQ(r.status, 0) << r.err;
  EXPECT_TRUE(sameFiles(tables(data), gens.ref[0]));
  EXPECT_EQ(stagingLeftovers(data), std::vector<std::string>());
}

TEST(VpdloadFaults, AWriteFailureChangesNothing) {
  struct Case {
    const char* name;
    int limit_kib;          // RLIMIT_FSIZE of the import, in KiB
    int sma, chassis, bpa;  // records of the inventory
    std::string failing;    // the record whose write meets the limit, and its table
  } cases[] = {
      {"chassis table", 16, 2, 10, 1, "chassis[7] to "},  // 7 x 2284 fit in 16384
      {"BPA table", 4, 2, 1, 5, "bpa[2] to "},            // 2 x 1508 fit in 4096
      {"SMA table", 1, 20, 0, 0, "sma[6] to "},           // 6 x 160 fit in 1024
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    TempDir tmp;
    std::string data = tmp / "data";
    ASSERT_EQ(importText(data, makeInventory(1, 1, 1, "A"), tmp / "a.json").status, 0);
    ASSERT_EQ(importText(data, makeInventory(2, 1, 1, "B"), tmp / "b.json").status, 0);
    const auto before = snapshot(data);
    testsupport::writeFile(tmp / "big.json", makeInventory(c.sma, c.chassis, c.bpa, "BIG"));

    // SIGXFSZ ignored: the write fails with EFBIG instead of killing the process.
    RunResult r = testsupport::run(
        {"/bin/bash", "-c",
         "ulimit -f " + std::to_string(c.limit_kib) + " && trap '' XFSZ && exec \"$@\"", "bash",
         vpdloadtest::vpdloadPath(), "import", "--data", data, tmp / "big.json"},
        {{"CHRONICLE_LOG", "/dev/null"}});
    EXPECT_EQ(r.status, 4);
    EXPECT_TRUE(startsWith(r.err, "vpdload: cannot write " + c.failing + data + "/.vpdload."))
        << r.err;
    EXPECT_TRUE(endsWith(r.err, ": File too large\n")) << r.err;
    EXPECT_TRUE(sameFiles(snapshot(data), before));
  }
}

// Holds the data directory's lock as another import would.
class LockHolder {
 public:
  explicit LockHolder(const std::string& data) {
    fd_ = ::open((data + "/.vpdload.lock").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0664);
    EXPECT_EQ(::flock(fd_, LOCK_EX), 0);
  }
  ~LockHolder() { release(); }
  void release() {
    if (fd_ >= 0) ::close(fd_);
    fd_ = -1;
  }

 private:
  int fd_ = -1;
};

TEST(VpdloadFaults, AHeldLockMakesOthersWaitAndGiveUp) {
  TempDir tmp;
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, makeInventory(2, 1, 1, "A"), tmp / "a.json").status, 0);
  testsupport::writeFile(tmp / "b.json", makeInventory(3, 2, 1, "B"));
  const auto before = snapshot(data);
  const std::string gave_up = "vpdload: another import holds the lock " + data +
                              "/.vpdload.lock; gave up after waiting 0.3 seconds (see --wait)\n";
  {
    LockHolder holder(data);
    RunResult imp = vpdload({"import", "--wait", "0.3", "--data", data, tmp / "b.json"});
    EXPECT_EQ(imp.status, 5);
    EXPECT_EQ(imp.err, gave_up);
    RunResult exp = vpdload({"export", "--wait=0.3", "--data", data});
    EXPECT_EQ(exp.status, 5);
    EXPECT_EQ(exp.err, gave_up);
    EXPECT_EQ(exp.out, "");
    EXPECT_TRUE(sameFiles(snapshot(data), before));

    // Released while an import waits: that import goes ahead.
    pid_t pid = vpdloadtest::spawnQuiet(
        {vpdloadtest::vpdloadPath(), "import", "--wait", "20", "--data", data, tmp / "b.json"});
    std::this_thread::sleep_for(std::chrono::milliseconds(300));
    EXPECT_TRUE(sameFiles(snapshot(data), before)) << "the import did not wait for the lock";
    holder.release();
    EXPECT_EQ(vpdloadtest::waitChild(pid), 0);
  }
  ASSERT_EQ(vpdload({"import", "--data", tmp / "ref", tmp / "b.json"}).status, 0);
  EXPECT_TRUE(sameFiles(tables(data), tables(tmp / "ref")));
  Tables previous;
  for (const auto& t : tables(data)) previous[t.first] = before.at(t.first);
  EXPECT_TRUE(sameFiles(oldTables(data), previous));
}

TEST(VpdloadFaults, TwoImportsAtOnceEndWithExactlyOneInventory) {
  TempDir tmp;
  TwoGenerations gens(tmp, 5000, 100, 10);
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, makeInventory(1, 1, 1, "PRE"), tmp / "pre.json").status, 0);
  for (int round = 0; round < 3; ++round) {
    SCOPED_TRACE("round " + std::to_string(round));
    pid_t a = vpdloadtest::spawnQuiet(
        {vpdloadtest::vpdloadPath(), "import", "--data", data, gens.file[0]});
    pid_t b = vpdloadtest::spawnQuiet(
        {vpdloadtest::vpdloadPath(), "import", "--data", data, gens.file[1]});
    EXPECT_EQ(vpdloadtest::waitChild(a), 0);
    EXPECT_EQ(vpdloadtest::waitChild(b), 0);
    Tables live = tables(data), old = oldTables(data);
    int last = live == gens.ref[0] ? 0 : live == gens.ref[1] ? 1 : -1;
    ASSERT_NE(last, -1) << "live tables mix the inventories: " << gens.which(live);
    // The import that ran first left its tables as the previous generation.
    EXPECT_TRUE(sameFiles(old, gens.ref[1 - last])) << gens.which(old);
  }
}

}  // namespace
