#include <regex>

#include "tests/platform/libreoffice/Docx.h"
#include "tests/platform/libreoffice/FlatDocument.h"
#include "tests/platform/libreoffice/Writer.h"

namespace {

/// A picture's size on a sheet in millimetres.
struct PictureSize {
  double Width;
  double Height;
};

/// A BMP file of one colour; no density is told where `dotsPerMetre` is 0.
std::string Bmp(std::uint32_t width, std::uint32_t height, std::uint32_t dotsPerMetre = 0) {
  const std::uint32_t row = (width * 3 + 3) / 4 * 4;
  return "BM" + LittleEndian(54 + row * height, 4) + LittleEndian(0, 4) + LittleEndian(54, 4) +
         LittleEndian(40, 4) + LittleEndian(width, 4) + LittleEndian(height, 4) + LittleEndian(1, 2) +
         LittleEndian(24, 2) + LittleEndian(0, 8) + LittleEndian(dotsPerMetre, 4) +
         LittleEndian(dotsPerMetre, 4) + LittleEndian(0, 8) + std::string(std::size_t{row} * height, '\x40');
}

/// Units of the density in a JPEG's header.
constexpr char ProportionOnly = 0;
constexpr char DotsPerInch = 1;
constexpr char DotsPerCentimetre = 2;

std::string BigEndian(std::uint32_t number) {
  return {static_cast<char>(number >> 8U), static_cast<char>(number & 0xFFU)};
}

/// A grey JPEG file, whose width and height are multiples of 8.
std::string Jpeg(std::uint32_t width, std::uint32_t height, char unit, std::uint32_t density) {
  const std::string oneCode =
      "\x01" + std::string(15, '\0') + '\0';  // the code "0" of one bit for the value 0
  const std::size_t bits = std::size_t{2} * (width / 8) * (height / 8);
  return "\xFF\xD8\xFF\xE0" + BigEndian(16) + std::string("JFIF\0\x01\x01", 7) + unit + BigEndian(density) +
         BigEndian(density) + std::string(2, '\0') +                                   //
         "\xFF\xDB" + BigEndian(67) + '\0' + std::string(64, '\x01') +                 //
         "\xFF\xC0" + BigEndian(11) + '\x08' + BigEndian(height) + BigEndian(width) +  //
         std::string("\x01\x01\x11\x00", 4) +                                          //
         "\xFF\xC4" + BigEndian(20) + '\x00' + oneCode +                               //
         "\xFF\xC4" + BigEndian(20) + '\x10' + oneCode +                               //
         "\xFF\xDA" + BigEndian(8) + std::string("\x01\x01\x00\x00\x3F\x00", 6) +      //
         std::string((bits + 7) / 8, '\0') + "\xFF\xD9";
}

/// A table of one row in a Word 2007 file. Widths are in twips (1/1440 inch).
std::string Table(const std::string& width, const std::vector<int>& cells, const std::string& place = "") {
  std::string grid;
  std::string whole;
  for (const int cell : cells) {
    grid += "<w:gridCol w:w=\"" + std::to_string(cell) + "\"/>";
    whole += "<w:tc><w:tcPr><w:tcW w:w=\"" + std::to_string(cell) +
             "\" w:type=\"dxa\"/></w:tcPr><w:p><w:r><w:t>cell</w:t></w:r></w:p></w:tc>";
  }
  return "<w:tbl><w:tblPr>" + place + "<w:tblW " + width + "/></w:tblPr><w:tblGrid>" + grid +
         "</w:tblGrid><w:tr>" + whole + "</w:tr></w:tbl><w:p/>";
}

/// A table whose first cell is merged from that many rows of 20 mm; `rule` is "exact" or "atLeast".
std::string Rows(int count, const std::string& rule) {
  const std::string cell = R"(<w:tc><w:tcPr><w:tcW w:w="3000" w:type="dxa"/>)";
  std::string rows;
  for (int row = 0; row < count; ++row) {
    rows += R"(<w:tr><w:trPr><w:trHeight w:val="1134" w:hRule=")" + rule + "\"/></w:trPr>" + cell +
            (row == 0 ? R"(<w:vMerge w:val="restart"/>)" : "<w:vMerge/>") + "</w:tcPr><w:p/></w:tc>" + cell +
            "</w:tcPr><w:p/></w:tc></w:tr>";
  }
  return R"(<w:tbl><w:tblPr><w:tblW w:w="0" w:type="auto"/></w:tblPr><w:tblGrid><w:gridCol w:w="3000"/>)"
         R"(<w:gridCol w:w="3000"/></w:tblGrid>)" +
         rows + "</w:tbl><w:p/>";
}

const std::string Automatic = R"(w:w="0" w:type="auto")";
const std::string WholePage = R"(w:w="5000" w:type="pct")";

/// A4 with margins of 20 mm, a header and a footer of 30 mm each, spacing included, and a table of one cell.
std::string PageWithHeaderAndFooter() {
  return FlatDocument(
      {.AutomaticStyles = R"(<style:page-layout style:name="pm1"><style:page-layout-properties
        fo:page-width="210mm" fo:page-height="297mm" fo:margin-top="20mm" fo:margin-bottom="20mm"
        fo:margin-left="20mm" fo:margin-right="20mm"/>
      <style:header-style><style:header-footer-properties svg:height="30mm" fo:margin-bottom="5mm"/></style:header-style>
      <style:footer-style><style:header-footer-properties svg:height="30mm" fo:margin-top="5mm"/></style:footer-style>
      </style:page-layout>)",
       .MasterStyles = R"(<style:master-page style:name="Standard" style:page-layout-name="pm1">
      <style:header><text:p>head</text:p></style:header><style:footer><text:p>foot</text:p></style:footer>
      </style:master-page>)",
       .Body = FlatTable(1)});
}

/// A template, the picture that comes into its first cell, and the size which that has on the sheet.
struct SheetCase {
  std::string Template;
  std::string Picture;
  PictureSize Expected;
};

class APictureOnASheet : public Writer {
 protected:
  std::string WordTemplate(const std::string& body) {
    std::string path = folder / ("template" + std::to_string(++templates_) + ".docx");
    WriteFile(path, Docx(body));
    return path;
  }

  /// The same in Word's binary format.
  std::string OldWordTemplate(const std::string& body) {
    const std::string path = WordTemplate(body);
    Convert({path}, "doc:MS Word 97");
    return std::filesystem::path(path).replace_extension(".doc");
  }

  std::string OtherTemplate(const std::string& flatDocument) {
    std::string path = folder / ("template" + std::to_string(++templates_) + ".fodt");
    WriteFile(path, flatDocument);
    return path;
  }

  /// Makes a sheet of each template with its picture, saves it and measures the picture in what was saved.
  void ExpectSizes(const std::vector<SheetCase>& cases) {
    std::vector<std::string> sheets;
    for (const SheetCase& one : cases) {
      WriteFile(folder / "picture", one.Picture);
      sheets.push_back(folder / ("sheet" + std::to_string(sheets.size()) + ".doc"));
      const auto document = Office().Add(one.Template);
      document->AddPicture(1, 1, 1, folder / "picture");
      document->SaveAs(sheets.back());
      document->Close();
    }
    Convert(sheets, "fodt");
    for (std::size_t at = 0; at < cases.size(); ++at) {
      const std::string sheet = ReadFile(std::filesystem::path(sheets[at]).replace_extension(".fodt"));
      EXPECT_NEAR(Measured(sheet, "width"), cases[at].Expected.Width, 0.3) << "case " << at;
      EXPECT_NEAR(Measured(sheet, "height"), cases[at].Expected.Height, 0.3) << "case " << at;
    }
  }

 private:
  /// Width or height of the only picture, in millimetres.
  static double Measured(const std::string& sheet, const std::string& attribute) {
    const std::regex form("<draw:frame [^>]*svg:" + attribute +
                          "=\"([0-9.]+)(in|cm|mm)\"[^>]*>\\s*<draw:image");
    std::smatch found;
    if (!std::regex_search(sheet, found, form)) {
      return 0;
    }
    return std::stod(found[1]) * (found[2] == "in" ? 25.4 : found[2] == "cm" ? 10 : 1);
  }

  int templates_ = 0;
};

// The text of a page is 159.2 mm wide and 246.2 mm high; a cell's border takes 1.9 mm at each side.

TEST_F(APictureOnASheet, HasItsOwnSizeInAWideCell) {
  const std::string wide = Table(Automatic, {7000, 2026});
  const PictureSize own = {31.75, 42.33};
  ExpectSizes({{DefaultSheetTemplate, Bmp(120, 160), own},
               {WordTemplate(wide), Bmp(120, 160), own},
               {WordTemplate(Table(WholePage, {7000, 2026})), Bmp(120, 160), own},
               {OldWordTemplate(wide), Bmp(120, 160), own}});
}

TEST_F(APictureOnASheet, IsAsWideAsItsCellAtMost) {
  const std::string picture = Bmp(3000, 400);
  const std::string narrow = Table(Automatic, {2000, 2000});
  ExpectSizes({{DefaultSheetTemplate, picture, {34.93, 4.66}},
               {WordTemplate(Table(Automatic, {7000, 2026})), picture, {119.64, 15.95}},
               {WordTemplate(narrow), picture, {31.47, 4.20}},
               {OldWordTemplate(narrow), picture, {31.47, 4.20}},
               {WordTemplate(Table(WholePage, {2000, 2000})), picture, {75.78, 10.10}},
               {OldWordTemplate(Table(WholePage, {2000, 2000})), picture, {75.78, 10.10}}});
}

TEST_F(APictureOnASheet, IsNoWiderThanThePageInACellThatIs) {
  ExpectSizes({{WordTemplate(Table(Automatic, {20000, 3000})), Bmp(3000, 400), {159.2, 21.23}}});
}

TEST_F(APictureOnASheet, FitsIntoATableThatTextFlowsAround) {
  const std::string place =
      R"(<w:tblpPr w:vertAnchor="page" w:horzAnchor="page" w:tblpX="3000" w:tblpY="3000"/>)";
  const std::string floating =
      Table(Automatic, {2000, 2000}, place) + "<w:p><w:r><w:t>text</w:t></w:r></w:p>";
  ExpectSizes({{WordTemplate(floating), Bmp(100, 100), {26.46, 26.46}},
               {WordTemplate(floating), Bmp(3000, 400), {31.47, 4.20}}});
}

TEST_F(APictureOnASheet, IsNoHigherThanThePage) {
  const PictureSize fitted = {32.30, 242.3};  // leaves the room that the line needs below it
  ExpectSizes({{WordTemplate(Table(Automatic, {7000, 2026})), Bmp(400, 3000), fitted},
               {OldWordTemplate(Table(WholePage, {7000, 2026})), Bmp(400, 3000), fitted}});
}

TEST_F(APictureOnASheet, IsNoHigherThanAPageBetweenHeaderAndFooter) {
  ExpectSizes({{OtherTemplate(PageWithHeaderAndFooter()), Bmp(400, 3000), {25.70, 192.8}}});
}

TEST_F(APictureOnASheet, IsNoHigherThanARowOfExactHeight) {
  const PictureSize own = {31.75, 42.33};
  const PictureSize fitted = {14.27, 19.03};  // the row has 20 mm, the line needs a little below the picture
  const PictureSize small = {15.88, 15.88};
  const std::string exact = Rows(1, "exact");
  ExpectSizes({{WordTemplate(exact), Bmp(120, 160), fitted},
               {OldWordTemplate(exact), Bmp(120, 160), fitted},
               {WordTemplate(exact), Bmp(60, 60), small},
               {WordTemplate(Rows(1, "atLeast")), Bmp(120, 160), own},
               {OldWordTemplate(Rows(1, "atLeast")), Bmp(120, 160), own}});
}

TEST_F(APictureOnASheet, MayTakeAllRowsOfAMergedCell) {
  const PictureSize fitted = {29.27, 39.03};
  ExpectSizes({{WordTemplate(Rows(2, "exact")), Bmp(120, 160), fitted},
               {OldWordTemplate(Rows(2, "exact")), Bmp(120, 160), fitted},
               {WordTemplate(Rows(2, "atLeast")), Bmp(120, 160), {31.75, 42.33}}});
}

TEST_F(APictureOnASheet, IsAsLargeAsItTells) {
  const std::string page = WordTemplate(Table(WholePage, {9000}));
  const PictureSize at96 = {31.75, 42.33};
  const PictureSize at72 = {42.33, 56.44};
  const PictureSize at300 = {10.16, 13.55};
  ExpectSizes({{page, Bmp(120, 160, 11811), at300},
               {page, Bmp(120, 160, 2835), at72},
               {page, Jpeg(120, 160, DotsPerInch, 300), at300},
               {page, Jpeg(120, 160, DotsPerInch, 72), at72},
               {page, Jpeg(120, 160, DotsPerCentimetre, 118), at300},
               {page, Jpeg(120, 160, ProportionOnly, 1), at96},
               {page, Jpeg(120, 160, DotsPerInch, 300) + std::string(10000, 'x'), at300}});
}

}  // namespace
