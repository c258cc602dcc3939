// Writes the seed corpora of the fuzz targets into CORPUS_DIR/<target>/ from the sample
// installation: small, valid examples of every input, plus a few near misses; with
// EXAMPLES_DIR also from the example installation's files (examples/ of the source tree).
//   fuzz_make_seeds CORPUS_DIR [EXAMPLES_DIR]
#include <sys/stat.h>

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "inventory_schema.h"
#include "sample_installation.h"

namespace {

std::string corpus;

void put(const std::string& target, const std::string& name, const std::string& bytes) {
  std::string dir = corpus + "/" + target;
  mkdir(dir.c_str(), 0755);
  std::string path = dir + "/" + name;
  FILE* f = std::fopen(path.c_str(), "wb");
  if (f == nullptr || std::fwrite(bytes.data(), 1, bytes.size(), f) != bytes.size()) {
    std::perror(path.c_str());
    std::exit(1);
  }
  std::fclose(f);
}

std::string u32(uint32_t v) {
  std::string s(4, '\0');
  for (int i = 0; i < 4; ++i) s[i] = static_cast<char>(v >> (8 * i));
  return s;
}

// The input of fuzz_tables: header, then the chassis, BPA and SMA bytes.
std::string tablesInput(uint8_t flags, const std::string& chassis, const std::string& bpa,
                        const std::string& sma, uint32_t frame, uint32_t cage, uint32_t adapter,
                        uint32_t network, const mtms& key, uint8_t pick) {
  std::string s(1, static_cast<char>(flags));
  s += u32(static_cast<uint32_t>(chassis.size())) + u32(static_cast<uint32_t>(bpa.size()));
  s += u32(frame) + u32(cage) + u32(adapter) + u32(network);
  s.append(reinterpret_cast<const char*>(&key), sizeof key);
  s += static_cast<char>(pick);
  return s + chassis + bpa + sma;
}

void tableSeeds() {
  std::string chassis = sample::tableBytes(sample::chassisRecords());
  std::string bpa = sample::tableBytes(sample::bpaRecords());
  std::string sma = sample::tableBytes(sample::smaRecords());
  put("tables", "sample",
      tablesInput(0x40, chassis, bpa, sma, 1, 1, 1, 1, mtms("7045-SW4", "20SWT02"), 1));
  put("tables", "sample-cec",
      tablesInput(0x40, chassis, bpa, sma, 2, 0, 2, 2, mtms("9458-100", "02A9B9C"), 4));
  put("tables", "one-each",
      tablesInput(0x40, chassis.substr(0, sizeof(chassisVPD)), bpa.substr(0, sizeof(bpaVPD)),
                  sma.substr(0, sizeof(smaVPD)), 1, 255, 1, 1, mtms("9458-100", "02A1B2C"), 0));
  // Each table cut inside its last record.
  put("tables", "partial",
      tablesInput(0, chassis.substr(0, chassis.size() - 100), bpa.substr(0, bpa.size() - 7),
                  sma.substr(0, sma.size() - 1), 3, 1, 1, 2, mtms(), 2));
  put("tables", "empty", tablesInput(0, "", "", "", 0, 0, 0, 0, mtms(), 0));
  put("tables", "missing-sma", tablesInput(0x84, chassis, bpa, "", 1, 1, 1, 1, mtms(), 0));
}

std::string chiplistInput(uint32_t network, uint8_t piece, const std::string& text) {
  return u32(network) + static_cast<char>(piece) + text;
}

void chiplistSeeds() {
  put("chiplist", "sample-net1", chiplistInput(1, 0, sample::rackprobeDump()));
  put("chiplist", "sample-net2", chiplistInput(2, 5, sample::rackprobeDump()));
  put("chiplist", "spacing",
      chiplistInput(1, 3,
                    "  4   2  SW_CHIPX 0 1   01\n5\t2 SW_CHIP 0 1 1\n6 2 sw_chip 0 1 1\n"
                    "7 2 SW_CHIP 0 1 1x extra fields\n\n header line\n"));
  put("chiplist", "numbers",
      chiplistInput(static_cast<uint32_t>(-1), 1,
                    "+8 -3 SW_CHIP a b -1\n99999999999999999999 2 SW_CHIP 0 1 -1\n9 9 SW_CHIP"));
}

void hwserverSeeds() {
  put("hwserver", "sample", sample::hwserverJson());
  put("hwserver", "no-consoles", "{}\n");
  put("hwserver", "two-consoles",
      R"({"consoles": [{"ip": "10.0.0.5", "tm": "7042CR9", "se": "10ABCDE", "bpa_vports": [1, 4294967295]},
 {"ip": "192.168.1.200", "tm": "", "se": "1"}, {"ip": "10.0.0.5", "tm": "X", "se": "Y", "bpa_vports": []}],
 "bpas": [{"vport": 4294967295, "tm": "12345678", "se": "1234567"}]}
)");
  put("hwserver", "too-long-tm",
      R"({"consoles": [{"ip": "1.2.3.4", "tm": "123456789", "se": "1"}]})");
  put("hwserver", "missing", "");
}

void inventorySeeds() {
  vpdload::Inventory inv;
  inv.chassis = sample::chassisRecords();
  inv.bpa = sample::bpaRecords();
  inv.sma = sample::smaRecords();
  put("inventory", "sample", vpdload::formatJson(vpdload::inventoryToJson(inv)));
  put("inventory", "small", R"({"sma": [{"loc": {"frame": 2, "cage": 0, "chip": 1, "type": "SMA"},
  "fru": {"pn": "21P4567", "sn": {"hex": "59ff"}}, "cec": {"tm": "7040-681", "se": "10CEC01"},
  "neighbor": {"frame": 1, "cage": 1, "type": 5}, "timestamp": "now"}],
 "chassis": [{"loc": {"frame": 1, "cage": 1, "network": 7}, "risers": [{"slot": 15, "port1": -2147483648}]}],
 "bpa": [{"loc": {"frame": 4095, "cage": 255, "plane": 1}, "bpr1": [{}, {"pn": "x"}]}]}
)");
  put("inventory", "twice", R"({"bpa": [{"loc": {"frame": 1}}, {"loc": {"frame": 1}}], "sma": 3})");
}

void argsSeeds() {
  for (const std::vector<std::string>& args : sample::requestArguments()) {
    std::string joined, name = "req";
    for (const std::string& a : args) {
      joined += a + '\0';
      if (a[0] != '-') name += "-" + a;
    }
    for (char& c : name) {
      if (c == '*' || c == '/') c = '_';
    }
    put("args", name, joined);
  }
  put("args", "help", std::string("--help") + '\0');
  put("args", "one-word", std::string("-yall") + '\0');
  put("args", "unknown-option", std::string("-x\0005\0-y\0all\0", 12));
  put("args", "missing-value", std::string("-y\0all\0-f\0", 10));
  put("args", "prefixes",
      std::string("-ycecabc\0-f\0 12x\0-c\0-0\0-r\0bpcx\0-h\0+1\0-p\0009\0", 42));
}

bool readFile(const std::string& path, std::string* text) {
  std::ifstream in(path, std::ios::binary);
  if (!in) return false;
  text->assign(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
  return true;
}

// The example installation: its configuration, its dump listing, its inventory and the
// tables that the inventory makes.
void exampleSeeds(const std::string& dir) {
  std::string text;
  if (readFile(dir + "/hwserver.json", &text)) put("hwserver", "example", text);
  if (readFile(dir + "/rackprobe.dump", &text)) {
    put("chiplist", "example-net1", chiplistInput(1, 0, text));
    put("chiplist", "example-net2", chiplistInput(2, 64, text));
  }
  if (!readFile(dir + "/installation.json", &text)) return;
  put("inventory", "example", text);
  vpdload::Inventory inv;
  if (!vpdload::parseInventory(text, &inv).empty()) {
    std::fprintf(stderr, "%s/installation.json is not a valid inventory\n", dir.c_str());
    std::exit(1);
  }
  const smaVPD& first_sma = inv.sma.empty() ? smaVPD() : inv.sma.front();
  put("tables", "example",
      tablesInput(0x40, sample::tableBytes(inv.chassis), sample::tableBytes(inv.bpa),
                  sample::tableBytes(inv.sma), first_sma.loc_id.getFrame(),
                  first_sma.loc_id.getCage(), 1, 1, first_sma.cec_mtms, 5));
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2 && argc != 3) {
    std::fprintf(stderr, "usage: %s CORPUS_DIR [EXAMPLES_DIR]\n", argv[0]);
    return 2;
  }
  corpus = argv[1];
  mkdir(corpus.c_str(), 0755);
  tableSeeds();
  chiplistSeeds();
  hwserverSeeds();
  inventorySeeds();
  argsSeeds();
  if (argc == 3) exampleSeeds(argv[2]);
  return 0;
}
