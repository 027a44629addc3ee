#pragma once

#include <cstddef>
#include <string>

#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// Photographs are transferred between a file and a long binary column in blocks of this many bytes.
inline constexpr std::size_t PhotoBlockSize = 10000;

/// How a photo is divided: full blocks first, then one piece of `Rest` bytes if that is above 0.
struct PhotoBlocks {
  std::size_t Blocks;
  std::size_t Rest;
};

/// The number of blocks is rounded to nearest with ties to even, not down: if it rounds up, one block of
/// padding follows the photo. This is part of the stored format.
PhotoBlocks BlocksOf(std::size_t size);

/// The current row's photo as it is stored, with its padding; empty if the row has none. A read error cuts
/// the bytes short.
std::string StoredPhoto(Recordset& recordset, const std::string& blobColumn, const std::string& lengthColumn);

/// Stores the bytes of the file at `path`, whatever they are, in the current row, which the caller has put
/// into edit mode. Asks before storing more than 100000 bytes; if the answer is no, or the file is empty, the
/// row keeps its photo. A box reports a file that cannot be read. Throws RuntimeError if the row refuses the
/// photo.
void StorePhoto(const std::string& path, Recordset& recordset, const std::string& blobColumn,
                const std::string& lengthColumn, const Files& files, MessageBoxes& boxes);

/// Writes the current row's photo to the file at `path`. Returns false, and leaves the file alone, if the row
/// has none. Read and write errors are not reported.
bool ExportPhoto(Recordset& recordset, const std::string& blobColumn, const std::string& lengthColumn,
                 const std::string& path, Files& files);
