#include "platform/libreoffice/OfficeDocument.h"

#include <atomic>
#include <com/sun/star/container/NoSuchElementException.hpp>
#include <com/sun/star/container/XContentEnumerationAccess.hpp>
#include <com/sun/star/container/XEnumerationAccess.hpp>
#include <com/sun/star/container/XNamed.hpp>
#include <com/sun/star/frame/XStorable.hpp>
#include <com/sun/star/sheet/XCellRangeData.hpp>
#include <com/sun/star/table/XCellRange.hpp>
#include <com/sun/star/text/WrapTextMode.hpp>
#include <com/sun/star/text/XBookmarksSupplier.hpp>
#include <com/sun/star/text/XTextContent.hpp>
#include <com/sun/star/text/XTextFrame.hpp>
#include <com/sun/star/text/XTextTablesSupplier.hpp>
#include <com/sun/star/util/XCloseable.hpp>
#include <com/sun/star/view/PrintableState.hpp>
#include <com/sun/star/view/XPrintJobBroadcaster.hpp>
#include <com/sun/star/view/XPrintJobListener.hpp>
#include <com/sun/star/view/XPrintable.hpp>
#include <cppuhelper/implbase1.hxx>
#include <filesystem>
#include <rtl/ref.hxx>
#include <string>
#include <string_view>
#include <utility>

#include <unistd.h>

#include "platform/libreoffice/OfficePicture.h"
#include "platform/libreoffice/OfficeRows.h"

namespace container = com::sun::star::container;
namespace table = com::sun::star::table;
namespace text = com::sun::star::text;
namespace view = com::sun::star::view;
using com::sun::star::uno::UNO_QUERY;
using com::sun::star::uno::UNO_QUERY_THROW;
using Uno::Any;
using Uno::OUString;
using Uno::Reference;
using Uno::Sequence;

namespace {

/// The bookmark of this name, in any case, as Word finds it.
Any FindBookmark(container::XNameAccess& bookmarks, const OUString& name) {
  try {
    return bookmarks.getByName(name);
  } catch (const container::NoSuchElementException&) {
    for (const OUString& other : bookmarks.getElementNames()) {
      if (other.equalsIgnoreAsciiCase(name)) {
        return bookmarks.getByName(other);
      }
    }
    throw;
  }
}

/// A name in the folder of `path` that no other file has.
std::string UnfinishedBeside(const std::string& path) {
  static std::atomic<int> count = 0;
  const std::string name = ".new-" + std::to_string(getpid()) + "-" + std::to_string(++count);
  return std::filesystem::path(path).parent_path() / name;
}

/// A block of cells. `Texts` runs down each column in turn.
struct Block {
  int FirstColumn;  ///< counted from 0, like the row
  int FirstRow;
  int Columns;
  int Rows;
  const std::string* Texts;
};

void WriteAtOnce(table::XCellRange& range, const Block& block) {
  Sequence<Sequence<Any>> rows(block.Rows);
  for (int row = 0; row < block.Rows; ++row) {
    Sequence<Any> cells(block.Columns);
    for (int column = 0; column < block.Columns; ++column) {
      cells.getArray()[column] <<= Uno::ToOffice(block.Texts[column * block.Rows + row]);
    }
    rows.getArray()[row] = cells;
  }
  const Reference<com::sun::star::sheet::XCellRangeData> cells(
      range.getCellRangeByPosition(block.FirstColumn, block.FirstRow, block.FirstColumn + block.Columns - 1,
                                   block.FirstRow + block.Rows - 1),
      UNO_QUERY_THROW);
  cells->setDataArray(rows);
}

/// Tables with merged cells have no ranges; their cells are found by name: "B3" is the second one in row 3.
/// Behind column Z come a to z, and then AA.
Reference<text::XText> CellByName(text::XTextTable& table, int row, int column) {
  constexpr std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz";
  constexpr int count = static_cast<int>(letters.size());
  OUString name;
  for (int rest = column + 1; rest > 0; rest = (rest - 1) / count) {
    name = OUString(static_cast<sal_Unicode>(letters[static_cast<std::size_t>((rest - 1) % count)])) + name;
  }
  return {table.getCellByName(name + OUString::number(row + 1)), UNO_QUERY_THROW};
}

void WriteOneByOne(text::XTextTable& table, const Block& block) {
  for (int column = 0; column < block.Columns; ++column) {
    for (int row = 0; row < block.Rows; ++row) {
      CellByName(table, block.FirstRow + row, block.FirstColumn + column)
          ->setString(Uno::ToOffice(block.Texts[column * block.Rows + row]));
    }
  }
}

void WriteBlock(text::XTextTable& table, table::XCellRange& range, const Block& block) {
  try {
    WriteAtOnce(range, block);
  } catch (const com::sun::star::uno::Exception&) {
    WriteOneByOne(table, block);  // throws if a cell is missing
  }
}

/// Calls `use` with each paragraph of a text and each table in it, or with each portion of a paragraph.
template <typename Use>
void ForEachPart(const Reference<container::XEnumerationAccess>& whole, Use&& use) {
  const Reference<container::XEnumeration> parts = whole->createEnumeration();
  while (parts->hasMoreElements()) {
    use(parts->nextElement());
  }
}

/// Adds the name of `part` when it is a table.
void AddTable(const Any& part, BodyTables& names) {
  if (const Reference<text::XTextTable> found(part, UNO_QUERY); found.is()) {
    names.push_back(Reference<container::XNamed>(found, UNO_QUERY_THROW)->getName());
  }
}

/// True unless the frame is a text box, which may begin with a table as well: text runs through it, or it
/// keeps a distance (in 1/100 mm) from what is in it.
bool IsOfFloatingTable(const Reference<text::XTextFrame>& frame) {
  const Reference<com::sun::star::beans::XPropertySet> properties(frame, UNO_QUERY_THROW);
  text::WrapTextMode wrap{};
  properties->getPropertyValue("Surround") >>= wrap;
  sal_Int32 distance = 0;
  properties->getPropertyValue("LeftBorderDistance") >>= distance;
  constexpr sal_Int32 rounding = 10;
  return wrap != text::WrapTextMode_THROUGH && distance < rounding;
}

/// Word counts a table that text flows around among the body's tables. LibreOffice puts it first in a frame,
/// which is anchored to the paragraph after it or to a character of that paragraph.
void AddFloatingTables(const Any& place, BodyTables& names) {
  const Reference<container::XContentEnumerationAccess> access(place, UNO_QUERY_THROW);
  const Reference<container::XEnumeration> hanging =
      access->createContentEnumeration("com.sun.star.text.TextContent");
  while (hanging->hasMoreElements()) {
    const Reference<text::XTextFrame> frame(hanging->nextElement(), UNO_QUERY);
    if (frame.is() && IsOfFloatingTable(frame)) {
      const Reference<container::XEnumerationAccess> inside(frame->getText(), UNO_QUERY_THROW);
      AddTable(inside->createEnumeration()->nextElement(), names);
    }
  }
}

/// Learns whether the print queue accepted a document, which LibreOffice reports in no other way.
class PrintJobWatch : public cppu::WeakImplHelper1<view::XPrintJobListener> {
 public:
  bool Failed() const { return failed_; }

  void SAL_CALL printJobEvent(const view::PrintJobEvent& event) override {
    if (event.State == view::PrintableState_JOB_FAILED || event.State == view::PrintableState_JOB_ABORTED ||
        event.State == view::PrintableState_JOB_SPOOLING_FAILED) {
      failed_ = true;
    }
  }
  void SAL_CALL disposing(const com::sun::star::lang::EventObject& /*source*/) override {}

 private:
  std::atomic<bool> failed_ = false;  // set on one of LibreOffice's threads
};

}  // namespace

OfficeDocument::OfficeDocument(const Reference<text::XTextDocument>& document, const OfficeServices& services,
                               std::shared_ptr<BodyTables> bodyTables)
    : document_(document), services_(services), bodyTables_(std::move(bodyTables)) {
  document_->lockControllers();  // saves a new layout after each change
}

void OfficeDocument::SetBookmark(const std::string& name, const std::string& words) {
  Uno::Call([&] {
    if (!bookmarks_.is()) {
      bookmarks_ = Reference<text::XBookmarksSupplier>(document_, UNO_QUERY_THROW)->getBookmarks();
    }
    const Reference<text::XTextContent> bookmark(FindBookmark(*bookmarks_, Uno::ToOffice(name)),
                                                 UNO_QUERY_THROW);
    bookmark->getAnchor()->setString(Uno::ToOffice(words));
  });
}

void OfficeDocument::WriteCells(int number, int firstRow, int rows, const std::vector<std::string>& texts) {
  Uno::Call([&] {
    const Reference<text::XTextTable> whole = Table(number);
    const int count = static_cast<int>(texts.size());
    const int full = count / rows;
    const int rest = count % rows;
    const Block blocks[] = {{0, firstRow - 1, full, rows, texts.data()},
                            {full, firstRow - 1, 1, rest, texts.data() + (count - rest)}};
    const Reference<table::XCellRange> range(whole, UNO_QUERY_THROW);
    for (const Block& block : blocks) {
      if (block.Columns > 0 && block.Rows > 0) {
        WriteBlock(*whole, *range, block);
      }
    }
  });
}

void OfficeDocument::ResizeRows(int number, int firstRow, int rows, const RowSizes& sizes) {
  Uno::Call([&] { ::ResizeRows(Table(number), firstRow, rows, sizes); });
}

void OfficeDocument::AddPicture(int number, int row, int column, const std::string& file) {
  Uno::Call([&] {
    const Reference<com::sun::star::beans::XPropertySet> graphic(
        services_.Graphics->queryGraphic(Uno::Properties({{"URL", Any(Uno::UrlOf(file))}})), UNO_QUERY_THROW);
    const Reference<text::XTextTable> whole = Table(number);
    const Reference<text::XText> cell = CellByName(*whole, row - 1, column - 1);
    InsertPicture(document_, graphic, cell, {whole->getRows()->getByIndex(row - 1), UNO_QUERY_THROW});
  });
}

void OfficeDocument::SaveAs(const std::string& path) {
  Store(path, "MS Word 97");
}

void OfficeDocument::ExportPdf(const std::string& path) {
  Store(path, "writer_pdf_Export");
}

// First under a name of its own: an old file stays until the new one is whole, and a lock that a killed
// LibreOffice has left on it does not matter.
void OfficeDocument::Store(const std::string& path, const char* filter) {
  const std::string unfinished = UnfinishedBeside(path);
  std::error_code failed;
  try {
    Uno::Call([&] {
      if (document_->hasControllersLocked()) {
        document_->unlockControllers();
      }
      const Reference<com::sun::star::frame::XStorable> storable(document_, UNO_QUERY_THROW);
      storable->storeToURL(Uno::UrlOf(unfinished),
                           Uno::Properties({{"FilterName", Any(OUString::createFromAscii(filter))}}));
    });
    std::filesystem::rename(unfinished, path, failed);
    if (failed) {
      throw RuntimeError(Fault::AutomationError, "Automation error: " + failed.message() + ": " + path);
    }
  } catch (const RuntimeError&) {
    std::filesystem::remove(unfinished, failed);
    throw;
  }
}

void OfficeDocument::PrintOut() {
  Uno::Call([&] {
    // LibreOffice looks for printers in the background; asking for the list waits until it has found them.
    services_.Printers->getPrinterNames();
    // "Generic Printer" is the stand-in on a system without printers: it discards whatever it is given.
    const OUString printer = services_.Printers->getDefaultPrinterName();
    if (printer.isEmpty() || printer == "Generic Printer") {
      throw RuntimeError(Fault::PrinterError, "Printer error");
    }
    const rtl::Reference<PrintJobWatch> watch(new PrintJobWatch);
    Reference<view::XPrintJobBroadcaster>(document_, UNO_QUERY_THROW)->addPrintJobListener(watch.get());
    Reference<view::XPrintable>(document_, UNO_QUERY_THROW)->print(Uno::Properties({{"Wait", Any(true)}}));
    if (watch->Failed()) {
      throw RuntimeError(Fault::PrinterError, "Printer error");
    }
  });
}

void OfficeDocument::Close() {
  Uno::Call([&] { Reference<com::sun::star::util::XCloseable>(document_, UNO_QUERY_THROW)->close(true); });
}

Reference<text::XTextTable> OfficeDocument::Table(int number) {
  if (!tables_.is()) {
    tables_ = Reference<text::XTextTablesSupplier>(document_, UNO_QUERY_THROW)->getTextTables();
  }
  if (bodyTables_->empty()) {
    FindBodyTables();
  }
  if (number > static_cast<int>(bodyTables_->size())) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  return {tables_->getByName((*bodyTables_)[static_cast<std::size_t>(number) - 1]), UNO_QUERY_THROW};
}

void OfficeDocument::FindBodyTables() {
  // The document's own collection has no documented order and includes tables in cells and text boxes.
  BodyTables names;
  const Reference<container::XEnumerationAccess> body(document_->getText(), UNO_QUERY_THROW);
  ForEachPart(body, [&names](const Any& part) {
    AddTable(part, names);
    if (const Reference<container::XEnumerationAccess> paragraph(part, UNO_QUERY); paragraph.is()) {
      AddFloatingTables(part, names);
      ForEachPart(paragraph, [&names](const Any& portion) { AddFloatingTables(portion, names); });
    }
  });
  *bodyTables_ = std::move(names);
}
