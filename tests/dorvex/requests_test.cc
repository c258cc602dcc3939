// End-to-end: every request form but the network one, run as the built dorvex against the
// standard installation; whole standard output and exit status.
#include "requests.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "installation.h"
#include "settings.h"

namespace dorvextest {
namespace {

class StandardInstallation : public ::testing::Test {
 protected:
  static void SetUpTestSuite() {
    inst_ = new Installation;
    fillStandard(*inst_);
  }
  static void TearDownTestSuite() {
    delete inst_;
    inst_ = nullptr;
  }
  static void check(const std::vector<RunCase>& cases) { expectRuns(*inst_, cases); }
  static Installation* inst_;
};
Installation* StandardInstallation::inst_ = nullptr;

const char kSwA[] = "7045-SW4*0C0FFEE";
const char kBpa2[] = "9458-100*02A1B2C";

std::string line(const std::string& mtms_text, const std::string& rest) {
  return mtms_text + " " + rest + "\n";
}

TEST_F(StandardInstallation, PartAndFruRequests) {
  check({
      // switch DCA
      {"dca 2",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "2"},
       "7045-SW4*0C0FFEE 80P5678 YL10DC000002 51C0\n",
       0},
      {"dca 1 without VPD", {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "1"}, "", 1},
      {"dca 3 names no DCA", {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "3"}, "", 0},
      {"dca of a missing chassis",
       {"-y", "switch", "-f", "9", "-c", "9", "-r", "dca", "-h", "2"},
       "",
       1},
      {"dca 0 of a missing chassis",
       {"-y", "switch", "-f", "9", "-c", "9", "-r", "dca", "-h", "0"},
       "",
       0},
      // switch riser
      {"riser 0",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "0"},
       "7045-SW4*0C0FFEE 21P4001 YL10RS000001 2A1F\n",
       0},
      {"riser 15",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "15"},
       "7045-SW4*0C0FFEE 21P4001 YL10RS000016 2A1F\n",
       0},
      {"riser without part number",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "1"},
       "7045-SW4*0C0FFEE  YL10RS000002 2A1F\n",
       0},
      {"riser without card id",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "2"},
       "7045-SW4*0C0FFEE 21P4001 YL10RS000003 \n",
       0},
      {"empty riser slot", {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "5"}, "", 1},
      {"riser 16", {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "16"}, "", 2},
      {"riser -2", {"-y", "switch", "-f", "2", "-c", "3", "-r", "riser", "-h", "-2"}, "", 2},
      // switches cabled to a CEC adapter
      {"switch adapter 1",
       {"-y", "switch", "-r", "adapter", "-f", "5", "-c", "2", "-h", "1"},
       "2 3 7045-SW4*0C0FFEE\n2 4 7045-SW4*0C0FFEF\n",
       0},
      {"found then missing neighbour is not written twice",
       {"-y", "switch", "-r", "adapter", "-f", "5", "-c", "2", "-h", "2"},
       "2 3 7045-SW4*0C0FFEE\n",
       1},
      {"only neighbour missing",
       {"-y", "switch", "-r", "adapter", "-f", "5", "-c", "3", "-h", "2"},
       "",
       1},
      {"adapter without SMA",
       {"-y", "switch", "-r", "adapter", "-f", "5", "-c", "7", "-h", "1"},
       "",
       1},
      // CEC adapter
      {"cec adapter 1 writes the first record",
       {"-y", "cec", "-r", "adapter", "-f", "5", "-c", "2", "-h", "1"},
       "9119-595*0212345 41V1111 YL30SM000001 5A00\n",
       0},
      {"cec adapter 2",
       {"-y", "cec", "-r", "adapter", "-f", "5", "-c", "2", "-h", "2"},
       "9119-595*0212345 41V1111 YL30SM000002 5A00\n",
       0},
      {"cec adapter without SMA",
       {"-y", "cec", "-r", "adapter", "-f", "5", "-c", "7", "-h", "1"},
       "",
       1},
      // BPA parts
      {"bpd side 1",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpd", "-a", "1", "-h", "0"},
       line(kBpa2, "12R7776 YH10BD000011 "),
       0},
      {"bpr side 2",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpr", "-a", "2", "-h", "1"},
       "9458-100*02A1B2C 12R5556 YH10BR000022 2B02\n",
       0},
      {"bpr side 1 index 2",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpr", "-a", "1", "-h", "2"},
       "9458-100*02A1B2C 12R5556 YH10BR000013 2B02\n",
       0},
      {"bpr without pn and sn",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpr", "-a", "1", "-h", "1"},
       "",
       1},
      {"bpd index 3",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpd", "-a", "1", "-h", "3"},
       "",
       2},
      {"bpr index -5",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpr", "-a", "2", "-h", "-5"},
       "",
       2},
      {"bpd without -a", {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpd", "-h", "0"}, "", 2},
      {"ibf writes nothing",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "ibf", "-a", "1", "-h", "7"},
       "",
       0},
      {"bpc is no part kind",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpc", "-a", "2", "-h", "0"},
       "",
       2},
      {"planar is no part kind",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "planar", "-h", "1"},
       "",
       2},
      {"cec planar part", {"-y", "cec", "-f", "1", "-c", "1", "-r", "planar", "-h", "1"}, "", 2},
      // FRU requests
      {"bpc side 2",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpc", "-a", "2"},
       "9458-100*02A1B2C 12R3456 YH10BC000002 2B01\n",
       0},
      {"bpc side 1",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpc", "-a", "1"},
       "9458-100*02A1B2C 12R3456 YH10BC000001 2B01\n",
       0},
      {"bpc side 3", {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpc", "-a", "3"}, "", 2},
      {"bpc of a missing BPA",
       {"-y", "bpa", "-f", "3", "-c", "255", "-r", "bpc", "-a", "1"},
       "",
       1},
      {"epo_sw writes nothing",
       {"-y", "bpa", "-f", "2", "-c", "255", "-r", "epo_sw", "-a", "1"},
       "",
       0},
      {"epo_sw of a missing BPA",
       {"-y", "bpa", "-f", "3", "-c", "255", "-r", "epo_sw", "-a", "2"},
       "",
       0},
      {"planar",
       {"-y", "switch", "-f", "2", "-c", "3", "-r", "planar"},
       line(kSwA, "53P1234 YL10AB123456 28D5"),
       0},
      {"planar of a missing chassis",
       {"-y", "switch", "-f", "9", "-c", "9", "-r", "planar"},
       "",
       1},
      {"dca without -h", {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca"}, "", 2},
      {"cec planar", {"-y", "cec", "-f", "1", "-c", "1", "-r", "planar"}, "", 2},
  });
}

TEST_F(StandardInstallation, ListingRequests) {
  const char kCecList[] = "5 2 9119-595*0212345\n5 3 9119-595*0212346\n8 1 9117-570*10ABCDE\n";
  check({
      {"bpa location", {"-y", "bpa", "-f", "2", "-c", "255"}, "2 255 9458-100*02A1B2C\n", 0},
      {"switch location", {"-y", "switch", "-f", "6", "-c", "1"}, "6 1 7045SW4X*1234567\n", 0},
      {"cec location", {"-y", "cec", "-f", "5", "-c", "2"}, "5 2 9119-595*0212345\n", 0},
      {"cec location looks at adapter 1 only", {"-y", "cec", "-f", "8", "-c", "1"}, "", 0},
      {"missing switch location", {"-y", "switch", "-f", "9", "-c", "9"}, "", 1},
      {"missing bpa location", {"-y", "bpa", "-f", "2", "-c", "3"}, "", 1},
      {"all with frame and cage", {"-y", "all", "-f", "1", "-c", "1"}, "", 2},
      {"time is ignored beside frame and cage",
       {"-y", "cec", "-f", "5", "-c", "2", "-t", "5"},
       "5 2 9119-595*0212345\n",
       0},
      // change poll: the SMA table's time is 1700000000
      {"poll from 0", {"-y", "cec", "-t", "0"}, (std::string("1700000000\n") + kCecList), 0},
      {"poll just before",
       {"-y", "cec", "-t", "1699999999"},
       (std::string("1700000000\n") + kCecList),
       0},
      {"poll at the time", {"-y", "cec", "-t", "1700000000"}, "NoChange\n", 0},
      {"poll after", {"-y", "cec", "-t", "2000000000"}, "NoChange\n", 0},
      {"poll with a frame", {"-y", "cec", "-f", "1", "-t", "1700000000"}, "NoChange\n", 0},
      {"switch poll", {"-y", "switch", "-t", "5"}, "", 2},
      // frame request
      {"switches of frame 2",
       {"-y", "switch", "-f", "2"},
       "2 3 7045-SW4*0C0FFEE\n2 4 7045-SW4*0C0FFEF\n",
       0},
      {"no switch in frame 4", {"-y", "switch", "-f", "4"}, "", 1},
      {"bpa frame", {"-y", "bpa", "-f", "4"}, "", 2},
      // MTMS request
      {"bpa by mtms", {"-y", "bpa", "-m", "9458-100*02A9999"}, "6 255 9458-100*02A9999\n", 0},
      {"switch by mtms", {"-y", "switch", "-m", "7045SW4X*1234567"}, "6 1 7045SW4X*1234567\n", 0},
      {"separator not examined",
       {"-y", "switch", "-m", "7045SW4X 1234567"},
       "6 1 7045SW4X*1234567\n",
       0},
      {"longer text", {"-y", "switch", "-m", "7045SW4X*1234567890"}, "6 1 7045SW4X*1234567\n", 0},
      {"short text has an empty serial", {"-y", "switch", "-m", "7045SW4X"}, "", 1},
      {"unknown mtms", {"-y", "bpa", "-m", "9458-100*0000000"}, "", 1},
      {"cec mtms", {"-y", "cec", "-m", "9119-595*0212345"}, "", 2},
      // dump request needs -y all
      {"no type", {"-f", "2", "-c", "3"}, "", 2},
      {"switch dump", {"-y", "switch", "-c", "3"}, "", 2},
  });
}

// Without the SMA table's time there is nothing to compare: nothing is written and the
// request counts as not performed (status 2).
TEST(ChangePoll, UnreadableTableTimeWritesNothing) {
  Installation inst;
  fillStandard(inst);
  inst.writeTables();
  vpdDB db(inst.path("data"), 1);
  for (bool readable : {true, false}) {
    if (!readable) {
      ASSERT_EQ(std::remove(inst.path("data/sma_vpd.db").c_str()), 0);
    }
    OutputCapture out;
    dorvex::type = dorvex::kTypeCec;
    dorvex::mtime = 0;
    int rc = dorvex::changePoll(db);
    EXPECT_EQ(rc == dorvex::kNothingPerformed, !readable);
    EXPECT_EQ(out.text().empty(), !readable) << out.text();
  }
}

TEST(DumpRequest, WritesTheThreeTablesInOrder) {
  Installation inst;
  smaVPD sma;
  sma.loc_id = location(5, 2, 0, SMA);
  sma.sma_fru = fru("SMA Adapter", "41V1111", "", "41V1112", "YL30SM000001", "5A00", "P1-H1");
  sma.cec_mtms = mtms("9119-595", "0212345");
  sma.neighbor_id = location(2, 3, 0, CHASSIS);
  inst.add(sma);
  const char kDump[] =
      "show chassis table:\n"
      "show SMA table:\n"
      "location id:  nwk 1 plane 0 type 1 frame 5 slot 2 chip 0 \n"
      "sma fru:     SMA Adapter 41V1111  41V1112 YL30SM000001 5A00 P1-H1\n"
      "CEC_mtms:    9119-595*0212345\n"
      "neighbor_id:  nwk 1 plane 0 type 5 frame 2 slot 3 chip 0 \n"
      "timestamp: \n"
      "\n"
      "show BPA table:\n";
  expectRuns(inst, {
                       {"all", {"-y", "all"}, kDump, 0},
                       {"all with a cage", {"-y", "all", "-c", "3"}, kDump, 0},
                       {"all with fru kind and part",
                        {"-y", "all", "-r", "dca", "-h", "1", "-a", "2"},
                        kDump,
                        0},
                       {"all with a network", {"-y", "all", "-n", "1"}, "", 2},
                   });
}

}  // namespace
}  // namespace dorvextest
