// The state that the routines of one computation run share, under the names
// the surveying office uses. The window's controls and the file-selection
// fields outlive a run; the computation fields are reset at the start of each.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/random.h"
#include "core/survey.h"
#include "core/text.h"

namespace kavu {

// A check box counts as ticked only in state 1 (2 is the grayed third state).
inline bool Ticked(int state) { return state == 1; }

// The values of the main window's controls that the run reads or sets.
struct WindowFields {
  std::string txtfile;           // the chosen file's path, native
  int cbkieu = 0;                // kind of input: its index in the table of formats
  int fasc = 0;                  // regenerated field book and companion file
  int ftd = 1;                   // coordinate text file
  int fdc = 1;                   // detail heights
  int fsdo = 2;                  // field sketch (grayed until clicked)
  int fdxf = 2;                  // drawing file (grayed until clicked)
  int fcp = 0;                   // auxiliary-peg file
  int fkc = 0;                   // control-coordinate file
  int ckKC = 0;                  // control points from the common file
  std::string TyleTXT = "1000";  // map scale denominator, as typed
  std::string Htxt = "2.0";      // label height in mm, as typed
  std::string txtSoleDC = "2";   // decimals of heights, as typed
  std::string txtFKC;            // common control-point file, native path
  // The seven texts of the header form (TCVN3): survey area, sketch number,
  // instrument, instrument number, surveyor, recorder, survey date.
  std::array<std::string, 7> nhapsdo{};
  // A fixed seed for the generator (batch use); without it, the clock.
  std::optional<std::uint64_t> seed;
  // A kind chosen by the user over the one of the extension (batch use), or -1.
  int kindOverride = -1;
};

// Names derived from the chosen path; every product is daufile + extension.
struct FileSelection {
  std::string filesl;    // full path of the file to compute
  std::string tentm;     // its folder, with the trailing separator
  std::string daufile;   // the path up to the first "." of the file name
  std::string duoifile;  // between the first and second "." of the file name
  std::string tentmbd;   // the folder's parent + "TRIDO" + separator
  std::string filesl1;   // tentmbd + the name up to its first "." + ".asc"
  // The field sketch's copy of the header texts at their fixed widths
  // (39, 6, 19, 20, 17, 18, 10).
  std::array<std::string, 7> nhap{};
};


struct ComputationFields {
  std::int32_t err = 0;  // data errors written to the error report
  SplitMix64 rng;        // draws for check records and sketch orientation rows

  // Current line of the working copy and its fields (views into dong).
  std::string dong;
  std::vector<std::string_view> MangTruong;
  int stp = 0;
  // Field i of the current record, or the empty text past its last field.
  std::string_view Field(std::size_t i) const {
    return i < MangTruong.size() ? MangTruong[i] : std::string_view();
  }
  // Where dong stands in the survey's texts: in the field book when the line
  // stands there as dong reads (dongKept), or kept among the made texts once
  // a point or a report line needs it.
  std::uint64_t dongAt = 0;
  bool dongKept = false;

  // Angle and distance of the current observation.
  double goc = 0, s = 0, rad = 0;
  double do1 = 0;
  std::int16_t phut = 0;
  double giay = 0;
  std::string StGoc;

  // Station and orientation.
  int I = 1;
  int n = 0;
  FixedText<kNameWidth> TenKC, TenTram, TenDinhHuong, TenDiem;
  std::string StXTram, StYTram, StZTram;
  std::string StXDinhHuong, StYDinhHuong, StZDinhHuong;
  double xTR = 0, yTR = 0, zTR = 0;
  double xDKD = 0, yDKD = 0, zDKD = 0;
  std::string ccm;
  FixedText<5> DiemDau, DiemCuoi;
  std::int16_t dctdau = 1;
  double pvd = 0, cdhdau = 0, dscdh = 0.05;
  double gpv = 0, cdh = 0;

  // The current point.
  double ccg = 0;
  double xi = 0, yi = 0, zi = 0;
  double pv2 = 0, scgcd = 0;
  double X = 0, Y = 0, Z = 0;
  // Coordinate texts of a looked-up point, padded to their widths, never cut.
  FixedNumber<11> StX;
  FixedNumber<10> StY, StZ;

  // The known points of the run.
  std::vector<KnownPoint> MangKhongChe;

  // Lookup indexes of the tables above by trimmed name, brought up to date
  // when a point is looked up: positions in MangKhongChe and
  // survey.points, the names in survey.controlListing, the names of
  // survey.control.
  struct NameIndex {
    std::unordered_map<std::string, std::vector<std::size_t>> positions;
    std::size_t done = 0;
  };
  NameIndex knownIndex, detailIndex;
  std::unordered_set<std::string> listedNames;
  std::unordered_set<std::string> controlNames;

  int sdkc() const { return static_cast<int>(MangKhongChe.size()); }

  // The working copy: the lines of the field book (survey.book) that are
  // neither blank nor control records, and their number; none when no
  // station record stands where the station loop can reach it.
  std::size_t workingLines = 0;
  std::size_t stationRecords = 0;  // the records of the working copy that begin a station
  // The field-book line (from 1) of the record being read (0 when none).
  std::size_t line = 0;

  // What the run found, in numbers.
  Survey survey;
  // Whether the point last looked up has a height text.
  bool hasZ = false;

  // Files kept open through the station loop.
  TextOut errFile;  // error report .err, written from survey.report at the end
  TextOut cpvFile;  // station listing .cpv
  TextOut sdoFile;  // field sketch .sdo
  TextOut cpFile;   // auxiliary-peg file .cp

  // What the conversion found in the instrument file itself, for the error
  // report.
  std::vector<std::string> conversionReport;

  // Products that could not be written (with the reason), named in the
  // summary; and those put in place.
  std::vector<std::string> unwritable;
  std::vector<std::string> written;
  // The files the run reads (chosen file, field book, common control file):
  // no product is written over one of them.
  std::vector<std::string> inputs;
};

struct RunState : WindowFields, FileSelection, ComputationFields {
  // Starts a run's computation afresh; the window and file fields stay.
  void ResetComputation() { static_cast<ComputationFields&>(*this) = ComputationFields{}; }
};

// Adds a message to the run's report (survey.report) and counts it; point is
// the name the line concerns (empty when none).
void ReportError(RunState& st, std::string_view line, std::string_view point = {});
// Adds and counts the message "Diem " + name in 12 columns + message, message
// being one of msg::kPointMessages.
void ReportPoint(RunState& st, std::string_view name, std::string_view message);

// Where a text stands in the survey's texts: within the current line
// (dong) when it is part of it, otherwise kept among the made texts.
std::uint64_t Place(RunState& st, std::string_view text);

}  // namespace kavu
