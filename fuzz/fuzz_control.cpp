// Any common control-point file, read for a field book whose stations look up
// the points P1, P2 and P3 in it, with every product.
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "fuzz/run_every_product.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const auto folder = [] {
    const auto made = kavu::fuzzing::Folder("kavu_fuzz_control");
    kavu::fuzzing::WriteFile(
        made / "job.asc",
        "TR P1 1.5\r\nDKD P2\r\n1 0450000 10 0900000 1.5\r\n2 0 20 0850000 1.5 P4X\r\n"
        "TR P2 1.4\r\nDKD P3\r\nDKD 0 30 0900000 1.5 P1\r\n3 1200000 15 0950000 1.5 KT\r\n");
    return made;
  }();
  kavu::fuzzing::WriteFile(folder / "area.kc",
                           std::string_view(reinterpret_cast<const char*>(data), size));
  kavu::fuzzing::RunEveryProduct(folder / "job.asc", (folder / "area.kc").string());
  return 0;
}
