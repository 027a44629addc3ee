#include "platform/RuntimeError.h"
#include "tests/platform/libreoffice/Docx.h"
#include "tests/platform/libreoffice/FlatDocument.h"
#include "tests/platform/libreoffice/Writer.h"
#include "tests/support/Thrown.h"

namespace {

TEST_F(Writer, CountsTablesThatTextFlowsAround) {
  const auto inFrame = [](const std::string& anchor, const std::string& inside) {
    return FlatFrame("floating", anchor, inside, "behind");
  };
  WriteFile(folder / "floating.fodt",
            FlatDocument({.AutomaticStyles = FrameStyle("floating", "parallel", "0mm"),
                          .Body = inFrame("paragraph", FlatTable(1)) + FlatTable(2) +
                                  inFrame("char", FlatTable(3)) + inFrame("char", "<text:p>box</text:p>") +
                                  FlatTable(4)}));
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
  std::string frames;
  for (const char* style : {"through", "padded", "floating"}) {
    frames += FlatFrame(style, "paragraph", FlatTable(1));
  }
  WriteFile(folder / "frames.fodt",
            FlatDocument({.AutomaticStyles = FrameStyle("through", "run-through", "0mm") +
                                             FrameStyle("padded", "parallel", "1mm") +
                                             FrameStyle("floating", "parallel", "0mm"),
                          .Body = frames}));
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

}  // namespace
