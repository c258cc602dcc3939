#include "installation_layout.h"

#include "vpd_types.h"

namespace gen {
namespace {

constexpr unsigned int kMaxNetworks = 7;  // the 3-bit field, network 0 left unused
constexpr unsigned int kMaxFrames = 4095;
constexpr unsigned int kMaxChips = 16;
constexpr unsigned int kMaxCage = 254;  // 255 is the BPA's
constexpr unsigned int kMaxConsoles = 16383;
constexpr unsigned int kChipsPerFarSwitch = 8;  // chip indexes with a far riser slot
constexpr unsigned int kPorts = 4;
constexpr unsigned int kSmaJacksPerSwitch = kSmaRisers * 2;

// What a hash is for, so that two questions with the same numbers get different answers.
enum HashKind : uint64_t {
  kSwitchSerial = 1,
  kCecSerial,
  kBpaSerial,
  kConsoleSerial,
  kSwitchCable,
};

uint64_t mix(uint64_t x) {  // the splitmix64 finaliser
  x += 0x9e3779b97f4a7c15ull;
  x = (x ^ (x >> 30)) * 0xbf58476d1ce4e5b9ull;
  x = (x ^ (x >> 27)) * 0x94d049bb133111ebull;
  return x ^ (x >> 31);
}

unsigned int ceilDiv(unsigned int a, unsigned int b) { return (a + b - 1) / b; }

}  // namespace

Params Params::scaled(unsigned int n) {
  Params p;
  p.switches_per_network = 16 * n;
  p.networks = 1;
  p.cecs = 64 * n;
  p.sma_per_cec = 8;
  p.frames = 4 * n;
  p.consoles = 2;
  return p;
}

std::string checkParams(const Params& p) {
  if (p.networks < 1 || p.networks > kMaxNetworks) return "networks must be 1 to 7";
  if (p.frames < 1 || p.frames > kMaxFrames) return "frames must be 1 to 4095";
  if (p.sma_per_cec > kMaxChips) return "SMA records per CEC must be 0 to 16 (one per chip)";
  if (p.switches_per_network > kChipListEntries)
    return "at most 2048 switch chassis per network fit dorvex's chip list";
  if (p.consoles > kMaxConsoles) return "at most 16383 consoles";
  uint64_t switches = uint64_t{p.switches_per_network} * p.networks;
  uint64_t cages =
      (switches + p.frames - 1) / p.frames + (uint64_t{p.cecs} + p.frames - 1) / p.frames;
  if (cages > kMaxCage)
    return "too many switch chassis and CECs for the frames: a frame has cages 1 to 254";
  return "";
}

Layout::Layout(const Params& p) : p_(p), switch_cages_(ceilDiv(switchCount(), p.frames)) {}

unsigned int Layout::chipLinesPerSwitch() const {
  return p_.switches_per_network * 2 <= kChipListEntries ? 2 : 1;
}

uint64_t Layout::hash(uint64_t what, uint64_t a, uint64_t b, uint64_t c) const {
  uint64_t h = mix(p_.seed ^ mix(what));
  h = mix(h ^ a);
  h = mix(h ^ b);
  return mix(h ^ c);
}

Position Layout::switchAt(unsigned int s) const { return {1 + s % p_.frames, 1 + s / p_.frames}; }

Position Layout::cecAt(unsigned int c) const {
  return {1 + c % p_.frames, 1 + switch_cages_ + c / p_.frames};
}

loc_id_t Layout::switchLocation(unsigned int s) const {
  Position at = switchAt(s);
  return loc_id_t(at.frame, at.cage, 0, CHASSIS, s % 2, networkOf(s));
}

loc_id_t Layout::cecLocation(unsigned int c, unsigned int chip) const {
  Position at = cecAt(c);
  return loc_id_t(at.frame, at.cage, chip, SMA, chip % 2, 1 + chip % p_.networks);
}

loc_id_t Layout::bpaLocation(unsigned int f) const {
  return loc_id_t(f, kBpaCage, 0, BPA, 0, 1 + (f - 1) % p_.networks);
}

// A letter and six base-36 digits: distinct for distinct indexes below 36^6, and the seed
// moves where the numbering starts.
std::string Layout::serial(char prefix, uint64_t kind, unsigned int index) const {
  static const char kDigits[] = "0123456789ABCDEFGHIJKLMNOPQRSTUVWXYZ";
  constexpr uint64_t kRange = 36ull * 36 * 36 * 36 * 36 * 36;
  uint64_t v = (index + hash(kind, 0)) % kRange;
  std::string text(7, '0');
  text[0] = prefix;
  for (int i = 6; i >= 1; --i, v /= 36) text[i] = kDigits[v % 36];
  return text;
}

mtms Layout::switchMtms(unsigned int s) const {
  return mtms("7045-SW4", serial('S', kSwitchSerial, s).c_str());
}
mtms Layout::cecMtms(unsigned int c) const {
  return mtms("9125-F2A", serial('C', kCecSerial, c).c_str());
}
mtms Layout::bpaMtms(unsigned int f) const {
  return mtms("9458-100", serial('B', kBpaSerial, f).c_str());
}
mtms Layout::consoleMtms(unsigned int c) const {
  return mtms("7042CR9", serial('H', kConsoleSerial, c).c_str());
}

Cable Layout::cable(unsigned int s, int riser, int jack) const {
  if (riser < kSmaRisers && smaCount() > 0) {
    uint64_t q = uint64_t{s} * kSmaJacksPerSwitch + static_cast<uint64_t>(riser) * 2 + (jack - 1);
    unsigned int sma = static_cast<unsigned int>(q % smaCount());
    return {cecLocation(sma / p_.sma_per_cec, sma % p_.sma_per_cec), 0};
  }
  uint64_t h = hash(kSwitchCable, s, static_cast<uint64_t>(riser), static_cast<uint64_t>(jack));
  unsigned int per_network = p_.switches_per_network;
  unsigned int k = s % per_network;
  unsigned int far_k =
      per_network > 1 ? (k + 1 + static_cast<unsigned int>(h % (per_network - 1))) % per_network
                      : k;
  unsigned int far = s - k + far_k;
  Position at = switchAt(far);
  unsigned int chip = static_cast<unsigned int>((h >> 32) % kChipsPerFarSwitch);
  int port = static_cast<int>((h >> 40) % kPorts);
  unsigned int type = ((h >> 48) & 1) != 0 ? ISB : NSB;
  return {loc_id_t(at.frame, at.cage, chip, type, (h >> 49) & 1, networkOf(far)), port};
}

loc_id_t Layout::smaNeighbor(unsigned int c, unsigned int chip) const {
  if (switchCount() == 0) return loc_id_t(0);
  uint64_t idx = uint64_t{c} * p_.sma_per_cec + chip;
  unsigned int s = static_cast<unsigned int>((idx / kSmaJacksPerSwitch) % switchCount());
  Position at = switchAt(s);
  unsigned int riser = static_cast<unsigned int>(idx % kSmaJacksPerSwitch) / 2;
  return loc_id_t(at.frame, at.cage, riser, NSB, chip % 2, networkOf(s));
}

}  // namespace gen
