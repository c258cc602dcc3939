#include "table_desc.h"

#include <cstddef>

#include "locid.h"
#include "vpd_records.h"
#include "zrv_const.h"

namespace vpd {
namespace {

constexpr uint32_t fieldMask(unsigned shift, unsigned width) {
  return ((uint32_t{1} << width) - 1) << shift;
}

// Chassis and BPA records are keyed by frame and cage; SMA records also by chip.
constexpr uint32_t kFrameCageMask = fieldMask(loc_id_t::kFrameShift, loc_id_t::kFrameWidth) |
                                    fieldMask(loc_id_t::kUidShift, loc_id_t::kUidWidth);
constexpr uint32_t kFrameCageChipMask =
    kFrameCageMask | fieldMask(loc_id_t::kChipShift, loc_id_t::kChipWidth);

}  // namespace

const TableDesc kChassisTable = {CHASSIS_TABLE,
                                 ZRV_CHASSIS_TABLE,
                                 "chassisTbl",
                                 chassisVPD::kRecordSize,
                                 kFrameCageMask,
                                 offsetof(chassisVPD, sw_mtms),
                                 "Failed to open the chassisTbl",
                                 "Failed to read the chassisTbl",
                                 "Failed to write to the chassisTbl",
                                 "show chassis table:",
                                 "The switch chassis table is empty "};

const TableDesc kBpaTable = {BPA_TABLE,
                             ZRV_BPA_TABLE,
                             "bpaTbl",
                             bpaVPD::kRecordSize,
                             kFrameCageMask,
                             offsetof(bpaVPD, frame_mtms),
                             "Failed to open the bpaTbl",
                             "Failed to read the bpaTbl",
                             "Failed to write to the bpaTbl",
                             "show BPA table:",
                             "The bpa table is empty "};

const TableDesc kSmaTable = {SMA_TABLE,
                             ZRV_SMA_TABLE,
                             "smaTbl",
                             smaVPD::kRecordSize,
                             kFrameCageChipMask,
                             offsetof(smaVPD, cec_mtms),
                             "Failed to open the smaTbl",
                             "Failed to read the smaTbl",
                             "Failed to write to the smaTbl",
                             "show SMA table:",
                             "The sma table is empty "};

const TableDesc* tableForDeviceType(unsigned int type) {
  switch (type) {
    case SMA:
      return &kSmaTable;
    case BPA:
      return &kBpaTable;
    case CHASSIS:
      return &kChassisTable;
    default:
      return nullptr;
  }
}

}  // namespace vpd
