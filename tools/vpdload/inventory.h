// An installation inventory: every record of the three tables, in table order.
#ifndef TOOLS_VPDLOAD_INVENTORY_H_
#define TOOLS_VPDLOAD_INVENTORY_H_

#include <vector>

#include "vpd_records.h"

namespace vpdload {

struct Inventory {
  std::vector<smaVPD> sma;
  std::vector<chassisVPD> chassis;
  std::vector<bpaVPD> bpa;

  std::size_t size() const { return sma.size() + chassis.size() + bpa.size(); }
};

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_INVENTORY_H_
