// End-to-end tests of the batch command: options, exit codes, the summary on
// stdout, messages on stderr, and the bundled example against the coordinates
// it was generated from.
#include "cli/cli.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <regex>
#include <string>
#include <string_view>
#include <vector>

#include "core/lines.h"
#include "core/messages.h"
#include "core/numbers.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "tests/cli/cli_support.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

using testing::Cli;
using testing::FileBytes;
using testing::FreshFolder;
using testing::Outcome;

// The fields of a product line, without its padding.
std::vector<std::string> Words(std::string_view line) {
  std::string text = Trim(line);
  return SplitFields(text);
}

// The five lines of the summary on stdout, with the start and end times.
std::regex Summary(int stations, int points, int errors) {
  const std::string time = "[0-2][0-9]:[0-5][0-9]:[0-5][0-9]\n";
  return std::regex(std::string(msg::kTotalStations) + " " + std::to_string(stations) + "\n" +
                    std::string(msg::kTotalPoints) + " " + std::to_string(points) + "\n" +
                    std::string(msg::kTotalErrors) + " " + std::to_string(errors) + "\n" +
                    std::string(msg::kStarted) + time + std::string(msg::kEnded) + time);
}

TEST(CliUsage, BadCommandLinesExit64WithoutRunning) {
  const fs::path dir = FreshFolder();
  const std::string book = (dir / "a.asc").string();
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", book);
  const std::vector<std::vector<std::string>> bad = {
      {},                                        // no FILE
      {book, book},                              // two files
      {"--frobnicate", book},                    // unknown option
      {"--kind", "10", book},                    // kinds are 0 to 9
      {"--seed", "abc", book},                   // the seed is a whole number
      {"--seed", "18446744073709551616", book},  // 2^64 does not fit
      {"--scale", book},                         // option without its value
      {"--scale", "abc", book},                  // the settings are numbers
      {"--scale", "0", book},                    // a scale is positive
      {"--scale", "nan", book},                  //
      {"--scale", "1:5OO", book},                // a letter O among the digits
      {"--scale", "1.000", book},                // a thousand, or one?
      {"--text-height", "2,5,0", book},          // one separator at most
      {"--text-height", "0", book},              // a label has a height
      {"--height-decimals", "", book},           //
#ifndef KAVU_CLI_PICTURES
      {"--png", book + ".png", book},  // pictures need Qt
#endif
  };
  for (const auto& args : bad) {
    const Outcome o = Cli(args);
    EXPECT_EQ(o.code, kExitUsage) << ::testing::PrintToString(args);
    EXPECT_TRUE(o.out.empty()) << o.out;
    EXPECT_NE(o.err.find("--help"), std::string::npos) << o.err;
  }
  // None of them ran: no report, no product.
  EXPECT_EQ(std::distance(fs::directory_iterator(dir), fs::directory_iterator{}), 1);
}

// The program itself: a clean run prints the five summary lines, writes only
// the product asked for and, off a terminal, nothing on stderr. On a terminal
// the progress goes there, cleared at the end.
TEST(CliExe, SummaryProgressAndHeights) {
  const fs::path dir = FreshFolder();
  fs::create_directories(dir / "job");
  const std::string book = (dir / "job" / "job1.asc").string();
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", book);
  const Outcome o = testing::Exe({"--txt", book}, dir);
  EXPECT_EQ(o.code, kExitOk) << o.err;
  // 4 stations; 100 detail points, 2 pegs, 4 orientation distances, 4 checks.
  EXPECT_TRUE(std::regex_match(o.out, Summary(4, 110, 0))) << o.out;
  EXPECT_EQ(o.err, "");
  EXPECT_TRUE(fs::exists(dir / "job" / "job1.txt"));
  EXPECT_EQ(std::distance(fs::directory_iterator(dir / "job"), fs::directory_iterator{}), 2);
  EXPECT_FALSE(fs::exists(dir / "TRIDO"));

  const Outcome shown = Cli({book}, true);
  EXPECT_EQ(shown.code, kExitOk);
  EXPECT_NE(shown.err.find(std::string(msg::kStationTitle) + "DC01"), std::string::npos);
  EXPECT_TRUE(shown.err.ends_with("\r\x1b[K")) << shown.err;
  EXPECT_EQ(shown.out.find(msg::kStationTitle), std::string::npos);

  // Without heights a control-coordinate line ends after Y: "TR name X Y".
  // The last of --heights and --no-heights wins.
  ASSERT_EQ(Cli({"--no-heights", "--heights", "--no-heights", "--kc", book}).code, kExitOk);
  EXPECT_EQ(Words(ReadLines(dir / "job" / "job1.kc").value().at(0)).size(), 4u);
}

// --- The bundled example -------------------------------------------------

// Copies the example into dir/work and runs it.
Outcome RunExample(const fs::path& dir, std::vector<std::string> options) {
  fs::create_directories(dir / "work");
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", dir / "work" / "job1.asc");
  options.push_back((dir / "work" / "job1.asc").string());
  return Cli(options);
}

// Every product of a clean run, the same for the same seed; the points and
// pegs where examples/job1.expected.txt, written by make_job1.py with the true
// coordinates, puts them: "point NAME X Y H [CODE [NOTE]]" in the order of the
// coordinate text file, "peg NAME X Y H" in the control-coordinate file; the
// header texts (UTF-8) in the field sketch in TCVN3.
TEST(Example, TruePointsSameSeedSameProductsHeaderTexts) {
  const std::vector<std::pair<std::string, std::string>> header = {
      {"--area", "Xã Đông Hội"},       {"--sketch-no", "07"},
      {"--instrument", "NIKON DTM"},   {"--instrument-no", "A1234"},
      {"--surveyor", "Nguyễn Văn An"}, {"--recorder", "Trần Thị Bình Mai"},
      {"--date", "12/5/2004"}};
  std::vector<std::string> args = {"--all", "--seed", "42", "--height-decimals", "3"};
  for (const auto& [option, text] : header) args.insert(args.end(), {option, text});
  const fs::path first = FreshFolder("kavu-cli-1"), second = FreshFolder("kavu-cli-2");
  const Outcome o = RunExample(first, args);
  ASSERT_EQ(o.code, kExitOk) << o.out << o.err << FileBytes(first / "work" / "job1.err");
  EXPECT_FALSE(fs::exists(first / "work" / "job1.cpv"));

  const auto txt = ReadLines(first / "work" / "job1.txt").value();
  std::map<std::string, std::vector<std::string>> kc;
  const auto kcLines = ReadLines(first / "work" / "job1.kc").value();
  const auto expected = ReadLines(fs::path(KAVU_EXAMPLES) / "job1.expected.txt").value();
  for (const std::string& line : kcLines) {
    const auto w = Words(line);
    if (w.size() >= 5) kc[w[1]] = {w.begin() + 1, w.end()};
  }
  std::size_t points = 0;
  for (const std::string& line : expected) {
    const auto e = Words(line);
    if (e.size() < 5) continue;
    const bool point = e[0] == "point";
    ASSERT_TRUE(point ? points < txt.size() : kc.contains(e[1])) << line;
    const auto got = point ? Words(txt[points++]) : kc[e[1]];
    ASSERT_GE(got.size(), 4u) << line;
    EXPECT_EQ(got[0], e[1]);
    for (std::size_t i = 1; i < 4; ++i) {
      EXPECT_NEAR(Val(got[i]), Val(e[i + 1]), 0.002) << line;  // metres
    }
    // A point's code and note, their TCVN3 bytes unchanged; a peg's line ends at H.
    EXPECT_EQ(std::vector(got.begin() + 4, got.end()), std::vector(e.begin() + 5, e.end()));
  }
  EXPECT_TRUE(points == 100 && txt.size() == points) << txt.size();
  // The four control points were looked up and recorded too.
  for (const char* name : {"DC01", "DC02", "DC03", "DC04"}) EXPECT_TRUE(kc.contains(name)) << name;

  ASSERT_EQ(RunExample(second, args).code, kExitOk);
  for (const char* name : {"job1.kc", "job1.td1", "job1.txt", "job1.dxf", "job1.sdo", "job1.cp"}) {
    EXPECT_GT(FileBytes(first / "work" / name).size(), 0u) << name;
    EXPECT_EQ(FileBytes(first / "work" / name), FileBytes(second / "work" / name)) << name;
  }
  EXPECT_EQ(FileBytes(first / "TRIDO" / "job1.asc"), FileBytes(second / "TRIDO" / "job1.asc"));

  const std::string sketch = FileBytes(first / "work" / "job1.sdo");
  for (const auto& [option, text] : header) {
    EXPECT_NE(sketch.find(Utf8ToTcvn3(text)), std::string::npos) << option;
  }
  // The seed does reach the generator: the sketch's orientation rows draw from it.
  const fs::path third = FreshFolder("kavu-cli-3");
  std::vector<std::string> other = args;
  other[2] = "43";
#ifdef KAVU_CLI_PICTURES
  // The map as pictures, the sketch as PDF pages.
  for (const char* picture : {"--png", "--svg", "--pdf"}) {
    other.insert(other.end(), {picture, (third / (picture + 2)).string()});
  }
  const Outcome p = RunExample(third, other);
  EXPECT_EQ(p.err, "");  // Qt's notes about the missing desktop stay quiet
  EXPECT_TRUE(FileBytes(third / "png").starts_with("\x89PNG\r\n"));
  EXPECT_NE(FileBytes(third / "svg").find(">DC04<"), std::string::npos);
  EXPECT_TRUE(FileBytes(third / "pdf").starts_with("%PDF-"));
#else
  const Outcome p = RunExample(third, other);
#endif
  ASSERT_EQ(p.code, kExitOk) << p.out;
  EXPECT_NE(sketch, FileBytes(third / "work" / "job1.sdo"));
}

}  // namespace
}  // namespace kavu
