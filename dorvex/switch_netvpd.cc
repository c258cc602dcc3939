#include "switch_netvpd.h"

#include "output_stream.h"
#include "record_output.h"

namespace dorvex {
namespace {

// Far riser slot by the chip index of a switch far end.
const unsigned int chip_riser_map[8] = {8, 4, 12, 0, 14, 2, 10, 6};

// Characters of the chassis timestamp that the header shows.
constexpr std::size_t kTimestampChars = 27;

// The digits of riser number n into `digits`; returns how many (none outside 1 to 16).
std::size_t riserDigits(int n, char (&digits)[2]) {
  if (n < 1 || n > 16) return 0;
  if (n < 10) {
    digits[0] = static_cast<char>('0' + n);
    return 1;
  }
  digits[0] = static_cast<char>('0' + n / 10);
  digits[1] = static_cast<char>('0' + n % 10);
  return 2;
}

void putRiserNumber(FILE* out, int n) {
  char digits[2];
  putBytes(out, digits, riserDigits(n, digits));
}

// "U" + tm + se, both up to their first NUL; just "U" for an unknown unit (null).
void putUnit(FILE* out, const mtms* m) {
  putChar(out, 'U');
  if (m == nullptr) return;
  putField(out, m->tm, mtms::kTmChars);
  putField(out, m->se, mtms::kSeChars);
}

void putJackLocation(FILE* out, const mtms* m, int slot_number, int jack) {
  putUnit(out, m);
  putText(out, "-P1-C");
  putRiserNumber(out, slot_number);
  putText(out, "-T");
  putRiserNumber(out, jack);
}

// The jack of a far switch chassis (`far_chassis`, null when it has no record) that
// `locid` and `port` name; nothing for a far end at frame 0, cage 0 (none recorded).
void putSwitchFarEnd(FILE* out, const mtms* far_chassis, loc_id_t locid, int port) {
  if (locid.getFrame() == 0 && locid.getCage() == 0) return;
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
  // A chip without a slot gives riser number 0, which shows as an empty slot number.
  putJackLocation(out, far_chassis, toriser + 1, tojack);
}

// The SMA port of a far CEC (`cec`, null when it has no record) that `locid` names.
void putSmaFarEnd(FILE* out, const mtms* cec, loc_id_t locid) {
  unsigned char sma_chip = locid.SMAchip();
  putUnit(out, cec);
  putText(out, "-P1-H");
  putText(out, smaHDigit(sma_chip));
  putChar(out, 'Q');
  putText(out, smaQDigit(sma_chip));
}

}  // namespace

std::string riseritoa(int n) {
  char digits[2];
  return std::string(digits, riserDigits(n, digits));
}

int farRiserSlot(unsigned int chip) {
  return chip < sizeof chip_riser_map / sizeof chip_riser_map[0]
             ? static_cast<int>(chip_riser_map[chip])
             : -1;
}

const char* smaHDigit(unsigned char sma_chip) {
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

const char* smaQDigit(unsigned char sma_chip) {
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
  bool to_switch;
  const mtms* far;  // the far unit's MTMS, looked up before anything of the line is written
  switch (locid.getType()) {
    case NSB:
    case ISB:
      to_switch = true;
      far = run.farChassis(locid.getFrame(), locid.getCage());
      break;
    case SMA:
      to_switch = false;
      far = run.farCec(locid.getFrame(), locid.getCage());
      break;
    default:
      return 0;  // power, chassis, board or riser far ends have no cable line
  }
  FILE* out = outStream();
  putText(out, "*CB \"");
  putJackLocation(out, &framemtms, fromriser + 1, fromjack);
  putText(out, "\" \"");
  if (to_switch) {
    putSwitchFarEnd(out, far, locid, port);
  } else {
    putSmaFarEnd(out, far, locid);
  }
  putText(out, "\"\n");
  return 0;
}

int outputCBinfo(vpdDB& vpd, mtms framemtms, loc_id_t locid, int port, int fromriser,
                 int fromjack) {
  NetvpdRun run(vpd);
  return outputCBinfo(run, framemtms, locid, port, fromriser, fromjack);
}

int outputnetvpdSW(NetvpdRun& run, chassisVPD switchdata, bpaVPD bpadata) {
  mtms bpamtms;
  bpamtms = bpadata.frame_mtms;
  writeSwitchStanza(run, switchdata, bpamtms);
  return 0;
}

void writeSwitchStanza(NetvpdRun& run, const chassisVPD& switchdata, const mtms& bpamtms) {
  mtms framemtms;
  framemtms = switchdata.sw_mtms;

  FILE* out = outStream();
  putText(out, "*FC ????????\n*DS 4 GB Switch\n");
  startKeyword(out, "YL");
  putChar(out, 'U');
  putMtmsText(out, framemtms);
  putChar(out, '\n');
  writeKeyword(out, "SE", framemtms.se, mtms::kSeChars);
  writeKeyword(out, "TM", framemtms.tm, mtms::kTmChars);
  putText(out, "*MN QOR\n");
  writeKeyword(out, "N2", switchdata.timestamp, kTimestampChars);
  for (const mtms& console : run.consolesReaching(bpamtms)) {
    startKeyword(out, "V1");
    putQuotedMtms(out, console);
    putChar(out, '\n');
  }
  startKeyword(out, "RD");
  putQuotedMtms(out, bpamtms);
  putChar(out, '\n');

  outputfruSW(switchdata.sw_fru, framemtms);
  outputfruSW(switchdata.dca1_fru, framemtms);
  outputfruSW(switchdata.dca2_fru, framemtms);
  for (int i = 0; i < kReportedRisers; ++i) {
    const riser_vpd_t& slot = switchdata.riser[i];
    if (outputfruSW(slot.riser_fru, framemtms) == 0) {
      outputCBinfo(run, framemtms, slot.nbr1, slot.port1, i, 1);
      outputCBinfo(run, framemtms, slot.nbr2, slot.port2, i, 2);
    }
  }
}

int outputnetvpdSW(vpdDB& vpd, chassisVPD switchdata, bpaVPD bpadata) {
  NetvpdRun run(vpd);
  return outputnetvpdSW(run, switchdata, bpadata);
}

}  // namespace dorvex
