// Value semantics of the record types: bit fields, text forms, bounded copies.
#include <gtest/gtest.h>

#include <cstring>

#include "vpd_records.h"
#include "vpd_test_util.h"

namespace {

TEST(LocIdTest, FieldsLieWhereTheWordSaysAndDropExtraBits) {
  struct Case {
    const char* name;
    unsigned frame, cage, chip, type, plane, network;
    uint32_t word;
  } cases[] = {
      {"zero", 0, 0, 0, 0, 0, 0, 0x00000000},
      {"chip", 0, 0, 0xf, 0, 0, 0, 0x0000000f},
      {"cage", 0, 0xff, 0, 0, 0, 0, 0x00000ff0},
      {"frame", 0xfff, 0, 0, 0, 0, 0, 0x00fff000},
      {"type", 0, 0, 0, 0xf, 0, 0, 0x0f000000},
      {"plane", 0, 0, 0, 0, 1, 0, 0x10000000},
      {"network", 0, 0, 0, 0, 0, 7, 0xe0000000},
      {"all", 2, 5, 3, SMA, 0, 1, 0x21002053},
      {"chip too wide", 0, 0, 0x13, 0, 0, 0, 0x00000003},
      {"cage too wide", 0, 0x1ff, 0, 0, 0, 0, 0x00000ff0},
      {"frame too wide", 0x1001, 0, 0, 0, 0, 0, 0x00001000},
      {"type too wide", 0, 0, 0, 0x12, 0, 0, 0x02000000},
      {"plane too wide", 0, 0, 0, 0, 2, 0, 0x00000000},
      {"network too wide", 0, 0, 0, 0, 0, 9, 0x20000000},
  };
  for (const Case& c : cases) {
    loc_id_t l(c.frame, c.cage, c.chip, c.type, c.plane, c.network);
    EXPECT_EQ(l.toInt(), c.word) << c.name;
    loc_id_t back(c.word);
    EXPECT_EQ(back.getFrame(), c.word >> 12 & 0xfff) << c.name;
    EXPECT_EQ(back.getCage(), c.word >> 4 & 0xff) << c.name;
    EXPECT_EQ(back.getChip(), c.word & 0xf) << c.name;
    EXPECT_EQ(back.getType(), c.word >> 24 & 0xf) << c.name;
    EXPECT_EQ(back.getPlane(), c.word >> 28 & 1) << c.name;
    EXPECT_EQ(back.getNetwork(), c.word >> 29) << c.name;
    unsigned char raw[4];
    std::memcpy(raw, &l, 4);
    EXPECT_EQ(raw[0], c.word & 0xff) << c.name << ": stored little-endian";
  }
}

TEST(LocIdTest, SettersTouchOnlyTheirField) {
  loc_id_t l(0xffffffffu);
  l.setCage(0);
  EXPECT_EQ(l.toInt(), 0xfffff00fu);
  l.setFrame(0x123);
  EXPECT_EQ(l.getFrame(), 0x123u);
  EXPECT_EQ(l.getChip(), 0xfu);
  EXPECT_EQ(l.getType(), 0xfu);
  EXPECT_FALSE(loc_id_t(0).isValid());
  EXPECT_TRUE(loc_id_t(1).isValid());
}

TEST(LocIdTest, SmaChipNumbers) {
  const unsigned char expected[16] = {2,   3,   6,   7,   8,   9,   12,  13,
                                      255, 255, 255, 255, 255, 255, 255, 255};
  for (unsigned chip = 0; chip < 16; ++chip) {
    loc_id_t l(0, 0, chip, SMA, 0, 0);
    EXPECT_EQ(l.SMAchip(), expected[chip]) << "chip " << chip;
    EXPECT_EQ(loc_id_t::SMAchip(chip), expected[chip]) << "chip " << chip;
  }
}

// Fills an MTMS from raw bytes, the way a record read from disk may hold them.
mtms rawMtms(const char* tm9, const char* se8) {
  mtms m;
  std::memcpy(m.tm, tm9, 9);
  std::memcpy(m.se, se8, 8);
  return m;
}

TEST(MtmsTest, TextForm) {
  struct Case {
    const char* name;
    mtms value;
    const char* text;
  } cases[] = {
      {"empty", mtms(), "*"},
      {"full", rawMtms("7040-681X", "10ABCDEY"), "7040-681*10ABCDE"},
      {"empty tm", mtms("", "1234567"), "*1234567"},
      {"non-printable third",
       rawMtms("AB\x01"
               "DEFGH\0",
               "SER\0\0\0\0\0"),
       "AB*SER"},
      {"short", mtms("7042", "12"), "7042*12"},
      {"tab stops",
       rawMtms("70\t2\0\0\0\0\0",
               "1\x7f"
               "3\0\0\0\0\0"),
       "70*1"},
  };
  for (const Case& c : cases) EXPECT_EQ(c.value.text(), c.text) << c.name;
}

TEST(MtmsTest, EqualityLooksAtSignificantCharactersOnly) {
  struct Case {
    const char* name;
    mtms a, b;
    bool equal;
  } cases[] = {
      {"same", mtms("7040-681", "10ABCDE"), mtms("7040-681", "10ABCDE"), true},
      {"differ after 8th tm", rawMtms("7040-681X", "10ABCDE\0"), rawMtms("7040-681Y", "10ABCDE\0"),
       true},
      {"differ after 7th se", rawMtms("7040-681\0", "10ABCDEX"), rawMtms("7040-681\0", "10ABCDEY"),
       true},
      {"shorter tm", mtms("7040", "1"), mtms("7040-681", "1"), false},
      {"differ after NUL in se", rawMtms("A\0\0\0\0\0\0\0\0", "12\0X\0\0\0\0"),
       rawMtms("A\0\0\0\0\0\0\0\0", "12\0Y\0\0\0\0"), true},
      {"serial differs", mtms("7040-681", "1"), mtms("7040-681", "2"), false},
  };
  for (const Case& c : cases) EXPECT_EQ(c.a == c.b, c.equal) << c.name;
}

TEST(MtmsTest, AssignmentCopiesSignificantCharactersAndKeepsTerminators) {
  mtms src = rawMtms("ABCDEFGHI", "1234567Z");
  mtms dst = rawMtms("zzzzzzzzQ", "yyyyyyyR");
  dst = src;
  EXPECT_EQ(std::string(dst.tm, 9), "ABCDEFGHQ");
  EXPECT_EQ(std::string(dst.se, 8), "1234567R");
  mtms copy(src);  // the copy constructor copies whole
  EXPECT_EQ(std::memcmp(&copy, &src, sizeof src), 0);
  mtms shorter("AB", "1");
  dst = shorter;
  EXPECT_EQ(std::string(dst.tm, 9), std::string("AB\0\0\0\0\0\0Q", 9));
}

TEST(MtmsTest, CommandLineFormNeverReadsPastTheText) {
  struct Case {
    const char* text;
    const char* tm;
    const char* se;
  } cases[] = {
      {"7040-681*10ABCDE", "7040-681", "10ABCDE"},
      {"7040-681*10ABCDEFGH", "7040-681", "10ABCDE"},
      {"7040-681*", "7040-681", ""},
      {"7040-681", "7040-681", ""},
      {"7040", "7040", ""},
      {"", "", ""},
      {"7040-681?12", "7040-681", "12"},
  };
  for (const Case& c : cases) {
    // A heap copy of exactly the text's size lets the sanitizer catch any over-read.
    std::unique_ptr<char[]> heap(new char[std::strlen(c.text) + 1]);
    std::strcpy(heap.get(), c.text);
    mtms m(heap.get());
    EXPECT_EQ(m.getTM(), c.tm) << c.text;
    EXPECT_EQ(m.getSE(), c.se) << c.text;
  }
}

TEST(FruStanzaTest, DefaultIsAllNulAndAssignmentIsBounded) {
  fru_stanza empty;
  EXPECT_EQ(vpdtest::bytesOf(empty), std::string(104, '\0'));
  fru_stanza src;
  std::memset(static_cast<void*>(&src), 'A', sizeof src);  // every field full, no terminators
  fru_stanza dst;
  std::memset(static_cast<void*>(&dst), 'z', sizeof dst);
  dst = src;
  const struct {
    const char* name;
    std::size_t offset, width;
  } fields[] = {{"ds", 0, 31},  {"pn", 31, 13}, {"ec", 44, 13}, {"fn", 57, 13},
                {"sn", 70, 13}, {"cc", 83, 5},  {"yl", 88, 16}};
  std::string bytes = vpdtest::bytesOf(dst);
  for (const auto& f : fields) {
    EXPECT_EQ(bytes.substr(f.offset, f.width - 1), std::string(f.width - 1, 'A')) << f.name;
    EXPECT_EQ(bytes[f.offset + f.width - 1], 'z') << f.name << ": last byte kept";
  }
  EXPECT_EQ(src.getDS(), std::string(30, 'A'));
  EXPECT_EQ(src.getCC(), "AAAA");
  fru_stanza whole(src);
  EXPECT_EQ(vpdtest::bytesOf(whole), vpdtest::bytesOf(src));
}

TEST(FruStanzaTest, SettersNeverWritePastTheSignificantLength) {
  fru_stanza f;
  std::string long_text(100, 'x');
  f.setDS(long_text.c_str(), 100);
  f.setPN(long_text.c_str(), 100);
  f.setCC(long_text.c_str(), 100);
  EXPECT_EQ(f.getDS(), std::string(30, 'x'));
  EXPECT_EQ(f.ds[30], '\0');
  EXPECT_EQ(f.getPN(), std::string(12, 'x'));
  EXPECT_EQ(f.pn[12], '\0');
  EXPECT_EQ(f.getCC(), "xxxx");
  EXPECT_EQ(f.ec[0], '\0');
}

TEST(RecordTest, DefaultsAreZeroAndAssignmentKeepsDestinationTerminators) {
  EXPECT_EQ(vpdtest::bytesOf(smaVPD()), std::string(160, '\0'));
  EXPECT_EQ(vpdtest::bytesOf(chassisVPD()), std::string(2284, '\0'));
  EXPECT_EQ(vpdtest::bytesOf(bpaVPD()), std::string(1508, '\0'));

  chassisVPD full;
  std::memset(static_cast<void*>(&full), 'B', sizeof full);
  chassisVPD dst;
  dst = full;
  EXPECT_EQ(dst.sw_mtms.getTM(), "BBBBBBBB");
  EXPECT_EQ(dst.sw_mtms.tm[8], '\0');
  EXPECT_EQ(dst.riser[15].riser_fru.yl[15], '\0');
  EXPECT_EQ(dst.riser[15].riser_fru.getYL(), std::string(15, 'B'));
  EXPECT_EQ(std::string(dst.timestamp, 28), std::string(28, 'B'));
  EXPECT_EQ(dst.riser[3].port1, full.riser[3].port1);
  chassisVPD copy(full);
  EXPECT_EQ(vpdtest::bytesOf(copy).substr(0, 333), vpdtest::bytesOf(full).substr(0, 333));
}

TEST(RecordTest, IndexedAccessorsIgnoreIndexesOutsideTheRecord) {
  chassisVPD c;
  fru_stanza f("d", "p", "e", "f", "s", "c", "y");
  c.setRiser(f, 16);
  c.setRiser(f, -1);
  EXPECT_EQ(vpdtest::bytesOf(c), vpdtest::bytesOf(chassisVPD()));
  riser_vpd_t r;
  EXPECT_EQ(c.getRiserStruct(r, 16), 1);
  EXPECT_EQ(c.getRiser(99).getPN(), "");
  bpaVPD b;
  b.setBpr1(f, 3);
  EXPECT_EQ(vpdtest::bytesOf(b), vpdtest::bytesOf(bpaVPD()));
  EXPECT_EQ(b.getBpd2(-1).getPN(), "");
  b.setBpd2(f, 2);
  EXPECT_EQ(b.getBpd2(2).getPN(), "p");
}

}  // namespace
