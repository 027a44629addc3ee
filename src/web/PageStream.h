#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// The two streams between the program and the one that serves the pages. Down: orders with finished pages.
/// Up: numbers and nothing else.

enum class PageOrder : char {
  Put = 'P',     ///< a page, new or in place of an old one
  Remove = 'R',  ///< a page is no longer served
  Show = 'S'     ///< all orders since the last Show take effect, at once
};

struct PageFrame {
  PageOrder Order = PageOrder::Show;
  std::string Path;  ///< of Put and Remove
  std::string Body;  ///< of Put

  bool operator==(const PageFrame&) const = default;
};

/// What a page may be: the reader refuses everything beyond.
inline constexpr std::size_t LongestPagePath = 64;
inline constexpr std::size_t LongestPageBody = 256UL * 1024;

/// All pages together; enough for 20 games of 40 players twice over.
inline constexpr std::size_t MostPages = 20'000;
inline constexpr std::size_t MostPageBytes = 24UL * 1024 * 1024;

/// True for a path of at most LongestPagePath characters that begins with a slash and has no others than
/// slashes, small letters, digits, hyphens and single points.
bool IsPagePath(std::string_view path);

/// A frame: the order, the length of the path (2 bytes, low byte first), that of the body (4 bytes), then
/// both. Throws RuntimeError 5 for a page that no reader would take.
std::string EncodeFrame(const PageFrame& frame);

/// Takes the frames out of the bytes as they come, and keeps nothing of those that it gave away: in its
/// memory they are wiped.
class PageFrameReader {
 public:
  PageFrameReader() = default;
  ~PageFrameReader();
  PageFrameReader(const PageFrameReader&) = delete;
  PageFrameReader& operator=(const PageFrameReader&) = delete;

  void Add(std::string_view bytes);

  /// The next complete frame; none until more bytes come, and none for ever once the stream is broken.
  std::optional<PageFrame> Next();

  /// A byte came that no frame has there. What came before it was right.
  bool Broken() const { return broken_; }

 private:
  void DropTaken();
  void Grow(std::size_t size);

  std::string bytes_;
  std::size_t at_ = 0;  ///< where the next frame begins
  bool broken_ = false;
};

enum class ReportKind : char {
  Port = 'P',      ///< the port on which the pages are served, 1 to 65535
  Visitors = 'V',  ///< addresses that asked for something within the last minute, at most MostVisitors
  Answer = 'A'     ///< of a trial request: 1 if the pages were answered with, else 0
};

inline constexpr std::uint32_t MostVisitors = 4096;

struct PageReport {
  ReportKind Kind = ReportKind::Visitors;
  std::uint32_t Number = 0;

  bool operator==(const PageReport&) const = default;
};

/// The kind and 4 bytes, low byte first.
std::string EncodeReport(const PageReport& report);

/// Takes the reports out of the bytes as they come.
class PageReportReader {
 public:
  void Add(std::string_view bytes);
  std::optional<PageReport> Next();

  /// A kind that there is not, or a number out of its range.
  bool Broken() const { return broken_; }

 private:
  std::string bytes_;
  std::size_t at_ = 0;  ///< where the next report begins
  bool broken_ = false;
};
