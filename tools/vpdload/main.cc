// vpdload: import an installation inventory into the VPD tables, or export them.
#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <exception>
#include <string>
#include <vector>

#include "inventory_schema.h"
#include "olv_root.h"
#include "options.h"
#include "table_export.h"
#include "table_files.h"
#include "table_import.h"
#include "zrv_const.h"

namespace vpdload {
namespace {

void say(const std::string& line) { std::fprintf(stderr, "vpdload: %s\n", line.c_str()); }

ExitStatus exitFor(const Status& s) {
  switch (s.outcome) {
    case Outcome::kOk:
      return ExitStatus::kDone;
    case Outcome::kInvalidInventory:
      return ExitStatus::kInvalidInventory;
    case Outcome::kCannotRead:
      return ExitStatus::kCannotRead;
    case Outcome::kCannotWrite:
      return ExitStatus::kCannotWrite;
    case Outcome::kLocked:
      return ExitStatus::kLocked;
  }
  return ExitStatus::kCannotWrite;
}

ExitStatus fail(const Status& s) {
  say(s.message);
  return exitFor(s);
}

bool isStdio(const std::string& file) { return file.empty() || file == "-"; }
std::string displayName(const std::string& file) { return isStdio(file) ? "standard input" : file; }

// errno is taken by the caller right after the call that failed: building the message may
// change it.
Status ioFailure(Outcome o, const std::string& what, int err) {
  return Status::Fail(o, what + ": " + errnoText(err));
}

Status readAll(const std::string& file, std::string* text) {
  int fd = isStdio(file) ? 0 : ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
  if (fd < 0) {
    const int err = errno;
    return ioFailure(Outcome::kCannotRead, "cannot read " + file, err);
  }
  char buf[65536];
  Status s;
  for (;;) {
    ssize_t n = ::read(fd, buf, sizeof buf);
    if (n > 0) {
      text->append(buf, static_cast<std::size_t>(n));
    } else if (n == 0) {
      break;
    } else if (errno != EINTR) {
      const int err = errno;
      s = ioFailure(Outcome::kCannotRead, "cannot read " + displayName(file), err);
      break;
    }
  }
  if (fd != 0) ::close(fd);
  return s;
}

Status writeAll(const std::string& file, const std::string& text) {
  const std::string name = isStdio(file) ? "standard output" : file;
  int fd = isStdio(file) ? 1 : ::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
  if (fd < 0) {
    const int err = errno;
    return ioFailure(Outcome::kCannotWrite, "cannot create " + name, err);
  }
  std::size_t done = 0;
  Status s;
  while (done < text.size()) {
    ssize_t n = ::write(fd, text.data() + done, text.size() - done);
    if (n > 0) {
      done += static_cast<std::size_t>(n);
    } else if (n < 0 && errno == EINTR) {
      continue;
    } else {
      const int err = n < 0 ? errno : ENOSPC;  // a write of nothing: no room left
      s = ioFailure(Outcome::kCannotWrite, "cannot write " + name, err);
      break;
    }
  }
  if (fd != 1 && ::close(fd) != 0 && s.ok()) {
    const int err = errno;
    s = ioFailure(Outcome::kCannotWrite, "cannot write " + name, err);
  }
  return s;
}

ExitStatus runImport(const Options& o, const std::string& data_dir) {
  std::string text;
  Status s = readAll(o.file, &text);
  if (!s.ok()) return fail(s);
  Inventory inv;
  Problems problems = parseInventory(text, &inv);
  text = std::string();
  if (!problems.empty()) {
    std::string where = displayName(o.file);
    for (const std::string& p : problems.list) say(where + ": " + p);
    std::size_t n = problems.total;
    say(where + ": " + std::to_string(n) + (n == 1 ? " error" : " errors") +
        (n > problems.list.size()
             ? " (the first " + std::to_string(problems.list.size()) + " shown)"
             : "") +
        "; no table was changed");
    return ExitStatus::kInvalidInventory;
  }
  s = importTables(inv, data_dir, o.wait_seconds);
  if (!s.ok()) return fail(s);
  say("stored " + std::to_string(inv.chassis.size()) + " chassis, " +
      std::to_string(inv.bpa.size()) + " BPA and " + std::to_string(inv.sma.size()) +
      " SMA records in " + data_dir);
  return ExitStatus::kDone;
}

ExitStatus runExport(const Options& o, const std::string& data_dir) {
  Inventory inv;
  std::vector<std::string> warnings;
  Status s = exportTables(data_dir, o.wait_seconds, &inv, &warnings);
  if (!s.ok()) return fail(s);
  for (const std::string& w : warnings) say("warning: " + w);
  s = writeAll(o.file, inventoryText(inv));
  return s.ok() ? ExitStatus::kDone : fail(s);
}

ExitStatus run(const std::vector<std::string>& args) {
  Options o;
  std::string error;
  if (!parseOptions(args, &o, &error)) {
    say(error);
    std::fprintf(stderr, "Try 'vpdload --help'.\n");
    return ExitStatus::kUsage;
  }
  if (o.command == Command::kHelp) {
    std::fputs(helpText(), stdout);
    return std::fflush(stdout) == 0 ? ExitStatus::kDone : ExitStatus::kCannotWrite;
  }
  std::string data_dir = o.data_dir.empty() ? olv::underRoot(ZRV_DATA_DIR) : o.data_dir;
  return o.command == Command::kImport ? runImport(o, data_dir) : runExport(o, data_dir);
}

}  // namespace
}  // namespace vpdload

int main(int argc, char** argv) {
  try {
    return static_cast<int>(vpdload::run(std::vector<std::string>(argv + 1, argv + argc)));
  } catch (const std::exception& e) {
    // Out of memory on a huge inventory, mostly; never a crash.
    std::fprintf(stderr, "vpdload: %s\n", e.what());
    return static_cast<int>(vpdload::ExitStatus::kCannotWrite);
  }
}
