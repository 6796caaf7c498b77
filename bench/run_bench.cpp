// Speed and memory of a computation run with every product ticked, each
// figure beside its floor: the same process reading the field book and
// writing as many bytes as the run's products, the way products are written
// (a temporary file, flushed to the disk, renamed). Every run is a child
// process of its own, so that its peak memory is its own.
//
//   kavu_bench [--quick]
//
// Field books of 100 detail points per station, a peg and a check record per
// station (10,000, 100,000 and 1,000,000 points; --quick stops at 100,000),
// then the hostile inputs: 10 million lines of one or two characters and a
// single line of 200 MB.
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include "core/host.h"
#include "core/lines.h"
#include "run/run.h"
#include "tests/generated_book.h"

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;

struct Measure {
  double seconds = 0;
  double peakMiB = 0;
};

// Runs body in a child process: its wall time and its peak resident memory.
template <typename Body>
Measure InChild(Body body) {
  // What is waiting in the buffers is printed once, not again by the child.
  std::fflush(nullptr);
  const auto start = Clock::now();
  const pid_t pid = fork();
  if (pid == 0) {
    body();
    _exit(0);
  }
  int status = 0;
  rusage usage{};
  wait4(pid, &status, 0, &usage);
  Measure m;
  m.seconds = std::chrono::duration<double>(Clock::now() - start).count();
  m.peakMiB = static_cast<double>(usage.ru_maxrss) / 1024;
  return m;
}

void Compute(const fs::path& file) {
  kavu::QuietHost host;
  kavu::RunState st;
  st.txtfile = file.string();
  st.seed = 1;
  st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = st.fdxf = 1;
  kavu::tinh_Click(st, host);
}

// The bytes of every file in the job's tree but the field book.
std::uintmax_t ProductBytes(const fs::path& root, const fs::path& input) {
  std::uintmax_t bytes = 0;
  for (const auto& entry : fs::recursive_directory_iterator(root)) {
    if (entry.is_regular_file() && entry.path() != input) bytes += entry.file_size();
  }
  return bytes;
}

// The floor: read the field book, write `bytes` to a temporary file, flush it
// to the disk and rename it.
void Floor(const fs::path& input, std::uintmax_t bytes) {
  const auto book = kavu::ReadFileBytes(input);
  const fs::path target = input.parent_path() / "floor.out";
  kavu::TextOut out(target);
  const std::string block(1 << 16, book && !book->empty() ? (*book)[0] : 'x');
  for (std::uintmax_t left = bytes; left > 0;) {
    const std::size_t n = static_cast<std::size_t>(std::min<std::uintmax_t>(left, block.size()));
    out.Write(std::string_view(block).substr(0, n));
    left -= n;
  }
  out.commit();
}

Measure Median(std::vector<Measure> runs) {
  std::sort(runs.begin(), runs.end(),
            [](const Measure& a, const Measure& b) { return a.seconds < b.seconds; });
  Measure m = runs[runs.size() / 2];
  for (const Measure& r : runs) m.peakMiB = std::max(m.peakMiB, r.peakMiB);
  return m;
}

// A fresh job folder holding the field book.
fs::path Job(const std::string& name, const std::string& book) {
  const fs::path root = fs::temp_directory_path() / ("kavu_bench_" + name);
  fs::remove_all(root);
  fs::create_directories(root / "data");
  const fs::path file = root / "data" / "job.asc";
  kavu::TextOut out(file);
  out.Write(book);
  out.commit();
  return file;
}

}  // namespace

int main(int argc, char** argv) {
  const bool quick = argc > 1 && std::strcmp(argv[1], "--quick") == 0;
  constexpr int kRepeats = 5;
  std::printf("%-28s %10s %10s %8s %12s %10s %10s\n", "field book", "run s", "floor s", "x floor",
              "us a point", "peak MiB", "input MiB");
  double perPointAt10k = 0;
  for (const int stations : {100, 1000, 10000}) {
    if (quick && stations > 1000) break;
    const int points = 100;
    const fs::path file =
        Job(std::to_string(stations), kavu::testing::GeneratedFieldBook(stations, points));
    const fs::path root = file.parent_path().parent_path();
    std::vector<Measure> runs, floors;
    for (int k = 0; k < kRepeats; ++k) runs.push_back(InChild([&] { Compute(file); }));
    const std::uintmax_t bytes = ProductBytes(root, file);
    for (int k = 0; k < kRepeats; ++k) floors.push_back(InChild([&] { Floor(file, bytes); }));
    const Measure run = Median(runs);
    const Measure floor = Median(floors);
    const double perPoint = run.seconds / (stations * points) * 1e6;
    if (stations == 100) perPointAt10k = perPoint;
    std::printf("%-28s %10.3f %10.3f %8.1f %12.2f %10.1f %10.1f\n",
                (std::to_string(stations * points) + " points").c_str(), run.seconds, floor.seconds,
                run.seconds / floor.seconds, perPoint, run.peakMiB,
                static_cast<double>(fs::file_size(file)) / (1 << 20));
    if (stations > 100) {
      std::printf("%-28s %.2fx the time a point at 10,000 points\n", "", perPoint / perPointAt10k);
    }
    fs::remove_all(root);
  }
  if (quick) return 0;
  // Hostile inputs: the peak against three times the input and 64 MB. Each
  // book is made and let go of before the run, whose peak would count the
  // pages it shares with this process.
  const auto shortLines = [] {
    std::string book;
    for (int k = 0; k < 10'000'000; ++k) book += k % 2 == 0 ? "a\r\n" : "TR\r\n";
    return book;
  };
  const auto longLine = [] { return std::string(200 << 20, '7'); };
  for (const auto& [name, make] :
       {std::pair<const char*, std::string (*)()>{"10M lines of 1-2 characters", shortLines},
        {"one line of 200 MB", longLine}}) {
    const fs::path file = Job("hostile", make());
    const Measure run = InChild([&] { Compute(file); });
    const double inputMiB = static_cast<double>(fs::file_size(file)) / (1 << 20);
    std::printf("%-28s %10.3f %10s %8s %12s %10.1f %10.1f  (limit %.0f MiB)\n", name, run.seconds,
                "-", "-", "-", run.peakMiB, inputMiB, 3 * inputMiB + 64);
    fs::remove_all(file.parent_path().parent_path());
  }
  return 0;
}
