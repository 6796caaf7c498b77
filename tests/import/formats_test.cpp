#include "import/formats.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

namespace kavu {
namespace {

std::string FileText(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

// The kinds keep their indices, names, patterns and list texts: settings and
// scripts store the index, the window shows the text.
TEST(Formats, TheKindsKeepTheirIndicesAndPatterns) {
  const std::vector<std::string> names = {"asc", "sdr", "obs", "set", "raw",
                                          "idx", "tcm", "gre", "dn7", "other"};
  const auto formats = Formats();
  ASSERT_EQ(formats.size(), names.size());
  for (std::size_t k = 0; k < names.size(); ++k) {
    const int index = static_cast<int>(k);
    EXPECT_EQ(formats[k].name, names[k]);
    EXPECT_EQ(FormatIndexOf(names[k]), index);
    EXPECT_EQ(FormatIndexOf(std::to_string(k)), index);
    const std::string pattern = k + 1 < names.size() ? "*." + names[k] : "*.*";
    EXPECT_EQ(PatternOfKind(index), pattern);
    EXPECT_TRUE(formats[k].listText.ends_with("[" + pattern + "]")) << formats[k].listText;
    if (k + 1 < names.size()) {
      EXPECT_EQ(KindOfExtension(formats[k].extension), index);
    }
  }
  EXPECT_EQ(formats[1].listText, "Số liệu FieldBook SDR     [*.sdr]");
  EXPECT_EQ(LastFormatIndex(), 9);
  // Converted kinds: 1, 2, 3, 5, 6, 7.
  std::vector<int> converted;
  for (std::size_t k = 0; k < formats.size(); ++k) {
    if (formats[k].convert != nullptr) converted.push_back(static_cast<int>(k));
  }
  EXPECT_EQ(converted, (std::vector<int>{1, 2, 3, 5, 6, 7}));
  for (const char* refused : {"", "10", "-1", "SDR", "sdr ", "1x", "auto"}) {
    EXPECT_EQ(FormatIndexOf(refused), std::nullopt) << refused;
  }
  for (const char* other : {"", "sdr", "TXT", "ASC2"}) EXPECT_EQ(KindOfExtension(other), 9);
  EXPECT_EQ(PatternOfKind(42), "*.*");
}

// The manual page and the README name every format by its number and name.
TEST(Formats, TheManualAndTheReadmeNameEveryFormat) {
  const std::string manual = FileText(KAVU_SOURCE "/packaging/kavu-cli.1");
  const std::string readme = FileText(KAVU_SOURCE "/README.md");
  ASSERT_FALSE(manual.empty());
  int index = 0;
  for (const Format& format : Formats()) {
    const std::string entry = std::to_string(index++) + " " + std::string(format.name);
    EXPECT_NE(manual.find(entry), std::string::npos) << entry;
    EXPECT_NE(readme.find(entry), std::string::npos) << entry;
  }
}

}  // namespace
}  // namespace kavu
