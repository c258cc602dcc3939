// Lookups by machine type-model and serial, and the list of CECs.
#include <list>

#include "table_scan.h"
#include "vpdDB.h"

namespace {

template <class Record>
bool any(const Record&) {
  return true;
}

}  // namespace

int vpdDB::getBPAvpd(mtms frame_mtms, bpaVPD& bpa_vpd) {
  vpd::Table& t = tables_->bpaTbl;
  vpd::ScanOutcome o =
      vpd::scanTable<bpaVPD>(t, t.index().firstByMtms(frame_mtms), vpd::Take::kFirst, any<bpaVPD>,
                             [&](const bpaVPD& r) { bpa_vpd = r; });
  return vpd::lookupResult(o, "getBPAvpd", "The bpa table is empty", [] {
    VPD_TRACE(ZRV_TRACE_INFO, "getBPAvpd", loc_id_t(0),
              "The specified mtms is not find in the bpaTbl");
  });
}

int vpdDB::getSwitchvpd(mtms sw_mtms, chassisVPD& switch_vpd) {
  vpd::Table& t = tables_->chassisTbl;
  vpd::ScanOutcome o =
      vpd::scanTable<chassisVPD>(t, t.index().firstByMtms(sw_mtms), vpd::Take::kFirst,
                                 any<chassisVPD>, [&](const chassisVPD& r) { switch_vpd = r; });
  return vpd::lookupResult(o, "getSwitchvpd", "The switch chassis table is empty ", [] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSwitchvpd", loc_id_t(0),
              "The specified switch mtms not find in the chassisTable");
  });
}

int vpdDB::getSwitchmtms(unsigned int frame, std::list<mtms>& switch_mtms) {
  vpd::Table& t = tables_->chassisTbl;
  vpd::ScanOutcome o =
      vpd::scanTable<chassisVPD>(t, t.index().byFrame(frame), vpd::Take::kAll, any<chassisVPD>,
                                 [&](const chassisVPD& r) { switch_mtms.push_back(r.sw_mtms); });
  return vpd::lookupResult(o, "getSwitchmtms", "The switch chassis table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSwitchmtms", loc_id_t(0),
              "The specified frame %d is not in the chassis table", vpd::asSigned(frame));
  });
}

int vpdDB::getCECmtms(std::list<loc_id_t>& id_list, std::list<mtms>& mtms_list) {
  vpd::Table& t = tables_->smaTbl;
  vpd::ScanOutcome o = vpd::scanTable<smaVPD>(t, t.index().firstOfEachFrameCage(), vpd::Take::kAll,
                                              any<smaVPD>, [&](const smaVPD& r) {
                                                id_list.push_back(r.loc_id);
                                                mtms_list.push_back(r.cec_mtms);
                                              });
  // A table with a record always yields a CEC, so only the empty table is reported.
  return vpd::lookupResult(o, "getCECmtms", "The sma table is empty", [] {});
}
