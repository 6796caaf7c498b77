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

// codes.sdr holds every record code and the quirks: one name (the first
// description) for the 08CO and 08KI of one id, a blank-padded id (DKC__12),
// a coordinate record without X and Y (no control point), an observation
// between a set-up and its backsight record (a block without orientation), a
// point between the backsight record and the backsight itself, the backsight
// found through its description, the backsight observed twice (one
// orientation record), an empty 03NM, 8-decimal prism heights and "0.0"
// before any, a station label from its description, and a set-up whose
// backsight is never observed and has no circle reading (no orientation
// record). .gre files (kind 7) use the same set-up codes.
TEST(SdrConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 1).book, TestData("sdr/codes.asc"));
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 7).book, TestData("sdr/codes.asc"));
}

// codes.obs: keyed-in points (coordinates as recorded, a nameless one
// dropped), an 08CO and a set-up with coordinates that are control points
// too, a point before its backsight (turned once the backsight is read), a
// backsight name longer than its 10-character column, targets 0012 and P7
// named as recorded, a blank distance, and a set-up whose backsight is never
// observed and has no circle reading (no orientation record).
TEST(ObsConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertObs(TestData("obs/codes.obs"), 2).book, TestData("obs/codes.asc"));
}

// codes.set: an observation before any set-up (skipped), two set-ups in a
// row (the second counts), an orientation before any prism height ("0.0"), a
// 9-character target (kept whole), an 8-decimal prism height, a set-up
// without coordinates (no control point), an orientation coded like its
// station (named by its identifier all the same), a line longer than 100
// characters, and a set-up at the end with no observation; readings turned
// to the orientation, once with the 360 wrap. Points are named by their
// identifiers.
TEST(SetConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSet(TestData("set/codes.set")).book, TestData("set/codes.asc"));
}

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

// Checked by hand. The header line is skipped though it looks like a set-up;
// ST0 followed by ST1 is dropped; number 0 at 0 00 00 orients ST1 and its
// column shows the recorded "0"; a 2-character description is dropped; a
// blank zenith stays blank (the run reports the record), blank distance and
// prism give "0.0"; 360 30 00 turns to
// 0 30 00; a blank height gives "0.0"; two number-0 lines in a row: the first
// is skipped, the second (0 00 02) orients; a reading of 0 00 04 orients a
// point numbered 5, and 0 00 06 after it turns to 2"; 10 00 00 after an
// orientation at 350 00 00 becomes 20 00 00; TCVN3 bytes and an inner blank
// of a description pass through; a set-up as the last record is written.
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
