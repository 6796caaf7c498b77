#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

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

TEST(ConvertTcm, LookAheadAtTheEnds) {
  // The last record has no successor: a number-0 observation there orients.
  EXPECT_EQ(ConvertTcm("h\nST1         1.45\n" + Obs("0", "0", "0000", "DC02")).book,
            "TR ST1 1.45\r\nDKD DC02\r\n0              0    10.000    900000    1.50 DC02\r\n");
  // Before any set-up the reference is 0; a number-0 line followed by another
  // is skipped.
  EXPECT_EQ(ConvertTcm("h\n" + Obs("0", "1", "0000") + "\n" + Obs("0", "2", "0000")).book,
            "DKD \r\n0          20000    10.000    900000    1.50 \r\n");
  // Every written set-up sets the reference back to 0 (3" here): 1 00 00
  // stays 1 00 00.
  EXPECT_EQ(
      ConvertTcm("h\nA\n" + Obs("0", "0", "0003") + "\nB              1\n" + Obs("7", "1", "0000"))
          .book,
      "TR A 0.0\r\nDKD \r\n0          00003    10.000    900000    1.50 \r\n"
      "TR B 1\r\n7          10000    10.000    900000    1.50 \r\n");
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
}

TEST(ConvertTcm, BadInputEndsWithABoundedFieldBook) {
  // Lines shorter than the columns read: a set-up without height, an
  // observation with nothing after its point number.
  EXPECT_EQ(ConvertTcm("h\nS\n                         12").book,
            "TR S 0.0\r\nDKD \r\n12             0       0.0               0.0 \r\n");
  // Not numbers: readings without a value become "0" (and orient), the
  // distance and prism texts are copied.
  EXPECT_EQ(ConvertTcm("h\n" + std::string(25, ' ') + "     9 abc defg hij klmn" +
                       std::string(9, ' ') + "    x.yz   abc")
                .book,
            "DKD \r\n9              0      x.yz         0     abc \r\n");
  // A NUL inside a station name passes through.
  const std::string nul(1, '\0');
  EXPECT_EQ(ConvertTcm("h\nS" + nul + "T          1.5\n").book, "TR S" + nul + "T 1.5\r\n");
  // A 10 MB line is one record read by its columns.
  const std::string big = ConvertTcm("h\n" + std::string(10'000'000, 'x')).book;
  EXPECT_EQ(big, "TR xxxxxxxxxx xxxxxx\r\n");
}

}  // namespace
}  // namespace kavu::testing
