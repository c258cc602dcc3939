// Lookups that select records by the frame and cage of their location.
#include <list>

#include "table_scan.h"
#include "vpdDB.h"

namespace {

using vpd::asSigned;
using vpd::ScanOutcome;
using vpd::Take;

// The chips of the two SMA adapters of a CEC.
bool chipOfAdapter(unsigned int chip, unsigned int adapter) {
  switch (adapter) {
    case 1:
      return chip == 0 || chip == 1 || chip == 4 || chip == 5;
    case 2:
      return chip == 2 || chip == 3 || chip == 6 || chip == 7;
    default:
      return false;
  }
}

template <class Record>
bool any(const Record&) {
  return true;
}

}  // namespace

int vpdDB::getSMAvpd(unsigned int frame, unsigned int cage, unsigned int adapter,
                     std::list<smaVPD>& vpd_list) {
  vpd::Table& t = tables_->smaTbl;
  ScanOutcome o = vpd::scanTable<smaVPD>(
      t, t.index().byFrameCage(frame, cage), Take::kAll,
      [&](const smaVPD& r) { return chipOfAdapter(r.loc_id.getChip(), adapter); },
      [&](const smaVPD& r) { vpd_list.push_back(r); });
  return vpd::lookupResult(o, "getSMAvpd", "The sma table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSMAvpd", loc_id_t(0),
              "The specified frame %d, cage %d is not in the smaTbl", asSigned(frame),
              asSigned(cage));
  });
}

int vpdDB::getBPAvpd(unsigned int frame, unsigned int cage, bpaVPD& bpa_vpd) {
  vpd::Table& t = tables_->bpaTbl;
  ScanOutcome o = vpd::scanTable<bpaVPD>(t, t.index().byFrameCage(frame, cage), Take::kFirst,
                                         any<bpaVPD>, [&](const bpaVPD& r) { bpa_vpd = r; });
  return vpd::lookupResult(o, "getBPAvpd", "The bpa table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getBPAvpd", loc_id_t(0),
              "The specified frame %d, cage %d is not find in the bpaTbl", asSigned(frame),
              asSigned(cage));
  });
}

int vpdDB::getSwitchvpd(unsigned int frame, unsigned int cage, chassisVPD& switch_vpd) {
  vpd::Table& t = tables_->chassisTbl;
  ScanOutcome o =
      vpd::scanTable<chassisVPD>(t, t.index().byFrameCage(frame, cage), Take::kFirst,
                                 any<chassisVPD>, [&](const chassisVPD& r) { switch_vpd = r; });
  return vpd::lookupResult(o, "getSwitchvpd", "The switch chassis table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSwitchvpd", loc_id_t(0),
              "The specified frame %d, cage %d is not find in the chassisTable", asSigned(frame),
              asSigned(cage));
  });
}

int vpdDB::getSwitchvpd(unsigned int frame, std::list<chassisVPD>& vpd_list) {
  vpd::Table& t = tables_->chassisTbl;
  ScanOutcome o =
      vpd::scanTable<chassisVPD>(t, t.index().byFrame(frame), Take::kAll, any<chassisVPD>,
                                 [&](const chassisVPD& r) { vpd_list.push_back(r); });
  return vpd::lookupResult(o, "getSwitchvpd", "The switch chassis table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSwitchvpd", loc_id_t(0),
              "The specified frame %d is not find in the chassisTable", asSigned(frame));
  });
}
