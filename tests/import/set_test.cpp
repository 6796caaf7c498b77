#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::RealData;
using testing::TestData;

// codes.set: an observation before any set-up (skipped), two set-ups in a
// row (the second counts, its label DKC7), an orientation without prism
// height (blank), a 9-character target (first 5 kept), an 8-decimal prism
// height, a set-up without coordinates (no control point), an orientation
// coded like its station (DKC + columns 32-36), a line longer than 100
// characters, and a set-up at the end with no observation; readings turned
// to the orientation, once with the 360 wrap. The expected book was checked
// line by line by hand.
TEST(SetConversion, MatchesHandCheckedBookByteForByte) {
  EXPECT_EQ(ConvertSet(TestData("set/codes.set")), TestData("set/codes.asc"));
}

TEST(SetConversion, IncompleteScratchDataStillEnds) {
  // Only observations: nothing. Only a set-up: its control point.
  EXPECT_EQ(ConvertSet("09F1\r\n09F1"), "");
  EXPECT_EQ(ConvertSet("02TP               1             1.0             2.0"),
            "TR DKC1         1.0         2.0                  \r\n");
  // A set-up followed by a bare observation line.
  EXPECT_EQ(ConvertSet("02TP               1\r\n09F1"),
            "TR DKC1         0.0\r\nDKD DKC         \r\n"
            "0             0    0.000    00000        DKC         \r\n");
}

TEST(SetRealData, SetJobWithOneSetUp) {
  KAVU_SKIP_WITHOUT_REALDATA();
  const std::string book = ConvertSet(RealData("geoeasy-20151130.set"));
  EXPECT_TRUE(
      book.starts_with("TR DKCSTLEV     6594.363000 15102.1060 163.403000\r\n"
                       "TR DKCSTLEV     0.90000000\r\nDKD DKCRYSHA    \r\n"
                       "0             0    0.000   801717 0.00000000 DKCRYSHA    \r\n"));
  EXPECT_EQ(CountStarting(book, "TR "), 2);
  EXPECT_EQ(testing::CountLines(book), 3 + 21);  // the orientation and 20 points
  // 210.14861111 - 202.45805556 = 7.69055555; 82.227 m at 119.35166667.
  EXPECT_NE(book.find("1000      74126   71.671  1192106 0.00000000             \r\n"),
            std::string::npos);
}

TEST(SetRealData, SetUpWithoutObservationsLeavesItsControlPoint) {
  KAVU_SKIP_WITHOUT_REALDATA();
  EXPECT_EQ(ConvertSet(RealData("tops-sokkia_sdr33.set")),
            "TR DKC00000     509.9700000 937.274000 20.0530000\r\n");
}

}  // namespace
}  // namespace kavu
