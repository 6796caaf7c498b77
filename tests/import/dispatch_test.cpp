#include "import/dispatch.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

TEST(DeriveFileSelection, ProductsAreNamedAfterTheFileNameOnly) {
  FileSelection sel;
  DeriveFileSelection(sel, "/data/survey/job1.sdr");
  EXPECT_EQ(sel.filesl, "/data/survey/job1.sdr");
  EXPECT_EQ(sel.tentm, "/data/survey/");
  EXPECT_EQ(sel.daufile, "/data/survey/job1");
  EXPECT_EQ(sel.duoifile, "sdr");
  EXPECT_EQ(sel.tentmbd, "/data/TRIDO/");
  EXPECT_EQ(sel.filesl1, "/data/TRIDO/job1.asc");

  // A dot in a folder name no longer renames the products.
  DeriveFileSelection(sel, "/data/My.Data/Job1.v2.ASC");
  EXPECT_EQ(sel.daufile, "/data/My.Data/Job1");
  EXPECT_EQ(sel.duoifile, "v2");
  EXPECT_EQ(sel.filesl1, "/data/TRIDO/Job1.asc");

  // No dot at all: kind 9 and the whole path as the base.
  DeriveFileSelection(sel, "/data/survey/README");
  EXPECT_EQ(sel.daufile, "/data/survey/README");
  EXPECT_EQ(sel.duoifile, "");
  EXPECT_EQ(KindOfExtension(sel.duoifile), 9);

  // At the root the folder has no parent: TRIDO goes into it.
  DeriveFileSelection(sel, "/job1.asc");
  EXPECT_EQ(sel.tentmbd, "/TRIDO/");
}

TEST(KindOfExtension, UpperCaseExtensionsSelectTheirKindAndPattern) {
  const char* extensions[] = {"ASC", "SDR", "OBS", "SET", "RAW", "IDX", "TCM", "GRE", "DN7"};
  for (int k = 0; k < 9; ++k) EXPECT_EQ(KindOfExtension(extensions[k]), k);
  EXPECT_EQ(KindOfExtension("sdr"), 9);
  EXPECT_EQ(KindOfExtension("TXT"), 9);
  EXPECT_EQ(PatternOfKind(6), "*.tcm");
  EXPECT_EQ(PatternOfKind(9), "*.*");
  EXPECT_EQ(PatternOfKind(42), "*.*");
}

TEST(CheckAndConvert, KindComesFromTheExtensionUnlessOverriddenAndHeaderIsCut) {
  const fs::path folder = testing::FreshFolder();
  testing::WriteBytes(folder / "job.TXT", "anything\r\n");
  testing::WriteBytes(folder / "job.asc", "TR A 1.5\r\n");
  testing::RecordingHost host;
  RunState st;
  st.txtfile = (folder / "job.TXT").string();
  st.fsdo = 1;
  st.nhapsdo[1] = "sketch number longer than six";
  const auto lines = CheckAndConvert(st, host);
  ASSERT_TRUE(lines);
  EXPECT_EQ(*lines, std::vector<std::string>{"TR A 1.5"});
  EXPECT_EQ(st.filesl, (folder / "job.asc").string());
  EXPECT_EQ(host.fileBox, st.filesl);
  EXPECT_EQ(st.cbkieu, 0);
  EXPECT_EQ(st.nhap[1], "sketch");
  EXPECT_EQ(st.nhap[6], std::string(10, ' '));

  // Told it is a field book, the chosen file itself is read.
  RunState told;
  told.txtfile = (folder / "job.TXT").string();
  told.kindOverride = 0;
  EXPECT_EQ(*CheckAndConvert(told, host), std::vector<std::string>{"anything"});
}

}  // namespace
}  // namespace kavu
