// Faults that must never cost the user a file. Each row starts from a job
// folder in which an earlier good run left its products, does what a user or
// the machine did, and checks the exit code and the message, that every file
// that was there before is byte for byte what it was (bar the ones the row
// names), that a run that did not come to its end wrote nothing at all, and
// that no temporary file and no lock file is left behind.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <regex>
#include <set>
#include <string>
#include <vector>

#include "cli/cli.h"
#include "core/lines.h"
#include "core/messages.h"
#include "core/text.h"
#include "tests/cli/cli_support.h"
#include "tests/generated_book.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;
using testing::WriteBytes;

// The example job: root/data/job1.asc, its products beside it and the
// regenerated field book in root/TRIDO. "@PATH" in a row's texts is PATH in
// the job's folder.
struct Job {
  fs::path root;
  std::unique_ptr<FileLock> held;  // another run's lock on the job
  std::string In(const std::string& text) const {
    return std::regex_replace(text, std::regex("@([^ ]+)"), (root / "$1").string());
  }
};

// Every file under root by its relative path: the bytes of a regular file,
// the target of a link; FIFOs and devices are never opened.
std::map<std::string, std::string> Files(const fs::path& root) {
  std::map<std::string, std::string> files;
  for (const auto& entry : fs::recursive_directory_iterator(root)) {
    const std::string name = entry.path().lexically_relative(root).string();
    const fs::file_status status = entry.symlink_status();
    if (fs::is_directory(status)) continue;
    files[name] = fs::is_symlink(status) ? "link to " + fs::read_symlink(entry.path()).string()
                  : fs::is_regular_file(status) ? FileBytes(entry.path())
                                                : "<special>";
  }
  return files;
}

struct Row {
  const char* what;
  std::string args;  // split at blanks
  int code;
  std::vector<std::string> shown = {};          // on stderr or stdout
  std::function<void(Job&)> prepare = nullptr;  // makes the fault in the job's folder
  std::set<std::string> changed = {};           // files that may change, from the root
  std::string shell = "";                       // runs the executable after this set-up
  std::vector<std::string> hidden = {};         // never on stderr or stdout
};

std::string S(std::string_view text) { return std::string(text); }
std::string OverInput(const char* path) {
  return S(msg::kCannotWrite) + path + S(msg::kProductIsInput);
}

std::string Full(const char* path) {
  return S(msg::kCannotWrite) + path + " (" + S(msg::kDiskFull) + ")\n";
}

std::vector<Row> Rows() {
  const std::string all = "--all --seed 1 @data/job1.asc";
  const auto file = [](const char* name, std::string bytes) {
    return [name, bytes](Job& j) { WriteBytes(j.In(name), bytes); };
  };
  std::vector<Row> rows = {
      Row("conversion of the field book itself", "--kind 1 --all @data/job1.asc", kExitStopped,
          {S(msg::kConversionOverInput) + "@data/job1.asc"}),
      Row("field book in a folder named TRIDO", "--asc @TRIDO/job1.asc", kExitDataErrors,
          {OverInput("@TRIDO/job1.asc")}),
      Row("--kind 0 job1.txt --txt", "--kind 0 --txt @data/job1.txt", kExitDataErrors,
          {OverInput("@data/job1.txt")},
          [](Job& j) { WriteBytes(j.In("@data/job1.txt"), FileBytes(j.In("@data/job1.asc"))); }),
      Row("--control-file a hard link of job1.cp, --pegs",
          "--control-file @data/area.cp --pegs @data/job1.asc", kExitDataErrors,
          {OverInput("@data/job1.cp")},
          [](Job& j) {
            WriteBytes(j.In("@data/job1.cp"),
                       FileBytes(j.In("@data/job1.cp")) + "TR SPARE 1 2 3\r\n");
            fs::create_hard_link(j.In("@data/job1.cp"), j.In("@data/area.cp"));
          }),
#ifdef KAVU_CLI_PICTURES
      Row("pictures: one that cannot be written, one over the field book",
          "--seed 1 --png @no/map.png --pdf @data/job1.asc @data/job1.asc", kExitDataErrors,
          {S(msg::kCannotWrite) + "@no/map.png\n", OverInput("@data/job1.asc")}),
#endif
      Row("products that are symbolic links: replaced, not followed", all, kExitOk, {},
          [](Job& j) {
            for (const char* link : {"@data/job1.txt", "@data/job1.kc", "@TRIDO/job1.asc"}) {
              const std::string target = j.In("@precious-") + fs::path(link).filename().string();
              WriteBytes(target, "not a product\r\n");
              fs::remove(j.In(link));
              fs::create_symlink(target, j.In(link));
            }
          },
          {"data/job1.txt", "data/job1.kc", "TRIDO/job1.asc"}),
      // Files may not grow beyond 2 KB: the larger products cannot be written.
      // The reason is named; the error report is not, since the run found no error.
      Row("disk full", all, kExitDataErrors,
          {Full("@data/job1.txt"), Full("@data/job1.td1"), Full("@data/job1.sdo"),
           Full("@data/job1.dxf")},
          nullptr, {}, "ulimit -f 4; trap '' XFSZ; ", {"job1.err", "job1.cpv"}),
      Row("a folder where a product goes", all, kExitDataErrors,
          {S(msg::kCannotWrite) + "@data/job1.txt (" + S(msg::kIsAFolder) + ")\n"},
          [](Job& j) {
            fs::remove(j.In("@data/job1.txt"));
            fs::create_directory(j.In("@data/job1.txt"));
          }),
      Row("the temporary files of a killed run", all, kExitOk, {},
          [](Job& j) {
            for (const char* name : {"@data/job1.txt.kavu-tmp", "@TRIDO/job1.asc.kavu-tmp"}) {
              WriteBytes(j.In(name), "cut short");
            }
            WriteBytes(j.In("@data/job1.lock"), "");
          },
          {"data/job1.txt.kavu-tmp", "TRIDO/job1.asc.kavu-tmp", "data/job1.lock"}),
      Row("two runs of one job at once", all, kExitStopped,
          {S(msg::kBeingComputed) + "@data/job1.asc"},
          [](Job& j) {
            j.held = std::make_unique<FileLock>();
            EXPECT_EQ(j.held->Acquire(j.In("@data/job1.lock")), FileLock::Result::Taken);
          },
          {"data/job1.lock"}),
      // The job grown large enough that its station loop is at work when
      // Ctrl+C comes, once the run writes its temporary files (its handler is
      // in place by then).
      Row("Ctrl+C", all, kExitInterrupted, {S(msg::kRunCancelled) + "\n"},
          file("@data/job1.asc", testing::GeneratedFieldBook(400, 100)), {},
          "(for i in $(seq 2000); do ls @data/*.kavu-tmp && break; sleep 0.005; done;"
          " kill -INT $$) >/dev/null 2>&1 & "),
      Row("a run stopped early: the control file is missing",
          "--all --control-file @data/none.kc @data/job1.asc", kExitStopped,
          {S(msg::kCannotOpen) + "@data/none.kc"}),
      Row("--control-file a folder", "--all --control-file @data @data/job1.asc", kExitStopped,
          {S(msg::kNotDataFile) + "@data"}),
      Row("the field book a FIFO", "--all @data/pipe.asc", kExitStopped,
          {S(msg::kNotDataFile) + "@data/pipe.asc"},
          [](Job& j) { EXPECT_EQ(mkfifo(j.In("@data/pipe.asc").c_str(), 0600), 0); }),
      Row("a missing field book", "--all @data/none.asc", kExitStopped,
          {S(msg::kFileNotFound) + "@data/none.asc\n" + S(msg::kEnterNewFile) + "\n"}),
      Row("an empty field book", "--all @data/empty.asc", kExitStopped,
          {S(msg::kFileSizeZero) + "\n" + S(msg::kCheckFileAgain) + "\n"},
          file("@data/empty.asc", "")),
      Row("every station fails: the report and the station listing", "--all @data/lost.asc",
          kExitDataErrors, {},
          file("@data/lost.asc", "TR DC01 1 2 3\r\nTR X 1.5\r\nDKD Y\r\n1 0 10 0900000 1.5\r\n"),
          {"data/lost.err", "data/lost.cpv"}),
  };
  for (const std::string& book : {S("TR DC01 1.45\r\n"), std::string(1 << 20, '7'),
                                  S("TR DC01 1 2 3\r\nTR DC02 4 5 6\r\n")}) {
    rows.push_back({"no station to compute: one line, one long line, control records only",
                    "--all @data/odd.asc",
                    kExitStopped,
                    {S(msg::kNoDetailData)},
                    file("@data/odd.asc", book)});
  }
  return rows;
}

TEST(Faults, NoFileIsEverLost) {
  const fs::path base = testing::FreshFolder();
  int n = 0;
  for (const Row& row : Rows()) {
    Job j{base / std::to_string(++n) / "job", nullptr};
    SCOPED_TRACE(std::to_string(n) + ": " + row.what);
    const auto args = [&j](const std::string& line) {
      std::string expanded = j.In(line);
      return SplitFields(expanded);
    };
    fs::create_directories(j.root / "data");
    fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", j.In("@data/job1.asc"));
    ASSERT_EQ(testing::Cli(args("--all --seed 1 @data/job1.asc")).code, kExitOk);

    if (row.prepare) row.prepare(j);
    const auto before = Files(j.root);
    const testing::Outcome o =
        row.shell.empty() ? testing::Cli(args(row.args))
                          : testing::Exe(args(row.args), j.root.parent_path(), j.In(row.shell));
    j.held.reset();
    const auto after = Files(j.root);

    EXPECT_EQ(o.code, row.code) << o.out << o.err;
    for (const std::string& text : row.shown) {
      EXPECT_NE((o.err + o.out).find(j.In(text)), std::string::npos) << text << o.out << o.err;
    }
    for (const std::string& text : row.hidden) {
      EXPECT_EQ((o.err + o.out).find(text), std::string::npos) << text << o.out << o.err;
    }
    const bool stopped = row.code == kExitStopped || row.code == kExitInterrupted;
    EXPECT_TRUE(o.out.empty() || !stopped) << o.out;
    for (const auto& [name, bytes] : before) {
      if (row.changed.contains(name)) continue;
      const auto it = after.find(name);
      ASSERT_NE(it, after.end()) << name << " is gone";
      EXPECT_TRUE(it->second == bytes) << name << " changed";
    }
    for (const auto& [name, bytes] : after) {
      EXPECT_TRUE(before.contains(name) || !stopped) << name << " was written";
      EXPECT_FALSE(name.ends_with(kTempSuffix) || name.ends_with(".lock")) << name << " is left";
    }
    for (const std::string& name : row.changed) {
      EXPECT_TRUE(before.contains(name) || after.contains(name)) << name << " was not written";
    }
  }
}

}  // namespace
}  // namespace kavu
