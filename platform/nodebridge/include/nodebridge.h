// Hardware-server client, as the console's libnodebridge offers it.
//
// This stand-in answers from $OLV_ROOT/etc/hwserver.json (see docs/platform.md).
#ifndef PLATFORM_NODEBRIDGE_INCLUDE_NODEBRIDGE_H_
#define PLATFORM_NODEBRIDGE_INCLUDE_NODEBRIDGE_H_

#include <memory>

namespace hwserver {
struct Config;
}

class NodeBridge {
 public:
  // Throws std::runtime_error (naming the file and the fault) when the configuration exists
  // but cannot be read or parsed, or breaks a rule; a missing file is an installation
  // without consoles.
  NodeBridge();
  ~NodeBridge();
  NodeBridge(const NodeBridge&) = delete;
  NodeBridge& operator=(const NodeBridge&) = delete;

  // Sends one query (three one-byte codes and a request payload) and returns the reply
  // payload. The bytes stay readable until the next call on this object; the pointer may
  // be null when the reply is empty. *rc is set to 0 for a known query, 1 otherwise.
  unsigned char* fetchReply(int* rc, unsigned char code1, unsigned char code2,
                            unsigned char code3, unsigned char* payload, unsigned short length);
  // Length in bytes of the last reply payload.
  unsigned short getPayloadLength();

 private:
  std::unique_ptr<hwserver::Config> config_;
  std::unique_ptr<unsigned char[]> reply_;
  unsigned short reply_length_ = 0;
};

#endif  // PLATFORM_NODEBRIDGE_INCLUDE_NODEBRIDGE_H_
