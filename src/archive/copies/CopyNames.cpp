#include "archive/copies/CopyNames.h"

#include <algorithm>
#include <string_view>
#include <tuple>

#include "platform/Letters.h"

namespace {

constexpr std::string_view CopyExtension = ".mdb";
constexpr std::string_view KeptMark = "-kept";
constexpr std::string_view ReplacedMark = "-replaced";
constexpr std::string_view WeeklyMark = "-weekly";
constexpr std::string_view TimeInName = "-0000-00-00-000000";

bool IsTimeInName(std::string_view text) {
  return std::equal(text.begin(), text.end(), TimeInName.begin(), TimeInName.end(),
                    [](char letter, char form) { return form == '0' ? IsDigit(letter) : letter == form; });
}

/// "2026-11-21 20:15:00" of "-2026-11-21-201500".
std::string TimeOf(std::string_view text) {
  const auto part = [text](std::size_t start, std::size_t length) {
    return std::string(text.substr(start, length));
  };
  return part(1, 10) + " " + part(12, 2) + ":" + part(14, 2) + ":" + part(16, 2);
}

/// Takes a mark with the number of a second copy of one instant off the end of `name`.
bool TakeMark(std::string_view& name, std::string_view mark) {
  std::string_view rest = name;
  while (!rest.empty() && IsDigit(rest.back())) {
    rest.remove_suffix(1);
  }
  if (!rest.ends_with(mark)) {
    return false;
  }
  rest.remove_suffix(mark.size());
  name = rest;
  return true;
}

std::string_view MarkOf(CopyKind kind) {
  switch (kind) {
    case CopyKind::ByHand:
      return KeptMark;
    case CopyKind::BeforeRestore:
      return ReplacedMark;
    case CopyKind::Weekly:
      return WeeklyMark;
    case CopyKind::FirstChange:
      break;
  }
  return {};
}

}  // namespace

std::optional<BackupCopy> BackupCopyOf(const std::string& file) {
  std::string_view name = file;
  if (!name.ends_with(CopyExtension)) {
    return std::nullopt;
  }
  name.remove_suffix(CopyExtension.size());
  BackupCopy copy;
  copy.File = file;
  if (TakeMark(name, KeptMark)) {
    copy.Kind = CopyKind::ByHand;
  } else if (TakeMark(name, ReplacedMark)) {
    copy.Kind = CopyKind::BeforeRestore;
  } else if (TakeMark(name, WeeklyMark)) {
    copy.Kind = CopyKind::Weekly;
  }
  if (name.size() <= TimeInName.size()) {
    return std::nullopt;
  }
  const std::string_view time = name.substr(name.size() - TimeInName.size());
  if (!IsTimeInName(time)) {
    return std::nullopt;
  }
  copy.Time = TimeOf(time);
  copy.Database = std::string(name.substr(0, name.size() - TimeInName.size()));
  return copy;
}

std::string FreeCopyName(const Files& disk, const std::string& folder, const std::string& database,
                         const std::string& now, CopyKind kind) {
  std::string start = database + "-" + now;
  std::replace(start.begin(), start.end(), ' ', '-');
  start.erase(std::remove(start.begin(), start.end(), ':'), start.end());
  start += MarkOf(kind);
  const auto named = [&start](const std::string& number) {
    return std::string(start).append(number).append(CopyExtension);
  };
  std::string name = named({});
  for (int number = 2; disk.FileExists(folder + "/" + name); ++number) {
    name = named(std::to_string(number));
  }
  return name;
}

std::vector<BackupCopy> CopiesIn(const Files& disk, const std::string& folder) {
  std::vector<BackupCopy> copies;
  for (const std::string& file : disk.FileNames(folder)) {
    if (std::optional<BackupCopy> copy = BackupCopyOf(file)) {
      copies.push_back(std::move(*copy));
    }
  }
  std::sort(copies.begin(), copies.end(), [](const BackupCopy& one, const BackupCopy& other) {
    return std::tie(other.Time, one.File) < std::tie(one.Time, other.File);
  });
  return copies;
}
