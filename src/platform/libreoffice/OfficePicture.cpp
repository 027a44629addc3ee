#include "platform/libreoffice/OfficePicture.h"

#include <algorithm>
#include <com/sun/star/awt/Size.hpp>
#include <com/sun/star/lang/XMultiServiceFactory.hpp>
#include <com/sun/star/style/XStyleFamiliesSupplier.hpp>
#include <com/sun/star/text/TextContentAnchorType.hpp>
#include <com/sun/star/text/XTextContent.hpp>

namespace text = com::sun::star::text;
using com::sun::star::awt::Size;
using com::sun::star::beans::XPropertySet;
using com::sun::star::container::XNameAccess;
using com::sun::star::uno::UNO_QUERY_THROW;
using Uno::Any;
using Uno::OUString;
using Uno::Reference;

namespace {

/// Lengths are in 1/100 mm.
constexpr double Inch = 2540;

template <typename Value>
Value Property(const Reference<XPropertySet>& properties, const char* name) {
  Value value{};
  properties->getPropertyValue(OUString::createFromAscii(name)) >>= value;
  return value;
}

sal_Int32 Length(const Reference<XPropertySet>& properties, const char* name) {
  return Property<sal_Int32>(properties, name);
}

Size OwnSize(const Reference<XPropertySet>& graphic) {
  const Size told = Property<Size>(graphic, "Size100thMM");
  if (told.Width > 0 && told.Height > 0) {
    return told;
  }
  constexpr double dotsPerInch = 96;
  const Size pixels = Property<Size>(graphic, "SizePixel");
  return {static_cast<sal_Int32>(pixels.Width * Inch / dotsPerInch),
          static_cast<sal_Int32>(pixels.Height * Inch / dotsPerInch)};
}

/// Height of the text of the paragraph's page; 0 if the paragraph is hidden and thus on no page.
sal_Int32 PageRoom(const Reference<text::XTextDocument>& document, const Reference<XPropertySet>& paragraph) {
  const Reference<com::sun::star::style::XStyleFamiliesSupplier> styles(document, UNO_QUERY_THROW);
  const Reference<XNameAccess> pages(styles->getStyleFamilies()->getByName("PageStyles"), UNO_QUERY_THROW);
  const OUString name = Property<OUString>(paragraph, "PageStyleName");
  if (!pages->hasByName(name)) {
    return 0;
  }
  const Reference<XPropertySet> page(pages->getByName(name), UNO_QUERY_THROW);
  const auto ifOn = [&page](const char* isOn, const char* height) {
    return Property<bool>(page, isOn) ? Length(page, height) : 0;
  };
  return Length(page, "Height") - Length(page, "TopMargin") - Length(page, "BottomMargin") -
         ifOn("HeaderIsOn", "HeaderHeight") - ifOn("FooterIsOn", "FooterHeight");
}

Reference<XPropertySet> FirstParagraph(const Reference<text::XText>& cell) {
  return {cell->createTextCursor(), UNO_QUERY_THROW};
}

/// Height of the characters in the first line of the cell.
sal_Int32 CharacterHeight(const Reference<XPropertySet>& paragraph) {
  constexpr double points = 72;
  return static_cast<sal_Int32>(Property<float>(paragraph, "CharHeight") * Inch / points);
}

/// Greatest height of a picture in the cell: a page's, less what the cell and the picture's line add to it.
sal_Int32 HeightRoom(const Reference<text::XTextDocument>& document, const Reference<text::XText>& cell) {
  const Reference<XPropertySet> inside(cell, UNO_QUERY_THROW);
  const Reference<XPropertySet> paragraph = FirstParagraph(cell);
  return PageRoom(document, paragraph) - Length(inside, "TopBorderDistance") -
         Length(inside, "BottomBorderDistance") - Length(paragraph, "ParaTopMargin") -
         Length(paragraph, "ParaBottomMargin") - CharacterHeight(paragraph);
}

/// Width of the cell as it is laid out, within its borders. Only the layout knows it: the widths of a table
/// whose columns fit themselves to the page are no lengths. `picture` stands in the cell.
sal_Int32 WidthRoom(const Reference<XPropertySet>& picture) {
  constexpr sal_Int16 whole = 100;
  picture->setPropertyValue("RelativeWidth", Any(whole));
  const Size laidOut = Property<Size>(picture, "LayoutSize");
  picture->setPropertyValue("RelativeWidth", Any(sal_Int16{0}));
  return laidOut.Width;
}

/// `own` made smaller, if need be, to fit into `room`, where only a length above 0 is a limit.
Size Fit(const Size& own, const Size& room) {
  const auto scaleTo = [](sal_Int32 limit, sal_Int32 length) {
    return limit > 0 ? static_cast<double>(limit) / length : 1.0;
  };
  const double scale = std::min({1.0, scaleTo(room.Width, own.Width), scaleTo(room.Height, own.Height)});
  return {std::max(sal_Int32{1}, static_cast<sal_Int32>(own.Width * scale)),
          std::max(sal_Int32{1}, static_cast<sal_Int32>(own.Height * scale))};
}

/// A small picture at the start of the cell's text.
Reference<XPropertySet> InsertSmall(const Reference<text::XTextDocument>& document,
                                    const Reference<XPropertySet>& graphic,
                                    const Reference<text::XText>& cell) {
  const Reference<com::sun::star::lang::XMultiServiceFactory> factory(document, UNO_QUERY_THROW);
  const Reference<XPropertySet> picture(factory->createInstance("com.sun.star.text.TextGraphicObject"),
                                        UNO_QUERY_THROW);
  constexpr sal_Int32 small = 100;
  picture->setPropertyValue("Graphic", Any(graphic));
  picture->setPropertyValue("AnchorType", Any(text::TextContentAnchorType_AS_CHARACTER));
  picture->setPropertyValue("Size", Any(Size(small, small)));
  cell->insertTextContent(cell->getStart(), Reference<text::XTextContent>(picture, UNO_QUERY_THROW), false);
  return picture;
}

/// Height of the cell as it is laid out, within its borders; of all its rows if it is merged with cells
/// below. It is measured by a second picture, which takes part of it.
sal_Int32 LaidOutHeight(const Reference<text::XTextDocument>& document,
                        const Reference<XPropertySet>& graphic, const Reference<text::XText>& cell) {
  const Reference<XPropertySet> measure = InsertSmall(document, graphic, cell);
  constexpr sal_Int16 half = 50;  // all of it would let a row grow that can
  measure->setPropertyValue("RelativeHeight", Any(half));
  const Size laidOut = Property<Size>(measure, "LayoutSize");
  cell->removeTextContent(Reference<text::XTextContent>(measure, UNO_QUERY_THROW));
  return laidOut.Height * 2;
}

/// Makes the picture, which has `size`, smaller if its cell has not grown with it: rows of exact height cut
/// off what is higher.
void FitIntoExactRow(const Reference<text::XTextDocument>& document, const Reference<XPropertySet>& graphic,
                     const Reference<text::XText>& cell, const Reference<XPropertySet>& picture,
                     const Size& size) {
  const sal_Int32 height = LaidOutHeight(document, graphic, cell);
  if (height >= size.Height) {
    return;
  }
  const Reference<XPropertySet> paragraph = FirstParagraph(cell);
  const sal_Int32 belowTheLine = CharacterHeight(paragraph) / 4;  // enough for the descenders of most fonts
  const sal_Int32 room = height - Length(paragraph, "ParaTopMargin") - belowTheLine;
  picture->setPropertyValue("Size", Any(Fit(size, {0, std::max(sal_Int32{1}, room)})));
}

}  // namespace

void InsertPicture(const Reference<text::XTextDocument>& document, const Reference<XPropertySet>& graphic,
                   const Reference<text::XText>& cell, const Reference<XPropertySet>& row) {
  const sal_Int32 height = HeightRoom(document, cell);
  const Reference<XPropertySet> picture = InsertSmall(document, graphic, cell);
  const Size size = Fit(OwnSize(graphic), {WidthRoom(picture), height});
  picture->setPropertyValue("Size", Any(size));
  // The sheets of most templates need no more, and measuring takes a layout.
  if (!Property<bool>(row, "IsAutoHeight")) {
    FitIntoExactRow(document, graphic, cell, picture, size);
  }
}
