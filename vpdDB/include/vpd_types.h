// Enumerations of the VPD database.
#ifndef VPDDB_INCLUDE_VPD_TYPES_H_
#define VPDDB_INCLUDE_VPD_TYPES_H_

// Device type held in loc_id_t::type. Values 8 to 15 fit the field but have no name (the
// fixed underlying type makes them valid values of the enumeration).
enum dev_type_t : int {
  NSB = 0,
  SMA = 1,  // SMA chip: stored in the SMA table
  ISB = 2,
  BPA = 3,      // bulk power assembly: stored in the BPA table
  DCA = 4,      // power converter of a switch chassis
  CHASSIS = 5,  // switch chassis: stored in the chassis table
  BOARD = 6,
  RISER = 7,
};

// Names one of the three tables. The fixed underlying type makes any int a valid value, so
// showVPD can be handed a number that names no table and say so.
enum table_t : int {
  SMA_TABLE = 1,
  CHASSIS_TABLE = 2,
  BPA_TABLE = 3,
};

#endif  // VPDDB_INCLUDE_VPD_TYPES_H_
