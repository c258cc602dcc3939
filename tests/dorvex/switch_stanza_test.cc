// The header and cable lines of a switch stanza with MTMS and timestamps that fill their
// fields: each line shows a field up to its first NUL and never past its width, and the
// location lines show the MTMS text form (printable characters only).
#include <gtest/gtest.h>

#include <cstdio>
#include <cstring>
#include <string>

#include "console_discovery.h"
#include "installation.h"
#include "switch_netvpd.h"

namespace dorvextest {
namespace {

// An MTMS from its 17 raw bytes: 8 of type-model, the terminator byte, 7 of serial and the
// terminator byte. Shorter texts are padded with 'Z', so no field ends before its width
// unless the text says so.
mtms rawMtms(const std::string& tm9, const std::string& se8) {
  mtms m;
  std::memset(static_cast<void*>(&m), 'Z', sizeof m);
  std::memcpy(m.tm, tm9.data(), std::min(tm9.size(), sizeof m.tm));
  std::memcpy(m.se, se8.data(), std::min(se8.size(), sizeof m.se));
  return m;
}

TEST(SwitchStanza, FieldsStopAtTheirNulAndTheirWidth) {
  Installation inst;
  chassisVPD far;
  far.loc_id = location(2, 4, 0, CHASSIS);
  inst.add(far);
  inst.writeTables();
  {  // the far chassis's MTMS fills both fields, terminators included
    chassisVPD raw = far;
    raw.sw_mtms = rawMtms("FARTMXYZ!", "FARSE77!");
    FILE* f = std::fopen(inst.path("data/chassis_vpd.db").c_str(), "r+b");
    ASSERT_NE(f, nullptr);
    ASSERT_EQ(std::fwrite(&raw, sizeof raw, 1, f), 1u);
    std::fclose(f);
  }
  vpdDB db(inst.path("data"), 1);
  dorvex::zev.clear();

  const std::string full_ts(28, 'T');
  struct {
    const char* name;
    mtms sw, bpa;
    std::string timestamp;  // 28 bytes
    std::string yl, se, tm, n2, rd, unit;
  } cases[] = {
      {"every field full", rawMtms("ABCDEFGH", "1234567"), rawMtms("9458-100", "02A1B2C"), full_ts,
       "ABCDEFGH*1234567", "1234567", "ABCDEFGH", std::string(27, 'T'), "\"9458-100\" \"02A1B2C\"",
       "ABCDEFGH1234567"},
      {"unprintable characters",
       rawMtms("AB\x01"
               "DEFGH",
               "12\x7f"
               "4567"),
       rawMtms("9\t58-100", "0\x1b"), "2026-01-15" + std::string(18, '\0'), "AB*12",
       "12\x7f"
       "4567",
       "AB\x01"
       "DEFGH",
       "2026-01-15", "\"9\t58-100\" \"0\x1bZZZZZ\"",
       "AB\x01"
       "DEFGH12\x7f"
       "4567"},
      {"bytes after a NUL",
       rawMtms(std::string("AB\0DEFGH", 8), std::string("\0"
                                                        "234567",
                                                        7)),
       rawMtms(std::string("9\0", 2), std::string("0\0", 2)),
       std::string("\0"
                   "XYZ",
                   4) +
           std::string(24, 'W'),
       "AB*", "", "AB", "", "\"9\" \"0\"", "AB"},
  };
  for (const auto& c : cases) {
    chassisVPD sw;
    sw.loc_id = location(2, 3, 0, CHASSIS);
    sw.sw_mtms = c.sw;
    ASSERT_EQ(c.timestamp.size(), sizeof sw.timestamp) << c.name;
    std::memcpy(sw.timestamp, c.timestamp.data(), sizeof sw.timestamp);
    sw.riser[0].riser_fru = fru("", "P", "", "F", "", "", "C1");
    sw.riser[0].nbr1 = location(2, 4, 0, NSB);  // nbr2 stays 0: no far end on jack 2
    bpaVPD bpa;
    bpa.frame_mtms = c.bpa;

    OutputCapture out;
    EXPECT_EQ(dorvex::outputnetvpdSW(db, sw, bpa), 0) << c.name;
    EXPECT_EQ(out.text(), "*FC ????????\n*DS 4 GB Switch\n*YL U" + c.yl + "\n*SE " + c.se +
                              "\n*TM " + c.tm + "\n*MN QOR\n*N2 " + c.n2 + "\n*RD " + c.rd +
                              "\n*FC ????????\n*DS \n*PN P\n*EC \n*FN F\n*SN \n*YL U" + c.yl +
                              "-C1\n*CC \n*CB \"U" + c.unit +
                              "-P1-C1-T1\" \"UFARTMXYZFARSE77-P1-C9-T1\"\n*CB \"U" + c.unit +
                              "-P1-C1-T2\" \"\"\n")
        << c.name;
  }
}

}  // namespace
}  // namespace dorvextest
