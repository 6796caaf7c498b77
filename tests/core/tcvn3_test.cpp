#include "core/tcvn3.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>

#include "core/messages.h"

namespace kavu {
namespace {

// The letters of TCVN 5712:1993 (VN3) by the standard's rows, written here as
// the letters themselves: the vowels with grave, hook, tilde, acute and dot
// below, and the letters without tone. Both directions.
TEST(Tcvn3, LettersOfTheStandard) {
  struct Row {
    unsigned first;
    const char* letters;  // UTF-8, one letter per consecutive byte
  };
  const Row rows[] = {
      {0xA1, "ĂÂÊÔƠƯĐăâêôơưđ"},  {0xB5, "àảãáạ"},          {0xBB, "ằẳẵắ"},
      {0xC6, "ặầẩẫấậè"},         {0xCE, "ẻẽéẹềểễếệìỉ"},    {0xDC, "ĩíịò"},
      {0xE1, "ỏõóọồổỗốộờởỡớợù"}, {0xF1, "ủũúụừửữứựỳỷỹýỵ"},
  };
  int count = 0;
  for (const Row& row : rows) {
    std::string_view letters = row.letters;
    for (unsigned byte = row.first; !letters.empty(); ++byte, ++count) {
      const std::size_t size = static_cast<unsigned char>(letters[0]) >= 0xE0 ? 3 : 2;
      const std::string letter(letters.substr(0, size));
      letters.remove_prefix(size);
      const std::string code(1, static_cast<char>(byte));
      EXPECT_EQ(Utf8ToTcvn3(letter), code) << letter;
      EXPECT_EQ(Tcvn3ToUtf8(code), letter) << std::hex << byte;
    }
  }
  EXPECT_EQ(count, 74);
  // A capital with a tone mark has no code: the lowercase one stands for it.
  EXPECT_EQ(Utf8ToTcvn3("ÀẢÃÁẠỲỶỸÝỴỔẮĨŨ"),
            "\xB5\xB6\xB7\xB8\xB9\xFA\xFB\xFC\xFD\xFE\xE6\xBE\xDC\xF2");
}

TEST(Tcvn3, ProgramTextsAndDecomposedMarks) {
  EXPECT_EQ(Utf8ToTcvn3(msg::kTotalErrors), "T\xE6ng s\xE8 l\xE7i: ");
  EXPECT_EQ(Tcvn3ToUtf8(Utf8ToTcvn3(msg::kProgramTitle)), msg::kProgramTitle);
  // A vowel and its combining marks are joined; a stray mark is unknown.
  EXPECT_EQ(Utf8ToTcvn3("To\u0302\u0309ng A\u0301 U\u031B \u0301 e\u0303"),
            "T\xE6ng \xB8 \xA6 ? \xCF");
  EXPECT_EQ(Utf8ToTcvn3("a\u0302\u0303a\u0302\u0301o\u031Ba\u0306\u0323"), "\xC9\xCA\xAC\xC6");
}

TEST(Tcvn3, OtherBytesAndInvalidText) {
  // A byte that is no VN3 letter travels as a private-use character and back.
  for (const char* raw : {"\xAF", "\xB0", "\x80"}) {
    EXPECT_EQ(Utf8ToTcvn3(Tcvn3ToUtf8(raw)), raw);
  }
  EXPECT_EQ(Tcvn3ToUtf8("\xAF"), "\uF7AF");
  EXPECT_EQ(Tcvn3ToUtf8("A\x01"), "A\x01");
  EXPECT_EQ(Utf8ToTcvn3("€ ñ"), "? ?");
  EXPECT_EQ(Utf8ToTcvn3("a\xFF"
                        "b\xC3"),
            "a?b?");
  EXPECT_EQ(Utf8ToTcvn3("\xED\xA0\x80"), "???");  // a surrogate is not UTF-8
  EXPECT_EQ(Utf8ToTcvn3("\xC0\xAF"), "??");       // overlong
}

}  // namespace
}  // namespace kavu
