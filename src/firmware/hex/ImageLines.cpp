#include "firmware/hex/ImageLines.h"

#include <algorithm>
#include <bit>
#include <utility>

#include "firmware/hex/HexText.h"

void ImageLine::Append(std::string& text, std::uint32_t address, const std::uint8_t* sixteenBytes) {
  text += FormatHex(address, AddressDigits);
  text += ' ';
  for (std::size_t i = 0; i < Bytes; ++i) {
    AppendHexByte(text, sixteenBytes[i]);
    text += ' ';
  }
}

std::uint32_t ImageLine::AddressOf(std::string_view line) {
  return HexNumber(line.substr(0, AddressDigits));
}

ImageLine::Data ImageLine::DataOf(std::string_view line) {
  Data data;
  for (std::size_t i = 0; i < Bytes; ++i) {
    data[i] = HexByteAt(line, DataColumn + ByteColumns * i);
  }
  return data;
}

namespace {

/// Quick sort with the middle element as pivot. It recurses into the smaller part only, and a part that it
/// does not get smaller is left to the library: files made for that purpose would take it hours.
class LineSort {
 public:
  LineSort(std::vector<std::string>& lines, std::ptrdiff_t low, std::ptrdiff_t high)
      : lines_(lines), first_(low) {
    keys_.reserve(static_cast<std::size_t>(high - low + 1));
    for (std::ptrdiff_t i = low; i <= high; ++i) {
      keys_.push_back(ImageLine::AddressOf(lines[static_cast<std::size_t>(i)]));
    }
    Sort(0, high - low, static_cast<int>(2 * std::bit_width(keys_.size())));
  }

 private:
  void Sort(std::ptrdiff_t low, std::ptrdiff_t high, int steps) {
    while (low < high) {
      if (steps-- == 0) {
        SortByLibrary(low, high);
        return;
      }
      const auto [left, right] = Part(low, high);
      if (right - low < high - left) {
        Sort(low, right, steps);
        low = left;
      } else {
        Sort(left, high, steps);
        high = right;
      }
    }
  }

  /// Parts the lines at the pivot. Returns the start of the upper part and the end of the lower one.
  std::pair<std::ptrdiff_t, std::ptrdiff_t> Part(std::ptrdiff_t low, std::ptrdiff_t high) {
    const std::uint32_t pivot = Key(low + (high - low) / 2);
    while (low <= high) {
      while (Key(low) < pivot) {
        ++low;
      }
      while (pivot < Key(high)) {
        --high;
      }
      if (low <= high) {
        std::swap(Key(low), Key(high));
        std::swap(Line(low), Line(high));
        ++low;
        --high;
      }
    }
    return {low, high};
  }

  void SortByLibrary(std::ptrdiff_t low, std::ptrdiff_t high) {
    std::vector<std::pair<std::uint32_t, std::string>> part;
    for (std::ptrdiff_t i = low; i <= high; ++i) {
      part.emplace_back(Key(i), std::move(Line(i)));
    }
    std::stable_sort(part.begin(), part.end(),
                     [](const auto& left, const auto& right) { return left.first < right.first; });
    for (std::ptrdiff_t i = low; i <= high; ++i) {
      auto& [key, line] = part[static_cast<std::size_t>(i - low)];
      Key(i) = key;
      Line(i) = std::move(line);
    }
  }

  std::uint32_t& Key(std::ptrdiff_t i) { return keys_[static_cast<std::size_t>(i)]; }
  std::string& Line(std::ptrdiff_t i) { return lines_[static_cast<std::size_t>(first_ + i)]; }

  std::vector<std::string>& lines_;
  std::ptrdiff_t first_;
  std::vector<std::uint32_t> keys_;
};

}  // namespace

void SortImageLines(std::vector<std::string>& lines, std::ptrdiff_t low, std::ptrdiff_t high) {
  if (low < high) {
    LineSort(lines, low, high);
  }
}
