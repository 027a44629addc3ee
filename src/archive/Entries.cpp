#include "archive/Entries.h"

#include <zlib.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <ctime>
#include <new>
#include <optional>
#include <utility>

namespace {

constexpr std::string_view Suffix = ".game.xml";

/// How hard zlib tries. At its default of 6 the fullest game takes more than twice as long, and is no
/// smaller.
constexpr int Level = 3;

/// The parts of "YYYY-MM-DD HH:MM:SS".
std::optional<std::tm> TimeOf(std::string_view text) {
  constexpr std::string_view form = "dddd-dd-dd dd:dd:dd";
  if (text.size() != form.size()) {
    return std::nullopt;
  }
  for (std::size_t at = 0; at < form.size(); ++at) {
    const bool isDigit = text[at] >= '0' && text[at] <= '9';
    if (form[at] == 'd' ? !isDigit : text[at] != form[at]) {
      return std::nullopt;
    }
  }
  const auto number = [text](std::size_t at, std::size_t length) {
    return std::stoi(std::string(text.substr(at, length)));
  };
  std::tm time{};
  time.tm_year = number(0, 4) - 1900;
  time.tm_mon = number(5, 2) - 1;
  time.tm_mday = number(8, 2);
  time.tm_hour = number(11, 2);
  time.tm_min = number(14, 2);
  time.tm_sec = number(17, 2);
  time.tm_isdst = -1;
  return time;
}

std::string WithZeros(std::int64_t number) {
  std::array<char, 32> digits{};
  std::snprintf(digits.data(), digits.size(), "%06lld", static_cast<long long>(number));
  return digits.data();
}

/// Ends the stream with its scope.
class InflateStream {
 public:
  explicit InflateStream(const Blob& data) {
    // zlib reads only, but has no const.
    stream_.next_in = const_cast<Bytef*>(data.data());
    stream_.avail_in = static_cast<uInt>(data.size());
    if (inflateInit(&stream_) != Z_OK) {
      throw std::bad_alloc();
    }
  }
  ~InflateStream() { inflateEnd(&stream_); }
  InflateStream(const InflateStream&) = delete;
  InflateStream& operator=(const InflateStream&) = delete;

  /// Appends up to `most` further bytes to `bytes`. Returns false at the end of the stream or a fault in it.
  bool Read(std::string& bytes, std::size_t most) {
    const std::size_t start = bytes.size();
    bytes.resize(start + most);
    stream_.next_out = reinterpret_cast<Bytef*>(bytes.data() + start);
    stream_.avail_out = static_cast<uInt>(most);
    const int result = inflate(&stream_, Z_NO_FLUSH);
    bytes.resize(bytes.size() - stream_.avail_out);
    isAtEnd_ = result == Z_STREAM_END;
    return result == Z_OK && bytes.size() > start;
  }

  /// True if the stream ended as it should, with nothing behind it.
  bool IsWhole() const { return isAtEnd_ && stream_.avail_in == 0; }

 private:
  z_stream stream_{};
  bool isAtEnd_ = false;
};

Unpacking Inflate(const Blob& data, std::size_t size, std::string& bytes) {
  constexpr std::size_t step = std::size_t{1} << 16U;
  InflateStream stream(data);
  bytes.reserve(size + 1);  // growing would take half as much again
  // One byte more than there may be, so that a stream which holds more is seen.
  while (bytes.size() <= size && stream.Read(bytes, std::min(step, size + 1 - bytes.size()))) {
  }
  return stream.IsWhole() && bytes.size() == size ? Unpacking::Done : Unpacking::Damaged;
}

}  // namespace

std::string EntryName(std::string_view played, std::int64_t gameId, std::int64_t state) {
  const std::string further = state > 0 ? "-" + std::to_string(state) : std::string();
  const std::string number = WithZeros(gameId).append(further).append(Suffix);
  if (!TimeOf(played)) {
    return "undated/" + number;
  }
  std::string name(played.substr(0, 10));
  return name.append("/")
      .append(played.substr(11, 2))
      .append(played.substr(14, 2))
      .append("-")
      .append(number);
}

std::int64_t SecondsOf(const std::string& localTime) {
  std::optional<std::tm> time = TimeOf(localTime);
  return time ? std::max<std::int64_t>(std::mktime(&*time), 0) : 0;
}

class Packer::Stream {
 public:
  Stream() {
    if (deflateInit(&stream_, Level) != Z_OK) {
      throw std::bad_alloc();
    }
  }
  ~Stream() { deflateEnd(&stream_); }
  Stream(const Stream&) = delete;
  Stream& operator=(const Stream&) = delete;

  /// Takes the bytes in, and gives out what is deflated by then; all of it if `flush` is Z_FINISH.
  void Deflate(std::string_view bytes, int flush) {
    // zlib reads only, but has no const.
    stream_.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(bytes.data()));
    stream_.avail_in = static_cast<uInt>(bytes.size());
    int result = Z_OK;
    do {
      stream_.next_out = piece_.data();
      stream_.avail_out = static_cast<uInt>(piece_.size());
      result = deflate(&stream_, flush);
      const std::size_t length = piece_.size() - stream_.avail_out;
      Packed.insert(Packed.end(), piece_.begin(), piece_.begin() + static_cast<std::ptrdiff_t>(length));
    } while (result == Z_OK && stream_.avail_out == 0);
  }

  Blob Packed;

 private:
  z_stream stream_{};
  std::array<Bytef, 16384> piece_{};
};

Packer::Packer() : stream_(std::make_unique<Stream>()) {}

Packer::~Packer() = default;

void Packer::Add(std::string_view bytes) {
  stream_->Deflate(bytes, Z_NO_FLUSH);
  size_ += bytes.size();
}

Blob Packer::Finish() {
  stream_->Deflate({}, Z_FINISH);
  return std::move(stream_->Packed);
}

Blob Packed(std::string_view bytes) {
  Packer packer;
  packer.Add(bytes);
  Blob packed = packer.Finish();
  // Equal lengths would tell a reader that the bytes are not deflated.
  return packed.size() < bytes.size() ? packed : Blob(bytes.begin(), bytes.end());
}

Unpacking Unpack(const Blob& data, std::int64_t size, std::string& bytes) {
  bytes.clear();
  if (size < 0) {
    return Unpacking::Damaged;
  }
  const auto whole = static_cast<std::size_t>(size);
  if (whole > LargestEntry || data.size() > LargestEntry) {
    return Unpacking::TooLarge;
  }
  if (data.size() == whole) {
    bytes.assign(data.begin(), data.end());
    return Unpacking::Done;
  }
  const Unpacking result = Inflate(data, whole, bytes);
  if (result != Unpacking::Done) {
    bytes.clear();
  }
  return result;
}

std::string BeginningOf(const Blob& start, bool isDeflated, std::size_t most) {
  std::string bytes;
  if (isDeflated) {
    InflateStream(start).Read(bytes, most);
  } else {
    bytes.assign(start.begin(), start.begin() + static_cast<std::ptrdiff_t>(std::min(most, start.size())));
  }
  return bytes;
}

class EntryComparison::Stream {
 public:
  Stream(const Blob& data, bool isDeflated) : isDeflated_(isDeflated) {
    // zlib reads only, but has no const.
    stream_.next_in = const_cast<Bytef*>(data.data());
    stream_.avail_in = static_cast<uInt>(data.size());
    if (inflateInit(&stream_) != Z_OK) {
      throw std::bad_alloc();
    }
  }
  ~Stream() { inflateEnd(&stream_); }
  Stream(const Stream&) = delete;
  Stream& operator=(const Stream&) = delete;

  /// Up to `most` further bytes; none at the end, or at a fault.
  std::string_view Next(std::size_t most) {
    if (!isDeflated_) {
      const auto* next = reinterpret_cast<const char*>(stream_.next_in);
      const std::size_t length = std::min<std::size_t>(most, stream_.avail_in);
      stream_.next_in += length;
      stream_.avail_in -= static_cast<uInt>(length);
      return {next, length};
    }
    const std::size_t room = std::min(most, piece_.size());
    stream_.next_out = piece_.data();
    stream_.avail_out = static_cast<uInt>(room);
    isWhole_ = inflate(&stream_, Z_NO_FLUSH) == Z_STREAM_END && stream_.avail_in == 0;
    return {reinterpret_cast<const char*>(piece_.data()), room - stream_.avail_out};
  }

  /// True if the entry ends here, as it should. To be asked once.
  bool IsAtEnd() {
    if (!isDeflated_) {
      return stream_.avail_in == 0;
    }
    return isWhole_ || (Next(1).empty() && isWhole_);  // what ends a stream may follow its last byte
  }

 private:
  const bool isDeflated_;
  z_stream stream_{};
  std::array<Bytef, 16384> piece_{};
  bool isWhole_ = false;
};

EntryComparison::EntryComparison(const Blob& data, std::int64_t size)
    : stream_(std::make_unique<Stream>(data, static_cast<std::int64_t>(data.size()) != size)), size_(size) {}

EntryComparison::~EntryComparison() = default;

void EntryComparison::Add(std::string_view bytes) {
  added_ += static_cast<std::int64_t>(bytes.size());
  while (isEqual_ && !bytes.empty()) {
    const std::string_view next = stream_->Next(bytes.size());
    isEqual_ = !next.empty() && bytes.starts_with(next);
    bytes.remove_prefix(std::min(next.size(), bytes.size()));
  }
}

bool EntryComparison::IsEqual() {
  return isEqual_ && added_ == size_ && stream_->IsAtEnd();
}
