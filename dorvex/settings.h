// The request settings: one global per command-line option, plus the result code.
//
// -1 (or a null mtmsid) means "not given"; the dispatcher compares against exactly that.
#ifndef DORVEX_SETTINGS_H_
#define DORVEX_SETTINGS_H_

namespace dorvex {

extern int network;   // -n: network whose switch chips are listed
extern int frame;     // -f
extern int cage;      // -c
extern int mtime;     // -t: last modification time the caller knows, seconds since the epoch
extern int partnum;   // -h: DCA number, riser index, adapter number or BPR/BPD index
extern int port;      // -p: accepted and stored; no request reads it
extern int bpanum;    // -a: which BPA of the frame, 1 or 2
extern int type;      // -y: request type code (RequestType)
extern int fruid;     // -r: FRU kind code (FruKind)
extern char* mtmsid;  // -m: points at the command-line argument itself; never copied
extern int prc;       // result code, the process exit status (an ExitStatus value)

// Request type codes (-y).
enum RequestType : int {
  kTypeCec = 0,
  kTypeSwitch = 1,
  kTypeBpa = 2,
  kTypeNetvpd = 3,
  kTypeAll = 4
};

// FRU kind codes (-r).
enum FruKind : int {
  kFruDca = 10,
  kFruPlanar = 11,
  kFruRiser = 12,
  kFruAdapter = 13,
  kFruBpc = 14,
  kFruBpd = 15,
  kFruBpr = 16,
  kFruIbf = 17,
  kFruEpoSw = 18,
};

constexpr int kNotGiven = -1;

// Puts every setting back to its initial value (for running several requests in one
// process, as the tests do).
void resetSettings();

}  // namespace dorvex

#endif  // DORVEX_SETTINGS_H_
