#include "netvpd_run.h"

#include <cstring>
#include <list>

#include "console_discovery.h"

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

mtms NetvpdRun::bpaMtmsAt(unsigned int frame, unsigned int cage) {
  uint64_t key = positionKey(frame, cage);
  auto known = bpas_.find(key);
  if (known != bpas_.end()) return known->second;
  bpaVPD record;
  if (vpd_.getBPAvpd(frame, cage, record) != VPD_FOUND) return mtms();
  return bpas_.emplace(key, record.frame_mtms).first->second;
}

std::string NetvpdRun::mtmsKey(const mtms& m) {
  std::string key(mtms::kTmChars + mtms::kSeChars, '\0');
  std::memcpy(&key[0], m.tm, strnlen(m.tm, mtms::kTmChars));
  std::memcpy(&key[mtms::kTmChars], m.se, strnlen(m.se, mtms::kSeChars));
  return key;
}

const std::vector<mtms>& NetvpdRun::consolesReaching(const mtms& bpa) {
  // A run that writes one chassis compares its BPA with every console's list once, as
  // cheap as it gets; from the second chassis on, one pass has built the table.
  if (++console_queries_ == 1) {
    for (const zev_info_t& console : zev) {
      for (const bpa_info_t& listed : console.bpa) {
        if (listed.bpamtms == bpa) first_consoles_.push_back(console.zevmtms);
      }
    }
    return first_consoles_;
  }
  if (console_queries_ == 2) {
    for (const zev_info_t& console : zev) {
      for (const bpa_info_t& listed : console.bpa) {
        consoles_by_bpa_[mtmsKey(listed.bpamtms)].push_back(console.zevmtms);
      }
    }
  }
  static const std::vector<mtms> kNone;
  auto found = consoles_by_bpa_.find(mtmsKey(bpa));
  return found != consoles_by_bpa_.end() ? found->second : kNone;
}

}  // namespace dorvex
