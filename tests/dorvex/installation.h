// A temporary install root for running the built dorvex: the three tables written through
// vpdDB, a scripted bin/rackprobe and etc/hwserver.json.
#ifndef TESTS_DORVEX_INSTALLATION_H_
#define TESTS_DORVEX_INSTALLATION_H_

#include <cstdio>
#include <string>
#include <vector>

#include "test_support.h"
#include "vpdDB.h"

namespace dorvextest {

fru_stanza fru(const char* ds, const char* pn, const char* ec, const char* fn, const char* sn,
               const char* cc, const char* yl);
loc_id_t location(unsigned frame, unsigned cage, unsigned chip, dev_type_t type);

class Installation {
 public:
  // Creates data/, bin/ and etc/ and points this process's traces at the root.
  Installation();

  const std::string& root() const { return dir_.path(); }
  std::string path(const std::string& relative) const { return dir_ / relative; }

  // Records to store; the tables are written (a new generation) before the next run.
  void add(const chassisVPD& record);
  void add(const bpaVPD& record);
  void add(const smaVPD& record);
  void writeTables();

  // bin/rackprobe prints `text` exactly when called as "rackprobe dump -d", and nothing
  // (status 2) for any other arguments.
  void setDump(const std::string& text);
  void setHwserver(const std::string& json);

  // Runs the built dorvex with `args` under this root, traces to trace.log.
  testsupport::RunResult run(const std::vector<std::string>& args);
  std::string traces() const;

 private:
  testsupport::TempDir dir_;
  std::vector<chassisVPD> chassis_;
  std::vector<bpaVPD> bpas_;
  std::vector<smaVPD> smas_;
  bool written_ = false;
};

// One run of dorvex and what it must leave: the whole standard output and the status.
struct RunCase {
  const char* name;
  std::vector<std::string> args;
  std::string out;
  int status;
};
void expectRuns(Installation& inst, const std::vector<RunCase>& cases);

// Points the writers of dorvex_core at a temporary file for its lifetime, and puts the
// request settings back to their initial values.
class OutputCapture {
 public:
  OutputCapture();
  ~OutputCapture();
  // Everything written so far.
  std::string text();

 private:
  FILE* file_;
};

// The installation most end-to-end tests share: three switch chassis, two BPAs and the SMA
// adapters of three CECs (see installation.cc for the values).
void fillStandard(Installation& inst);

}  // namespace dorvextest

#endif  // TESTS_DORVEX_INSTALLATION_H_
