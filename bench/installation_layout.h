// The shape of a generated installation: where every switch chassis, CEC and BPA sits,
// what each riser jack is cabled to, and the identities (MTMS) of every enclosure.
//
// Everything here is a pure function of the parameters and the seed, and every answer can
// be asked for in any order (the randomness comes from hashing the seed with the question,
// not from a sequence), so the writer, the benchmarks and the tests agree on the layout
// without sharing state.
//
// Placement: frame numbers 1..frames. Switch chassis s (all networks, network-major) sits
// in frame 1 + s % frames at cage 1 + s / frames; CEC c in frame 1 + c % frames at a cage
// above the switch cages; every frame has its BPA at cage 255.
//
// Cabling: risers 0-7 of every switch go down to SMA chips (spread over all CECs), risers
// 8-15 across to random switch chassis of the same network (random far chip and port).
#ifndef BENCH_INSTALLATION_LAYOUT_H_
#define BENCH_INSTALLATION_LAYOUT_H_

#include <cstdint>
#include <string>

#include "locid.h"
#include "mtms.h"

namespace gen {

// Cage of a frame's BPA record.
constexpr unsigned int kBpaCage = 255;
// Risers of a chassis cabled to SMA chips; the others go to switch chassis.
constexpr int kSmaRisers = 8;
// Entries of dorvex's switch chip list, repeats included.
constexpr unsigned int kChipListEntries = 2048;

struct Params {
  unsigned int switches_per_network = 16;
  unsigned int networks = 1;  // numbered 1..networks
  unsigned int cecs = 64;
  unsigned int sma_per_cec = 8;  // SMA chips 0..n-1 of each CEC
  unsigned int frames = 4;
  unsigned int consoles = 2;
  uint64_t seed = 1;

  // The growth series: size proportional to n; n = 64 is the large installation (1024
  // switch chassis on one network, 4096 CECs with 8 SMA records each, 256 frames).
  static Params scaled(unsigned int n);
};

// Why the parameters cannot make an installation, or "" when they can.
std::string checkParams(const Params& p);

struct Position {
  unsigned int frame;
  unsigned int cage;
};

// The far end of one riser jack as the chassis record stores it.
struct Cable {
  loc_id_t far;
  int port;
};

class Layout {
 public:
  // REQUIRES: checkParams(p) is empty.
  explicit Layout(const Params& p);

  const Params& params() const { return p_; }
  unsigned int switchCount() const { return p_.switches_per_network * p_.networks; }
  unsigned int smaCount() const { return p_.cecs * p_.sma_per_cec; }
  // Switch chassis cages in use per frame (cages 1..n).
  unsigned int switchCagesPerFrame() const { return switch_cages_; }
  // SW_CHIP lines in the dump per chassis: two while they all fit dorvex's chip list.
  unsigned int chipLinesPerSwitch() const;

  unsigned int networkOf(unsigned int s) const { return 1 + s / p_.switches_per_network; }
  Position switchAt(unsigned int s) const;
  Position cecAt(unsigned int c) const;
  // Frames are numbered from 1; f is 1..frames.
  Position bpaAt(unsigned int f) const { return {f, kBpaCage}; }

  loc_id_t switchLocation(unsigned int s) const;
  loc_id_t cecLocation(unsigned int c, unsigned int chip) const;
  loc_id_t bpaLocation(unsigned int f) const;

  mtms switchMtms(unsigned int s) const;
  mtms cecMtms(unsigned int c) const;
  mtms bpaMtms(unsigned int f) const;
  mtms consoleMtms(unsigned int c) const;

  // riser 0..15, jack 1 or 2.
  Cable cable(unsigned int s, int riser, int jack) const;
  // The switch chassis that SMA chip `chip` of CEC c is cabled to (its riser jack points
  // back at this chip when the switches have jacks enough for every SMA chip).
  loc_id_t smaNeighbor(unsigned int c, unsigned int chip) const;

  // A number from the seed and up to three coordinates; the same question, the same answer.
  uint64_t hash(uint64_t what, uint64_t a, uint64_t b = 0, uint64_t c = 0) const;

 private:
  std::string serial(char prefix, uint64_t kind, unsigned int index) const;

  Params p_;
  unsigned int switch_cages_;
};

}  // namespace gen

#endif  // BENCH_INSTALLATION_LAYOUT_H_
