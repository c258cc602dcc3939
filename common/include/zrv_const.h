// Constants shared with the console's other programs.
#ifndef COMMON_INCLUDE_ZRV_CONST_H_
#define COMMON_INCLUDE_ZRV_CONST_H_

// Install root of the console's programs; the environment variable below replaces it.
#define ZRV_DEFAULT_ROOT "/opt/olv"
#define ZRV_ROOT_ENV "OLV_ROOT"

// Paths below the install root.
#define ZRV_DATA_DIR "data"
#define ZRV_CHASSIS_TABLE "chassis_vpd.db"
#define ZRV_BPA_TABLE "bpa_vpd.db"
#define ZRV_SMA_TABLE "sma_vpd.db"
#define ZRV_OLD_SUFFIX ".old"
#define ZRV_RACKPROBE "bin/rackprobe"
#define ZRV_HWSERVER_CONFIG "etc/hwserver.json"

// Identifier of every trace record of the VPD database.
#define ZRV_VPD_COMPONENT "ZRV_VPD"

// Trace detail levels.
constexpr unsigned int ZRV_TRACE_INFO = 1;
constexpr unsigned int ZRV_TRACE_ERROR = 64;

#endif  // COMMON_INCLUDE_ZRV_CONST_H_
