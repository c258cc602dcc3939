// showVPD: the exact bytes of each table's layout.
#include <cstring>

#include "vpd_test_util.h"

namespace {

using vpdtest::bytesOf;

class DumpTest : public vpdtest::VpdTest {
 protected:
  std::string dump(table_t t) {
    vpdDB db(dataDir(), 1);
    testing::internal::CaptureStdout();
    EXPECT_EQ(db.showVPD(t), 0);
    std::fflush(stdout);
    return testing::internal::GetCapturedStdout();
  }
};

const std::string kEmptyFru = "      ";  // seven empty fields, six separators

TEST_F(DumpTest, EmptyTablesPrintTheHeadingAndTrace) {
  struct Case {
    table_t table;
    std::string out;
    std::string trace;
  } cases[] = {
      {SMA_TABLE, "show SMA table:\n", "1|showVPD|The sma table is empty "},
      {CHASSIS_TABLE, "show chassis table:\n", "1|showVPD|The switch chassis table is empty "},
      {BPA_TABLE, "show BPA table:\n", "1|showVPD|The bpa table is empty "},
  };
  writeTables("", "", std::string(100, 'x'));  // shorter than a record counts as empty
  for (const Case& c : cases) {
    EXPECT_EQ(dump(c.table), c.out);
    EXPECT_EQ(takeTraces(), std::vector<std::string>{c.trace});
  }
  EXPECT_EQ(dump(static_cast<table_t>(4)), "");
  EXPECT_EQ(takeTraces(), std::vector<std::string>{"1|showVPD|unknown table name 4"});
}

TEST_F(DumpTest, SmaRecords) {
  smaVPD r;
  r.loc_id = loc_id_t(2, 5, 3, SMA, 0, 1);
  r.sma_fru = fru_stanza("SMA adapter", "PN1", "", "FN1", "SN1", "CC1", "YL1");
  std::memcpy(r.sma_fru.ds, std::string(31, 'D').data(), 31);  // 31 printable: 30 shown
  r.cec_mtms = mtms("7040-681", "10ABCDE");
  r.neighbor_id = loc_id_t(3, 2, 0, CHASSIS, 1, 7);
  r.setTimestamp("2026-12-01");
  smaVPD empty;
  writeTables("", "", bytesOf(r) + bytesOf(empty) + "partial");
  EXPECT_EQ(dump(SMA_TABLE),
            "show SMA table:\n"
            "location id:  nwk 1 plane 0 type 1 frame 2 slot 5 chip 3 \n"
            "sma fru:     " +
                std::string(30, 'D') +
                " PN1  FN1 SN1 CC1 YL1\n"
                "CEC_mtms:    7040-681*10ABCDE\n"
                "neighbor_id:  nwk 7 plane 1 type 5 frame 3 slot 2 chip 0 \n"
                "timestamp: 2026-12-01\n"
                "\n"
                "location id:  nwk 0 plane 0 type 0 frame 0 slot 0 chip 0 \n"
                "sma fru:     " +
                kEmptyFru +
                "\n"
                "CEC_mtms:    *\n"
                "neighbor_id:  nwk 0 plane 0 type 0 frame 0 slot 0 chip 0 \n"
                "timestamp: \n"
                "\n");
  EXPECT_TRUE(takeTraces().empty());
}

TEST_F(DumpTest, ChassisRecord) {
  chassisVPD r;
  r.loc_id = loc_id_t(3, 2, 0, CHASSIS, 0, 1);
  r.sw_mtms = mtms("7045-SW4", "20SWTCH");
  r.sw_fru = fru_stanza("Switch", "SWPN", "SWEC", "SWFN", "SWSN", "SWCC", "P1");
  r.dca2_fru = fru_stanza("DCA", "DPN", "", "DFN", "", "", "");
  r.riser[1].nbr1 = loc_id_t(4, 1, 4, NSB, 0, 1);
  r.riser[1].port1 = -3;
  r.riser[1].riser_fru = fru_stanza("Riser", "RPN", "", "RFN", "RSN", "", "C2");
  r.setTimestamp("2026-12-01 11:00\x01tail");
  writeTables(bytesOf(r), "", "");
  const std::string zero = " nwk 0 plane 0 type 0 frame 0 slot 0 chip 0 ";
  std::string risers;
  for (int i = 0; i < 16; ++i) {
    if (i == 1) {
      risers +=
          "\nneighbor1:  nwk 1 plane 0 type 0 frame 4 slot 1 chip 4  port -3"
          "\nneighbor2: " +
          zero +
          " port 0"
          "\nriser fru: Riser RPN  RFN RSN  C2\n";
    } else {
      risers += "\nneighbor1: " + zero + " port 0\nneighbor2: " + zero +
                " port 0\nriser fru: " + kEmptyFru + "\n";
    }
  }
  EXPECT_EQ(dump(CHASSIS_TABLE),
            "show chassis table:\n"
            "location id:  nwk 1 plane 0 type 5 frame 3 slot 2 chip 0 \n"
            "switch mtms:\n 7045-SW4*20SWTCH\n"
            "switch fru: \n Switch SWPN SWEC SWFN SWSN SWCC P1\n"
            "dca1 fru: \n " +
                kEmptyFru +
                "\n"
                "dca2 fru: \n DCA DPN  DFN   \n"
                "riser card data include neighbor info:  \n" +
                risers + "2026-12-01 11:00\n\n");
}

TEST_F(DumpTest, BpaRecord) {
  bpaVPD r;
  r.loc_id = loc_id_t(1, 255, 0, BPA, 0, 0);
  r.frame_mtms = mtms("9458-100", "02A1B2C");
  r.bpc1_fru = fru_stanza("BPC", "C1", "", "F1", "S1", "", "");
  r.bpr1_fru[2] = fru_stanza("BPR", "R3", "", "F3", "", "", "");
  r.bpd2_fru[0] = fru_stanza("BPD", "D1", "", "", "", "", "");
  r.bpc2_fru = fru_stanza("BPC2", "", "", "", "", "", "");
  r.setTimestamp("ts");
  writeTables("", bytesOf(r), "");
  const std::string e = kEmptyFru;
  EXPECT_EQ(dump(BPA_TABLE),
            "show BPA table:\n"
            "location id:    nwk 0 plane 0 type 3 frame 1 slot 255 chip 0 \n"
            "frame mtms:    9458-100*02A1B2C\n"
            "bpa1:  \n"
            "bpc fru:       BPC C1  F1 S1  \n"
            "bpr fru:       " +
                e +
                " \n"
                "bpr fru:       " +
                e +
                " \n"
                "bpr fru:       BPR R3  F3    \n"
                "bpd fru:       " +
                e +
                " \n"
                "bpd fru:       " +
                e +
                " \n"
                "bpd fru:       " +
                e +
                " \n"
                "bpa2: \n"
                "bpc fru:      BPC2      \n"
                "bpr fru:       " +
                e +
                " \n"
                "bpr fru:       " +
                e +
                " \n"
                "bpr fru:       " +
                e +
                " \n"
                "bpd fru:       BPD D1      \n"
                "bpd fru:       " +
                e +
                " \n"
                "bpd fru:       " +
                e +
                " \n"
                "ts\n"
                "\n");
}

}  // namespace
