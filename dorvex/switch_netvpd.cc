#include "switch_netvpd.h"

#include "console_discovery.h"
#include "output_stream.h"
#include "record_output.h"

namespace dorvex {
namespace {

// Far riser slot by the chip index of a switch far end.
const unsigned int chip_riser_map[8] = {8, 4, 12, 0, 14, 2, 10, 6};

// Characters of the chassis timestamp that the header shows.
constexpr std::size_t kTimestampChars = 27;

// "U" + tm + se, both up to their first NUL.
std::string unitPrefix(const mtms& m) { return "U" + m.getTM() + m.getSE(); }

std::string jackLocation(const mtms& m, int slot_number, int jack) {
  return unitPrefix(m) + "-P1-C" + riseritoa(slot_number) + "-T" + riseritoa(jack);
}

std::string switchFarEnd(NetvpdRun& run, loc_id_t locid, int port) {
  mtms neighbormtms;
  if (const mtms* found = run.farChassis(locid.getFrame(), locid.getCage())) {
    neighbormtms = *found;
  }

  int toriser = farRiserSlot(locid.getChip());
  int tojack = 0;  // no jack number
  switch (port) {
    case 0:
      tojack = 1;
      break;
    case 1:
      tojack = 2;
      break;
    case 2:
      tojack = 1;
      if (toriser >= 0) ++toriser;
      break;
    case 3:
      tojack = 2;
      if (toriser >= 0) ++toriser;
      break;
    default:
      break;
  }
  // riseritoa(0) is empty, so a chip without a slot gives an empty slot number.
  std::string far = jackLocation(neighbormtms, toriser + 1, tojack);
  if (locid.getFrame() == 0 && locid.getCage() == 0) far.clear();  // no far end recorded
  return far;
}

std::string smaFarEnd(NetvpdRun& run, loc_id_t locid) {
  mtms neighbormtms;
  if (const mtms* found = run.farCec(locid.getFrame(), locid.getCage())) neighbormtms = *found;
  unsigned char sma_chip = locid.SMAchip();
  return unitPrefix(neighbormtms) + "-P1-H" + smaHDigit(sma_chip) + "Q" + smaQDigit(sma_chip);
}

}  // namespace

std::string riseritoa(int n) {
  std::string text;
  if (n >= 1 && n <= 16) {
    if (n > 9) text += static_cast<char>('0' + n / 10);
    text += static_cast<char>('0' + n % 10);
  }
  return text;
}

int farRiserSlot(unsigned int chip) {
  return chip < sizeof chip_riser_map / sizeof chip_riser_map[0]
             ? static_cast<int>(chip_riser_map[chip])
             : -1;
}

std::string smaHDigit(unsigned char sma_chip) {
  switch (sma_chip) {
    case 2:
    case 3:
    case 8:
    case 9:
      return "1";
    case 6:
    case 7:
    case 12:
    case 13:
      return "4";
    default:
      return "";
  }
}

std::string smaQDigit(unsigned char sma_chip) {
  switch (sma_chip) {
    case 8:
    case 12:
      return "1";
    case 9:
    case 13:
      return "2";
    case 2:
    case 6:
      return "3";
    case 3:
    case 7:
      return "4";
    default:
      return "";
  }
}

int outputCBinfo(NetvpdRun& run, mtms framemtms, loc_id_t locid, int port, int fromriser,
                 int fromjack) {
  std::string local = jackLocation(framemtms, fromriser + 1, fromjack);
  std::string far;
  switch (locid.getType()) {
    case NSB:
    case ISB:
      far = switchFarEnd(run, locid, port);
      break;
    case SMA:
      far = smaFarEnd(run, locid);
      break;
    default:
      return 0;  // power, chassis, board or riser far ends have no cable line
  }
  writeKeyword("CB", quotedPair(local, far));
  return 0;
}

int outputCBinfo(vpdDB& vpd, mtms framemtms, loc_id_t locid, int port, int fromriser,
                 int fromjack) {
  NetvpdRun run(vpd);
  return outputCBinfo(run, framemtms, locid, port, fromriser, fromjack);
}

int outputnetvpdSW(NetvpdRun& run, chassisVPD switchdata, bpaVPD bpadata) {
  mtms framemtms;
  framemtms = switchdata.sw_mtms;
  mtms bpamtms;
  bpamtms = bpadata.frame_mtms;

  writeLine("*FC ????????");
  writeLine("*DS 4 GB Switch");
  writeKeyword("YL", "U" + framemtms.text());
  writeKeyword("SE", framemtms.getSE());
  writeKeyword("TM", framemtms.getTM());
  writeLine("*MN QOR");
  writeKeyword("N2", vpd::fieldText(switchdata.timestamp, kTimestampChars));
  for (const zev_info_t& console : zev) {
    for (const bpa_info_t& bpa : console.bpa) {
      if (bpa.bpamtms == bpamtms) {
        writeKeyword("V1", quotedPair(console.zevmtms.getTM(), console.zevmtms.getSE()));
      }
    }
  }
  writeKeyword("RD", quotedPair(bpamtms.getTM(), bpamtms.getSE()));

  fru_stanza fru;
  fru = switchdata.sw_fru;
  outputfruSW(fru, framemtms);
  fru = switchdata.dca1_fru;
  outputfruSW(fru, framemtms);
  fru = switchdata.dca2_fru;
  outputfruSW(fru, framemtms);

  for (int i = 0; i < kReportedRisers; ++i) {
    riser_vpd_t slot;
    switchdata.getRiserStruct(slot, i);
    fru = slot.riser_fru;
    if (outputfruSW(fru, framemtms) == 0) {
      outputCBinfo(run, framemtms, slot.nbr1, slot.port1, i, 1);
      outputCBinfo(run, framemtms, slot.nbr2, slot.port2, i, 2);
    }
  }
  return 0;
}

int outputnetvpdSW(vpdDB& vpd, chassisVPD switchdata, bpaVPD bpadata) {
  NetvpdRun run(vpd);
  return outputnetvpdSW(run, switchdata, bpadata);
}

}  // namespace dorvex
