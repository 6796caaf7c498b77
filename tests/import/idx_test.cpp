#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

// Checked by hand. Block S1: header lines before STN_ID skipped; height
// "1.550;" -> ' 1.55 '; "A 1" -> A1; HA 0 -> '    00000'; Z 90 keeps SD;
// prism -1.5 -> 1.5; face 2 (HA 45.5, Z 270) reduces to 225.5 and 90; an
// 8-digit name is not cut; 359.99999 rounds to 0; 100 x sin 60 = 86.603;
// prism "1.234567" gets a blank before it; a 3-field line is skipped; an
// empty name and a distance "abc" still write a record; the line after END
// SLOPE is ignored. Block "ST 1" (two blanks before it): label ST_1, height
// .5. Block "STN_ID X": label X, "INST_HT;" keeps .5, no END SLOPE: the next
// STN_ID starts block S3, which ends with the file (95 deg: 30 x sin 95 =
// 29.886). Every block turns its readings so that its first shot reads 0.
TEST(ConvertIdx, GoldenEveryQuirk) {
  EXPECT_EQ(ConvertIdx(TestData("idx/quirks.idx")).book, TestData("idx/quirks.asc"));
}

// Degrees, minutes and seconds: Q at 45.3000 is 45 30 00. P's two faces,
// 0 10 00 and 179 50 00 at zenith 270 (359 50 00), straddle 0: their mean is
// 0 00 00, not 180.
TEST(ConvertIdx, DmsReadingsAndFacesAcrossZero) {
  const std::string file =
      "ANGULAR DMS\nSTN_ID \"S\"\nINST_HT 1.5;\n\n\n1,\"B\",1,0,90,10,0\n"
      "2,\"Q\",1,45.3000,90,10,0\n3,\"P\",1,0.1000,90,10,0\n4,\"P\",1,179.5000,270,10,0\n";
  EXPECT_EQ(
      ConvertIdx(file).book,
      "TR S  1.5 \r\nDKD B\r\nB        00000   10.000   900000      0\r\n"
      "Q       453000   10.000   900000      0\r\nP        00000   10.000   900000      0\r\n");
}

TEST(ConvertIdx, BadInputEndsWithABoundedFieldBook) {
  // Numbers that are not numbers read as 0.
  EXPECT_EQ(ConvertIdx("STN_ID \"S\"\nINST_HT x;\n\n\n1,\"P\",c,h,z,d,p\nEND SLOPE\n").book,
            "TR S  0 \r\nDKD P\r\nP        00000    0.000    00000      0\r\n");

  // A 10 MB observation line of commas, and one of letters: one short record
  // or none, the rest of the file still read.
  const std::string head = "STN_ID \"S\"\nINST_HT 1;\n\n\n";
  const std::string tail = "\nEND SLOPE\nSTN_ID \"T\"\nINST_HT 1;\n";
  const std::string commas = ConvertIdx(head + std::string(10'000'000, ',') + tail).book;
  EXPECT_EQ(CountStarting(commas, "TR "), 2);
  EXPECT_LT(commas.size(), 200u);
  const std::string letters = ConvertIdx(head + std::string(10'000'000, 'a') + tail).book;
  EXPECT_EQ(letters, "TR S  1 \r\nDKD \r\nTR T  1 \r\n");
}

}  // namespace
}  // namespace kavu::testing
