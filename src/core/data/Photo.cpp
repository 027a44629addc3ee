#include "core/data/Photo.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>

#include "core/data/FieldValue.h"
#include "platform/RuntimeError.h"

namespace {

/// Limit for an absurd value in the length column; no photo is longer.
constexpr double LongestPhoto = std::numeric_limits<std::int32_t>::max();

/// Bytes of the photo without padding; 0 also if the column cannot be read.
std::size_t SizeOf(Recordset& recordset, const std::string& lengthColumn) {
  try {
    const double size = NumberOf(recordset.Fields(lengthColumn));
    return size < 1 ? 0 : static_cast<std::size_t>(std::min(size, LongestPhoto));
  } catch (const RuntimeError&) {
    return 0;
  }
}

/// One piece; empty if it cannot be read.
Blob Piece(Recordset& recordset, const std::string& blobColumn, std::size_t offset, std::size_t count) {
  try {
    return recordset.GetChunk(blobColumn, offset, count);
  } catch (const RuntimeError&) {
    return {};
  }
}

constexpr std::uint64_t LargePhoto = 100'000;

bool WantsLargePhoto(MessageBoxes& boxes) {
  return boxes.Show("This photo is large. Large photo's will reduce performance. Do you wish to proceed?",
                    "Photo Warning", BoxIcon::Question, BoxButtons::OkCancel) == BoxAnswer::Ok;
}

/// The photo file's bytes; empty if the operator declines or the file cannot be read.
std::string BytesToStore(const std::string& path, const Files& files, MessageBoxes& boxes) {
  try {
    if (files.FileLen(path) > LargePhoto && !WantsLargePhoto(boxes)) {
      return {};
    }
    return files.Read(path);
  } catch (const RuntimeError& error) {
    boxes.Show(error.what(), DefaultBoxTitle, BoxIcon::None);
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

void StorePhoto(const std::string& path, Recordset& recordset, const std::string& blobColumn,
                const std::string& lengthColumn, const Files& files, MessageBoxes& boxes) {
  const std::string bytes = BytesToStore(path, files, boxes);
  if (bytes.empty()) {
    return;
  }
  const PhotoBlocks cut = BlocksOf(bytes.size());
  recordset.SetField(lengthColumn, static_cast<std::int64_t>(bytes.size()));
  const std::size_t end = cut.Blocks * PhotoBlockSize + cut.Rest;
  for (std::size_t offset = 0; offset < end;) {
    const std::size_t count = std::min(PhotoBlockSize, end - offset);
    const auto first = bytes.begin() + static_cast<std::ptrdiff_t>(std::min(offset, bytes.size()));
    const auto left = static_cast<std::size_t>(bytes.end() - first);
    Blob piece(first, first + static_cast<std::ptrdiff_t>(std::min(count, left)));
    piece.resize(count);  // the padding
    recordset.AppendChunk(blobColumn, piece);
    offset += count;
  }
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
    // The file is then missing or short, as after a column that cannot be read.
    return true;
  }
  return true;
}
