#include "sample_installation.h"

namespace sample {
namespace {

const char kStamp[] = "2026-12-06 12:00:00";

fru_stanza fru(const char* ds, const char* pn, const char* sn, const char* yl) {
  return fru_stanza(ds, pn, "EC01", "FN-", sn, "28E7", yl);
}

chassisVPD chassis(unsigned frame, unsigned cage, unsigned network, const char* se) {
  chassisVPD c;
  c.setLocid(loc_id_t(frame, cage, 0, CHASSIS, 0, network));
  c.setSWmtms(mtms("7045-SW4", se));
  c.setSWfru(fru("Switch board", "41V2137", "YL10SB01", "U7045.SW4-P1"));
  c.setDca1(fru("DC converter", "41V2140", "YL10DC01", "U7045.SW4-V1"));
  c.setDca2(fru("DC converter", "41V2140", "YL10DC02", "U7045.SW4-V2"));
  for (int slot = 0; slot < 4; ++slot) {
    std::string sn = "YL10RS0" + std::to_string(slot);
    c.setRiser(fru("Riser card", "41V2150", sn.c_str(), "U7045.SW4-P1-C1"), slot);
  }
  // Jack 1 of riser 0 goes to an SMA adapter, jack 2 of riser 1 to the other chassis of the
  // frame; riser 2 has a far end of a type that has no cable line.
  c.setNeighbor1(loc_id_t(2, 0, 1, SMA, 0, network), 0);
  c.setPort1(0, 0);
  c.setNeighbor2(loc_id_t(frame, cage == 1 ? 2 : 1, 3, NSB, 0, network), 1);
  c.setPort2(2, 1);
  c.setNeighbor1(loc_id_t(frame, 9, 0, BOARD, 0, network), 2);
  c.setPort1(1, 2);
  c.setTimestamp(kStamp);
  return c;
}

bpaVPD bpa(unsigned frame, unsigned network, const char* se) {
  bpaVPD b;
  b.setLocid(loc_id_t(frame, 255, 0, BPA, 0, network));
  b.setTimestamp(kStamp);
  b.setMtms(mtms("9458-100", se));
  fru_stanza bpc = fru("Bulk power controller", "44V1234", "YL20BC01", "U1.35-P1");
  b.setBpc1(bpc);
  b.setBpc2(bpc);
  for (int i = 0; i < 3; ++i) {
    fru_stanza unit = fru("Bulk power regulator", "44V2000", "YL20BR00", "U1.35-P1-V1");
    b.setBpr1(unit, i);
    b.setBpd2(fru("Bulk power distributor", "44V3000", "YL20BD00", "U1.35-P2-V3"), i);
  }
  return b;
}

smaVPD sma(unsigned frame, unsigned cage, unsigned chip, const char* cec_se) {
  smaVPD s;
  s.setLocid(loc_id_t(frame, cage, chip, SMA, 0, 1));
  fru_stanza f = fru("SMA adapter", "21P4567", "YL30SM01", "U7040.681-P1-H1");
  s.setSmafru(f);
  mtms cec("7040-681", cec_se);
  s.setCECmtms(cec);
  s.setNeighborid(loc_id_t(1, 1, chip, CHASSIS, 0, 1));
  s.setTimestamp(kStamp);
  return s;
}

}  // namespace

std::vector<chassisVPD> chassisRecords() {
  return {chassis(1, 1, 1, "20SWT01"), chassis(1, 2, 1, "20SWT02"), chassis(3, 1, 2, "20SWT03")};
}

std::vector<bpaVPD> bpaRecords() { return {bpa(1, 1, "02A1B2C"), bpa(3, 2, "02A9B9C")}; }

std::vector<smaVPD> smaRecords() {
  return {sma(2, 0, 0, "10CEC01"), sma(2, 0, 1, "10CEC01"), sma(2, 0, 2, "10CEC01"),
          sma(2, 0, 5, "10CEC01"), sma(2, 1, 0, "10CEC02"), sma(4, 0, 6, "10CEC03")};
}

std::string hwserverJson() {
  return R"({
  "consoles": [
    { "ip": "10.0.0.5", "tm": "7042CR9", "se": "10ABCDE", "bpa_vports": [1, 2] }
  ],
  "bpas": [
    { "vport": 1, "tm": "9458-100", "se": "02A1B2C" },
    { "vport": 2, "tm": "9458-100", "se": "02A9B9C" }
  ]
}
)";
}

std::string rackprobeDump() {
  return "1 1 SW_CHIP 0 1 1\n"
         "1 1 SW_CHIP 1 1 1\n"
         "1 2 SW_CHIP 0 1 1\n"
         "3 1 SW_CHIP 0 1 2\n"
         "2 0 SMA 0 1 1\n";
}

std::vector<std::vector<std::string>> requestArguments() {
  return {
      {"-y", "switch", "-f", "1", "-c", "1", "-r", "dca", "-h", "2"},
      {"-y", "switch", "-f", "1", "-c", "2", "-r", "riser", "-h", "3"},
      {"-y", "switch", "-f", "2", "-c", "0", "-r", "adapter", "-h", "1"},
      {"-y", "cec", "-f", "2", "-c", "0", "-r", "adapter", "-h", "2"},
      {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpr", "-a", "1", "-h", "0"},
      {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpd", "-a", "2", "-h", "2"},
      {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpc", "-a", "2"},
      {"-y", "switch", "-f", "3", "-c", "1", "-r", "planar"},
      {"-y", "bpa", "-f", "3", "-c", "255"},
      {"-y", "switch", "-f", "1", "-c", "2"},
      {"-y", "cec", "-f", "2", "-c", "1"},
      {"-y", "cec", "-t", "0"},
      {"-y", "cec", "-t", "2000000000"},
      {"-y", "switch", "-f", "1"},
      {"-y", "switch", "-m", "7045-SW4*20SWT03"},
      {"-y", "bpa", "-m", "9458-100*02A1B2C"},
      {"-y", "switch", "-n", "1"},
      {"-y", "bpa", "-n", "1"},
      {"-y", "netvpd", "-n", "1"},
      {"-y", "all"},
  };
}

}  // namespace sample
