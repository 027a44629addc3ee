#pragma once

#include <com/sun/star/text/XTextTable.hpp>

#include "platform/WordProcessor.h"
#include "platform/libreoffice/Uno.h"

/// See WordDocument::ResizeRows. Throws exceptions of LibreOffice.
void ResizeRows(const Uno::Reference<com::sun::star::text::XTextTable>& table, int firstRow, int rows,
                const RowSizes& sizes);
