#include "nodebridge.h"

#include <cstring>
#include <stdexcept>
#include <utility>
#include <vector>

#include "hwconfig.h"

namespace {

// The queries this stand-in answers, as their three codes.
struct Codes {
  unsigned char c1, c2, c3;
  bool is(unsigned char a, unsigned char b, unsigned char c) const {
    return c1 == a && c2 == b && c3 == c;
  }
};

void appendConsoleList(const hwserver::Config& config, std::vector<unsigned char>* reply) {
  for (const hwserver::Console& console : config.consoles) {
    reply->insert(reply->end(), console.ip.begin(), console.ip.end());
  }
}

// Each virtual port as it lies in memory: the client reads the bytes back the same way.
void appendBpaList(const hwserver::Console& console, std::vector<unsigned char>* reply) {
  for (uint32_t vport : console.bpa_vports) {
    unsigned char bytes[sizeof vport];
    std::memcpy(bytes, &vport, sizeof vport);
    reply->insert(reply->end(), bytes, bytes + sizeof bytes);
  }
}

void appendConsoleMtms(const hwserver::Console& console, std::vector<unsigned char>* reply) {
  std::string image = hwserver::mtmsImage(console.tm, console.se);
  reply->insert(reply->end(), image.begin(), image.end());
}

// Fills `reply` and tells whether the query was one this stand-in knows, with the payload
// it needs. Replies never exceed a 16-bit length: the configuration's lists are bounded.
bool answer(const hwserver::Config& config, Codes codes, const unsigned char* payload,
            unsigned short length, std::vector<unsigned char>* reply) {
  if (codes.is(0x26, 0x27, 0x28)) {
    appendConsoleList(config, reply);
    return true;
  }
  bool bpa_list = codes.is(0x2c, 0x2d, 0x2e);
  bool console_mtms = codes.is(0x2f, 0x30, 0x31);
  if (!bpa_list && !console_mtms) return false;
  if (payload == nullptr || length < 4) return false;
  const hwserver::Console* console = hwserver::findConsole(config, payload);
  if (console == nullptr) return true;
  if (bpa_list) {
    appendBpaList(*console, reply);
  } else {
    appendConsoleMtms(*console, reply);
  }
  return true;
}

}  // namespace

NodeBridge::NodeBridge() {
  hwserver::LoadResult loaded = hwserver::load();
  if (!loaded.ok) throw std::runtime_error(loaded.error);
  config_ = std::make_unique<hwserver::Config>(std::move(loaded.config));
}

NodeBridge::~NodeBridge() = default;

unsigned char* NodeBridge::fetchReply(int* rc, unsigned char code1, unsigned char code2,
                                      unsigned char code3, unsigned char* payload,
                                      unsigned short length) {
  reply_.reset();
  reply_length_ = 0;
  std::vector<unsigned char> reply;
  bool known = answer(*config_, Codes{code1, code2, code3}, payload, length, &reply);
  if (rc != nullptr) *rc = known ? 0 : 1;
  if (!reply.empty()) {
    reply_ = std::make_unique<unsigned char[]>(reply.size());
    std::memcpy(reply_.get(), reply.data(), reply.size());
    reply_length_ = static_cast<unsigned short>(reply.size());
  }
  return reply_.get();
}

unsigned short NodeBridge::getPayloadLength() { return reply_length_; }
