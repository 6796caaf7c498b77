// Corner cases of the surveying rules, through the batch command on field
// books in a temp folder and through the pure rules. Each expected value is
// worked out by hand from the rule, not taken from a run.
#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <regex>
#include <string>
#include <string_view>
#include <vector>

#include "core/messages.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "tests/cli/cli_support.h"

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
  options.insert(options.end(), {file.string(), "--seed=5"});
  run.code = testing::Cli(options).code;
  return run;
}

std::string Book(std::string_view body) {
  return std::string(kControl) + std::string(kStation) + std::string(body);
}

// A book's corner and what its products must show; the error report is
// compared whole after its head. The orientation distance against the
// scale's tolerance (0.02 m to 1:500, 0.05 m to 1:2000, 0.3 m below 1:5000,
// 2 m beyond), a difference equal to it reported; 60 seconds or minutes and
// over 2000 m reported, 1234559.9 rounded for minutes only; 0 00 01.45 read
// as 1.5000... seconds (02, the even second), due south at 0.5 m; the .txt
// heights to the typed decimals, ties to even, a negative count as 0.
TEST(Corners, BooksAndWhatTheirProductsShow) {
  struct Case {
    std::vector<std::string> options;
    std::string body;
    std::string report;  // the error report after its head; "" when it has none
    std::vector<std::pair<std::string, std::string>> shown = {};  // product, text
  };
  const std::string tolerance = "X1 0 %s 900000 1.5 KC2\r\n1 900000 10 900000 1.5\r\n";
  const auto measured = [&](const char* distance) {
    return std::regex_replace(tolerance, std::regex("%s"), distance);
  };
  const auto ds = [](const char* text) {
    return "\r\nTram KC1         " + Utf8ToTcvn3(msg::kOrientation) +
           "KC2         Sai canh dinh huong DS= " + text + "\r\n";
  };
  const std::string heights = "A 0 10 900000 0\r\nB 0 10 900000 -1.25\r\n";
  const Case cases[] = {
      {{"--scale", "500"}, measured("100.03"), ds(" .03 ")},
      {{"--scale", "501"}, measured("100.03"), ""},
      {{"--scale", "2000"}, measured("100.06"), ds(" .06 ")},
      {{"--scale", "2001"}, measured("100.06"), ""},
      {{"--scale", "4999"}, measured("100.4"), ds(" .4 ")},
      {{"--scale", "5000"}, measured("100.4"), ""},
      {{"--scale", "5000"}, measured("102"), ds(" 2 ")},
      {{"--scale", "5000"}, measured("97.5"), ds("-2.5 ")},
      {{}, "S 1234560 10 900000 1.5\r\n", "\r\nDiem S            nhap sai phan giay\r\n"},
      {{}, "S 1234559.9 10 900000 1.5\r\n", ""},
      {{}, "S 1234599.6 10 900000 1.5\r\n", ""},  // -0.4 seconds carried into 46 minutes
      {{}, "S 1236000 10 900000 1.5\r\n", "\r\nDiem S            nhap sai phan phut\r\n"},
      {{}, "S 0 10 0895960 1.5\r\n", "\r\nDiem S            nhap sai phan giay\r\n"},
      {{}, "S 0 2000 900000 1.5\r\n", ""},
      {{},
       "S 0 2000.01 900000 1.5\r\n",
       "\r\nDiem S            co the nhap sai canh\r\n\r\nDiem S            co the nhap sai "
       "canh\r\n"},
      {{"--asc", "--sketch"},
       "A 1.45 0.5 900000 0.5\r\n",
       "",
       {{".td1", "A         999.500    1000.000      11.000      .500\r\n"},
        {".sdo", "|A     |     .500 |     0 00 02  |"}}},
      {{"--txt"}, heights, "", {{".txt", "       11.5  \r\n"}, {".txt", "      12.75  \r\n"}}},
      {{"--txt", "--height-decimals", "1"},
       heights,
       "",
       {{".txt", "       11.5  \r\n"}, {".txt", "       12.8  \r\n"}}},
      {{"--txt", "--height-decimals", "0"},
       heights,
       "",
       {{".txt", "         12  \r\n"}, {".txt", "         13  \r\n"}}},
      {{"--txt", "--height-decimals", "-1"}, heights, "", {{".txt", "         13  \r\n"}}},
  };
  for (const Case& c : cases) {
    const Outcome run = Compute(Book(c.body), c.options);
    const std::string err = run.Product(".err");
    SCOPED_TRACE(c.body + err);
    EXPECT_EQ(run.code, c.report.empty() ? kExitOk : kExitDataErrors);
    if (!c.report.empty()) {
      EXPECT_EQ(err.substr(err.find("-\r\n") + 3), c.report);
    }
    for (const auto& [product, text] : c.shown) {
      EXPECT_NE(run.Product(product).find(text), std::string::npos) << product << " " << text;
    }
  }
}

// The azimuth is held in single precision: quarter turns come out a few
// millionths of a degree off, as the office's products always showed.
TEST(Corners, SinglePrecisionAzimuthsAndDistance) {
  RunState st;
  st.xTR = st.yTR = 1000;
  for (const auto& [x, y, azimuth] :
       {std::tuple{900.0, 1000.0, 0.0}, std::tuple{1000.0, 900.0, 90.0000025},
        std::tuple{1000.0, 1100.0, 270.0000007}, std::tuple{1100.0, 1000.0, 180.000005},
        std::tuple{900.0, 900.0, 45.0000013}}) {
    st.xDKD = x;
    st.yDKD = y;
    TinhPhuongViCanh(st);
    EXPECT_NEAR(st.gpv, azimuth, 1e-7) << x << " " << y;
  }
  EXPECT_DOUBLE_EQ(st.cdh, 100 * std::sqrt(2.0));
  // Radians from degrees with pi to 15 digits, as every angle of the book.
  st.goc = 1800000;
  gocdo(st);
  EXPECT_EQ(st.rad, 3.14159265358979);
}

// The check reading: on KC3 seen oriented on KC2 it is 270, on KC2 oriented
// on KC3 0 - 270 wraps to 90. A recorded reading is kept; a reading of 0 is
// made up within 32 seconds of the computed one.
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

// --kind overrides the extension; 4 mm labels at 1:500 are 2 m high in the
// drawing, the control points' 3 m.
TEST(Corners, KindAndTextHeightOfTheBatchCommand) {
  const std::string book = Book("1 0 10 900000 1.5\r\n");
  EXPECT_EQ(Compute(book, {"--kind", "0", "--txt"}, ".dat").code, kExitOk);
  EXPECT_EQ(Compute(book, {"--txt"}, ".dat").code, kExitStopped);  // kind 9: job.asc needed
  const Outcome other = Compute(book, {"--kind", "9"}, ".asc");
  EXPECT_EQ(other.code, kExitOk);
  const std::string dxf =
      Compute(book, {"--dxf", "--text-height", "4", "--scale", "500"}).Product(".dxf");
  EXPECT_NE(dxf.find(" 40\r\n 2 \r\n"), std::string::npos) << dxf;
  EXPECT_NE(dxf.find(" 40\r\n 3 \r\n"), std::string::npos) << dxf;
}

// A .gre file is an SDR recording, its numbers filling their columns up to
// the next: 1234 at zenith 89.5 is 1233.953 m, 45 turned to the backsight at
// 45.5 wraps to 359 30 00; heights kept as recorded; a description of two
// characters names no point, nor renames a listed backsight.
TEST(Corners, GreFileConvertedAsSdrColumnByColumn) {
  const std::string gre =
      "08KI0001  1000.000  1000.0000000010.00          KC1\r\n"
      "08KI0002   900.000  1000.0000000010.00          K2\r\n"
      "02TP0001                                   1.500\r\n"
      "07TP    0002\r\n"
      "09F1    000200000001000090.000000000045.50MOC5\r\n"
      "03NM000001.500\r\n"
      "09F1    000300000012340089.500000000000045\r\n";
  const Outcome run = Compute(gre, {"--txt"}, ".gre");
  EXPECT_EQ(run.code, kExitOk);
  EXPECT_EQ(run.Product(".asc"),
            "TR KC1    1000.000    1000.000 0000010.00\r\n"
            "TR DKC0002     900.000    1000.000 0000010.00\r\n"
            "TR KC1 1.500\r\n"
            "DKD DKC0002\r\n"
            "DKC0002    00000  100.000   900000    0.0 DKC0002\r\n"
            "3     3593000 1233.953   893000 000001.500 \r\n");
}

// A body record by its field count, "KT" in any case, and a sixth field that
// names a peg (3 characters or more, not all digits and points).
TEST(Corners, KindOfABodyRecord) {
  const std::vector<std::pair<std::vector<std::string_view>, BodyRecord>> cases = {
      {{"1", "0", "10", "900000"}, BodyRecord::TooFew},
      {{"1", "0", "10", "900000", "1.5"}, BodyRecord::Detail},
      {{"1", "0", "10", "900000", "1.5", "CP1"}, BodyRecord::Peg},
      {{"1", "0", "10", "900000", "1.5", "CP"}, BodyRecord::Detail},
      {{"1", "0", "10", "900000", "1.5", "12.5"}, BodyRecord::Detail},
      {{"1", "0", "10", "900000", "1.5", "K2", "kt"}, BodyRecord::Check},
      {{"1", "0", "10", "900000", "1.5", "MOC", "N"}, BodyRecord::Peg},
      {{"1", "0", "10", "900000", "1.5", "123", "KTX"}, BodyRecord::Detail},
      {{"1", "0", "10", "900000", "1.5", "K2", "KT", "x"}, BodyRecord::TooMany},
  };
  for (const auto& [fields, kind] : cases) {
    EXPECT_EQ(BodyRecordOf(fields), kind) << fields.size() << " " << fields.back();
  }
}

}  // namespace
}  // namespace kavu
