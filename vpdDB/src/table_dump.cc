// The readable dump of one table on standard output.
#include <cstdio>
#include <string>

#include "tables.h"
#include "vpdDB.h"
#include "vpd_trace.h"

namespace {

const char kOperation[] = "showVPD";

// " nwk N plane N type N frame N slot N chip N "
std::string locationText(loc_id_t l) {
  char buf[96];
  std::snprintf(buf, sizeof buf, " nwk %u plane %u type %u frame %u slot %u chip %u ",
                l.getNetwork(), l.getPlane(), l.getType(), l.getFrame(), l.getCage(), l.getChip());
  return buf;
}

// The seven fields' printable leading characters, separated by single spaces.
std::string fruText(const fru_stanza& f) {
  using vpd::printableText;
  return printableText(f.ds, fru_stanza::kDsChars) + " " +
         printableText(f.pn, fru_stanza::kPnChars) + " " +
         printableText(f.ec, fru_stanza::kEcChars) + " " +
         printableText(f.fn, fru_stanza::kFnChars) + " " +
         printableText(f.sn, fru_stanza::kSnChars) + " " +
         printableText(f.cc, fru_stanza::kCcChars) + " " +
         printableText(f.yl, fru_stanza::kYlChars);
}

std::string timestampText(const char* ts) { return vpd::printableText(ts, kTimestampBytes); }

void dumpRecord(const smaVPD& r, std::string& out) {
  out += "location id: " + locationText(r.loc_id) + "\n";
  out += "sma fru:     " + fruText(r.sma_fru) + "\n";
  out += "CEC_mtms:    " + r.cec_mtms.text() + "\n";
  out += "neighbor_id: " + locationText(r.neighbor_id) + "\n";
  out += "timestamp: " + timestampText(r.timestamp) + "\n";
  out += "\n";
}

void dumpRecord(const chassisVPD& r, std::string& out) {
  out += "location id: " + locationText(r.loc_id) + "\n";
  out += "switch mtms:\n " + r.sw_mtms.text() + "\n";
  out += "switch fru: \n " + fruText(r.sw_fru) + "\n";
  out += "dca1 fru: \n " + fruText(r.dca1_fru) + "\n";
  out += "dca2 fru: \n " + fruText(r.dca2_fru) + "\n";
  out += "riser card data include neighbor info:  \n";
  for (const riser_vpd_t& slot : r.riser) {
    out += "\nneighbor1: " + locationText(slot.nbr1) + " port " + std::to_string(slot.port1);
    out += "\nneighbor2: " + locationText(slot.nbr2) + " port " + std::to_string(slot.port2);
    out += "\nriser fru: " + fruText(slot.riser_fru) + "\n";
  }
  out += timestampText(r.timestamp) + "\n";
  out += "\n";
}

void dumpSide(const fru_stanza& bpc, const char* bpc_label, const fru_stanza (&bpr)[3],
              const fru_stanza (&bpd)[3], std::string& out) {
  out += bpc_label + fruText(bpc) + "\n";
  for (const fru_stanza& f : bpr) out += "bpr fru:       " + fruText(f) + " \n";
  for (const fru_stanza& f : bpd) out += "bpd fru:       " + fruText(f) + " \n";
}

void dumpRecord(const bpaVPD& r, std::string& out) {
  out += "location id:   " + locationText(r.loc_id) + "\n";
  out += "frame mtms:    " + r.frame_mtms.text() + "\n";
  out += "bpa1:  \n";
  dumpSide(r.bpc1_fru, "bpc fru:       ", r.bpr1_fru, r.bpd1_fru, out);
  out += "bpa2: \n";
  dumpSide(r.bpc2_fru, "bpc fru:      ", r.bpr2_fru, r.bpd2_fru, out);
  out += timestampText(r.timestamp) + "\n";
  out += "\n";
}

void emit(const std::string& text) { std::fwrite(text.data(), 1, text.size(), stdout); }

template <class Record>
void dumpTable(vpd::Table& t) {
  emit(std::string(t.desc.dump_heading) + "\n");
  const vpd::TableSnapshot& snapshot = t.snapshot();
  if (snapshot.count() == 0) {
    VPD_TRACE(ZRV_TRACE_INFO, kOperation, loc_id_t(0), "%s", t.desc.dump_empty);
    return;
  }
  std::string out;
  Record r;
  for (std::size_t i = 0; i < snapshot.count(); ++i) {
    snapshot.copyInto(i, r);
    dumpRecord(r, out);
    if (out.size() > (1u << 16)) {
      emit(out);
      out.clear();
    }
  }
  emit(out);
}

}  // namespace

int vpdDB::showVPD(table_t table_name) {
  switch (table_name) {
    case SMA_TABLE:
      dumpTable<smaVPD>(tables_->smaTbl);
      break;
    case CHASSIS_TABLE:
      dumpTable<chassisVPD>(tables_->chassisTbl);
      break;
    case BPA_TABLE:
      dumpTable<bpaVPD>(tables_->bpaTbl);
      break;
    default:
      VPD_TRACE(ZRV_TRACE_INFO, kOperation, loc_id_t(0), "unknown table name %d",
                static_cast<int>(table_name));
      break;
  }
  return 0;
}
