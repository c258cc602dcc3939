#include "table_import.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <vector>

#include "data_lock.h"
#include "table_files.h"
#include "vpdDB.h"

namespace vpdload {

namespace {

Status cannotWrite(const std::string& what, int err) {
  return Status::Fail(Outcome::kCannotWrite, err != 0 ? what + ": " + errnoText(err) : what);
}

// Creates the data directory and its parents, so that a fresh install can be filled.
Status makeDataDir(const std::string& dir) {
  for (std::size_t pos = 1; pos <= dir.size(); ++pos) {
    if (pos != dir.size() && dir[pos] != '/') continue;
    std::string part = dir.substr(0, pos);
    if (::mkdir(part.c_str(), 0755) != 0 && errno != EEXIST) {
      const int err = errno;
      return cannotWrite("cannot create the data directory " + part, err);
    }
  }
  struct stat st;
  if (::stat(dir.c_str(), &st) != 0) {
    const int err = errno;
    return cannotWrite("cannot use " + dir, err);
  }
  if (!S_ISDIR(st.st_mode)) return cannotWrite("cannot use " + dir, ENOTDIR);
  return Status::Ok();
}

// Removes a staging folder: the files in it (it never holds folders), then the folder.
void removeStaging(const std::string& path) {
  if (DIR* d = ::opendir(path.c_str())) {
    std::vector<std::string> names;
    while (dirent* e = ::readdir(d)) {
      if (std::strcmp(e->d_name, ".") != 0 && std::strcmp(e->d_name, "..") != 0) {
        names.push_back(e->d_name);
      }
    }
    ::closedir(d);
    for (const std::string& n : names) ::unlink(joinPath(path, n).c_str());
  }
  ::rmdir(path.c_str());
}

// Staging folders left by imports that were killed. Only an import holding the lock makes
// one, so with the lock held every one found is a leftover.
void removeLeftovers(const std::string& data_dir) {
  DIR* d = ::opendir(data_dir.c_str());
  if (d == nullptr) return;
  std::vector<std::string> found;
  std::size_t prefix = std::strlen(kStagingPrefix);
  while (dirent* e = ::readdir(d)) {
    if (std::strncmp(e->d_name, kStagingPrefix, prefix) == 0 &&
        std::strcmp(e->d_name, kLockFile) != 0) {
      found.push_back(joinPath(data_dir, e->d_name));
    }
  }
  ::closedir(d);
  for (const std::string& path : found) {
    struct stat st;
    if (::lstat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode)) removeStaging(path);
  }
}

// The private folder in which the new generation is built; removed with whatever is left
// in it when the import ends, however it ends short of being killed.
class Staging {
 public:
  Status create(const std::string& data_dir) {
    std::string templ = joinPath(data_dir, std::string(kStagingPrefix) + "XXXXXX");
    std::vector<char> buf(templ.begin(), templ.end());
    buf.push_back('\0');
    if (::mkdtemp(buf.data()) == nullptr) {
      const int err = errno;
      return cannotWrite("cannot create a staging folder in " + data_dir, err);
    }
    path_ = buf.data();
    return Status::Ok();
  }
  ~Staging() {
    if (!path_.empty()) removeStaging(path_);
  }
  std::string file(const std::string& name) const { return joinPath(path_, name); }
  const std::string& path() const { return path_; }

 private:
  std::string path_;
};

template <typename Record>
Status storeAll(vpdDB& db, const std::vector<Record>& records, const TableFile& table,
                const Staging& stage) {
  for (std::size_t i = 0; i < records.size(); ++i) {
    Record copy(records[i]);
    errno = 0;
    if (db.putVPD(copy.loc_id, &copy) != 0) {
      const int err = errno;  // the database keeps the errno of the failed write
      return cannotWrite("cannot write " + std::string(table.key) + "[" + std::to_string(i) +
                             "] to " + stage.file(table.file),
                         err);
    }
  }
  return Status::Ok();
}

// Checks a staged table as it lies on disk and makes it durable before it is renamed:
// closing the table can fail where storing did not, and without the fsync a crash after
// the rename could leave an empty live table.
Status syncStaged(const std::string& path, std::size_t expected_size) {
  int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
  if (fd < 0) {
    const int err = errno;
    return cannotWrite("cannot open " + path, err);
  }
  struct stat st;
  Status status;
  if (::fstat(fd, &st) != 0) {
    const int err = errno;
    status = cannotWrite("cannot read the status of " + path, err);
  } else if (static_cast<std::size_t>(st.st_size) != expected_size) {
    status = cannotWrite(path + " holds " + std::to_string(st.st_size) + " bytes instead of " +
                             std::to_string(expected_size),
                         0);
  } else if (::fsync(fd) != 0) {
    const int err = errno;
    status = cannotWrite("cannot sync " + path, err);
  }
  ::close(fd);
  return status;
}

Status writeStaged(const Inventory& inv, const Staging& stage) {
  try {
    vpdDB db(stage.path());
    Status s = storeAll(db, inv.chassis, kChassisTable, stage);
    if (s.ok()) s = storeAll(db, inv.bpa, kBpaTable, stage);
    if (s.ok()) s = storeAll(db, inv.sma, kSmaTable, stage);
    if (!s.ok()) return s;
  } catch (int) {
    const int err = errno;
    return cannotWrite("cannot create the new tables in " + stage.path(), err);
  }
  const std::size_t counts[] = {inv.chassis.size(), inv.bpa.size(), inv.sma.size()};
  for (int t = 0; t < 3; ++t) {
    Status s = syncStaged(stage.file(kTables[t]->file), counts[t] * kTables[t]->record_size);
    if (!s.ok()) return s;
  }
  return Status::Ok();
}

Status syncDirectory(const std::string& dir) {
  int fd = ::open(dir.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (fd < 0) {
    const int err = errno;
    return cannotWrite("cannot open " + dir + " to sync it", err);
  }
  Status status;
  if (::fsync(fd) != 0) {
    const int err = errno;
    status = cannotWrite("cannot sync " + dir, err);
  }
  ::close(fd);
  return status;
}

// Moves the staged tables into place. Every step that can fail for want of space or
// permission comes first: the second name of each live table that keeps the previous
// generation. Then only renames within one directory remain.
Status commit(const Staging& stage, const std::string& data_dir) {
  bool had_live[3];
  for (int t = 0; t < 3; ++t) {
    std::string live = joinPath(data_dir, kTables[t]->file);
    std::string prev = stage.file(std::string(kTables[t]->file) + ZRV_OLD_SUFFIX);
    had_live[t] = ::link(live.c_str(), prev.c_str()) == 0;
    // Without a live table, the read-write constructor leaves an older ".old" alone too.
    const int err = had_live[t] ? 0 : errno;
    if (!had_live[t] && err != ENOENT) {
      return cannotWrite("cannot keep the previous " + live, err);
    }
  }
  // A change poll compares the SMA table's time with the time of its last answer; the new
  // table must not look older than the moment it appears.
  ::utimensat(AT_FDCWD, stage.file(kSmaTable.file).c_str(), nullptr, 0);
  std::string done;
  for (int t = 0; t < 3; ++t) {
    std::string live = joinPath(data_dir, kTables[t]->file);
    std::string old = live + ZRV_OLD_SUFFIX;
    std::string prev = stage.file(std::string(kTables[t]->file) + ZRV_OLD_SUFFIX);
    std::string already = done.empty() ? "" : " (already replaced:" + done + ")";
    if (had_live[t] && ::rename(prev.c_str(), old.c_str()) != 0) {
      const int err = errno;
      return cannotWrite("cannot rename " + prev + " to " + old + already, err);
    }
    if (::rename(stage.file(kTables[t]->file).c_str(), live.c_str()) != 0) {
      const int err = errno;
      return cannotWrite("cannot rename the new table to " + live + already, err);
    }
    done += std::string(" ") + kTables[t]->file;
  }
  return syncDirectory(data_dir);
}

}  // namespace

Status importTables(const Inventory& inv, const std::string& data_dir, double wait_seconds) {
  Status s = makeDataDir(data_dir);
  if (!s.ok()) return s;
  DataLock lock;
  s = lock.lockForImport(data_dir, wait_seconds);
  if (!s.ok()) return s;
  removeLeftovers(data_dir);
  Staging stage;
  s = stage.create(data_dir);
  if (s.ok()) s = writeStaged(inv, stage);
  if (s.ok()) s = commit(stage, data_dir);
  return s;
}

}  // namespace vpdload
