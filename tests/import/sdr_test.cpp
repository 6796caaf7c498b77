#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::RealData;
using testing::TestData;

// codes.sdr holds every record code and the quirks: 08CO winning over 08KI of
// the same id, a blank-padded id (DKC  12), a coordinate record without X and
// Y (no control point), an observation before any set-up, a point between the
// backsight record and the backsight itself, the backsight found through its
// description, the backsight observed twice, an empty 03NM, 8-decimal prism
// heights, a station label from its description, and a set-up whose backsight
// is never observed. The expected book was checked line by line by hand.
// .gre files (kind 7) use the same set-up codes.
TEST(SdrConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 1), TestData("sdr/codes.asc"));
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 7), TestData("sdr/codes.asc"));
}

TEST(SdrConversion, SetUpCodesDependOnTheKind) {
  const std::string file =
      "02KI0001                              1.500\r\n"
      "07KI00010002\r\n"
      "09F100010002  10.000  90.000000 45.500000\r\n"
      "02TP0001                              1.500\r\n"
      "07TP00010002\r\n";
  EXPECT_EQ(ConvertSdr(file, 8),
            "TR DKC0001 1.500\r\nDKD DKC0002\r\n2       00000   10.000   900000 \r\n");
  // Kinds without set-up codes write the observations only.
  EXPECT_EQ(ConvertSdr(file, 3), "2      453000   10.000   900000 \r\n");
}

TEST(SdrConversion, ReadingsTurnToTheBacksightWithOneWrap) {
  const std::string file =
      "02TP0001                              1.500\r\n"
      "07TP00010002\r\n"
      "03NM1.5\r\n"
      "09F100010002  10.000  90.000000 45.500000\r\n"
      "09F100010003 100.000  90.000000 30.250000\r\n"
      "09F100010004 100.000  60.000000 -400.0000\r\n";
  const std::string book = ConvertSdr(file, 1);
  // 360 + 30.25 - 45.5 = 344.75; -400 - 45.5 + 360 stays negative after the
  // one wrap. 100 m at zenith 60 reduces to 86.603 m.
  EXPECT_NE(book.find("3     3444500  100.000   900000    1.5 \r\n"), std::string::npos) << book;
  EXPECT_NE(book.find("4     -853000   86.603   600000    1.5 \r\n"), std::string::npos) << book;
}

TEST(SdrConversion, IncompleteBlocksStillEnd) {
  // Ends right after the backsight record: station and orientation records.
  EXPECT_EQ(ConvertSdr("02TP0001\r\n07TP00010002", 1), "TR DKC0001 0.0\r\nDKD DKC0002\r\n");
  // Ends inside a record: the short fields are empty (1 m at no zenith is 0).
  EXPECT_EQ(ConvertSdr("02TP0001\r\n07TP00010002\r\n09F100010002  1", 1),
            "TR DKC0001 0.0\r\nDKD DKC0002\r\n2       00000    0.000    00000 \r\n");
  EXPECT_EQ(ConvertSdr("", 1), "");
}

TEST(SdrRealData, Sdr2xJobWithFourCharacterIds) {
  KAVU_SKIP_WITHOUT_REALDATA();
  const std::string book = ConvertSdr(RealData("barnes-example.sdr"), 1);
  EXPECT_EQ(CountStarting(book, "TR "), 5);
  EXPECT_EQ(CountStarting(book, "DKD "), 5);
  EXPECT_EQ(testing::CountLines(book), 5 + 5 + 79);  // every 09F1 record
  EXPECT_TRUE(
      book.starts_with("TR DKC0001 1.59500000\r\nDKD DKC9999\r\n"
                       "9999    00000   28.950   901630 1.47400000 \r\n"));
  // 105.372222 - 104.975000 = 0.397222 degrees; the note passes through.
  EXPECT_NE(book.find("1029    02350    0.000   904330 1.47400000 CONF-FIT\r\n"),
            std::string::npos);
  // 139.97 m at 89.8333333 degrees: 139.969 m; 336.491666 - 309.452777.
  EXPECT_NE(book.find("TR DKC0004 1.60100000\r\nDKD DKC0003\r\n"
                      "3       00000  139.969   895000 1.47400000 \r\n"
                      "1069   270220    0.000   894710 1.47400000 \r\n"),
            std::string::npos);
  EXPECT_TRUE(testing::AllLinesCrLf(book));
}

TEST(SdrRealData, CollectorJobWithOtherSetUpCodesEnds) {
  KAVU_SKIP_WITHOUT_REALDATA();
  // Its set-ups are 02KI/07KI with 16-character fields: as an .sdr it yields
  // control points and observations but no station.
  const std::string book = ConvertSdr(RealData("geoeasy-focus6-1.sdr"), 1);
  EXPECT_EQ(CountStarting(book, "TR "), 3);
  EXPECT_EQ(CountStarting(book, "DKD "), 0);
  EXPECT_EQ(testing::CountLines(book), 3 + 17);
}

}  // namespace
}  // namespace kavu
