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
// prism -1.5 -> 1.5; face-2 Z 270 gives a positive HD; an 8-digit name is
// not cut; 359.99999 rounds to 0; 100 x sin 60 = 86.603; prism "1.234567" gets
// a blank before it; a 3-field line is skipped; an empty name and a distance
// "abc" still write a record; the line after END SLOPE is ignored. Block "ST 1"
// (two blanks before it): label S, height .5. Block "STN_ID X": empty label,
// "INST_HT;" keeps .5, no END SLOPE: the next STN_ID starts block S3, which
// ends with the file (95 deg: 30 x sin 95 = 29.886).
TEST(ConvertIdx, GoldenEveryQuirk) {
  EXPECT_EQ(ConvertIdx(TestData("idx/quirks.idx")), TestData("idx/quirks.asc"));
}

// The end of the file ends the conversion wherever it falls; what was written
// stays.
TEST(ConvertIdx, FileEndingInsideABlockKeepsWhatWasWritten) {
  const std::string stn = "STN_ID \"S1\"\n";
  const std::string ht = "INST_HT 1.5;\n";
  const std::string obs = "1,\"P1\",1,90,90,12.5,1.5\n";
  const std::string tr = "TR S1  1.5 \r\n";
  const std::string detail = "P1      900000   12.500   900000    1.5\r\n";
  EXPECT_EQ(ConvertIdx(stn), "");
  EXPECT_EQ(ConvertIdx(stn + ht), tr);
  EXPECT_EQ(ConvertIdx(stn + ht + "a\nb\n"), tr);
  EXPECT_EQ(ConvertIdx(stn + ht + "a\nb\n" + obs), tr + "DKD P1\r\n" + detail);
  EXPECT_EQ(ConvertIdx(stn + ht + "a\nb\n" + obs + obs), tr + "DKD P1\r\n" + detail + detail);
  // A STN_ID where the first observation should be: a station without one.
  EXPECT_EQ(ConvertIdx(stn + ht + "a\nb\n" + stn + ht + "a\nb\n" + obs),
            tr + tr + "DKD P1\r\n" + detail);
  // END SLOPE as the first observation: the orientation has no name.
  EXPECT_EQ(ConvertIdx(stn + ht + "a\nb\nEND SLOPE\n" + obs), tr + "DKD \r\n");
}

TEST(ConvertIdx, NamesPassThroughByteForByte) {
  // TCVN3 letters and a NUL inside quoted names; a long name is not cut.
  const std::string name("\xae\xad\xeang\0x", 6);
  const std::string file = "STN_ID \"" + name + "\"\nINST_HT 2;\n\n\n1,\"" + name +
                           "\",1,0,90,5,0\n1,\"" + name + "12345\",1,0,90,5,0\n";
  EXPECT_EQ(ConvertIdx(file), "TR " + name + "  2 \r\nDKD " + name + "\r\n" + name +
                                  "    00000    5.000   900000      0\r\n" + name +
                                  "12345    00000    5.000   900000      0\r\n");
}

TEST(ConvertIdx, BadInputEndsWithABoundedFieldBook) {
  // Numbers that are not numbers read as 0.
  EXPECT_EQ(ConvertIdx("STN_ID \"S\"\nINST_HT x;\n\n\n1,\"P\",c,h,z,d,p\nEND SLOPE\n"),
            "TR S  0 \r\nDKD P\r\nP        00000    0.000    00000      0\r\n");

  // A 10 MB observation line of commas, and one of letters: one short record
  // or none, the rest of the file still read.
  const std::string head = "STN_ID \"S\"\nINST_HT 1;\n\n\n";
  const std::string tail = "\nEND SLOPE\nSTN_ID \"T\"\nINST_HT 1;\n";
  const std::string commas = ConvertIdx(head + std::string(10'000'000, ',') + tail);
  EXPECT_EQ(CountStarting(commas, "TR "), 2);
  EXPECT_LT(commas.size(), 200u);
  const std::string letters = ConvertIdx(head + std::string(10'000'000, 'a') + tail);
  EXPECT_EQ(letters, "TR S  1 \r\nDKD \r\nTR T  1 \r\n");
}

// geoeasy-test.idx declares ANGULAR DMS: 18 set-ups with INST_HT 0.000000,
// each oriented on "2000"; 160 lines inside its SLOPE sections.
TEST(ConvertIdx, RealKeywordFile) {
  KAVU_SKIP_WITHOUT_REALDATA();
  const std::string book = ConvertIdx(RealData("geoeasy-test.idx"));
  const std::vector<std::string> lines = SplitLines(book);
  ASSERT_EQ(lines.size(), 18u + 18u + 160u);
  EXPECT_EQ(lines[0], "TR 1283  0 ");
  EXPECT_EQ(lines[1], "DKD 2000");
  EXPECT_EQ(CountStarting(book, "DKD 2000"), 18);
  EXPECT_EQ(CountStarting(book, "TR "), 18);
  // 17.573160 = 17 57 31.60; 91.032780 = 91 03 27.80; SD 0.
  EXPECT_EQ(lines[2], "2000    175732    0.000   910328      0");
  // 204 from 1283: 42 46 11.8 and 16.9418 x sin(90 44 11.7) = 16.940, as the
  // file's own coordinates of 204 (E 11.503488, N 12.435712) give: azimuth
  // 42 46 11.7, distance 16.9404.
  EXPECT_EQ(lines[6], "204     424612   16.940   904412      0");
  // 306 20 37.5 -> 38 (even); 97.2516 x sin(88 38 04.6) = 97.224, as from its
  // coordinates (E -78.311543, N 57.617702).
  EXPECT_NE(std::find(lines.begin(), lines.end(), "1095   3062038   97.224   883805      0"),
            lines.end());
  // An 8-digit station name whole.
  EXPECT_NE(std::find(lines.begin(), lines.end(), "TR 42433272  0 "), lines.end());
  // 318 19 58.20; 88 10 33.60.
  EXPECT_EQ(lines.back(), "2000   3181958    0.000   881034      0");
}

// The declared angle unit holds from its line on; DEG (or none) is decimal.
TEST(ConvertIdx, AngularUnitOfTheHeader) {
  const std::string block =
      "STN_ID \"S\"\nINST_HT 1;\n\n\n1,\"P\",1,17.573160,90.300000,10,1.5\nEND SLOPE\n";
  const std::string tr = "TR S  1 \r\nDKD P\r\n";
  EXPECT_EQ(ConvertIdx("ANGULAR\tDMS\n" + block),
            tr + "P       175732   10.000   903000    1.5\r\n");
  EXPECT_EQ(ConvertIdx("ANGULAR DMS\n" + block + "ANGULAR DEG\n" + block),
            tr + "P       175732   10.000   903000    1.5\r\n" + tr +
                "P       173423   10.000   901800    1.5\r\n");
}

}  // namespace
}  // namespace kavu::testing
