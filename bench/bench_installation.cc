#include "bench_installation.h"

#include <sys/stat.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <memory>
#include <vector>

#include "installation_writer.h"
#include "zrv_const.h"

namespace benchgen {
namespace {

struct Generated {
  std::string root;
  gen::Layout layout;
};

std::map<unsigned int, std::unique_ptr<Generated>>& generated() {
  static std::map<unsigned int, std::unique_ptr<Generated>> all;
  return all;
}

std::vector<std::string>& createdDirs() {
  static std::vector<std::string> dirs;
  return dirs;
}

[[noreturn]] void die(const std::string& why) {
  std::fprintf(stderr, "dorvex_bench: %s\n", why.c_str());
  removeAll();
  std::exit(1);
}

const Generated& generatedAt(unsigned int scale) {
  auto& all = generated();
  auto it = all.find(scale);
  if (it != all.end()) return *it->second;
  gen::Params p = gen::Params::scaled(scale);
  std::string problem = gen::checkParams(p);
  if (!problem.empty()) die("scale " + std::to_string(scale) + ": " + problem);
  auto g = std::make_unique<Generated>(Generated{scratchDir(), gen::Layout(p)});
  std::string error = gen::writeInstallation(g->root, g->layout, nullptr);
  if (!error.empty()) die(error);
  return *all.emplace(scale, std::move(g)).first->second;
}

}  // namespace

const std::string& rootAt(unsigned int scale) { return generatedAt(scale).root; }

std::string dataDirAt(unsigned int scale) { return rootAt(scale) + "/" ZRV_DATA_DIR; }

const gen::Layout& layoutAt(unsigned int scale) { return generatedAt(scale).layout; }

uint64_t tableBytesAt(unsigned int scale, const std::string& file) {
  if (file.empty()) {
    return tableBytesAt(scale, ZRV_CHASSIS_TABLE) + tableBytesAt(scale, ZRV_BPA_TABLE) +
           tableBytesAt(scale, ZRV_SMA_TABLE);
  }
  struct stat st;
  std::string path = dataDirAt(scale) + "/" + file;
  if (::stat(path.c_str(), &st) != 0) die("cannot stat " + path);
  return static_cast<uint64_t>(st.st_size);
}

std::string scratchDir() {
  const char* tmp = std::getenv("TMPDIR");
  std::string pattern =
      std::string(tmp != nullptr && *tmp != '\0' ? tmp : "/tmp") + "/dorvex_bench.XXXXXX";
  std::vector<char> name(pattern.begin(), pattern.end());
  name.push_back('\0');
  if (::mkdtemp(name.data()) == nullptr) die("cannot create a folder like " + pattern);
  createdDirs().emplace_back(name.data());
  return createdDirs().back();
}

void removeAll() {
  std::error_code ignored;
  for (const std::string& dir : createdDirs()) std::filesystem::remove_all(dir, ignored);
  createdDirs().clear();
  generated().clear();
}

}  // namespace benchgen
