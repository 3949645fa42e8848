#include <gtest/gtest.h>

#include <string>

#include "installer/DiskSpace.h"
#include "installer/ExtractionReport.h"
#include "installer/Slowdown.h"
#include "installer/VersionText.h"

TEST(DiskSpace, NeedsOnePointEightTimesTheArchive) {
  const uint64_t MB = 1 << 20, GB4 = uint64_t{4} << 30;
  EXPECT_TRUE(bEnoughSpace(180 * MB, 100 * MB));
  EXPECT_FALSE(bEnoughSpace(180 * MB - 1, 100 * MB));
  EXPECT_TRUE(bEnoughSpace(1, 1));  // 1.8 bytes are cut to one
  EXPECT_FALSE(bEnoughSpace(GB4, GB4 - 1));
  EXPECT_TRUE(bEnoughSpace(GB4 + 1, GB4 - 1));  // more than 4 GiB always pass
  EXPECT_EQ(lSpaceToFree(0xFFFFFFFFu, SPACE_ON_TEMP_DRIVE), 12582911);
}

TEST(Slowdown, SpreadsTheTimeOverTheFilesOfASmallArchive) {
  Slowdown slowdown(2097151);
  EXPECT_TRUE(slowdown.bStartsStretch());
  EXPECT_EQ(slowdown.PauseAfter(1000, 3, 5, 24000), 8000u);
  EXPECT_EQ(slowdown.PauseAfter(1000, 1, 5, 24000), 24000u);
  EXPECT_EQ(Slowdown(100).PauseAfter(100, 1, 5, 0), 0u);  // no slides
}

TEST(Slowdown, MeasuresALargeArchiveByStretchesOfOneMegabyte) {
  const uint32_t MB = 1048576;
  Slowdown slowdown(uint64_t{10} * MB);
  EXPECT_EQ(slowdown.PauseAfter(MB / 2, 20, 500, 24000), 0u);  // nothing computed yet
  EXPECT_FALSE(slowdown.bStartsStretch());
  // 9 MB still to come at 1000 ms for each: 15000 ms are left for 19 files.
  EXPECT_EQ(slowdown.PauseAfter(MB / 2, 19, 1000, 24000), 15000u / 19);
  EXPECT_TRUE(slowdown.bStartsStretch());
  EXPECT_EQ(slowdown.PauseAfter(MB - 1, 18, 700, 24000), 15000u / 19);  // the last pause again
  EXPECT_EQ(slowdown.PauseAfter(1, 17, 24000, 24000), 0u);              // slow enough by itself
}

TEST(Slowdown, TurnsToTheSmallRuleWhenLittleIsLeft) {
  Slowdown slowdown(3 * 1048576);
  slowdown.PauseAfter(2 * 1048576, 2, 0, 1000);
  EXPECT_EQ(slowdown.PauseAfter(1048576, 1, 50000, 1000), 1000u);
}

static std::string Label(const std::string& name) {
  CNString csLabel;
  MakeFileLabel(name.c_str(), csLabel);
  return csLabel.Text();
}

TEST(ExtractionReport, ShortensLongNamesAtASlash) {
  const std::string tail(40, 't');
  EXPECT_EQ(Label("folder/" + std::string(38, 't')), "folder/" + std::string(38, 't'));  // 45 characters
  EXPECT_EQ(Label("folders/" + std::string(38, 't')), "../" + std::string(38, 't'));     // 46
  EXPECT_EQ(Label("longer/folders/ab/" + tail), "../ab/" + tail);              // from the first '/' among the last 45
  EXPECT_EQ(Label("a/" + std::string(60, 't')), "a/" + std::string(60, 't'));  // no '/' among the last 45
}

TEST(ExtractionReport, CountsPercentInWholeNumbers) {
  EXPECT_EQ(iEntryPercent(1, 1), 100);
  EXPECT_EQ(iEntryPercent(1, 3), 33);
  EXPECT_EQ(iEntryPercent(29, 100), 29);
  EXPECT_EQ(iEntryPercent(50000000, 100000000), 50);
}

TEST(ExtractionReport, NamesTenFailedFilesAndCountsTheRest) {
  FailedFiles failed;
  CNString csText;
  failed.MakeText(csText);
  EXPECT_STREQ(csText.Text(), "");
  failed.Add("..\\x");
  failed.Add("<%failed_files%>\n");  // must not be taken for a marker, nor begin a line
  failed.MakeText(csText);
  EXPECT_STREQ(csText.Text(), "..\\x\n?%failed_files%>?");
  for (int i = 2; i < 10; i++) failed.Add("f");
  failed.MakeText(csText);
  EXPECT_EQ(csText.Find("more"), -1);
  failed.Add("g");
  failed.Add("h");
  failed.MakeText(csText);
  EXPECT_TRUE(csText.EndsWith("f\n... and 2 more"));
}

TEST(VersionText, TurnsTheCompilersDateAround) {
  CNString csVersion;
  MakeVersionText("Nov  5 2026", csVersion);
  EXPECT_STREQ(csVersion.Text(), "2026.11.05");
  MakeVersionText("Jan 31 2031", csVersion);
  EXPECT_STREQ(csVersion.Text(), "2031.01.31");
  MakeVersionText("anF  5 2026", csVersion);  // no month: two letters of one and one of the next
  EXPECT_STREQ(csVersion.Text(), "anF  5 2026");
}
