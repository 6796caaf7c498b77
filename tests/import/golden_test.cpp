// The SDR, Sokkia and SET converters against field books checked line by line
// by hand.
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
  // Without the Sokkia kind the set-up records are not read: control points
  // and bare detail records only.
  const std::string other = ConvertObs(TestData("obs/codes.obs"), 3).book;
  EXPECT_EQ(CountStarting(other, "TR "), 4);
  EXPECT_EQ(CountStarting(other, "DKD "), 0);
  EXPECT_EQ(testing::CountLines(other), 4 + 6);
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

}  // namespace
}  // namespace kavu
