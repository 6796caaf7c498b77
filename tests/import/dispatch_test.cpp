#include "import/dispatch.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace kavu {
namespace {

// The names of a path, native on each system: on Windows with drive letters
// and backslashes (the system's absolute path gives the TRIDO folder).
TEST(DeriveFileSelection, ProductsAreNamedAfterTheFileNameOnly) {
  struct Case {
    const char *path, *tentm, *daufile, *duoifile, *tentmbd, *filesl1;
  };
  const Case cases[] = {
#ifdef _WIN32
      // A dot in a folder name does not rename the products.
      {"D:\\Đo vẽ\\My.Data\\Job1.v2.ASC", "D:\\Đo vẽ\\My.Data\\", "D:\\Đo vẽ\\My.Data\\Job1", "v2",
       "D:\\Đo vẽ\\TRIDO\\", "D:\\Đo vẽ\\TRIDO\\Job1.asc"},
      // Forward slashes are separators too.
      {"C:/data/survey/job1.sdr", "C:/data/survey/", "C:/data/survey/job1", "sdr",
       "C:\\data\\TRIDO\\", "C:\\data\\TRIDO\\job1.asc"},
      // At the drive root the folder has no parent: TRIDO goes into it.
      {"C:\\job1.asc", "C:\\", "C:\\job1", "asc", "C:\\TRIDO\\", "C:\\TRIDO\\job1.asc"},
#else
      // A dot in a folder name does not rename the products.
      {"/data/My.Data/Job1.v2.ASC", "/data/My.Data/", "/data/My.Data/Job1", "v2", "/data/TRIDO/",
       "/data/TRIDO/Job1.asc"},
      // At the root the folder has no parent: TRIDO goes into it.
      {"/job1.asc", "/", "/job1", "asc", "/TRIDO/", "/TRIDO/job1.asc"},
#endif
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.path);
    FileSelection sel;
    DeriveFileSelection(sel, c.path);
    using Names = std::vector<std::string>;
    EXPECT_EQ((Names{sel.filesl, sel.tentm, sel.daufile, sel.duoifile, sel.tentmbd, sel.filesl1}),
              (Names{c.path, c.tentm, c.daufile, c.duoifile, c.tentmbd, c.filesl1}));
  }
}

}  // namespace
}  // namespace kavu
