// putVPD: replace in place by key, append a new key, and the faults around it.
#include <fcntl.h>
#include <unistd.h>

#include <cerrno>

#include "table_io.h"
#include "vpd_test_util.h"

namespace {

using testsupport::fileSize;
using testsupport::readFile;
using vpdtest::bytesOf;
using vpdtest::makeBpa;
using vpdtest::makeChassis;
using vpdtest::makeSma;

class RecordStoreTest : public vpdtest::VpdTest {
 protected:
  void appendBytes(const char* name, const std::string& bytes) {
    int fd = ::open(table(name).c_str(), O_WRONLY | O_APPEND);
    ASSERT_GE(fd, 0);
    ASSERT_EQ(::write(fd, bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
    ::close(fd);
  }
};

template <class Record>
int put(vpdDB& db, Record r) {
  return db.putVPD(r.loc_id, &r);
}

TEST_F(RecordStoreTest, NewKeysAreAppendedWithoutAnyTrace) {
  vpdDB db(dataDir());
  smaVPD a = makeSma(1, 2, 0), b = makeSma(1, 2, 1), c = makeSma(1, 3, 0);
  EXPECT_EQ(put(db, a), 0);
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 160);
  EXPECT_EQ(put(db, b), 0);
  EXPECT_EQ(put(db, c), 0);
  EXPECT_EQ(readFile(table("sma_vpd.db")), bytesOf(a) + bytesOf(b) + bytesOf(c));
  EXPECT_EQ(fileSize(table("chassis_vpd.db")), 0) << "other tables untouched";
  EXPECT_EQ(fileSize(table("bpa_vpd.db")), 0);
  EXPECT_TRUE(takeTraces().empty());
}

TEST_F(RecordStoreTest, StoredKeyIsReplacedInPlace) {
  struct Case {
    const char* name;
    std::function<void(vpdDB&)> store;  // stores three records, then a replacement
    const char* file;
    std::size_t size;
    std::size_t replaced;  // index of the record that must hold the replacement
  };
  bpaVPD b_new = makeBpa(3, 1, "NEW-TM", "NEWSE");
  b_new.loc_id.setChip(9);  // chip, network, plane and type do not take part in the key
  b_new.loc_id.setNetwork(5);
  b_new.loc_id.setPlane(1);
  chassisVPD c_new = makeChassis(3, 1, "NEW-TM", "NEWSE");
  c_new.loc_id.setChip(4);
  smaVPD s_new = makeSma(3, 1, 2, "NEW-PN");
  s_new.loc_id.setNetwork(3);
  Case cases[] = {
      {"bpa",
       [&](vpdDB& db) {
         put(db, makeBpa(1, 1));
         put(db, makeBpa(2, 1));
         put(db, makeBpa(3, 1));
         put(db, b_new);
       },
       "bpa_vpd.db", 1508, 2},
      {"chassis",
       [&](vpdDB& db) {
         put(db, makeChassis(3, 1));
         put(db, makeChassis(2, 1));
         put(db, makeChassis(1, 1));
         put(db, c_new);
       },
       "chassis_vpd.db", 2284, 0},
      {"sma",
       [&](vpdDB& db) {
         put(db, makeSma(3, 1, 1));
         put(db, makeSma(3, 1, 2));
         put(db, makeSma(3, 1, 3));
         put(db, s_new);
       },
       "sma_vpd.db", 160, 1},
  };
  for (const Case& c : cases) {
    vpdDB db(dataDir());
    c.store(db);
    std::string bytes = readFile(table(c.file));
    ASSERT_EQ(bytes.size(), 3 * c.size) << c.name << ": length kept";
    std::string expect = std::string(c.name) == "bpa"       ? bytesOf(b_new)
                         : std::string(c.name) == "chassis" ? bytesOf(c_new)
                                                            : bytesOf(s_new);
    EXPECT_EQ(bytes.substr(c.replaced * c.size, c.size), expect) << c.name;
    EXPECT_TRUE(takeTraces().empty()) << c.name;
  }
}

TEST_F(RecordStoreTest, SmaChipIsPartOfTheKeyButNotForTheOtherTables) {
  vpdDB db(dataDir());
  put(db, makeSma(1, 1, 1));
  put(db, makeSma(1, 1, 5));
  chassisVPD c1 = makeChassis(1, 1), c2 = makeChassis(1, 1, "OTHER");
  c2.loc_id.setChip(5);
  put(db, c1);
  put(db, c2);
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 2 * 160);
  EXPECT_EQ(readFile(table("chassis_vpd.db")), bytesOf(c2));
}

TEST_F(RecordStoreTest, StoredBytesCarryTheKeyForLaterCalls) {
  vpdDB db(dataDir());
  bpaVPD inner = makeBpa(7, 7);  // stored under 5,5 but holds 7,7
  db.putVPD(loc_id_t(5, 5, 0, BPA, 0, 0), &inner);
  bpaVPD again = makeBpa(5, 5, "SECOND");
  put(db, again);  // 5,5 is not stored: appended
  bpaVPD third = makeBpa(7, 7, "THIRD");
  put(db, third);  // 7,7 is the first record: replaced
  EXPECT_EQ(readFile(table("bpa_vpd.db")), bytesOf(third) + bytesOf(again));
}

TEST_F(RecordStoreTest, DeviceTypeWithoutTableStoresNothing) {
  vpdDB db(dataDir());
  for (unsigned type : {0u, 2u, 4u, 6u, 7u, 8u, 15u}) {
    smaVPD r = makeSma(1, 1, 1);
    loc_id_t l(1, 1, 1, type, 0, 0);
    EXPECT_EQ(db.putVPD(l, &r), 0) << type;
    std::vector<vpdtest::TraceRecord> t = traces();
    ASSERT_FALSE(t.empty());
    EXPECT_EQ(t.back().level, "1");
    EXPECT_EQ(t.back().operation, "putVPD");
    EXPECT_EQ(t.back().message, "unknow type, " + std::to_string(type) + "\\n");
    char loc[16];
    std::snprintf(loc, sizeof loc, "0x%08x", l.toInt());
    EXPECT_EQ(t.back().location, loc);
  }
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 0);
}

TEST_F(RecordStoreTest, PartialTrailingRecordIsOverwrittenNotFollowed) {
  vpdDB db(dataDir());
  smaVPD a = makeSma(1, 1, 0), b = makeSma(1, 1, 1);
  put(db, a);
  put(db, b);
  takeTraces();
  appendBytes("sma_vpd.db", std::string(7, 'Z'));  // a producer died mid-record
  smaVPD c = makeSma(2, 2, 0);
  EXPECT_EQ(put(db, c), 0);
  EXPECT_EQ(readFile(table("sma_vpd.db")), bytesOf(a) + bytesOf(b) + bytesOf(c));
  EXPECT_EQ(takeTraces(), std::vector<std::string>{"64|putVPD|Failed to read the smaTbl"});
  smaVPD d = makeSma(2, 2, 1);
  put(db, d);
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 4 * 160);
  EXPECT_TRUE(takeTraces().empty()) << "the table is whole again";
  // A key stored before the damage is still replaced in place.
  smaVPD b2 = makeSma(1, 1, 1, "B2");
  appendBytes("sma_vpd.db", "Q");
  put(db, b2);
  EXPECT_EQ(readFile(table("sma_vpd.db")).substr(160, 160), bytesOf(b2));
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 4 * 160 + 1);
}

TEST_F(RecordStoreTest, ReadOnlyDatabaseTracesEveryWriteFailure) {
  writeTables("", "", bytesOf(makeSma(1, 1, 0)));
  vpdDB db(dataDir(), 1);
  smaVPD r = makeSma(1, 1, 0, "NEW");
  EXPECT_NE(put(db, r), 0);
  chassisVPD c = makeChassis(1, 1);
  EXPECT_NE(put(db, c), 0);
  EXPECT_EQ(takeTraces(),
            (std::vector<std::string>{"64|putVPD|Failed to write to the smaTbl",
                                      "64|putVPD|Failed to write to the chassisTbl"}));
  EXPECT_EQ(readFile(table("sma_vpd.db")), bytesOf(makeSma(1, 1, 0)));
}

// Replaces one file operation for the life of the object.
class FailingOp {
 public:
  FailingOp() : saved_(vpd::fileOps()) {}
  ~FailingOp() { vpd::fileOps() = saved_; }

 private:
  vpd::FileOps saved_;
};

ssize_t failWrite(int, const void*, size_t, off_t) {
  errno = ENOSPC;
  return -1;
}
ssize_t halfWrite(int fd, const void* buf, size_t n, off_t off) {
  vpd::fileOps().pwrite = failWrite;  // the second part fails
  return ::pwrite(fd, buf, n / 2, off);
}
ssize_t failRead(int, void*, size_t, off_t) {
  errno = EIO;
  return -1;
}

TEST_F(RecordStoreTest, FailedWriteIsReportedAndTheNextStoreRecovers) {
  vpdDB db(dataDir());
  smaVPD a = makeSma(1, 1, 0);
  put(db, a);
  {
    FailingOp guard;
    vpd::fileOps().pwrite = halfWrite;
    smaVPD b = makeSma(1, 1, 1);
    EXPECT_EQ(put(db, b), -1);
  }
  EXPECT_EQ(takeTraces(), std::vector<std::string>{"64|putVPD|Failed to write to the smaTbl"});
  EXPECT_EQ(fileSize(table("sma_vpd.db")), 160 + 80);
  smaVPD c = makeSma(1, 1, 4);
  EXPECT_EQ(put(db, c), 0);
  EXPECT_EQ(readFile(table("sma_vpd.db")), bytesOf(a) + bytesOf(c));
}

TEST_F(RecordStoreTest, ReadErrorEndsTheStoreWithoutWriting) {
  vpdDB db(dataDir());
  smaVPD a = makeSma(1, 1, 0);
  put(db, a);
  appendBytes("sma_vpd.db", "X");  // forces the table to be read again
  {
    FailingOp guard;
    vpd::fileOps().pread = failRead;
    smaVPD b = makeSma(1, 1, 1);
    EXPECT_EQ(put(db, b), -1);
  }
  EXPECT_EQ(takeTraces(), std::vector<std::string>{"64|putVPD|Failed to read the smaTbl"});
  EXPECT_EQ(readFile(table("sma_vpd.db")), bytesOf(a) + "X");
}

TEST_F(RecordStoreTest, LookupsSeeWhatWasJustStored) {
  vpdDB db(dataDir());
  put(db, makeChassis(4, 4));
  chassisVPD out;
  EXPECT_EQ(db.getSwitchvpd(4, 4, out), 0);
  chassisVPD replaced = makeChassis(4, 4, "REPL");
  put(db, replaced);
  EXPECT_EQ(db.getSwitchvpd(4, 4, out), 0);
  EXPECT_EQ(out.sw_mtms.getTM(), "REPL");
}

}  // namespace
