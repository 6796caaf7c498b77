// Every instrument converter ends on any input, with a field book of CR LF
// lines that holds only the columns it read.
#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <string_view>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

struct Converter {
  const char* name;
  std::string (*convert)(std::string_view);
};

const Converter kConverters[] = {
    {"sdr", [](std::string_view file) { return ConvertSdr(file, 1).book; }},
    {"gre", [](std::string_view file) { return ConvertSdr(file, 7).book; }},
    {"obs", [](std::string_view file) { return ConvertObs(file, 2).book; }},
    {"set", [](std::string_view file) { return ConvertSet(file).book; }},
    {"idx", [](std::string_view file) { return ConvertIdx(file).book; }},
    {"tcm", [](std::string_view file) { return ConvertTcm(file).book; }},
};

TEST(InstrumentBadInput, AnyBytesGiveABoundedBookOfCrLfLines) {
  std::string noise;
  unsigned state = 12345;
  for (int i = 0; i < 100000; ++i) {
    state = state * 1103515245u + 12345u;
    noise += static_cast<char>(state >> 16);
  }
  const std::string nul = "02TP" + std::string(120, '\0') + "\r\n07TP" + std::string(40, '\0') +
                          "\r\n09F1" + std::string(120, '\0') + "\r\n";
  std::string not_numbers;
  for (const char* code : {"08KI", "08CO", "02TP", "07TP", "03NM", "09F1"}) {
    for (const std::string fill : {"abc.-+E", "1E308", "-", "9999999999999999", "1D-9 ."}) {
      not_numbers += code;
      for (int i = 0; i < 20; ++i) not_numbers += fill;
      not_numbers += "\r\n";
    }
  }
  const std::string big = "08KI" + std::string(10'000'000, '9') + "\r\n02TP" +
                          std::string(10'000'000, '1') + "\n09F1" + std::string(10'000'000, 'x');
  for (const auto& [name, convert] : kConverters) {
    for (std::string_view file : std::initializer_list<std::string_view>{noise, nul, not_numbers}) {
      EXPECT_TRUE(AllLinesCrLf(convert(file))) << name;
    }
    EXPECT_LT(convert(big).size(), 4000u) << name;  // only the read columns reach the book
  }
  // Records made of NUL bytes keep them as names, never as numbers: the
  // set-up's control point and station record.
  const std::string book = ConvertSdr(nul, 1).book;
  EXPECT_EQ(CountStarting(book, "TR "), 2);
  EXPECT_EQ(CountStarting(book, "DKD "), 1);
}

TEST(InstrumentBadInput, EmptyAndHeaderOnlyFilesGiveEmptyBooks) {
  const std::string header = "00NMSDR33  V04-04.34    25-Sep-15 12:33 111121\r\n";
  for (const auto& [name, convert] : kConverters) {
    EXPECT_EQ(convert(""), "") << name;
    EXPECT_EQ(convert(header), "") << name;
    EXPECT_EQ(convert(header + "\r\n   \r\n"), "") << name;
  }
}

}  // namespace
}  // namespace kavu::testing
