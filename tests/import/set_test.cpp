#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::TestData;

// codes.set: an observation before any set-up (skipped), two set-ups in a
// row (the second counts), an orientation before any prism height ("0.0"), a
// 9-character target (kept whole), an 8-decimal prism height, a set-up
// without coordinates (no control point), an orientation coded like its
// station (named by its identifier all the same), a line longer than 100
// characters, and a set-up at the end with no observation; readings turned
// to the orientation, once with the 360 wrap. Points are named by their
// identifiers. The expected book was checked
// line by line by hand.
TEST(SetConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSet(TestData("set/codes.set")).book, TestData("set/codes.asc"));
}

TEST(SetConversion, IncompleteScratchDataStillEnds) {
  // Only observations: nothing. Only a set-up: its control point.
  EXPECT_EQ(ConvertSet("09F1\r\n09F1").book, "");
  EXPECT_EQ(ConvertSet("02TP               1             1.0             2.0").book,
            "TR 1         1.0         2.0           \r\n");
  // A set-up followed by a bare observation line.
  EXPECT_EQ(ConvertSet("02TP               1\r\n09F1").book,
            "TR 1 0.0\r\nDKD \r\n              0    0.000    00000    0.0 \r\n");
}

}  // namespace
}  // namespace kavu
