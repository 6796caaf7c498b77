// The converters against field books checked line by line by hand: the
// golden files of the SDR, Sokkia, SET, Topcom keyword and column files, and
// short recordings for the rules the golden files do not hold.
#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <vector>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

// codes.sdr: every record code and quirk (08CO and 08KI of one id, padded ids,
// blocks without orientation, the backsight found through its description or
// observed twice, prism heights before any); .gre files (kind 7) read alike.
TEST(SdrConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 1).book, TestData("sdr/codes.asc"));
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 7).book, TestData("sdr/codes.asc"));
}

// codes.obs: keyed-in and set-up points, a point before its backsight, a
// backsight name over its column, a blank distance, a backsight never observed.
TEST(ObsConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertObs(TestData("obs/codes.obs"), 2).book, TestData("obs/codes.asc"));
}

// codes.set: observations before and set-ups without observations, an
// orientation before any prism height, long targets and lines, the 360 wrap.
TEST(SetConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSet(TestData("set/codes.set")).book, TestData("set/codes.asc"));
}

// quirks.idx: header lines, faces 1 and 2, heights and prisms as written,
// names with blanks, blocks without END SLOPE; each block turned to its first
// shot.
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

// Gon and feet as declared: the backsight B at 0 and P at 100 gon (90
// degrees) on face 1, 10 ft (3.048 m) at a zenith of 100 gon; R on face 2 at
// 350 and 320 gon (315 and 288 degrees, reduced to 135 and 72), then on face 1
// at 150 and 79.9 gon (135 and 71.91 degrees): the mean zenith 71 57 18 turns
// the 10 ft slope into 2.898 m. Instrument and prism heights are in feet too.
TEST(ConvertIdx, DeclaredUnitsAndFaceTwo) {
  const std::string file =
      "ANGULAR GON\nLINEAR FEET\nSTN_ID \"S\"\nINST_HT 5;\n\n\n1,\"B\",1,0,100,10,1\n"
      "2,\"P\",1,100,100,10,1\n3,\"R\",1,350,320,10,1\n4,\"R\",1,150,79.9,10,1\n";
  EXPECT_EQ(
      ConvertIdx(file).book,
      "TR S  1.524 \r\nDKD B\r\nB        00000    3.048   900000  .3048\r\n"
      "P       900000    3.048   900000  .3048\r\nR      1350000    2.898   715718  .3048\r\n");
  EXPECT_EQ(ConvertIdx("ANGULAR RAD\n").report,
            std::vector<std::string>{"Khong hieu khai bao cua File: ANGULAR RAD"});
}

// An observation line: point number in 26-31, reading in 32-35 and 37-40,
// zenith in 41-44 and 46-49, distance 59-67, prism 68-73, description 75-84.
std::string Obs(std::string_view number, std::string_view deg, std::string_view mmss,
                std::string_view desc = "") {
  std::string line(25, ' ');
  line += std::string(6 - number.size(), ' ') + std::string(number);
  line += std::string(4 - deg.size(), ' ') + std::string(deg) + " " + std::string(mmss);
  line += "  90 0000         ";
  line += "   10.000";
  line += "  1.50 ";
  line += desc;
  return line;
}

// quirks.tcm: the header line, set-ups in a row or last, number-0 lines that
// orient, blank zenith, distance, prism and height, readings over 360 and
// turned across 0, TCVN3 descriptions.
TEST(ConvertTcm, GoldenEveryQuirk) {
  EXPECT_EQ(ConvertTcm(TestData("tcm/quirks.tcm")).book, TestData("tcm/quirks.asc"));
}

TEST(ConvertTcm, OrientationsAndShortLines) {
  // 360 00 00 turns to 0; a reading of 0 00 05 still orients, and 90 00 00
  // then turns to 89 59 55; column 74, run into, is no part of the description.
  std::string run_together = Obs("8", "90", "0000", "ABC");
  run_together[73] = '*';
  EXPECT_EQ(ConvertTcm("h\nA\n" + Obs("0", "0", "0000", "DC05") + "\n" + Obs("7", "360", "0000") +
                       "\nB\n" + Obs("1", "0", "0005", "DC06") + "\n" + run_together)
                .book,
            "TR A 0.0\r\nDKD DC05\r\n0              0    10.000    900000    1.50 DC05\r\n"
            "7          00000    10.000    900000    1.50 \r\nTR B 0.0\r\nDKD DC06\r\n"
            "1          00005    10.000    900000    1.50 DC06\r\n"
            "8         895955    10.000    900000    1.50 ABC\r\n");
  // Lines shorter than the columns read: a set-up without height, an
  // observation with nothing after its point number.
  EXPECT_EQ(ConvertTcm("h\nS\n                         12").book,
            "TR S 0.0\r\nDKD \r\n12             0       0.0               0.0 \r\n");
  // The header line read as none, though an observation follows it; not
  // numbers: readings without a value become "0" (and orient), the distance
  // and prism texts are copied.
  EXPECT_EQ(ConvertTcm("h\n" + std::string(25, ' ') + "     9 abc defg hij klmn" +
                       std::string(9, ' ') + "    x.yz   abc")
                .book,
            "DKD \r\n9              0      x.yz         0     abc \r\n");
}

}  // namespace
}  // namespace kavu::testing
