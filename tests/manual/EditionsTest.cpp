#include <gmock/gmock.h>

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>

#include "manual/ManualPages.h"
#include "tests/manual/Edition.h"

namespace {

using testing::Contains;
using testing::ElementsAreArray;
using testing::SizeIs;

std::string Described(const ManualPart& part) {
  std::ostringstream text;
  text << "level " << part.Level << ", " << part.TableRows << " rows, " << part.ListItems << " items, "
       << part.CodeLines << " lines of code, " << part.Paragraphs << " paragraphs, " << part.Pictures
       << " pictures";
  return text.str();
}

/// Object names of the windows that F1 can find in front, from their forms.
std::vector<std::string> WindowsOfTheProgram() {
  const std::regex root(R"re(<widget class="Q(?:Dialog|MainWindow)" name="(\w+)">)re");
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(TESSARINE_SOURCE)) {
    std::smatch match;
    if (entry.path().extension() == ".ui") {
      const std::string form = ReadFile(entry.path());
      if (std::regex_search(form, match, root)) {
        names.push_back(match[1]);
      }
    }
  }
  return names;
}

std::string Without(const std::string& text, const char* pattern) {
  return std::regex_replace(text, std::regex(pattern), "");
}

/// The program's texts in English, each with what they are in Chinese; without their Alt letters.
std::multimap<std::string, std::string> TextsOfTheProgram() {
  const std::pair<const char*, const char*> texts[] = {
#define TEXT(number, english, simplifiedChinese) {english, simplifiedChinese},
#define OWN_TEXT(number, name, english, simplifiedChinese) {english, simplifiedChinese},
#include "resources/StringTable.inc"
  };
  std::multimap<std::string, std::string> plain;
  for (const auto& [english, chinese] : texts) {
    plain.emplace(Without(english, "&"), Without(chinese, R"(\(&\w\))"));
  }
  return plain;
}

/// What stands in bold on a page: the captions that the operator meets, one by one, and other words.
std::set<std::string> CaptionsOn(const ManualPage& page) {
  const std::regex bold(R"(\*\*([^*]+)\*\*)");
  const std::regex between(", |，");
  std::set<std::string> captions;
  for (std::sregex_iterator match(page.Text.begin(), page.Text.end(), bold), end; match != end; ++match) {
    const std::string text = (*match)[1];
    captions.insert(std::sregex_token_iterator(text.begin(), text.end(), between, -1), {});
  }
  return captions;
}

class BothEditions : public testing::Test {
 protected:
  const Edition english{"manual.md"};
  const Edition chinese{"manual.zh.md"};
  const std::vector<const Edition*> editions{&english, &chinese};
};

TEST_F(BothEditions, AreBuiltAlike) {
  const std::vector<ManualPart> parts = english.Parts();
  const std::vector<ManualPart> partsInChinese = chinese.Parts();
  ASSERT_GT(parts.size(), 20U);
  ASSERT_EQ(partsInChinese.size(), parts.size());
  for (std::size_t i = 0; i < parts.size(); ++i) {
    EXPECT_EQ(Described(partsInChinese[i]), Described(parts[i]))
        << parts[i].Title << " / " << partsInChinese[i].Title;
  }
}

TEST_F(BothEditions, ListTheirPagesInTheTableOfContents) {
  for (const Edition* edition : editions) {
    std::vector<std::string> pages;
    for (const ManualPage& page : ManualPages(edition->Text())) {
      pages.push_back('#' + AnchorOf(page.Title));
    }
    EXPECT_THAT(edition->Links(true), ElementsAreArray(pages));
    EXPECT_THAT(pages, SizeIs(std::set(pages.begin(), pages.end()).size())) << "two pages of one name";
  }
}

TEST_F(BothEditions, LeadToAPageWithEachLink) {
  for (const Edition* edition : editions) {
    const std::vector<ManualPage> pages = ManualPages(edition->Text());
    ASSERT_GT(edition->Links().size(), pages.size());
    for (const std::string& link : edition->Links()) {
      EXPECT_TRUE(PageOfLink(link, pages)) << link;
    }
  }
}

TEST_F(BothEditions, ShowEveryPictureThatThereIsAndNoOther) {
  std::set<std::string> shown;
  for (const Edition* edition : editions) {
    const std::vector<std::string> pictures = edition->Pictures();
    shown.insert(pictures.begin(), pictures.end());
  }
  std::set<std::string> present;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(TESSARINE_DOCS "/pictures")) {
    if (entry.is_regular_file()) {
      present.insert(std::filesystem::relative(entry.path(), TESSARINE_DOCS));
    }
  }
  EXPECT_THAT(shown, ElementsAreArray(present));
  EXPECT_GE(shown.size(), 20U);
}

TEST_F(BothEditions, ShowEachWindowInTheirLanguage) {
  std::vector<std::string> pictures = english.Pictures();
  for (std::string& picture : pictures) {
    picture.insert(std::string("pictures/").size(), "zh/");
  }
  EXPECT_THAT(chinese.Pictures(), ElementsAreArray(pictures));
}

// Windows that are in English in both languages have the same captions in both editions.
TEST_F(BothEditions, CallTheProgramsTextsByTheirWords) {
  const auto texts = TextsOfTheProgram();
  const std::vector<ManualPage> pages = ManualPages(english.Text());
  const std::vector<ManualPage> chinesePages = ManualPages(chinese.Text());
  int known = 0;
  for (std::size_t page = 0; page < pages.size(); ++page) {
    const std::set<std::string> inChinese = CaptionsOn(chinesePages.at(page));
    for (const std::string& caption : CaptionsOn(pages[page])) {
      const auto [first, last] = texts.equal_range(caption);
      known += first != last ? 1 : 0;
      EXPECT_TRUE(first == last || inChinese.contains(caption) ||
                  std::any_of(first, last, [&](const auto& text) { return inChinese.contains(text.second); }))
          << caption << " on the page " << chinesePages[page].Title;
    }
  }
  EXPECT_GT(known, 50);
}

TEST_F(BothEditions, TellOfEachWindowOfTheProgram) {
  const std::vector<std::string> windows = WindowsOfTheProgram();
  EXPECT_THAT(windows, Contains("Members"));
  EXPECT_THAT(windows, SizeIs(WindowPages().size()));
  for (const Edition* edition : editions) {
    const std::vector<ManualPage> pages = ManualPages(edition->Text());
    for (const std::string& window : windows) {
      EXPECT_TRUE(PageOfWindow(window, pages)) << window;
    }
  }
}

TEST_F(BothEditions, NameTheSameSettings) {
  EXPECT_GT(english.Settings().size(), 10U);
  std::vector<std::string> settings = chinese.Settings();
  for (std::string& setting : settings) {
    setting = std::regex_replace(setting, std::regex("\\| 无 \\|"), "| none |");
  }
  EXPECT_THAT(settings, ElementsAreArray(english.Settings()));
}

}  // namespace
