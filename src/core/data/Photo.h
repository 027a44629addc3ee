#pragma once

#include <cstddef>
#include <string>

#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// Photographs move between a file and a long binary column in blocks of this many bytes.
inline constexpr std::size_t PhotoBlockSize = 10000;

/// How a photo of some size is cut: full blocks first, then one piece of `Rest` bytes when that is above 0.
struct PhotoBlocks {
  std::size_t Blocks;
  std::size_t Rest;
};

/// The number of blocks is rounded to nearest with ties to even, not down: a photo whose division rounds up
/// is stored with one block of padding behind it. This is part of the stored format.
PhotoBlocks BlocksOf(std::size_t size);

/// The photo of the current row as it is stored, with its padding; empty when the row has none. A column that
/// cannot be read leaves the bytes short.
std::string StoredPhoto(Recordset& recordset, const std::string& blobColumn, const std::string& lengthColumn);

/// Puts the bytes of the file at `path`, whatever they are, into the current row, which the caller has put
/// into edit mode. Asks about a file of more than 100000 bytes; when the answer is no, and for an empty file,
/// the row keeps its photo. A file that cannot be read is said in a box. Throws RuntimeError for what the row
/// does not take.
void StorePhoto(const std::string& path, Recordset& recordset, const std::string& blobColumn,
                const std::string& lengthColumn, const Files& files, MessageBoxes& boxes);

/// Writes the photo of the current row into the file at `path`. Returns false, and leaves the file alone,
/// when the row has none. What cannot be read or written is left out without a word.
bool ExportPhoto(Recordset& recordset, const std::string& blobColumn, const std::string& lengthColumn,
                 const std::string& path, Files& files);
