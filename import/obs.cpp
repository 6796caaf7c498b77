// Sokkia field books: the SDR record codes with 16-character identifiers and
// numbers. The first pass writes the keyed-in control points, the second the
// set-ups.

#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/instrument_common.h"

namespace kavu {
namespace {

struct Observation {
  std::string target;  // trimmed identifier
  double reading = 0;
  double distance = 0;
  double zenith = 0;
  std::string prism_height;
};

// A target whose identifier is its own number text (12, not 0012, 12A or A7).
bool IsPlainNumber(std::string_view target) {
  return target.size() <= NumberText(Val(target)).size();
}

class ObsWriter {
 public:
  ObsWriter(std::string& out, int kind) : out_(out), setups_(kind == 2) {}

  void Line(std::string_view line) {
    const std::string_view code = RecordCode(line);
    if (setups_ && code == "02TP") {
      CloseOrientation();
      station_label_ = FixedWidth(TrimView(Columns(line, 5, 20)), 12);
      instrument_height_ = Trim(Columns(line, 69, 84));
      if (instrument_height_.empty()) instrument_height_ = "0.0";
    } else if (setups_ && code == "07TP") {
      CloseOrientation();
      AppendLine(out_, "TR " + station_label_ + " " + instrument_height_);
      backsight_label_ = FixedWidth(TrimView(Columns(line, 21, 36)), 12);
      AppendLine(out_, "DKD " + backsight_label_);
      reference_ = 0;
      have_backsight_ = true;
      held_.Await();
    } else if (code == "03NM") {
      prism_height_ = Trim(Columns(line, 5, 20));
      if (prism_height_.empty()) prism_height_ = "0.0";
    } else if (code == "09F1") {
      Observe(line);
    }
  }

  void Finish() { CloseOrientation(); }

 private:
  void Observe(std::string_view line) {
    Observation obs;
    obs.target = Trim(Columns(line, 21, 36));
    const double slope = Val(Columns(line, 37, 52));
    obs.zenith = Val(Columns(line, 53, 68));
    obs.reading = Val(Columns(line, 69, 84));
    obs.distance = HorizontalDistance(slope, obs.zenith);
    obs.prism_height = prism_height_;

    // Compared as the 12-character names the field book keeps, so a target
    // longer than its 10-character column still finds its backsight.
    if (have_backsight_ && TrimView(FixedWidth(obs.target, 12)) == TrimView(backsight_label_)) {
      reference_ = obs.reading;
      // The orientation record went out with the backsight record; only the
      // points held for the backsight follow.
      held_.Release();
    } else if (held_.awaiting()) {
      held_.Hold(std::move(obs));
      return;
    }
    Write(obs);
  }

  // A set-up whose backsight was never observed: its points keep their
  // circle readings.
  void CloseOrientation() { held_.Release(); }

  void Write(const Observation& obs) {
    std::string distance = DistanceText(obs.distance);
    std::string name = FixedWidth(obs.target, 10);
    std::string tail;
    if (!IsPlainNumber(TrimView(name))) {
      // The record is numbered 0000 and the name stands in field 5.
      tail = " " + name;
      name = FixedWidth("0000", 10);
    }
    AppendLine(out_, name + GocSt(TurnReading(obs.reading, reference_)) + distance +
                         GocSt(obs.zenith) + PrismHeightText(obs.prism_height) + tail);
  }

  std::string& out_;
  bool setups_;  // the set-up codes count only for the Sokkia kind
  std::string station_label_ = std::string(12, ' ');
  std::string instrument_height_ = "0.0";
  std::string backsight_label_;
  bool have_backsight_ = false;
  double reference_ = 0;
  std::string prism_height_ = "0.0";
  HeldObservations<Observation> held_{[this](const Observation& obs) { Write(obs); }};
};

}  // namespace

std::string ConvertObs(std::string_view content, int kind) {
  const std::vector<std::string> lines = SplitLines(content);
  std::string out;

  // Pass 1: keyed-in points. Computed points ("08CO") are not written.
  for (const std::string& line : lines) {
    if (RecordCode(line) != "08KI") continue;
    const std::string_view name = TrimView(Columns(line, 5, 20));
    // A nameless record would read back as a station record.
    if (name.empty()) continue;
    AppendLine(out, "TR " + FixedWidth(name, 12) + " " +
                        FixedWidth(Mask(Val(Columns(line, 21, 36)), "########.000"), 11) + " " +
                        FixedWidth(Mask(Val(Columns(line, 37, 52)), "########.000"), 10));
  }

  ObsWriter writer(out, kind);
  for (const std::string& line : lines) writer.Line(line);
  writer.Finish();
  return out;
}

}  // namespace kavu
