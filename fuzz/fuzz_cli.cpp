// The batch command's handling of its arguments, with a kind chosen by hand:
// the first byte picks the kind of the table of formats, the bytes up to the
// first NUL are options, one a line (only lines that begin with "-" are
// passed, and no picture option, so that the products stay in the fuzzer's
// folder), and the rest is the chosen file, named with the kind's extension
// (".dat" for any other).
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"
#include "core/lines.h"
#include "import/formats.h"
#include "fuzz/run_every_product.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const std::filesystem::path folder = kavu::fuzzing::Folder("kavu_fuzz_cli");
  if (size == 0) return 0;
  const auto formats = kavu::Formats();
  const int kind = data[0] % static_cast<int>(formats.size());
  const kavu::Format& format = formats[static_cast<std::size_t>(kind)];
  const std::string extension =
      format.extension.empty() ? std::string(".dat") : "." + std::string(format.name);
  const std::string_view rest(reinterpret_cast<const char*>(data) + 1, size - 1);
  const std::size_t nul = rest.find('\0');
  const std::string_view options = rest.substr(0, nul);
  const std::string_view content = nul == std::string_view::npos ? "" : rest.substr(nul + 1);

  const std::filesystem::path file =
      folder / (std::string("job") + extension);
  kavu::fuzzing::WriteFile(file, content);
  std::vector<std::string> args{"--kind", std::to_string(kind), "--seed", "1"};
  for (const std::string& line : kavu::SplitLines(options)) {
    // A picture option takes the next line, whatever it is, as its file and
    // would write it outside the folder: pictures are left out.
    const bool picture =
        line.starts_with("--png") || line.starts_with("--svg") || line.starts_with("--pdf");
    if (line.starts_with("-") && !picture) args.push_back(line);
  }
  args.push_back(file.string());
  const std::vector<std::string_view> views(args.begin(), args.end());
  std::ostringstream out, err;
  (void)kavu::RunCli(views, out, err, false);
  return 0;
}
