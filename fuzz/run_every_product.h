// The fuzzers' run: a file written whole, and one computation run with every
// product ticked, as the compute button makes it.
#pragma once

#include <unistd.h>

#include <filesystem>
#include <string>
#include <string_view>

#include "core/host.h"
#include "core/lines.h"
#include "core/run.h"

namespace kavu::fuzzing {

// A folder of this fuzzing process: runs write their products there.
inline std::filesystem::path Folder(const std::string& name) {
  const std::filesystem::path folder =
      std::filesystem::temp_directory_path() / (name + "_" + std::to_string(getpid())) / "data";
  std::filesystem::create_directories(folder);
  return folder;
}

inline void WriteFile(const std::filesystem::path& path, std::string_view bytes) {
  TextOut out(path);
  out.Write(bytes);
  out.commit();
}

// A run of the field book with every product; with a common control-point
// file when one is named.
inline void RunEveryProduct(const std::filesystem::path& book,
                            const std::string& controlFile = "") {
  RunState st;
  st.txtfile = book.string();
  st.ckKC = controlFile.empty() ? 0 : 1;
  st.txtFKC = controlFile;
  st.seed = 1;
  st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = st.fdxf = 1;
  QuietHost host;
  (void)tinh_Click(st, host);
}

}  // namespace kavu::fuzzing
