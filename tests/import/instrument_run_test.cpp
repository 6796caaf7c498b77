// Instrument files through a whole run: the example job of every kind, a
// coordinate checked against an azimuth and a reduced distance worked out
// here from the raw values; the real recordings beside the tree.
#include <cmath>
#include <map>
#include <string>
#include <vector>

#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

const Xy kKc01{5000, 3000}, kKc02{5100, 3050}, kKc03{4950, 3120};
const Xy kGps01{2341520.412, 585310.227}, kGps02{2341688.905, 585402.618},
    kGps03{2341605.330, 585561.774}, kGps04{2341432.118, 585498.501};

double Degrees(double d, double m, double s) { return d + m / 60 + s / 3600; }

// A point shot with the circle reading `circle` when the orientation point
// was read at `circle0`; slope distance and zenith angle as recorded.
Xy Shot(Xy station, Xy orientation, double circle0, double circle, double slope, double zenith) {
  return Polar(station, orientation, circle - circle0,
               slope * std::sin(zenith * std::acos(-1.0) / 180));
}

class InstrumentRun : public InstrumentRunTest {};
using RealRecordings = InstrumentRun;

TEST_F(InstrumentRun, ExampleJobsComputeToTheirShots) {
  struct Job {
    const char* file;
    bool control;        // the Topcom jobs take their control points from a common file
    std::size_t points;  // lines of the coordinate text file's names
    const char* name;
    Xy expected;
  };
  const Job jobs[] = {
      // 101 is shot before the backsight KC02 (read at 349.315051): turned.
      {"job-sdr.sdr", false, 6, "101",
       Shot(kKc01, kKc02, 349.315051, 15.880102, 50.0025, 89.427061)},
      // The backsight shots KC02 and KC01 check the orientation distances,
      // no points; 105 from KC03 on KC01.
      {"job-obs.obs", false, 6, "105",
       Shot(kKc03, kKc01, 351.11986495, 95.36989765, 50.00022500, 89.82811318)},
      // 103 twice, the second from KC02 on KC01, read at 194.56505118.
      {"job-set.set", false, 8, "103",
       Shot(kKc02, kKc01, 194.56505118, 224.30993247, 72.11369079, 90.49260855)},
      // 113 from GPS04 on GPS03 in whole seconds.
      {"job-idx.idx", true, 16, "113", Polar(kGps04, kGps03, Degrees(215, 57, 52), 89.659)},
      // 205 from GPS01, circle 0 00 02 on GPS04: 293 25 37 - 2"; the peg and
      // the orientation sights are no detail points.
      {"job-tcm.tcm", true, 9, "205", Polar(kGps01, kGps04, Degrees(293, 25, 35), 42.866)},
  };
  const std::filesystem::path examples = std::filesystem::path(KAVU_EXAMPLES) / "instruments";
  for (const Job& job : jobs) {
    SCOPED_TRACE(job.file);
    std::vector<std::string> args{"--txt", "--seed", "1"};
    if (job.control) {
      args.insert(args.end(), {"--control-file", (examples / "job-idx-tcm-control.txt").string()});
    }
    EXPECT_EQ(Run(examples / job.file, args), kExitOk);
    const auto points = Coordinates(std::filesystem::path(job.file).stem().string() + ".txt");
    EXPECT_EQ(points.size(), job.points);
    // Readings through whole seconds, distances through millimetres.
    ExpectNear(points, job.name, job.expected, 0.002);
  }
}

// The real recordings, each run on its own without a control file: its known
// points reach the field book, the points it shot again agree with its own
// coordinates, and what cannot be computed is reported.
struct Point {
  const char* name;
  double x, y;  // north, east
};

TEST_F(RealRecordings, ComputeOnTheirOwn) {
  if (!std::filesystem::is_directory(KAVU_REALDATA)) {
    GTEST_SKIP() << "no real recordings at " << KAVU_REALDATA;
  }
  struct Case {
    const char* file;
    std::vector<Point> known;      // coordinate records as the field book must hold them
    std::vector<Point> shot = {};  // computed points and the file's coordinates of them
    std::vector<const char*> reported = {}, never_reported = {};
    // Lines the converted field book holds (trimmed), and names the
    // coordinate text file must not list.
    std::vector<const char*> book = {}, not_computed = {};
  };
  const std::vector<Point> stlev = {{"STLEV", 15102.106, 6594.363},
                                    {"KRYSHA", 14783.699, 6463.655}};
  const std::vector<const char*> fits = {"KHAC TOA DO", "khong co toa do"};
  const Case cases[] = {
      {"barnes-example.sdr",
       {{"DKC0001", 0, 0}, {"DKC0003", -14.791761, -168.03557}},
       {},
       // The first set-up's backsight 9999 has no coordinates anywhere.
       {"Diem: DKC9999      khong co toa do", "Cac diem mia 9999  - 1027  khong duoc tinh"},
       // Every backsight shot with a distance fits the coordinates.
       {"Sai canh dinh huong", "KHAC TOA DO"}},
      // 101 and 102 shot again as 1011 and 1012 (the backsight never under
      // its own name: the circle reading of 07KI turns the set-up).
      {"geoeasy-focus6-1.sdr",
       {{"101", -4.347, -6.794}, {"202", -2.422, 4.773}},
       {{"1011", -4.347, -6.794}, {"1012", -0.172, -6.773}},
       {},
       fits},
      // The angle-only shot on the backsight KRYSHA is its orientation
      // distance record (nothing to check), no point without distance.
      {"geoeasy-20151125.obs",
       stlev,
       {},
       {},
       {"KHAC TOA DO", "khong co toa do", "khong co khoang cach"},
       {"KRYSHA        00000    0.000   801608 0.00000000 KRYSHA"},
       {"KRYSHA"}},
      {"geoeasy-sdr33-20151204.sdr",
       stlev,
       {},
       {},
       {"KHAC TOA DO", "khong co toa do", "khong co khoang cach"},
       {"KRYSHA        00000    0.000   801709 0.00000000 KRYSHA"},
       {"KRYSHA"}},
      // The backsight OR has no coordinates: the set-up is reported. Its
      // shot carries its name as the other shots on a backsight do.
      {"tops-pr-sokkia_sdr33_polar.sdr",
       {{"STZTEMP", 0, 0}, {"1", 19.914, 9.217}, {"33", 10.289, 11.174}},
       {},
       {"Diem: OR           khong co toa do"},
       {},
       {"OR            00000    0.000   851345  1.530 OR"}},
      {"geoeasy-20151130.set", stlev, {}, {}, fits},
      // No observation at all: its known points only, and the run stops.
      {"tops-sokkia_sdr33.set", {{"00000031", 509.97, 937.274}, {"00000020", 506.797, 915.514}}},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.file);
    Run(std::filesystem::path(KAVU_REALDATA) / c.file, {"--txt", "--asc", "--seed", "1"});
    const std::string stem = std::filesystem::path(c.file).stem().string();
    std::map<std::string, Xy> known;
    for (std::string line :
         ReadLines(dir_ / (stem + ".asc")).value_or(std::vector<std::string>())) {
      line = Trim(line);
      const std::vector<std::string> f = SplitFields(line);
      if (f.size() >= 4 && f[0] == "TR") known.emplace(f[1], Xy{Val(f[2]), Val(f[3])});
    }
    for (const Point& p : c.known) ExpectNear(known, p.name, {p.x, p.y}, 1e-6);
    const std::string book = FileBytes(dir_ / (stem + ".asc"));
    for (const char* line : c.book) {
      EXPECT_NE(book.find(std::string("\n") + line + "\r\n"), std::string::npos) << line;
    }
    const auto points = Coordinates(stem + ".txt");
    for (const Point& p : c.shot) ExpectNear(points, p.name, {p.x, p.y}, 0.005);
    for (const char* name : c.not_computed) EXPECT_FALSE(points.contains(name)) << name;
    const std::string report = FileBytes(dir_ / (stem + ".err"));
    for (const char* line : c.reported) {
      EXPECT_NE(report.find(std::string("\r\n") + line + "\r\n"), std::string::npos) << line;
    }
    for (const char* text : c.never_reported) {
      EXPECT_EQ(report.find(text), std::string::npos) << text;
    }
  }
}

}  // namespace
}  // namespace kavu::testing
