#include "installation_writer.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstdio>
#include <cstring>

#include "installation_records.h"
#include "vpdDB.h"

namespace gen {
namespace {

std::string errnoText(int e) { return std::strerror(e); }

// mkdir -p: an existing folder is fine.
std::string makeDirs(const std::string& path) {
  for (std::size_t pos = 1; pos <= path.size(); ++pos) {
    if (pos != path.size() && path[pos] != '/') continue;
    std::string part = path.substr(0, pos);
    if (::mkdir(part.c_str(), 0755) != 0 && errno != EEXIST)
      return "cannot create " + part + ": " + errnoText(errno);
  }
  struct stat st;
  if (::stat(path.c_str(), &st) != 0 || !S_ISDIR(st.st_mode)) return path + " is not a folder";
  return "";
}

// Written beside the target and renamed over it, so that a reader sees old or new, whole.
std::string writeFile(const std::string& path, const std::string& text) {
  std::string temp = path + ".tmp";
  FILE* f = std::fopen(temp.c_str(), "wb");
  if (f == nullptr) return "cannot create " + temp + ": " + errnoText(errno);
  bool ok = std::fwrite(text.data(), 1, text.size(), f) == text.size();
  int write_errno = errno;
  if (std::fclose(f) != 0 && ok) {
    ok = false;
    write_errno = errno;
  }
  if (!ok) {
    std::remove(temp.c_str());
    return "cannot write " + temp + ": " + errnoText(write_errno);
  }
  if (std::rename(temp.c_str(), path.c_str()) != 0)
    return "cannot rename " + temp + " to " + path + ": " + errnoText(errno);
  return "";
}

std::string mtmsJson(const mtms& m) {
  return "\"tm\": \"" + m.getTM() + "\", \"se\": \"" + m.getSE() + "\"";
}

bool managedBy(const Layout& layout, unsigned int console, unsigned int frame) {
  unsigned int consoles = layout.params().consoles;
  return consoles == 1 || (frame - 1) % consoles == console || frame % consoles == console;
}

std::string writeTables(const std::string& data_dir, const Layout& layout, Written* w) {
  try {
    vpdDB db(data_dir);
    for (unsigned int s = 0; s < layout.switchCount(); ++s) {
      chassisVPD r = chassisRecord(layout, s);
      if (db.putVPD(r.loc_id, &r) != 0) return "cannot store switch chassis " + std::to_string(s);
      ++w->chassis_records;
    }
    for (unsigned int f = 1; f <= layout.params().frames; ++f) {
      bpaVPD r = bpaRecord(layout, f);
      if (db.putVPD(r.loc_id, &r) != 0) return "cannot store the BPA of frame " + std::to_string(f);
      ++w->bpa_records;
    }
    for (unsigned int c = 0; c < layout.params().cecs; ++c) {
      for (unsigned int chip = 0; chip < layout.params().sma_per_cec; ++chip) {
        smaVPD r = smaRecord(layout, c, chip);
        if (db.putVPD(r.loc_id, &r) != 0)
          return "cannot store SMA records of CEC " + std::to_string(c);
        ++w->sma_records;
      }
    }
  } catch (int) {
    return "cannot open the tables in " + data_dir;
  }
  w->table_bytes = w->chassis_records * chassisVPD::kRecordSize +
                   w->bpa_records * bpaVPD::kRecordSize + w->sma_records * smaVPD::kRecordSize;
  return "";
}

}  // namespace

std::string rackprobeDump(const Layout& layout) {
  const Params& p = layout.params();
  std::string out;
  auto line = [&out](unsigned int frame, unsigned int cage, const char* type, unsigned int chip,
                     unsigned int plane, unsigned int network) {
    out += std::to_string(frame) + ' ' + std::to_string(cage) + ' ' + type + ' ' +
           std::to_string(chip) + ' ' + std::to_string(plane) + ' ' + std::to_string(network) +
           '\n';
  };
  for (unsigned int f = 1; f <= p.frames; ++f) {
    loc_id_t bpa = layout.bpaLocation(f);
    line(f, kBpaCage, "BPA", 0, 0, bpa.getNetwork());
    for (unsigned int row = 0; row < layout.switchCagesPerFrame(); ++row) {
      unsigned int s = row * p.frames + (f - 1);
      if (s >= layout.switchCount()) break;
      loc_id_t at = layout.switchLocation(s);
      for (unsigned int chip = 0; chip < layout.chipLinesPerSwitch(); ++chip)
        line(f, at.getCage(), "SW_CHIP", chip, at.getPlane(), at.getNetwork());
    }
    for (unsigned int c = f - 1; c < p.cecs; c += p.frames) {
      for (unsigned int chip = 0; chip < p.sma_per_cec; ++chip) {
        loc_id_t at = layout.cecLocation(c, chip);
        line(f, at.getCage(), "SMA", chip, at.getPlane(), at.getNetwork());
      }
    }
  }
  return out;
}

std::string hwserverJson(const Layout& layout) {
  const Params& p = layout.params();
  std::string out = "{\n  \"consoles\": [";
  for (unsigned int c = 0; c < p.consoles; ++c) {
    out += c == 0 ? "\n" : ",\n";
    out += "    { \"ip\": \"10.0." + std::to_string(c / 250) + "." + std::to_string(c % 250 + 1) +
           "\", " + mtmsJson(layout.consoleMtms(c)) + ", \"bpa_vports\": [";
    bool first = true;
    for (unsigned int f = 1; f <= p.frames; ++f) {
      if (!managedBy(layout, c, f)) continue;
      out += (first ? "" : ", ") + std::to_string(f);
      first = false;
    }
    out += "] }";
  }
  out += "\n  ],\n  \"bpas\": [";
  for (unsigned int f = 1; f <= p.frames; ++f) {
    out += f == 1 ? "\n" : ",\n";
    out += "    { \"vport\": " + std::to_string(f) + ", " + mtmsJson(layout.bpaMtms(f)) + " }";
  }
  out += "\n  ]\n}\n";
  return out;
}

std::string writeInstallation(const std::string& root, const Layout& layout, Written* out) {
  Written ignored;
  Written* w = out != nullptr ? out : &ignored;
  *w = Written();
  std::string error = makeDirs(root + "/data");
  if (error.empty()) error = makeDirs(root + "/etc");
  if (error.empty()) error = writeTables(root + "/data", layout, w);
  if (error.empty()) error = writeFile(root + "/etc/rackprobe.dump", rackprobeDump(layout));
  if (error.empty()) error = writeFile(root + "/etc/hwserver.json", hwserverJson(layout));
  return error;
}

}  // namespace gen
