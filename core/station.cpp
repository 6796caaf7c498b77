#include "core/station.h"

#include <cmath>
#include <optional>
#include <string>

#include "core/lookup.h"
#include "core/messages.h"
#include "core/numbers.h"
#include "core/results.h"
#include "core/survey_math.h"
#include "core/tcvn3.h"
#include "core/text.h"

namespace kavu {
namespace {

void EntryError(RunState& st, std::string_view message) {
  // The name as it stands in the record, when the record is the point's.
  const std::string_view first = st.Field(0).substr(0, decltype(st.TenDiem)::kWidth);
  const std::string_view name = st.TenDiem.str();
  const bool own = name.starts_with(first) && TrimView(name.substr(first.size())).empty();
  ReportPoint(st, own ? first : name, message);
}

// A record whose reading, distance, zenith angle or prism height holds no
// number cannot be computed: it is reported and passed over.
bool NumbersMissing(RunState& st, std::initializer_list<std::size_t> fields) {
  for (std::size_t i : fields) {
    if (!HasNumber(st.Field(i))) {
      EntryError(st, msg::kNotANumber);
      return true;
    }
  }
  return false;
}

// The checks of a detail or peg observation before it is computed. A record
// without a usable distance (an angle-only observation) or, when heights are
// wanted, with a zenith angle that cannot give one, would put a false point
// into the products: it is reported once and passed over.
// The numbers of a usable observation: reading, distance, zenith angle and
// prism height, each read once.
struct Observation {
  double reading = 0, distance = 0, zenith = 0, prism = 0;
};
std::optional<Observation> UsableObservation(RunState& st) {
  double numbers[4];
  for (std::size_t i = 0; i < 4; ++i) {
    if (!ReadNumber(st.Field(i + 1), numbers[i])) {
      EntryError(st, msg::kNotANumber);
      return std::nullopt;
    }
  }
  const Observation o{numbers[0], numbers[1], numbers[2], numbers[3]};
  if (o.distance == 0) {
    EntryError(st, msg::kNoDistance);
    return std::nullopt;
  }
  if (Ticked(st.fdc)) {
    const double zenith = PackedDegrees(o.zenith);
    if (!(zenith > 0 && zenith < 180)) {
      EntryError(st, msg::kWrongZenith);
      return std::nullopt;
    }
  }
  return o;
}

// The point of a usable observation: its height, then its coordinates.
void ComputeObservation(RunState& st, const Observation& o) {
  st.s = o.distance;
  st.goc = o.zenith;
  st.ccg = o.prism;
  TinhDoCao(st);
  st.goc = o.reading;
  TinhToaDo(st);
}

// Azimuth and distance from the orientation (or check) point to the station,
// reported against the station and otherName.
void Orient(RunState& st, std::string_view otherName) {
  const Bearing bearing = BearingBetween(st.xDKD, st.yDKD, st.xTR, st.yTR);
  st.gpv = bearing.azimuth;
  st.goc = st.gpv;
  GocString(st);
  st.cdh = bearing.distance;
  if (st.cdh > 10000) {
    ReportError(st,
                std::string(msg::kPointColon) + st.TenTram.str() + std::string(msg::kOr) +
                    std::string(otherName) + std::string(msg::kWrongCoordinates),
                st.TenTram.str());
  }
}

// A computed detail point or peg of the current record, its name, code and
// note within its record line.
void NotePoint(RunState& st, PointKind kind, bool words, bool listed) {
  ComputedPoint point;
  point.x = st.xi;
  point.y = st.yi;
  point.z = st.zi;
  point.record = Place(st, st.dong) & ((std::uint64_t{1} << 61) - 1);
  point.line = static_cast<std::uint32_t>(st.line);
  point.station = static_cast<std::uint32_t>(st.survey.stations.size() - 1);
  point.SetKind(kind);
  point.listed = listed;
  point.words = words;
  st.survey.points.push_back(point);
}

}  // namespace

double PackedDegrees(double packed) { return DecodePacked(packed).degrees; }

void gocdo(RunState& st) {
  const DecodedAngle angle = DecodePacked(st.goc);
  if (angle.negative) EntryError(st, msg::kNegativeAngle);
  if (st.s < 0) {
    st.s = std::fabs(st.s);
    EntryError(st, msg::kNegativeDistance);
  }
  if (angle.degreesOver) EntryError(st, msg::kWrongDegrees);
  if (angle.minutesOver) EntryError(st, msg::kWrongMinutes);
  if (angle.secondsOver) EntryError(st, msg::kWrongSeconds);
  if (st.s > 2000) EntryError(st, msg::kDistanceMayBeWrong);
  st.do1 = angle.parts.do1;
  st.phut = angle.parts.phut;
  st.giay = angle.parts.giay;
  st.goc = angle.degrees;
  st.rad = Radians(st.goc);
}

void GocString(RunState& st) {
  AngleParts parts;
  st.StGoc = GocStringText(st.goc, &parts);
  st.do1 = parts.do1;
  st.phut = parts.phut;
  st.giay = parts.giay;
}

std::string NorthingText(double x) { return Mask(x, kNorthingMask.text); }
std::string EastingText(double y) { return Mask(y, kEastingMask.text); }
std::string HeightText(double z) { return Mask(z, kHeightMask.text); }

void TinhPhuongViCanh(RunState& st) { Orient(st, st.TenDinhHuong.str()); }

void TinhDoCao(RunState& st) {
  gocdo(st);
  st.zi = PointHeight(st.zTR, st.goc, st.s, Val(st.ccm), st.ccg);
}

void TinhToaDo(RunState& st) {
  gocdo(st);
  const Radiated point = Radiate(st.xTR, st.yTR, st.pvd, st.goc, st.s);
  st.xi = point.x;
  st.yi = point.y;
  st.s = RoundEven(st.s, 3);
}

void ReportLongName(RunState& st, std::string_view name) {
  if (name.size() > decltype(st.TenDiem)::kWidth) {
    ReportPoint(st, name, msg::kNameTooLong);
  }
}

bool ReadingTooLong(std::string_view reading) { return TrimView(reading).size() > 7; }

void CheckPegReadings(RunState& st, std::size_t firstPoint) {
  if (!Ticked(st.fcp)) return;
  for (std::size_t i = firstPoint; i < st.survey.points.size(); ++i) {
    const ComputedPoint& point = st.survey.points[i];
    if (point.kind() != PointKind::Peg) continue;
    const std::string_view record = st.survey.Record(point);
    if (ReadingTooLong(RecordField(record, 1))) {
      ReportPoint(st, RecordField(record, 5).substr(0, kNameWidth), msg::kWrongDegrees);
      return;
    }
  }
}

BodyRecord BodyRecordOf(std::span<const std::string_view> fields) {
  if (fields.size() < 5) return BodyRecord::TooFew;
  if (fields.size() > 7) return BodyRecord::TooMany;
  if (fields.size() == 7 && Upper(fields[6]) == "KT") return BodyRecord::Check;
  if (fields.size() == 5) return BodyRecord::Detail;
  const std::string_view code = TrimView(fields[5]);
  return code.size() > 2 && KTraCCG(code) == 1 ? BodyRecord::Peg : BodyRecord::Detail;
}

void ComputeDetailRecord(RunState& st) {
  ReportLongName(st, st.Field(0));
  const auto observation = UsableObservation(st);
  if (!observation) return;
  if (st.dctdau == 1) {
    st.DiemDau = st.TenDiem.str();
    st.DiemCuoi = st.TenDiem.str();
    st.dctdau = 2;
  } else {
    st.DiemCuoi = st.TenDiem.str();
  }
  ComputeObservation(st, *observation);
  // Descriptive words are the code; a record without them is listed too.
  const bool words = (st.stp == 6 || st.stp == 7) && DescriptiveWords(st);
  NotePoint(st, PointKind::Detail, words, st.stp == 5 || words);
}

void ComputePegRecord(RunState& st) {
  st.TenKC = st.Field(5);
  if (st.TenKC == st.TenTram || st.TenKC == st.TenDinhHuong) {
    // An orientation distance record: only the distance counts. A shot
    // without a distance (blank, not a number or 0) has nothing to check.
    st.s = Val(st.Field(2));
    const bool measured = HasNumber(st.Field(2)) && st.s != 0;
    if (measured && st.TenKC == st.TenDinhHuong && std::fabs(st.s - st.cdhdau) >= st.dscdh) {
      ReportError(st,
                  std::string(msg::kStation) + st.TenTram.str() + Utf8ToTcvn3(msg::kOrientation) +
                      st.TenDinhHuong.str() + std::string(msg::kWrongOrientationDistance) +
                      std::string(msg::kDS) + ReportNumber(RoundEven(st.s - st.cdhdau, 2)),
                  st.TenTram.str());
    }
    return;
  }
  ReportLongName(st, st.Field(5));
  const auto observation = UsableObservation(st);
  if (!observation) return;
  ComputeObservation(st, *observation);
  NotePoint(st, PointKind::Peg, false, false);
  // The peg becomes a known point for the rest of the run, listed with its
  // height and note.
  st.StX = NorthingText(st.xi);
  st.StY = EastingText(st.yi);
  st.StZ = HeightText(st.zi);
  st.MangKhongChe.push_back({st.TenKC.str(), st.StX.str(), st.StY.str(), st.StZ.str()});
  const std::string name = Trim(st.TenKC.str());
  st.listedNames.insert(name);
  st.survey.controlListing.push_back({name, st.survey.points.size() - 1, {}, {}, {}, true});
}

void ComputeCheckRecord(RunState& st) {
  if (NumbersMissing(st, {1, 2})) return;
  st.TenKC = st.Field(5);
  SketchTexts& sketch = st.survey.stations.back().sketch;
  sketch.checkName = st.TenKC.str();
  std::string& checkRecord = st.survey.stations.back().checkRecord;
  checkRecord = "DKD2 " + st.TenKC.str();
  // The record's own distance is the one checked.
  st.s = Val(st.Field(2));
  st.goc = Val(st.Field(1));
  gocdo(st);
  st.pv2 = st.goc;
  TimToaDoDiem(st);
  const bool found = st.n != 0;
  if (found) {
    st.xDKD = st.X;
    st.yDKD = st.Y;
    sketch.checkX = st.StX.str();
    sketch.checkY = st.StY.str();
    Orient(st, sketch.checkName);
    st.scgcd = CheckResidual(st.pv2, st.gpv, st.pvd);
    st.goc = st.scgcd;
    GocString(st);
    StationResult& station = st.survey.stations.back();
    station.check = SurveyPoint{Trim(st.TenKC.str()), st.X, st.Y, std::nullopt};
    station.checkResidual = st.scgcd;
  }
  const double r = st.rng.Next();
  if (!found) {
    // Without the check point nothing can be computed: keep the reading as
    // written rather than make one up.
    sketch.checkX.clear();
    sketch.checkY.clear();
    checkRecord += " ";
    checkRecord += st.Field(1);
  } else if (Val(TrimView(st.Field(1))) != 0) {
    checkRecord += " ";
    checkRecord += st.Field(1);
  } else {
    // No reading was recorded: make one from the computed angle, within half
    // a minute of it.
    st.goc = std::fabs(st.scgcd);
    if (r < 0.3) {
      st.goc -= r * 45 / 3600;
    } else if (r > 0.3 && r <= 0.6) {
      st.goc += r * 39 / 3600;
    } else if (r > 0.6 && r <= 0.8) {
      st.goc -= r * 36 / 3600;
    } else if (r > 0.8) {
      st.goc += r * 32 / 3600;
    }
    GocString(st);
    st.StGoc = Trim(Mask(Val(st.StGoc), "#######"));
    checkRecord += " " + st.StGoc;
  }
  checkRecord += " ";
  checkRecord += st.Field(2);
}

}  // namespace kavu
