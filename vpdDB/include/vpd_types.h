// Enumerations of the VPD database.
#ifndef VPDDB_INCLUDE_VPD_TYPES_H_
#define VPDDB_INCLUDE_VPD_TYPES_H_

// Device type held in loc_id_t::type. Values 8 to 15 fit the field but have no name.
enum dev_type_t {
  NSB = 0,
  SMA = 1,  // SMA chip: stored in the SMA table
  ISB = 2,
  BPA = 3,      // bulk power assembly: stored in the BPA table
  DCA = 4,      // power converter of a switch chassis
  CHASSIS = 5,  // switch chassis: stored in the chassis table
  BOARD = 6,
  RISER = 7,
};

// Names one of the three tables.
enum table_t {
  SMA_TABLE = 1,
  CHASSIS_TABLE = 2,
  BPA_TABLE = 3,
};

#endif  // VPDDB_INCLUDE_VPD_TYPES_H_
