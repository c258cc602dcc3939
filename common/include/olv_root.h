// Where the console's programs and data live.
#ifndef COMMON_INCLUDE_OLV_ROOT_H_
#define COMMON_INCLUDE_OLV_ROOT_H_

#include <string>

namespace olv {

// The install root: $OLV_ROOT when set and not empty (ignored by set-id processes),
// otherwise /opt/olv. Never ends in a slash unless it is "/".
std::string installRoot();

// installRoot() joined with a relative path such as "data" or "bin/rackprobe".
std::string underRoot(const std::string& relative);

}  // namespace olv

#endif  // COMMON_INCLUDE_OLV_ROOT_H_
