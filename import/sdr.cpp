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
#include "import/sdr_records.h"

namespace kavu {
namespace {

// The names of the points: one per identifier through the whole recording.
// In the wide layout a point is named by its identifier. In the narrow one a
// point with coordinates is named by the first description of 3 characters
// or more that its "08" records give it, else "DKC" + its identifier. A
// set-up's own description names its point only when no "08" record lists
// it: the set-up's description says what the station is, and it may well be
// the name of another point.
class Names {
 public:
  Names(const std::vector<std::string>& lines, const SdrLayout& layout)
      : wide_(layout.width == 16) {
    if (wide_) return;
    std::unordered_map<std::string, std::string> set_ups;
    for (const std::string& line : lines) {
      const std::string_view code = RecordCode(line);
      if (!IsCoordinateCode(code)) continue;
      if (TrimView(layout.x.Of(line)).empty() || TrimView(layout.y.Of(line)).empty()) continue;
      const bool set_up = IsSetUpCode(code);
      const std::string_view description =
          set_up ? layout.description.Of(line) : ColumnsFrom(line, 49);
      auto [it, fresh] = (set_up ? set_ups : labels_).try_emplace(Identifier(line, layout.id));
      if (fresh || it->second.empty()) {
        const std::string_view text = TrimView(description);
        it->second = text.size() < 3 ? std::string() : Trim(FixedWidth(text, kNameWidth));
      }
    }
    labels_.merge(set_ups);  // keeps the name an "08" record gives
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
  Shot shot;
  std::string prism_height;
  std::string description;
};

class SdrWriter {
 public:
  SdrWriter(std::string& out, const Names& names, const SdrHeader& header, const SdrLayout& layout,
            int kind)
      : out_(out),
        names_(names),
        header_(header),
        layout_(layout),
        wide_(layout.width == 16),
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
      station_name_ = BlankFreeName(Trim(FixedWidth(Columns(line, 49, 60), kNameWidth)));
    } else {
      station_name_ = names_.Of(id);
    }
    station_open_ = true;
  }

  void Backsight(std::string_view line) {
    CloseSetUp();
    AppendLine(out_, "TR " + station_name_ + " " + instrument_height_);
    station_open_ = false;
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
    // A set-up without backsight record: its points follow its station
    // record with no orientation, so the run reports them instead of
    // computing them from the set-up before.
    if (station_open_) {
      AppendLine(out_, "TR " + station_name_ + " " + instrument_height_);
      station_open_ = false;
      have_backsight_ = false;
      reference_ = 0;
    }
    Observation obs;
    const std::string id = names_.Identifier(line, layout_.target);
    obs.shot = ReadShot(line, layout_, header_.units);
    obs.prism_height = prism_height_;
    const std::string* known = names_.Known(id);
    if (wide_) {
      obs.name = BlankFreeName(id);
    } else {
      obs.name = known != nullptr ? *known : FixedWidth(PointNumberText(id), 4);
      obs.description = known != nullptr ? *known : Trim(layout_.note.Of(line));
    }

    if (have_backsight_ && id == backsight_id_) {
      // The shot on the backsight carries its name after the prism height,
      // as the narrow layout's description does: the run then reads it as
      // the orientation distance to check, not as a point to compute.
      if (wide_) obs.description = backsight_name_;
      reference_ = obs.shot.reading;
      if (!oriented_) {
        const std::string note = Trim(layout_.note.Of(line));
        if (!backsight_found_ && note.size() > 2) {
          backsight_name_ = BlankFreeName(Trim(FixedWidth(note, kNameWidth)));
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
    const Shot& shot = obs.shot;
    std::string record =
        LString(obs.name, wide_ ? 10 : 4) + GocSt(TurnReading(shot.reading, reference_)) +
        DistanceText(shot.distance) + GocSt(shot.zenith) + PrismHeightText(obs.prism_height);
    // The 4-column book carries a description; the 16-column one none but
    // the backsight's name on the shots of the backsight.
    if (!wide_ || !obs.description.empty()) record += " " + obs.description;
    AppendLine(out_, record);
  }

  std::string& out_;
  const Names& names_;
  const SdrHeader& header_;
  const SdrLayout& layout_;
  bool wide_;
  bool setups_;      // kinds whose set-up records are read
  bool keyed_only_;  // only the keyed-in set-up codes

  std::string station_name_;
  std::string instrument_height_;
  std::string backsight_id_;
  std::string backsight_name_;
  bool backsight_found_ = false;
  bool station_open_ = false;    // a set-up record waits for its backsight record
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
  const SdrLayout& layout = header.width == 16 ? kWideLayout : kNarrowLayout;
  const Names names(lines, layout);

  // Pass 1: every coordinate record, set-ups included, in file order.
  for (const std::string& line : lines) {
    if (!IsCoordinateCode(RecordCode(line))) continue;
    const std::string record =
        KnownPointRecord(names.Of(names.Identifier(line, layout.id)), line, layout, header);
    if (!record.empty()) AppendLine(result.book, record);
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
