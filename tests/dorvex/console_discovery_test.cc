// Console discovery against scripted hardware-server and power-command stand-ins.
#include "console_discovery.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "installation.h"

namespace dorvextest {
namespace {

using Bytes = std::vector<unsigned char>;
using dorvex::zev_info_t;

Bytes bytes(const std::string& s) { return Bytes(s.begin(), s.end()); }

std::string ipText(const unsigned char* ip) {
  return std::to_string(ip[0]) + "." + std::to_string(ip[1]) + "." + std::to_string(ip[2]) + "." +
         std::to_string(ip[3]);
}

// Replies by query ("list", "bpa <ip>", "mtms <ip>"); every call goes to the shared log.
// Each reply lives in fresh storage that the next call frees, so reading a reply after the
// next query is caught by the address sanitizer.
class ScriptedBridge {
 public:
  ScriptedBridge(std::map<std::string, Bytes> replies, std::vector<std::string>& log)
      : replies_(std::move(replies)), log_(log) {}
  unsigned char* fetchReply(int* rc, unsigned char c1, unsigned char c2, unsigned char c3,
                            unsigned char* payload, unsigned short length) {
    std::string key;
    if (c1 == 0x26 && c2 == 0x27 && c3 == 0x28 && payload == nullptr && length == 0) {
      key = "list";
    } else if (c1 == 0x2c && c2 == 0x2d && c3 == 0x2e && payload != nullptr && length == 4) {
      key = "bpa " + ipText(payload);
    } else if (c1 == 0x2f && c2 == 0x30 && c3 == 0x31 && payload != nullptr && length == 4) {
      key = "mtms " + ipText(payload);
    } else {
      key = "bad query";
    }
    log_.push_back(key);
    *rc = 0;
    reply_ = std::make_unique<Bytes>(replies_[key]);
    return reply_->empty() ? nullptr : reply_->data();
  }
  unsigned short getPayloadLength() { return static_cast<unsigned short>(reply_->size()); }

 private:
  std::map<std::string, Bytes> replies_;
  std::vector<std::string>& log_;
  std::unique_ptr<Bytes> reply_;
};

// MTMS texts by vport; an unknown vport fails and leaves the text alone.
class ScriptedPower {
 public:
  ScriptedPower(std::map<unsigned long, std::string> texts, std::vector<std::string>& log)
      : texts_(std::move(texts)), log_(log) {}
  int getBpaMtms(unsigned long vport, std::string& text) {
    log_.push_back("power " + std::to_string(vport));
    auto it = texts_.find(vport);
    if (it == texts_.end()) return 1;
    text = it->second;
    return 0;
  }

 private:
  std::map<unsigned long, std::string> texts_;
  std::vector<std::string>& log_;
};

// The significant bytes of both fields, NUL shown as '.'.
std::string fields(const mtms& m) {
  std::string s(m.tm, mtms::kTmChars);
  s += ' ';
  s.append(m.se, mtms::kSeChars);
  for (char& c : s) c = c == '\0' ? '.' : c;
  return s;
}

std::string describe(const std::vector<zev_info_t>& consoles) {
  std::string out;
  for (const zev_info_t& c : consoles) {
    out += ipText(c.ip) + " " + fields(c.zevmtms);
    for (const dorvex::bpa_info_t& b : c.bpa)
      out += " [" + std::to_string(b.vport) + " " + fields(b.bpamtms) + "]";
    out += "\n";
  }
  return out;
}

TEST(ConsoleDiscovery, RepliesOfAnyLength) {
  struct {
    const char* name;
    std::map<std::string, Bytes> replies;
    std::map<unsigned long, std::string> power;
    std::string consoles;
    std::vector<std::string> log;
  } cases[] = {
      {"ten-byte console list",
       {{"list", {10, 0, 0, 5, 10, 0, 0, 6, 99, 99}},
        {"bpa 10.0.0.5", {1, 0, 0, 0, 2, 0, 0, 0, 7}},
        {"mtms 10.0.0.5", bytes(std::string("7042CR\0\0X10ABCDE", 16))},
        {"mtms 10.0.0.6", bytes("70")}},
       {{1, "9458-100*02A1B2C"}, {2, "9458"}},
       "10.0.0.5 7042CR.. 10ABCDE [1 9458-100 02A1B2C] [2 9458.... .......]\n"
       "10.0.0.6 70...... .......\n",
       {"list", "bpa 10.0.0.5", "bpa 10.0.0.6", "mtms 10.0.0.5", "mtms 10.0.0.6", "power 1",
        "power 2"}},
      {"failing BPA MTMS stays empty",
       {{"list", {1, 2, 3, 4}}, {"bpa 1.2.3.4", {1, 0, 0, 0, 5, 0, 0, 0, 2, 0, 0, 0}}},
       {{1, "9458-100*02A1B2C"}, {2, "9458-100*02A9999"}},
       "1.2.3.4 ........ ....... [1 9458-100 02A1B2C] [5 ........ .......]"
       " [2 9458-100 02A9999]\n",
       {"list", "bpa 1.2.3.4", "mtms 1.2.3.4", "power 1", "power 5", "power 2"}},
      {"long images",
       {{"list", {1, 2, 3, 4}},
        {"bpa 1.2.3.4", {3, 0, 0, 0}},
        {"mtms 1.2.3.4", bytes("ABCDEFGHIJKLMNOPQRST")}},
       {{3, "abcdefgh*jklmnopqrs"}},
       "1.2.3.4 ABCDEFGH JKLMNOP [3 abcdefgh jklmnop]\n",
       {"list", "bpa 1.2.3.4", "mtms 1.2.3.4", "power 3"}},
      {"serial stops at its NUL",
       {{"list", {1, 2, 3, 4}},
        {"mtms 1.2.3.4", bytes(std::string("12345678*12\0"
                                           "4567",
                                           16))}},
       {},
       "1.2.3.4 12345678 12.....\n",
       {"list", "bpa 1.2.3.4", "mtms 1.2.3.4"}},
      {"vport in host byte order",
       {{"list", {1, 2, 3, 4}}, {"bpa 1.2.3.4", {0x01, 0x02, 0x03, 0x04}}},
       {},
       "1.2.3.4 ........ ....... [67305985 ........ .......]\n",
       {"list", "bpa 1.2.3.4", "mtms 1.2.3.4", "power 67305985"}},
      {"no consoles", {{"list", {1, 2, 3}}}, {}, "", {"list"}},
  };
  for (const auto& c : cases) {
    std::vector<std::string> log;
    ScriptedBridge bridge(c.replies, log);
    ScriptedPower power(c.power, log);
    std::vector<zev_info_t> consoles;
    EXPECT_EQ(dorvex::discoverConsoles(consoles, bridge, power), 0) << c.name;
    EXPECT_EQ(describe(consoles), c.consoles) << c.name;
    EXPECT_EQ(log, c.log) << c.name;
  }
}

TEST(ConsoleDiscovery, EarlierConsolesAreAskedAgain) {
  std::vector<std::string> log;
  ScriptedBridge bridge({{"list", {10, 0, 0, 6}}, {"bpa 10.0.0.5", {4, 0, 0, 0}}}, log);
  ScriptedPower power({{4, "9458-100*0000004"}}, log);
  std::vector<zev_info_t> consoles(1);
  const unsigned char old_ip[4] = {10, 0, 0, 5};
  std::copy(old_ip, old_ip + 4, consoles[0].ip);
  dorvex::discoverConsoles(consoles, bridge, power);
  EXPECT_EQ(describe(consoles),
            "10.0.0.5 ........ ....... [4 9458-100 0000004]\n10.0.0.6 ........ .......\n");
  EXPECT_EQ(log, (std::vector<std::string>{"list", "bpa 10.0.0.5", "bpa 10.0.0.6", "mtms 10.0.0.5",
                                           "mtms 10.0.0.6", "power 4"}));
}

TEST(ConsoleDiscovery, PlatformClients) {
  Installation inst;
  setenv("OLV_ROOT", inst.root().c_str(), 1);
  inst.setHwserver(R"({"consoles": [{"ip": "10.0.0.5", "tm": "7042CR4", "se": "10ABCDE",
                       "bpa_vports": [1, 9]}],
                       "bpas": [{"vport": 1, "tm": "9458-100", "se": "02A1B2C"}]})");
  dorvex::zev.clear();
  EXPECT_EQ(dorvex::getzevmtms(), 0);
  EXPECT_EQ(describe(dorvex::zev),
            "10.0.0.5 7042CR4. 10ABCDE [1 9458-100 02A1B2C] [9 ........ .......]\n");

  inst.setHwserver("{\"consoles\": [");
  int thrown = 0;
  try {
    dorvex::getzevmtms();
  } catch (int e) {
    thrown = e;
  }
  EXPECT_EQ(thrown, 3548);
  EXPECT_EQ(dorvex::zev.size(), 1u);  // nothing appended
  dorvex::zev.clear();
  unsetenv("OLV_ROOT");
}

}  // namespace
}  // namespace dorvextest
