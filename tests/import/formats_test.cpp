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

// The kinds keep their indices and names (settings and scripts store the
// index), their patterns and extensions; only those names and indices read.
TEST(Formats, TheKindsKeepTheirIndicesAndPatterns) {
  const std::vector<std::string> names = {"asc", "sdr", "obs", "set", "raw",
                                          "idx", "tcm", "gre", "dn7", "other"};
  ASSERT_EQ(Formats().size(), names.size());
  for (std::size_t k = 0; k < names.size(); ++k) {
    const int index = static_cast<int>(k);
    const std::string pattern = k + 1 < names.size() ? "*." + names[k] : "*.*";
    EXPECT_EQ(FormatIndexOf(names[k]), index);
    EXPECT_EQ(FormatIndexOf(std::to_string(k)), index);
    EXPECT_EQ(PatternOfKind(index), pattern);
    EXPECT_TRUE(Formats()[k].listText.ends_with("[" + pattern + "]")) << Formats()[k].listText;
    EXPECT_EQ(KindOfExtension(Formats()[k].extension), k + 1 < names.size() ? index : 9);
  }
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
