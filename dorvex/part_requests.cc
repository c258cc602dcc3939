// Forms 1 and 2: the summary line of one FRU.
#include <list>

#include "exit_status.h"
#include "record_output.h"
#include "requests.h"
#include "settings.h"

namespace dorvex {
namespace {

unsigned int u(int value) { return static_cast<unsigned int>(value); }

bool bpaSideGiven() { return bpanum == 1 || bpanum == 2; }

// BPR or BPD `partnum` of the side `bpanum`; the caller has checked the index.
const fru_stanza& bpaUnit(const bpaVPD& bpadata) {
  if (fruid == kFruBpd) return bpanum == 1 ? bpadata.bpd1_fru[partnum] : bpadata.bpd2_fru[partnum];
  return bpanum == 1 ? bpadata.bpr1_fru[partnum] : bpadata.bpr2_fru[partnum];
}

int bpaPart(vpdDB& vpd) {
  // An index outside the three units would name no FRU of the record: nothing is performed.
  if (fruid != kFruIbf && !bpaVPD::unitOk(partnum)) return kNothingPerformed;
  bpaVPD bpadata;
  int rc = vpd.getBPAvpd(u(frame), u(cage), bpadata);
  if (fruid == kFruIbf) return rc;  // the record holds no FRU for it
  fru_stanza fru;
  fru = bpaUnit(bpadata);
  return outputpnsn(bpadata.frame_mtms, fru.pn, fru.sn, fru.cc);
}

// The switch chassis cabled to the SMA records of a CEC adapter; frame and cage locate the
// CEC, partnum is the adapter number.
int switchesOfAdapter(vpdDB& vpd) {
  std::list<smaVPD> smalist;
  int rc = vpd.getSMAvpd(u(frame), u(cage), u(partnum), smalist);
  for (const smaVPD& sma : smalist) {
    loc_id_t neighborid = sma.neighbor_id;
    chassisVPD switchdata;  // fresh for each record: a missing neighbour writes nothing
    vpd.getSwitchvpd(neighborid.getFrame(), neighborid.getCage(), switchdata);
    rc = outputmtms(switchdata.sw_mtms, switchdata.loc_id);
  }
  if (smalist.empty()) prc = kExitNotFound;
  return rc;
}

int switchPart(vpdDB& vpd) {
  if (fruid == kFruAdapter) return switchesOfAdapter(vpd);
  if (fruid == kFruRiser && !chassisVPD::slotOk(partnum)) return kNothingPerformed;
  chassisVPD switchdata;
  int rc = vpd.getSwitchvpd(u(frame), u(cage), switchdata);
  fru_stanza fru;
  if (fruid == kFruDca) {
    if (partnum != 1 && partnum != 2) return rc;  // no such DCA: nothing to write
    fru = partnum == 1 ? switchdata.dca1_fru : switchdata.dca2_fru;
  } else {
    fru = switchdata.riser[partnum].riser_fru;
  }
  return outputpnsn(switchdata.sw_mtms, fru.pn, fru.sn, fru.cc);
}

int cecAdapter(vpdDB& vpd) {
  std::list<smaVPD> smalist;
  int rc = vpd.getSMAvpd(u(frame), u(cage), u(partnum), smalist);
  if (smalist.empty()) {
    prc = kExitNotFound;
    return rc;
  }
  const smaVPD& first = smalist.front();  // only the first record is written
  fru_stanza fru;
  fru = first.sma_fru;
  return outputpnsn(first.cec_mtms, fru.pn, fru.sn, fru.cc);
}

}  // namespace

int partRequest(vpdDB& vpd) {
  if (type == kTypeBpa && bpaSideGiven() &&
      (fruid == kFruBpd || fruid == kFruBpr || fruid == kFruIbf)) {
    return bpaPart(vpd);
  }
  if (type == kTypeSwitch && (fruid == kFruDca || fruid == kFruRiser || fruid == kFruAdapter)) {
    return switchPart(vpd);
  }
  if (type == kTypeCec && fruid == kFruAdapter) return cecAdapter(vpd);
  return kNothingPerformed;
}

int fruRequest(vpdDB& vpd) {
  if (type == kTypeBpa && bpaSideGiven() && (fruid == kFruBpc || fruid == kFruEpoSw)) {
    bpaVPD bpadata;
    int rc = vpd.getBPAvpd(u(frame), u(cage), bpadata);
    if (fruid == kFruEpoSw) return rc;  // the record holds no FRU for it
    fru_stanza fru;
    fru = bpanum == 1 ? bpadata.bpc1_fru : bpadata.bpc2_fru;
    return outputpnsn(bpadata.frame_mtms, fru.pn, fru.sn, fru.cc);
  }
  if (type == kTypeSwitch && fruid == kFruPlanar) {
    chassisVPD switchdata;
    vpd.getSwitchvpd(u(frame), u(cage), switchdata);
    fru_stanza fru;
    fru = switchdata.sw_fru;
    return outputpnsn(switchdata.sw_mtms, fru.pn, fru.sn, fru.cc);
  }
  return kNothingPerformed;
}

}  // namespace dorvex
