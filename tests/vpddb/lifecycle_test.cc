// Opening the tables, the ".old" generation, and the SMA table's time.
#include <sys/stat.h>
#include <utime.h>

#include "table_io.h"
#include "vpd_test_util.h"

namespace {

using testsupport::fileExists;
using testsupport::readFile;
using testsupport::writeFile;

class LifecycleTest : public vpdtest::VpdTest {};

const char* const kTables[] = {"chassis_vpd.db", "bpa_vpd.db", "sma_vpd.db"};

TEST_F(LifecycleTest, ReadWriteConstructorStartsANewGeneration) {
  struct Case {
    const char* name;
    bool live;  // the table exists before
    bool old;   // an older .old exists before
  } cases[] = {
      {"missing table, no old", false, false},
      {"missing table keeps an older old", false, true},
      {"existing table", true, false},
      {"existing table replaces older old", true, true},
  };
  mode_t saved_mask = umask(002);
  for (const Case& c : cases) {
    for (const char* t : kTables) {
      std::remove(table(t).c_str());
      std::remove((table(t) + ".old").c_str());
      if (c.live) writeFile(table(t), std::string("live ") + t);
      if (c.old) writeFile(table(t) + ".old", "older");
    }
    { vpdDB db(dataDir()); }
    for (const char* t : kTables) {
      EXPECT_EQ(testsupport::fileSize(table(t)), 0) << c.name << " " << t;
      struct stat st;
      ASSERT_EQ(stat(table(t).c_str(), &st), 0);
      EXPECT_EQ(st.st_mode & 0777, 0664u) << c.name;
      std::string old = table(t) + ".old";
      if (c.live) {
        EXPECT_EQ(readFile(old), std::string("live ") + t) << c.name;
      } else if (c.old) {
        EXPECT_EQ(readFile(old), "older") << c.name;
      } else {
        EXPECT_FALSE(fileExists(old)) << c.name;
      }
    }
  }
  umask(saved_mask);
  EXPECT_TRUE(takeTraces().empty());
}

int failRename(const char*, const char*) {
  errno = EACCES;
  return -1;
}

TEST_F(LifecycleTest, TableThatCannotBeMovedAsideIsNeverEmptied) {
  writeTables("chassis bytes", "bpa bytes", "sma bytes");
  vpd::FileOps saved = vpd::fileOps();
  vpd::fileOps().rename = failRename;
  int thrown = 0;
  try {
    vpdDB db(dataDir());
  } catch (int e) {
    thrown = e;
  }
  vpd::fileOps() = saved;
  EXPECT_EQ(thrown, 1);
  EXPECT_EQ(readFile(table("chassis_vpd.db")), "chassis bytes");
  EXPECT_EQ(readFile(table("bpa_vpd.db")), "bpa bytes");
  EXPECT_EQ(readFile(table("sma_vpd.db")), "sma bytes");
  EXPECT_EQ(takeTraces(), std::vector<std::string>{"64|vpdDB|Failed to open the chassisTbl"});
}

TEST_F(LifecycleTest, ReadOnlyConstructorChangesNothing) {
  writeTables("c", "b", "s");
  for (int arg : {0, 1, -7}) {
    vpdDB db(dataDir(), arg);
    EXPECT_EQ(readFile(table("chassis_vpd.db")), "c");
    EXPECT_EQ(readFile(table("sma_vpd.db")), "s");
    EXPECT_FALSE(fileExists(table("sma_vpd.db") + ".old"));
  }
}

TEST_F(LifecycleTest, ReadOnlyConstructorFailsOnAMissingTable) {
  struct Case {
    const char* missing;
    const char* message;
  } cases[] = {
      {"chassis_vpd.db", "Failed to open the chassisTbl"},
      {"bpa_vpd.db", "Failed to open the bpaTbl"},
      {"sma_vpd.db", "Failed to open the smaTbl"},
  };
  for (const Case& c : cases) {
    writeTables("", "", "");
    std::remove(table(c.missing).c_str());
    unsigned long opens_before = vpd::tableOpenCount();
    int thrown = 0;
    try {
      vpdDB db(dataDir(), 1);
    } catch (int e) {
      thrown = e;
    }
    EXPECT_EQ(thrown, 1) << c.missing;
    EXPECT_FALSE(fileExists(table(c.missing))) << c.missing << ": nothing created";
    EXPECT_EQ(takeTraces(), std::vector<std::string>{std::string("64|vpdDB|") + c.message});
    // Tables before the missing one were opened (and closed again), none after it.
    unsigned long expected_opens = std::string(c.missing) == "chassis_vpd.db" ? 0
                                   : std::string(c.missing) == "bpa_vpd.db"   ? 1
                                                                              : 2;
    EXPECT_EQ(vpd::tableOpenCount() - opens_before, expected_opens) << c.missing;
  }
}

TEST_F(LifecycleTest, TraceRecordCarriesTheFixedFields) {
  int thrown = 0;
  try {
    vpdDB db(dataDir() + "/nowhere", 1);
  } catch (int e) {
    thrown = e;
  }
  EXPECT_EQ(thrown, 1);
  std::vector<vpdtest::TraceRecord> t = traces();
  ASSERT_EQ(t.size(), 1u);
  EXPECT_EQ(t[0].level, "64");
  EXPECT_EQ(t[0].component, "ZRV_VPD");
  EXPECT_EQ(t[0].operation, "vpdDB");
  EXPECT_EQ(t[0].location, "0x00000000");
  EXPECT_EQ(t[0].source.substr(0, t[0].source.find(':')), "table_lifecycle.cc");
  char host[256] = {};
  gethostname(host, sizeof host - 1);
  EXPECT_EQ(t[0].host, host);
}

TEST_F(LifecycleTest, LongDataDirectoryIsNoProblem) {
  std::string dir = dataDir();
  for (int i = 0; i < 12; ++i) dir += "/" + std::string(40, 'a' + i);
  testsupport::makeDirs(dir);
  for (const char* t : kTables) writeFile(dir + "/" + t, "x");
  { vpdDB db(dir); }
  for (const char* t : kTables) EXPECT_EQ(readFile(dir + "/" + t + ".old"), "x");
  vpdDB ro(dir, 1);
  EXPECT_EQ(ro.dataDir(), dir);
}

TEST_F(LifecycleTest, CecTimestampIsTheSmaTablesModificationTime) {
  writeTables("", "", "");
  struct utimbuf times = {1000, 1234567};
  utime(table("sma_vpd.db").c_str(), &times);
  struct utimbuf other = {1000, 999};
  utime(table("chassis_vpd.db").c_str(), &other);
  vpdDB db(dataDir(), 1);
  long ts = 5;
  EXPECT_EQ(db.getCECtimestamp(ts), 0);
  EXPECT_EQ(ts, 1234567);
  std::remove(table("sma_vpd.db").c_str());
  ts = 5;
  EXPECT_EQ(db.getCECtimestamp(ts), -1);
  EXPECT_EQ(ts, 5);
  EXPECT_EQ(takeTraces(),
            std::vector<std::string>{"1|getCECtimestamp|the file status is not available"});
}

TEST_F(LifecycleTest, DefaultDataDirectoryFollowsTheInstallRoot) {
  setenv("OLV_ROOT", tmp_.path().c_str(), 1);
  EXPECT_EQ(vpdDB::defaultDataDir(), dataDir());
  setenv("OLV_ROOT", "", 1);
  EXPECT_EQ(vpdDB::defaultDataDir(), "/opt/olv/data");
  unsetenv("OLV_ROOT");
  EXPECT_EQ(vpdDB::defaultDataDir(), "/opt/olv/data");
  setenv("OLV_ROOT", (tmp_.path() + "/").c_str(), 1);
  writeTables("", "", "");
  vpdDB db(1);
  EXPECT_EQ(db.dataDir(), dataDir());
  unsetenv("OLV_ROOT");
}

}  // namespace
