// Speed and memory of a computation run on synthetic field books of growing
// size, and of the number rules that every product line goes through.
#include <benchmark/benchmark.h>
#include <sys/resource.h>

#include <cmath>
#include <filesystem>
#include <string>

#include "core/host.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/run.h"

namespace {

namespace fs = std::filesystem;

// A field book of `stations` set-ups on a line of control points, each with
// `points` detail points, a peg and a check record.
std::string FieldBook(int stations, int points) {
  std::string book;
  for (int k = 0; k <= stations; ++k) {
    book += "TR K" + std::to_string(k) + " " + std::to_string(1000 + 100 * k) + " 5000 10\r\n";
  }
  for (int k = 1; k <= stations; ++k) {
    book += "TR K" + std::to_string(k) + " 1.5\r\nDKD K" + std::to_string(k - 1) + "\r\n";
    for (int p = 0; p < points; ++p) {
      const int reading = (p * 7919) % 3600000;
      book += std::to_string(k) + "-" + std::to_string(p) + " " + std::to_string(reading) + " " +
              std::to_string(5 + p % 150) + ".125 0893000 1.5 N\r\n";
    }
    book += "C" + std::to_string(k) + " 1800000 20 900000 1.5 CP" + std::to_string(k) + "\r\n";
    book += "T" + std::to_string(k) + " 0 100 900000 1.5 K" + std::to_string(k + 1) + " KT\r\n";
  }
  return book;
}

long PeakRssKiB() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  return usage.ru_maxrss;
}

void BM_ComputationRun(benchmark::State& state) {
  const int stations = static_cast<int>(state.range(0));
  const int points = 100;
  const fs::path folder = fs::temp_directory_path() / ("kavu_bench_" + std::to_string(stations));
  fs::create_directories(folder / "data");
  const fs::path file = folder / "data" / "job.asc";
  {
    kavu::TextOut out(file);
    out.Write(FieldBook(stations, points));
    out.commit();
  }
  kavu::QuietHost host;
  for (auto _ : state) {
    kavu::RunState st;
    st.txtfile = file.string();
    st.seed = 1;
    st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = st.fdxf = 1;
    benchmark::DoNotOptimize(kavu::tinh_Click(st, host));
  }
  state.SetItemsProcessed(state.iterations() * stations * points);
  state.counters["peak_rss_KiB"] = static_cast<double>(PeakRssKiB());
  fs::remove_all(folder);
}
BENCHMARK(BM_ComputationRun)->Arg(10)->Arg(100)->Arg(1000)->Unit(benchmark::kMillisecond);

void BM_Val(benchmark::State& state) {
  for (auto _ : state) benchmark::DoNotOptimize(kavu::Val(" 2345678.123"));
}
BENCHMARK(BM_Val);

void BM_Mask(benchmark::State& state) {
  double x = 2345678.1234;
  for (auto _ : state) {
    benchmark::DoNotOptimize(kavu::Mask(x, "#######.000"));
    x += 0.001;
  }
}
BENCHMARK(BM_Mask);

void BM_NumberText(benchmark::State& state) {
  double x = 0.05;
  for (auto _ : state) {
    benchmark::DoNotOptimize(kavu::NumberText(x));
    x += 0.01;
  }
}
BENCHMARK(BM_NumberText);

}  // namespace
