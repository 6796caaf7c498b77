#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::TestData;

// codes.obs: keyed-in points (coordinates as recorded, a nameless one
// dropped), an 08CO and a set-up with coordinates that are control points
// too, a point before its backsight (turned once the backsight is read), a
// backsight name longer than its 10-character column, targets 0012 and P7
// named as recorded, a blank distance, and a set-up whose backsight is never
// observed and has no circle reading (no orientation record).
// The expected book was checked line by line by hand.
TEST(ObsConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertObs(TestData("obs/codes.obs"), 2).book, TestData("obs/codes.asc"));
  // Without the Sokkia kind the set-up records are not read: control points
  // and bare detail records only.
  const std::string other = ConvertObs(TestData("obs/codes.obs"), 3).book;
  EXPECT_EQ(CountStarting(other, "TR "), 4);
  EXPECT_EQ(CountStarting(other, "DKD "), 0);
  EXPECT_EQ(testing::CountLines(other), 4 + 6);
}

TEST(ObsConversion, IncompleteBlocksStillEnd) {
  EXPECT_EQ(ConvertObs("02TP             ST1\r\n07TP             ST1", 2).book, "TR ST1 0.0\r\n");
  // A coordinate record without Y is not a control point.
  EXPECT_EQ(ConvertObs("08KI             ST1   1234", 2).book, "");
  EXPECT_EQ(ConvertObs("09F1", 2).book, "              00000    0.000    00000    0.0\r\n");
}

}  // namespace
}  // namespace kavu
