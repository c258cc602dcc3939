// The power-command stand-in's BPA MTMS answers.
#include "rackpower.h"

#include <gtest/gtest.h>

#include <string>

#include "platform_env.h"

namespace {

TEST(RackPower, BpaMtmsByVport) {
  struct Case {
    const char* name;
    unsigned long vport;
    int result;
    std::string text;  // what mtms holds afterwards
  };
  const std::string kBefore = "left by the previous call";
  const Case cases[] = {
      {"known", 1, 0, std::string("9458-100*02A1B2C", 16)},
      {"padded", 2, 0, std::string("94\0\0\0\0\0\0*7\0\0\0\0\0\0", 16)},
      {"empty values", 0, 0, std::string("\0\0\0\0\0\0\0\0*\0\0\0\0\0\0\0", 16)},
      {"highest port", 4294967295ul, 0, "ABCDEFGH*1234567"},
      {"first of two with one port", 7, 0, std::string("FIRST\0\0\0*1\0\0\0\0\0\0", 16)},
      {"unknown", 3, 1, kBefore},
      {"above 32 bits, low half known", 0x100000001ul, 1, kBefore},
      {"above 32 bits, all ones", ~0ul, 1, kBefore},
  };
  PlatformEnv env;
  env.writeConfig(R"({"bpas": [
      {"vport": 1, "tm": "9458-100", "se": "02A1B2C"},
      {"vport": 2, "tm": "94", "se": "7"},
      {"vport": 0, "tm": "", "se": ""},
      {"vport": 4294967295, "tm": "ABCDEFGH", "se": "1234567"},
      {"vport": 7, "tm": "FIRST", "se": "1"},
      {"vport": 7, "tm": "SECOND", "se": "2"}]})");
  RackPower rp;
  for (const Case& c : cases) {
    std::string text = kBefore;
    EXPECT_EQ(rp.getBpaMtms(c.vport, text), c.result) << c.name;
    EXPECT_EQ(text, c.text) << c.name;
  }
}

TEST(RackPower, MissingFileKnowsNoBpa) {
  PlatformEnv env;
  RackPower rp;
  std::string text = "unchanged";
  EXPECT_EQ(rp.getBpaMtms(1, text), 1);
  EXPECT_EQ(text, "unchanged");
}

}  // namespace
