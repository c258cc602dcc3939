// Lookups that collect every record of one network.
#include <list>

#include "table_scan.h"
#include "vpdDB.h"

namespace {

template <class Record>
bool any(const Record&) {
  return true;
}

}  // namespace

int vpdDB::getBPAvpdNW(unsigned int network, std::list<bpaVPD>& bpa_list) {
  vpd::Table& t = tables_->bpaTbl;
  vpd::ScanOutcome o =
      vpd::scanTable<bpaVPD>(t, t.index().byNetwork(network), vpd::Take::kAll, any<bpaVPD>,
                             [&](const bpaVPD& r) { bpa_list.push_back(r); });
  return vpd::lookupResult(o, "getBPAvpdNW", "The bpa table is empty ", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getBPAvpdNW", loc_id_t(0),
              "The specified network %d is not find in the bpaTbl", vpd::asSigned(network));
  });
}

int vpdDB::getSwitchvpdNW(unsigned int network, std::list<chassisVPD>& vpd_list) {
  vpd::Table& t = tables_->chassisTbl;
  vpd::ScanOutcome o =
      vpd::scanTable<chassisVPD>(t, t.index().byNetwork(network), vpd::Take::kAll, any<chassisVPD>,
                                 [&](const chassisVPD& r) { vpd_list.push_back(r); });
  return vpd::lookupResult(o, "getSwitchvpdNW", "The switch chassis table is empty", [&] {
    VPD_TRACE(ZRV_TRACE_INFO, "getSwitchvpdNW", loc_id_t(0),
              "The specified network %d is not find in the chassisTable", vpd::asSigned(network));
  });
}
