#include "core/tcvn3.h"

#include <gtest/gtest.h>

#include "core/messages.h"

namespace kavu {
namespace {

TEST(Tcvn3, EncodesTheProgramTexts) {
  // ổ 0xE6, ố 0xE8, ỗ 0xE7.
  EXPECT_EQ(Utf8ToTcvn3(msg::kTotalErrors), "T\xE6ng s\xE8 l\xE7i: ");
  // Đ 0xA7, ị 0xDE, í 0xDD.
  EXPECT_EQ(Utf8ToTcvn3("Địa chính"),
            "\xA7\xDE"
            "a ch\xDDnh");
  EXPECT_EQ(Utf8ToTcvn3("ĂÂÊÔƠƯĐăâêôơưđ"),
            "\xA1\xA2\xA3\xA4\xA5\xA6\xA7\xA8\xA9\xAA\xAB\xAC\xAD\xAE");
  EXPECT_EQ(Tcvn3ToUtf8(Utf8ToTcvn3(msg::kProgramTitle)), msg::kProgramTitle);
}

TEST(Tcvn3, CapitalsWithToneTakeTheLowercaseCode) {
  EXPECT_EQ(Utf8ToTcvn3("ỔÀẮĨŨỲ"), "\xE6\xB5\xBE\xDC\xF2\xFA");
  // Decomposed text: a vowel and its combining marks are joined; a stray mark is unknown.
  EXPECT_EQ(Utf8ToTcvn3("To\u0302\u0309ng A\u0301 U\u031B \u0301"), "T\xE6ng \xB8 \xA6 ?");
  EXPECT_EQ(Utf8ToTcvn3("\xC3\xB4\xCC\x89"), "\xE6");  // ô + hook
}

TEST(Tcvn3, AllLettersRoundTrip) {
  int letters = 0;
  for (int b = 0x80; b < 0x100; ++b) {
    const std::string byte(1, static_cast<char>(b));
    const std::string shown = Tcvn3ToUtf8(byte);
    const bool private_use =
        shown.size() == 3 && shown[0] == '\xEF' && (shown[1] == '\x9E' || shown[1] == '\x9F');
    if (!private_use) ++letters;
    EXPECT_EQ(Utf8ToTcvn3(shown), byte) << b;
  }
  EXPECT_EQ(letters, 75);
  EXPECT_EQ(Tcvn3ToUtf8("\xAF"), "\uF7AF");  // not VN3, kept as a raw byte
  EXPECT_EQ(Tcvn3ToUtf8("\xB0"), "\uF7B0");
  EXPECT_EQ(Tcvn3ToUtf8("A\x01"), "A\x01");
}

TEST(Tcvn3, UnknownOrInvalidBecomesQuestionMark) {
  EXPECT_EQ(Utf8ToTcvn3("€ ñ"), "? ?");
  EXPECT_EQ(Utf8ToTcvn3("a\xFF"
                        "b\xC3"),
            "a?b?");
  EXPECT_EQ(Utf8ToTcvn3("\xED\xA0\x80"), "???");  // a surrogate is not UTF-8
  EXPECT_EQ(Utf8ToTcvn3("\xC0\xAF"), "??");       // overlong
}

}  // namespace
}  // namespace kavu
