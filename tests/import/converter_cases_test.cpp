// Short recordings of the converters' corners, each through a whole batch run
// in a folder of its own: the lines its products must hold, the names they
// must not list, and its error report, worked out by hand.
#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "core/tcvn3.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

namespace fs = std::filesystem;

const std::string kSdr20 = "00NMSDR20     V03-05    01-Jan-24 08:00 111111\r\n";
const std::string kSdr33 = "00NMSDR33     V04-04.02 01-Jan-24 08:00 111111\r\n";

// Records of the 4-column layout: 10-character numbers after 4-character
// identifiers.
std::string N(const std::string& text) { return text + std::string(10 - text.size(), ' '); }
std::string Known(const std::string& id, const std::string& x, const std::string& y,
                  const std::string& description = "") {
  return Rec("08KI", {{5, id}, {9, N(x)}, {19, N(y)}, {29, N("10.000")}, {49, description}});
}
std::string Station(const std::string& id, const std::string& x = "", const std::string& y = "",
                    const std::string& description = "") {
  const std::string h = x.empty() ? "" : "10.000";
  return Rec("02TP",
             {{5, id}, {9, N(x)}, {19, N(y)}, {29, N(h)}, {39, N("1.500")}, {49, description}});
}
std::string Backsight(const std::string& station, const std::string& target) {
  return Rec("07TP", {{5, station}, {9, target}});
}
// A level shot (zenith 90) with its slope distance and circle reading.
std::string Shot(const std::string& station, const std::string& target, const std::string& slope,
                 const std::string& reading) {
  return Rec("09F1",
             {{5, station}, {9, target}, {13, N(slope)}, {23, N("90.0000")}, {33, N(reading)}});
}

// The same records in the 16-column layout: every field right-aligned in 16.
std::string W(const std::string& text) { return std::string(16 - text.size(), ' ') + text; }
std::string WideShot(const std::string& target, const std::string& slope,
                     const std::string& reading) {
  return Rec(
      "09F1",
      {{5, W("KC01")}, {21, W(target)}, {37, W(slope)}, {53, W("90.0000")}, {69, W(reading)}});
}

// The wide scene: station KC01 (5000, 3000), backsight KC02 100 m north of
// it, the prism at 1.5 m; P shot 90 degrees clockwise from KC02 at 50 m, so
// due east at (5000, 3050), H 10 + 1.5 - 1.5. The backsight's distance as
// recorded: 101 m, or blank (an angle-only sight).
std::string WideScene(const std::string& header, const std::string& backsight_distance) {
  std::string file = header;
  for (const auto& [id, x] : {std::pair{"KC01", "5000.000"}, std::pair{"KC02", "5100.000"}}) {
    file += Rec("08KI", {{5, W(id)}, {21, W(x)}, {37, W("3000.000")}, {53, W("10.000")}});
  }
  return file + Rec("02TP", {{5, W("KC01")}, {69, W("1.500")}}) +
         Rec("07TP", {{5, W("KC01")}, {21, W("KC02")}}) + Rec("03NM", {{5, "1.500"}}) +
         WideShot("KC02", backsight_distance, "10.0000") + WideShot("P", "50.000", "100.0000");
}

struct Case {
  const char* file;  // its extension picks the kind
  std::string bytes;
  std::string control;  // a common control-point file, when the file has no known points
  // Product (".asc" the converted book, "TRIDO" the regenerated one) and a
  // whole line it must hold.
  std::vector<std::pair<std::string, std::string>> shown;
  std::vector<std::string> not_computed = {};  // names the .txt must not list
  std::string report = {};                     // after the error report's head; "" for none
};

TEST(ConverterCases, ProductsOfEachCorner) {
  const Case cases[] = {
      // Lines ending in a tab have an empty last field: the points 10 m due
      // west of A, every word after the prism height keeping its blank.
      {"tabs.asc",
       "TR A 1000.000 1000.000 10.000\r\nTR B 900.000 1000.000 10.000\r\nTR A 1.500\r\nDKD B\r\n"
       "P1 0900000 10.000 0900000 1.5\t\r\nP2 0900000 10.000 0900000 1.5\tN\t\r\n",
       "",
       {{".td1", "P1       1000.000     990.000      10.000     1.500 "},
        {".td1", "P2       1000.000     990.000      10.000     1.500 N "},
        {".txt", "P1    1000.000    990.000            10  "},
        {".txt", "P2    1000.000    990.000            10 N "},
        {"TRIDO", "P1 0900000 10.000 0900000 1.5 "},
        {"TRIDO", "P2 0900000 10.000 0900000 1.5 N "}}},
      // The set-up on 0012, listed without description, describes itself as
      // TRAM, 0013's name: it stays DKC0012, 20 due south of it at 50 m.
      {"setup-description.sdr",
       kSdr20 + Known("0013", "500.000", "600.000", "TRAM") + Known("0012", "100.000", "200.000") +
           Known("0014", "100.000", "300.000", "BS1") +
           Station("0012", "100.000", "200.000", "TRAM") + Backsight("0012", "0014") +
           Rec("03NM", {{5, "1.500"}}) + Shot("0012", "0014", "100.000", "0.0000") +
           Shot("0012", "0020", "50.000", "90.0000"),
       "",
       {{".asc", "TR DKC0012 1.500"}, {".txt", "20    50.000      200.000            10  "}}},
      // The 16-column layout's shot on the backsight is its orientation
      // distance, 101 m checked against 100 m, no computed point.
      {"backsight.obs",
       WideScene("", "101.000"),
       "",
       {{".asc", "KC02          00000  101.000   900000  1.500 KC02"},
        {".txt", "P     5000.000    3050.000           10  "}},
       {"KC02"},
       "\r\nTram KC01        " + Utf8ToTcvn3("Định hướng ") +
           "KC02        Sai canh dinh huong DS=  1 \r\n"},
      // An angle-only backsight (blank distance) has nothing to check and is
      // not reported as a point without distance.
      {"angle-only-backsight.sdr",
       WideScene(kSdr33, ""),
       "",
       {{".txt", "P     5000.000    3050.000           10  "}},
       {"KC02"}},
      // Face pairs, one face without distance and the other negative: |SD sin
      // Z| of the one that has it. P east of S at 50 m, Q north at 30 m.
      {"face-pairs.idx",
       "STN_ID \"S\"\r\nINST_HT 1.5;\r\n\r\n\r\n1,\"B\",1,0,90,100,1.5\r\n"
       "2,\"P\",1,90,90,,1.5\r\n3,\"P\",1,270,270,-50,1.5\r\n"
       "4,\"Q\",1,180,270,-30,1.5\r\n5,\"Q\",1,0,90,0,1.5\r\nEND SLOPE\r\n",
       "TR S 1000 1000 10\r\nTR B 1100 1000 10\r\n",
       {{".txt", "P     1000.000    1050.000           10  "},
        {".txt", "Q     1030.000    1000.000           10  "}}},
      // LINEAR FT is feet: 100 ft is 30.48 m; heights of 5 ft cancel out.
      {"feet.idx",
       "LINEAR FT\r\nSTN_ID \"S\"\r\nINST_HT 5;\r\n\r\n\r\n1,\"B\",1,0,90,100,5\r\n"
       "2,\"P\",1,90,90,100,5\r\nEND SLOPE\r\n",
       "TR S 1000 1000 10\r\nTR B 1100 1000 10\r\n",
       {{".txt", "P     1000.000    1030.480           10  "}}},
      // The identifier "538 " is the point 538 computed at (1000, 1050): the
      // set-up on it is DKC538, found among the computed points.
      {"padded-id.sdr",
       kSdr20 + Known("0001", "1000.000", "1000.000") + Known("0002", "1100.000", "1000.000") +
           Station("0001") + Backsight("0001", "0002") + Rec("03NM", {{5, "1.500"}}) +
           Shot("0001", "0002", "100.000", "0.0000") + Shot("0001", "538 ", "50.000", "90.0000") +
           Station("538 ") + Backsight("538 ", "0001") + Shot("538 ", "0001", "50.000", "0.0000") +
           Shot("538 ", "0600", "20.000", "90.0000"),
       "",
       {{".asc", "TR DKC538 1.500"}, {".txt", "600   1020.000    1050.000           10  "}}},
  };
  const std::string head =
      "        THONG BAO CAC LOI NHAP SO LIEU\r\n      ----------------------------------\r\n";
  for (const Case& c : cases) {
    SCOPED_TRACE(c.file);
    const fs::path folder = FreshFolder("kavu-converter-cases") / fs::path(c.file).stem() / "data";
    fs::create_directories(folder);
    const fs::path file = folder / c.file;
    WriteBytes(file, c.bytes);
    std::vector<std::string> args{file.string(), "--asc", "--txt", "--seed", "1"};
    if (!c.control.empty()) {
      WriteBytes(folder / "control.txt", c.control);
      args.insert(args.end(), {"--control-file", (folder / "control.txt").string()});
    }
    Cli(args);

    const std::string stem = file.stem().string();
    auto product = [&](const std::string& kind) {
      return FileBytes(kind == "TRIDO" ? folder.parent_path() / "TRIDO" / (stem + ".asc")
                                       : folder / (stem + kind));
    };
    for (const auto& [kind, line] : c.shown) {
      EXPECT_NE(("\n" + product(kind)).find("\n" + line + "\r\n"), std::string::npos)
          << kind << ": '" << line << "'\n"
          << product(kind);
    }
    const std::string txt = product(".txt");
    for (const std::string& name : c.not_computed) {
      EXPECT_EQ(("\n" + txt).find("\n" + name + " "), std::string::npos) << name << "\n" << txt;
    }
    if (c.report.empty()) {
      EXPECT_FALSE(fs::exists(folder / (stem + ".err"))) << product(".err");
    } else {
      EXPECT_EQ(product(".err"), head + c.report);
    }
  }
}

}  // namespace
}  // namespace kavu::testing
