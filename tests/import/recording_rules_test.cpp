// Made-up recordings, one per header declaration and per reading rule, each
// run without a control file: the point P must land where an azimuth and a
// distance from the known points put it.
#include <charconv>
#include <cmath>
#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

// The scene: station A, backsight B, the circle reading 30 on B; P is shot
// 50 degrees clockwise from B at 40 m horizontal, zenith 88.
const Xy kA{1000, 2000};
const Xy kB{1100, 2050};
constexpr double kCircleOnB = 30;
constexpr double kTurn = 50;
constexpr double kDistance = 40;
constexpr double kZenith = 88;
// The slope distance recorded for a horizontal one at the zenith kZenith.
double Slope(double horizontal) { return horizontal / std::sin(kZenith * std::acos(-1.0) / 180); }
const double kSlope = Slope(kDistance);
const double kSlopeToB = Slope(std::hypot(kB.x - kA.x, kB.y - kA.y));
const Xy kP = Polar(kA, kB, kTurn, kDistance);

// How a recording states its values.
struct Dialect {
  const char* instrument = "SDR20";
  const char* digits = "111111";  // the unit digits closing "00NM"
  int width = 4;                  // identifier columns
  const char* job = nullptr;      // a "10NM" record, when there is one
  double per_degree = 1;          // angle units per degree
  double per_metre = 1;           // length units per metre
  bool east_north = false;
  bool counter_clockwise = false;
};

std::string Number(double value, std::size_t width) {
  char text[64];
  const auto end = std::to_chars(text, text + sizeof text, value, std::chars_format::fixed, 8).ptr;
  std::string s(text, end);
  s.resize(std::min(s.size(), width - 1), ' ');  // one blank keeps fields apart
  s.resize(width, ' ');
  return s;
}

// A record: its code, then fields placed at their columns.
std::string Record(std::string code, std::vector<std::pair<std::size_t, std::string>> fields) {
  for (const auto& [column, text] : fields) {
    if (code.size() < column - 1) code.resize(column - 1, ' ');
    code.replace(column - 1, text.size(), text);
  }
  return code + "\r\n";
}

// An SDR-family recording of the scene in a dialect. The station and
// backsight records use `station`/`backsight` codes; without a circle
// reading the backsight record leaves it blank; `shoot_backsight` adds the
// observation of B.
struct Scene {
  std::string station = "02TP", backsight = "07TP";
  bool circle = true;
  bool shoot_backsight = true;
  std::string a = "0001", b = "0002", p = "0003";
  bool then_setup_on_b_without_backsight = false;  // shooting point 4
};

std::string Recording(const Dialect& d, const Scene& s) {
  const bool wide = d.width == 16;
  const std::size_t n = wide ? 16 : 10;
  auto id = [&](const std::string& name) {
    return wide ? std::string(16 - name.size(), ' ') + name : name;
  };
  auto len = [&](double metres) { return Number(metres * d.per_metre, n); };
  auto angle = [&](double degrees) { return Number(degrees * d.per_degree, n); };
  auto reading = [&](double degrees) {
    return angle(d.counter_clockwise ? 360 - degrees : degrees);
  };
  auto xy = [&](Xy p) {
    return d.east_north ? std::pair{len(p.y), len(p.x)} : std::pair{len(p.x), len(p.y)};
  };
  // Columns: identifier, X, Y, H, instrument height; backsight, its
  // circle reading; target, slope, zenith, reading.
  const std::size_t c[] = {5, wide ? 21u : 9u, wide ? 37u : 19u, wide ? 53u : 29u,
                           wide ? 69u : 39u};
  const std::size_t t = wide ? 21 : 9, sd = wide ? 37 : 13, z = wide ? 53 : 23, ha = wide ? 69 : 33,
                    circle = wide ? 53 : 23;

  std::string file = Record("00NM" + std::string(d.instrument) + "     V03-05    01-Jan-24 08:00 " +
                                std::string(d.digits),
                            {});
  if (d.job != nullptr) file += Record("10NM" + std::string(d.job), {});
  for (const auto& [name, p] : {std::pair{s.a, kA}, std::pair{s.b, kB}}) {
    const auto [x, y] = xy(p);
    file += Record("08KI", {{c[0], id(name)}, {c[1], x}, {c[2], y}, {c[3], len(10)}});
  }
  file += Record(s.station, {{c[0], id(s.a)}, {c[4], len(1.5)}});
  file += Record(
      s.backsight,
      {{c[0], id(s.a)}, {t, id(s.b)}, {circle, s.circle ? reading(kCircleOnB) : std::string()}});
  file += Record("03NM", {{5, len(1.5)}});
  auto shot = [&](const std::string& target, double slope, double circle_reading) {
    return Record("09F1", {{5, id(s.a)},
                           {t, id(target)},
                           {sd, len(slope)},
                           {z, angle(kZenith)},
                           {ha, reading(circle_reading)}});
  };
  if (s.shoot_backsight) file += shot(s.b, kSlopeToB, kCircleOnB);
  file += shot(s.p, kSlope, kCircleOnB + kTurn);
  if (s.then_setup_on_b_without_backsight) {
    file += Record(s.station, {{c[0], id(s.b)}, {c[4], len(1.5)}});
    file += shot("0004", kSlope, kCircleOnB + kTurn);
  }
  return file;
}

class RecordingRules : public InstrumentRunTest {
 protected:
  // Runs a recording as the file `name` in a folder of its own.
  int RunFile(const std::string& folder, const std::string& name, const std::string& bytes) {
    std::filesystem::create_directories(dir_ / folder);
    WriteBytes(dir_ / folder / name, bytes);
    const std::string path = (dir_ / folder / name).string();
    const std::vector<std::string_view> args{"--txt", "--seed", "1", path};
    std::ostringstream out, err;
    return RunCli(args, out, err, false);
  }
  std::string Report(const std::string& folder, const std::string& stem) const {
    return FileBytes(dir_ / folder / (stem + ".err"));
  }
};

TEST_F(RecordingRules, HeaderDeclarationsAreHonoured) {
  struct Case {
    const char* what;
    const char* file;  // its extension picks the kind
    Dialect dialect;
    const char* p_name;  // the name P gets in the field book
  };
  const Case cases[] = {
      {"gon", "g.sdr", {.digits = "211111", .per_degree = 400.0 / 360}, "3"},
      {"mil", "m.sdr", {.digits = "311111", .per_degree = 6400.0 / 360}, "3"},
      {"feet", "f.sdr", {.digits = "121111", .per_metre = 1 / 0.3048}, "3"},
      {"east-north", "e.sdr", {.digits = "111121", .east_north = true}, "3"},
      {"counter-clockwise", "c.sdr", {.digits = "111112", .counter_clockwise = true}, "3"},
      {"16 columns by job record", "j.sdr", {.width = 16, .job = "JOB1            1"}, "0003"},
      {"16 columns by SDR33", "s.gre", {.instrument = "SDR33", .width = 16}, "0003"},
      {"4 columns in an .obs", "o.obs", {.width = 4, .job = "JOB1            4"}, "3"},
      {"all at once, wide",
       "w.obs",
       {.digits = "222122",
        .width = 16,
        .per_degree = 400.0 / 360,
        .per_metre = 1 / 0.3048,
        .east_north = true,
        .counter_clockwise = true},
       "0003"},
  };
  for (const Case& c : cases) {
    EXPECT_EQ(RunFile(c.what, c.file, Recording(c.dialect, Scene{})), kExitOk) << c.what;
    const std::string stem = std::string(c.file).substr(0, 1);
    const auto points = Coordinates(std::string(c.what) + "/" + stem + ".txt");
    ExpectNear(points, c.p_name, kP);
  }
}

TEST_F(RecordingRules, SetUpRules) {
  struct Case {
    const char* what;
    Scene scene;
    bool p_computed;
    const char* not_computed;  // a point the run reports as not computed
  };
  const Case cases[] = {
      {"keyed-in set-up codes", {.station = "02KI", .backsight = "07KI"}, true, nullptr},
      {"backsight never shot: the recorded circle turns",
       {.shoot_backsight = false},
       true,
       nullptr},
      {"nothing to turn by", {.circle = false, .shoot_backsight = false}, false, "3"},
      {"blanks inside identifiers", {.a = "  12", .b = "B  2"}, true, nullptr},
      // Not computed from the set-up before it.
      {"a set-up without backsight record", {.then_setup_on_b_without_backsight = true}, true, "4"},
  };
  for (const Case& c : cases) {
    EXPECT_EQ(RunFile(c.what, "r.sdr", Recording({}, c.scene)), c.not_computed ? 1 : kExitOk)
        << c.what;
    const auto points = Coordinates(std::string(c.what) + "/r.txt");
    if (c.p_computed) ExpectNear(points, "3", kP);
    if (c.not_computed != nullptr) {
      EXPECT_EQ(points.count(c.not_computed), 0u) << c.what;
      EXPECT_NE(Report(c.what, "r").find(" khong duoc tinh"), std::string::npos) << c.what;
    }
  }
}

TEST_F(RecordingRules, UnknownDeclarationIsReportedAndTheRestComputed) {
  const std::string bytes = Recording({.digits = "413111"}, Scene{});
  EXPECT_EQ(RunFile("x", "u.sdr", bytes), 1);
  ExpectNear(Coordinates("x/u.txt"), "3", kP);
  EXPECT_NE(Report("x", "u").find("\r\n\r\nKhong hieu khai bao cua File: "
                                  "00NMSDR20     V03-05    01-Jan-24 08:00 413111\r\n"),
            std::string::npos);
}

// A SET job: the station's coordinates in its set-up record, the backsight's
// in a computed-point record named like the shot, east first.
TEST_F(RecordingRules, SetJobNamesItsBacksightAsItsCoordinateRecord) {
  auto f = [](double v) { return Number(v, 16); };
  auto id = [](std::string_view name) {
    return std::string(16 - name.size(), ' ') + std::string(name);
  };
  const std::string bytes =
      Record("00NMSDR33 V04-04.02     01-Jan-24 08:00 111121", {}) +
      Record("02TP", {{5, id("STA")}, {21, f(kA.y)}, {37, f(kA.x)}, {53, f(10)}, {69, f(1.5)}}) +
      Record("08CO", {{5, id("KRY SHA")}, {21, f(kB.y)}, {37, f(kB.x)}, {53, f(12)}}) +
      Record("09F1", {{5, id("STA")},
                      {21, id("KRY SHA")},
                      {37, f(kSlopeToB)},
                      {53, f(kZenith)},
                      {69, f(kCircleOnB)}}) +
      Record("09F1", {{5, id("STA")},
                      {21, id("P")},
                      {37, f(kSlope)},
                      {53, f(kZenith)},
                      {69, f(kCircleOnB + kTurn)}});
  EXPECT_EQ(RunFile("set", "s.set", bytes), kExitOk);
  ExpectNear(Coordinates("set/s.txt"), "P", kP);
}

// Keyword files: the reading and distance of P in the field book, turned to
// the orientation shot, whatever the declared units and faces.
TEST(KeywordFileRules, UnitsFacesAndHeights) {
  struct Shot {
    double reading, zenith, slope;
  };
  const Shot on_b{kCircleOnB, kZenith, 100};
  const Shot face1{kCircleOnB + kTurn, kZenith, kSlope};
  const Shot face2{kCircleOnB + kTurn + 180, 360 - kZenith, kSlope};
  // Two faces a little off each way, as real ones are: their mean is P.
  const double off = 2.0 / 3600;
  const Shot face1_off{face1.reading - off, face1.zenith - off, kSlope - 0.002};
  const Shot face2_off{face2.reading + off, face2.zenith - off, kSlope + 0.002};
  struct Case {
    const char* what;
    const char* units;
    double per_degree, per_metre;
    std::vector<Shot> shots_of_p;
  };
  const Case cases[] = {
      {"degrees", "ANGULAR DEG", 1, 1, {face1}},
      {"gon", "ANGULAR GON", 400.0 / 360, 1, {face1}},
      {"feet", "LINEAR FEET", 1, 1 / 0.3048, {face1}},
      {"face 2 alone", "", 1, 1, {face2}},
      {"both faces", "", 1, 1, {face1_off, face2_off}},
  };
  for (const Case& c : cases) {
    auto line = [&c](std::string_view name, const Shot& s) {
      return "1,\"" + std::string(name) + "\",1," + Number(s.reading * c.per_degree, 20) + "," +
             Number(s.zenith * c.per_degree, 20) + "," + Number(s.slope * c.per_metre, 20) +
             ",1.5\n";
    };
    // The instrument height without its ";".
    std::string file = std::string(c.units) + "\nSTN_ID \"A\"\nINST_HT " +
                       Number(1.55 * c.per_metre, 12) + "\n\n\n" + line("B", on_b);
    for (const Shot& s : c.shots_of_p) file += line("P", s);
    const std::vector<std::string> lines = SplitLines(ConvertIdx(file + "END SLOPE\n").book);
    ASSERT_EQ(lines.size(), 4u) << c.what;
    std::string station = Trim(lines[0]);
    const std::vector<std::string> st = SplitFields(station);
    ASSERT_EQ(st.size(), 3u) << c.what;
    EXPECT_NEAR(Val(st[2]), 1.55, 1e-6) << c.what;
    std::string record = lines[3];
    const std::vector<std::string> f = SplitFields(record);
    ASSERT_EQ(f.size(), 5u) << c.what;
    EXPECT_EQ(f[0], "P");
    EXPECT_NEAR(CvGocDbl(f[1]), kTurn, 1.0 / 3600) << c.what;
    EXPECT_NEAR(Val(f[2]), kDistance, 0.001) << c.what;
    EXPECT_NEAR(CvGocDbl(f[3]), kZenith, 1.0 / 3600) << c.what;
  }
  EXPECT_EQ(ConvertIdx("ANGULAR RAD\n").report,
            std::vector<std::string>{"Khong hieu khai bao cua File: ANGULAR RAD"});
}

}  // namespace
}  // namespace kavu::testing
