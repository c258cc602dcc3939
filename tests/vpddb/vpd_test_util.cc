#include "vpd_test_util.h"

#include <cstdlib>

namespace vpdtest {

void VpdTest::SetUp() {
  testsupport::makeDirs(dataDir());
  log_ = tmp_ / "trace.log";
  setenv("CHRONICLE_LOG", log_.c_str(), 1);
}

void VpdTest::TearDown() { unsetenv("CHRONICLE_LOG"); }

std::vector<TraceRecord> VpdTest::traces() const {
  std::vector<TraceRecord> out;
  if (!testsupport::fileExists(log_)) return out;
  for (const std::string& line : testsupport::lines(testsupport::readFile(log_))) {
    std::vector<std::string> f;
    std::string cur;
    for (char c : line) {
      if (c == '\t') {
        f.push_back(cur);
        cur.clear();
      } else {
        cur += c;
      }
    }
    f.push_back(cur);
    EXPECT_EQ(f.size(), 8u) << "trace line: " << line;
    if (f.size() != 8) continue;
    out.push_back({f[1], f[2], f[3], f[4], f[5], f[6], f[7]});
  }
  return out;
}

std::vector<std::string> VpdTest::takeTraces() {
  std::vector<TraceRecord> all = traces();
  std::vector<std::string> out;
  for (std::size_t i = traces_seen_; i < all.size(); ++i) {
    out.push_back(all[i].level + "|" + all[i].operation + "|" + all[i].message);
  }
  traces_seen_ = all.size();
  return out;
}

void VpdTest::writeTables(const std::string& chassis, const std::string& bpa,
                          const std::string& sma) {
  testsupport::writeFile(table("chassis_vpd.db"), chassis);
  testsupport::writeFile(table("bpa_vpd.db"), bpa);
  testsupport::writeFile(table("sma_vpd.db"), sma);
}

smaVPD makeSma(unsigned frame, unsigned cage, unsigned chip, const char* pn, const char* tm,
               const char* se) {
  smaVPD r;
  r.setLocid(loc_id_t(frame, cage, chip, SMA, 0, 1));
  r.setSmafru(fru_stanza("SMA adapter", pn, "EC01", "FN01", "SN-SMA", "2B3C", "P1-H1"));
  r.setCECmtms(mtms(tm, se));
  r.setNeighborid(loc_id_t(3, 2, 0, CHASSIS, 0, 1));
  r.setTimestamp("2026-12-01 10:00:00");
  return r;
}

chassisVPD makeChassis(unsigned frame, unsigned cage, const char* tm, const char* se,
                       unsigned network) {
  chassisVPD r;
  r.setLocid(loc_id_t(frame, cage, 0, CHASSIS, 0, network));
  r.setSWmtms(mtms(tm, se));
  r.setSWfru(fru_stanza("Switch board", "SW-PN", "EC02", "FN02", "SN-SW", "1A2B", "P1"));
  r.setDca1(fru_stanza("DCA", "DCA-PN1", "EC03", "FN03", "SN-DCA1", "3C4D", "P2"));
  r.setTimestamp("2026-12-01 11:00:00");
  return r;
}

bpaVPD makeBpa(unsigned frame, unsigned cage, const char* tm, const char* se, unsigned network) {
  bpaVPD r;
  r.setLocid(loc_id_t(frame, cage, 0, BPA, 0, network));
  r.setMtms(mtms(tm, se));
  r.setBpc1(fru_stanza("BPC", "BPC-PN1", "EC04", "FN04", "SN-BPC1", "5E6F", "E1"));
  r.setTimestamp("2026-12-01 12:00:00");
  return r;
}

}  // namespace vpdtest
