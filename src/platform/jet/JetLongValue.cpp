#include "platform/jet/JetLongValue.h"

#include <cstdint>
#include <cstring>

namespace {

constexpr std::size_t ReferenceSize = MDB_MEMO_OVERHEAD;
constexpr std::size_t PlaceOffset = 4;

// The two highest bits of the length tell where the value lies; without any it is a chain of pieces.
constexpr std::uint32_t LengthMask = 0x3FFFFFFF;
constexpr std::uint32_t InRow = 0x80000000;
constexpr std::uint32_t InOnePiece = 0x40000000;

/// More is not read: such a length is a damaged one, and memory is limited.
constexpr std::size_t MostBytes = std::size_t{256} << 20U;

std::uint32_t NumberAt(std::string_view bytes, std::size_t at) {
  std::uint32_t number = 0;
  for (std::size_t i = 4; i > 0; --i) {
    number = number << 8U | static_cast<unsigned char>(bytes[at + i - 1]);
  }
  return number;
}

/// A piece of a long value: row `place & 255` of page `place >> 8`. Nothing if there is no such piece.
std::optional<std::string_view> PieceAt(MdbHandle* mdb, std::uint32_t place) {
  constexpr std::uint32_t rowMask = 0xFF;
  constexpr unsigned int pageShift = 8;
  constexpr int offsetMask = 0x1FFF;
  constexpr std::size_t ownerOffset = 4;
  const unsigned long page = place >> pageShift;
  const int row = static_cast<int>(place & rowMask);
  if (page == 0 || mdb_read_pg(mdb, page) != mdb->fmt->pg_size) {
    return std::nullopt;
  }
  const unsigned char* const bytes = mdb->pg_buf;
  int start = 0;
  std::size_t size = 0;
  if (bytes[0] != MDB_PAGE_DATA || std::memcmp(bytes + ownerOffset, "LVAL", 4) != 0 ||
      row >= mdb_get_int16(mdb->pg_buf, mdb->fmt->row_count_offset) ||
      mdb_find_row(mdb, row, &start, &size) != 0) {
    return std::nullopt;
  }
  return std::string_view(reinterpret_cast<const char*>(bytes) + (start & offsetMask), size);
}

std::optional<std::string> ReadChain(MdbHandle* mdb, std::uint32_t place, std::size_t length) {
  constexpr std::size_t nextSize = 4;
  std::string value;
  while (place != 0) {
    const auto piece = PieceAt(mdb, place);
    // An empty piece adds nothing, so that a chain of them could go round for ever.
    if (!piece || piece->size() <= nextSize || value.size() + piece->size() - nextSize > length) {
      return std::nullopt;
    }
    place = NumberAt(*piece, 0);
    value += piece->substr(nextSize);
  }
  return value.size() == length ? std::optional(std::move(value)) : std::nullopt;
}

}  // namespace

std::optional<std::string> ReadLongValue(MdbHandle* mdb, std::string_view reference) {
  if (reference.empty()) {
    return std::string();
  }
  if (reference.size() < ReferenceSize) {
    return std::nullopt;
  }
  const std::uint32_t head = NumberAt(reference, 0);
  const std::size_t length = head & LengthMask;
  if (length > MostBytes) {
    return std::nullopt;
  }
  const std::uint32_t place = NumberAt(reference, PlaceOffset);
  if ((head & (InRow | InOnePiece)) == 0) {
    return ReadChain(mdb, place, length);
  }
  const auto piece = (head & InRow) != 0 ? reference.substr(ReferenceSize) : PieceAt(mdb, place);
  if (!piece || piece->size() < length) {
    return std::nullopt;
  }
  return std::string(piece->substr(0, length));
}
