#include "bench/PlainSheets.h"

#include <chrono>
#include <com/sun/star/awt/Size.hpp>
#include <com/sun/star/beans/XPropertySet.hpp>
#include <com/sun/star/bridge/XUnoUrlResolver.hpp>
#include <com/sun/star/connection/NoConnectException.hpp>
#include <com/sun/star/container/XIndexAccess.hpp>
#include <com/sun/star/frame/XComponentLoader.hpp>
#include <com/sun/star/frame/XDesktop.hpp>
#include <com/sun/star/frame/XStorable.hpp>
#include <com/sun/star/lang/XMultiComponentFactory.hpp>
#include <com/sun/star/lang/XMultiServiceFactory.hpp>
#include <com/sun/star/table/XCellRange.hpp>
#include <com/sun/star/text/TextContentAnchorType.hpp>
#include <com/sun/star/text/XBookmarksSupplier.hpp>
#include <com/sun/star/text/XTextContent.hpp>
#include <com/sun/star/text/XTextDocument.hpp>
#include <com/sun/star/text/XTextTablesSupplier.hpp>
#include <com/sun/star/uno/XComponentContext.hpp>
#include <com/sun/star/util/XCloseable.hpp>
#include <cppuhelper/bootstrap.hxx>
#include <cstdlib>
#include <thread>

#include "platform/libreoffice/Uno.h"

namespace star = com::sun::star;
using star::uno::UNO_QUERY_THROW;
using Uno::Any;
using Uno::OUString;
using Uno::Reference;

namespace {

void WriteCells(const Reference<star::container::XIndexAccess>& tables, int index,
                const std::vector<std::string>& texts) {
  const Reference<star::table::XCellRange> table(tables->getByIndex(index), UNO_QUERY_THROW);
  constexpr int rows = 20;
  for (int i = 0; i < static_cast<int>(texts.size()); ++i) {
    const Reference<star::text::XText> cell(table->getCellByPosition(i / rows, 1 + i % rows),
                                            UNO_QUERY_THROW);
    cell->setString(Uno::ToOffice(texts[static_cast<std::size_t>(i)]));
  }
}

void AddPhoto(const Reference<star::lang::XMultiServiceFactory>& factory,
              const Reference<star::container::XIndexAccess>& tables, const std::string& file) {
  const Reference<star::table::XCellRange> table(tables->getByIndex(0), UNO_QUERY_THROW);
  const Reference<star::text::XText> cell(table->getCellByPosition(0, 0), UNO_QUERY_THROW);
  const Reference<star::text::XTextContent> picture(
      factory->createInstance("com.sun.star.text.TextGraphicObject"), UNO_QUERY_THROW);
  const Reference<star::beans::XPropertySet> properties(picture, UNO_QUERY_THROW);
  properties->setPropertyValue("GraphicURL", Any(Uno::UrlOf(file)));
  properties->setPropertyValue("AnchorType", Any(star::text::TextContentAnchorType_AS_CHARACTER));
  properties->setPropertyValue("Size", Any(star::awt::Size(3480, 4640)));
  cell->insertTextContent(cell->getStart(), picture, false);
}

}  // namespace

struct PlainSheets::Office {
  Reference<star::frame::XDesktop> Desktop;
};

PlainSheets::PlainSheets(const std::string& pipe) : office_(std::make_unique<Office>()) {
  setenv("URE_BOOTSTRAP", "vnd.sun.star.pathname:" LIBREOFFICE_PROGRAM "/fundamentalrc", 1);
  const Reference<star::uno::XComponentContext> local = cppu::defaultBootstrap_InitialComponentContext();
  const Reference<star::bridge::XUnoUrlResolver> resolver(
      local->getServiceManager()->createInstanceWithContext("com.sun.star.bridge.UnoUrlResolver", local),
      UNO_QUERY_THROW);
  while (!office_->Desktop.is()) {
    try {
      const Reference<star::uno::XComponentContext> remote(
          resolver->resolve(Uno::ToOffice("uno:pipe,name=" + pipe + ";urp;StarOffice.ComponentContext")),
          UNO_QUERY_THROW);
      office_->Desktop.set(
          remote->getServiceManager()->createInstanceWithContext("com.sun.star.frame.Desktop", remote),
          UNO_QUERY_THROW);
    } catch (const star::connection::NoConnectException&) {
      std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
  }
}

PlainSheets::~PlainSheets() = default;

void PlainSheets::Make(const std::string& templatePath, const Sheet& sheet) {
  const Reference<star::frame::XComponentLoader> loader(office_->Desktop, UNO_QUERY_THROW);
  const Reference<star::text::XTextDocument> document(
      loader->loadComponentFromURL(Uno::UrlOf(templatePath), "_blank", 0,
                                   Uno::Properties({{"Hidden", Any(true)}, {"AsTemplate", Any(true)}})),
      UNO_QUERY_THROW);
  const auto bookmarks = Reference<star::text::XBookmarksSupplier>(document, UNO_QUERY_THROW)->getBookmarks();
  for (const auto& [name, text] : sheet.Bookmarks) {
    const Reference<star::text::XTextContent> bookmark(bookmarks->getByName(OUString::createFromAscii(name)),
                                                       UNO_QUERY_THROW);
    bookmark->getAnchor()->setString(Uno::ToOffice(text));
  }
  const Reference<star::container::XIndexAccess> tables(
      Reference<star::text::XTextTablesSupplier>(document, UNO_QUERY_THROW)->getTextTables(),
      UNO_QUERY_THROW);
  AddPhoto({document, UNO_QUERY_THROW}, tables, sheet.Photo);
  WriteCells(tables, 3, sheet.Scored);
  WriteCells(tables, 4, sheet.Taken);
  Reference<star::frame::XStorable>(document, UNO_QUERY_THROW)
      ->storeToURL(Uno::UrlOf(sheet.Target), Uno::Properties({{"FilterName", Any(OUString("MS Word 97"))}}));
  Reference<star::util::XCloseable>(document, UNO_QUERY_THROW)->close(true);
}

void PlainSheets::Quit() {
  office_->Desktop->terminate();
}
