// The UTF-8 test decides whether a text is exported as a string or in hex: it must agree
// with the JSON library, which refuses to write anything else as a string.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <string>

#include "inventory_schema.h"
#include "text_bytes.h"

namespace {

bool libraryAccepts(const std::string& bytes) {
  try {
    (void)nlohmann::json(bytes).dump();
    return true;
  } catch (const nlohmann::json::type_error&) {
    return false;
  }
}

TEST(VpdloadText, Utf8AgreesWithTheJsonLibrary) {
  struct Case {
    const char* name;
    std::string bytes;
    bool utf8;
  } cases[] = {
      {"empty", "", true},
      {"ASCII with controls", std::string("a\x01\x1f\x7f", 4), true},
      {"two-byte", "\xc3\xa9", true},
      {"three-byte", "\xe2\x82\xac", true},
      {"four-byte, highest", "\xf4\x8f\xbf\xbf", true},
      {"lone continuation", "\x80", false},
      {"overlong two-byte", "\xc0\xaf", false},
      {"overlong C1", "\xc1\xbf", false},
      {"overlong three-byte", "\xe0\x9f\xbf", false},
      {"smallest three-byte", "\xe0\xa0\x80", true},
      {"surrogate", "\xed\xa0\x80", false},
      {"last before surrogates", "\xed\x9f\xbf", true},
      {"overlong four-byte", "\xf0\x8f\xbf\xbf", false},
      {"above U+10FFFF", "\xf4\x90\x80\x80", false},
      {"F5 lead", "\xf5\x80\x80\x80", false},
      {"FF", "\xff", false},
      {"truncated at the end", "ab\xe2\x82", false},
      {"truncated in the middle", "\xe2\x82z", false},
      {"bad third byte", "\xf0\x90\xc0\x80", false},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(vpdload::isUtf8(c.bytes), c.utf8);
    EXPECT_EQ(libraryAccepts(c.bytes), c.utf8);
  }
}

TEST(VpdloadText, HexRoundTripAndRejects) {
  struct Case {
    const char* hex;
    bool ok;
    std::string bytes_or_why;
  } cases[] = {
      {"", true, ""},
      {"00ff7F80", true, std::string("\x00\xff\x7f\x80", 4)},
      {"ABcd", true, "\xab\xcd"},
      {"a", false, "an odd number of hex digits (1)"},
      {"0x", false, "character 2 is not a hex digit"},
      {"12 4", false, "character 3 is not a hex digit"},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.hex);
    std::string bytes, why;
    EXPECT_EQ(vpdload::fromHex(c.hex, &bytes, &why), c.ok);
    EXPECT_EQ(c.ok ? bytes : why, c.bytes_or_why);
    if (c.ok) {
      std::string back;
      EXPECT_TRUE(vpdload::fromHex(vpdload::toHex(bytes), &back, &why));
      EXPECT_EQ(back, c.bytes_or_why);
    }
  }
}

// Export builds its text record by record; it must be the layout of the whole document.
TEST(VpdloadText, ExportTextIsTheFormattedDocument) {
  const char* cases[] = {
      "{}",
      R"({"bpa": [{"loc": {"frame": 1}, "bpr1": [{}, {"pn": "x"}]}]})",
      R"({"sma": [{"loc": {"chip": 1}, "fru": {"ds": {"hex": "ff"}}}, {"loc": {"chip": 2}}],
          "chassis": [{"risers": [{"slot": 3, "port1": -1}, {"slot": 4, "fru": {"sn": "s"}}]}],
          "bpa": [{"timestamp": "t\n"}]})",
  };
  for (const char* json : cases) {
    SCOPED_TRACE(json);
    vpdload::Inventory inv;
    ASSERT_TRUE(vpdload::parseInventory(json, &inv).empty());
    EXPECT_EQ(vpdload::inventoryText(inv), vpdload::formatJson(vpdload::inventoryToJson(inv)));
  }
}

}  // namespace
