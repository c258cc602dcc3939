// The management consoles, the BPAs each one reaches, and their MTMS, as the hardware
// server reports them. Filled once per network VPD request, read by the switch writer.
#ifndef DORVEX_CONSOLE_DISCOVERY_H_
#define DORVEX_CONSOLE_DISCOVERY_H_

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "mtms.h"

namespace dorvex {

// One BPA that a console reaches.
struct bpa_info_t {
  uint32_t vport;  // virtual port of the power commands; not set by the constructor
  mtms bpamtms;
  bpa_info_t() : bpamtms() {}
};

// One management console.
struct zev_info_t {
  unsigned char ip[4];  // IP address, bytes in reply order; not set by the constructor
  mtms zevmtms;
  std::vector<bpa_info_t> bpa;  // in reply order
  zev_info_t() : zevmtms(), bpa() {}
};

// The consoles of this installation; empty until getzevmtms fills it.
extern std::vector<zev_info_t> zev;

// Hardware-server query codes, three bytes each.
constexpr unsigned char kConsoleListQuery[3] = {0x26, 0x27, 0x28};
constexpr unsigned char kBpaListQuery[3] = {0x2c, 0x2d, 0x2e};
constexpr unsigned char kConsoleMtmsQuery[3] = {0x2f, 0x30, 0x31};

// Bytes per entry of a list reply (an IP address or a virtual port).
constexpr std::size_t kListEntryBytes = 4;
// An MTMS image: type-model in bytes 0-7, byte 8 unused, serial in bytes 9-15.
constexpr std::size_t kImageBytes = 16;
constexpr std::size_t kImageSerialOffset = 9;

// Stores an MTMS image of `length` bytes into `m` (strncpy manner: each field stops at the
// first NUL and is NUL-padded). Bytes beyond `length` count as NUL; `image` may be null
// when `length` is 0.
inline void storeMtmsImage(mtms& m, const unsigned char* image, std::size_t length) {
  char bytes[kImageBytes] = {};
  if (image != nullptr) std::memcpy(bytes, image, length < kImageBytes ? length : kImageBytes);
  m.setTM(bytes, mtms::kTmChars);
  m.setSE(bytes + kImageSerialOffset, mtms::kSeChars);
}

// Asks `bridge` (fetchReply, getPayloadLength) and `power` (getBpaMtms) for the consoles and
// appends them to `consoles`: the console list, then the BPA list of every element of
// `consoles` (old elements included), then the MTMS of every console, then the MTMS of
// every BPA. A list reply holds length / 4 entries. Query results are not examined; an
// absent or short reply gives fewer entries or empty MTMS fields. Returns 0.
template <class Bridge, class Power>
int discoverConsoles(std::vector<zev_info_t>& consoles, Bridge& bridge, Power& power) {
  int rc = 0;  // the clients report through it; the replies speak for themselves
  const unsigned char* reply = bridge.fetchReply(&rc, kConsoleListQuery[0], kConsoleListQuery[1],
                                                 kConsoleListQuery[2], nullptr, 0);
  std::size_t entries = reply != nullptr ? bridge.getPayloadLength() / kListEntryBytes : 0;
  for (std::size_t i = 0; i < entries; ++i) {
    zev_info_t console;
    std::memcpy(console.ip, reply + i * kListEntryBytes, kListEntryBytes);
    consoles.push_back(console);
  }

  // Every BPA list before the first console MTMS query: a reply is only readable until
  // the next query on the same client.
  for (zev_info_t& console : consoles) {
    unsigned char ip[4];
    std::memcpy(ip, console.ip, sizeof ip);
    reply =
        bridge.fetchReply(&rc, kBpaListQuery[0], kBpaListQuery[1], kBpaListQuery[2], ip, sizeof ip);
    entries = reply != nullptr ? bridge.getPayloadLength() / kListEntryBytes : 0;
    for (std::size_t i = 0; i < entries; ++i) {
      bpa_info_t bpa;
      std::memcpy(&bpa.vport, reply + i * kListEntryBytes, sizeof bpa.vport);  // host order
      console.bpa.push_back(bpa);
    }
  }

  for (zev_info_t& console : consoles) {
    unsigned char ip[4];
    std::memcpy(ip, console.ip, sizeof ip);
    reply = bridge.fetchReply(&rc, kConsoleMtmsQuery[0], kConsoleMtmsQuery[1], kConsoleMtmsQuery[2],
                              ip, sizeof ip);
    std::size_t length = reply != nullptr ? bridge.getPayloadLength() : 0;
    storeMtmsImage(console.zevmtms, reply, length);
  }

  std::string text;
  for (zev_info_t& console : consoles) {
    for (bpa_info_t& bpa : console.bpa) {
      // A failing call may leave the text alone: never let one BPA inherit another's MTMS.
      text.clear();
      power.getBpaMtms(bpa.vport, text);
      storeMtmsImage(bpa.bpamtms, reinterpret_cast<const unsigned char*>(text.data()), text.size());
    }
  }
  return 0;
}

// Fills zev from the platform's hardware-server client and power commands. Throws the int
// 3548 when no NodeBridge can be created and 3549 when no RackPower can be. Returns 0.
int getzevmtms();

}  // namespace dorvex

#endif  // DORVEX_CONSOLE_DISCOVERY_H_
