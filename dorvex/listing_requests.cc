// Forms 3 to 6 and 8: enclosure lines, the change poll and the table dump.
#include <list>

#include "exit_status.h"
#include "output_stream.h"
#include "record_output.h"
#include "requests.h"
#include "settings.h"

namespace dorvex {
namespace {
unsigned int u(int value) { return static_cast<unsigned int>(value); }
}  // namespace

int locationRequest(vpdDB& vpd) {
  if (type == kTypeBpa) {
    bpaVPD bpadata;
    vpd.getBPAvpd(u(frame), u(cage), bpadata);
    return outputmtms(bpadata.frame_mtms, bpadata.loc_id);
  }
  if (type == kTypeSwitch) {
    chassisVPD switchdata;
    vpd.getSwitchvpd(u(frame), u(cage), switchdata);
    return outputmtms(switchdata.sw_mtms, switchdata.loc_id);
  }
  if (type == kTypeCec) {
    std::list<smaVPD> smalist;
    int rc = vpd.getSMAvpd(u(frame), u(cage), 1, smalist);
    if (rc != VPD_FOUND) return rc;  // not found: nothing written, status 0
    return outputmtms(smalist.front().cec_mtms, smalist.front().loc_id);
  }
  return kNothingPerformed;
}

int changePoll(vpdDB& vpd) {
  if (type != kTypeCec) return kNothingPerformed;
  long cectime = 0;
  // Without the table's time there is nothing to compare: nothing is written and the
  // request counts as not performed.
  if (vpd.getCECtimestamp(cectime) != 0) return kNothingPerformed;
  if (cectime <= mtime) {
    writeLine("NoChange");
    return 0;
  }
  writeLine(std::to_string(cectime));
  std::list<loc_id_t> idlist;
  std::list<mtms> mtmslist;
  int rc = vpd.getCECmtms(idlist, mtmslist);
  auto id = idlist.begin();
  for (auto m = mtmslist.begin(); m != mtmslist.end() && id != idlist.end(); ++m, ++id) {
    rc = outputmtms(*m, *id);
  }
  if (mtmslist.empty()) prc = kExitNotFound;
  return rc;
}

int frameRequest(vpdDB& vpd) {
  if (type != kTypeSwitch) return kNothingPerformed;
  std::list<chassisVPD> chassislist;
  int rc = vpd.getSwitchvpd(u(frame), chassislist);
  for (const chassisVPD& chassis : chassislist) rc = outputmtms(chassis.sw_mtms, chassis.loc_id);
  if (chassislist.empty()) prc = kExitNotFound;
  return rc;
}

int mtmsRequest(vpdDB& vpd) {
  if (type != kTypeBpa && type != kTypeSwitch) return kNothingPerformed;
  // 8 characters of type-model, a separator, 7 of serial; a shorter text leaves the
  // missing characters empty and nothing past its end is read.
  mtms passmtms(mtmsid);
  if (type == kTypeBpa) {
    bpaVPD bpadata;
    vpd.getBPAvpd(passmtms, bpadata);
    return outputmtms(bpadata.frame_mtms, bpadata.loc_id);
  }
  chassisVPD switchdata;
  vpd.getSwitchvpd(passmtms, switchdata);
  return outputmtms(switchdata.sw_mtms, switchdata.loc_id);
}

int dumpRequest(vpdDB& vpd) {
  if (type != kTypeAll) return kNothingPerformed;
  std::fflush(outStream());  // the dump has its own way to standard output
  vpd.showVPD(CHASSIS_TABLE);
  vpd.showVPD(SMA_TABLE);
  vpd.showVPD(BPA_TABLE);
  return 0;
}

}  // namespace dorvex
