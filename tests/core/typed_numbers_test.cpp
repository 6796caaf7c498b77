#include "core/typed_numbers.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <vector>

namespace kavu {
namespace {

constexpr std::optional<double> kRefused = std::nullopt;

TEST(TypedNumber, ReadsPointOrCommaDecimalsAndNothingElse) {
  const std::vector<std::pair<std::string, std::optional<double>>> cases = {
      {"2.5", 2.5},        {"2,5", 2.5},        {" \t2,5 ", 2.5},  {"-1,25", -1.25},
      {"+3", 3},           {",5", 0.5},         {"5.", 5},         {"0012", 12},
      {"2,5,0", kRefused}, {"2.5,0", kRefused}, {"2 5", kRefused}, {"1e3", kRefused},
      {"", kRefused},      {" ", kRefused},     {".", kRefused},   {"-", kRefused},
      {"2mm", kRefused},   {"nan", kRefused},   {"inf", kRefused}, {"0x10", kRefused},
      {"--2", kRefused},   {"2.5\n", kRefused}};
  for (const auto& [text, value] : cases) EXPECT_EQ(ReadTypedNumber(text), value) << text;
}

TEST(TypedNumber, ReadsAScaleAsMapsAreLabelled) {
  const std::vector<std::pair<std::string, std::optional<double>>> cases = {
      {"500", 500},         {"1:500", 500},          {"1/500", 500},
      {" 1 : 2000 ", 2000}, {"1000.5", 1000.5},      {"1:5OO", kRefused},
      {"2:500", kRefused},  {":500", kRefused},      {"1:", kRefused},
      {"1::500", kRefused}, {"0", kRefused},         {"-500", kRefused},
      {"1:0", kRefused},    {"1.000", kRefused},     {"1:2,000", kRefused},
      {"1,5", 1.5},         {"1:500 000", kRefused}, {"1", 1}};
  for (const auto& [text, value] : cases) EXPECT_EQ(ReadTypedScale(text), value) << text;
}

// The first box that cannot be read is named, with its text as typed; the
// decimals are rounded ties to even and held to 0-10.
TEST(TypedNumber, ReadsTheRunsNumbersOrNamesTheFirstRefusedBox) {
  struct Case {
    std::string scale, height, decimals;
    std::optional<TypedBox> refused;
    double wantScale = 0, wantHeight = 0;
    int wantDecimals = 0;
  };
  const std::vector<Case> cases = {
      {"1:500", "2,5", "3", std::nullopt, 500, 2.5, 3},
      {"1000", "2.0", "2", std::nullopt, 1000, 2, 2},
      {"500", "1", "2.5", std::nullopt, 500, 1, 2},
      {"500", "1", "3,5", std::nullopt, 500, 1, 4},
      {"500", "1", "-4", std::nullopt, 500, 1, 0},
      {"500", "1", "99", std::nullopt, 500, 1, 10},
      {"1:5OO", "x", "y", TypedBox::Scale},
      {"500", "0", "y", TypedBox::TextHeight},
      {"500", "-2", "2", TypedBox::TextHeight},
      {"500", "2", "two", TypedBox::HeightDecimals},
  };
  for (const Case& c : cases) {
    const TypedRunNumbersRead read = ReadRunNumbers(c.scale, c.height, c.decimals);
    if (c.refused) {
      ASSERT_FALSE(read.numbers) << c.scale;
      EXPECT_EQ(read.refused, *c.refused) << c.scale;
      continue;
    }
    ASSERT_TRUE(read.numbers) << c.scale << ' ' << c.height << ' ' << c.decimals;
    EXPECT_EQ(read.numbers->scale, c.wantScale);
    EXPECT_EQ(read.numbers->textHeight, c.wantHeight);
    EXPECT_EQ(read.numbers->heightDecimals, c.wantDecimals);
  }
  EXPECT_EQ(TypedRefusalMessage(ReadRunNumbers("1:5OO", "2", "2")),
            "Tỷ lệ bản đồ không đọc được: 1:5OO");
  EXPECT_EQ(TypedRefusalMessage(ReadRunNumbers("500", " 2,5,0", "2")),
            "Chiều cao chữ không đọc được:  2,5,0");
}

}  // namespace
}  // namespace kavu
