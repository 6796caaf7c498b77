#include "core/text.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "core/angles.h"
#include "core/lines.h"
#include "tests/support.h"

namespace kavu {
namespace {

TEST(Text, TrimTouchesOnlySpaces) {
  EXPECT_EQ(Trim("  \ta b\t  "), "\ta b\t");
  EXPECT_EQ(Upper("akt\xB5z"), "AKT\xB5Z");
  EXPECT_EQ(FixedWidth("abcdefg", 5), "abcde");
  FixedText<12> name;
  name = "DC05";
  EXPECT_EQ(name.str(), "DC05        ");
}

// RString and LString decide on the untrimmed length and pad the trimmed
// text; a text as long as the width or longer is returned as it stands.
TEST(Text, AlignDecidesOnUntrimmedLengthAndNeverCuts) {
  struct Case {
    const char* text;
    int width;
    const char* right;
    const char* left;
  };
  for (const Case& c : {Case{"ab", 5, "   ab", "ab   "}, Case{"ab  ", 5, "   ab", "ab   "},
                        Case{" ab ", 5, "   ab", "ab   "}, Case{"ab  ", 4, "ab  ", "ab  "},
                        Case{"  ab", 4, "  ab", "  ab"}, Case{"abcdef", 4, "abcdef", "abcdef"},
                        Case{"", 3, "   ", "   "}, Case{"ab", -1, "ab", "ab"}}) {
    EXPECT_EQ(RString(c.text, c.width), c.right) << "'" << c.text << "' " << c.width;
    EXPECT_EQ(LString(c.text, c.width), c.left) << "'" << c.text << "' " << c.width;
  }
}

TEST(Text, KTraCCGFlagsOtherCharactersThanDigitsAndPoint) {
  for (const char* t : {" 1.55 ", "", "007"}) EXPECT_EQ(KTraCCG(t), 0) << t;
  for (const char* t : {"1,55", "-1", "M12", "1 2"}) EXPECT_EQ(KTraCCG(t), 1) << t;
}

TEST(Angles, TextFormsRoundTheHalfSecondToEven) {
  AngleParts parts;
  EXPECT_EQ(GocStringText(123.7584722, &parts), " 123 45 30");
  EXPECT_EQ(parts.do1, 123);
  EXPECT_EQ(parts.phut, 45);
  EXPECT_EQ(parts.giay, 30);
  EXPECT_EQ(GocStringText(5.0691666667), "   5 04 09");
  EXPECT_EQ(GocStringText(-12.5), " -12 30 00");
  EXPECT_EQ(GocStringText(359.99999), "   0 00 00");  // carry wraps 360 to 0
  EXPECT_EQ(GocStringText(1000), " 640 00 00");       // 360 taken off once only
  EXPECT_EQ(GocStringText(-0.00001), "  -0 00 00");
  // Rounded twice: to a tenth, then to the even second (31.46 -> 31.5 -> 32).
  EXPECT_EQ(GocStringText(123 + 45 / 60.0 + 31.46 / 3600), " 123 45 32");
  EXPECT_EQ(GocStringText(123 + 45 / 60.0 + 30.46 / 3600), " 123 45 30");
  EXPECT_EQ(GocStringText(-(5 + 59 / 60.0 + 59.96 / 3600)), "  -6 00 00");
  EXPECT_EQ(GocStringText(5 + 59 / 60.0 + 59.5 / 3600), "   6 00 00");  // 60" then 60'

  EXPECT_EQ(GocSt(359.99999), "    00000");
  EXPECT_EQ(GocSt(-12.5), "  -123000");
  EXPECT_EQ(GocSt1(5.0691666667), "  5 04 09");
  EXPECT_EQ(GocSt1(-123.7584722), "-123 45 30");  // 10 characters, not cut
}

TEST(Lines, EveryLineEndCounts) {
  using V = std::vector<std::string>;
  EXPECT_EQ(SplitLines("a\r\nb\rc\nd"), (V{"a", "b", "c", "d"}));
  EXPECT_EQ(SplitLines("a\r\n"), (V{"a"}));
  EXPECT_EQ(SplitLines("a\n\nb\n"), (V{"a", "", "b"}));
  EXPECT_EQ(SplitLines("a\r\r\n"), (V{"a", ""}));
  EXPECT_EQ(SplitLines("\r\n"), (V{""}));
  EXPECT_TRUE(SplitLines("").empty());
}

// Nothing is in place before commit; an output abandoned, or dropped
// unfinished, leaves the earlier file and no temporary one; a file that cannot
// be made swallows its lines and fails.
TEST(Lines, TextOutWritesCrLfAndReportsFailure) {
  const auto dir = testing::FreshFolder();
  TextOut out(dir / "a.txt");
  out.Line("x");
  out.Buffer() += "y";
  out.EndLine();
  EXPECT_FALSE(std::filesystem::exists(dir / "a.txt"));
  EXPECT_TRUE(out.commit());
  EXPECT_EQ(ReadLines(dir / "a.txt"), (std::optional<std::vector<std::string>>({"x", "y"})));
  EXPECT_FALSE(ReadFileBytes(dir));
  for (bool explicitly : {true, false}) {
    TextOut half(dir / "a.txt");
    half.Line("half");
    EXPECT_TRUE(half.finish());
    if (explicitly) half.abandon();
  }
  EXPECT_EQ(ReadFileBytes(dir / "a.txt"), std::optional<std::string>("x\r\ny\r\n"));
  EXPECT_FALSE(std::filesystem::exists(TempPathOf(dir / "a.txt")));
  TextOut bad(dir / "no" / "such" / "b.txt");
  bad.Line("swallowed");
  EXPECT_FALSE(bad.commit());
}

}  // namespace
}  // namespace kavu
