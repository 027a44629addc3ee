#include "manual/ManualPages.h"

#include <gmock/gmock.h>

#include "tests/manual/Edition.h"

namespace {

using testing::IsEmpty;

TEST(ManualPages, BeginAtHeadingsOfTheSecondLevel) {
  const std::vector<ManualPage> pages =
      ManualPages("# Manual\n\nbefore\n\n## First\r\n\ntext\n### Part\nmore\n## Second\nend");
  ASSERT_EQ(pages.size(), 2U);
  EXPECT_EQ(pages[0].Title, "First");
  EXPECT_EQ(pages[0].Text, "## First\r\n\ntext\n### Part\nmore\n");
  EXPECT_EQ(pages[1].Title, "Second");
  EXPECT_EQ(pages[1].Text, "## Second\nend");
}

TEST(ManualPages, AreNoneWithoutHeadings) {
  EXPECT_THAT(ManualPages(""), IsEmpty());
  EXPECT_THAT(ManualPages("text\n# Title\n"), IsEmpty());
}

TEST(ManualPages, TellAboutEachWindow) {
  const std::vector<ManualPage> pages = ManualPages(Edition("manual.md").Text());
  ASSERT_GT(WindowPages().size(), 15U);
  for (const WindowPage& window : WindowPages()) {
    const auto page = PageOfWindow(window.Window, pages);
    ASSERT_TRUE(page) << window.Window;
    EXPECT_EQ(pages[*page].Title, window.English);
  }
  EXPECT_FALSE(PageOfWindow("CommonDialog1", pages));
}

TEST(ManualPages, AreFoundByTheirChineseTitles) {
  const std::vector<ManualPage> pages = ManualPages(Edition("manual.zh.md").Text());
  for (const WindowPage& window : WindowPages()) {
    const auto page = PageOfWindow(window.Window, pages);
    ASSERT_TRUE(page) << window.Window;
    EXPECT_EQ(pages[*page].Title, window.Chinese);
  }
}

TEST(ManualPages, AreFoundByLinks) {
  const std::vector<ManualPage> pages =
      ManualPages("## The board\n## If it fails, ask: (twice) a re-run\n## 计分板 A\n");
  EXPECT_EQ(AnchorOf(pages[1].Title), "if-it-fails-ask-twice-a-re-run");
  EXPECT_EQ(PageOfLink("#the-board", pages), 0U);
  EXPECT_EQ(PageOfLink("#if-it-fails-ask-twice-a-re-run", pages), 1U);
  EXPECT_EQ(PageOfLink("#计分板-a", pages), 2U);
  EXPECT_EQ(PageOfLink("#The board", pages), std::nullopt);
  EXPECT_EQ(PageOfLink("the-board", pages), std::nullopt);
  EXPECT_EQ(PageOfLink("", pages), std::nullopt);
}

}  // namespace
