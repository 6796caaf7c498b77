// SDR field books with 4-character point identifiers and 10-character
// numbers. The first pass writes the points of known coordinates as control
// points; the second walks the set-ups in file order.

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

namespace kavu {
namespace {

// Labels of the points of known coordinates by identifier. Keyed-in points
// ("08KI") are listed before computed ones ("08CO"), and a lookup takes the
// last listed row: a computed point wins over a keyed-in one of the same id.
using LabelTable = std::unordered_map<std::string, std::string>;

std::string Identifier(std::string_view line, std::size_t from) {
  return FixedWidth(Columns(line, from, from + 3), 4);
}

const std::string* FindLabel(const LabelTable& labels, const std::string& id) {
  auto it = labels.find(id);
  return it == labels.end() ? nullptr : &it->second;
}

// One observation waiting for its detail record.
struct Observation {
  std::string number;  // point number, 4 characters
  double reading = 0;  // horizontal circle, decimal degrees
  double distance = 0;
  double zenith = 0;
  std::string target_height;
  std::string description;
};

class SdrWriter {
 public:
  SdrWriter(std::string& out, const LabelTable& labels, int kind) : out_(out), labels_(labels) {
    if (kind == 1 || kind == 7) {
      station_code_ = "02TP";
      backsight_code_ = "07TP";
    } else if (kind == 8) {
      station_code_ = "02KI";
      backsight_code_ = "07KI";
    }
  }

  void Line(std::string_view line) {
    const std::string_view code = RecordCode(line);
    if (!station_code_.empty() && code == station_code_) {
      Station(line);
    } else if (!backsight_code_.empty() && code == backsight_code_) {
      Backsight(line);
    } else if (code == "03NM") {
      std::string height = Trim(Columns(line, 5, 14));
      target_height_ = PrismHeightText(height.empty() ? "0.0" : height);
    } else if (code == "09F1") {
      Observe(line);
    }
  }

  // The end of the file closes the last set-up.
  void Finish() { CloseOrientation(); }

 private:
  void Station(std::string_view line) {
    CloseOrientation();
    const std::string id = Identifier(line, 5);
    instrument_height_ = Trim(Columns(line, 39, 48));
    if (instrument_height_.empty()) instrument_height_ = "0.0";
    if (const std::string* label = FindLabel(labels_, id)) {
      station_label_ = *label;
    } else if (Trim(Columns(line, 49, 65)).size() > 2) {
      station_label_ = FixedWidth(Columns(line, 49, 60), 12);
    } else {
      station_label_ = FixedWidth("DKC" + id, 12);
    }
  }

  void Backsight(std::string_view line) {
    CloseOrientation();
    AppendLine(out_, "TR " + Trim(station_label_) + " " + instrument_height_);
    backsight_id_ = Identifier(line, 9);
    if (const std::string* label = FindLabel(labels_, backsight_id_)) {
      backsight_label_ = *label;
      backsight_found_ = true;
    } else {
      backsight_label_ = FixedWidth("DKC" + backsight_id_, 12);
      backsight_found_ = false;
    }
    reference_ = 0;
    have_backsight_ = true;
    held_.Await();
  }

  void Observe(std::string_view line) {
    Observation obs;
    const std::string id = Identifier(line, 9);
    obs.number = FixedWidth(PointNumberText(id), 4);
    const double slope = Val(Columns(line, 13, 22));
    obs.zenith = Val(Columns(line, 23, 32));
    obs.reading = Val(Columns(line, 33, 42));
    obs.distance = HorizontalDistance(slope, obs.zenith);
    obs.target_height = target_height_;
    const std::string note = Trim(Columns(line, 43, 59));
    if (const std::string* label = FindLabel(labels_, id)) {
      obs.description = Trim(*label);
    } else {
      obs.description = note;
    }

    if (have_backsight_ && id == backsight_id_) {
      reference_ = obs.reading;
      if (!backsight_found_ && note.size() > 2) backsight_label_ = FixedWidth(note, 12);
      // Every reading of the backsight writes its orientation record; the
      // points held for it follow.
      AppendLine(out_, "DKD " + Trim(backsight_label_));
      held_.Release();
    } else if (held_.awaiting()) {
      held_.Hold(std::move(obs));
      return;
    }
    Write(obs);
  }

  // A set-up whose backsight was never observed still gets its orientation
  // record, and its points keep their circle readings.
  void CloseOrientation() {
    if (!held_.awaiting()) return;
    AppendLine(out_, "DKD " + Trim(backsight_label_));
    held_.Release();
  }

  void Write(const Observation& obs) {
    AppendLine(out_, obs.number + GocSt(TurnReading(obs.reading, reference_)) +
                         DistanceText(obs.distance) + GocSt(obs.zenith) + obs.target_height + " " +
                         obs.description);
  }

  std::string& out_;
  const LabelTable& labels_;
  std::string station_code_;
  std::string backsight_code_;

  std::string station_label_;
  std::string instrument_height_;
  std::string backsight_id_;
  std::string backsight_label_;
  bool backsight_found_ = false;
  bool have_backsight_ = false;  // no observation is the backsight before one is named
  double reference_ = 0;
  std::string target_height_;  // empty until the first "03NM"
  HeldObservations<Observation> held_{[this](const Observation& obs) { Write(obs); }};
};

}  // namespace

std::string ConvertSdr(std::string_view content, int kind) {
  const std::vector<std::string> lines = SplitLines(content);
  std::string out;

  // Pass 1: control points in file order; the label table lists "08KI" rows
  // before "08CO" rows.
  LabelTable labels;
  std::vector<std::pair<std::string, std::string>> computed;
  for (const std::string& line : lines) {
    const std::string_view code = RecordCode(line);
    if (code != "08KI" && code != "08CO") continue;
    const std::string id = Identifier(line, 5);
    const std::string description = Trim(ColumnsFrom(line, 49));
    const std::string label = FixedWidth(description.size() < 3 ? "DKC" + id : description, 12);
    if (code == "08KI") {
      labels[id] = label;
    } else {
      computed.emplace_back(id, label);
    }
    const std::string x = FixedWidth(Columns(line, 9, 18), 10);
    const std::string y = FixedWidth(Columns(line, 19, 28), 10);
    // Without both coordinates the record would read back as a station.
    if (TrimView(x).empty() || TrimView(y).empty()) continue;
    AppendLine(out, "TR " + Trim(label) + RString(x, 12) + RString(y, 12) + " " +
                        FixedWidth(Columns(line, 29, 38), 10));
  }
  for (auto& [id, label] : computed) labels[id] = std::move(label);

  // Pass 2: the set-ups.
  SdrWriter writer(out, labels, kind);
  for (const std::string& line : lines) writer.Line(line);
  writer.Finish();
  return out;
}

}  // namespace kavu
