// The real recordings, each run on its own as a surveyor drops it onto the
// program, without a control file: what the file says of itself is the
// expected result. Its known points reach the field book, the orientation
// bearings agree with the azimuths its backsight records hold, the points it
// shot again agree with its own coordinates, and what cannot be computed is
// reported.
#include <cctype>
#include <cmath>
#include <map>
#include <string>
#include <vector>

#include "core/angles.h"
#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

bool HaveRealData() { return std::filesystem::is_directory(KAVU_REALDATA); }

struct Point {
  const char* name;
  double x, y;  // north, east
};

// A set-up and the station-to-backsight azimuth its backsight record holds.
struct Bearing {
  const char* station;
  const char* backsight;
  double azimuth;
};

struct RealCase {
  const char* file;
  std::vector<Point> known;       // coordinate records as the field book must hold them
  std::vector<Bearing> bearings;  // from the 07TP/07KI records
  std::vector<Point> shot;        // computed points and the file's coordinates of them
  std::vector<const char*> reported;
  std::vector<const char*> never_reported;
};

// Name -> X, Y of the control-point records of a field book; set-ups as
// (station, backsight) in order.
struct Book {
  std::map<std::string, Xy> known;
  std::vector<std::pair<std::string, std::string>> setups;
};

Book ReadBook(const std::filesystem::path& path) {
  Book book;
  const std::vector<std::string> lines = ReadLines(path).value_or(std::vector<std::string>());
  for (std::size_t i = 0; i < lines.size(); ++i) {
    std::string line = Trim(lines[i]);
    const std::vector<std::string> f = SplitFields(line);
    if (f.size() >= 4 && f[0] == "TR") book.known.emplace(f[1], Xy{Val(f[2]), Val(f[3])});
    if (f.size() == 3 && f[0] == "TR" && i + 1 < lines.size() && lines[i + 1].starts_with("DKD ")) {
      book.setups.emplace_back(f[1], Trim(lines[i + 1].substr(4)));
    }
  }
  return book;
}

double Azimuth(Xy from, Xy to) {
  const double degrees = std::atan2(to.y - from.y, to.x - from.x) * 180 / std::acos(-1.0);
  return degrees < 0 ? degrees + 360 : degrees;
}

class RealRecordings : public InstrumentRunTest {};

TEST_F(RealRecordings, ComputeOnTheirOwn) {
  if (!HaveRealData()) GTEST_SKIP() << "no real recordings at " << KAVU_REALDATA;
  const RealCase cases[] = {
      {"barnes-example.sdr",
       {{"DKC0001", 0, 0}, {"DKC0003", -14.791761, -168.03557}},
       {{"DKC0002", "DKC0001", 243.172137},
        {"DKC0001", "DKC0002", 63.1721374},
        {"DKC0003", "DKC0001", 84.9692915},
        {"DKC0004", "DKC0003", 95.2444306}},
       {},
       // The first set-up's backsight 9999 has no coordinates anywhere.
       {"Diem: DKC9999      khong co toa do", "Cac diem mia 9999  - 1027  khong duoc tinh"},
       // Every backsight shot with a distance fits the coordinates.
       {"Sai canh dinh huong", "KHAC TOA DO"}},
      {"geoeasy-focus6-1.sdr",
       {{"101", -4.347, -6.794}, {"202", -2.422, 4.773}},
       {{"202", "101", 260.55138889}},
       // 101 and 102 shot again as 1011 and 1012 (the backsight never under
       // its own name: the circle reading of 07KI turns the set-up).
       {{"1011", -4.347, -6.794}, {"1012", -0.172, -6.773}},
       {},
       {"KHAC TOA DO", "khong co toa do"}},
      {"geoeasy-20151125.obs",
       {{"STLEV", 15102.106, 6594.363}, {"KRYSHA", 14783.699, 6463.655}},
       {{"STLEV", "KRYSHA", 202.31844673}},
       {},
       {},
       {"KHAC TOA DO", "khong co toa do"}},
      {"geoeasy-20151130.set",
       {{"STLEV", 15102.106, 6594.363}, {"KRYSHA", 14783.699, 6463.655}},
       {{"STLEV", "KRYSHA", 202.31844673}},
       {},
       {},
       {"KHAC TOA DO", "khong co toa do"}},
      // No observation at all: its known points only, and the run stops.
      {"tops-sokkia_sdr33.set",
       {{"00000031", 509.97, 937.274}, {"00000020", 506.797, 915.514}},
       {},
       {},
       {},
       {}},
  };
  for (const RealCase& c : cases) {
    SCOPED_TRACE(c.file);
    const std::filesystem::path folder = dir_ / c.file;
    std::filesystem::create_directories(folder);
    std::filesystem::copy_file(std::filesystem::path(KAVU_REALDATA) / c.file, folder / c.file);
    const std::string input = (folder / c.file).string();
    const std::vector<std::string_view> args{"--txt", "--asc", "--seed", "1", input};
    std::ostringstream out, err;
    RunCli(args, out, err, false);
    const std::string stem = std::filesystem::path(c.file).stem().string();

    const Book book = ReadBook(folder / (stem + ".asc"));
    for (const Point& p : c.known) {
      const auto it = book.known.find(p.name);
      ASSERT_NE(it, book.known.end()) << p.name;
      EXPECT_NEAR(it->second.x, p.x, 1e-6) << p.name;
      EXPECT_NEAR(it->second.y, p.y, 1e-6) << p.name;
    }

    // The bearings the run oriented with: the set-ups its station listing
    // names (kept when the run reports something), else those its companion
    // file shows; a set-up whose shots are all angle-only is in the listing
    // only.
    Book used = ReadBook(folder / (stem + ".td1"));
    if (const auto listing = ReadLines(folder / (stem + ".cpv"))) {
      used.setups.clear();
      for (const std::string& line : *listing) {
        if (line.size() > 40 && std::isdigit(static_cast<unsigned char>(line[30]))) {
          used.setups.emplace_back(Trim(line.substr(0, 12)), Trim(line.substr(12, 12)));
        }
      }
      used.known = book.known;
    }
    ASSERT_EQ(used.setups.size(), c.bearings.size());
    for (std::size_t i = 0; i < c.bearings.size(); ++i) {
      const Bearing& b = c.bearings[i];
      EXPECT_EQ(used.setups[i].first, b.station);
      EXPECT_EQ(used.setups[i].second, b.backsight);
      const double azimuth = Azimuth(used.known.at(b.station), used.known.at(b.backsight));
      EXPECT_NEAR(azimuth, b.azimuth, 1.0 / 3600) << b.station;
    }

    const auto points = Coordinates(std::string(c.file) + "/" + stem + ".txt");
    tolerance_ = 0.005;
    for (const Point& p : c.shot) ExpectNear(points, p.name, {p.x, p.y});

    const std::string report = FileBytes(folder / (stem + ".err"));
    for (const char* line : c.reported) {
      EXPECT_NE(report.find(std::string("\r\n") + line + "\r\n"), std::string::npos) << line;
    }
    for (const char* text : c.never_reported) {
      EXPECT_EQ(report.find(text), std::string::npos) << text;
    }
  }
}

// The keyword file holds no control points, but its database lists the
// coordinates the instrument computed for 204 from station 1283 (at 0, 0,
// circle zero on north): the field book's reading of 204, turned to the
// orientation on 2000 (read at 17 57 31.6), and its distance give them back.
TEST(RealKeywordFile, ReadingsTurnedAndFacesReduced) {
  if (!HaveRealData()) GTEST_SKIP() << "no real recordings at " << KAVU_REALDATA;
  const std::string book = ConvertIdx(RealData("geoeasy-test.idx")).book;
  // Every set-up orients on 2000, which then reads 0.
  EXPECT_EQ(CountStarting(book, "TR "), 18);
  std::size_t oriented = 0;
  for (std::size_t at = 0; (at = book.find("DKD 2000\r\n2000     00000 ", at)) != std::string::npos;
       ++at) {
    ++oriented;
  }
  EXPECT_EQ(oriented, 18u);
  const double orientation = 17 + 57.0 / 60 + 31.6 / 3600;
  // Face 1, then face 2 (Hz 222 46 27.6, V 269 15 07.4) shot later.
  const Xy database[] = {{12.435712, 11.503488}, {12.431200, 11.501087}};
  std::size_t found = 0;
  for (std::string line : SplitLines(book)) {
    if (!line.starts_with("204 ")) continue;
    ASSERT_LT(found, 2u);
    const std::vector<std::string> f = SplitFields(line);
    const Xy p = database[found++];
    EXPECT_NEAR(CvGocDbl(f[1]) + orientation, Azimuth({0, 0}, p), 1.0 / 3600) << line;
    EXPECT_NEAR(Val(f[2]), std::hypot(p.x, p.y), 0.001) << line;
    EXPECT_LT(CvGocDbl(f[3]), 180) << line;
  }
  EXPECT_EQ(found, 2u);
}

}  // namespace
}  // namespace kavu::testing
