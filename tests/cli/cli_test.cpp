// End-to-end tests of the batch command: options, exit codes, the summary on
// stdout, messages on stderr, and the bundled example against the coordinates
// it was generated from.
#include "cli/cli.h"

#include <gtest/gtest.h>

#include <charconv>
#include <filesystem>
#include <map>
#include <regex>
#include <string>
#include <string_view>
#include <vector>

#include "core/lines.h"
#include "core/messages.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "tests/cli/cli_support.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

using testing::Cli;
using testing::Exe;
using testing::FileBytes;
using testing::FreshFolder;
using testing::Outcome;
using testing::WriteBytes;

double Number(std::string_view text) {
  double value = 0;
  const auto [end, ec] = std::from_chars(text.data(), text.data() + text.size(), value);
  EXPECT_TRUE(ec == std::errc{} && end == text.data() + text.size()) << "not a number: " << text;
  return value;
}

// The fields of a product line, without its padding.
std::vector<std::string> Words(std::string_view line) {
  std::string text = Trim(line);
  return SplitFields(text);
}

// One station on two known points: a detail point 50 m due east of DC01.
constexpr char kSmallBook[] =
    "TR DC01 1000.000 2000.000 10.000\r\n"
    "TR DC02 1100.000 2000.000 10.000\r\n"
    "TR DC01 1.50\r\n"
    "DKD DC02\r\n"
    "1 0900000 50.000 0900000 1.50\r\n"
    "2 1800000 25.000 0900000 1.50 N\r\n";

const std::regex kTime("[0-2][0-9]:[0-5][0-9]:[0-5][0-9]");

void ExpectSummary(const Outcome& o, int stations, int points, int errors) {
  const std::vector<std::string> lines = SplitLines(o.out);
  ASSERT_GE(lines.size(), 5u) << o.out;
  EXPECT_EQ(lines[0], std::string(msg::kTotalStations) + " " + std::to_string(stations));
  EXPECT_EQ(lines[1], std::string(msg::kTotalPoints) + " " + std::to_string(points));
  EXPECT_EQ(lines[2], std::string(msg::kTotalErrors) + " " + std::to_string(errors));
  ASSERT_TRUE(lines[3].starts_with(msg::kStarted)) << lines[3];
  EXPECT_TRUE(std::regex_match(lines[3].substr(msg::kStarted.size()), kTime)) << lines[3];
  ASSERT_TRUE(lines[4].starts_with(msg::kEnded)) << lines[4];
  EXPECT_TRUE(std::regex_match(lines[4].substr(msg::kEnded.size()), kTime)) << lines[4];
}

TEST(CliUsage, BadCommandLinesExit64WithoutRunning) {
  const fs::path dir = FreshFolder();
  const std::string book = (dir / "a.asc").string();
  WriteBytes(book, kSmallBook);
  const std::vector<std::vector<std::string>> bad = {
      {},                                        // no FILE
      {book, book},                              // two files
      {"--frobnicate", book},                    // unknown option
      {"--kind", "10", book},                    // kinds are 0 to 9
      {"--kind", "sdr", book},                   //
      {"--seed", "abc", book},                   // the seed is a whole number
      {"--seed", "-1", book},                    //
      {"--seed", "18446744073709551616", book},  // 2^64 does not fit
      {"--scale", book},                         // option without its value
      {"--scale", "abc", book},                  // the settings are numbers
      {"--scale", "0", book},                    // a scale is positive
      {"--scale", "-500", book},                 //
      {"--scale", "nan", book},                  //
      {"--text-height", "2,5", book},            //
      {"--height-decimals", "", book},           //
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

// The program itself: a missing or empty field book stops before the run
// with the two-line message box on stderr (its lone CR a line feed) and no
// report; a clean run prints the five summary lines, writes only the product
// asked for and, off a terminal, nothing on stderr.
TEST(CliExe, ExitCodesAndStreams) {
  const fs::path dir = FreshFolder();
  WriteBytes(dir / "empty.asc", "");
  const std::string missing = (dir / "nothere.asc").string();
  const std::vector<std::pair<std::string, std::string>> cases = {
      {missing, std::string(msg::kFileNotFound) + missing + "\n" + std::string(msg::kEnterNewFile)},
      {(dir / "empty.asc").string(),
       std::string(msg::kFileSizeZero) + "\n" + std::string(msg::kCheckFileAgain)}};
  for (const auto& [file, message] : cases) {
    const Outcome o = Exe({"--all", file}, dir);
    EXPECT_EQ(o.code, kExitStopped);
    EXPECT_EQ(o.out, "");
    EXPECT_EQ(o.err, message + "\n");
  }
  EXPECT_FALSE(fs::exists(dir / "empty.err"));

  fs::create_directories(dir / "job");
  WriteBytes(dir / "job" / "small.asc", kSmallBook);
  const Outcome o = Exe({"--txt", (dir / "job" / "small.asc").string()}, dir);
  EXPECT_EQ(o.code, kExitOk) << o.err;
  ExpectSummary(o, 1, 2, 0);
  EXPECT_EQ(SplitLines(o.out).size(), 5u);
  EXPECT_EQ(o.err, "");
  EXPECT_TRUE(fs::exists(dir / "job" / "small.txt"));
  for (const char* ext : {".err", ".cpv", ".kc", ".td1", ".dxf", ".sdo", ".cp"}) {
    EXPECT_FALSE(fs::exists(dir / "job" / ("small" + std::string(ext)))) << ext;
  }
  EXPECT_FALSE(fs::exists(dir / "TRIDO"));
}

TEST(Cli, UnwritableProductIsNamedAndExits1WhileTheOthersAreWritten) {
  const fs::path dir = FreshFolder();
  fs::create_directories(dir / "job");
  WriteBytes(dir / "job" / "small.asc", kSmallBook);
  fs::create_directories(dir / "job" / "small.txt");  // a folder where the file should go
  const Outcome o = Cli({"--txt", "--kc", (dir / "job" / "small.asc").string()});
  EXPECT_EQ(o.code, kExitDataErrors);
  ExpectSummary(o, 1, 2, 0);
  const auto lines = SplitLines(o.out);
  ASSERT_EQ(lines.size(), 6u) << o.out;
  EXPECT_EQ(lines[5], std::string(msg::kCannotWrite) + (dir / "job" / "small.txt").string());
  EXPECT_TRUE(fs::is_regular_file(dir / "job" / "small.kc"));
}

// Off a terminal stderr stays empty (CliExe.ExitCodesAndStreams).
TEST(Cli, ProgressGoesToStderrOnATerminal) {
  const fs::path dir = FreshFolder();
  WriteBytes(dir / "small.asc", kSmallBook);
  const Outcome shown = Cli({(dir / "small.asc").string()}, true);
  EXPECT_EQ(shown.code, kExitOk);
  EXPECT_NE(shown.err.find(std::string(msg::kStationTitle) + "DC01"), std::string::npos);
  // The progress line is cleared at the end and never reaches stdout.
  EXPECT_TRUE(shown.err.ends_with("\r\x1b[K")) << shown.err;
  EXPECT_EQ(shown.out.find(msg::kStationTitle), std::string::npos);
}

TEST(Cli, ControlFileOption) {
  const fs::path dir = FreshFolder();
  // The field book without its control points; they come from the common file.
  WriteBytes(dir / "obs.asc", "TR DC01 1.50\r\nDKD DC02\r\n1 0900000 50.000 0900000 1.50\r\n");
  WriteBytes(dir / "area.kc",
             "TR DC01 1000.000 2000.000 10.000\r\nTR DC02 1100.000 2000.000 10.000\r\n");
  const Outcome o = Cli({"--control-file", (dir / "area.kc").string(), (dir / "obs.asc").string()});
  EXPECT_EQ(o.code, kExitOk) << o.err;
  ExpectSummary(o, 1, 1, 0);

  // A file that cannot be read stops the run (its message: the engine's tests).
  const Outcome m =
      Cli({"--control-file", (dir / "nothere.kc").string(), (dir / "obs.asc").string()});
  EXPECT_EQ(m.code, kExitStopped);
  EXPECT_EQ(m.out, "");
}

// Without heights a control-coordinate line ends after Y: "TR name X Y".
TEST(Cli, NoHeightsLeavesTheHeightOutOfControlLinesTheLastFlagWins) {
  const fs::path dir = FreshFolder();
  WriteBytes(dir / "small.asc", kSmallBook);
  const std::vector<std::pair<std::vector<std::string>, std::size_t>> cases = {
      {{}, 5u},
      {{"--no-heights"}, 4u},
      {{"--no-heights", "--heights"}, 5u},
      {{"--heights", "--no-heights"}, 4u},
  };
  for (const auto& [flags, fields] : cases) {
    std::vector<std::string> args = flags;
    args.push_back("--kc");
    args.push_back((dir / "small.asc").string());
    ASSERT_EQ(Cli(args).code, kExitOk);
    const auto lines = ReadLines(dir / "small.kc").value();
    ASSERT_GE(lines.size(), 2u);
    EXPECT_EQ(Words(lines[0]).size(), fields) << ::testing::PrintToString(flags) << lines[0];
  }
}

TEST(Cli, HeaderTextsReachTheFieldSketchInTcvn3) {
  const fs::path dir = FreshFolder();
  WriteBytes(dir / "small.asc", kSmallBook);
  const std::vector<std::pair<std::string, std::string>> header = {
      {"--area", "Xã Đông Hội"},       {"--sketch-no", "07"},
      {"--instrument", "NIKON DTM"},   {"--instrument-no", "A1234"},
      {"--surveyor", "Nguyễn Văn An"}, {"--recorder", "Trần Thị Bình Minh"},
      {"--date", "12/5/2004"}};
  std::vector<std::string> args = {"--sketch", "--seed", "1"};
  for (const auto& [option, text] : header) {
    args.push_back(option);
    args.push_back(text);
  }
  args.push_back((dir / "small.asc").string());
  ASSERT_EQ(Cli(args).code, kExitOk);
  const std::string sketch = FileBytes(dir / "small.sdo");
  for (const auto& [option, text] : header) {
    EXPECT_NE(sketch.find(Utf8ToTcvn3(text)), std::string::npos) << option;
  }
  EXPECT_EQ(sketch.find("TOPCOM"), std::string::npos);  // the default was replaced
  // Surveyor, recorder and date in their widths of 17, 18 (filled) and 10.
  EXPECT_NE(sketch.find(Utf8ToTcvn3("2. Người đo: Nguyễn Văn An    Người ghi: Trần Thị Bình Minh"
                                    "Ngày đo:12/5/2004 \r\n")),
            std::string::npos);
}

// --- The bundled example -------------------------------------------------

struct Expected {
  std::string name;
  double x = 0, y = 0, h = 0;
  std::string code, note;
};

// examples/job1.expected.txt, written by make_job1.py with the true
// coordinates: "point NAME X Y H [CODE [NOTE]]" and "peg NAME X Y H".
std::map<std::string, std::vector<Expected>> ReadExpected() {
  std::map<std::string, std::vector<Expected>> table;
  const auto lines = ReadLines(fs::path(KAVU_EXAMPLES) / "job1.expected.txt").value();
  for (const std::string& line : lines) {
    const auto w = Words(line);
    if (w.size() < 5) continue;
    Expected e{w[1],
               Number(w[2]),
               Number(w[3]),
               Number(w[4]),
               w.size() > 5 ? w[5] : "",
               w.size() > 6 ? w[6] : ""};
    table[w[0]].push_back(e);
  }
  return table;
}

// Copies the example into dir/work and runs it.
Outcome RunExample(const fs::path& dir, std::vector<std::string> options) {
  fs::create_directories(dir / "work");
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", dir / "work" / "job1.asc");
  options.push_back((dir / "work" / "job1.asc").string());
  return Cli(options);
}

constexpr double kTolerance = 0.002;  // metres

TEST(Example, CoordinatesAgreeWithTheTruePointsOfTheGenerator) {
  const auto expected = ReadExpected();
  ASSERT_EQ(expected.at("point").size(), 100u);
  const fs::path dir = FreshFolder();
  const Outcome o = RunExample(dir, {"--txt", "--kc", "--height-decimals", "3"});
  ASSERT_EQ(o.code, kExitOk) << o.err;

  const auto lines = ReadLines(dir / "work" / "job1.txt").value();
  ASSERT_EQ(lines.size(), expected.at("point").size());
  for (std::size_t i = 0; i < lines.size(); ++i) {
    const Expected& e = expected.at("point")[i];
    const auto w = Words(lines[i]);
    ASSERT_GE(w.size(), 4u) << lines[i];
    EXPECT_EQ(w[0], e.name);
    EXPECT_NEAR(Number(w[1]), e.x, kTolerance) << e.name;
    EXPECT_NEAR(Number(w[2]), e.y, kTolerance) << e.name;
    EXPECT_NEAR(Number(w[3]), e.h, kTolerance) << e.name;
    EXPECT_EQ(w.size() > 4 ? w[4] : "", e.code) << e.name;
    EXPECT_EQ(w.size() > 5 ? w[5] : "", e.note) << e.name;  // TCVN3 bytes unchanged
  }

  // The pegs set out are in the control-coordinate file, with their heights.
  std::map<std::string, std::vector<std::string>> kc;
  const auto kcLines = ReadLines(dir / "work" / "job1.kc").value();
  for (const std::string& line : kcLines) {
    auto w = Words(line);
    if (w.size() >= 5) kc[w[1]] = w;
  }
  for (const Expected& peg : expected.at("peg")) {
    ASSERT_TRUE(kc.contains(peg.name)) << peg.name;
    EXPECT_NEAR(Number(kc[peg.name][2]), peg.x, kTolerance) << peg.name;
    EXPECT_NEAR(Number(kc[peg.name][3]), peg.y, kTolerance) << peg.name;
    EXPECT_NEAR(Number(kc[peg.name][4]), peg.h, kTolerance) << peg.name;
  }
  // The four control points were looked up and recorded too.
  for (const char* name : {"DC01", "DC02", "DC03", "DC04"}) EXPECT_TRUE(kc.contains(name)) << name;
}

// Every product of a clean run, the same for the same seed.
TEST(Example, SameSeedSameProductsOtherSeedOtherSketch) {
  const fs::path first = FreshFolder("kavu-cli-1"), second = FreshFolder("kavu-cli-2");
  const Outcome o = RunExample(first, {"--all", "--seed", "42"});
  EXPECT_EQ(o.code, kExitOk) << o.out << o.err << FileBytes(first / "work" / "job1.err");
  // 4 stations; 100 detail points, 2 pegs, 4 orientation distances, 4 checks.
  ExpectSummary(o, 4, 110, 0);
  EXPECT_FALSE(fs::exists(first / "work" / "job1.cpv"));
  ASSERT_EQ(RunExample(second, {"--all", "--seed", "42"}).code, kExitOk);
  for (const char* name : {"job1.kc", "job1.td1", "job1.txt", "job1.dxf", "job1.sdo", "job1.cp"}) {
    EXPECT_GT(FileBytes(first / "work" / name).size(), 0u) << name;
    EXPECT_EQ(FileBytes(first / "work" / name), FileBytes(second / "work" / name)) << name;
  }
  EXPECT_EQ(FileBytes(first / "TRIDO" / "job1.asc"), FileBytes(second / "TRIDO" / "job1.asc"));
  // The seed does reach the generator: the sketch's orientation rows draw from it.
  const fs::path third = FreshFolder("kavu-cli-3");
  ASSERT_EQ(RunExample(third, {"--sketch", "--seed", "43"}).code, kExitOk);
  EXPECT_NE(FileBytes(first / "work" / "job1.sdo"), FileBytes(third / "work" / "job1.sdo"));
}

}  // namespace
}  // namespace kavu
