// Reading a fuzz input as a sequence of little fields. Past the end every field reads as 0
// (or empty), so any byte string is a valid input and the layout needs no length checks.
#ifndef TESTS_FUZZ_FUZZ_INPUT_H_
#define TESTS_FUZZ_FUZZ_INPUT_H_

#include <cstddef>
#include <cstdint>
#include <string>

namespace fuzzsupport {

class FuzzInput {
 public:
  FuzzInput(const uint8_t* data, std::size_t size) : data_(data), size_(size) {}

  uint8_t u8() { return pos_ < size_ ? data_[pos_++] : 0; }
  // Little-endian, as the tables store their words.
  uint32_t u32() {
    uint32_t v = 0;
    for (int i = 0; i < 4; ++i) v |= uint32_t{u8()} << (8 * i);
    return v;
  }
  // Up to n bytes (fewer at the end of the input).
  std::string bytes(std::size_t n) {
    std::size_t take = n < remaining() ? n : remaining();
    std::string out(reinterpret_cast<const char*>(data_ + pos_), take);
    pos_ += take;
    return out;
  }
  std::string rest() { return bytes(remaining()); }
  std::size_t remaining() const { return size_ - pos_; }

 private:
  const uint8_t* data_;
  std::size_t size_;
  std::size_t pos_ = 0;
};

}  // namespace fuzzsupport

#endif  // TESTS_FUZZ_FUZZ_INPUT_H_
