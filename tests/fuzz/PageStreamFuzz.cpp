#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

#include "web/PageStream.h"
#include "web/server/ServedPages.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

struct Reading {
  std::vector<PageFrame> Frames;
  bool Broken = false;

  bool operator==(const Reading&) const = default;
};

/// Reads the stream in pieces of that many bytes.
Reading FramesIn(std::string_view bytes, std::size_t piece) {
  PageFrameReader reader;
  Reading reading;
  while (!bytes.empty()) {
    const std::string_view next = bytes.substr(0, piece);
    reader.Add(next);
    bytes.remove_prefix(next.size());
    while (auto frame = reader.Next()) {
      reading.Frames.push_back(std::move(*frame));
    }
  }
  reading.Broken = reader.Broken();
  return reading;
}

void CheckReports(std::string_view bytes) {
  PageReportReader reader;
  reader.Add(bytes);
  std::string again;
  while (const auto report = reader.Next()) {
    Require(report->Number <= 65535);
    again += EncodeReport(*report);
  }
  Require(bytes.starts_with(again));
}

}  // namespace

/// Both streams between the program and the one that serves its pages. The first byte says how the orders are
/// torn.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) {
    return 0;
  }
  const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
  const Reading reading = FramesIn(bytes, std::max<std::size_t>(bytes.size(), 1));
  Require(FramesIn(bytes, std::size_t{data[0]} + 1) == reading);
  std::string again;
  ServedPages pages;
  for (const PageFrame& frame : reading.Frames) {
    again += EncodeFrame(frame);
    Require(pages.Take(frame));
  }
  Require(bytes.starts_with(again));
  Require(pages.Bytes() <= size && pages.Count() <= reading.Frames.size());
  CheckReports(bytes);
  return 0;
}
