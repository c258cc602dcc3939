// A small installation that the fuzz seeds, the argument-vector target and the corrupt-table
// tests share: three switch chassis cabled to each other and to SMA adapters, the BPAs of
// two frames, the SMA adapters of three CECs, one console and a matching dump listing.
#ifndef TESTS_FUZZ_SAMPLE_INSTALLATION_H_
#define TESTS_FUZZ_SAMPLE_INSTALLATION_H_

#include <string>
#include <vector>

#include "vpdDB.h"

namespace sample {

std::vector<chassisVPD> chassisRecords();
std::vector<bpaVPD> bpaRecords();
std::vector<smaVPD> smaRecords();

// The bytes of a table file holding exactly these records.
template <class Record>
std::string tableBytes(const std::vector<Record>& records) {
  return std::string(reinterpret_cast<const char*>(records.data()),
                     records.size() * sizeof(Record));
}

// etc/hwserver.json naming one console that reaches the BPAs of both frames.
std::string hwserverJson();
// What bin/rackprobe dump -d prints for the switch chips of the chassis.
std::string rackprobeDump();

// One argument vector per request form and branch that the installation answers (without
// the program name).
std::vector<std::vector<std::string>> requestArguments();

}  // namespace sample

#endif  // TESTS_FUZZ_SAMPLE_INSTALLATION_H_
