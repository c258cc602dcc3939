// Result codes of the database operations.
#ifndef COMMON_INCLUDE_RETURN_CODES_H_
#define COMMON_INCLUDE_RETURN_CODES_H_

// A lookup found what it was asked for.
constexpr int VPD_FOUND = 0;
// A lookup met an empty table or found nothing.
constexpr int VPD_NOT_FOUND = 4;
// A file status could not be read, or a record could not be written.
constexpr int VPD_FAILED = -1;

// What the constructors throw when a table cannot be opened.
constexpr int VPD_OPEN_FAILED = 1;

// What console discovery throws when a platform client cannot be created.
constexpr int ZEV_NO_NODEBRIDGE = 3548;
constexpr int ZEV_NO_RACKPOWER = 3549;

#endif  // COMMON_INCLUDE_RETURN_CODES_H_
