#include <array>
#include <cstdio>

#include "core/text/Filled.h"
#include "firmware/files/FirmwareDescription.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::uint64_t WireBytesOfASecond = 1920;  // 19,200 baud, ten bits a byte

std::string ChecksumText(std::uint32_t checksum) {
  std::array<char, 16> text{};
  std::snprintf(text.data(), text.size(), "%08X", checksum);
  return text.data();
}

/// Collects what looks odd, each with its count.
class Oddities {
 public:
  explicit Oddities(const StringTable& strings) : strings_(strings) {}

  void Add(bool there, OwnText text, const std::string& value = {}) {
    if (there) {
      text_ += (text_.empty() ? "" : "; ") + Filled(strings_.Text(text), {value});
    }
  }
  void AddCount(std::uint64_t count, OwnText text) { Add(count > 0, text, std::to_string(count)); }

  const std::string& Text() const { return text_; }

 private:
  const StringTable& strings_;
  std::string text_;
};

std::string Facts(const FirmwareDescription& file, const StringTable& strings) {
  const std::string bytes = std::to_string(file.Bytes);
  const std::string checksum = ChecksumText(file.Checksum);
  const std::string time = MinutesText(
      static_cast<std::int64_t>((file.WireBytes + WireBytesOfASecond / 2) / WireBytesOfASecond), strings);
  switch (file.Type) {
    case FirmwareFileType::Qvm:
      return Filled(strings.Text(OwnText::QvmFacts), {std::to_string(file.Lines), bytes, checksum, time});
    case FirmwareFileType::Qvm2:
      return file.LoadFault.empty()
                 ? Filled(strings.Text(OwnText::Qvm2Facts),
                          {std::to_string(file.Pages), std::to_string(file.Rows), bytes, checksum, time})
                 : Filled(strings.Text(OwnText::UnloadableFacts), {bytes, checksum, file.LoadFault});
    default:
      return Filled(strings.Text(OwnText::NoKindFacts), {bytes, checksum});
  }
}

}  // namespace

std::string MinutesText(std::int64_t seconds, const StringTable& strings) {
  return Filled(strings.Text(OwnText::Minutes), {std::to_string(seconds / 60), std::to_string(seconds % 60)});
}

std::string DescriptionText(const FirmwareDescription& file, const StringTable& strings) {
  Oddities odd(strings);
  odd.Add(file.BareLineFeeds, OwnText::OddLineEnds);
  if (file.Type == FirmwareFileType::Qvm) {
    odd.Add(file.Lines == 0, OwnText::OddNoLines);
    odd.Add(file.Lines == 1, OwnText::OddOneLine);
  }
  odd.AddCount(file.Odd.OddDigits, OwnText::OddDigits);
  odd.AddCount(file.Odd.TooLong, OwnText::OddLongLines);
  odd.AddCount(file.Odd.ForeignCharacters, OwnText::OddCharacters);
  odd.AddCount(file.OtherLines, OwnText::OddOtherLines);
  odd.AddCount(static_cast<std::uint64_t>(file.RowsOutsidePages), OwnText::OddRows);
  odd.AddCount(static_cast<std::uint64_t>(file.PagesBehindImage), OwnText::OddImageEnd);
  odd.AddCount(file.BytesOutsidePages, OwnText::OddData);
  std::string text = Facts(file, strings);
  if (!odd.Text().empty()) {
    text += '\n' + Filled(strings.Text(OwnText::LooksOdd), {odd.Text()});
  }
  return text;
}

std::string DescribeFile(const Files& disk, const std::string& fileName, const StringTable& strings) {
  try {
    if (fileName.empty() || !disk.FileExists(fileName)) {
      return {};
    }
    const std::uint64_t bytes = disk.FileLen(fileName);
    return bytes > MostDescribedBytes
               ? Filled(strings.Text(OwnText::FirmwareTooLarge), {std::to_string(bytes)})
               : DescriptionText(Describe(fileName, disk.Read(fileName)), strings);
  } catch (const RuntimeError& error) {
    return Filled(strings.Text(OwnText::FirmwareUnreadable), {error.what()});
  }
}
