// A whole computation run with every product on any field book.
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <string>

#include "core/host.h"
#include "core/lines.h"
#include "core/run.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  namespace fs = std::filesystem;
  static const fs::path folder =
      fs::temp_directory_path() / ("kavu_fuzz_" + std::to_string(getpid())) / "data";
  fs::create_directories(folder);
  {
    kavu::TextOut out(folder / "job.asc");
    out.Write(std::string(reinterpret_cast<const char*>(data), size));
    out.commit();
  }
  kavu::RunState st;
  st.txtfile = (folder / "job.asc").string();
  st.seed = 1;
  st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = st.fdxf = 1;
  kavu::QuietHost host;
  (void)kavu::tinh_Click(st, host);
  return 0;
}
