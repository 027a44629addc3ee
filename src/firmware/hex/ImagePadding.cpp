#include "firmware/hex/ImagePadding.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <utility>

#include "firmware/hex/HexText.h"
#include "firmware/hex/ImageLines.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t BlockLines = 16;
constexpr std::int32_t LineBytes = ImageLine::Bytes;
constexpr std::int32_t BlockBytes = 256;

/// Address after the last line: beyond every device.
constexpr std::int32_t NoLine = 20'000'000;

/// Fill before data, and fill behind it, which has no blank at its end.
constexpr std::string_view LeadingFill = " FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 ";
constexpr std::string_view TrailingFill = " FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00";

constexpr std::int32_t LineStart(std::int32_t address) {
  return address & ~(LineBytes - 1);
}

std::string_view DataOf(std::string_view line, std::size_t from, std::size_t count) {
  return Middle(line, ImageLine::DataColumn + from, count);
}

/// Fill for `bytes` bytes, each with a blank behind.
std::string FillPattern(std::size_t bytes) {
  std::string pattern;
  for (std::size_t i = 0; i < bytes; ++i) {
    pattern += ImageLine::FillAt(i) == 0 ? "00 " : "FF ";
  }
  return pattern;
}

bool IsBlank(std::string_view line) {
  constexpr std::string_view erased = "FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF FF";
  const std::string_view data = DataOf(line, 0, erased.size());
  return data == erased || data == TrailingFill.substr(1);
}

/// Makes the blocks one after the other. Members are named as the steps use them: `cur` is the address of the
/// line at hand and `next` that of the line after it, `block` is the block being made and `k` its length.
class Padding {
 public:
  explicit Padding(std::vector<std::string> lines) : lines_(std::move(lines)) {}

  std::string Run() {
    std::string image;
    while (i_ < lines_.size()) {
      StartBlock();
      FillBeforeData();
      PlaceFirstLine();
      FillBlock();
      TakeStartOfNextLine();
      if (!std::all_of(block_.begin(), block_.end(), IsBlank)) {
        for (const std::string& line : block_) {
          image += line;
          image += '\n';
        }
      }
    }
    return image;
  }

 private:
  std::int32_t AddressOf(std::size_t i) const {
    return static_cast<std::int32_t>(ImageLine::AddressOf(lines_[i]));
  }

  std::int32_t Previous() const { return AddressOf(i_ - 1); }

  void TakeAddresses() {
    cur_ = AddressOf(i_);
    next_ = i_ + 1 < lines_.size() ? AddressOf(i_ + 1) : NoLine;
  }

  /// Characters of data that a line has before the next multiple of 16 addresses.
  std::size_t Overhang() const { return static_cast<std::size_t>(cur_ % LineBytes) * ImageLine::ByteColumns; }

  bool BeginsWithinPrevious() const { return cur_ > Previous() && cur_ - Previous() < LineBytes; }

  void StartBlock() {
    k_ = 0;
    filled_ = false;
    TakeAddresses();
    if (i_ + 1 < lines_.size() && Overhang() != 0 && i_ >= 1 && cur_ - Previous() < LineBytes &&
        next_ - cur_ < LineBytes) {
      ++i_;  // it lies where its neighbours overlap
      TakeAddresses();
    }
  }

  /// When data resumes after a hole, the block begins with fill. `k` is then the slot of the data itself.
  void FillBeforeData() {
    if (cur_ == 0) {
      return;
    }
    if (i_ == 0) {
      throw RuntimeError(Fault::SubscriptOutOfRange,
                         "Subscript out of range: the program memory does not begin at address 0");
    }
    if (cur_ - Previous() <= LineBytes) {
      return;
    }
    const std::int32_t start = cur_ & ~(BlockBytes - 1);
    k_ = static_cast<std::size_t>(cur_ % BlockBytes / LineBytes);
    for (std::size_t j = 0; j <= k_; ++j) {
      block_[j] = Address(start + LineBytes * static_cast<std::int32_t>(j)).append(LeadingFill);
    }
  }

  void PlaceFirstLine() {
    const std::size_t overhang = Overhang();
    if (overhang == 0) {
      return;
    }
    const std::string fill = FillPattern(overhang / ImageLine::ByteColumns);
    std::string& line = lines_[i_];
    const std::string start(DataOf(line, 0, overhang));
    const std::string rest(DataOf(line, overhang, ImageLine::DataColumns - overhang));
    if (BeginsWithinPrevious()) {
      GiveStartToPrevious(overhang);
      cur_ = LineStart(cur_) + LineBytes;
      line = Address(cur_) + ' ' + rest + fill;
    } else if (cur_ - Previous() > LineBytes) {
      block_[k_++] = Address(LineStart(cur_)) + ' ' + fill + start;
      cur_ = LineStart(cur_) + LineBytes;
      const std::string end(DataOf(line, ImageLine::DataColumns - overhang, overhang));
      line = Address(cur_) + ' ' + rest + end;
    }
  }

  void FillBlock() {
    while (k_ < BlockLines) {
      block_[k_++] = lines_[i_++];
      while (k_ < BlockLines && (next_ - cur_ > LineBytes || filled_)) {
        cur_ += LineBytes;
        block_[k_++] = Address(cur_).append(TrailingFill);
        filled_ = true;  // later data goes into a new block
      }
      if (k_ < BlockLines) {
        TakeAddresses();
        JoinToPrevious();
      }
    }
  }

  /// A line that begins within the previous one gives it its start, and keeps its rest for the next multiple
  /// of 16 addresses.
  void JoinToPrevious() {
    const std::size_t overhang = Overhang();
    if (overhang == 0 || !BeginsWithinPrevious()) {
      return;
    }
    GiveStartToPrevious(overhang);
    block_[k_ - 1] = lines_[i_ - 1];
    const bool isLastSlot = k_ == BlockLines - 1;
    const std::string tail = isLastSlot && i_ + 1 < lines_.size()
                                 ? std::string(DataOf(lines_[i_ + 1], 0, overhang))
                                 : FillPattern(overhang / ImageLine::ByteColumns);
    const std::string rest(DataOf(lines_[i_], overhang, ImageLine::DataColumns - overhang));
    lines_[i_] = Address(LineStart(cur_) + LineBytes) + ' ' + rest + tail;
  }

  void TakeStartOfNextLine() {
    if (i_ == lines_.size()) {
      return;
    }
    const std::int32_t address = AddressOf(i_);
    if (address > cur_ && address - cur_ < LineBytes) {
      GiveStartToPrevious(static_cast<std::size_t>(address % LineBytes) * ImageLine::ByteColumns);
      block_[k_ - 1] = lines_[i_ - 1];
    }
  }

  void GiveStartToPrevious(std::size_t overhang) {
    std::string& previous = lines_[i_ - 1];
    previous = previous.substr(0, ImageLine::Columns - overhang).append(DataOf(lines_[i_], 0, overhang));
  }

  static std::string Address(std::int32_t address) {
    return FormatHex(static_cast<std::uint32_t>(address), ImageLine::AddressDigits);
  }

  std::vector<std::string> lines_;
  std::array<std::string, BlockLines> block_;
  std::size_t i_ = 0;  ///< the line at hand
  std::size_t k_ = 0;
  std::int32_t cur_ = 0;
  std::int32_t next_ = 0;
  bool filled_ = false;
};

}  // namespace

std::string PaddedImage(std::vector<std::string> lines) {
  if (lines.empty()) {
    throw RuntimeError(Fault::PastEndOfFile, "Input past end of file: there is no program memory data");
  }
  SortImageLines(lines, 0, static_cast<std::ptrdiff_t>(lines.size()) - 1);
  return Padding(std::move(lines)).Run();
}

void PadProgramImage(Files& files, const std::string& path) {
  const std::string image = files.Read(path);
  std::vector<std::string> lines;
  for (LineReader reader(image); !reader.AtEnd();) {
    lines.emplace_back(reader.Next());
  }
  files.Replace(path, PaddedImage(std::move(lines)));
}
