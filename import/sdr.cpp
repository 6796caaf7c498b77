// SDR-family field books: fixed-column records with 4-character point
// identifiers and 10-character numbers, or 16-character identifiers and
// numbers (the Sokkia layout), as the header declares. The first pass writes
// every point of known coordinates the recording holds, set-ups included, as
// control points; the second walks the set-ups in file order.

#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/instrument_common.h"
#include "import/sdr_header.h"

namespace kavu {
namespace {

struct Span {
  std::size_t from, to;
  std::string_view Of(std::string_view line) const { return Columns(line, from, to); }
};

// Where the fields stand in the two layouts.
struct Layout {
  Span id;                            // point of an "08" record, station of a set-up
  Span x, y, h;                       // coordinates of "08" and set-up records
  Span height;                        // instrument height of a set-up
  Span description;                   // of a set-up (4-character layout)
  Span target;                        // backsight of "07", target of "09F1"
  Span azimuth;                       // recorded backsight bearing of "07"
  Span circle;                        // circle reading on the backsight of "07"
  Span prism;                         // "03NM"
  Span slope, zenith, reading, note;  // "09F1"
};

constexpr Layout kNarrow{{5, 8},   {9, 18},  {19, 28}, {29, 38}, {39, 48}, {49, 65}, {9, 12},
                         {13, 22}, {23, 32}, {5, 14},  {13, 22}, {23, 32}, {33, 42}, {43, 59}};
constexpr Layout kWide{{5, 20},  {21, 36}, {37, 52}, {53, 68}, {69, 84}, {85, 100}, {21, 36},
                       {37, 52}, {53, 68}, {5, 20},  {37, 52}, {53, 68}, {69, 84},  {85, 100}};

bool IsCoordinateCode(std::string_view code) {
  return code == "08KI" || code == "08CO" || code == "08TP";
}

// The names of the points: one per identifier through the whole recording.
// In the wide layout a point is named by its identifier. In the narrow one a
// point with coordinates is named by the first description of 3 characters
// or more that its coordinate records give it, else "DKC" + its identifier.
class Names {
 public:
  Names(const std::vector<std::string>& lines, const Layout& layout, bool wide,
        bool (*is_station)(std::string_view))
      : wide_(wide) {
    if (wide) return;
    for (const std::string& line : lines) {
      const std::string_view code = RecordCode(line);
      std::string_view description;
      if (IsCoordinateCode(code)) {
        description = ColumnsFrom(line, 49);
      } else if (is_station(code)) {
        description = layout.description.Of(line);
      } else {
        continue;
      }
      if (TrimView(layout.x.Of(line)).empty() || TrimView(layout.y.Of(line)).empty()) continue;
      const std::string id = Identifier(line, layout.id);
      auto [it, fresh] = labels_.try_emplace(id);
      if (fresh || it->second.empty()) {
        const std::string_view text = TrimView(description);
        it->second = text.size() < 3 ? std::string() : Trim(FixedWidth(text, 12));
      }
    }
    for (auto& [id, label] : labels_) {
      label = BlankFreeName(label.empty() ? "DKC" + id : label);
    }
  }

  std::string Identifier(std::string_view line, Span span) const {
    return wide_ ? Trim(span.Of(line)) : FixedWidth(span.Of(line), 4);
  }
  // The name of a point with coordinates, or nullptr.
  const std::string* Known(const std::string& id) const {
    const auto it = labels_.find(id);
    return it == labels_.end() ? nullptr : &it->second;
  }
  // Any point named in a set-up or backsight record.
  std::string Of(const std::string& id) const {
    if (wide_) return BlankFreeName(id);
    if (const std::string* label = Known(id)) return *label;
    return BlankFreeName("DKC" + id);
  }

 private:
  bool wide_;
  std::unordered_map<std::string, std::string> labels_;
};

struct Observation {
  std::string name;
  double reading = 0;  // clockwise, decimal degrees
  double distance = 0;
  double zenith = 0;
  std::string prism_height;
  std::string description;
};

class SdrWriter {
 public:
  SdrWriter(std::string& out, const Names& names, const SdrHeader& header, const Layout& layout,
            int kind)
      : out_(out),
        names_(names),
        header_(header),
        layout_(layout),
        wide_(header.width == 16),
        setups_(kind == 1 || kind == 2 || kind == 7 || kind == 8),
        keyed_only_(kind == 8) {}

  bool IsStation(std::string_view code) const {
    return setups_ && (code == "02KI" || (!keyed_only_ && code == "02TP"));
  }
  bool IsBacksight(std::string_view code) const {
    return setups_ && (code == "07KI" || (!keyed_only_ && code == "07TP"));
  }

  void Line(std::string_view line) {
    const std::string_view code = RecordCode(line);
    if (IsStation(code)) {
      Station(line);
    } else if (IsBacksight(code)) {
      Backsight(line);
    } else if (code == "03NM") {
      const std::string height = Trim(layout_.prism.Of(line));
      prism_height_ = height.empty() ? "0.0" : header_.units.LengthText(height);
    } else if (code == "09F1") {
      Observe(line);
    }
  }

  // The end of the file closes the last set-up.
  void Finish() { CloseSetUp(); }

 private:
  void Station(std::string_view line) {
    CloseSetUp();
    const std::string id = names_.Identifier(line, layout_.id);
    instrument_height_ = header_.units.LengthText(Trim(layout_.height.Of(line)));
    if (instrument_height_.empty()) instrument_height_ = "0.0";
    const std::string_view description = TrimView(layout_.description.Of(line));
    if (!wide_ && names_.Known(id) == nullptr && description.size() > 2) {
      station_name_ = BlankFreeName(Trim(FixedWidth(Columns(line, 49, 60), 12)));
    } else {
      station_name_ = names_.Of(id);
    }
  }

  void Backsight(std::string_view line) {
    CloseSetUp();
    AppendLine(out_, "TR " + station_name_ + " " + instrument_height_);
    backsight_id_ = names_.Identifier(line, layout_.target);
    backsight_name_ = names_.Of(backsight_id_);
    backsight_found_ = wide_ || names_.Known(backsight_id_) != nullptr;
    circle_.reset();
    const std::string_view circle = layout_.circle.Of(line);
    if (HasNumber(circle)) circle_ = header_.units.Reading(Val(circle));
    reference_ = 0;
    have_backsight_ = true;
    oriented_ = false;
    held_.Await();
  }

  void Observe(std::string_view line) {
    const Units& units = header_.units;
    Observation obs;
    const std::string id = names_.Identifier(line, layout_.target);
    obs.zenith = units.Angle(Val(layout_.zenith.Of(line)));
    obs.reading = units.Reading(Val(layout_.reading.Of(line)));
    obs.distance = HorizontalDistance(units.Length(Val(layout_.slope.Of(line))), obs.zenith);
    obs.prism_height = prism_height_;
    const std::string* known = names_.Known(id);
    if (wide_) {
      obs.name = BlankFreeName(id);
    } else {
      obs.name = known != nullptr ? *known : FixedWidth(PointNumberText(id), 4);
      obs.description = known != nullptr ? *known : Trim(layout_.note.Of(line));
    }

    if (have_backsight_ && id == backsight_id_) {
      reference_ = obs.reading;
      if (!oriented_) {
        const std::string note = Trim(layout_.note.Of(line));
        if (!backsight_found_ && note.size() > 2) {
          backsight_name_ = BlankFreeName(Trim(FixedWidth(note, 12)));
        }
        Orient();
      }
    } else if (held_.awaiting()) {
      held_.Hold(std::move(obs));
      return;
    }
    Write(obs);
  }

  // The orientation record, then the points that waited for it.
  void Orient() {
    AppendLine(out_, "DKD " + backsight_name_);
    oriented_ = true;
    held_.Release();
  }

  // A set-up whose backsight was never observed is turned by the circle
  // reading its backsight record holds; without one it gets no orientation
  // record, and the run reports its points as not computed.
  void CloseSetUp() {
    if (!held_.awaiting()) return;
    if (circle_) {
      reference_ = *circle_;
      Orient();
    } else {
      held_.Release();
    }
  }

  void Write(const Observation& obs) {
    const double reading = TurnReading(obs.reading, reference_);
    if (wide_) {
      AppendLine(out_, LString(obs.name, 10) + GocSt(reading) + DistanceText(obs.distance) +
                           GocSt(obs.zenith) + PrismHeightText(obs.prism_height));
    } else {
      AppendLine(out_, LString(obs.name, 4) + GocSt(reading) + DistanceText(obs.distance) +
                           GocSt(obs.zenith) + PrismHeightText(obs.prism_height) + " " +
                           obs.description);
    }
  }

  std::string& out_;
  const Names& names_;
  const SdrHeader& header_;
  const Layout& layout_;
  bool wide_;
  bool setups_;      // kinds whose set-up records are read
  bool keyed_only_;  // only the keyed-in set-up codes

  std::string station_name_;
  std::string instrument_height_;
  std::string backsight_id_;
  std::string backsight_name_;
  bool backsight_found_ = false;
  bool have_backsight_ = false;  // no observation is the backsight before one is named
  bool oriented_ = false;
  std::optional<double> circle_;  // circle reading on the backsight, as recorded
  double reference_ = 0;
  std::string prism_height_ = "0.0";
  HeldObservations<Observation> held_{[this](const Observation& obs) { Write(obs); }};
};

Conversion ConvertSdrFamily(std::string_view content, int kind, int width_default) {
  const std::vector<std::string> lines = SplitLines(content);
  Conversion result;
  const SdrHeader header = ReadSdrHeader(lines, width_default);
  result.report = header.report;
  const bool wide = header.width == 16;
  const Layout& layout = wide ? kWide : kNarrow;

  static constexpr auto is_station = [](std::string_view code) {
    return code == "02TP" || code == "02KI";
  };
  const Names names(lines, layout, wide, +is_station);

  // Pass 1: every coordinate record, set-ups included, in file order.
  for (const std::string& line : lines) {
    const std::string_view code = RecordCode(line);
    if (!IsCoordinateCode(code) && !is_station(code)) continue;
    std::string x = std::string(layout.x.Of(line));
    std::string y = std::string(layout.y.Of(line));
    if (header.east_north) std::swap(x, y);
    const std::string name = names.Of(names.Identifier(line, layout.id));
    // Without a name or both coordinates the record would read back wrongly.
    if (name.empty() || TrimView(x).empty() || TrimView(y).empty()) continue;
    const std::string_view h = layout.h.Of(line);
    const Units& units = header.units;
    AppendLine(result.book, ControlPointRecord(name, units.LengthText(x), units.LengthText(y),
                                               units.LengthText(wide ? TrimView(h) : h)));
  }

  // Pass 2: the set-ups.
  SdrWriter writer(result.book, names, header, layout, kind);
  for (const std::string& line : lines) writer.Line(line);
  writer.Finish();
  return result;
}

}  // namespace

Conversion ConvertSdr(std::string_view content, int kind) {
  return ConvertSdrFamily(content, kind, 4);
}

Conversion ConvertObs(std::string_view content, int kind) {
  return ConvertSdrFamily(content, kind, 16);
}

}  // namespace kavu
