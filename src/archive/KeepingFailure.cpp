#include "archive/KeepingFailure.h"

#include <optional>
#include <string_view>

#include "core/text/Filled.h"

namespace {

std::optional<OwnText> AdviceOn(int number) {
  switch (number) {
    case Fault::DatabaseLocked:
      return OwnText::ArchiveLocked;
    case Fault::DatabaseReadOnly:
    case Fault::DatabaseCannotOpen:
    case Fault::PermissionDenied:
    case Fault::PathAccess:
      return OwnText::ArchiveNotWritable;
    case Fault::DatabaseDiskFull:
    case Fault::DiskFull:
      return OwnText::ArchiveDiskFull;
    case Fault::UnrecognizedDatabase:
      return OwnText::ArchiveDamagedToo;
    case Fault::DatabaseDiskError:
      return OwnText::ArchiveDiskError;
    default:
      return std::nullopt;
  }
}

}  // namespace

bool IsAboutFile(const RuntimeError& failure, const std::string& path) {
  return !path.empty() && std::string_view(failure.what()).find(path) != std::string_view::npos;
}

std::string KeepingFailureText(const RuntimeError& failure, const std::string& path,
                               const StringTable& strings) {
  const std::optional<OwnText> advice = AdviceOn(failure.Number());
  return advice && IsAboutFile(failure, path) ? Filled(strings.Text(*advice), {path}) : failure.what();
}
