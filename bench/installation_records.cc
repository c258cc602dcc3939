#include "installation_records.h"

#include <ctime>
#include <string>

#include "vpd_types.h"

namespace gen {
namespace {

// What a FRU is: its description, part number, engineering change level, card id and the
// start of its location text. Serial numbers and the rest of the location vary per unit.
struct FruKind {
  uint64_t id;
  const char* ds;
  const char* pn;
  const char* ec;
  const char* cc;
};

const FruKind kSwitchBoard = {11, "4 GB Switch Board", "44V3021", "H86442", "28A1"};
const FruKind kDca = {12, "Switch Power Converter", "44V3130", "H86450", "51B2"};
const FruKind kRiser = {13, "Switch Riser Card 4x", "44V3206", "H86461", "28B7"};
const FruKind kSmaAdapter = {14, "SMA Host Channel Adapter", "44V4412", "H87120", "2856"};
const FruKind kBpc = {15, "Bulk Power Controller", "44V5001", "H88010", "52A1"};
const FruKind kBpr = {16, "Bulk Power Regulator", "44V5102", "H88022", "52B4"};
const FruKind kBpd = {17, "Bulk Power Distributor", "44V5210", "H88031", "52C3"};

constexpr uint64_t kTimestampKind = 30;
constexpr long kEpochStart = 1700000000;    // 2023-11-14, when the series was "installed"
constexpr long kInstallSpan = 90L * 86400;  // records stamped over 90 days

std::string base36(uint64_t v, int digits) {
  static const char kDigits[] = "0123456789ABCDEFGHIJKLMNOPQRSTUVWXYZ";
  std::string text(static_cast<std::size_t>(digits), '0');
  for (int i = digits - 1; i >= 0; --i, v /= 36)
    text[static_cast<std::size_t>(i)] = kDigits[v % 36];
  return text;
}

// One unit of a kind; (a, b) names the unit within the installation.
fru_stanza makeFru(const Layout& layout, const FruKind& kind, const std::string& yl, uint64_t a,
                   uint64_t b) {
  uint64_t h = layout.hash(kind.id, a, b);
  std::string fn = std::string(kind.pn).substr(0, 5) + std::to_string(h % 10) + "9";
  std::string sn = "YL1" + base36(h >> 8, 9);
  return fru_stanza(kind.ds, kind.pn, kind.ec, fn.c_str(), sn.c_str(), kind.cc, yl.c_str());
}

// "2024-01-05 13:02:51 UTC": a free text that only people read.
std::string timestamp(const Layout& layout, uint64_t table, uint64_t a, uint64_t b = 0) {
  time_t t =
      static_cast<time_t>(kEpochStart + static_cast<long>(layout.hash(kTimestampKind, table, a, b) %
                                                          static_cast<uint64_t>(kInstallSpan)));
  struct tm parts;
  gmtime_r(&t, &parts);
  char text[32];
  std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S UTC", &parts);
  return text;
}

// The H and Q digits of an SMA chip's location code.
std::string smaPlace(unsigned int chip) {
  static const char* const kPlaces[8] = {"H1-Q3", "H1-Q4", "H4-Q3", "H4-Q4",
                                         "H1-Q1", "H1-Q2", "H4-Q1", "H4-Q2"};
  return chip < 8 ? kPlaces[chip] : "H0-Q" + std::to_string(chip);
}

}  // namespace

chassisVPD chassisRecord(const Layout& layout, unsigned int s) {
  chassisVPD r;
  r.setLocid(layout.switchLocation(s));
  r.setSWmtms(layout.switchMtms(s));
  r.setSWfru(makeFru(layout, kSwitchBoard, "P1", s, 0));
  r.setDca1(makeFru(layout, kDca, "P1-V1", s, 1));
  r.setDca2(makeFru(layout, kDca, "P1-V2", s, 2));
  for (int i = 0; i < chassisVPD::kRiserSlots; ++i) {
    r.setRiser(makeFru(layout, kRiser, "P1-C" + std::to_string(i + 1), s, static_cast<uint64_t>(i)),
               i);
    Cable c1 = layout.cable(s, i, 1);
    Cable c2 = layout.cable(s, i, 2);
    r.setNeighbor1(c1.far, i);
    r.setPort1(c1.port, i);
    r.setNeighbor2(c2.far, i);
    r.setPort2(c2.port, i);
  }
  r.setTimestamp(timestamp(layout, CHASSIS_TABLE, s).c_str());
  return r;
}

bpaVPD bpaRecord(const Layout& layout, unsigned int f) {
  bpaVPD r;
  r.setLocid(layout.bpaLocation(f));
  r.setTimestamp(timestamp(layout, BPA_TABLE, f).c_str());
  mtms m = layout.bpaMtms(f);
  r.setMtms(m);
  for (int side = 1; side <= 2; ++side) {
    std::string prefix = side == 1 ? "U1.35-P1-" : "U1.35-P2-";
    uint64_t unit = static_cast<uint64_t>(side) * 10;
    fru_stanza bpc = makeFru(layout, kBpc, prefix + "M1", f, unit);
    side == 1 ? r.setBpc1(bpc) : r.setBpc2(bpc);
    for (int i = 0; i < bpaVPD::kUnitsPerKind; ++i) {
      fru_stanza bpr = makeFru(layout, kBpr, prefix + "E" + std::to_string(i + 1), f, unit + 1 + i);
      fru_stanza bpd = makeFru(layout, kBpd, prefix + "D" + std::to_string(i + 1), f, unit + 4 + i);
      if (side == 1) {
        r.setBpr1(bpr, i);
        r.setBpd1(bpd, i);
      } else {
        r.setBpr2(bpr, i);
        r.setBpd2(bpd, i);
      }
    }
  }
  return r;
}

smaVPD smaRecord(const Layout& layout, unsigned int c, unsigned int chip) {
  smaVPD r;
  r.setLocid(layout.cecLocation(c, chip));
  fru_stanza fru = makeFru(layout, kSmaAdapter, "P1-" + smaPlace(chip), c, chip);
  r.setSmafru(fru);
  mtms m = layout.cecMtms(c);
  r.setCECmtms(m);
  r.setNeighborid(layout.smaNeighbor(c, chip));
  r.setTimestamp(timestamp(layout, SMA_TABLE, c, chip).c_str());
  return r;
}

}  // namespace gen
