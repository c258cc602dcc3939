// The packed hardware location word shared by every table record and by the
// console's other programs.
//
// Layout of the 32-bit word, counted from the least significant bit:
//   chip     bits 0-3    (4)   chip index within the cage
//   uid      bits 4-11   (8)   cage number, also called slot
//   frame    bits 12-23  (12)  frame number
//   type     bits 24-27  (4)   device type, a dev_type_t value
//   plane    bit  28     (1)
//   network  bits 29-31  (3)
// The word is stored little-endian, on disk as in memory.
#ifndef COMMON_INCLUDE_LOCID_H_
#define COMMON_INCLUDE_LOCID_H_

#include <cstdint>

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__,
              "table records are stored as they lie in memory: a little-endian host is required");

class loc_id_t {
 public:
  loc_id_t() = default;
  // Takes the whole packed word; loc_id_t(0) is the no-location value.
  loc_id_t(unsigned int word) : word_(word) {}  // NOLINT(google-explicit-constructor)
  // Builds a location from its six fields; bits beyond a field's width are dropped.
  loc_id_t(unsigned int frame, unsigned int cage, unsigned int chip, unsigned int type,
           unsigned int plane, unsigned int network) {
    setFrame(frame);
    setCage(cage);
    setChip(chip);
    setType(type);
    setPlane(plane);
    setNetwork(network);
  }

  // A location is valid when it names something: the all-zero word is "no location".
  bool isValid() const { return word_ != 0; }

  void setChip(unsigned int v) { put(kChipShift, kChipWidth, v); }
  void setCage(unsigned int v) { put(kUidShift, kUidWidth, v); }
  void setFrame(unsigned int v) { put(kFrameShift, kFrameWidth, v); }
  void setType(unsigned int v) { put(kTypeShift, kTypeWidth, v); }
  void setPlane(unsigned int v) { put(kPlaneShift, kPlaneWidth, v); }
  void setNetwork(unsigned int v) { put(kNetworkShift, kNetworkWidth, v); }

  unsigned int getChip() const { return get(kChipShift, kChipWidth); }
  unsigned int getCage() const { return get(kUidShift, kUidWidth); }
  unsigned int getFrame() const { return get(kFrameShift, kFrameWidth); }
  unsigned int getType() const { return get(kTypeShift, kTypeWidth); }
  unsigned int getPlane() const { return get(kPlaneShift, kPlaneWidth); }
  unsigned int getNetwork() const { return get(kNetworkShift, kNetworkWidth); }

  unsigned int toInt() const { return word_; }

  // SMA chip number of a 4-bit chip index; 255 for an index above 7.
  static unsigned char SMAchip(unsigned int chip) {
    static const unsigned char kMap[8] = {2, 3, 6, 7, 8, 9, 12, 13};
    return chip < 8 ? kMap[chip] : 255;
  }
  unsigned char SMAchip() const { return SMAchip(getChip()); }

  bool operator!=(const loc_id_t& o) const { return word_ != o.word_; }
  bool operator==(const loc_id_t& o) const { return word_ == o.word_; }

  // Field widths in bits and their positions.
  static constexpr unsigned kChipShift = 0, kChipWidth = 4;
  static constexpr unsigned kUidShift = 4, kUidWidth = 8;
  static constexpr unsigned kFrameShift = 12, kFrameWidth = 12;
  static constexpr unsigned kTypeShift = 24, kTypeWidth = 4;
  static constexpr unsigned kPlaneShift = 28, kPlaneWidth = 1;
  static constexpr unsigned kNetworkShift = 29, kNetworkWidth = 3;

 private:
  static constexpr uint32_t mask(unsigned width) { return (uint32_t{1} << width) - 1; }
  void put(unsigned shift, unsigned width, unsigned int v) {
    word_ = (word_ & ~(mask(width) << shift)) | ((uint32_t{v} & mask(width)) << shift);
  }
  unsigned int get(unsigned shift, unsigned width) const { return (word_ >> shift) & mask(width); }

  uint32_t word_ = 0;
};

static_assert(sizeof(loc_id_t) == 4, "loc_id_t is one 32-bit word");

#endif  // COMMON_INCLUDE_LOCID_H_
