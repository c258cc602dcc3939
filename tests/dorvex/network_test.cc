// End-to-end: network requests over the chip list of a scripted dump tool, with the
// consoles of etc/hwserver.json.
#include <gtest/gtest.h>

#include <cstdio>

#include "installation.h"

namespace dorvextest {
namespace {

const char kHwserver[] = R"({
  "consoles": [
    { "ip": "10.0.0.5", "tm": "7042CR4", "se": "10ABCDE", "bpa_vports": [1, 2] },
    { "ip": "10.0.0.6", "tm": "7042-CR5", "se": "1122334", "bpa_vports": [1, 1] }
  ],
  "bpas": [
    { "vport": 1, "tm": "9458-100", "se": "02A1B2C" },
    { "vport": 2, "tm": "9458-100", "se": "02A9999" }
  ]
})";

// Network 1: (2,3) twice, (6,0), (6,1), (2,4); the other lines do not count for it.
const char kDump[] =
    "FRAME CAGE TYPE\n"
    "2 3 SW_CHIP 0 1 1\n"
    "2 3 SW_CHIP 1 1 1\n"
    "6 0 SW_CHIP 0 0 1\n"
    "6  1 SW_CHIP 0 1   1\n"
    "2 4 SW_CHIPX 0 1 01\n"
    "9 9 BPA 0 0 1\n"
    "5 2 SW_CHIP 0 0 2\n"
    "2\t4\tSW_CHIP\t0\t0\t1\n";

const char kSwitchA[] =
    "*FC ????????\n*DS 4 GB Switch\n*YL U7045-SW4*0C0FFEE\n*SE 0C0FFEE\n*TM 7045-SW4\n"
    "*MN QOR\n*N2 2026-01-15 10:20:30\n"
    "*V1 \"7042CR4\" \"10ABCDE\"\n*V1 \"7042-CR5\" \"1122334\"\n*V1 \"7042-CR5\" \"1122334\"\n"
    "*RD \"9458-100\" \"02A1B2C\"\n"
    "*FC ????????\n*DS Switch Board\n*PN 53P1234\n*EC H12345\n*FN 53P1235\n*SN YL10AB123456\n"
    "*YL U7045-SW4*0C0FFEE-P1\n*CC 28D5\n"
    "*FC ????????\n*DS DC Assembly\n*PN 80P5678\n*EC \n*FN 80P5679\n*SN YL10DC000002\n"
    "*YL U7045-SW4*0C0FFEE-P1-V2\n*CC 51C0\n"
    "*FC ????????\n*DS Riser Card\n*PN 21P4001\n*EC E1\n*FN 21P4002\n*SN YL10RS000001\n"
    "*YL U7045-SW4*0C0FFEE-P1-C1\n*CC 2A1F\n"
    "*CB \"U7045-SW40C0FFEE-P1-C1-T1\" \"U7045-SW40C0FFEF-P1-C16-T2\"\n"
    "*CB \"U7045-SW40C0FFEE-P1-C1-T2\" \"U9119-5950212345-P1-H1Q2\"\n"
    "*FC ????????\n*DS Riser Card\n*PN 21P4001\n*EC E1\n*FN 21P4002\n*SN YL10RS000003\n"
    "*YL U7045-SW4*0C0FFEE-P1-C3\n*CC \n"
    "*CB \"U7045-SW40C0FFEE-P1-C3-T1\" \"\"\n"
    "*FC ????????\n*DS Riser Card\n*PN 21P4001\n*EC E1\n*FN 21P4002\n*SN YL10RS000004\n"
    "*YL U7045-SW4*0C0FFEE-P1-C4\n*CC 2A1F\n"
    "*CB \"U7045-SW40C0FFEE-P1-C4-T1\" \"U7045-SW40C0FFEF-P1-C9-T\"\n"
    "*CB \"U7045-SW40C0FFEE-P1-C4-T2\" \"U7045-SW40C0FFEF-P1-C-T1\"\n"
    "*FC ????????\n*DS Riser Card\n*PN 21P4001\n*EC E1\n*FN 21P4002\n*SN YL10RS000005\n"
    "*YL U7045-SW4*0C0FFEE-P1-C5\n*CC 2A1F\n"
    "*CB \"U7045-SW40C0FFEE-P1-C5-T1\" \"U-P1-C5-T2\"\n"
    "*CB \"U7045-SW40C0FFEE-P1-C5-T2\" \"U9119-5950212345-P1-HQ\"\n";

const char kSwitchCHeader[] =
    "*FC ????????\n*DS 4 GB Switch\n*YL U7045SW4X*1234567\n*SE 1234567\n*TM 7045SW4X\n"
    "*MN QOR\n*N2 Thu Jan 15 10:20:30 2026 UT\n";
const char kSwitchCRest[] =
    "*RD \"9458-100\" \"02A9999\"\n"
    "*FC ????????\n*DS Switch Board\n*PN 53P9999\n*EC \n*FN 53P9998\n*SN YL10AB999999\n"
    "*YL U7045SW4X*1234567-P1\n*CC 28D6\n";

const char kSwitchB[] =
    "*FC ????????\n*DS 4 GB Switch\n*YL U7045-SW4*0C0FFEF\n*SE 0C0FFEF\n*TM 7045-SW4\n"
    "*MN QOR\n*N2 \n"
    "*V1 \"7042CR4\" \"10ABCDE\"\n*V1 \"7042-CR5\" \"1122334\"\n*V1 \"7042-CR5\" \"1122334\"\n"
    "*RD \"9458-100\" \"02A1B2C\"\n"
    "*FC ????????\n*DS Switch Board\n*PN 53P1234\n*EC H12345\n*FN 53P1235\n*SN YL10AB654321\n"
    "*YL U7045-SW4*0C0FFEF-P1\n*CC 28D5\n";

const char kBpaFrame2[] =
    "*FC ????????\n*VC 5.0\n*DS MT/M Serial VPD\n*YK BPA\n*YL U1.35\n*SE 02A1B2C\n"
    "*TM 9458-100\n*VK TQ4M\n"
    "*FC ????????\n*DS BPC\n*YL U1.35-P1-C1\n*SN YH10BC000001\n*CC 2B01\n*FN 12R3457\n*VK TQ4M\n"
    "*FC ????????\n*DS BPR\n*YL U1.35-P1-E3\n*SN YH10BR000013\n*CC 2B02\n*FN 12R5557\n*VK TQ4M\n"
    "*FC ????????\n*DS BPD\n*YL U1.35-P1-D1\n*SN YH10BD000011\n*CC \n*FN 12R7777\n*VK TQ4M\n"
    "*FC ????????\n*DS BPC\n*YL U1.35-P2-C1\n*SN YH10BC000002\n*CC 2B01\n*FN 12R3457\n*VK TQ4M\n"
    "*FC ????????\n*DS BPR\n*YL U1.35-P2-E2\n*SN YH10BR000022\n*CC 2B02\n*FN 12R5557\n*VK TQ4M\n";

const char kBpaFrame6[] =
    "*FC ????????\n*VC 5.0\n*DS MT/M Serial VPD\n*YK BPA\n*YL U1.35\n*SE 02A9999\n"
    "*TM 9458-100\n*VK TQ4M\n"
    "*FC ????????\n*DS BPD\n*YL U1.35-P2-D3\n*SN YH10BD000623\n*CC 2B03\n*FN 12R7777\n*VK TQ4M\n";

const char kEmptyBpa[] =
    "*FC ????????\n*VC 5.0\n*DS MT/M Serial VPD\n*YK BPA\n*YL U1.35\n*SE \n*TM \n*VK TQ4M\n";

class Network : public ::testing::Test {
 protected:
  void SetUp() override {
    fillStandard(inst_);
    inst_.setHwserver(kHwserver);
    inst_.setDump(kDump);
  }
  Installation inst_;
};

TEST_F(Network, EnclosureLines) {
  expectRuns(inst_,
             {
                 {"switches of network 1",
                  {"-y", "switch", "-n", "1"},
                  "2 3 7045-SW4*0C0FFEE\n6 1 7045SW4X*1234567\n2 4 7045-SW4*0C0FFEF\n",
                  0},
                 {"bpas of the frames of network 1",
                  {"-y", "bpa", "-n", "1"},
                  "2 255 9458-100*02A1B2C\n6 255 9458-100*02A9999\n",
                  0},
                 {"a position without a chassis still counts", {"-y", "switch", "-n", "2"}, "", 0},
                 {"a frame without a BPA still counts", {"-y", "bpa", "-n", "2"}, "", 0},
                 {"empty network", {"-y", "switch", "-n", "3"}, "", 1},
                 {"empty network, bpa", {"-y", "bpa", "-n", "3"}, "", 1},
                 {"empty network, netvpd", {"-y", "netvpd", "-n", "3"}, "", 1},
                 {"cec has no network branch", {"-y", "cec", "-n", "1"}, "", 2},
             });
}

TEST_F(Network, NetworkVpdWithConsolesCablesAndBpas) {
  std::string expected = std::string(kSwitchA) + kSwitchCHeader + "*V1 \"7042CR4\" \"10ABCDE\"\n" +
                         kSwitchCRest + kSwitchB + kBpaFrame2 + kBpaFrame6;
  expectRuns(inst_, {{"netvpd 1", {"-y", "netvpd", "-n", "1"}, expected, 0}});
}

TEST_F(Network, NetworkVpdWithoutConsoles) {
  std::remove(inst_.path("etc/hwserver.json").c_str());
  inst_.setDump("6 1 SW_CHIP 0 0 1\n");
  std::string expected = std::string(kSwitchCHeader) + kSwitchCRest + kBpaFrame6;
  expectRuns(inst_, {{"no hwserver.json", {"-y", "netvpd", "-n", "1"}, expected, 0}});
}

TEST_F(Network, NetworkVpdOfAPositionWithoutRecords) {
  inst_.setDump("9 9 SW_CHIP 0 0 1\n");
  std::string expected =
      "*FC ????????\n*DS 4 GB Switch\n*YL U*\n*SE \n*TM \n*MN QOR\n*N2 \n*RD \"\" \"\"\n" +
      std::string(kEmptyBpa);
  expectRuns(inst_, {{"empty records", {"-y", "netvpd", "-n", "1"}, expected, 0}});
}

// A frame whose first listed chip has cage 0 still gets its one BPA stanza.
TEST_F(Network, EveryFrameWithASwitchStanzaGetsOneBpaStanza) {
  inst_.setDump("6 0 SW_CHIP 0 0 1\n6 1 SW_CHIP 0 0 1\n6 1 SW_CHIP 1 0 1\n");
  std::string expected =
      std::string(kSwitchCHeader) + "*V1 \"7042CR4\" \"10ABCDE\"\n" + kSwitchCRest + kBpaFrame6;
  expectRuns(inst_, {{"cage 0 first", {"-y", "netvpd", "-n", "1"}, expected, 0}});
}

}  // namespace
}  // namespace dorvextest
