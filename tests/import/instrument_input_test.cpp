// Every converter of fixed-column instrument files ends on any input, and the
// example jobs convert to complete station blocks.
#include <gtest/gtest.h>

#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu {
namespace {

using testing::CountStarting;
using testing::Example;

std::string ConvertAll(const std::string& file) {
  return ConvertSdr(file, 1) + ConvertSdr(file, 7) + ConvertObs(file, 2) + ConvertSet(file);
}

TEST(InstrumentBadInput, BinaryAndNulBytesEnd) {
  std::string noise;
  unsigned state = 12345;
  for (int i = 0; i < 100000; ++i) {
    state = state * 1103515245u + 12345u;
    noise += static_cast<char>(state >> 16);
  }
  EXPECT_TRUE(testing::AllLinesCrLf(ConvertAll(noise)));
  // Records made of NUL bytes keep them as names, never as numbers.
  const std::string nul = "02TP" + std::string(120, '\0') + "\r\n07TP" + std::string(40, '\0') +
                          "\r\n09F1" + std::string(120, '\0') + "\r\n";
  const std::string book = ConvertSdr(nul, 1);
  EXPECT_EQ(CountStarting(book, "TR "), 1);
  EXPECT_EQ(CountStarting(book, "DKD "), 1);
  EXPECT_TRUE(testing::AllLinesCrLf(ConvertAll(nul)));
}

TEST(InstrumentBadInput, TenMegabyteLinesEnd) {
  const std::string big = "08KI" + std::string(10'000'000, '9') + "\r\n02TP" +
                          std::string(10'000'000, '1') + "\n09F1" + std::string(10'000'000, 'x');
  const std::string book = ConvertAll(big);
  EXPECT_LT(book.size(), 4000u);  // only the read columns reach the book
}

TEST(InstrumentBadInput, NonNumbersInEveryColumn) {
  std::string file;
  for (const char* code : {"08KI", "08CO", "02TP", "07TP", "03NM", "09F1"}) {
    for (const std::string fill : {"abc.-+E", "1E308", "-", "9999999999999999", "1D-9 ."}) {
      file += code;
      for (int i = 0; i < 20; ++i) file += fill;
      file += "\r\n";
    }
  }
  EXPECT_TRUE(testing::AllLinesCrLf(ConvertAll(file)));
}

TEST(InstrumentBadInput, HeaderOnlyFilesGiveEmptyBooks) {
  const std::string header = "00NMSDR33  V04-04.34    25-Sep-15 12:33 111121\r\n";
  EXPECT_EQ(ConvertAll(header), "");
  EXPECT_EQ(ConvertAll(header + "\r\n   \r\n"), "");
}

// The example jobs: two or three set-ups on three known points, a point shot
// before its backsight, prism-height changes.
TEST(InstrumentExamples, SdrJob) {
  const std::string book = ConvertSdr(Example("job-sdr.sdr"), 1);
  EXPECT_EQ(CountStarting(book, "TR KC0"), 3 + 2);
  EXPECT_EQ(CountStarting(book, "DKD "), 2);
  EXPECT_EQ(testing::CountLines(book), 3 + 2 * 2 + 8);
  // 101 lies at azimuth 53.1301 from KC01 and KC02 at 26.5651: 26 33 54.
  EXPECT_NE(book.find("TR KC01 1.500\r\nDKD KC02\r\n101    263354   50.000"), std::string::npos);
}

TEST(InstrumentExamples, ObsJob) {
  const std::string book = ConvertObs(Example("job-obs.obs"), 2);
  EXPECT_EQ(CountStarting(book, "TR "), 3 + 2);
  EXPECT_EQ(CountStarting(book, "DKD "), 2);
  EXPECT_EQ(testing::CountLines(book), 3 + 2 * 2 + 8);
  EXPECT_NE(book.find("DKD KC02        \r\n101          263354   50.000"), std::string::npos);
}

TEST(InstrumentExamples, SetJob) {
  const std::string book = ConvertSet(Example("job-set.set"));
  EXPECT_EQ(CountStarting(book, "TR "), 3 + 3);
  EXPECT_EQ(CountStarting(book, "DKD "), 3);
  EXPECT_EQ(testing::CountLines(book), 3 + 3 * 2 + 10);
}

}  // namespace
}  // namespace kavu
