// The pages for a browser, as the build leaves them.

#include <gmock/gmock.h>

#include <filesystem>
#include <ostream>

#include "manual/ManualPages.h"
#include "tests/manual/Edition.h"

namespace {

using testing::HasSubstr;
using testing::Not;

struct Page {
  const char* Source;
  const char* Html;
  const char* Language;

  friend void PrintTo(const Page& page, std::ostream* text) { *text << page.Language; }
};

class ManualHtml : public testing::TestWithParam<Page> {
 protected:
  const Edition edition{GetParam().Source};
  const std::string html{ReadFile(std::string(TESSARINE_MANUAL_HTML "/") + GetParam().Html)};
};

TEST_P(ManualHtml, HasEachHeadingUnderTheNameThatLinksUse) {
  for (const ManualPart& part : edition.Parts()) {
    const std::string level = "h" + std::to_string(part.Level);
    std::string heading = "<";
    heading += level + " id=\"" + AnchorOf(part.Title) + "\">" + part.Title + "</" + level + ">";
    EXPECT_THAT(html, HasSubstr(heading));
  }
}

TEST_P(ManualHtml, HasItsPicturesBesideIt) {
  ASSERT_FALSE(edition.Pictures().empty());
  for (const std::string& picture : edition.Pictures()) {
    EXPECT_THAT(html, HasSubstr("<img src=\"" + picture + "\""));
    EXPECT_TRUE(std::filesystem::exists(std::string(TESSARINE_MANUAL_HTML "/") + picture)) << picture;
  }
}

TEST_P(ManualHtml, IsAWholePageOfItsLanguage) {
  EXPECT_TRUE(html.starts_with("<!DOCTYPE html>\n<html lang=\"" + std::string(GetParam().Language) + "\">"));
  EXPECT_THAT(html, HasSubstr("<table>"));
  EXPECT_THAT(html, Not(HasSubstr("@TEXT@")));
  EXPECT_THAT(html, Not(HasSubstr("](")));
  EXPECT_TRUE(html.ends_with("</html>\n"));
}

TEST_P(ManualHtml, NeedsNoNetwork) {
  EXPECT_THAT(html, Not(HasSubstr("http:")));
  EXPECT_THAT(html, Not(HasSubstr("https:")));
  EXPECT_THAT(ReadFile(TESSARINE_MANUAL_HTML "/manual.css"), Not(HasSubstr("url(")));
}

INSTANTIATE_TEST_SUITE_P(Editions, ManualHtml,
                         testing::Values(Page{"manual.md", "manual.html", "en"},
                                         Page{"manual.zh.md", "manual.zh.html", "zh"}),
                         [](const auto& test) { return std::string(test.param.Language); });

}  // namespace
