#include "core/Photo.h"

#include <algorithm>
#include <cmath>

#include "core/FieldValue.h"
#include "platform/RuntimeError.h"

namespace {

/// Bytes of the photo without padding; 0 also for a column that cannot be read.
std::size_t SizeOf(Recordset& recordset, const std::string& lengthColumn) {
  try {
    const double size = NumberOf(recordset.Fields(lengthColumn));
    return size < 1 ? 0 : static_cast<std::size_t>(size);
  } catch (const RuntimeError&) {
    return 0;
  }
}

/// One piece; empty when it cannot be read.
Blob Piece(Recordset& recordset, const std::string& blobColumn, std::size_t offset, std::size_t count) {
  try {
    return recordset.GetChunk(blobColumn, offset, count);
  } catch (const RuntimeError&) {
    return {};
  }
}

}  // namespace

PhotoBlocks BlocksOf(std::size_t size) {
  const double blocks = std::nearbyint(static_cast<double>(size) / static_cast<double>(PhotoBlockSize));
  return {static_cast<std::size_t>(blocks), size % PhotoBlockSize};
}

std::string StoredPhoto(Recordset& recordset, const std::string& blobColumn,
                        const std::string& lengthColumn) {
  const PhotoBlocks cut = BlocksOf(SizeOf(recordset, lengthColumn));
  const std::size_t end = cut.Blocks * PhotoBlockSize + cut.Rest;
  std::string bytes;
  for (std::size_t offset = 0; offset < end; offset += PhotoBlockSize) {
    const Blob piece = Piece(recordset, blobColumn, offset, std::min(PhotoBlockSize, end - offset));
    if (piece.empty()) {
      break;
    }
    bytes.append(piece.begin(), piece.end());
  }
  return bytes;
}

bool ExportPhoto(Recordset& recordset, const std::string& blobColumn, const std::string& lengthColumn,
                 const std::string& path, Files& files) {
  if (SizeOf(recordset, lengthColumn) == 0) {
    return false;
  }
  const std::string bytes = StoredPhoto(recordset, blobColumn, lengthColumn);
  try {
    files.Write(path, bytes);
  } catch (const RuntimeError&) {
    // The caller finds a short file, as with a column that cannot be read.
    return true;
  }
  return true;
}
