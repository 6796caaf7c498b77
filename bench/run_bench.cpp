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
#include "tests/generated_book.h"

namespace {

namespace fs = std::filesystem;

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
    out.Write(kavu::testing::GeneratedFieldBook(stations, points));
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
