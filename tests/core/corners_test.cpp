// Corner cases of the surveying rules, through the batch command on field
// books in a temp folder and through the pure rules. Each expected value is
// worked out by hand from the rule, not taken from a run.
#include <gtest/gtest.h>

#include <filesystem>
#include <regex>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;
using testing::FreshFolder;
using testing::WriteBytes;

// Station KC1 at (1000, 1000), H 10, instrument height 1.5; orientation KC2
// 100 m due south of it, so the orientation azimuth (KC2 to the station) is 0
// and its distance 100; KC3 100 m due east.
constexpr std::string_view kControl =
    "TR KC1 1000 1000 10\r\nTR KC2 900 1000 10\r\nTR KC3 1000 1100 10\r\n";
constexpr std::string_view kStation = "TR KC1 1.5\r\nDKD KC2\r\n";

struct Outcome {
  int code = -1;
  fs::path folder;
  std::string Product(std::string_view extension) const {
    return FileBytes(folder / ("job" + std::string(extension)));
  }
};

// Writes job + extension with the given body and runs the batch command on it.
Outcome Compute(std::string_view book, std::vector<std::string> options = {},
                std::string_view extension = ".asc") {
  Outcome run;
  run.folder = FreshFolder() / "data";
  fs::create_directories(run.folder);
  const fs::path file = run.folder / ("job" + std::string(extension));
  WriteBytes(file, std::string(book));
  options.insert(options.begin(), file.string());
  options.push_back("--seed=5");
  const std::vector<std::string_view> args(options.begin(), options.end());
  std::ostringstream out, err;
  run.code = RunCli(args, out, err, false);
  return run;
}

std::string Book(std::string_view body) {
  return std::string(kControl) + std::string(kStation) + std::string(body);
}

// The orientation distance is checked against the map scale's tolerance:
// 0.02 m up to 1:500, 0.05 m to 1:2000, 0.3 m below 1:5000, 2 m beyond; a
// difference equal to the tolerance is reported.
TEST(Corners, OrientationDistanceToleranceOfEveryScale) {
  struct Case {
    const char* scale;
    const char* measured;
    const char* ds;  // the report's difference, or nullptr
  };
  for (const Case& c : {Case{"500", "100.03", " .03 "}, Case{"501", "100.03", nullptr},
                        Case{"2000", "100.06", " .06 "}, Case{"2001", "100.06", nullptr},
                        Case{"4999", "100.4", " .4 "}, Case{"5000", "100.4", nullptr},
                        Case{"5000", "102", " 2 "}, Case{"5000", "97.5", "-2.5 "}}) {
    const Outcome run = Compute(Book(std::string("X1 0 ") + c.measured + " 900000 1.5 KC2\r\n" +
                                     "1 900000 10 900000 1.5\r\n"),
                                {"--scale", c.scale});
    const std::string err = run.Product(".err");
    if (c.ds == nullptr) {
      EXPECT_EQ(run.code, kExitOk) << c.scale << " " << c.measured << err;
    } else {
      EXPECT_EQ(run.code, kExitDataErrors);
      EXPECT_NE(err.find(std::string("Sai canh dinh huong DS= ") + c.ds + "\r\n"),
                std::string::npos)
          << c.scale << " " << c.measured << err;
    }
  }
}

// Entry checks of a packed angle and a distance, and the report line each
// gives (name in 12 columns). 1234560 has 60 seconds; 1234559.9 rounds to
// the whole 1234560 for minutes but keeps 59.9 seconds; a distance over
// 2000 m is checked by the height and again by the position.
TEST(Corners, EntryChecksOfAnglesAndDistances) {
  struct Case {
    const char* record;
    const char* report;  // the error report's lines after its header
  };
  const std::string seconds = "\r\nDiem S            nhap sai phan giay\r\n";
  for (const Case& c : {
           Case{"S 1234560 10 900000 1.5", "\r\nDiem S            nhap sai phan giay\r\n"},
           Case{"S 1234559.9 10 900000 1.5", ""},
           Case{"S 1236000 10 900000 1.5", "\r\nDiem S            nhap sai phan phut\r\n"},
           Case{"S 0 10 0895960 1.5", "\r\nDiem S            nhap sai phan giay\r\n"},
           Case{"S 0 2000 900000 1.5", ""},
           Case{"S 0 2000.01 900000 1.5",
                "\r\nDiem S            co the nhap sai canh\r\n"
                "\r\nDiem S            co the nhap sai canh\r\n"},
       }) {
    const Outcome run = Compute(Book(std::string(c.record) + "\r\n"));
    const std::string err = run.Product(".err");
    if (*c.report == '\0') {
      EXPECT_EQ(run.code, kExitOk) << c.record << err;
    } else {
      const std::size_t body = err.find("-\r\n");
      ASSERT_NE(body, std::string::npos) << c.record << err;
      EXPECT_EQ(err.substr(body + 3), c.report) << c.record;
    }
  }
}

// The check record on KC3. Orientation azimuth (KC2 to KC1) 0; azimuth from
// KC3 to KC1 is 270, so the check reading should be 270 - 0. With the
// orientation on KC3 instead (azimuth 270) and the check on KC2 (azimuth 0),
// 0 - 270 wraps to 90. A recorded reading is kept; a reading of 0 is made up
// within 32 seconds of the computed one (packed, without leading zeros).
TEST(Corners, CheckReadingKeptOrMadeUpWithinHalfAMinute) {
  struct Case {
    const char* orientation;
    const char* check;
    const char* reading;
    const char* line;  // a regular expression of the auxiliary-peg file's line
  };
  for (const Case& c : {
           Case{"KC2", "KC3", "2700010", R"(DKD2 KC3          2700010 100)"},
           Case{"KC2", "KC3", "0", R"(DKD2 KC3          (26959[2-5]\d|27000[0-3]\d) 100)"},
           Case{"KC3", "KC2", "0",
                R"(DKD2 KC2          (89592[89]|8959[3-5]\d|9000[0-2]\d|90003[0-2]) 100)"},
       }) {
    const std::string book = std::string(kControl) + "TR KC1 1.5\r\nDKD " + c.orientation +
                             "\r\nK1 " + c.reading + " 100 900000 1.5 " + c.check +
                             " KT\r\nP1 1800000 40 900000 1.5 CP1\r\n";
    const std::string pegs = Compute(book, {"--pegs"}).Product(".cp");
    EXPECT_TRUE(std::regex_search(pegs, std::regex("\r\n" + std::string(c.line) + "\r\n")))
        << c.orientation << " " << c.reading << "\n"
        << pegs;
  }
}

// Values below 1 m are written without a 0 before the point (the masks
// "####.000" and "#####.000"). The reading 1.45 (0 00 01.45) is decoded as
// 1.45 x 100.00001 = 1.5000... seconds, which the sketch shows as the even 02.
// Reading about 0 points at the orientation, due south: X = 1000 - 0.5;
// H = 10 + 1.5 - 0.5.
TEST(Corners, ValuesBelowOneMetreAndTheDecodedSeconds) {
  const Outcome run = Compute(Book("A 1.45 0.5 900000 0.5\r\n"), {"--asc", "--sketch"});
  EXPECT_NE(run.Product(".td1").find("A         999.500    1000.000      11.000      .500\r\n"),
            std::string::npos)
      << run.Product(".td1");
  EXPECT_NE(run.Product(".sdo").find("|A     |     .500 |     0 00 02  |"), std::string::npos)
      << run.Product(".sdo");
}

// The coordinate text file's heights: rounded to the typed number of
// decimals, ties to even, no trailing zeros; a negative count is 0.
TEST(Corners, HeightDecimalsOfTheCoordinateTextFile) {
  // H = 10 + 1.5 - 0 = 11.5 and 10 + 1.5 + 1.25 = 12.75 (prism -1.25).
  const std::string book = Book("A 0 10 900000 0\r\nB 0 10 900000 -1.25\r\n");
  for (const auto& [decimals, a, b] :
       {std::tuple{"2", "      11.5", "     12.75"}, std::tuple{"1", "      11.5", "      12.8"},
        std::tuple{"0", "        12", "        13"},
        std::tuple{"-1", "        12", "        13"}}) {
    const std::string txt = Compute(book, {"--txt", "--height-decimals", decimals}).Product(".txt");
    EXPECT_NE(txt.find(std::string(" ") + a + "  \r\n"), std::string::npos) << decimals << txt;
    EXPECT_NE(txt.find(std::string(" ") + b + "  \r\n"), std::string::npos) << decimals << txt;
  }
}

}  // namespace
}  // namespace kavu
