#include "olv_root.h"

#include <cstdlib>

#include "zrv_const.h"

namespace olv {

std::string installRoot() {
  const char* env = secure_getenv(ZRV_ROOT_ENV);
  std::string root = (env != nullptr && *env != '\0') ? env : ZRV_DEFAULT_ROOT;
  while (root.size() > 1 && root.back() == '/') root.pop_back();
  return root;
}

std::string underRoot(const std::string& relative) {
  std::string root = installRoot();
  if (root.back() != '/') root += '/';
  return root + relative;
}

}  // namespace olv
