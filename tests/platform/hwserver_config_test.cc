// How the two stand-ins take etc/hwserver.json: a bad file stops both constructors with a
// message naming the file and the faulty field; a good or missing file lets them answer.
#include <gtest/gtest.h>
#include <unistd.h>

#include <functional>
#include <stdexcept>
#include <string>

#include "nodebridge.h"
#include "platform_env.h"
#include "rackpower.h"

namespace {

// The message each constructor threw, or "(no throw)".
std::string constructorMessage(const std::function<void()>& construct) {
  try {
    construct();
  } catch (const std::runtime_error& e) {
    return e.what();
  }
  return "(no throw)";
}

std::string console(const std::string& members) { return R"({"consoles": [)" + members + "]}"; }
std::string bpa(const std::string& members) { return R"({"bpas": [)" + members + "]}"; }
const char kGoodConsole[] = R"({"ip": "10.0.0.5", "tm": "7042CR9", "se": "10ABCDE"})";

std::string manyVports(size_t n) {
  std::string list;
  for (size_t i = 0; i < n; ++i) list += (i ? "," : "") + std::to_string(i);
  return list;
}

std::string manyConsoles(size_t n) {
  std::string list;
  for (size_t i = 0; i < n; ++i) {
    list += std::string(i ? "," : "") + R"({"ip": "10.0.)" + std::to_string(i / 256) + "." +
            std::to_string(i % 256) + R"(", "tm": "", "se": ""})";
  }
  return console(list);
}

TEST(HwserverConfig, BadFilesStopBothConstructors) {
  struct Case {
    const char* name;
    std::string text;
    std::string expected;  // message after "<file>: "
  };
  const Case cases[] = {
      {"console tm too long",
       console(std::string(kGoodConsole) + R"(, {"ip": "10.0.0.6", "tm": "123456789", "se": ""})"),
       "consoles[1].tm: 9 characters, at most 8"},
      {"console se too long", console(R"({"ip": "10.0.0.5", "tm": "", "se": "12345678"})"),
       "consoles[0].se: 8 characters, at most 7"},
      {"tm counted in bytes", console(R"({"ip": "10.0.0.5", "tm": "ééééé", "se": ""})"),
       "consoles[0].tm: 10 characters, at most 8"},
      {"tm with NUL", console(R"({"ip": "10.0.0.5", "tm": "70\u000042", "se": ""})"),
       "consoles[0].tm: contains a control character"},
      {"se with newline", bpa(R"({"vport": 1, "tm": "", "se": "02A\n"})"),
       "bpas[0].se: contains a control character"},
      {"se with DEL", bpa(R"({"vport": 1, "tm": "", "se": "02A\u007f"})"),
       "bpas[0].se: contains a control character"},
      {"tm not a string", console(R"({"ip": "10.0.0.5", "tm": 7042, "se": ""})"),
       "consoles[0].tm: expected a string, found number"},
      {"bpa tm too long", bpa(R"({"vport": 1, "tm": "9458-1000", "se": ""})"),
       "bpas[0].tm: 9 characters, at most 8"},
      {"bpa se too long", bpa(R"({"vport": 1, "tm": "", "se": "02A1B2C3"})"),
       "bpas[0].se: 8 characters, at most 7"},
      {"vport above 32 bits", bpa(R"({"vport": 4294967296, "tm": "", "se": ""})"),
       "bpas[0].vport: 4294967296 is not a whole number from 0 to 4294967295"},
      {"vport negative", bpa(R"({"vport": -1, "tm": "", "se": ""})"),
       "bpas[0].vport: -1 is not a whole number from 0 to 4294967295"},
      {"vport fraction", bpa(R"({"vport": 1.5, "tm": "", "se": ""})"),
       "bpas[0].vport: 1.5 is not a whole number from 0 to 4294967295"},
      {"vport as text", bpa(R"({"vport": "1", "tm": "", "se": ""})"),
       "bpas[0].vport: expected a number, found string"},
      {"bpa without vport", bpa(R"({"tm": "", "se": ""})"), "bpas[0]: missing key \"vport\""},
      {"bpa_vports entry",
       console(R"({"ip": "1.2.3.4", "tm": "", "se": "", "bpa_vports": [1, -2]})"),
       "consoles[0].bpa_vports[1]: -2 is not a whole number from 0 to 4294967295"},
      {"bpa_vports not an array",
       console(R"({"ip": "1.2.3.4", "tm": "", "se": "", "bpa_vports": 1})"),
       "consoles[0].bpa_vports: expected an array, found number"},
      {"bpa_vports beyond a reply",
       console(R"({"ip": "1.2.3.4", "tm": "", "se": "", "bpa_vports": [)" + manyVports(16384) +
               "]}"),
       "consoles[0].bpa_vports: 16384 entries, at most 16383"},
      {"ip three octets", console(R"({"ip": "10.0.0", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10.0.0\" is not a dotted quad of four decimal octets 0-255"},
      {"ip five octets", console(R"({"ip": "10.0.0.5.1", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10.0.0.5.1\" is not a dotted quad of four decimal octets 0-255"},
      {"ip octet 256", console(R"({"ip": "10.0.0.256", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10.0.0.256\" is not a dotted quad of four decimal octets 0-255"},
      {"ip four digits", console(R"({"ip": "1000.0.0.1", "tm": "", "se": ""})"),
       "consoles[0].ip: \"1000.0.0.1\" is not a dotted quad of four decimal octets 0-255"},
      {"ip leading zero", console(R"({"ip": "010.0.0.5", "tm": "", "se": ""})"),
       "consoles[0].ip: \"010.0.0.5\" is not a dotted quad of four decimal octets 0-255"},
      {"ip empty octet", console(R"({"ip": "10..0.5", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10..0.5\" is not a dotted quad of four decimal octets 0-255"},
      {"ip sign", console(R"({"ip": "10.0.0.+5", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10.0.0.+5\" is not a dotted quad of four decimal octets 0-255"},
      {"ip trailing blank", console(R"({"ip": "10.0.0.5 ", "tm": "", "se": ""})"),
       "consoles[0].ip: \"10.0.0.5 \" is not a dotted quad of four decimal octets 0-255"},
      {"ip as number", console(R"({"ip": 167772165, "tm": "", "se": ""})"),
       "consoles[0].ip: expected a string, found number"},
      {"console without ip", console(R"({"tm": "", "se": ""})"), "consoles[0]: missing key \"ip\""},
      {"console without se", console(R"({"ip": "10.0.0.5", "tm": ""})"),
       "consoles[0]: missing key \"se\""},
      {"misspelt key", console(R"({"ip": "1.2.3.4", "tm": "", "se": "", "bpa_vport": [1]})"),
       "consoles[0]: unknown key \"bpa_vport\""},
      {"consoles beyond a reply", manyConsoles(16384), "consoles: 16384 entries, at most 16383"},
      {"console not an object", console("[]"), "consoles[0]: expected an object, found array"},
      {"consoles null", R"({"consoles": null})", "consoles: expected an array, found null"},
      {"bpas an object", R"({"bpas": {}})", "bpas: expected an array, found object"},
      {"unknown top-level key", R"({"console": []})", "unknown key \"console\""},
      {"top level an array", "[]", "expected an object, found array"},
  };
  for (const Case& c : cases) {
    PlatformEnv env;
    env.writeConfig(c.text);
    std::string expected = env.configPath() + ": " + c.expected;
    EXPECT_EQ(constructorMessage([] { NodeBridge nb; }), expected) << c.name;
    EXPECT_EQ(constructorMessage([] { RackPower rp; }), expected) << c.name;
  }
}

TEST(HwserverConfig, UnreadableFilesStopBothConstructors) {
  struct Case {
    const char* name;
    std::function<void(const PlatformEnv&)> make;
    std::string expected_start;  // message after "<file>: "
  };
  const Case cases[] = {
      {"empty file", [](const PlatformEnv& e) { e.writeConfig(""); }, "not valid JSON: "},
      {"cut short", [](const PlatformEnv& e) { e.writeConfig(R"({"consoles": [)"); },
       "not valid JSON: "},
      {"trailing garbage", [](const PlatformEnv& e) { e.writeConfig("{} x"); }, "not valid JSON: "},
      {"directory", [](const PlatformEnv& e) { testsupport::makeDirs(e.configPath()); },
       "not a regular file"},
      {"symlink loop",
       [](const PlatformEnv& e) {
         ASSERT_EQ(symlink(e.configPath().c_str(), e.configPath().c_str()), 0);
       },
       "cannot open: "},
  };
  for (const Case& c : cases) {
    PlatformEnv env;
    c.make(env);
    std::string expected = env.configPath() + ": " + c.expected_start;
    std::string nb = constructorMessage([] { NodeBridge nb; });
    std::string rp = constructorMessage([] { RackPower rp; });
    EXPECT_EQ(nb.rfind(expected, 0), 0u) << c.name << ": " << nb;
    EXPECT_EQ(rp.rfind(expected, 0), 0u) << c.name << ": " << rp;
  }
}

TEST(HwserverConfig, GoodFilesAndMissingFileAreAccepted) {
  struct Case {
    const char* name;
    bool present;
    std::string text;
    unsigned short console_list_length;
  };
  const Case cases[] = {
      {"missing file", false, "", 0},
      {"empty object", true, "{}", 0},
      {"empty arrays", true, R"({"consoles": [], "bpas": []})", 0},
      {"values at their limits", true,
       R"({"consoles": [{"ip": "255.255.255.255", "tm": "12345678", "se": "1234567",
                         "bpa_vports": [0, 4294967295]},
                        {"ip": "0.0.0.0", "tm": "", "se": ""}],
           "bpas": [{"vport": 4294967295, "tm": "12345678", "se": "1234567"}]})",
       8},
      {"full reply of consoles", true, manyConsoles(16383), 65532},
  };
  for (const Case& c : cases) {
    PlatformEnv env;
    if (c.present) env.writeConfig(c.text);
    int rc = -1;
    NodeBridge nb;
    nb.fetchReply(&rc, 0x26, 0x27, 0x28, nullptr, 0);
    EXPECT_EQ(rc, 0) << c.name;
    EXPECT_EQ(nb.getPayloadLength(), c.console_list_length) << c.name;
    EXPECT_NO_THROW(RackPower()) << c.name;
  }
}

}  // namespace
