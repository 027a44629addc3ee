#include "sound/WaveCheck.h"

#include <algorithm>
#include <array>
#include <limits>
#include <optional>

#include "platform/Letters.h"
#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"

namespace {

constexpr std::uint64_t HeaderBytes = 8;  ///< of a chunk: its name and its size
constexpr std::uint64_t FormTypeBytes = 4;
constexpr std::size_t FormatBufferBytes = 50;

struct Chunk {
  std::uint64_t Offset;  ///< of its contents
  std::uint32_t Size;    ///< of its contents
};

std::uint16_t WordAt(std::string_view bytes, std::size_t at) {
  const auto byte = [&](std::size_t i) {
    return i < bytes.size() ? static_cast<unsigned char>(bytes[i]) : 0U;
  };
  return static_cast<std::uint16_t>(byte(at) | byte(at + 1) << 8U);
}

std::uint32_t LongAt(std::string_view bytes, std::size_t at) {
  return WordAt(bytes, at) | static_cast<std::uint32_t>(WordAt(bytes, at + 2)) << 16U;
}

/// The chunks of a file, of which one piece at a time is in memory.
class Chunks {
 public:
  /// Throws RuntimeError if the file cannot be opened.
  Chunks(const Files& files, const std::string& path)
      : files_(files), path_(path), piece_(files.ReadPart(path, 0, PieceBytes)) {}

  /// Up to `count` bytes at `offset`; none where the disk fails.
  std::string_view Bytes(std::uint64_t offset, std::size_t count) {
    if (offset < pieceOffset_ || offset + count > pieceOffset_ + piece_.size()) {
      piece_.clear();
      pieceOffset_ = offset;
      try {
        piece_ = files_.ReadPart(path_, offset, std::max(PieceBytes, count));
      } catch (const RuntimeError&) {
        return {};  // nothing found there; the caller tells what it looked for
      }
    }
    return std::string_view(piece_).substr(static_cast<std::size_t>(offset - pieceOffset_), count);
  }

  /// The next chunk of that name from `offset` on, which begins before `end`.
  std::optional<Chunk> Find(std::string_view name, std::uint64_t offset, std::uint64_t end) {
    // A file of zeros is made of empty chunks, and a large one must not keep the operator waiting.
    constexpr int mostChunks = 1'000'000;
    for (int passed = 0; offset < end && passed < mostChunks; ++passed) {
      const std::string_view header = Bytes(offset, HeaderBytes);
      if (header.size() < HeaderBytes) {
        return std::nullopt;
      }
      const Chunk chunk{offset + HeaderBytes, LongAt(header, 4)};
      if (header.starts_with(name)) {
        return chunk;
      }
      offset = EndOf(chunk);
    }
    return std::nullopt;
  }

  /// Behind the padding that makes its size even.
  static std::uint64_t EndOf(const Chunk& chunk) { return chunk.Offset + chunk.Size + chunk.Size % 2; }

 private:
  static constexpr std::size_t PieceBytes = 4096;

  const Files& files_;
  const std::string& path_;
  std::string piece_;
  std::uint64_t pieceOffset_ = 0;
};

std::optional<Chunk> FindWave(Chunks& chunks) {
  constexpr std::uint64_t anywhere = std::numeric_limits<std::uint64_t>::max();
  std::optional<Chunk> riff = chunks.Find("RIFF", 0, anywhere);
  while (riff && chunks.Bytes(riff->Offset, FormTypeBytes) != "WAVE") {
    riff = chunks.Find("RIFF", Chunks::EndOf(*riff), anywhere);
  }
  return riff;
}

WaveFormat FormatIn(std::string_view bytes) {
  return {.Tag = WordAt(bytes, 0),
          .Channels = WordAt(bytes, 2),
          .SamplesPerSecond = LongAt(bytes, 4),
          .AverageBytesPerSecond = LongAt(bytes, 8),
          .BlockAlign = WordAt(bytes, 12),
          .BitsPerSample = WordAt(bytes, 14),
          .ExtraSize = WordAt(bytes, 16)};
}

bool IsChipFormat(const WaveFormat& format) {
  return format.BitsPerSample == 8 && format.Channels == 1 &&
         format.SamplesPerSecond == SoundChip::SamplesPerSecond;
}

WaveCheck Failed(WaveError error) {
  return {.Error = error, .Format = {}};
}

WaveCheck CheckChunks(Chunks& chunks) {
  const std::optional<Chunk> wave = FindWave(chunks);
  if (!wave) {
    return Failed(WaveError::NotWave);
  }
  const std::uint64_t end = wave->Offset + wave->Size;
  const std::optional<Chunk> format = chunks.Find("fmt ", wave->Offset + FormTypeBytes, end);
  if (!format) {
    return Failed(WaveError::NoFormat);
  }
  const std::size_t formatBytes = std::min<std::size_t>(format->Size, FormatBufferBytes);
  const std::string_view bytes = chunks.Bytes(format->Offset, formatBytes);
  if (bytes.size() < formatBytes) {
    return Failed(WaveError::CannotReadFormat);
  }
  WaveCheck check;
  check.Format = FormatIn(bytes);
  if (!IsChipFormat(check.Format)) {
    check.Error = WaveError::NotChipFormat;
    return check;
  }
  const std::optional<Chunk> data = chunks.Find("data", Chunks::EndOf(*format), end);
  if (!data) {
    check.Error = WaveError::NoData;
    return check;
  }
  check.DataOffset = data->Offset;
  check.DataLength = data->Size;
  return check;
}

}  // namespace

std::string_view TextOf(WaveError error) {
  static constexpr std::array<std::string_view, 9> texts = {"",
                                                            "Only Mono, 8 bit, 22khz wave files supported.",
                                                            "Unable to open file.",
                                                            "Not a Wave file.",
                                                            "Unable to retrieve format chunk",
                                                            "Error reading format",
                                                            "No Wave File Open",
                                                            "Insufficient memory",
                                                            "Position out of range"};
  return texts.at(static_cast<std::size_t>(error));
}

WaveCheck CheckWave(const Files& files, const std::string& path) {
  std::optional<Chunks> chunks;
  try {
    chunks.emplace(files, path);
  } catch (const RuntimeError&) {
    return Failed(WaveError::CannotOpen);
  }
  return CheckChunks(*chunks);
}

bool IsPlainChipWave(const WaveCheck& check) {
  constexpr std::uint16_t aLaw = 6;
  constexpr std::uint16_t muLaw = 7;
  return check.Error == WaveError::None && check.Format.Tag != aLaw && check.Format.Tag != muLaw;
}

bool IsWave(std::string_view path) {
  constexpr std::string_view extension = "wav";
  const std::string_view end =
      path.size() < extension.size() ? "" : path.substr(path.size() - extension.size());
  return std::equal(end.begin(), end.end(), extension.begin(), extension.end(),
                    [](char letter, char lower) { return LowerAscii(letter) == lower; });
}
