// The bundled example installation under a temporary install root, as ./demo.sh sets it up.
#ifndef TESTS_PRODUCT_EXAMPLE_ROOT_H_
#define TESTS_PRODUCT_EXAMPLE_ROOT_H_

#include <map>
#include <string>
#include <vector>

#include "test_support.h"

namespace producttest {

// The SMA table's modification time after installExample, in seconds since the epoch, so
// that the change poll answers the same on every run.
constexpr long kPollTime = 1710403200;

// Where the programs and the example files come from.
struct Tools {
  std::string vpdload;    // the vpdload to import with
  std::string examples;   // folder holding installation.json, hwserver.json, rackprobe.dump
  std::string rackprobe;  // copied to bin/rackprobe; empty when the root already has one
};

// Imports installation.json into root/data with `tools.vpdload`, copies the stand-ins'
// files to root/etc and rackprobe to root/bin, and sets the SMA table's time to kPollTime.
// Returns what went wrong, or "" when the installation is in place.
std::string installExample(const Tools& tools, const std::string& root);

// The environment for running a program on `root`: OLV_ROOT, and traces to root/trace.log.
std::map<std::string, std::string> rootEnv(const std::string& root);

// The contents of a file of tests/product/golden/.
std::string golden(const std::string& name);

// "dorvex -y switch -f 1" style text of a command line, for failure messages.
std::string commandText(const std::vector<std::string>& args);

}  // namespace producttest

#endif  // TESTS_PRODUCT_EXAMPLE_ROOT_H_
