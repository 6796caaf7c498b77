#include "core/run.h"

#include <algorithm>
#include <ctime>
#include <filesystem>
#include <string>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/paths.h"
#include "core/reports.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "core/text.h"
#include "import/dispatch.h"
#include "products/control_points.h"
#include "products/dxf.h"
#include "products/lookup.h"
#include "products/pegs.h"
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

// Distance tolerance in metres for the map scale 1:T.
double DistanceTolerance(double scale) {
  if (scale <= 500) return 0.02;
  if (scale <= 2000) return 0.05;
  if (scale < 5000) return 0.3;
  return 2.0;
}

// The working copy, read strictly forward. Reading past its end gives an
// empty line.
class WorkingCopy {
 public:
  explicit WorkingCopy(RunState& st) : st_(st) {}
  bool AtEnd() const { return next_ >= st_.tamsl.size(); }
  long long LinesRead() const { return static_cast<long long>(next_); }
  long long Lines() const { return static_cast<long long>(st_.tamsl.size()); }
  void ReadLine() {
    st_.dong = AtEnd() ? std::string() : st_.tamsl[next_++];
    st_.MangTruong = SplitFields(st_.dong);
    st_.stp = static_cast<int>(st_.MangTruong.size());
  }

 private:
  RunState& st_;
  std::size_t next_ = 0;
};

// The lengths of the two lists of the regenerated field book stay equal to
// the count of its lines.
void DropStationEntries(RunState& st, std::size_t keep) {
  st.MangSoLieuASC.resize(keep);
  if (st.MangSoLieuToaDo.size() > keep) st.MangSoLieuToaDo.resize(keep);
}

void HandleBodyRecord(RunState& st) {
  const std::size_t stp = st.MangTruong.size();
  auto codeIsPegName = [&] {
    std::string& code = st.MangTruong[5];
    const int notDigits = KTraCCG(code);
    return code.size() > 2 && notDigits == 1;
  };
  if (stp == 7) {
    if (Upper(st.MangTruong[6]) == "KT") {
      STP7(st);
    } else if (codeIsPegName()) {
      STP6(st);
    } else {
      STP5(st);
    }
  } else if (stp == 6) {
    if (codeIsPegName()) {
      STP6(st);
    } else {
      STP5(st);
    }
  } else if (stp == 5) {
    STP5(st);
  }
  const std::string name = Trim(st.TenDiem.str());
  if (stp < 5 && name != "TR" && name != "DKD") {
    ReportError(st, std::string(msg::kPoint) + st.TenDiem.str() + std::string(msg::kRunTogether));
  }
}

struct Counters {
  int stations = 0;
  long long bodyRecords = 0;
};

void ComputeStation(RunState& st, Host& host, WorkingCopy& copy, Counters& counters) {
  host.SetTitle(std::string(msg::kStationTitle) + Tcvn3ToUtf8(st.TenTram.str()));
  ++counters.stations;
  TinhPhuongViCanh(st);
  st.cdhdau = RoundEven(st.cdh, 3);
  st.pvd = st.gpv;
  st.DongTram += " " + st.StGoc + " " + st.StCanh.str();
  if (Ticked(st.fsdo)) {
    st.TenDinhHuong2 = "";
    st.StXDinhHuong2.clear();
    st.StYDinhHuong2.clear();
    st.StSaiGoc.clear();
  }
  const std::string stationLine = "TR " + st.TenTram.str() + " " + st.ccm;
  const std::string orientationLine = "DKD " + st.TenDinhHuong.str();
  st.MangSoLieuToaDo.resize(st.MangSoLieuASC.size());
  for (const std::string& line : {stationLine, orientationLine}) {
    st.MangSoLieuASC.push_back(line);
    st.MangSoLieuToaDo.push_back(line);
  }
  const std::size_t bodyStart = st.MangSoLieuASC.size();

  // An orientation record on the last line leaves the station without a body.
  const bool hasBody = !copy.AtEnd();
  copy.ReadLine();
  st.TenDiem = st.Field(0);
  st.DiemDau = "";
  st.DiemCuoi = "";
  st.dctdau = 1;
  st.DongDinhHuong2.clear();
  while (hasBody && Trim(st.TenDiem.str()) != "TR") {
    ++counters.bodyRecords;
    HandleBodyRecord(st);
    if (copy.AtEnd()) break;
    copy.ReadLine();
    st.TenDiem = st.Field(0);
  }
  if (st.MangSoLieuASC.size() == bodyStart) DropStationEntries(st, bodyStart - 2);
  st.cpvFile.Line(st.DongTram + "    " + st.DiemDau.str() + " -  " + st.DiemCuoi.str());
  insodo(st);
  incocphu(st);
}

void SkipStation(RunState& st, WorkingCopy& copy) {
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
  st.errFile.Line(std::string(msg::kSkippedFrom) + st.DiemDau.str() + std::string(msg::kSkippedTo) +
                  st.DiemCuoi.str() + std::string(msg::kSkippedEnd));
}

// Station and orientation records of a block; I = 0 when it cannot be computed.
void ReadStationHeader(RunState& st, WorkingCopy& copy) {
  st.I = 1;
  st.MangSoLieuSoDo.clear();
  st.MangCocPhu.clear();
  if (st.Field(0).starts_with("TR") && st.stp >= 2) {
    ReportLongName(st, st.Field(1));
    st.TenKC = st.Field(1);
    st.ccm = st.Field(2);
    st.DongTram = st.TenKC.str();
    // A height that is no number is as good as none: computed with 0.
    if (!HasNumber(st.ccm)) {
      ReportError(
          st, std::string(msg::kPoint) + st.TenKC.str() + std::string(msg::kNoInstrumentHeight));
    }
    TimToaDoDiem(st);
    st.TenTram = st.TenKC.str();
    if (st.n != 0) {
      st.xTR = st.X;
      st.yTR = st.Y;
      st.zTR = st.Z;
      st.StXTram = st.StX.str();
      st.StYTram = st.StY.str();
      st.StZTram = st.StZ.str();
    } else {
      st.I = 0;
      st.StXTram.clear();
      st.StYTram.clear();
      st.StZTram.clear();
    }
  } else {
    st.I = 0;
    ReportError(
        st, std::string(msg::kPointColon) + st.Field(0) + Utf8ToTcvn3(msg::kStationRunTogether));
  }

  copy.ReadLine();
  if (st.Field(0).starts_with("DKD") && st.stp >= 2) {
    ReportLongName(st, st.Field(1));
    st.TenKC = st.Field(1);
    st.DongTram += st.TenKC.str();
    TimToaDoDiem(st);
    st.TenDinhHuong = st.TenKC.str();
    if (st.n != 0) {
      st.xDKD = st.X;
      st.yDKD = st.Y;
      st.zDKD = st.Z;
      st.StXDinhHuong = st.StX.str();
      st.StYDinhHuong = st.StY.str();
      st.StZDinhHuong = st.StZ.str();
    } else {
      st.I = 0;
      st.StXDinhHuong.clear();
      st.StYDinhHuong.clear();
      st.StZDinhHuong.clear();
    }
  } else {
    st.I = 0;
    ReportError(st, std::string(msg::kPointColon) + st.Field(0) +
                        std::string(msg::kOrientationRunTogether));
  }
}

void CommitKeptFile(RunState& st, TextOut& file) {
  if (file.is_open() && !file.commit()) st.unwritable.push_back(Utf8FromPath(file.path()));
}

void OpenKeptFile(RunState& st, TextOut& file, const std::string& path) {
  if (ProductOverInput(st, path)) return;
  if (!file.open(path)) st.unwritable.push_back(path);
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

// A station record that the station loop can reach: on any line but the last.
bool HasStationRecord(const std::vector<std::string>& tamsl) {
  if (tamsl.size() < 2) return false;
  return std::any_of(tamsl.begin(), tamsl.end() - 1, [](const std::string& line) {
    return line.starts_with("TR") && line.find(' ') != std::string::npos;
  });
}

RunResult Finish(RunState& st, RunOutcome outcome) {
  RunResult result;
  result.outcome = outcome;
  result.err = st.err;
  result.unwritable = st.unwritable;
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

  FileLock jobLock;
  const auto fieldBook = CheckAndConvert(st, host, &jobLock);
  if (!fieldBook) return Finish(st, RunOutcome::NotStarted);

  st.Tyle = st.TyleTXT;
  st.Htext = st.Htxt;
  st.dscdh = DistanceTolerance(Val(st.Tyle));

  // Every product goes to a temporary file and replaces the earlier one only
  // when the run has come to its end, after all that it reads was read.
  if (Ticked(st.fcp)) OpenKeptFile(st, st.cpFile, st.daufile + ".cp");
  if (Ticked(st.fsdo)) OpenKeptFile(st, st.sdoFile, st.daufile + ".sdo");
  OpenKeptFile(st, st.errFile, st.daufile + ".err");
  WriteErrorReportHeader(st.errFile);
  for (const std::string& line : st.conversionReport) ReportError(st, line);
  OpenKeptFile(st, st.cpvFile, st.daufile + ".cpv");
  WriteStationListingHeader(st.cpvFile);
  if (!DocFileKhongChe(st, host, *fieldBook)) {
    AbandonKeptFiles(st);
    return Finish(st, RunOutcome::StoppedEarly);
  }
  st.ChuoiKC.clear();
  // The working copy holds no station record the loop could reach (control
  // records only, one line, one endless line).
  if (!HasStationRecord(st.tamsl)) {
    host.MessageBox(msg::kNoDetailData, MsgIcon::Critical, MsgButtons::Ok);
    st.txtfile.clear();
    host.SetFileBox("");
    host.FocusFileBox();
    AbandonKeptFiles(st);
    return Finish(st, RunOutcome::StoppedEarly);
  }

  Counters counters;
  WorkingCopy copy(st);
  copy.ReadLine();
  while (!copy.AtEnd() && !host.Cancelled()) {
    host.Progress(copy.LinesRead(), copy.Lines());
    ReadStationHeader(st, copy);
    if (st.I != 0) {
      ComputeStation(st, host, copy, counters);
    } else {
      SkipStation(st, copy);
    }
  }
  // Stopped by the user: as a run that stops early, nothing is written.
  if (host.Cancelled()) {
    AbandonKeptFiles(st);
    host.SetTitle(msg::kProgramTitle);
    host.MessageBox(msg::kRunCancelled, MsgIcon::Information, MsgButtons::Ok);
    return Finish(st, RunOutcome::Cancelled);
  }

  // A run without errors leaves no error report and no station listing.
  if (st.err == 0) {
    st.errFile.abandon();
    st.cpvFile.abandon();
    for (const char* extension : {".err", ".cpv"}) RemoveProduct(st, st.daufile + extension);
  } else {
    CommitKeptFile(st, st.cpvFile);
    CommitKeptFile(st, st.errFile);
  }
  WriteTextProducts(st);
  if (Ticked(st.fdxf) && !ProductOverInput(st, st.daufile + ".dxf") && !indxf(st)) {
    st.unwritable.push_back(st.daufile + ".dxf");
  }
  CommitKeptFile(st, st.cpFile);
  CommitKeptFile(st, st.sdoFile);
  if (st.err == 0) RemoveProduct(st, st.daufile + ".bak");

  jobLock.Release();

  RunResult result = Finish(st, RunOutcome::Completed);
  result.stations = counters.stations;
  result.bodyRecords = counters.bodyRecords;
  result.startTime = startTime;
  host.SetTitle(msg::kProgramTitle);
  result.endTime = TimeOfDay();

  std::string text;
  for (const std::string& line : SummaryLines(result)) text += line + "\r";
  for (const std::string& path : result.unwritable) {
    text += std::string(msg::kCannotWrite) + path + "\r";
  }
  text += "\r" + std::string(msg::kContinue);
  result.answer = host.MessageBox(text, MsgIcon::Information, MsgButtons::YesNo);
  host.Beep();
  return result;
}

}  // namespace kavu
