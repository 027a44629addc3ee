#include "platform/libreoffice/OfficeRows.h"

#include <algorithm>
#include <cmath>
#include <com/sun/star/beans/XPropertySet.hpp>
#include <com/sun/star/style/LineSpacing.hpp>
#include <com/sun/star/style/LineSpacingMode.hpp>
#include <com/sun/star/table/XCellRange.hpp>
#include <com/sun/star/text/TableColumnSeparator.hpp>
#include <com/sun/star/text/XText.hpp>

namespace style = com::sun::star::style;
namespace text = com::sun::star::text;
using com::sun::star::beans::XPropertySet;
using com::sun::star::table::XCellRange;
using com::sun::star::uno::UNO_QUERY_THROW;
using Uno::Any;
using Uno::OUString;
using Uno::Reference;
using Uno::Sequence;

namespace {

constexpr const char* Separators = "TableColumnSeparators";

/// Cells of a table: from a row and column, counted from 0, up to others.
struct Area {
  int FirstColumn;
  int FirstRow;
  int LastColumn;
  int LastRow;
};

Reference<XPropertySet> CellsIn(const Reference<text::XTextTable>& table, const Area& area) {
  const Reference<XCellRange> whole(table, UNO_QUERY_THROW);
  return {whole->getCellRangeByPosition(area.FirstColumn, area.FirstRow, area.LastColumn, area.LastRow),
          UNO_QUERY_THROW};
}

void SetLetters(const Reference<XPropertySet>& cells, float points) {
  for (const char* script : {"CharHeight", "CharHeightAsian", "CharHeightComplex"}) {
    cells->setPropertyValue(OUString::createFromAscii(script), Any(points));
  }
}

void SetLineHeight(const Reference<XPropertySet>& cells, double height) {
  style::LineSpacing line;
  line.Mode = style::LineSpacingMode::FIX;
  line.Height = static_cast<sal_Int16>(std::lround(height));
  cells->setPropertyValue("ParaLineSpacing", Any(line));
}

/// Lets the first column take nearly all the room of the second one, so that long names stay on one line.
/// Returns by how much it has grown.
double WidenFirstColumn(const Reference<text::XTextTable>& table) {
  const Reference<XPropertySet> properties(table, UNO_QUERY_THROW);
  Sequence<text::TableColumnSeparator> separators;
  properties->getPropertyValue(OUString::createFromAscii(Separators)) >>= separators;
  if (separators.getLength() < 2 || separators[0].Position <= 0) {
    return 1;
  }
  constexpr double room = 0.97;  // leaves the second column something
  const double width = separators[0].Position;
  const double growth = room * separators[1].Position / width;
  if (growth <= 1) {
    return 1;
  }
  separators.getArray()[0].Position = static_cast<sal_Int16>(std::lround(width * growth));
  properties->setPropertyValue(OUString::createFromAscii(Separators), Any(separators));
  return growth;
}

}  // namespace

void ResizeRows(const Reference<text::XTextTable>& table, int firstRow, int rows, const RowSizes& sizes) {
  const int first = firstRow - 1;
  const Reference<XCellRange> range(table, UNO_QUERY_THROW);
  const Reference<text::XText> cell(range->getCellByPosition(0, first), UNO_QUERY_THROW);
  const Reference<XPropertySet> paragraph(cell->createTextCursor(), UNO_QUERY_THROW);
  style::LineSpacing line;
  paragraph->getPropertyValue("ParaLineSpacing") >>= line;
  float letters = 0;
  paragraph->getPropertyValue("CharHeight") >>= letters;
  const int lastColumn = table->getColumns()->getCount() - 1;
  if (line.Mode != style::LineSpacingMode::FIX || lastColumn < 1) {
    return;
  }
  const double growth = WidenFirstColumn(table);
  if (growth <= 1) {
    return;
  }
  const double larger = std::min(sizes.Letters, growth);
  SetLetters(CellsIn(table, {0, first, 0, first + sizes.Used - 1}), static_cast<float>(letters * larger));
  SetLineHeight(CellsIn(table, {0, first, 1, first + sizes.Used - 1}), line.Height * sizes.UsedHeight);
  if (sizes.Used < rows) {
    SetLineHeight(CellsIn(table, {0, first + sizes.Used, lastColumn, first + rows - 1}),
                  line.Height * sizes.RestHeight);
  }
}
