// A whole computation run with every product on any field book.
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "fuzz/run_every_product.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const auto folder = kavu::fuzzing::Folder("kavu_fuzz");
  kavu::fuzzing::WriteFile(folder / "job.asc",
                           std::string_view(reinterpret_cast<const char*>(data), size));
  kavu::fuzzing::RunEveryProduct(folder / "job.asc");
  return 0;
}
