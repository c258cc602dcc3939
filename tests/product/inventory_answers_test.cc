// Every FRU and enclosure that the example inventory describes, asked of dorvex one by one:
// the answer must be what the inventory says, which checks the import and the lookups
// together without relying on any recorded output.
#include <gtest/gtest.h>

#include <algorithm>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "example_root.h"
#include "test_support.h"

namespace producttest {
namespace {

using nlohmann::json;

struct Question {
  std::vector<std::string> args;
  std::string answer;  // the whole expected standard output
};

std::string text(const json& object, const char* key) {
  return object.contains(key) ? object[key].get<std::string>() : std::string();
}

std::string number(const json& loc, const char* key) {
  return std::to_string(loc.contains(key) ? loc[key].get<int>() : 0);
}

std::string mtmsText(const json& mtms) { return text(mtms, "tm") + "*" + text(mtms, "se"); }

std::string fruLine(const json& mtms, const json& fru) {
  return mtmsText(mtms) + " " + text(fru, "pn") + " " + text(fru, "sn") + " " + text(fru, "cc") +
         "\n";
}

// The questions a console admin could ask about the inventory, each with its answer.
std::vector<Question> questionsFor(const json& inv) {
  std::vector<Question> qs;
  for (const json& c : inv["chassis"]) {
    std::string f = number(c["loc"], "frame"), cg = number(c["loc"], "cage");
    const json& m = c["mtms"];
    qs.push_back({{"-y", "switch", "-f", f, "-c", cg, "-r", "planar"}, fruLine(m, c["fru"])});
    qs.push_back(
        {{"-y", "switch", "-f", f, "-c", cg, "-r", "dca", "-h", "1"}, fruLine(m, c["dca1"])});
    qs.push_back(
        {{"-y", "switch", "-f", f, "-c", cg, "-r", "dca", "-h", "2"}, fruLine(m, c["dca2"])});
    for (const json& r : c["risers"]) {
      std::string slot = std::to_string(r["slot"].get<int>());
      qs.push_back(
          {{"-y", "switch", "-f", f, "-c", cg, "-r", "riser", "-h", slot}, fruLine(m, r["fru"])});
    }
    std::string enclosure = f + " " + cg + " " + mtmsText(m) + "\n";
    qs.push_back({{"-y", "switch", "-f", f, "-c", cg}, enclosure});
    qs.push_back({{"-y", "switch", "-m", mtmsText(m)}, enclosure});
  }
  for (const json& b : inv["bpa"]) {
    std::string f = number(b["loc"], "frame"), cg = number(b["loc"], "cage");
    const json& m = b["mtms"];
    for (const char* side : {"1", "2"}) {
      std::string s = side;
      qs.push_back(
          {{"-y", "bpa", "-f", f, "-c", cg, "-r", "bpc", "-a", s}, fruLine(m, b["bpc" + s])});
      for (const char* kind : {"bpr", "bpd"}) {
        for (int i = 0; i < 3; ++i) {
          qs.push_back(
              {{"-y", "bpa", "-f", f, "-c", cg, "-r", kind, "-a", s, "-h", std::to_string(i)},
               fruLine(m, b[kind + s][i])});
        }
      }
    }
    std::string enclosure = f + " " + cg + " " + mtmsText(m) + "\n";
    qs.push_back({{"-y", "bpa", "-f", f, "-c", cg}, enclosure});
    qs.push_back({{"-y", "bpa", "-m", mtmsText(m)}, enclosure});
  }
  // The first SMA chip of each CEC adapter (chips 0, 1, 4, 5 and 2, 3, 6, 7) in table order.
  std::vector<std::string> asked;
  for (const json& s : inv["sma"]) {
    std::string f = number(s["loc"], "frame"), cg = number(s["loc"], "cage");
    int chip = s["loc"].value("chip", 0);
    std::string adapter = (chip & 2) ? "2" : "1";
    std::string key = f + "/" + cg + "/" + adapter;
    if (chip > 7 || std::find(asked.begin(), asked.end(), key) != asked.end()) continue;
    asked.push_back(key);
    qs.push_back({{"-y", "cec", "-f", f, "-c", cg, "-r", "adapter", "-h", adapter},
                  fruLine(s["cec"], s["fru"])});
  }
  return qs;
}

TEST(ExampleInventory, EveryFruAndEnclosureAnswersAsRecorded) {
  json inv = json::parse(testsupport::readFile(std::string(EXAMPLES_DIR) + "/installation.json"));
  std::vector<Question> qs = questionsFor(inv);
  // Four switch chassis with eight risers, two BPAs, four CECs with two adapters.
  ASSERT_EQ(qs.size(), 4u * (3 + 8 + 2) + 2u * (14 + 2) + 4u * 2);

  testsupport::TempDir root;
  ASSERT_EQ(installExample({VPDLOAD_BIN, EXAMPLES_DIR, RACKPROBE_BIN}, root.path()), "");
  for (const Question& q : qs) {
    std::vector<std::string> argv = {DORVEX_BIN};
    argv.insert(argv.end(), q.args.begin(), q.args.end());
    testsupport::RunResult r = testsupport::run(argv, rootEnv(root.path()));
    EXPECT_EQ(r.out, q.answer) << commandText(q.args);
    EXPECT_EQ(r.status, 0) << commandText(q.args);
  }
}

}  // namespace
}  // namespace producttest
