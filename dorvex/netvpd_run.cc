#include "netvpd_run.h"

#include <list>

namespace dorvex {

const mtms* NetvpdRun::farChassis(unsigned int frame, unsigned int cage) {
  uint64_t key = positionKey(frame, cage);
  auto known = far_chassis_.find(key);
  if (known != far_chassis_.end()) return &known->second;
  chassisVPD record;
  if (vpd_.getSwitchvpd(frame, cage, record) != VPD_FOUND) return nullptr;
  return &far_chassis_.emplace(key, record.sw_mtms).first->second;
}

const mtms* NetvpdRun::farCec(unsigned int frame, unsigned int cage) {
  uint64_t key = positionKey(frame, cage);
  auto known = far_cecs_.find(key);
  if (known != far_cecs_.end()) return &known->second;
  std::list<smaVPD> records;
  if (vpd_.getSMAvpd(frame, cage, 1, records) != VPD_FOUND) return nullptr;
  return &far_cecs_.emplace(key, records.front().cec_mtms).first->second;
}

}  // namespace dorvex
