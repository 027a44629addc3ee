#include "platform/libreoffice/LibreOffice.h"

#include <gmock/gmock.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <thread>

#include "platform/RuntimeError.h"
#include "tests/platform/libreoffice/Docx.h"
#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/platform/libreoffice/Writer.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

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
  WriteFile(folder / "places.fodt",
            R"(<?xml version="1.0" encoding="UTF-8"?><office:document
              xmlns:office="urn:oasis:names:tc:opendocument:xmlns:office:1.0"
              xmlns:text="urn:oasis:names:tc:opendocument:xmlns:text:1.0"
              xmlns:style="urn:oasis:names:tc:opendocument:xmlns:style:1.0"
              xmlns:table="urn:oasis:names:tc:opendocument:xmlns:table:1.0"
              xmlns:draw="urn:oasis:names:tc:opendocument:xmlns:drawing:1.0"
              xmlns:svg="urn:oasis:names:tc:opendocument:xmlns:svg-compatible:1.0" office:version="1.3"
              office:mimetype="application/vnd.oasis.opendocument.text"><office:automatic-styles>
              <style:page-layout style:name="pm1"><style:header-style/></style:page-layout>
              </office:automatic-styles><office:master-styles><style:master-page style:name="Standard"
              style:page-layout-name="pm1"><style:header><text:p><text:bookmark-start text:name="A"/>?<text:bookmark-end
              text:name="A"/></text:p></style:header></style:master-page></office:master-styles><office:body><office:text>
              <text:p><draw:frame text:anchor-type="paragraph" svg:width="5cm"><draw:text-box><text:p><text:bookmark-start
              text:name="B"/>?<text:bookmark-end text:name="B"/></text:p></draw:text-box></draw:frame></text:p>
              <table:table><table:table-column/><table:table-row><table:table-cell><text:p><text:bookmark-start
              text:name="C"/>?<text:bookmark-end text:name="C"/></text:p></table:table-cell></table:table-row></table:table>
              </office:text></office:body></office:document>)");
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

TEST_F(Writer, CountsTablesThatTextFlowsAround) {
  const auto table = [](int rows) {
    std::string text = "<table:table><table:table-column/>";
    for (int row = 0; row < rows; ++row) {
      text += "<table:table-row><table:table-cell><text:p/></table:table-cell></table:table-row>";
    }
    return text + "</table:table>";
  };
  const auto inFrame = [](const std::string& anchor, const std::string& inside) {
    return "<text:p><draw:frame draw:style-name='floating' text:anchor-type='" + anchor +
           "' svg:width='5cm'><draw:text-box>" + inside + "</draw:text-box></draw:frame>behind</text:p>";
  };
  WriteFile(folder / "floating.fodt",
            R"(<?xml version="1.0" encoding="UTF-8"?><office:document
              xmlns:office="urn:oasis:names:tc:opendocument:xmlns:office:1.0"
              xmlns:text="urn:oasis:names:tc:opendocument:xmlns:text:1.0"
              xmlns:table="urn:oasis:names:tc:opendocument:xmlns:table:1.0"
              xmlns:draw="urn:oasis:names:tc:opendocument:xmlns:drawing:1.0"
              xmlns:style="urn:oasis:names:tc:opendocument:xmlns:style:1.0"
              xmlns:fo="urn:oasis:names:tc:opendocument:xmlns:xsl-fo-compatible:1.0"
              xmlns:svg="urn:oasis:names:tc:opendocument:xmlns:svg-compatible:1.0" office:version="1.3"
              office:mimetype="application/vnd.oasis.opendocument.text"><office:automatic-styles><style:style
              style:name="floating" style:family="graphic" style:parent-style-name="Frame"><style:graphic-properties style:wrap="parallel"
              fo:padding="0mm" fo:border="none"/></style:style></office:automatic-styles><office:body><office:text>)" +
                inFrame("paragraph", table(1)) + table(2) + inFrame("char", table(3)) +
                inFrame("char", "<text:p>box</text:p>") + table(4) +
                "</office:text></office:body></office:document>");
  const auto document = Office().Add(folder / "floating.fodt");
  for (const std::size_t rows : {1, 2, 3, 4}) {
    const int number = static_cast<int>(rows);
    document->WriteCells(number, 1, 20, std::vector<std::string>(rows, "x"));
    EXPECT_EQ(
        NumberThrownBy([&] { document->WriteCells(number, 1, 20, std::vector<std::string>(rows + 1, "x")); }),
        440);
  }
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(5, 1, 20, {}); }), 9);
  document->Close();
}

/// A table of one column in a Word 2007 file, and a paragraph behind it.
std::string WordTable(int rows, const std::string& place = "") {
  std::string text =
      "<w:tbl><w:tblPr>" + place + "</w:tblPr><w:tblGrid><w:gridCol w:w=\"2000\"/></w:tblGrid>";
  for (int row = 0; row < rows; ++row) {
    text += "<w:tr><w:tc><w:p/></w:tc></w:tr>";
  }
  return text + "</w:tbl><w:p><w:r><w:t>text</w:t></w:r></w:p>";
}

TEST_F(Writer, CountsNoTableInATextBox) {
  const auto box = [](const std::string& wrap) {
    return R"(<w:p><w:r><w:pict><v:shape xmlns:v="urn:schemas-microsoft-com:vml")"
           R"( xmlns:w10="urn:schemas-microsoft-com:office:word")"
           R"( style="position:absolute;width:200pt;height:100pt"><v:textbox><w:txbxContent>)" +
           WordTable(1) + "</w:txbxContent></v:textbox>" + wrap + "</v:shape></w:pict></w:r></w:p>";
  };
  WriteFile(folder / "over.docx", Docx(box("") + WordTable(3)));
  WriteFile(folder / "beside.docx", Docx(box(R"(<w10:wrap type="square"/>)") + WordTable(3)));
  Convert({folder / "over.docx", folder / "beside.docx"}, "doc:MS Word 97");
  for (const char* name : {"over.docx", "over.doc", "beside.docx", "beside.doc"}) {
    const auto document = Office().Add(folder / name);
    EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(1, 1, 20, {"1", "2", "3"}); }), 0) << name;
    EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(2, 1, 20, {}); }), 9) << name;
    document->Close();
  }
}

TEST_F(Writer, CountsNoTableInAFrameThatTextRunsThroughOrThatKeepsADistance) {
  const auto frame = [](const std::string& style) {
    return "<text:p><draw:frame draw:style-name='" + style +
           "' text:anchor-type='paragraph' svg:width='5cm'><draw:text-box><table:table><table:table-column/>"
           "<table:table-row><table:table-cell><text:p/></table:table-cell></table:table-row></table:table>"
           "</draw:text-box></draw:frame></text:p>";
  };
  const auto style = [](const std::string& name, const std::string& wrap, const std::string& padding) {
    return "<style:style style:name='" + name +
           "' style:family='graphic' style:parent-style-name='Frame'><style:graphic-properties style:wrap='" +
           wrap + "' fo:padding='" + padding + "' fo:border='none'/></style:style>";
  };
  WriteFile(folder / "frames.fodt",
            R"(<?xml version="1.0" encoding="UTF-8"?><office:document
              xmlns:office="urn:oasis:names:tc:opendocument:xmlns:office:1.0"
              xmlns:text="urn:oasis:names:tc:opendocument:xmlns:text:1.0"
              xmlns:table="urn:oasis:names:tc:opendocument:xmlns:table:1.0"
              xmlns:draw="urn:oasis:names:tc:opendocument:xmlns:drawing:1.0"
              xmlns:style="urn:oasis:names:tc:opendocument:xmlns:style:1.0"
              xmlns:fo="urn:oasis:names:tc:opendocument:xmlns:xsl-fo-compatible:1.0"
              xmlns:svg="urn:oasis:names:tc:opendocument:xmlns:svg-compatible:1.0" office:version="1.3"
              office:mimetype="application/vnd.oasis.opendocument.text"><office:automatic-styles>)" +
                style("through", "run-through", "0mm") + style("padded", "parallel", "1mm") +
                style("floating", "parallel", "0mm") +
                "</office:automatic-styles><office:body><office:text>" + frame("through") + frame("padded") +
                frame("floating") + "</office:text></office:body></office:document>");
  const auto document = Office().Add(folder / "frames.fodt");
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(1, 1, 20, {"x"}); }), 0);
  EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(2, 1, 20, {}); }), 9);
  document->Close();
}

TEST_F(Writer, CountsAFloatingTableOfAWordFile) {
  const std::string place =
      R"(<w:tblpPr w:vertAnchor="page" w:horzAnchor="page" w:tblpX="3000" w:tblpY="3000"/>)";
  WriteFile(folder / "floating.docx", Docx(WordTable(2, place) + WordTable(3)));
  Convert({folder / "floating.docx"}, "doc:MS Word 97");
  for (const char* name : {"floating.docx", "floating.doc"}) {
    const auto document = Office().Add(folder / name);
    EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(1, 1, 20, {"1", "2", "3"}); }), 440) << name;
    EXPECT_EQ(NumberThrownBy([&] { document->WriteCells(2, 1, 20, {"1", "2", "3"}); }), 0) << name;
    document->Close();
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

TEST_F(Writer, CannotEndTheProgramByEndingInACall) {
  struct sigaction onLostPipe {};
  ASSERT_EQ(sigaction(SIGPIPE, nullptr, &onLostPipe), 0);
  EXPECT_EQ(onLostPipe.sa_handler, SIG_IGN);
}

TEST_F(Writer, IsStartedAfreshWhenItWasKilled) {
  const std::vector<pid_t> hosts = Hosts();
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  const auto document = Office().Add(Template);
  kill(offices[0], SIGKILL);
  EXPECT_TRUE(WaitUntil([] { return Office().State() == WordState::Ended; }));
  EXPECT_EQ(NumberThrownBy([&] { document->SetBookmark("PlayerName", "x"); }), 440);
  EXPECT_EQ(NumberThrownBy([&] { Office().Add(Template); }), 429);
  ASSERT_TRUE(StartAndWait(Office()));
  EXPECT_THAT(Hosts(), SizeIs(1));
  EXPECT_EQ(Profiles(), 1u);
  Office().Add(Template)->Close();
}

TEST_F(Writer, IsStartedOnce) {
  Office().Start();
  Office().Start();
  EXPECT_THAT(Hosts(), SizeIs(1));
}

TEST_F(Writer, EndsWithAProgramThatCrashes) {
  const std::size_t profiles = Profiles();
  int ready[2];
  ASSERT_EQ(pipe(ready), 0);
  const pid_t program = fork();
  if (program == 0) {
    execl(TESSARINE_PROGRAM_FOLDER "/office-runner", "office-runner", TESSARINE_PROGRAM_FOLDER,
          std::to_string(ready[1]).c_str(), nullptr);
    _exit(1);
  }
  close(ready[1]);
  char byte = 0;
  ASSERT_EQ(read(ready[0], &byte, 1), 1);
  close(ready[0]);
  const std::vector<pid_t> hosts = Hosts(program);
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  kill(program, SIGKILL);
  waitpid(program, nullptr, 0);
  const auto runs = [](pid_t id) {
    for (const ProcessInfo& process : Processes()) {
      if (process.Id == id) {
        return true;
      }
    }
    return false;
  };
  EXPECT_TRUE(WaitUntil([&] { return !runs(hosts[0]) && !runs(offices[0]); }));
  EXPECT_EQ(Profiles(), profiles);
}

class LibreOfficeInLocale : public testing::TestWithParam<const char*> {};

TEST_P(LibreOfficeInLocale, ReadsAndSavesFilesNamedInAnyScript) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "目录");
  std::filesystem::copy(Template, folder / "目录/样张.doc");
  setenv("LC_ALL", GetParam(), 1);
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  const bool ready = StartAndWait(office);
  unsetenv("LC_ALL");
  ASSERT_TRUE(ready);
  const auto document = office.Add(folder / "目录/样张.doc");
  document->SaveAs(folder / "目录/Red 5-王小明 é.doc");
  document->Close();
  EXPECT_TRUE(std::filesystem::exists(folder / "目录/Red 5-王小明 é.doc"));
}

INSTANTIATE_TEST_SUITE_P(OfAnyKind, LibreOfficeInLocale, testing::Values("C", "C.UTF-8", "tlh_XX.UTF-8"));

TEST(LibreOfficeThatHangs, EndsAndLeavesNoFiles) {
  const TemporaryFolder folder;
  setenv("TMPDIR", folder.Path().c_str(), 1);
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  const bool ready = StartAndWait(office);
  unsetenv("TMPDIR");
  ASSERT_TRUE(ready);
  const std::vector<pid_t> hosts = Hosts();
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  office.Add(Template)->Close();
  kill(offices[0], SIGSTOP);
  office.Quit();
  EXPECT_EQ(office.State(), WordState::Ended);
  EXPECT_THAT(Hosts(), IsEmpty());
  EXPECT_TRUE(std::filesystem::is_empty(folder.Path()));
}

TEST(LibreOfficeThatIsNotThere, IsAFailureOfTheStart) {
  const TemporaryFolder folder;
  LibreOffice office(folder.Path());
  EXPECT_EQ(NumberThrownBy([&] { office.Start(); }), 429);
  EXPECT_EQ(office.State(), WordState::Ended);
  office.Quit();
}

}  // namespace
