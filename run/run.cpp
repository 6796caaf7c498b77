#include "run/run.h"

#include <algorithm>
#include <array>
#include <ctime>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "core/control_points.h"
#include "core/lookup.h"
#include "core/messages.h"
#include "core/numbers.h"
#include "core/paths.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "core/typed_numbers.h"
#include "import/dispatch.h"
#include "products/dxf.h"
#include "products/pegs.h"
#include "products/reports.h"
#include "products/sketch.h"

namespace kavu {
namespace {

std::string TimeOfDay() {
  const std::time_t now = std::time(nullptr);
  std::tm local{};
#ifdef _WIN32
  localtime_s(&local, &now);
#else
  localtime_r(&now, &local);
#endif
  char text[16];
  const std::size_t length = std::strftime(text, sizeof text, "%H:%M:%S", &local);
  return std::string(text, length);
}

// The refusal to write the product at path when it would replace a file the
// run reads (the path and the words saying so), or nothing.
std::optional<std::string> OverInput(const RunState& st, const std::string& path) {
  for (const std::string& input : st.inputs) {
    if (WouldReplace(path, input)) return path + std::string(msg::kProductIsInput);
  }
  return std::nullopt;
}

// The same, the refusal named in st.unwritable; true when the product must be
// passed over.
bool ProductOverInput(RunState& st, const std::string& path) {
  const auto refused = OverInput(st, path);
  if (refused) st.unwritable.push_back(*refused);
  return refused.has_value();
}

// Distance tolerance in metres for the map scale 1:T.
double DistanceTolerance(double scale) {
  if (scale <= 500) return 0.02;
  if (scale <= 2000) return 0.05;
  if (scale < 5000) return 0.3;
  return 2.0;
}

// The working copy, read strictly forward from the field book's bytes.
// Reading past its end gives an empty line.
class WorkingCopy {
 public:
  explicit WorkingCopy(RunState& st) : st_(st), reader_(st.survey.book) {}
  bool AtEnd() const { return read_ >= st_.workingLines; }
  long long LinesRead() const { return static_cast<long long>(read_); }
  long long Lines() const { return static_cast<long long>(st_.workingLines); }
  void ReadLine() {
    st_.dongKept = false;
    std::string_view raw;
    bool found = false;
    while (!AtEnd() && !found && reader_.Next(raw)) {
      ++number_;
      found = WorkingLine(raw, st_.dong, st_.MangTruong);
    }
    if (!found) {
      st_.line = 0;
      st_.dong.clear();
      st_.MangTruong.clear();
      st_.stp = 0;
      read_ = st_.workingLines;
      return;
    }
    ++read_;
    st_.line = number_;
    st_.stp = static_cast<int>(st_.MangTruong.size());
    // A line that stands in the field book as it reads, up to its line end,
    // is not kept again.
    const std::string_view standing = TrimView(raw);
    if (standing == st_.dong && standing.data() + standing.size() == raw.data() + raw.size()) {
      st_.dongAt = static_cast<std::uint64_t>(standing.data() - st_.survey.book.data());
      st_.dongKept = true;
    }
  }

 private:
  RunState& st_;
  LineReader reader_;
  std::size_t read_ = 0;
  std::size_t number_ = 0;
};

void HandleBodyRecord(RunState& st) {
  const BodyRecord kind = BodyRecordOf(st.MangTruong);
  switch (kind) {
    case BodyRecord::Detail:
      ComputeDetailRecord(st);
      break;
    case BodyRecord::Peg:
      ComputePegRecord(st);
      break;
    case BodyRecord::Check:
      ComputeCheckRecord(st);
      break;
    case BodyRecord::TooFew:
    case BodyRecord::TooMany:
      break;
  }
  const std::string_view name = TrimView(st.TenDiem.str());
  if (kind == BodyRecord::TooFew && name != "TR" && name != "DKD") {
    ReportPoint(st, st.Field(0).substr(0, decltype(st.TenDiem)::kWidth), msg::kRunTogether);
  }
}

struct Counters {
  int stations = 0;
  long long bodyRecords = 0;
};

void ComputeStation(RunState& st, Host& host, WorkingCopy& copy, Counters& counters,
                    std::size_t recordLine) {
  host.SetTitle(std::string(msg::kStationTitle) + Tcvn3ToUtf8(st.TenTram.str()));
  ++counters.stations;
  TinhPhuongViCanh(st);
  st.cdhdau = RoundEven(st.cdh, 3);
  st.pvd = st.gpv;
  StationResult station;
  station.station = {Trim(st.TenTram.str()), st.xTR, st.yTR, std::nullopt};
  if (!Trim(st.StZTram).empty() && Ticked(st.fdc)) station.station.h = st.zTR;
  station.orientation = {Trim(st.TenDinhHuong.str()), st.xDKD, st.yDKD, std::nullopt};
  if (!Trim(st.StZDinhHuong).empty() && Ticked(st.fdc)) station.orientation.h = st.zDKD;
  // gpv is the azimuth from the orientation point to the station.
  station.bearing = st.gpv >= 180 ? st.gpv - 180 : st.gpv + 180;
  station.orientationDistance = st.cdhdau;
  station.line = recordLine;
  station.instrumentHeight = st.ccm;
  station.backBearing = st.gpv;
  if (Ticked(st.fsdo)) {
    station.sketch = {st.StXTram,
                      st.StYTram,
                      st.StZTram,
                      st.StXDinhHuong,
                      st.StYDinhHuong,
                      st.StZDinhHuong,
                      std::string(kNameWidth, ' '),
                      {},
                      {},
                      0};
  }
  st.survey.stations.push_back(std::move(station));
  // An orientation record on the last line leaves the station without a body.
  const bool hasBody = !copy.AtEnd();
  copy.ReadLine();
  st.TenDiem = st.Field(0);
  st.DiemDau = "";
  st.DiemCuoi = "";
  st.dctdau = 1;
  const std::size_t firstPoint = st.survey.points.size();
  while (hasBody && Trim(st.TenDiem.str()) != "TR") {
    ++counters.bodyRecords;
    HandleBodyRecord(st);
    if (copy.AtEnd()) break;
    copy.ReadLine();
    st.TenDiem = st.Field(0);
  }
  // The reading on the orientation point that the field sketch shows: 0 00
  // and a few seconds drawn at random, as the printed form has always shown.
  if (Ticked(st.fsdo)) st.survey.stations.back().sketch.orientationReading = st.rng.Next() * 0.025;
  CheckPegReadings(st, firstPoint);
}

void SkipStation(RunState& st, WorkingCopy& copy, std::size_t stationLine) {
  st.dctdau = 1;
  while (st.Field(0) != "TR" && !copy.AtEnd()) {
    copy.ReadLine();
    if (st.dctdau == 1) {
      st.DiemDau = st.Field(0);
      st.DiemCuoi = st.Field(0);
      st.dctdau = 2;
    } else {
      st.DiemCuoi = st.TenDiem.str();
    }
    st.TenDiem = st.Field(0);
  }
  const std::string line = std::string(msg::kSkippedFrom) + st.DiemDau.str() +
                           std::string(msg::kSkippedTo) + st.DiemCuoi.str() +
                           std::string(msg::kSkippedEnd);
  st.survey.AddReport(line, {}, stationLine, false);
}

// The coordinates the lookup found, in numbers and as texts; none (and I = 0)
// when it found nothing.
void TakeLookedUp(RunState& st, double& x, double& y, double& z, std::string& textX,
                  std::string& textY, std::string& textZ) {
  if (st.n != 0) {
    x = st.X;
    y = st.Y;
    z = st.Z;
    textX = st.StX.str();
    textY = st.StY.str();
    textZ = st.StZ.str();
  } else {
    st.I = 0;
    textX.clear();
    textY.clear();
    textZ.clear();
  }
}

// Station and orientation records of a block; I = 0 when it cannot be computed.
void ReadStationHeader(RunState& st, WorkingCopy& copy) {
  st.I = 1;
  if (st.Field(0).starts_with("TR") && st.stp >= 2) {
    ReportLongName(st, st.Field(1));
    st.TenKC = st.Field(1);
    st.ccm = st.Field(2);
    // A height that is no number is as good as none: computed with 0.
    if (!HasNumber(st.ccm)) {
      ReportError(st,
                  std::string(msg::kPoint) + st.TenKC.str() + std::string(msg::kNoInstrumentHeight),
                  st.TenKC.str());
    }
    TimToaDoDiem(st);
    st.TenTram = st.TenKC.str();
    TakeLookedUp(st, st.xTR, st.yTR, st.zTR, st.StXTram, st.StYTram, st.StZTram);
  } else {
    st.I = 0;
    ReportError(st,
                std::string(msg::kPointColon) + std::string(st.Field(0)) +
                    Utf8ToTcvn3(msg::kStationRunTogether),
                st.Field(0));
  }

  copy.ReadLine();
  if (st.Field(0).starts_with("DKD") && st.stp >= 2) {
    ReportLongName(st, st.Field(1));
    st.TenKC = st.Field(1);
    TimToaDoDiem(st);
    st.TenDinhHuong = st.TenKC.str();
    TakeLookedUp(st, st.xDKD, st.yDKD, st.zDKD, st.StXDinhHuong, st.StYDinhHuong, st.StZDinhHuong);
  } else {
    st.I = 0;
    ReportError(st,
                std::string(msg::kPointColon) + std::string(st.Field(0)) +
                    std::string(msg::kOrientationRunTogether),
                st.Field(0));
  }
}

// A file that cannot be opened is named at the end of the run, and only when
// it was to be written (the error report only when there are errors).
void OpenKeptFile(RunState& st, TextOut& file, const std::string& path) {
  if (ProductOverInput(st, path)) return;
  file.open(path);
}

// A run that stops early leaves every product as it was.
void AbandonKeptFiles(RunState& st) {
  for (TextOut* file : {&st.errFile, &st.cpvFile, &st.sdoFile, &st.cpFile}) file->abandon();
}

// Removes a file the run wrote earlier, never one it reads.
void RemoveProduct(const RunState& st, const std::string& path) {
  for (const std::string& input : st.inputs) {
    if (WouldReplace(path, input)) return;
  }
  std::error_code ignored;
  std::filesystem::remove(PathFromUtf8(path), ignored);
}

// A product of the run: written on one of two threads, then put in place in
// the order the summary names what could not be written.
struct Product {
  TextOut own;              // a product opened at the end of the run
  TextOut* kept = nullptr;  // or a file kept open through the run
  std::function<void(TextOut&)> write;
  std::string failure;                 // its name in the summary when it cannot be written
  std::optional<std::string> refused;  // it would replace a file the run reads
  bool commit = true;                  // a kept file is put in place only when it was opened
  bool wanted = true;                  // a kept file that the run was asked to write
  std::size_t weight = 0;              // its share of the writing

  TextOut& File() { return kept != nullptr ? *kept : own; }
};

Product KeptProduct(TextOut& file, bool wanted, std::size_t weight,
                    std::function<void(TextOut&)> write) {
  Product product;
  product.kept = &file;
  product.wanted = wanted;
  product.commit = file.is_open();
  product.failure = Utf8FromPath(file.path());
  product.weight = weight;
  product.write = std::move(write);
  return product;
}

Product NewProduct(const RunState& st, const std::string& path, std::size_t weight,
                   std::function<void(TextOut&)> write) {
  Product product;
  product.refused = OverInput(st, path);
  if (!product.refused) product.own.open(path);
  product.failure = path;
  product.weight = weight;
  product.write = std::move(write);
  return product;
}

// Writes every product, shared out by weight among this thread and two
// others (while one waits for the disk, two keep both cores busy): the
// heaviest first, each to the writer with the least to write. Each writes
// only its own files, reading the run's result.
void WriteProducts(std::vector<Product>& products) {
  std::vector<Product*> order;
  for (Product& product : products) {
    if (!product.refused) order.push_back(&product);
  }
  std::stable_sort(order.begin(), order.end(),
                   [](const Product* a, const Product* b) { return a->weight > b->weight; });
  constexpr std::size_t kWriters = 3;
  std::array<std::vector<Product*>, kWriters> shares;
  std::array<std::size_t, kWriters> load{};
  for (Product* product : order) {
    const auto least =
        static_cast<std::size_t>(std::min_element(load.begin(), load.end()) - load.begin());
    shares[least].push_back(product);
    load[least] += product->weight + 1;
  }
  const auto write = [](const std::vector<Product*>& share) {
    for (Product* product : share) {
      TextOut& file = product->File();
      if (product->write) product->write(file);
      file.finish();
    }
  };
  std::jthread second(write, std::cref(shares[1]));
  std::jthread third(write, std::cref(shares[2]));
  write(shares[0]);
}

RunResult Finish(RunState& st, RunOutcome outcome) {
  RunResult result;
  result.outcome = outcome;
  result.err = st.err;
  result.unwritable = st.unwritable;
  result.written = st.written;
  result.survey = std::move(st.survey);
  return result;
}

}  // namespace

std::vector<std::string> SummaryLines(const RunResult& result) {
  return {
      std::string(msg::kTotalStations) + SignedCount(result.stations),
      std::string(msg::kTotalPoints) + SignedCount(result.bodyRecords),
      std::string(msg::kTotalErrors) + SignedCount(result.err),
      std::string(msg::kStarted) + result.startTime,
      std::string(msg::kEnded) + result.endTime,
  };
}

RunResult tinh_Click(RunState& st, Host& host) {
  st.ResetComputation();
  st.rng = st.seed ? SplitMix64(*st.seed) : SplitMix64::FromClock();
  const std::string startTime = TimeOfDay();

  // The typed numbers are read before anything is converted or written; the
  // hosts refuse an unreadable one before they start a run.
  const TypedRunNumbersRead typed = ReadRunNumbers(st.TyleTXT, st.Htxt, st.txtSoleDC);
  if (!typed.numbers) {
    host.MessageBox(TypedRefusalMessage(typed), MsgIcon::Critical, MsgButtons::Ok);
    return Finish(st, RunOutcome::NotStarted);
  }
  const TypedRunNumbers numbers = *typed.numbers;

  FileLock jobLock;
  auto fieldBook = CheckAndConvert(st, host, &jobLock);
  if (!fieldBook) return Finish(st, RunOutcome::NotStarted);
  // The survey keeps the field book's bytes: its points' records stand there.
  st.survey.book = std::move(*fieldBook);
  fieldBook.reset();

  st.dscdh = DistanceTolerance(numbers.scale);

  // Every product goes to a temporary file and replaces the earlier one only
  // when the run has come to its end, after all that it reads was read.
  if (Ticked(st.fcp)) OpenKeptFile(st, st.cpFile, st.daufile + ".cp");
  if (Ticked(st.fsdo)) OpenKeptFile(st, st.sdoFile, st.daufile + ".sdo");
  OpenKeptFile(st, st.errFile, st.daufile + ".err");
  for (const std::string& line : st.conversionReport) ReportError(st, line);
  OpenKeptFile(st, st.cpvFile, st.daufile + ".cpv");
  WriteStationListingHeader(st.cpvFile);
  if (!DocFileKhongChe(st, host, st.survey.book)) {
    AbandonKeptFiles(st);
    return Finish(st, RunOutcome::StoppedEarly);
  }
  st.survey.knownRead = st.MangKhongChe.size();
  st.survey.controlListing.clear();
  st.listedNames.clear();
  // The working copy holds no station record the loop could reach (control
  // records only, one line, one endless line).
  if (st.workingLines == 0) {
    host.MessageBox(msg::kNoDetailData, MsgIcon::Critical, MsgButtons::Ok);
    st.txtfile.clear();
    host.SetFileBox("");
    host.FocusFileBox();
    AbandonKeptFiles(st);
    return Finish(st, RunOutcome::StoppedEarly);
  }

  // Room for a point and a report line a line: the vectors never move what
  // they hold, and the room not used is never touched.
  st.survey.points.reserve(st.workingLines);
  st.survey.stations.reserve(st.stationRecords);
  st.survey.report.reserve(st.survey.report.size() + st.workingLines);
  Counters counters;
  WorkingCopy copy(st);
  copy.ReadLine();
  while (!copy.AtEnd() && !host.Cancelled()) {
    host.Progress(copy.LinesRead(), copy.Lines());
    const std::size_t stationLine = st.line;
    ReadStationHeader(st, copy);
    if (st.I != 0) {
      ComputeStation(st, host, copy, counters, stationLine);
    } else {
      SkipStation(st, copy, stationLine);
    }
  }
  // Stopped by the user: as a run that stops early, nothing is written.
  if (host.Cancelled()) {
    AbandonKeptFiles(st);
    host.SetTitle(msg::kProgramTitle);
    host.MessageBox(msg::kRunCancelled, MsgIcon::Information, MsgButtons::Ok);
    return Finish(st, RunOutcome::Cancelled);
  }

  // The lookups are done: the known points go to the result.
  st.survey.known = std::move(st.MangKhongChe);
  // The products' weights: about their time in nanoseconds, as measured, for
  // each item they write (sketch rows and drawing entities take the longest).
  const Survey& survey = st.survey;
  const std::size_t details = survey.points.size();
  std::vector<Product> products;
  // A run without errors leaves no error report and no station listing.
  if (st.err == 0) {
    st.errFile.abandon();
    st.cpvFile.abandon();
  } else {
    products.push_back(KeptProduct(st.cpvFile, true, 1300 * survey.stations.size(),
                                   [&](TextOut& out) { WriteStationListing(out, survey); }));
    products.push_back(KeptProduct(st.errFile, true, 40 * survey.report.size(),
                                   [&](TextOut& out) { WriteErrorReport(out, survey); }));
  }
  if (Ticked(st.fkc)) {
    products.push_back(NewProduct(st, st.daufile + ".kc", 350 * survey.controlListing.size(),
                                  [&](TextOut& out) { WriteControlListing(out, survey); }));
  }
  if (Ticked(st.fasc)) {
    std::error_code ignored;
    std::filesystem::create_directories(PathFromUtf8(st.tentmbd), ignored);
    for (const bool coordinates : {false, true}) {
      products.push_back(NewProduct(st, coordinates ? st.daufile + ".td1" : st.filesl1,
                                    (coordinates ? 160 : 70) * details,
                                    [&, coordinates](TextOut& out) {
                                      WriteControlListing(out, survey);
                                      WriteStationRecords(out, survey, coordinates);
                                    }));
    }
  }
  if (Ticked(st.ftd)) {
    const int decimals = numbers.heightDecimals;
    products.push_back(
        NewProduct(st, st.daufile + ".txt", 160 * details,
                   [&, decimals](TextOut& out) { WriteCoordinateText(out, survey, decimals); }));
  }
  if (Ticked(st.fdxf)) {
    // Millimetres on paper times the scale: the label height on the ground.
    const double labelHeight = numbers.textHeight * numbers.scale / 1000;
    products.push_back(
        NewProduct(st, st.daufile + ".dxf", 350 * details,
                   [&, labelHeight](TextOut& out) { WriteDrawing(out, survey, labelHeight); }));
  }
  products.push_back(
      KeptProduct(st.cpFile, Ticked(st.fcp), Ticked(st.fcp) ? 1100 * survey.stations.size() : 0,
                  [&](TextOut& out) {
        if (!Ticked(st.fcp)) return;
        WritePegFileHead(out, survey, Ticked(st.fdc));
        WritePegBlocks(out, survey);
      }));
  products.push_back(
      KeptProduct(st.sdoFile, Ticked(st.fsdo), Ticked(st.fsdo) ? 350 * details : 0,
                  [&](TextOut& out) {
        if (Ticked(st.fsdo)) WriteSketch(out, survey, st.nhap);
      }));
  WriteProducts(products);
  // A stop asked for while the products were written still leaves every
  // earlier product as it was.
  if (host.Cancelled()) {
    for (Product& product : products) product.File().abandon();
    AbandonKeptFiles(st);
    host.SetTitle(msg::kProgramTitle);
    host.MessageBox(msg::kRunCancelled, MsgIcon::Information, MsgButtons::Ok);
    return Finish(st, RunOutcome::Cancelled);
  }
  for (Product& product : products) {
    TextOut& file = product.File();
    if (product.refused) {
      st.unwritable.push_back(*product.refused);
    } else if (!product.commit) {
      // A kept file that could not be opened (a refused one has no error).
      if (product.wanted && file.error()) {
        st.unwritable.push_back(UnwritableEntry(product.failure, file.error()));
      }
    } else if (file.commit()) {
      st.written.push_back(product.failure);
    } else {
      st.unwritable.push_back(UnwritableEntry(product.failure, file.error()));
    }
  }
  if (st.err == 0) {
    for (const char* extension : {".err", ".cpv", ".bak"}) {
      RemoveProduct(st, st.daufile + extension);
    }
  }

  jobLock.Release();

  RunResult result = Finish(st, RunOutcome::Completed);
  result.stations = counters.stations;
  result.bodyRecords = counters.bodyRecords;
  result.startTime = startTime;
  host.SetTitle(msg::kProgramTitle);
  result.endTime = TimeOfDay();

  // A stop that came after the products were put in place is too late.
  result.stopTooLate = host.Cancelled();
  std::string text;
  for (const std::string& line : SummaryLines(result)) text += line + "\r";
  for (const std::string& path : result.unwritable) {
    text += std::string(msg::kCannotWrite) + path + "\r";
  }
  if (result.stopTooLate) text += std::string(msg::kStopTooLate) + "\r";
  if (!result.written.empty()) {
    text += "\r" + std::string(msg::kFilesWritten) + "\r";
    for (const std::string& path : result.written) {
      // Named from the job's folder: the TRIDO book stands beside it.
      std::filesystem::path shown =
          PathFromUtf8(path).lexically_relative(PathFromUtf8(st.tentm));
      text += std::string(msg::kWrittenIndent) +
              Utf8FromPath(shown.empty() ? PathFromUtf8(path) : shown.make_preferred()) + "\r";
    }
  }
  text += "\r" + std::string(msg::kContinue);
  const MsgIcon icon = result.unwritable.empty() && !result.stopTooLate ? MsgIcon::Information
                                                                        : MsgIcon::Exclamation;
  result.answer = host.MessageBox(text, icon, MsgButtons::YesNo);
  host.Beep();
  return result;
}

}  // namespace kavu
