#include "installation.h"

#include <gtest/gtest.h>
#include <utime.h>

#include <cstdlib>

#include "output_stream.h"
#include "settings.h"

namespace dorvextest {

// Modification time given to the SMA table, so that change polls have a known answer.
constexpr time_t kSmaTableTime = 1700000000;

fru_stanza fru(const char* ds, const char* pn, const char* ec, const char* fn, const char* sn,
               const char* cc, const char* yl) {
  return fru_stanza(ds, pn, ec, fn, sn, cc, yl);
}

loc_id_t location(unsigned frame, unsigned cage, unsigned chip, dev_type_t type) {
  return loc_id_t(frame, cage, chip, type, 0, 1);
}

Installation::Installation() {
  testsupport::makeDirs(path("data"));
  testsupport::makeDirs(path("bin"));
  testsupport::makeDirs(path("etc"));
  // The tables are written from this process: keep its traces out of syslog too.
  setenv("CHRONICLE_LOG", path("writer-trace.log").c_str(), 1);
}

void Installation::add(const chassisVPD& record) { chassis_.push_back(record); }
void Installation::add(const bpaVPD& record) { bpas_.push_back(record); }
void Installation::add(const smaVPD& record) { smas_.push_back(record); }

void Installation::writeTables() {
  {
    vpdDB db(path("data"));
    for (chassisVPD& r : chassis_) db.putVPD(r.loc_id, &r);
    for (bpaVPD& r : bpas_) db.putVPD(r.loc_id, &r);
    for (smaVPD& r : smas_) db.putVPD(r.loc_id, &r);
  }
  utimbuf times{kSmaTableTime, kSmaTableTime};
  ASSERT_EQ(utime(path("data/sma_vpd.db").c_str(), &times), 0);
  written_ = true;
}

void Installation::setDump(const std::string& text) {
  testsupport::writeFile(path("etc/test.dump"), text);
  testsupport::writeFile(path("bin/rackprobe"),
                         "#!/bin/sh\n"
                         "if [ \"$#\" -ne 2 ] || [ \"$1\" != dump ] || [ \"$2\" != -d ]; then\n"
                         "  exit 2\n"
                         "fi\n"
                         "exec cat '" +
                             path("etc/test.dump") + "'\n",
                         0755);
}

void Installation::setHwserver(const std::string& json) {
  testsupport::writeFile(path("etc/hwserver.json"), json);
}

testsupport::RunResult Installation::run(const std::vector<std::string>& args) {
  if (!written_) writeTables();
  std::vector<std::string> argv{DORVEX_BIN};
  argv.insert(argv.end(), args.begin(), args.end());
  return testsupport::run(argv, {{"OLV_ROOT", root()}, {"CHRONICLE_LOG", path("trace.log")}});
}

std::string Installation::traces() const {
  return testsupport::fileExists(path("trace.log")) ? testsupport::readFile(path("trace.log")) : "";
}

void expectRuns(Installation& inst, const std::vector<RunCase>& cases) {
  for (const RunCase& c : cases) {
    testsupport::RunResult r = inst.run(c.args);
    EXPECT_EQ(r.out, c.out) << c.name;
    EXPECT_EQ(r.status, c.status) << c.name;
    EXPECT_EQ(r.err, "") << c.name;
  }
}

OutputCapture::OutputCapture() : file_(std::tmpfile()) {
  dorvex::setOutStream(file_);
  dorvex::resetSettings();
}

OutputCapture::~OutputCapture() {
  dorvex::setOutStream(nullptr);
  std::fclose(file_);
}

std::string OutputCapture::text() {
  std::fflush(file_);
  std::rewind(file_);
  std::string all;
  char buf[4096];
  size_t n;
  while ((n = std::fread(buf, 1, sizeof buf, file_)) > 0) all.append(buf, n);
  return all;
}

void fillStandard(Installation& inst) {
  chassisVPD a;
  a.loc_id = location(2, 3, 0, CHASSIS);
  a.sw_mtms = mtms("7045-SW4", "0C0FFEE");
  a.sw_fru = fru("Switch Board", "53P1234", "H12345", "53P1235", "YL10AB123456", "28D5", "P1");
  a.dca2_fru = fru("DC Assembly", "80P5678", "", "80P5679", "YL10DC000002", "51C0", "P1-V2");
  const char* serials[] = {"YL10RS000001", "YL10RS000002", "YL10RS000003", "YL10RS000004",
                           "YL10RS000005"};
  const char* codes[] = {"P1-C1", "P1-C2", "P1-C3", "P1-C4", "P1-C5"};
  for (int i = 0; i < 5; ++i) {
    a.riser[i].riser_fru =
        fru("Riser Card", "21P4001", "E1", "21P4002", serials[i], "2A1F", codes[i]);
  }
  a.riser[1].riser_fru.setPN("", 12);  // no part number: no stanza, no cable lines
  a.riser[2].riser_fru.setCC("", 4);
  struct {
    int slot;
    loc_id_t nbr1;
    int port1;
    loc_id_t nbr2;
    int port2;
  } cables[] = {
      {0, location(2, 4, 4, ISB), 3, location(5, 2, 5, SMA), 0},
      {1, location(2, 4, 0, NSB), 0, loc_id_t(0), 0},
      {2, loc_id_t(0), 0, location(2, 255, 0, BPA), 0},  // nothing, then a power far end
      {3, location(2, 4, 0, NSB), 7, location(2, 4, 9, ISB), 2},
      {4, location(7, 7, 1, ISB), 1, location(5, 2, 9, SMA), 0},  // no such switch
      {15, location(2, 4, 0, NSB), 0, loc_id_t(0), 0},
  };
  for (const auto& c : cables) {
    a.riser[c.slot].nbr1 = c.nbr1;
    a.riser[c.slot].port1 = c.port1;
    a.riser[c.slot].nbr2 = c.nbr2;
    a.riser[c.slot].port2 = c.port2;
  }
  a.riser[15].riser_fru =
      fru("Riser Card", "21P4001", "E1", "21P4002", "YL10RS000016", "2A1F", "P1-C16");
  a.setTimestamp("2026-01-15 10:20:30");
  inst.add(a);

  chassisVPD b;
  b.loc_id = location(2, 4, 0, CHASSIS);
  b.sw_mtms = mtms("7045-SW4", "0C0FFEF");
  b.sw_fru = fru("Switch Board", "53P1234", "H12345", "53P1235", "YL10AB654321", "28D5", "P1");
  inst.add(b);

  chassisVPD c;
  c.loc_id = location(6, 1, 0, CHASSIS);
  c.sw_mtms = mtms("7045SW4X", "1234567");
  c.sw_fru = fru("Switch Board", "53P9999", "", "53P9998", "YL10AB999999", "28D6", "P1");
  c.setTimestamp("Thu Jan 15 10:20:30 2026 UTC");  // all 28 bytes, no terminator
  inst.add(c);

  bpaVPD bpa2;
  bpa2.loc_id = location(2, 255, 0, BPA);
  bpa2.frame_mtms = mtms("9458-100", "02A1B2C");
  bpa2.bpc1_fru = fru("BPC", "12R3456", "", "12R3457", "YH10BC000001", "2B01", "P1-C1");
  bpa2.bpr1_fru[1] = fru("BPR", "", "", "12R5557", "", "2B02", "P1-E2");
  bpa2.bpr1_fru[2] = fru("BPR", "12R5556", "", "12R5557", "YH10BR000013", "2B02", "P1-E3");
  bpa2.bpd1_fru[0] = fru("BPD", "12R7776", "", "12R7777", "YH10BD000011", "", "P1-D1");
  bpa2.bpc2_fru = fru("BPC", "12R3456", "", "12R3457", "YH10BC000002", "2B01", "P2-C1");
  bpa2.bpr2_fru[1] = fru("BPR", "12R5556", "", "12R5557", "YH10BR000022", "2B02", "P2-E2");
  inst.add(bpa2);

  bpaVPD bpa6;
  bpa6.loc_id = location(6, 255, 0, BPA);
  bpa6.frame_mtms = mtms("9458-100", "02A9999");
  bpa6.bpd2_fru[2] = fru("BPD", "12R7776", "", "12R7777", "YH10BD000623", "2B03", "P2-D3");
  inst.add(bpa6);

  struct {
    unsigned frame, cage, chip;
    const char *tm, *se, *sn;
    unsigned nbr_frame, nbr_cage;
  } smas[] = {
      {5, 2, 0, "9119-595", "0212345", "YL30SM000001", 2, 3},  // adapter 1
      {5, 2, 5, "9119-595", "0212345", "YL30SM000005", 2, 4},  // adapter 1
      {5, 2, 2, "9119-595", "0212345", "YL30SM000002", 2, 3},  // adapter 2
      {5, 2, 6, "9119-595", "0212345", "YL30SM000006", 9, 9},  // adapter 2, no such switch
      {5, 3, 2, "9119-595", "0212346", "YL30SM000102", 9, 9},
      {8, 1, 3, "9117-570", "10ABCDE", "YL30SM000203", 6, 1},
  };
  for (const auto& s : smas) {
    smaVPD r;
    r.loc_id = location(s.frame, s.cage, s.chip, SMA);
    r.sma_fru = fru("SMA Adapter", "41V1111", "", "41V1112", s.sn, "5A00", "P1-H1");
    r.cec_mtms = mtms(s.tm, s.se);
    r.neighbor_id = location(s.nbr_frame, s.nbr_cage, 0, CHASSIS);
    inst.add(r);
  }
}

}  // namespace dorvextest
