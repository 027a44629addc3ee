#pragma once

#include <com/sun/star/awt/XPrinterServer2.hpp>
#include <com/sun/star/container/XNameAccess.hpp>
#include <com/sun/star/graphic/XGraphicProvider.hpp>
#include <com/sun/star/lang/XComponent.hpp>
#include <com/sun/star/text/XTextDocument.hpp>
#include <com/sun/star/text/XTextTable.hpp>
#include <memory>
#include <string>
#include <vector>

#include "platform/WordProcessor.h"
#include "platform/libreoffice/Uno.h"

/// Names of a template's body tables, in document order. Finding them takes many calls, and they are the same
/// in every document made from the template; empty until the first document has needed them.
using BodyTables = std::vector<Uno::OUString>;

/// LibreOffice's services that documents use.
struct OfficeServices {
  Uno::Reference<com::sun::star::graphic::XGraphicProvider> Graphics;
  Uno::Reference<com::sun::star::awt::XPrinterServer2> Printers;
};

/// A text document that is open in LibreOffice.
class OfficeDocument : public WordDocument {
 public:
  OfficeDocument(const Uno::Reference<com::sun::star::text::XTextDocument>& document,
                 const OfficeServices& services, std::shared_ptr<BodyTables> bodyTables);

  void SetBookmark(const std::string& name, const std::string& text) override;
  void WriteCells(int table, int firstRow, int rows, const std::vector<std::string>& texts) override;
  void ResizeRows(int table, int firstRow, int rows, const RowSizes& sizes) override;
  void AddPicture(int table, int row, int column, const std::string& file) override;
  void SaveAs(const std::string& path) override;
  void ExportPdf(const std::string& path) override;
  void PrintOut() override;
  void Close() override;

 private:
  Uno::Reference<com::sun::star::text::XTextTable> Table(int number);
  void FindBodyTables();
  void Store(const std::string& path, const char* filter);

  Uno::Reference<com::sun::star::text::XTextDocument> document_;
  OfficeServices services_;
  std::shared_ptr<BodyTables> bodyTables_;
  Uno::Reference<com::sun::star::container::XNameAccess> bookmarks_;
  Uno::Reference<com::sun::star::container::XNameAccess> tables_;
};
