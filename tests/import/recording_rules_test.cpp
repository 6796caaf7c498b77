// Made-up recordings, one per header declaration, each run without a control
// file: the point P must land where an azimuth and a distance from the known
// points put it.
#include <algorithm>
#include <charconv>
#include <cmath>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

// The scene: station A (0001), backsight B (0002), the circle reading 30 on
// B; P (0003) is shot 50 degrees clockwise from B at 40 m horizontal, zenith 88.
const Xy kA{1000, 2000};
const Xy kB{1100, 2050};
constexpr double kCircleOnB = 30, kTurn = 50, kZenith = 88;
const Xy kP = Polar(kA, kB, kTurn, 40);
// The slope distance recorded for a horizontal one at the zenith kZenith.
double Slope(double horizontal) { return horizontal / std::sin(kZenith * std::acos(-1.0) / 180); }

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

// An SDR-family recording of the scene in a dialect: the known points, the
// set-up on A with its backsight record, the prism height, the shots of B and P.
std::string Recording(const Dialect& d) {
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
  // Columns: identifier, X, Y, H, instrument height; target, slope, zenith,
  // reading; the backsight's circle reading.
  const std::size_t c[] = {5, wide ? 21u : 9u, wide ? 37u : 19u, wide ? 53u : 29u,
                           wide ? 69u : 39u};
  const std::size_t t = wide ? 21 : 9, sd = wide ? 37 : 13, z = wide ? 53 : 23, ha = wide ? 69 : 33;

  std::string file =
      Rec("00NM" + std::string(d.instrument) + "     V03-05    01-Jan-24 08:00 " + d.digits, {});
  if (d.job != nullptr) file += Rec("10NM" + std::string(d.job), {});
  for (const auto& [name, p] : {std::pair{"0001", kA}, std::pair{"0002", kB}}) {
    const auto [x, y] = d.east_north ? std::pair{p.y, p.x} : std::pair{p.x, p.y};
    file += Rec("08KI", {{c[0], id(name)}, {c[1], len(x)}, {c[2], len(y)}, {c[3], len(10)}});
  }
  file += Rec("02TP", {{c[0], id("0001")}, {c[4], len(1.5)}});
  file += Rec("07TP", {{c[0], id("0001")}, {t, id("0002")}, {z, reading(kCircleOnB)}});
  file += Rec("03NM", {{5, len(1.5)}});
  for (const auto& [target, slope, circle] :
       {std::tuple{"0002", Slope(std::hypot(kB.x - kA.x, kB.y - kA.y)), kCircleOnB},
        std::tuple{"0003", Slope(40), kCircleOnB + kTurn}}) {
    file += Rec("09F1", {{5, id("0001")},
                         {t, id(target)},
                         {sd, len(slope)},
                         {z, angle(kZenith)},
                         {ha, reading(circle)}});
  }
  return file;
}

class RecordingRules : public InstrumentRunTest {};

TEST_F(RecordingRules, HeaderDeclarationsAreHonoured) {
  struct Case {
    const char* file;  // its extension picks the kind
    Dialect dialect;
    const char* p_name;  // the name P gets in the field book
    const char* report = nullptr;
  };
  const Case cases[] = {
      {"gon.sdr", {.digits = "211111", .per_degree = 400.0 / 360}, "3"},
      {"mil.sdr", {.digits = "311111", .per_degree = 6400.0 / 360}, "3"},
      {"feet.sdr", {.digits = "121111", .per_metre = 1 / 0.3048}, "3"},
      {"east-north.sdr", {.digits = "111121", .east_north = true}, "3"},
      {"counter-clockwise.sdr", {.digits = "111112", .counter_clockwise = true}, "3"},
      {"wide-by-job-record.sdr", {.width = 16, .job = "JOB1            1"}, "0003"},
      {"wide-by-sdr33.gre", {.instrument = "SDR33", .width = 16}, "0003"},
      {"narrow-by-job-record.obs", {.width = 4, .job = "JOB1            4"}, "3"},
      // An unknown declaration is reported, and the rest computed.
      {"unknown.sdr",
       {.digits = "413111"},
       "3",
       "\r\n\r\nKhong hieu khai bao cua File: 00NMSDR20     V03-05    01-Jan-24 08:00 413111\r\n"},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.file);
    const std::filesystem::path made = FreshFolder("kavu-recordings") / c.file;
    WriteBytes(made, Recording(c.dialect));
    EXPECT_EQ(Run(made, {"--txt", "--seed", "1"}), c.report ? kExitDataErrors : kExitOk);
    const std::string stem = made.stem().string();
    ExpectNear(Coordinates(stem + ".txt"), c.p_name, kP);
    const std::string report = FileBytes(dir_ / (stem + ".err"));
    EXPECT_TRUE(c.report == nullptr || report.find(c.report) != std::string::npos) << report;
  }
}

}  // namespace
}  // namespace kavu::testing
