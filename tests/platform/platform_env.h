// A temporary install root for the stand-in libraries, set as OLV_ROOT for the life of
// the object and restored afterwards.
#ifndef TESTS_PLATFORM_PLATFORM_ENV_H_
#define TESTS_PLATFORM_PLATFORM_ENV_H_

#include <cstdlib>
#include <string>

#include "test_support.h"

class PlatformEnv {
 public:
  PlatformEnv() {
    testsupport::makeDirs(root_ / "etc");
    const char* old = std::getenv("OLV_ROOT");
    had_old_ = old != nullptr;
    if (had_old_) old_ = old;
    setenv("OLV_ROOT", root_.path().c_str(), 1);
  }
  ~PlatformEnv() {
    if (had_old_) {
      setenv("OLV_ROOT", old_.c_str(), 1);
    } else {
      unsetenv("OLV_ROOT");
    }
  }
  PlatformEnv(const PlatformEnv&) = delete;
  PlatformEnv& operator=(const PlatformEnv&) = delete;

  const std::string& root() const { return root_.path(); }
  std::string configPath() const { return root_ / "etc/hwserver.json"; }
  void writeConfig(const std::string& text) const { testsupport::writeFile(configPath(), text); }

 private:
  testsupport::TempDir root_;
  bool had_old_ = false;
  std::string old_;
};

#endif  // TESTS_PLATFORM_PLATFORM_ENV_H_
