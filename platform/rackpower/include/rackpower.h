// Power-controller commands, as the console's librackpower offers them.
//
// This stand-in answers from $OLV_ROOT/etc/hwserver.json (see docs/platform.md).
#ifndef PLATFORM_RACKPOWER_INCLUDE_RACKPOWER_H_
#define PLATFORM_RACKPOWER_INCLUDE_RACKPOWER_H_

#include <memory>
#include <string>

namespace hwserver {
struct Config;
}

class RackPower {
 public:
  // Throws std::runtime_error under the same conditions as NodeBridge().
  RackPower();
  ~RackPower();
  RackPower(const RackPower&) = delete;
  RackPower& operator=(const RackPower&) = delete;

  // The MTMS of the BPA behind vport: mtms becomes 16 characters, the type-model NUL-padded
  // to 8, "*", the serial NUL-padded to 7; result 0. Unknown vport: result 1, mtms unchanged.
  int getBpaMtms(unsigned long vport, std::string& mtms);

 private:
  std::unique_ptr<hwserver::Config> config_;
};

#endif  // PLATFORM_RACKPOWER_INCLUDE_RACKPOWER_H_
