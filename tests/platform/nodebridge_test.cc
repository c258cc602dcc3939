// The hardware-server stand-in's replies, byte for byte.
#include "nodebridge.h"

#include <gtest/gtest.h>

#include <string>

#include "platform_env.h"

namespace {

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__,
              "the expected virtual port bytes below are written for a little-endian host");

const char kConfig[] = R"({
  "consoles": [
    { "ip": "10.0.0.5", "tm": "7042CR9", "se": "10ABCDE", "bpa_vports": [1, 16909060] },
    { "ip": "192.168.1.2", "tm": "AB", "se": "", "bpa_vports": [] },
    { "ip": "10.0.0.6", "tm": "12345678", "se": "1234567", "bpa_vports": [4294967295] },
    { "ip": "10.0.0.5", "tm": "SHADOWED", "se": "NOTSEEN", "bpa_vports": [9] }
  ],
  "bpas": [ { "vport": 1, "tm": "9458-100", "se": "02A1B2C" } ]
})";

// What the caller sees of one reply: rc, the bytes, and whether the pointer was null.
struct Reply {
  int rc;
  std::string bytes;
  bool null_pointer;
};

Reply ask(NodeBridge& nb, unsigned char c1, unsigned char c2, unsigned char c3,
          const std::string* payload) {
  Reply r{-1, "", false};
  std::string copy = payload != nullptr ? *payload : "";
  unsigned char* p = payload != nullptr ? reinterpret_cast<unsigned char*>(&copy[0]) : nullptr;
  unsigned char* reply =
      nb.fetchReply(&r.rc, c1, c2, c3, p, static_cast<unsigned short>(copy.size()));
  r.null_pointer = reply == nullptr;
  if (reply != nullptr) r.bytes.assign(reinterpret_cast<char*>(reply), nb.getPayloadLength());
  return r;
}

TEST(NodeBridge, RepliesByteForByte) {
  struct Case {
    const char* name;
    unsigned char c1, c2, c3;
    const char* payload;  // null: no payload at all
    size_t payload_size;
    int rc;
    std::string reply;
  };
  const std::string kConsoles("\x0a\x00\x00\x05\xc0\xa8\x01\x02\x0a\x00\x00\x06\x0a\x00\x00\x05",
                              16);
  const Case cases[] = {
      {"console list in file order", 0x26, 0x27, 0x28, nullptr, 0, 0, kConsoles},
      {"console list ignores a payload", 0x26, 0x27, 0x28, "\x0a\x00\x00\x05", 4, 0, kConsoles},
      {"bpa list in host order", 0x2c, 0x2d, 0x2e, "\x0a\x00\x00\x05", 4, 0,
       std::string("\x01\x00\x00\x00\x04\x03\x02\x01", 8)},
      {"bpa list of the highest port", 0x2c, 0x2d, 0x2e, "\x0a\x00\x00\x06", 4, 0,
       "\xff\xff\xff\xff"},
      {"bpa list empty", 0x2c, 0x2d, 0x2e, "\xc0\xa8\x01\x02", 4, 0, ""},
      {"bpa list unknown ip", 0x2c, 0x2d, 0x2e, "\x0a\x00\x00\x07", 4, 0, ""},
      {"bpa list octets reversed", 0x2c, 0x2d, 0x2e, "\x05\x00\x00\x0a", 4, 0, ""},
      {"bpa list reads 4 bytes only", 0x2c, 0x2d, 0x2e, "\x0a\x00\x00\x06\x99", 5, 0,
       "\xff\xff\xff\xff"},
      {"bpa list short payload", 0x2c, 0x2d, 0x2e, "\x0a\x00\x00", 3, 1, ""},
      {"bpa list no payload", 0x2c, 0x2d, 0x2e, nullptr, 0, 1, ""},
      {"mtms image", 0x2f, 0x30, 0x31, "\x0a\x00\x00\x05", 4, 0,
       std::string("7042CR9\0*10ABCDE", 16)},
      {"mtms padded with NUL", 0x2f, 0x30, 0x31, "\xc0\xa8\x01\x02", 4, 0,
       std::string("AB\0\0\0\0\0\0*\0\0\0\0\0\0\0", 16)},
      {"mtms at full width", 0x2f, 0x30, 0x31, "\x0a\x00\x00\x06", 4, 0, "12345678*1234567"},
      {"mtms unknown ip", 0x2f, 0x30, 0x31, "\x0b\x00\x00\x05", 4, 0, ""},
      {"mtms short payload", 0x2f, 0x30, 0x31, "\x0a", 1, 1, ""},
      {"unknown third code", 0x26, 0x27, 0x29, nullptr, 0, 1, ""},
      {"codes reversed", 0x28, 0x27, 0x26, nullptr, 0, 1, ""},
      {"codes of two queries mixed", 0x2c, 0x30, 0x31, "\x0a\x00\x00\x05", 4, 1, ""},
  };
  PlatformEnv env;
  env.writeConfig(kConfig);
  NodeBridge nb;
  for (const Case& c : cases) {
    std::string payload(c.payload != nullptr ? c.payload : "", c.payload_size);
    Reply r = ask(nb, c.c1, c.c2, c.c3, c.payload != nullptr ? &payload : nullptr);
    EXPECT_EQ(r.rc, c.rc) << c.name;
    EXPECT_EQ(r.bytes, c.reply) << c.name;
    EXPECT_EQ(nb.getPayloadLength(), c.reply.size()) << c.name;
    EXPECT_EQ(r.null_pointer, c.reply.empty()) << c.name;
  }
}

TEST(NodeBridge, EmptyReplyAfterFullOneHasNoLength) {
  PlatformEnv env;
  env.writeConfig(kConfig);
  NodeBridge nb;
  const std::string ip("\x0a\x00\x00\x05", 4);
  Reply full = ask(nb, 0x2f, 0x30, 0x31, &ip);
  ASSERT_EQ(full.bytes.size(), 16u);
  const std::string unknown("\x0a\x00\x00\x09", 4);
  Reply empty = ask(nb, 0x2f, 0x30, 0x31, &unknown);
  EXPECT_TRUE(empty.null_pointer);
  EXPECT_EQ(nb.getPayloadLength(), 0u);
}

TEST(NodeBridge, MissingFileGivesEmptyReplies) {
  PlatformEnv env;
  NodeBridge nb;
  const std::string ip("\x0a\x00\x00\x05", 4);
  const unsigned char queries[][3] = {{0x26, 0x27, 0x28}, {0x2c, 0x2d, 0x2e}, {0x2f, 0x30, 0x31}};
  for (const auto& q : queries) {
    Reply r = ask(nb, q[0], q[1], q[2], &ip);
    EXPECT_EQ(r.rc, 0) << int(q[0]);
    EXPECT_TRUE(r.null_pointer) << int(q[0]);
    EXPECT_EQ(nb.getPayloadLength(), 0u) << int(q[0]);
  }
}

TEST(NodeBridge, ConfigurationIsReadOncePerObject) {
  PlatformEnv env;
  env.writeConfig(kConfig);
  NodeBridge nb;
  env.writeConfig("{}");
  Reply r = ask(nb, 0x26, 0x27, 0x28, nullptr);
  EXPECT_EQ(r.bytes.size(), 16u);
  NodeBridge later;
  EXPECT_TRUE(ask(later, 0x26, 0x27, 0x28, nullptr).bytes.empty());
}

}  // namespace
