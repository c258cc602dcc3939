// What the hardware-server and power-command stand-ins know about the installation: the
// consoles, the BPAs each console reaches, and the MTMS of every console and BPA, as read
// from $OLV_ROOT/etc/hwserver.json (format in docs/platform.md).
#ifndef PLATFORM_HWCONFIG_INCLUDE_HWCONFIG_H_
#define PLATFORM_HWCONFIG_INCLUDE_HWCONFIG_H_

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace hwserver {

// Longest type-model and serial, in bytes.
constexpr size_t kTypeModelMax = 8;
constexpr size_t kSerialMax = 7;
// Bytes of an MTMS image: the type-model, one '*', the serial.
constexpr size_t kMtmsImageSize = kTypeModelMax + 1 + kSerialMax;
// Bytes of one entry of a list reply (an IP address or a virtual port).
constexpr size_t kListEntrySize = 4;
// A reply's length is a 16-bit byte count, so a list reply holds at most this many entries.
constexpr size_t kMaxListEntries = 0xFFFF / kListEntrySize;

struct Console {
  std::array<unsigned char, 4> ip{};  // octets in the order written
  std::string tm;                     // at most kTypeModelMax bytes, no control characters
  std::string se;                     // at most kSerialMax bytes, no control characters
  std::vector<uint32_t> bpa_vports;   // file order, at most kMaxListEntries
};

struct Bpa {
  uint32_t vport = 0;
  std::string tm;
  std::string se;
};

struct Config {
  std::vector<Console> consoles;  // file order, at most kMaxListEntries
  std::vector<Bpa> bpas;          // file order
};

// A configuration, or the reason there is none.
struct LoadResult {
  bool ok = false;
  Config config;      // empty unless ok
  std::string error;  // when !ok: "<file>: <where>: <what was wrong>"
};

// Reads $OLV_ROOT/etc/hwserver.json. A missing file is ok and gives an empty Config; a file
// that cannot be read, is not valid JSON, or breaks a rule of the format is an error.
// Never throws (short of running out of memory).
LoadResult load();

// load() for any path.
LoadResult loadFile(const std::string& path);

// Checks JSON text against the format; `name` (the file) starts every error message.
LoadResult parse(const std::string& text, const std::string& name);

// The 16-byte MTMS image: tm NUL-padded to 8 bytes, '*', se NUL-padded to 7 bytes.
// Longer values are cut (parse() never lets one through).
std::string mtmsImage(const std::string& tm, const std::string& se);

// The first console with that address, or null.
const Console* findConsole(const Config& config, const unsigned char ip[4]);

// The first BPA with that virtual port, or null (always null above 32 bits).
const Bpa* findBpa(const Config& config, unsigned long vport);

}  // namespace hwserver

#endif  // PLATFORM_HWCONFIG_INCLUDE_HWCONFIG_H_
