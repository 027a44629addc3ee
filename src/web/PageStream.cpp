#include "web/PageStream.h"

#include <algorithm>
#include <cstring>
#include <utility>

#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t FrameHead = 7;
constexpr std::size_t ReportLength = 5;
constexpr std::size_t WorthMoving = 64UL * 1024;

void AppendNumber(std::string& bytes, std::size_t number, int count) {
  for (int i = 0; i < count; ++i) {
    bytes += static_cast<char>(number & 0xFFU);
    number >>= 8U;
  }
}

std::uint32_t NumberAt(std::string_view bytes, std::size_t at, std::size_t count) {
  std::uint32_t number = 0;
  for (std::size_t i = count; i > 0; --i) {
    number = (number << 8U) | static_cast<unsigned char>(bytes[at + i - 1]);
  }
  return number;
}

void Wipe(std::string& bytes) {
  explicit_bzero(bytes.data(), bytes.size());
}

bool MayBegin(char order, std::size_t path, std::size_t body) {
  switch (static_cast<PageOrder>(order)) {
    case PageOrder::Put:
      return path > 0 && path <= LongestPagePath && body <= LongestPageBody;
    case PageOrder::Remove:
      return path > 0 && path <= LongestPagePath && body == 0;
    case PageOrder::Show:
      return path == 0 && body == 0;
  }
  return false;
}

bool InRange(char kind, std::uint32_t number) {
  switch (static_cast<ReportKind>(kind)) {
    case ReportKind::Port:
      return number >= 1 && number <= 65535;
    case ReportKind::Visitors:
      return number <= MostVisitors;
    case ReportKind::Answer:
      return number <= 1;
  }
  return false;
}

}  // namespace

bool IsPagePath(std::string_view path) {
  const auto allowed = [](char letter) {
    return (letter >= 'a' && letter <= 'z') || (letter >= '0' && letter <= '9') || letter == '/' ||
           letter == '-' || letter == '.';
  };
  return !path.empty() && path.size() <= LongestPagePath && path.front() == '/' &&
         std::ranges::all_of(path, allowed) && path.find("..") == std::string_view::npos &&
         path.find("//") == std::string_view::npos;
}

std::string EncodeFrame(const PageFrame& frame) {
  const bool hasPath = frame.Order != PageOrder::Show;
  if (!MayBegin(static_cast<char>(frame.Order), frame.Path.size(), frame.Body.size()) ||
      (hasPath && !IsPagePath(frame.Path))) {
    throw RuntimeError(Fault::InvalidProcedureCall, "No page: " + frame.Path);
  }
  std::string bytes(1, static_cast<char>(frame.Order));
  bytes.reserve(FrameHead + frame.Path.size() + frame.Body.size());
  AppendNumber(bytes, frame.Path.size(), 2);
  AppendNumber(bytes, frame.Body.size(), 4);
  bytes += frame.Path;
  bytes += frame.Body;
  return bytes;
}

void PageFrameReader::Add(std::string_view bytes) {
  if (broken_) {
    return;
  }
  if (at_ >= WorthMoving || at_ == bytes_.size()) {
    DropTaken();
  }
  Grow(bytes_.size() + bytes.size());
  bytes_ += bytes;
}

PageFrameReader::~PageFrameReader() {
  Wipe(bytes_);
}

void PageFrameReader::DropTaken() {
  const std::size_t left = bytes_.size() - at_;
  std::memmove(bytes_.data(), bytes_.data() + at_, left);
  explicit_bzero(bytes_.data() + left, at_);
  bytes_.resize(left);
  at_ = 0;
}

void PageFrameReader::Grow(std::size_t size) {
  if (size <= bytes_.capacity()) {
    return;
  }
  std::string larger;
  larger.reserve(std::max(size, 2 * bytes_.capacity()));
  larger = bytes_;
  Wipe(bytes_);
  bytes_ = std::move(larger);
}

std::optional<PageFrame> PageFrameReader::Next() {
  if (bytes_.size() - at_ < FrameHead) {
    return std::nullopt;
  }
  const std::size_t path = NumberAt(bytes_, at_ + 1, 2);
  const std::size_t body = NumberAt(bytes_, at_ + 3, 4);
  broken_ = !MayBegin(bytes_[at_], path, body);
  if (!broken_ && bytes_.size() - at_ < FrameHead + path + body) {
    return std::nullopt;
  }
  if (!broken_) {
    PageFrame frame{.Order = static_cast<PageOrder>(bytes_[at_]),
                    .Path = bytes_.substr(at_ + FrameHead, path),
                    .Body = bytes_.substr(at_ + FrameHead + path, body)};
    explicit_bzero(bytes_.data() + at_, FrameHead + path + body);
    at_ += FrameHead + path + body;
    if (frame.Order == PageOrder::Show || IsPagePath(frame.Path)) {
      return frame;
    }
    broken_ = true;
  }
  Wipe(bytes_);
  bytes_ = {};
  at_ = 0;
  return std::nullopt;
}

std::string EncodeReport(const PageReport& report) {
  std::string bytes(1, static_cast<char>(report.Kind));
  AppendNumber(bytes, report.Number, 4);
  return bytes;
}

void PageReportReader::Add(std::string_view bytes) {
  if (!broken_) {
    bytes_.erase(0, std::exchange(at_, 0));
    bytes_ += bytes;
  }
}

std::optional<PageReport> PageReportReader::Next() {
  if (broken_ || bytes_.size() - at_ < ReportLength) {
    return std::nullopt;
  }
  const std::uint32_t number = NumberAt(bytes_, at_ + 1, 4);
  broken_ = !InRange(bytes_[at_], number);
  if (broken_) {
    bytes_ = {};
    at_ = 0;
    return std::nullopt;
  }
  const PageReport report{.Kind = static_cast<ReportKind>(bytes_[at_]), .Number = number};
  at_ += ReportLength;
  return report;
}
