// The common control-point file, read for a field book whose stations look up
// the points P1, P2 and P3 in it, with every product.
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>

#include "core/host.h"
#include "core/lines.h"
#include "core/run.h"

namespace {

void Write(const std::filesystem::path& path, std::string_view bytes) {
  kavu::TextOut out(path);
  out.Write(bytes);
  out.commit();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  namespace fs = std::filesystem;
  static const fs::path folder =
      fs::temp_directory_path() / ("kavu_fuzz_control_" + std::to_string(getpid())) / "data";
  static const bool ready = [] {
    fs::create_directories(folder);
    Write(folder / "job.asc",
          "TR P1 1.5\r\nDKD P2\r\n1 0450000 10 0900000 1.5\r\n2 0 20 0850000 1.5 P4X\r\n"
          "TR P2 1.4\r\nDKD P3\r\nDKD 0 30 0900000 1.5 P1\r\n3 1200000 15 0950000 1.5 KT\r\n");
    return true;
  }();
  (void)ready;
  Write(folder / "area.kc", std::string_view(reinterpret_cast<const char*>(data), size));

  kavu::RunState st;
  st.txtfile = (folder / "job.asc").string();
  st.ckKC = 1;
  st.txtFKC = (folder / "area.kc").string();
  st.seed = 1;
  st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = st.fdxf = 1;
  kavu::QuietHost host;
  (void)kavu::tinh_Click(st, host);
  return 0;
}
