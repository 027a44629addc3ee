#include "platform/libreoffice/LibreOffice.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <filesystem>

#include "tests/platform/libreoffice/FlatDocument.h"
#include "tests/platform/libreoffice/Writer.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;
using testing::Not;

const std::string Template = DefaultSheetTemplate;

TEST_F(Writer, FillsATemplateAndSavesItForWord) {
  const auto document = Office().Add(Template);
  document->SetBookmark("PlayerName", "Zoë 李雷");
  document->SetBookmark("rank", " 7");
  std::vector<std::string> hits;
  for (int i = 1; i <= 224; ++i) {
    hits.push_back("Hit " + std::to_string(i) + ".");
  }
  document->WriteCells(4, 2, 20, hits);
  document->WriteCells(5, 2, 20, {"Taken 1.", "Taken 2."});
  document->SaveAs(folder / "a sheet %41.doc");
  document->Close();
  EXPECT_EQ(ReadFile(folder / "a sheet %41.doc").substr(0, 8), "\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1");
  const std::string text = TextOf(folder / "a sheet %41.doc");
  for (const char* part : {"Zoë 李雷", " 7", "Hit 1.", "Hit 224.", "Taken 2."}) {
    EXPECT_THAT(text, HasSubstr(part));
  }
  // Columns are filled one after the other, so the first entries of columns 1 and 2 are in the same row.
  EXPECT_LT(text.find("Hit 1."), text.find("Hit 21."));
  EXPECT_LT(text.find("Hit 21."), text.find("Hit 2."));
}

TEST_F(Writer, WantsEveryBookmarkTableAndCell) {
  const auto document = Office().Add(Template);
  EXPECT_EQ(NumberThrownBy([&] { document->SetBookmark("Nowhere", "x"); }), 440);
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(6, 2, 20, {}); }), 9);
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(4, 2, 20, std::vector<std::string>(241, "x")); }), 440);
  document->WriteCells(4, 2, 20, {});
  document->Close();
}

TEST_F(Writer, WritesTablesWithMergedCells) {
  WriteFile(folder / "merged.html",
            "<html><body><table><tr><td colspan=3>Heading</td></tr>"
            "<tr><td>a</td><td>b</td><td rowspan=2><table><tr><td>inner</td></tr></table></td></tr>"
            "<tr><td>d</td><td>e</td></tr></table><table><tr><td>second</td></tr></table></body></html>");
  const auto document = Office().Add(folder / "merged.html");
  document->WriteCells(1, 2, 2, {"One.", "Two.", "Three."});
  document->WriteCells(2, 1, 20, {"Four."});
  document->SaveAs(folder / "merged.doc");
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(1, 2, 2, std::vector<std::string>(9, "x")); }), 440);
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(3, 1, 20, {}); }), 9);
  document->Close();
  const std::string text = TextOf(folder / "merged.doc");
  for (const char* part : {"Heading", "One.", "Two.", "Three.", "Four."}) {
    EXPECT_THAT(text, HasSubstr(part));
  }
  EXPECT_THAT(text, Not(HasSubstr("second")));
}

TEST_F(Writer, FindsCellsBehindColumnZNextToMergedOnes) {
  constexpr int columns = 60;
  std::string row;
  std::vector<std::string> texts;
  for (int column = 1; column <= columns; ++column) {
    row += "<td>x</td>";
    texts.push_back("Text" + std::to_string(column) + ".");
  }
  WriteFile(folder / "wide.html", "<html><body><table><tr><td colspan=60>Heading</td></tr><tr>" + row +
                                      "</tr></table></body></html>");
  WriteFile(folder / "photo", ReadFile(TESSARINE_RESOURCES "/pictures/tessarine-16.png"));
  const auto document = Office().Add(folder / "wide.html");
  document->WriteCells(1, 2, 1, texts);
  const int withPicture[] = {1, 26, 27, 52, 53, 60};
  for (const int column : withPicture) {
    document->AddPicture(1, 2, column, folder / "photo");
  }
  EXPECT_EQ(NumberThrownBy([&] { document->AddPicture(1, 2, columns + 1, folder / "photo"); }), 440);
  document->SaveAs(folder / "wide.doc");
  document->Close();
  Convert({folder / "wide.doc"}, "fodt");
  const std::string sheet = ReadFile(folder / "wide.fodt");
  for (int column = 1; column <= columns; ++column) {
    const std::string text = texts[static_cast<std::size_t>(column) - 1];
    const bool has =
        std::find(std::begin(withPicture), std::end(withPicture), column) != std::end(withPicture);
    EXPECT_EQ(sheet.find("</draw:frame>" + text) != std::string::npos, has) << column;
    EXPECT_NE(sheet.find(text), std::string::npos) << column;
  }
}

TEST_F(Writer, FillsBookmarksInHeadersTextBoxesAndCells) {
  const auto bookmark = [](const std::string& name) {
    return "<text:p><text:bookmark-start text:name='" + name + "'/>?<text:bookmark-end text:name='" + name +
           "'/></text:p>";
  };
  WriteFile(
      folder / "places.fodt",
      FlatDocument(
          {.AutomaticStyles = "<style:page-layout style:name='pm1'><style:header-style/></style:page-layout>",
           .MasterStyles =
               "<style:master-page style:name='Standard' style:page-layout-name='pm1'><style:header>" +
               bookmark("A") + "</style:header></style:master-page>",
           .Body = "<text:p><draw:frame text:anchor-type='paragraph' svg:width='5cm'><draw:text-box>" +
                   bookmark("B") +
                   "</draw:text-box></draw:frame></text:p><table:table><table:table-column/><table:table-row>"
                   "<table:table-cell>" +
                   bookmark("C") + "</table:table-cell></table:table-row></table:table>"}));
  const auto document = Office().Add(folder / "places.fodt");
  document->SetBookmark("A", "InHeader");
  document->SetBookmark("B", "InBox");
  document->SetBookmark("C", "InCell");
  document->SaveAs(folder / "filled.doc");
  document->Close();
  Convert({folder / "filled.doc"}, "fodt");
  const std::string text = ReadFile(folder / "filled.fodt");
  for (const char* part : {"InHeader", "InBox", "InCell"}) {
    EXPECT_THAT(text, HasSubstr(part));
  }
}

TEST_F(Writer, AddsPicturesWithPaddingAndRefusesOtherFiles) {
  const auto document = Office().Add(Template);
  WriteFile(folder / "no-picture", "bytes");
  EXPECT_EQ(NumberThrownBy([&] { document->AddPicture(1, 1, 1, folder / "no-picture"); }), 440);
  const std::size_t padding = 10000;
  WriteFile(folder / "photo",
            ReadFile(TESSARINE_RESOURCES "/pictures/tessarine-128.png") + std::string(padding, 0));
  document->SaveAs(folder / "without.doc");
  document->AddPicture(1, 1, 1, folder / "photo");
  document->SaveAs(folder / "with.doc");
  document->Close();
  EXPECT_GT(std::filesystem::file_size(folder / "with.doc"),
            std::filesystem::file_size(folder / "without.doc") + 5000);
}

TEST_F(Writer, WantsADocumentAsTemplate) {
  EXPECT_EQ(NumberThrownBy([&] { Office().Add(folder / "missing.doc"); }), 53);
  WriteFile(folder / "garbage.doc", std::string("\x01\x02garbage\xFF\xFE", 11));
  EXPECT_EQ(NumberThrownBy([&] { Office().Add(folder / "garbage.doc"); }), 321);
  WriteFile(folder / "picture.doc", ReadFile(TESSARINE_RESOURCES "/pictures/tessarine-16.png"));
  EXPECT_EQ(NumberThrownBy([&] { Office().Add(folder / "picture.doc"); }), 321);
  WriteFile(folder / "cut.doc", ReadFile(Template).substr(0, 20000));
  EXPECT_NE(NumberThrownBy([&] { Office().Add(folder / "cut.doc"); }), 0);
}

TEST_F(Writer, LeavesNoHalfFileWhereItCannotSave) {
  const auto document = Office().Add(Template);
  EXPECT_EQ(NumberThrownBy([&] { document->SaveAs("/proc/sheet.doc"); }), 440);
  std::filesystem::create_directories(folder / "scores/sheet.doc");
  EXPECT_EQ(NumberThrownBy([&] { document->SaveAs(folder / "scores/sheet.doc"); }), 440);
  document->Close();
  std::size_t files = 0;
  for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(folder / "scores")) {
    ++files;
  }
  EXPECT_EQ(files, 1U);
}

TEST_F(Writer, SavesWhereAKilledOneLeftItsLock) {
  const auto document = Office().Add(Template);
  for (const std::string name : {"sheet.doc", "sheet.pdf"}) {
    WriteFile(folder / (".~lock." + name + "#"), ",operator,venue,20.05.2013 20:15,file:///tmp/profile;");
    WriteFile(folder / name, "an old sheet");
    name == "sheet.doc" ? document->SaveAs(folder / name) : document->ExportPdf(folder / name);
    EXPECT_GT(ReadFile(folder / name).size(), 1000U);
  }
  document->Close();
}

TEST_F(Writer, JoinsPdfs) {
  const auto document = Office().Add(Template);
  document->SetBookmark("PlayerName", "First");
  document->ExportPdf(folder / "1.pdf");
  document->ExportPdf(folder / "2.pdf");
  document->Close();
  int calls = 0;
  Office().JoinPdfs({folder / "1.pdf", folder / "2.pdf"}, folder / "all.pdf", [&calls] { ++calls; });
  EXPECT_GT(calls, 2);
  const std::string all = ReadFile(folder / "all.pdf");
  EXPECT_EQ(all.substr(0, 5), "%PDF-");
  EXPECT_THAT(all, HasSubstr("/Count 2"));
  EXPECT_EQ(NumberThrownBy([&] { Office().JoinPdfs({folder / "missing.pdf"}, folder / "none.pdf", [] {}); }),
            75);
  EXPECT_FALSE(std::filesystem::exists(folder / "none.pdf"));
}

}  // namespace
