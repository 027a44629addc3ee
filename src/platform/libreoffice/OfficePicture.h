#pragma once

#include <com/sun/star/beans/XPropertySet.hpp>
#include <com/sun/star/text/XText.hpp>
#include <com/sun/star/text/XTextDocument.hpp>

#include "platform/libreoffice/Uno.h"

/// Inserts `graphic` at the start of a table cell's text, like a character. It has its own size (96 dots per
/// inch if it tells none), or less where the cell's width, the page's height or rows of exact height have no
/// room for that; its proportions are kept.
void InsertPicture(const Uno::Reference<com::sun::star::text::XTextDocument>& document,
                   const Uno::Reference<com::sun::star::beans::XPropertySet>& graphic,
                   const Uno::Reference<com::sun::star::text::XText>& cell,
                   const Uno::Reference<com::sun::star::beans::XPropertySet>& row);
