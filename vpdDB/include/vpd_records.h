// The three table records and the riser slot of a switch chassis.
//
// Records are stored on disk exactly as they lie in memory (little-endian, no header).
// Byte layouts, offsets in bytes from the start of the record:
//
// riser_vpd_t, 120 bytes:   nbr1 0 (4)   port1 4 (4, signed)   nbr2 8 (4)
//                           port2 12 (4, signed)   riser_fru 16 (104)
//
// smaVPD, 160 bytes:        loc_id 0 (4)   sma_fru 4 (104)   cec_mtms 108 (17)
//                           padding 125 (3)   neighbor_id 128 (4)   timestamp 132 (28)
//
// chassisVPD, 2284 bytes:   loc_id 0 (4)   sw_mtms 4 (17)   sw_fru 21 (104)
//                           dca1_fru 125 (104)   dca2_fru 229 (104)   padding 333 (3)
//                           riser[16] 336 (16 x 120)   timestamp 2256 (28)
//
// bpaVPD, 1508 bytes:       loc_id 0 (4)   timestamp 4 (28)   frame_mtms 32 (17)
//                           bpc1_fru 49 (104)   bpr1_fru[3] 153 (312)   bpd1_fru[3] 465 (312)
//                           bpc2_fru 777 (104)   bpr2_fru[3] 881 (312)   bpd2_fru[3] 1193 (312)
//                           padding 1505 (3)
//
// Copy constructors copy every member whole. Assignment copies loc_id, ports and the
// 28-byte timestamp whole and the mtms and fru_stanza members by their own bounded
// assignment, so the terminator bytes of the destination keep what they held.
#ifndef VPDDB_INCLUDE_VPD_RECORDS_H_
#define VPDDB_INCLUDE_VPD_RECORDS_H_

#include <cstddef>
#include <cstring>
#include <string>

#include "fru_stanza.h"
#include "locid.h"
#include "mtms.h"

// Bytes of the free-text timestamp of every record; copied whole, never parsed.
constexpr std::size_t kTimestampBytes = 28;

struct riser_vpd_t {
  loc_id_t nbr1;  // far end of jack 1
  int port1;      // port on that far end
  loc_id_t nbr2;  // far end of jack 2
  int port2;
  fru_stanza riser_fru;

  riser_vpd_t(const riser_vpd_t&) = default;
  // Neighbours zero, FRU cleared. The ports are zeroed too, so that unused slots hold no
  // stray bytes on disk.
  riser_vpd_t() : nbr1(0), port1(0), nbr2(0), port2(0), riser_fru() {}
  riser_vpd_t& operator=(const riser_vpd_t& o) {
    nbr1 = o.nbr1;
    port1 = o.port1;
    nbr2 = o.nbr2;
    port2 = o.port2;
    riser_fru = o.riser_fru;
    return *this;
  }
};

struct smaVPD {
  loc_id_t loc_id;
  fru_stanza sma_fru;
  mtms cec_mtms;         // the CEC the SMA belongs to
  char padding_[3];      // explicit, so that it is zero on disk like every unused byte
  loc_id_t neighbor_id;  // the switch chassis the adapter is cabled to
  char timestamp[kTimestampBytes];

  static constexpr std::size_t kRecordSize = 160;  // bytes on disk

  smaVPD(const smaVPD&) = default;
  smaVPD() : loc_id(0), sma_fru(), cec_mtms(), padding_{}, neighbor_id(0), timestamp{} {}
  smaVPD& operator=(const smaVPD& o) {
    loc_id = o.loc_id;
    sma_fru = o.sma_fru;
    cec_mtms = o.cec_mtms;
    neighbor_id = o.neighbor_id;
    std::memcpy(timestamp, o.timestamp, kTimestampBytes);
    return *this;
  }

  void setLocid(loc_id_t l) { loc_id = l; }
  void setNeighborid(loc_id_t l) { neighbor_id = l; }
  // Copies the text and NUL-pads the field; at most 28 bytes.
  void setTimestamp(const char* t) { vpd::copyPadded(timestamp, kTimestampBytes, t); }
  void setCECmtms(const mtms& m) { cec_mtms = m; }
  void setSmafru(const fru_stanza& f) { sma_fru = f; }
  loc_id_t getLocid() const { return loc_id; }
  loc_id_t getNeighborid() const { return neighbor_id; }
  // The timestamp up to its first NUL, at most 28 characters.
  std::string getTimestamp() const { return vpd::fieldText(timestamp, kTimestampBytes); }
  mtms getCECmtms() const { return cec_mtms; }
  fru_stanza getSmafru() const { return sma_fru; }
};

struct chassisVPD {
  static constexpr int kRiserSlots = 16;

  loc_id_t loc_id;
  mtms sw_mtms;       // switch MTMS
  fru_stanza sw_fru;  // switch board
  fru_stanza dca1_fru;
  fru_stanza dca2_fru;
  char padding_[3];
  riser_vpd_t riser[kRiserSlots];
  char timestamp[kTimestampBytes];

  static constexpr std::size_t kRecordSize = 2284;  // bytes on disk

  chassisVPD(const chassisVPD&) = default;
  chassisVPD()
      : loc_id(0), sw_mtms(), sw_fru(), dca1_fru(), dca2_fru(), padding_{}, riser(), timestamp{} {}
  chassisVPD& operator=(const chassisVPD& o) {
    loc_id = o.loc_id;
    sw_mtms = o.sw_mtms;
    sw_fru = o.sw_fru;
    dca1_fru = o.dca1_fru;
    dca2_fru = o.dca2_fru;
    for (int i = 0; i < kRiserSlots; ++i) riser[i] = o.riser[i];
    std::memcpy(timestamp, o.timestamp, kTimestampBytes);
    return *this;
  }

  // Slot arguments are 0-based indexes; an index outside 0 to 15 is ignored by the
  // setters and reads as an empty slot through the getters.
  void setLocid(loc_id_t l) { loc_id = l; }
  void setTimestamp(const char* t) { vpd::copyPadded(timestamp, kTimestampBytes, t); }
  void setSWmtms(const mtms& m) { sw_mtms = m; }
  void setSWfru(const fru_stanza& f) { sw_fru = f; }
  void setDca1(const fru_stanza& f) { dca1_fru = f; }
  void setDca2(const fru_stanza& f) { dca2_fru = f; }
  void setRiser(const fru_stanza& f, int i) {
    if (slotOk(i)) riser[i].riser_fru = f;
  }
  void setNeighbor1(loc_id_t l, int i) {
    if (slotOk(i)) riser[i].nbr1 = l;
  }
  void setNeighbor2(loc_id_t l, int i) {
    if (slotOk(i)) riser[i].nbr2 = l;
  }
  void setPort1(int port, int i) {
    if (slotOk(i)) riser[i].port1 = port;
  }
  void setPort2(int port, int i) {
    if (slotOk(i)) riser[i].port2 = port;
  }
  loc_id_t getLocid() const { return loc_id; }
  mtms getSWmtms() const { return sw_mtms; }
  fru_stanza getSWfru() const { return sw_fru; }
  fru_stanza getDca1() const { return dca1_fru; }
  fru_stanza getDca2() const { return dca2_fru; }
  fru_stanza getRiser(int i) const { return slotOk(i) ? riser[i].riser_fru : fru_stanza(); }
  // Copies slot i into r and returns 0; returns 1 and leaves r alone for a bad index.
  int getRiserStruct(riser_vpd_t& r, int i) const {
    if (!slotOk(i)) return 1;
    r = riser[i];
    return 0;
  }
  std::string getTimestamp() const { return vpd::fieldText(timestamp, kTimestampBytes); }

  static bool slotOk(int i) { return i >= 0 && i < kRiserSlots; }
};

struct bpaVPD {
  static constexpr int kUnitsPerKind = 3;  // regulators and distributors per side

  loc_id_t loc_id;
  char timestamp[kTimestampBytes];
  mtms frame_mtms;
  fru_stanza bpc1_fru;
  fru_stanza bpr1_fru[kUnitsPerKind];
  fru_stanza bpd1_fru[kUnitsPerKind];
  fru_stanza bpc2_fru;
  fru_stanza bpr2_fru[kUnitsPerKind];
  fru_stanza bpd2_fru[kUnitsPerKind];
  char padding_[3];

  static constexpr std::size_t kRecordSize = 1508;  // bytes on disk

  bpaVPD(const bpaVPD&) = default;
  bpaVPD()
      : loc_id(0),
        timestamp{},
        frame_mtms(),
        bpc1_fru(),
        bpr1_fru(),
        bpd1_fru(),
        bpc2_fru(),
        bpr2_fru(),
        bpd2_fru(),
        padding_{} {}
  ~bpaVPD() = default;
  bpaVPD& operator=(const bpaVPD& o) {
    loc_id = o.loc_id;
    std::memcpy(timestamp, o.timestamp, kTimestampBytes);
    frame_mtms = o.frame_mtms;
    bpc1_fru = o.bpc1_fru;
    bpc2_fru = o.bpc2_fru;
    for (int i = 0; i < kUnitsPerKind; ++i) {
      bpr1_fru[i] = o.bpr1_fru[i];
      bpd1_fru[i] = o.bpd1_fru[i];
      bpr2_fru[i] = o.bpr2_fru[i];
      bpd2_fru[i] = o.bpd2_fru[i];
    }
    return *this;
  }

  // Index arguments are 0 to 2; another index is ignored by the setters and reads as an
  // empty FRU through the getters.
  void setLocid(loc_id_t l) { loc_id = l; }
  void setTimestamp(const char* t) { vpd::copyPadded(timestamp, kTimestampBytes, t); }
  void setMtms(const mtms& m) { frame_mtms = m; }
  void setBpc1(const fru_stanza& f) { bpc1_fru = f; }
  void setBpr1(const fru_stanza& f, int i) { put(bpr1_fru, f, i); }
  void setBpd1(const fru_stanza& f, int i) { put(bpd1_fru, f, i); }
  void setBpc2(const fru_stanza& f) { bpc2_fru = f; }
  void setBpr2(const fru_stanza& f, int i) { put(bpr2_fru, f, i); }
  void setBpd2(const fru_stanza& f, int i) { put(bpd2_fru, f, i); }
  loc_id_t getLocid() const { return loc_id; }
  std::string getTimestamp() const { return vpd::fieldText(timestamp, kTimestampBytes); }
  mtms getMtms() const { return frame_mtms; }
  fru_stanza getBpc1() const { return bpc1_fru; }
  fru_stanza getBpr1(int i) const { return get(bpr1_fru, i); }
  fru_stanza getBpd1(int i) const { return get(bpd1_fru, i); }
  fru_stanza getBpc2() const { return bpc2_fru; }
  fru_stanza getBpr2(int i) const { return get(bpr2_fru, i); }
  fru_stanza getBpd2(int i) const { return get(bpd2_fru, i); }

  static bool unitOk(int i) { return i >= 0 && i < kUnitsPerKind; }

 private:
  static void put(fru_stanza (&a)[kUnitsPerKind], const fru_stanza& f, int i) {
    if (unitOk(i)) a[i] = f;
  }
  static fru_stanza get(const fru_stanza (&a)[kUnitsPerKind], int i) {
    return unitOk(i) ? a[i] : fru_stanza();
  }
};

// The records are stored as they lie in memory: prove every size and offset.
static_assert(sizeof(riser_vpd_t) == 120, "riser_vpd_t is 120 bytes");
static_assert(offsetof(riser_vpd_t, nbr1) == 0 && offsetof(riser_vpd_t, port1) == 4 &&
                  offsetof(riser_vpd_t, nbr2) == 8 && offsetof(riser_vpd_t, port2) == 12 &&
                  offsetof(riser_vpd_t, riser_fru) == 16,
              "riser_vpd_t field offsets");

static_assert(sizeof(smaVPD) == smaVPD::kRecordSize, "smaVPD is 160 bytes");
static_assert(offsetof(smaVPD, loc_id) == 0 && offsetof(smaVPD, sma_fru) == 4 &&
                  offsetof(smaVPD, cec_mtms) == 108 && offsetof(smaVPD, neighbor_id) == 128 &&
                  offsetof(smaVPD, timestamp) == 132,
              "smaVPD field offsets");

static_assert(sizeof(chassisVPD) == chassisVPD::kRecordSize, "chassisVPD is 2284 bytes");
static_assert(offsetof(chassisVPD, loc_id) == 0 && offsetof(chassisVPD, sw_mtms) == 4 &&
                  offsetof(chassisVPD, sw_fru) == 21 && offsetof(chassisVPD, dca1_fru) == 125 &&
                  offsetof(chassisVPD, dca2_fru) == 229 && offsetof(chassisVPD, riser) == 336 &&
                  offsetof(chassisVPD, timestamp) == 2256,
              "chassisVPD field offsets");

static_assert(sizeof(bpaVPD) == bpaVPD::kRecordSize, "bpaVPD is 1508 bytes");
static_assert(offsetof(bpaVPD, loc_id) == 0 && offsetof(bpaVPD, timestamp) == 4 &&
                  offsetof(bpaVPD, frame_mtms) == 32 && offsetof(bpaVPD, bpc1_fru) == 49 &&
                  offsetof(bpaVPD, bpr1_fru) == 153 && offsetof(bpaVPD, bpd1_fru) == 465 &&
                  offsetof(bpaVPD, bpc2_fru) == 777 && offsetof(bpaVPD, bpr2_fru) == 881 &&
                  offsetof(bpaVPD, bpd2_fru) == 1193,
              "bpaVPD field offsets");

#endif  // VPDDB_INCLUDE_VPD_RECORDS_H_
