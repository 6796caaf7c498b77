#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::RealData;
using testing::TestData;

// codes.obs: keyed-in points (X with 7 digits keeps 3 decimals, Y with 7
// keeps 2, a nameless one is dropped), an 08CO that writes nothing, a point
// before its backsight (turned once the backsight is read), a backsight name
// longer than its 10-character column, targets 0012 and P7 that are not plain
// numbers, a blank distance, and a set-up whose backsight is never observed.
// The expected book was checked line by line by hand.
TEST(ObsConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertObs(TestData("obs/codes.obs"), 2), TestData("obs/codes.asc"));
  // Without the Sokkia kind the set-up records are not read: control points
  // and bare detail records only.
  const std::string other = ConvertObs(TestData("obs/codes.obs"), 3);
  EXPECT_EQ(CountStarting(other, "TR "), 2);
  EXPECT_EQ(CountStarting(other, "DKD "), 0);
  EXPECT_EQ(testing::CountLines(other), 2 + 6);
}

// A reduced distance is rounded with ties to even (0.0625 m at a level sight
// gives 0.062), while coordinates go through their mask, half away from zero
// (0.0625 gives .063).
TEST(ObsConversion, DistancesRoundToEvenCoordinatesHalfAway) {
  EXPECT_EQ(ConvertObs("08KI             ST1          0.0625          1.0625\r\n"
                       "09F1                           3          0.0625              90\r\n",
                       2),
            "TR ST1          .063        1.063     \r\n"
            "3             00000    0.062   900000    0.0\r\n");
}

TEST(ObsConversion, IncompleteBlocksStillEnd) {
  EXPECT_EQ(ConvertObs("02TP             ST1\r\n07TP             ST1", 2),
            "TR ST1          0.0\r\nDKD             \r\n");
  EXPECT_EQ(ConvertObs("08KI             ST1   1234", 2),
            "TR ST1          1234.000    .000      \r\n");
  EXPECT_EQ(ConvertObs("09F1", 2), "              00000    0.000    00000    0.0\r\n");
}

TEST(ObsRealData, Sdr33JobWithSixteenCharacterFields) {
  KAVU_SKIP_WITHOUT_REALDATA();
  const std::string book = ConvertObs(RealData("geoeasy-20151125.obs"), 2);
  // Its known points are all computed (08CO): no control-point records.
  EXPECT_TRUE(
      book.starts_with("TR STLEV        0.90000000\r\nDKD KRYSHA      \r\n"
                       "0000          00000    0.000   801608 0.00000000 KRYSHA    \r\n"));
  EXPECT_EQ(CountStarting(book, "TR "), 1);
  EXPECT_EQ(testing::CountLines(book), 2 + 14);
  // 212.36416667 - 201.27666667 = 11.0875; 79.323 m at 122.85694444 degrees.
  EXPECT_NE(book.find("0000         110515   66.634  1225125 0.00000000 0004      \r\n"),
            std::string::npos);
  EXPECT_TRUE(testing::AllLinesCrLf(book));
}

}  // namespace
}  // namespace kavu
