#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::TestData;

// codes.sdr holds every record code and the quirks: one name (the first
// description) for the 08CO and 08KI of one id, a blank-padded id (DKC__12),
// a coordinate record without X and Y (no control point), an observation
// between a set-up and its backsight record (a block without orientation), a
// point between the backsight record and the backsight itself, the backsight
// found through its description, the backsight observed twice (one
// orientation record), an empty 03NM, 8-decimal prism heights and "0.0"
// before any, a station label from its description, and a set-up whose
// backsight is never observed and has no circle reading (no orientation
// record). The expected book was checked line by line by hand.
// .gre files (kind 7) use the same set-up codes.
TEST(SdrConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 1).book, TestData("sdr/codes.asc"));
  EXPECT_EQ(ConvertSdr(TestData("sdr/codes.sdr"), 7).book, TestData("sdr/codes.asc"));
}

TEST(SdrConversion, SetUpCodesDependOnTheKind) {
  const std::string file =
      "02KI0001                              1.500\r\n"
      "07KI00010002\r\n"
      "09F100010002  10.000  90.000000 45.500000\r\n"
      "02TP0001                              1.500\r\n"
      "07TP00010002\r\n";
  EXPECT_EQ(ConvertSdr(file, 8).book,
            "TR DKC0001 1.500\r\nDKD DKC0002\r\n2       00000   10.000   900000    0.0 \r\n");
  // Kinds without set-up codes write the observations only.
  EXPECT_EQ(ConvertSdr(file, 3).book, "2      453000   10.000   900000    0.0 \r\n");
}

TEST(SdrConversion, ReadingsTurnToTheBacksightWithOneWrap) {
  const std::string file =
      "02TP0001                              1.500\r\n"
      "07TP00010002\r\n"
      "03NM1.5\r\n"
      "09F100010002  10.000  90.000000 45.500000\r\n"
      "09F100010003 100.000  90.000000 30.250000\r\n"
      "09F100010004 100.000  60.000000 -400.0000\r\n";
  const std::string book = ConvertSdr(file, 1).book;
  // 360 + 30.25 - 45.5 = 344.75; -400 - 45.5 + 360 stays negative after the
  // one wrap. 100 m at zenith 60 reduces to 86.603 m.
  EXPECT_NE(book.find("3     3444500  100.000   900000    1.5 \r\n"), std::string::npos) << book;
  EXPECT_NE(book.find("4     -853000   86.603   600000    1.5 \r\n"), std::string::npos) << book;
}

TEST(SdrConversion, IncompleteBlocksStillEnd) {
  // Ends right after a backsight record without circle reading: nothing
  // orients the set-up.
  EXPECT_EQ(ConvertSdr("02TP0001\r\n07TP00010002", 1).book, "TR DKC0001 0.0\r\n");
  // Ends inside a record: the short fields are empty (1 m at no zenith is 0).
  EXPECT_EQ(ConvertSdr("02TP0001\r\n07TP00010002\r\n09F100010002  1", 1).book,
            "TR DKC0001 0.0\r\nDKD DKC0002\r\n2       00000    0.000    00000    0.0 \r\n");
  EXPECT_EQ(ConvertSdr("", 1).book, "");
}

}  // namespace
}  // namespace kavu
