// kavu-cli --png, --svg and --pdf: the map and the field sketch of a batch run,
// or a usage error in a build without Qt.
#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"
#include "core/messages.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;
using testing::FreshFolder;

int Cli(const std::vector<std::string>& args, std::string& out, std::string& err) {
  const std::vector<std::string_view> views(args.begin(), args.end());
  std::ostringstream o, e;
  const int code = RunCli(views, o, e, false);
  out = o.str();
  err = e.str();
  return code;
}

#ifdef KAVU_CLI_PICTURES

TEST(CliPictures, TheExampleAsPngSvgAndSketchPdf) {
  const fs::path dir = FreshFolder();
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", dir / "job1.asc");
  const fs::path png = dir / "map.png", svg = dir / "map.svg", pdf = dir / "sketch.pdf";
  std::string out, err;
  ASSERT_EQ(Cli({(dir / "job1.asc").string(), "--png", png.string(), "--svg", svg.string(), "--pdf",
                 pdf.string(), "--seed", "1"},
                out, err),
            kExitOk)
      << out << err;
  EXPECT_EQ(err, "");  // Qt's notes about the missing desktop stay quiet
  EXPECT_TRUE(FileBytes(png).starts_with("\x89PNG\r\n"));
  const std::string picture = FileBytes(svg);
  EXPECT_NE(picture.find("<svg"), std::string::npos);
  EXPECT_NE(picture.find(">DC04<"), std::string::npos);
  EXPECT_TRUE(FileBytes(pdf).starts_with("%PDF-"));
  EXPECT_TRUE(fs::exists(dir / "job1.sdo")) << "--pdf ticks the sketch";

  // A picture that cannot be written is named like a product, exit 1.
  const std::string nowhere = (dir / "no" / "map.png").string();
  EXPECT_EQ(Cli({(dir / "job1.asc").string(), "--png", nowhere}, out, err), kExitDataErrors);
  EXPECT_NE(out.find(std::string(msg::kCannotWrite) + nowhere), std::string::npos) << out;
  // Nor does it replace the field book.
  const std::string book = (dir / "job1.asc").string();
  EXPECT_EQ(Cli({book, "--pdf", book}, out, err), kExitDataErrors);
  EXPECT_NE(out.find(std::string(msg::kCannotWrite) + book + std::string(msg::kProductIsInput)),
            std::string::npos)
      << out;
  EXPECT_EQ(FileBytes(book), FileBytes(fs::path(KAVU_EXAMPLES) / "job1.asc"));
}

#else

TEST(CliPictures, ABuildWithoutQtRefusesThemAsUsage) {
  const fs::path dir = FreshFolder();
  for (const char* option : {"--png", "--svg", "--pdf"}) {
    std::string out, err;
    EXPECT_EQ(Cli({(dir / "a.asc").string(), option, (dir / "x").string()}, out, err), kExitUsage)
        << option;
    EXPECT_NE(err.find("without Qt"), std::string::npos) << err;
    EXPECT_FALSE(fs::exists(dir / "x"));
  }
}

#endif

}  // namespace
}  // namespace kavu
