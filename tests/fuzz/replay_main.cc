// Runs a fuzz target's entry point over files, without libFuzzer: each argument is a file or
// a folder whose files (not its subfolders) are replayed in name order. CTest uses it to run
// the committed corpora in every build. A folder without files is an error, so that a lost
// corpus cannot pass as a replayed one.
#include <dirent.h>
#include <sys/stat.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);
extern "C" __attribute__((weak)) int LLVMFuzzerInitialize(int* argc, char*** argv);

namespace {

bool isDir(const std::string& path) {
  struct stat st;
  return stat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

bool filesOf(const std::string& dir, std::vector<std::string>* out) {
  DIR* d = opendir(dir.c_str());
  if (d == nullptr) return false;
  std::vector<std::string> found;
  while (dirent* e = readdir(d)) {
    std::string path = dir + "/" + e->d_name;
    if (e->d_name[0] != '.' && !isDir(path)) found.push_back(path);
  }
  closedir(d);
  std::sort(found.begin(), found.end());
  out->insert(out->end(), found.begin(), found.end());
  return !found.empty();
}

}  // namespace

int main(int argc, char** argv) {
  if (LLVMFuzzerInitialize != nullptr) LLVMFuzzerInitialize(&argc, &argv);
  std::vector<std::string> inputs;
  for (int i = 1; i < argc; ++i) {
    std::string arg = argv[i];
    if (!isDir(arg)) {
      inputs.push_back(arg);
    } else if (!filesOf(arg, &inputs)) {
      std::fprintf(stderr, "replay: no inputs in %s\n", arg.c_str());
      return 1;
    }
  }
  if (inputs.empty()) {
    std::fprintf(stderr, "usage: %s FILE_OR_FOLDER...\n", argv[0]);
    return 1;
  }
  for (const std::string& path : inputs) {
    std::ifstream in(path, std::ios::binary);
    if (!in) {
      std::fprintf(stderr, "replay: cannot read %s\n", path.c_str());
      return 1;
    }
    std::vector<char> bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    // A copy of exactly the input's size: reading one byte past it shows under the sanitizers.
    std::vector<uint8_t> data(bytes.begin(), bytes.end());
    LLVMFuzzerTestOneInput(data.data(), data.size());
  }
  std::fprintf(stderr, "replay: %zu inputs, none failed\n", inputs.size());
  return 0;
}
