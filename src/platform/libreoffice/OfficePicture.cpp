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

/// Greatest height of a picture in the cell: a page's, less what the cell and the picture's line add to it.
sal_Int32 HeightRoom(const Reference<text::XTextDocument>& document, const Reference<text::XText>& cell) {
  const Reference<XPropertySet> inside(cell, UNO_QUERY_THROW);
  const Reference<XPropertySet> paragraph(cell->createTextCursor(), UNO_QUERY_THROW);
  constexpr double points = 72;
  return PageRoom(document, paragraph) - Length(inside, "TopBorderDistance") -
         Length(inside, "BottomBorderDistance") - Length(paragraph, "ParaTopMargin") -
         Length(paragraph, "ParaBottomMargin") -
         static_cast<sal_Int32>(Property<float>(paragraph, "CharHeight") * Inch / points);
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

}  // namespace

void InsertPicture(const Reference<text::XTextDocument>& document, const Reference<XPropertySet>& graphic,
                   const Reference<text::XText>& cell) {
  const Reference<com::sun::star::lang::XMultiServiceFactory> factory(document, UNO_QUERY_THROW);
  const Reference<text::XTextContent> content(factory->createInstance("com.sun.star.text.TextGraphicObject"),
                                              UNO_QUERY_THROW);
  const Reference<XPropertySet> picture(content, UNO_QUERY_THROW);
  constexpr sal_Int32 small = 100;
  picture->setPropertyValue("Graphic", Any(graphic));
  picture->setPropertyValue("AnchorType", Any(text::TextContentAnchorType_AS_CHARACTER));
  picture->setPropertyValue("Size", Any(Size(small, small)));
  const sal_Int32 height = HeightRoom(document, cell);
  cell->insertTextContent(cell->getStart(), content, false);
  picture->setPropertyValue("Size", Any(Fit(OwnSize(graphic), {WidthRoom(picture), height})));
}
