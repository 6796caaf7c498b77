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
#include <set>
#include <string>
#include <vector>

#include "cli/cli.h"
#include "core/lines.h"
#include "core/messages.h"
#include "tests/cli/cli_support.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::Cli;
using testing::Exe;
using testing::FileBytes;
using testing::FreshFolder;
using testing::Outcome;
using testing::WriteBytes;

// The example job: root/data/job1.asc, its products beside it and the
// regenerated field book in root/TRIDO.
struct Job {
  fs::path root, data;
  std::string book;
  std::unique_ptr<FileLock> held;  // another run's lock on the job
  std::string In(const std::string& name) const { return (data / name).string(); }
};

// Every file under root by its relative path: the bytes of a regular file,
// the target of a link; FIFOs and devices are never opened.
std::map<std::string, std::string> Files(const fs::path& root) {
  std::map<std::string, std::string> files;
  for (const auto& entry : fs::recursive_directory_iterator(root)) {
    const std::string name = entry.path().lexically_relative(root).string();
    const fs::file_status status = entry.symlink_status();
    if (fs::is_symlink(status)) {
      files[name] = "link to " + fs::read_symlink(entry.path()).string();
    } else if (fs::is_regular_file(status)) {
      files[name] = FileBytes(entry.path());
    } else if (!fs::is_directory(status)) {
      files[name] = "<special>";
    }
  }
  return files;
}

// What the row runs, and the texts the run must show (on stderr or stdout).
struct Call {
  std::vector<std::string> args;
  std::vector<std::string> messages;
};

struct Row {
  std::string what;
  std::function<Call(Job&)> prepare;  // makes the fault in the job's folder
  int code;
  std::vector<std::string> changed = {};  // files that may change, from the root
  std::string shell = "";                 // runs the executable after this set-up
  std::function<void(const Job&)> check = nullptr;
};

std::string Message(std::string_view text, const std::string& path) {
  return std::string(text) + path;
}

std::string OverInput(const std::string& path) {
  return std::string(msg::kCannotWrite) + path + std::string(msg::kProductIsInput);
}

// A file that is no data file, given in place of a file the run reads.
Call NotData(Job& j, const std::string& name, bool fifo, std::vector<std::string> args) {
  const std::string path = j.In(name);
  if (fifo) {
    EXPECT_EQ(mkfifo(path.c_str(), 0600), 0);
  } else {
    fs::create_directory(path);
  }
  args.push_back(path);
  if (args.size() == 3) args.push_back(j.book);
  return {args, {Message(msg::kNotDataFile, path)}};
}

std::vector<Row> Rows() {
  std::vector<Row> rows;
  for (const char* kind : {"1", "2", "3", "5", "6", "7"}) {
    rows.push_back(
        {std::string("conversion kind ") + kind + " of the field book itself",
         [kind](Job& j) -> Call {
           return {{"--kind", kind, "--all", j.book}, {Message(msg::kConversionOverInput, j.book)}};
         },
         kExitStopped});
  }
  rows.push_back({"field book inside a folder named TRIDO, --asc",
                  [](Job& j) -> Call {
                    const std::string book = (j.root / "TRIDO" / "job1.asc").string();
                    return {{"--asc", book}, {OverInput(book)}};
                  },
                  kExitDataErrors});
  // The common control file by its own name, a hard link and a ./ path.
  rows.push_back(
      {"--control-file job1.kc --kc",
       [](Job& j) -> Call {
         WriteBytes(j.In("job1.kc"), FileBytes(j.In("job1.kc")) + "TR SPARE 1 2 3\r\n");
         return {{"--control-file", j.In("job1.kc"), "--kc", j.book}, {OverInput(j.In("job1.kc"))}};
       },
       kExitDataErrors});
  rows.push_back(
      {"--control-file a hard link of job1.kc, --kc",
       [](Job& j) -> Call {
         fs::create_hard_link(j.In("job1.kc"), j.data / "area.kc");
         return {{"--control-file", j.In("area.kc"), "--kc", j.book}, {OverInput(j.In("job1.kc"))}};
       },
       kExitDataErrors});
  rows.push_back({"--control-file ./job1.kc --kc",
                  [](Job& j) -> Call {
                    return {{"--control-file", (j.data / "." / "job1.kc").string(), "--kc", j.book},
                            {OverInput(j.In("job1.kc"))}};
                  },
                  kExitDataErrors});
  rows.push_back({"--control-file job1.cp --pegs",
                  [](Job& j) -> Call {
                    return {{"--control-file", j.In("job1.cp"), "--pegs", j.book},
                            {OverInput(j.In("job1.cp")), std::string(msg::kTotalErrors) + " 0\n"}};
                  },
                  kExitDataErrors});
  rows.push_back(
      {"--kind 0 job1.txt --txt",
       [](Job& j) -> Call {
         WriteBytes(j.In("job1.txt"), FileBytes(j.book));
         return {{"--kind", "0", "--txt", j.In("job1.txt")}, {OverInput(j.In("job1.txt"))}};
       },
       kExitDataErrors});
  rows.push_back({"products that are symbolic links",
                  [](Job& j) -> Call {
                    for (const fs::path& link :
                         {j.data / "job1.txt", j.data / "job1.kc", j.root / "TRIDO" / "job1.asc"}) {
                      const fs::path target = j.root / ("precious-" + link.filename().string());
                      WriteBytes(target, "not a product\r\n");
                      fs::remove(link);
                      fs::create_symlink(target, link);
                    }
                    return {{"--all", "--seed", "1", j.book}, {}};
                  },
                  kExitOk,
                  {"data/job1.txt", "data/job1.kc", "TRIDO/job1.asc"},
                  "",
                  [](const Job& j) {
                    EXPECT_TRUE(fs::is_regular_file(fs::symlink_status(j.data / "job1.kc")));
                  }});
  rows.push_back({"a run stopped early: the control file is missing",
                  [](Job& j) -> Call {
                    return {{"--all", "--control-file", j.In("none.kc"), j.book},
                            {Message(msg::kCannotOpen, j.In("none.kc"))}};
                  },
                  kExitStopped});
  // Files may not grow beyond 2 KB: the larger products cannot be written.
  rows.push_back({"disk full",
                  [](Job& j) -> Call {
                    Call call{{"--all", "--seed", "1", j.book}, {}};
                    for (const char* name : {"job1.txt", "job1.td1", "job1.sdo", "job1.dxf"}) {
                      call.messages.push_back(Message(msg::kCannotWrite, j.In(name)));
                    }
                    return call;
                  },
                  kExitDataErrors,
                  {},
                  "ulimit -f 4; trap '' XFSZ; "});
  rows.push_back({"the temporary files of a killed run",
                  [](Job& j) -> Call {
                    WriteBytes(j.In("job1.txt.kavu-tmp"), "cut short");
                    WriteBytes(j.root / "TRIDO" / "job1.asc.kavu-tmp", "cut short");
                    WriteBytes(j.In("job1.lock"), "");
                    return {{"--all", "--seed", "1", j.book}, {}};
                  },
                  kExitOk,
                  {"data/job1.txt.kavu-tmp", "TRIDO/job1.asc.kavu-tmp", "data/job1.lock"}});
  rows.push_back({"two runs of one job at once",
                  [](Job& j) -> Call {
                    j.held = std::make_unique<FileLock>();
                    EXPECT_EQ(j.held->Acquire(j.In("job1.lock")), FileLock::Result::Taken);
                    return {{"--all", j.book}, {Message(msg::kBeingComputed, j.book)}};
                  },
                  kExitStopped,
                  {"data/job1.lock"}});
  rows.push_back({"--control-file a FIFO",
                  [](Job& j) {
                    return NotData(j, "pipe.kc", true, {"--all", "--control-file"});
                  },
                  kExitStopped});
  rows.push_back({"--control-file a folder",
                  [](Job& j) {
                    return NotData(j, "area.kc", false, {"--all", "--control-file"});
                  },
                  kExitStopped});
  rows.push_back({"--control-file /dev/zero",
                  [](Job& j) -> Call {
                    return {{"--all", "--control-file", "/dev/zero", j.book},
                            {Message(msg::kNotDataFile, "/dev/zero")}};
                  },
                  kExitStopped});
  rows.push_back({"the field book a FIFO",
                  [](Job& j) { return NotData(j, "pipe.asc", true, {"--all"}); }, kExitStopped});
  rows.push_back({"the instrument file a FIFO",
                  [](Job& j) { return NotData(j, "pipe.sdr", true, {"--all"}); }, kExitStopped});
  for (const auto& [what, book] : std::vector<std::pair<std::string, std::string>>{
           {"a one-line field book", "TR DC01 1.45\r\n"},
           {"a field book of one long line", std::string(1 << 20, '7')},
           {"a field book of control records only", "TR DC01 1 2 3\r\nTR DC02 4 5 6\r\n"}}) {
    rows.push_back({what,
                    [book](Job& j) -> Call {
                      WriteBytes(j.In("odd.asc"), book);
                      return {{"--all", j.In("odd.asc")}, {std::string(msg::kNoDetailData)}};
                    },
                    kExitStopped});
  }
  rows.push_back({"every station fails",
                  [](Job& j) -> Call {
                    WriteBytes(j.In("lost.asc"),
                               "TR DC01 1 2 3\r\nTR X 1.5\r\nDKD Y\r\n1 0 10 0900000 1.5\r\n");
                    return {{"--all", j.In("lost.asc")}, {}};
                  },
                  kExitDataErrors,
                  {},
                  "",
                  [](const Job& j) {
                    EXPECT_TRUE(fs::is_regular_file(j.data / "lost.err"));
                    EXPECT_TRUE(fs::is_regular_file(j.data / "lost.cpv"));
                  }});
  return rows;
}

TEST(Faults, NoFileIsEverLost) {
  const fs::path base = FreshFolder();
  int n = 0;
  for (const Row& row : Rows()) {
    SCOPED_TRACE(row.what);
    Job j;
    j.root = base / std::to_string(++n) / "job";
    j.data = j.root / "data";
    fs::create_directories(j.data);
    j.book = j.In("job1.asc");
    fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", j.book);
    ASSERT_EQ(Cli({"--all", "--seed", "1", j.book}).code, kExitOk);

    const Call call = row.prepare(j);
    const auto before = Files(j.root);
    const Outcome o =
        row.shell.empty() ? Cli(call.args) : Exe(call.args, j.root.parent_path(), row.shell);
    j.held.reset();
    const auto after = Files(j.root);

    EXPECT_EQ(o.code, row.code) << o.out << o.err;
    for (const std::string& text : call.messages) {
      EXPECT_NE((o.err + o.out).find(text), std::string::npos) << text << "\n" << o.out << o.err;
    }
    const std::set<std::string> changed(row.changed.begin(), row.changed.end());
    for (const auto& [name, bytes] : before) {
      if (changed.contains(name)) continue;
      const auto it = after.find(name);
      ASSERT_NE(it, after.end()) << name << " is gone";
      EXPECT_TRUE(it->second == bytes) << name << " changed";
    }
    for (const auto& [name, bytes] : after) {
      EXPECT_TRUE(row.code != kExitStopped || before.contains(name)) << name << " was written";
      EXPECT_FALSE(name.ends_with(kTempSuffix) || name.ends_with(".lock")) << name << " is left";
    }
    if (row.check) row.check(j);
  }
}

}  // namespace
}  // namespace kavu
