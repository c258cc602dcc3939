// The writers, with their output captured through the output stream seam.
#include <gtest/gtest.h>

#include <climits>
#include <cstdio>
#include <cstring>
#include <string>

#include "installation.h"
#include "output_stream.h"
#include "record_output.h"
#include "settings.h"
#include "switch_netvpd.h"

namespace dorvextest {
namespace {

TEST(Writers, SummaryLines) {
  struct {
    const char* name;
    mtms m;
    const char *pn, *fn, *cc;
    const char* out;
    int prc;
  } fru_lines[] = {
      {"all set", mtms("7045-SW4", "0C0FFEE"), "53P1234", "YL10AB123456", "28D5",
       "7045-SW4*0C0FFEE 53P1234 YL10AB123456 28D5\n", 0},
      {"no card id", mtms("7045-SW4", "0C0FFEE"), "53P1234", "YL10AB123456", "",
       "7045-SW4*0C0FFEE 53P1234 YL10AB123456 \n", 0},
      {"serial only", mtms("7045-SW4", "0C0FFEE"), "", "YL10AB123456", "28D5",
       "7045-SW4*0C0FFEE  YL10AB123456 28D5\n", 0},
      {"part number only", mtms(), "53P1234", "", "", "* 53P1234  \n", 0},
      {"nothing", mtms("7045-SW4", "0C0FFEE"), "", "", "", "", 1},
      {"card id only", mtms("7045-SW4", "0C0FFEE"), "", "", "28D5", "", 1},
      {"unprintable third character",
       mtms("ab\x01"
            "defgh",
            "1\x7f"),
       "P", "S", "C", "ab*1 P S C\n", 0},
  };
  for (const auto& c : fru_lines) {
    OutputCapture out;
    EXPECT_EQ(dorvex::outputpnsn(c.m, c.pn, c.fn, c.cc), 0) << c.name;
    EXPECT_EQ(out.text(), c.out) << c.name;
    EXPECT_EQ(dorvex::prc, c.prc) << c.name;
  }

  struct {
    const char* name;
    loc_id_t loc;
    mtms m;
    const char* out;
    int prc;
  } enclosure_lines[] = {
      {"empty mtms", location(12, 3, 0, CHASSIS), mtms(), "12 3 *\n", 0},
      {"frame and cage 0", location(0, 0, 5, CHASSIS), mtms("7045-SW4", "0C0FFEE"), "", 1},
      {"frame 0", location(0, 5, 0, CHASSIS), mtms("7045-SW4", "0C0FFEE"), "0 5 7045-SW4*0C0FFEE\n",
       0},
      {"cage 0", location(7, 0, 0, BPA), mtms("9458-100", ""), "7 0 9458-100*\n", 0},
      {"widest location", loc_id_t(0xffffffffu), mtms("12345678", "1234567"),
       "4095 255 12345678*1234567\n", 0},
  };
  for (const auto& c : enclosure_lines) {
    OutputCapture out;
    EXPECT_EQ(dorvex::outputmtms(c.m, c.loc), 0) << c.name;
    EXPECT_EQ(out.text(), c.out) << c.name;
    EXPECT_EQ(dorvex::prc, c.prc) << c.name;
  }
}

TEST(Writers, FruStanzas) {
  fru_stanza full_width;
  std::memset(static_cast<void*>(&full_width), 'A',
              sizeof full_width);  // no terminator in any field
  mtms full_mtms;
  std::memset(static_cast<void*>(&full_mtms), 'B', sizeof full_mtms);
  const std::string a30(30, 'A'), a15(15, 'A'), a12(12, 'A');

  struct {
    const char* name;
    fru_stanza fru;
    mtms m;
    int sw_result;
    std::string sw_out, bpa_out;
  } cases[] = {
      {"all set", fru("Riser Card", "21P4001", "E1", "21P4002", "YL10RS000001", "2A1F", "P1-C1"),
       mtms("7045SW4X", "1234567"), 0,
       "*FC ????????\n*DS Riser Card\n*PN 21P4001\n*EC E1\n*FN 21P4002\n*SN YL10RS000001\n"
       "*YL U7045SW4X*1234567-P1-C1\n*CC 2A1F\n",
       "*FC ????????\n*DS Riser Card\n*YL U1.35-P1-C1\n*SN YL10RS000001\n*CC 2A1F\n"
       "*FN 21P4002\n*VK TQ4M\n"},
      {"empty fields keep their blank", fru("", "21P4001", "", "21P4002", "", "", ""), mtms(), 0,
       "*FC ????????\n*DS \n*PN 21P4001\n*EC \n*FN 21P4002\n*SN \n*YL U*-\n*CC \n",
       "*FC ????????\n*DS \n*YL U1.35-\n*SN \n*CC \n*FN 21P4002\n*VK TQ4M\n"},
      {"no FRU number", fru("D", "21P4001", "E", "", "S", "C", "Y"), mtms(), 1, "", ""},
      {"no part number", fru("D", "", "E", "21P4002", "S", "C", "Y"), mtms(), 1, "", ""},
      {"fields at full width", full_width, full_mtms, 0,
       "*FC ????????\n*DS " + a30 + "\n*PN " + a12 + "\n*EC " + a12 + "\n*FN " + a12 + "\n*SN " +
           a12 + "\n*YL UBBBBBBBB*BBBBBBB-" + a15 + "\n*CC AAAA\n",
       "*FC ????????\n*DS " + a30 + "\n*YL U1.35-" + a15 + "\n*SN " + a12 + "\n*CC AAAA\n*FN " +
           a12 + "\n*VK TQ4M\n"},
  };
  for (const auto& c : cases) {
    {
      OutputCapture out;
      EXPECT_EQ(dorvex::outputfruSW(c.fru, c.m), c.sw_result) << c.name;
      EXPECT_EQ(out.text(), c.sw_out) << c.name;
    }
    OutputCapture out;
    dorvex::outputfruBPA(c.fru, c.m);
    EXPECT_EQ(out.text(), c.bpa_out) << c.name;
  }
}

TEST(Writers, RiserNumbers) {
  struct {
    int n;
    const char* text;
  } cases[] = {{1, "1"}, {9, "9"}, {10, "10"}, {16, "16"},    {0, ""},
               {17, ""}, {-1, ""}, {99, ""},   {INT_MIN, ""}, {INT_MAX, ""}};
  for (const auto& c : cases) EXPECT_EQ(dorvex::riseritoa(c.n), c.text) << c.n;
}

// Cable lines from riser jacks of the chassis 7045-SW4*0C0FFEE to far ends of the standard
// installation: the switch 7045-SW4*0C0FFEF at (2, 4), the CEC 9119-595*0212345 at (5, 2).
TEST(Writers, CableLines) {
  Installation inst;
  fillStandard(inst);
  inst.writeTables();
  vpdDB db(inst.path("data"), 1);
  const std::string local = "*CB \"U7045-SW40C0FFEE-P1-C1-T1\" ";
  struct {
    const char* name;
    loc_id_t far;
    int port, fromriser, fromjack;
    std::string out;
  } cases[] = {
      {"port 0", location(2, 4, 0, NSB), 0, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C9-T1\"\n"},
      {"port 1", location(2, 4, 1, ISB), 1, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C5-T2\"\n"},
      {"port 2", location(2, 4, 2, NSB), 2, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C14-T1\"\n"},
      {"port 3", location(2, 4, 4, NSB), 3, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C16-T2\"\n"},
      {"chip 7 port 3", location(2, 4, 7, NSB), 3, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C8-T2\"\n"},
      {"chip 3 port 4", location(2, 4, 3, NSB), 4, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C1-T\"\n"},
      {"chip 5 port -1", location(2, 4, 5, NSB), -1, 0, 1,
       local + "\"U7045-SW40C0FFEF-P1-C3-T\"\n"},
      {"chip 6", location(2, 4, 6, NSB), 0, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C11-T1\"\n"},
      {"chip 8", location(2, 4, 8, NSB), 0, 0, 1, local + "\"U7045-SW40C0FFEF-P1-C-T1\"\n"},
      {"chip 15 port 3", location(2, 4, 15, ISB), 3, 0, 1,
       local + "\"U7045-SW40C0FFEF-P1-C-T2\"\n"},
      {"missing far switch", location(3, 3, 0, NSB), 0, 0, 1, local + "\"U-P1-C9-T1\"\n"},
      {"frame 0 is still a far end", location(0, 5, 0, NSB), 0, 0, 1, local + "\"U-P1-C9-T1\"\n"},
      {"no far end", loc_id_t(0), 3, 0, 1, local + "\"\"\n"},
      {"sma chip 0", location(5, 2, 0, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H1Q3\"\n"},
      {"sma chip 1", location(5, 2, 1, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H1Q4\"\n"},
      {"sma chip 2", location(5, 2, 2, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H4Q3\"\n"},
      {"sma chip 3", location(5, 2, 3, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H4Q4\"\n"},
      {"sma chip 4", location(5, 2, 4, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H1Q1\"\n"},
      {"sma chip 5", location(5, 2, 5, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H1Q2\"\n"},
      {"sma chip 6", location(5, 2, 6, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H4Q1\"\n"},
      {"sma chip 7", location(5, 2, 7, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-H4Q2\"\n"},
      {"sma chip 8", location(5, 2, 8, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-HQ\"\n"},
      {"sma chip 15", location(5, 2, 15, SMA), 0, 0, 1, local + "\"U9119-5950212345-P1-HQ\"\n"},
      {"cec without adapter 1", location(8, 1, 3, SMA), 0, 0, 1, local + "\"U-P1-H4Q4\"\n"},
      {"missing cec", location(9, 9, 5, SMA), 0, 0, 1, local + "\"U-P1-H1Q2\"\n"},
      {"bpa far end", location(2, 255, 0, BPA), 0, 0, 1, ""},
      {"dca far end", location(2, 4, 0, DCA), 0, 0, 1, ""},
      {"chassis far end", location(2, 4, 0, CHASSIS), 0, 0, 1, ""},
      {"board far end", location(2, 4, 0, BOARD), 0, 0, 1, ""},
      {"riser far end", location(2, 4, 0, RISER), 0, 0, 1, ""},
      {"type 8", loc_id_t(2, 4, 0, 8, 0, 0), 0, 0, 1, ""},
      {"type 15", loc_id_t(2, 4, 0, 15, 0, 0), 0, 0, 1, ""},
      {"last reported slot, jack 2", loc_id_t(0), 0, 14, 2,
       "*CB \"U7045-SW40C0FFEE-P1-C15-T2\" \"\"\n"},
      {"slot 15", loc_id_t(0), 0, 15, 1, "*CB \"U7045-SW40C0FFEE-P1-C16-T1\" \"\"\n"},
      {"slot out of range", loc_id_t(0), 0, 16, 0, "*CB \"U7045-SW40C0FFEE-P1-C-T\" \"\"\n"},
  };
  for (const auto& c : cases) {
    OutputCapture out;
    EXPECT_EQ(dorvex::outputCBinfo(db, mtms("7045-SW4", "0C0FFEE"), c.far, c.port, c.fromriser,
                                   c.fromjack),
              0)
        << c.name;
    EXPECT_EQ(out.text(), c.out) << c.name;
  }
}

}  // namespace
}  // namespace dorvextest
