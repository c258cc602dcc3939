// What one network VPD request learns once and then reuses for every switch chassis it
// writes. A run lives exactly as long as its request: a second request (or a test) starts a
// fresh one, so nothing learned from one set of tables leaks into the next.
#ifndef DORVEX_NETVPD_RUN_H_
#define DORVEX_NETVPD_RUN_H_

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "vpdDB.h"

namespace dorvex {

class NetvpdRun {
 public:
  // Answers from `vpd`, the request's one open database; the caller keeps it alive.
  explicit NetvpdRun(vpdDB& vpd) : vpd_(vpd) {}

  NetvpdRun(const NetvpdRun&) = delete;
  NetvpdRun& operator=(const NetvpdRun&) = delete;

  // The MTMS of the first switch chassis at frame and cage (as getSwitchvpd assigns it), or
  // null when there is none. A chassis that was found is remembered; one that was not is
  // looked up again on every call, so each of its cable lines traces its own not-found.
  // The pointer stays valid for the life of the run.
  const mtms* farChassis(unsigned int frame, unsigned int cage);

  // The CEC MTMS of the first SMA record of adapter 1 at frame and cage (as getSMAvpd
  // lists it), or null when there is none; remembered on the same terms as farChassis.
  const mtms* farCec(unsigned int frame, unsigned int cage);

  // The frame MTMS of the first BPA record at frame and cage (as getBPAvpd assigns it), or
  // the empty MTMS when there is none; remembered on the same terms as farChassis.
  mtms bpaMtmsAt(unsigned int frame, unsigned int cage);

  // The MTMS of every console that lists a BPA equal (mtms ==) to `bpa`: one entry per such
  // listing, in the order of zev and of each console's BPA list, duplicates kept. The
  // consoles are those of zev, which must not change during the run. The reference stays
  // valid until the next call.
  const std::vector<mtms>& consolesReaching(const mtms& bpa);

 private:
  static uint64_t positionKey(unsigned int frame, unsigned int cage) {
    return (uint64_t{frame} << 32) | cage;
  }

  // Equal for two MTMS exactly when they compare equal: each field's text up to its first
  // NUL, padded with NUL to the field's significant length.
  static std::string mtmsKey(const mtms& m);

  vpdDB& vpd_;
  std::unordered_map<uint64_t, mtms> far_chassis_;
  std::unordered_map<uint64_t, mtms> far_cecs_;
  std::unordered_map<uint64_t, mtms> bpas_;

  int console_queries_ = 0;
  std::vector<mtms> first_consoles_;  // the answer to the first query
  std::unordered_map<std::string, std::vector<mtms>> consoles_by_bpa_;
};

}  // namespace dorvex

#endif  // DORVEX_NETVPD_RUN_H_
