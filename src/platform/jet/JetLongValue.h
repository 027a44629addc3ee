#pragma once

#include <glib.h>  // which must not be included for the first time by the library
#include <mdbtools.h>

#include <optional>
#include <string>
#include <string_view>

/// The bytes of a memo or OLE value, which lie outside its row unless they are few. `reference` is what the
/// row holds: 12 bytes with the value's length and place, and possibly the value itself. Nothing if they
/// cannot be read to exactly that length. The current page of `mdb` is another one afterwards.
std::optional<std::string> ReadLongValue(MdbHandle* mdb, std::string_view reference);
