#include "core/numbers.h"

#include <gtest/gtest.h>

#include <charconv>
#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include "core/random.h"

namespace kavu {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

// The numeric prefix, blanks inside it ignored (value, whether it has a digit).
TEST(Val, ReadsTheNumericPrefixSkippingBlanks) {
  const std::vector<std::tuple<std::string, double, bool>> cases = {
      {" -1 2.5e1x", -125, true},
      {"\t 3\n4", 34, true},
      {"+7", 7, true},
      {"-.5", -0.5, true},
      {"1.2.3", 1.2, true},
      {"1D2", 100, true},
      {"1 e -2", 0.01, true},
      {"1e", 1, true},
      {"12,5", 12, true},
      {"abc", 0, false},
      {"", 0, false},
      {"1e400", 0, true},
      {std::string(400, '9'), 0, true},
      {" -0", 0, true},
      {".", 0, false},
      {"-e5", 0, false},
      {"0.9007199254740993", 0.9007199254740993, true}};
  for (const auto& [text, value, digit] : cases) {
    EXPECT_EQ(Val(text), value) << text;
    EXPECT_EQ(HasNumber(text), digit) << text;
  }
}

// Ties to even (RoundEven(x, n) = RoundEvenWhole(x * 10^n) / 10^n), Fix
// toward zero.
TEST(Rounding, TiesGoToEven) {
  const std::vector<std::tuple<double, int, double>> cases = {
      {2.5, 0, 2},
      {3.5, 0, 4},
      {-2.5, 0, -2},
      {-0.5, 0, 0},
      {-1.5, 0, -2},
      {0.125, 2, 0.12},
      {0.375, 2, 0.38},
      {1.26, 1, 1.3},
      {1e300, 2, 1e300},  // beyond 2^52 left unchanged
      {2345678.0625, 3, 2345678.062}};
  for (const auto& [x, n, rounded] : cases) EXPECT_EQ(RoundEven(x, n), rounded) << x << " " << n;
  EXPECT_EQ(Fix(-1.7), -1);
  EXPECT_EQ(Fix(1.7), 1);
}

// Masks: half away from zero, "0" digits always, "#" only when significant,
// no minus on a zero result; beyond 2^53 the value's own decimal expansion;
// no number at all reads back as none.
TEST(Mask, HalvesAwayFromZeroAndOptionalDigits) {
  const std::vector<std::tuple<double, std::string, std::string>> cases = {
      {0.5, "####.000", ".500"},
      {-0.0004, "####.000", ".000"},
      {2.5, "##0", "3"},
      {-2.5, "##0", "-3"},
      {5, "00", "05"},
      {123, "00", "123"},
      {450, "0000000", "0000450"},
      {0, "#######", ""},
      {0.0005, "####0.000", "0.001"},
      {-12.3456, "#######.000", "-12.346"},
      {1e20, "#######.000", "100000000000000000000.000"},
      {-9007199254740993.0, "##0", "-9007199254740992"},
      {0x1p70, "0.00", "1180591620717411303424.00"},
      {1.5e17, "####.0#", "150000000000000000.0"},
      {kNaN, "##0", "***"},
      {-kInf, "####.000", "********"}};
  for (const auto& [x, mask, text] : cases) EXPECT_EQ(Mask(x, mask), text) << x << " " << mask;
}

TEST(NumberText, FifteenDigitsAndNoLeadingZero) {
  const std::vector<std::pair<double, std::string>> cases = {
      {3, "3"},
      {0, "0"},
      {-0.0, "0"},
      {0.05, ".05"},
      {-0.12, "-.12"},
      {0.1 + 0.2, ".3"},
      {0.0001, ".0001"},
      {1e-5, "1E-05"},
      {1e14, "100000000000000"},
      {1e15, "1E+15"},
      {1.5e20, "1.5E+20"},
      {123456789012345678.0, "1.23456789012346E+17"},
      {-2345678.125, "-2345678.125"}};
  for (const auto& [x, text] : cases) EXPECT_EQ(NumberText(x), text) << x;
  EXPECT_EQ(ReportNumber(-0.0), " 0 ");
  EXPECT_EQ(ReportNumber(-0.12), "-.12 ");
}

// The in-place forms write exactly what the reference rules write: over a
// table of corner values (ties, zeros of both signs, the 2^53 edge, values
// that are no numbers) with every mask the products use, and over a seeded
// sweep of coordinates, heights and angles; plain numbers read as the full
// conversion reads them.
TEST(Mask, InPlaceFormsWriteWhatTheReferenceWrites) {
  constexpr std::string_view kMasks[] = {"#######.000", "######.000", "#####.000", "####.000",
                                         "##0",         "00",         "0000000",   "#######",
                                         "####0.000",   "####.0#",    "0.00"};
  std::vector<double> values = {0,      -0.0,   0.5,          -0.5,      2.5,    -2.5,
                                0.0005, 0.125,  1234.5678,    1e20,      0x1p53, 0x1p53 - 1,
                                1e300,  5e-324, 9999999.9995, 0.1 + 0.2, kNaN,   kInf};
  SplitMix64 rng(2026);
  for (int i = 0; i < 20000; ++i) {
    values.push_back((rng.Next() - 0.3) * (i % 3 == 0 ? 1e7 : i % 3 == 1 ? 1e3 : 400));
    values.push_back(std::round(values.back() * 1000) / 1000);
  }
  for (const double x : values) {
    for (const std::string_view text : kMasks) {
      std::string out = "x";
      AppendMask(out, x, ReadMask(text));
      ASSERT_EQ(out, "x" + Mask(x, text)) << x << " " << text;
    }
    std::string number;
    AppendReportNumber(number, x);
    ASSERT_EQ(number, ReportNumber(x)) << x;
    if (std::isfinite(x)) {
      ASSERT_EQ(MillimetreValue(x), Val(Mask(x, "#.000"))) << x;
    }
    const std::string plain = Mask(x, "0.000");
    double expected = 0;
    std::from_chars(plain.data(), plain.data() + plain.size(), expected);
    if (std::isfinite(x) && std::fabs(x) < 1e11) {
      ASSERT_EQ(Val(plain), expected) << plain;
    }
  }
}

TEST(SplitMix64, MatchesTheReferenceSequence) {
  // First output of SplitMix64 seeded with 0 is 0xE220A8397B1DCDAF.
  SplitMix64 rng(0);
  EXPECT_EQ(rng.Next(), static_cast<double>(0xE220A8397B1DCDAFULL >> 11) * 0x1.0p-53);
}

}  // namespace
}  // namespace kavu
