#include "rackpower.h"

#include <stdexcept>
#include <utility>

#include "hwconfig.h"

RackPower::RackPower() {
  hwserver::LoadResult loaded = hwserver::load();
  if (!loaded.ok) throw std::runtime_error(loaded.error);
  config_ = std::make_unique<hwserver::Config>(std::move(loaded.config));
}

RackPower::~RackPower() = default;

int RackPower::getBpaMtms(unsigned long vport, std::string& mtms) {
  // findBpa compares in unsigned long, so a port above 32 bits matches no BPA rather than
  // one whose port equals its low half.
  const hwserver::Bpa* bpa = hwserver::findBpa(*config_, vport);
  if (bpa == nullptr) return 1;
  mtms = hwserver::mtmsImage(bpa->tm, bpa->se);
  return 0;
}
