// kavu-cli: one computation run with the settings of the command line, as the
// compute button would make it, with the window's questions answered for the
// batch user.
#include "cli/cli.h"

#include <CLI/CLI.hpp>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <exception>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "core/host.h"
#include "core/messages.h"
#include "core/state.h"
#include "core/tcvn3.h"
#include "core/typed_numbers.h"
#include "import/formats.h"
#include "run/run.h"
#ifdef KAVU_CLI_PICTURES
#include "cli/pictures.h"
#endif

namespace kavu {

namespace {

constexpr std::string_view kFooter =
    R"(Products are written beside FILE and named after its path up to the first
"." of the file name (NAME below):
  --asc     the regenerated field book ../TRIDO/NAME.asc (beside FILE's folder)
            and the companion file NAME.td1 (observations and coordinates)
  --txt     the coordinate text file NAME.txt
  --sketch  the field sketch NAME.sdo (with the seven header texts)
  --dxf     the drawing exchange file NAME.dxf
  --pegs    the auxiliary-peg file NAME.cp
  --kc      the control-coordinate file NAME.kc
Pictures (in a build with Qt) go where their option says:
  --png, --svg  the map of the whole survey (control points, stations,
            pegs, detail points; points named in NAME.err in red)
  --pdf     the field sketch on A4 pages (ticks --sketch)
The error report NAME.err and the station listing NAME.cpv are always written
and are removed again when the run finds no data error. Instrument files
(.sdr .gre .obs .set .idx .tcm) are first converted into the field book
NAME.asc; for the other kinds NAME.asc must exist.

Output: the summary (stations, detail points, errors, start and end times)
goes to standard output, followed by a line "Không ghi được File: PATH" for
each product that could not be written. Messages that stop a run go to
standard error; so does the progress, when standard error is a terminal.

Exit status:
  0   the run completed without data errors
  1   the run completed with data errors (see NAME.err), or a product could
      not be written
  2   the run did not start or stopped early (the message is on stderr)
  64  bad usage
  130 stopped by Ctrl+C: no product was written, the earlier ones are kept
      (a second Ctrl+C ends the command at once))";

// The seven header texts: option, meaning, default (the header form's).
struct HeaderOption {
  const char* name;
  const char* help;
  const char* fallback;
};
constexpr std::array<HeaderOption, 7> kHeaderOptions{{
    {"--area", "survey area (field sketch header)", ""},
    {"--sketch-no", "sketch number", "01"},
    {"--instrument", "instrument model", "TOPCOM 226"},
    {"--instrument-no", "instrument number", "23756"},
    {"--surveyor", "surveyor", ""},
    {"--recorder", "recorder", ""},
    {"--date", "survey date", "Ngày  tháng năm 2003"},
}};

// Message boxes and the title, for a batch user: every box is written to the
// error stream and answered with its default; the closing summary question is
// not shown (the command prints the summary itself).
class BatchHost : public Host {
 public:
  BatchHost(std::ostream& err, bool errIsTerminal, const std::atomic<bool>* interrupted)
      : err_(err), terminal_(errIsTerminal), interrupted_(interrupted) {}

  MsgAnswer MessageBox(std::string_view text, MsgIcon, MsgButtons buttons) override {
    const bool summary = buttons == MsgButtons::YesNo && text.starts_with(msg::kTotalStations);
    if (!summary) {
      ClearProgress();
      err_ << LoneCrAsLf(text) << '\n';
      err_.flush();
    }
    return buttons == MsgButtons::YesNo ? MsgAnswer::Yes : MsgAnswer::Ok;
  }

  void SetTitle(std::string_view title) override {
    if (!terminal_) return;
    ClearProgress();
    if (title == msg::kProgramTitle) return;  // the run is over
    err_ << title;
    err_.flush();
    progressShown_ = true;
  }

  void Beep() override {}
  void SetFileBox(std::string_view) override {}
  void FocusFileBox() override {}
  void SelectKind(int) override {}
  bool Cancelled() override { return interrupted_ != nullptr && interrupted_->load(); }

  void ClearProgress() {
    if (!progressShown_) return;
    err_ << "\r\x1b[K";
    progressShown_ = false;
  }

 private:
  static std::string LoneCrAsLf(std::string_view text) {
    std::string out(text);
    for (std::size_t i = 0; i < out.size(); ++i) {
      if (out[i] == '\r' && (i + 1 == out.size() || out[i + 1] != '\n')) out[i] = '\n';
    }
    return out;
  }

  std::ostream& err_;
  bool terminal_;
  const std::atomic<bool>* interrupted_;
  bool progressShown_ = false;
};

std::optional<int> ParseKind(std::string_view text) {
  if (text == "auto") return -1;
  return FormatIndexOf(text);
}

// The kinds for --help, from the table of formats: "0 asc field book, ...".
std::string KindsHelp() {
  std::string help = "kind of FILE (default: auto, from its extension), by number or name:";
  int index = 0;
  for (const Format& format : Formats()) {
    help += (index % 2 == 0 ? "\n" : ";  ") + std::to_string(index) + " " + std::string(format.name) +
            " " + std::string(format.about);
    ++index;
  }
  return help;
}

std::optional<std::uint64_t> ParseSeed(std::string_view text) {
  std::uint64_t value = 0;
  const auto [end, ec] = std::from_chars(text.data(), text.data() + text.size(), value);
  if (ec != std::errc{} || end != text.data() + text.size() || text.empty()) return std::nullopt;
  return value;
}

// The command line's settings, before they are turned into window fields.
struct Settings {
  std::string file;
  std::string kind = "auto";
  std::string scale = "1000";
  std::string textHeight = "2.0";
  std::string heightDecimals = "2";
  bool asc = false, txt = false, sketch = false, dxf = false, pegs = false, kc = false;
  bool all = false;
  bool heights = true;
  std::string png, svg, pdf;
  std::string controlFile;
  std::string seed;
  std::array<std::string, 7> header{};
};

int Usage(std::ostream& err, std::string_view what) {
  err << "kavu-cli: " << what << "\nRun with --help for more information.\n";
  return kExitUsage;
}

}  // namespace

int RunCli(std::span<const std::string_view> args, std::ostream& out, std::ostream& err,
           bool errIsTerminal, const std::atomic<bool>* interrupted) {
  Settings set;
  for (std::size_t i = 0; i < kHeaderOptions.size(); ++i) {
    set.header[i] = kHeaderOptions[i].fallback;
  }

  CLI::App app{
      "Computes the coordinates and heights of the detail points of a total-station "
      "field book, checks every observation and writes the products asked for.",
      "kavu-cli"};
  app.footer(std::string(kFooter));
  app.get_formatter()->column_width(26);
  app.set_version_flag("--version", "kavu-cli 0.1");

  app.add_option("FILE", set.file, "the field book (.asc) or instrument file to compute")
      ->required();
  app.add_option("--control-file", set.controlFile,
                 "take the control points from this common file, not from FILE")
      ->type_name("PATH");
  app.add_option("--kind", set.kind, KindsHelp())
      ->type_name("auto|N|NAME");
  app.add_option("--scale", set.scale,
                 "map scale: 500, 1:500 or 1/500; sets the distance tolerance\n(default: 1000)")
      ->type_name("NUMBER");
  app.add_option("--text-height", set.textHeight,
                 "label height in mm in the drawing file, 2.5 or 2,5 (default: 2.0)")
      ->type_name("NUMBER");
  app.add_option("--height-decimals", set.heightDecimals,
                 "decimals of the heights in the coordinate text file (default: 2)")
      ->type_name("NUMBER");

  app.add_flag("--asc", set.asc, "write the regenerated field book and its companion file");
  app.add_flag("--txt", set.txt, "write the coordinate text file");
  app.add_flag("--sketch", set.sketch, "write the field sketch");
  app.add_flag("--dxf", set.dxf, "write the drawing exchange file");
  app.add_flag("--pegs", set.pegs, "write the auxiliary-peg file");
  app.add_flag("--kc", set.kc, "write the control-coordinate file");
  app.add_flag("--all", set.all, "write all six products");
  app.add_option("--png", set.png, "draw the map of the survey as a PNG picture")
      ->type_name("FILE");
  app.add_option("--svg", set.svg, "draw the map of the survey as an SVG picture")
      ->type_name("FILE");
  app.add_option("--pdf", set.pdf, "print the field sketch to a PDF file (ticks --sketch)")
      ->type_name("FILE");
  // Each flag sets the value as it is met, so the last one given wins.
  app.add_flag_callback(
         "--heights", [&set] { set.heights = true; },
         "compute the detail points' heights (the default)")
      ->trigger_on_parse();
  app.add_flag_callback(
         "--no-heights", [&set] { set.heights = false; }, "do not compute them")
      ->trigger_on_parse();
  app.add_option("--seed", set.seed,
                 "seed of the pseudo-random generator, so that a run can be repeated\n"
                 "(default: the clock)")
      ->type_name("N");
  for (std::size_t i = 0; i < kHeaderOptions.size(); ++i) {
    const HeaderOption& h = kHeaderOptions[i];
    std::string help = std::string(h.help) + " (default: \"" + h.fallback + "\")";
    app.add_option(h.name, set.header[i], help)->type_name("TEXT");
  }

  // CLI11 takes the arguments in reverse order.
  std::vector<std::string> reversed;
  reversed.reserve(args.size());
  for (auto it = args.rbegin(); it != args.rend(); ++it) reversed.emplace_back(*it);
  try {
    app.parse(reversed);
  } catch (const CLI::Success& e) {
    return app.exit(e, out, err) == 0 ? kExitOk : kExitUsage;
  } catch (const CLI::ParseError& e) {
    return Usage(err, e.what());
  }

  const std::optional<int> kind = ParseKind(set.kind);
  if (!kind) {
    return Usage(err, "--kind: expected auto, a number from 0 to " +
                          std::to_string(LastFormatIndex()) + " or a format's name, got: " + set.kind);
  }
  // The window reads the same texts with the same reader.
  const TypedRunNumbersRead typed = ReadRunNumbers(set.scale, set.textHeight, set.heightDecimals);
  if (!typed.numbers) {
    switch (typed.refused) {
      case TypedBox::Scale:
        return Usage(err, "--scale: expected a map scale above 0 such as 500, 1:500 or 1/500, got: " +
                              set.scale);
      case TypedBox::TextHeight:
        return Usage(err, "--text-height: expected a number above 0 (2.5 or 2,5), got: " +
                              set.textHeight);
      case TypedBox::HeightDecimals:
        return Usage(err, "--height-decimals: expected a number, got: " + set.heightDecimals);
    }
  }
  std::optional<std::uint64_t> seed;
  if (!set.seed.empty() || app.count("--seed") > 0) {
    seed = ParseSeed(set.seed);
    if (!seed)
      return Usage(err, "--seed: expected a whole number from 0 to 2^64-1, got: " + set.seed);
  }

  const bool pictures = !set.png.empty() || !set.svg.empty() || !set.pdf.empty();
#ifndef KAVU_CLI_PICTURES
  if (pictures) return Usage(err, "--png, --svg and --pdf: this kavu-cli was built without Qt");
#endif

  RunState st;
  st.txtfile = set.file;
  st.kindOverride = *kind;
  st.TyleTXT = Utf8ToTcvn3(set.scale);
  st.Htxt = Utf8ToTcvn3(set.textHeight);
  st.txtSoleDC = Utf8ToTcvn3(set.heightDecimals);
  const auto tick = [&](bool wanted) { return wanted || set.all ? 1 : 0; };
  st.fasc = tick(set.asc);
  st.ftd = tick(set.txt);
  st.fsdo = tick(set.sketch || !set.pdf.empty());
  st.fdxf = tick(set.dxf);
  st.fcp = tick(set.pegs);
  st.fkc = tick(set.kc);
  st.fdc = set.heights ? 1 : 0;
  if (app.count("--control-file") > 0) {
    st.ckKC = 1;
    st.txtFKC = set.controlFile;
  }
  st.seed = seed;
  for (std::size_t i = 0; i < set.header.size(); ++i) st.nhapsdo[i] = Utf8ToTcvn3(set.header[i]);

  BatchHost host(err, errIsTerminal, interrupted);
  RunResult result;
  try {
    result = tinh_Click(st, host);
  } catch (const std::exception& e) {
    host.ClearProgress();
    err << "kavu-cli: the run failed: " << e.what() << '\n';
    return kExitStopped;
  }
  host.ClearProgress();
  if (result.outcome == RunOutcome::Cancelled) return kExitInterrupted;
  if (result.outcome != RunOutcome::Completed) return kExitStopped;
#ifdef KAVU_CLI_PICTURES
  if (pictures) {
    for (std::string& path : WritePictures(st, result.survey, {set.png, set.svg, set.pdf})) {
      result.unwritable.push_back(std::move(path));
    }
  }
#endif

  for (const std::string& line : SummaryLines(result)) out << line << '\n';
  for (const std::string& path : result.unwritable) out << msg::kCannotWrite << path << '\n';
  out.flush();
  return result.err > 0 || !result.unwritable.empty() ? kExitDataErrors : kExitOk;
}

}  // namespace kavu
