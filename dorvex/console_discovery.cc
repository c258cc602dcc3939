#include "console_discovery.h"

#include <memory>

#include "nodebridge.h"
#include "rackpower.h"
#include "return_codes.h"

namespace dorvex {

std::vector<zev_info_t> zev;

int getzevmtms() {
  std::unique_ptr<NodeBridge> bridge;
  try {
    bridge = std::make_unique<NodeBridge>();
  } catch (...) {
    throw ZEV_NO_NODEBRIDGE;
  }
  std::unique_ptr<RackPower> power;
  try {
    power = std::make_unique<RackPower>();
  } catch (...) {
    throw ZEV_NO_RACKPOWER;
  }
  discoverConsoles(zev, *bridge, *power);
  bridge.reset();
  power.reset();
  return 0;
}

}  // namespace dorvex
