// The second half of a take-over: copies of what is in use, and the exchange of the files.

#include <algorithm>
#include <iterator>
#include <memory>
#include <utility>

#include "platform/RuntimeError.h"
#include "takeover/TakeOverMark.h"
#include "takeover/TakeOverNames.h"
#include "takeover/TakeOverWork.h"

namespace {

bool IsSurelyUnmarked(const Files& disk, const std::string& dataFolder) {
  try {
    return !HasTakeOverMark(disk, dataFolder);
  } catch (const RuntimeError&) {
    return false;
  }
}

}  // namespace

TakenOver TakeOverWork::Take(const std::set<OldItem>& wanted, const OnTake& keepOn) {
  std::set<OldItem> items;
  std::set_intersection(wanted.begin(), wanted.end(), ready_.begin(), ready_.end(),
                        std::inserter(items, items.end()));
  TakenOver taken;
  std::vector<std::unique_ptr<WritersHeld>> held;
  try {
    for (const TakenDatabase& database : parts_.Databases) {
      if (items.contains(database.What)) {  // or what others write now would be lost
        held.push_back(std::make_unique<WritersHeld>(database.InUse()));
      }
    }
    const std::optional<std::vector<std::string>> names = Prepare(items, keepOn, taken);
    if (names) {
      Place(*names, keepOn, taken);
    } else {
      taken.What = TakenOver::Stopped;
    }
  } catch (const RuntimeError& error) {
    taken.What = TakenOver::Refused;
    taken.Reason = error.what();
  }
  if (taken.What == TakenOver::Refused || taken.What == TakenOver::Stopped) {
    DropCopies(taken);
  } else {
    ready_.clear();
  }
  return taken;
}

std::optional<std::vector<std::string>> TakeOverWork::Prepare(const std::set<OldItem>& items,
                                                              const OnTake& keepOn, TakenOver& taken) const {
  std::vector<std::string> names;
  for (const TakenDatabase& database : parts_.Databases) {
    if (!items.contains(database.What)) {
      continue;
    }
    if (!keepOn(TakeStep::Keeping)) {
      return std::nullopt;
    }
    const std::optional<std::string> copy =
        database.KeepCopy([&keepOn] { return keepOn(TakeStep::Keeping); });
    if (!copy) {
      return std::nullopt;
    }
    taken.KeptAs.push_back(*copy);
    names.push_back(FileNameIn(database.InUse().Path()));
  }
  if (items.contains(OldItem::Template)) {
    KeepFile(TemplateName, taken);
    names.emplace_back(TemplateName);
  }
  if (items.contains(OldItem::Settings)) {
    KeepFile(SettingsName, taken);
    parts_.Disk.Replace(MadePath(SettingsName), parts_.Disk.Read(parts_.DataFolder + "/" + SettingsName));
    GiveSettings(parts_.Disk, MadePath(SettingsName), settings_.Taken);
    names.emplace_back(SettingsName);
  }
  CheckRoomFor(names);
  if (!keepOn(TakeStep::Placing)) {
    return std::nullopt;
  }
  return names;
}

void TakeOverWork::CheckRoomFor(const std::vector<std::string>& names) const {
  std::uint64_t needed = RoomAfterTakeOver;
  for (const std::string& name : names) {
    needed += parts_.Disk.FileLen(MadePath(name));
  }
  if (parts_.Disk.FreeSpace(parts_.DataFolder) < needed) {
    throw RuntimeError(Fault::DiskFull, "Disk full: " + parts_.DataFolder);
  }
}

void TakeOverWork::KeepFile(const std::string& name, TakenOver& taken) const {
  const std::string path = parts_.DataFolder + "/" + name;
  if (!parts_.Disk.FileExists(path)) {
    return;
  }
  const std::string folder = parts_.DataFolder + "/backups";
  if (!parts_.Disk.FolderExists(folder)) {
    parts_.Disk.CreateFolder(folder);
  }
  std::string now = parts_.Time.Now();
  std::replace(now.begin(), now.end(), ' ', '-');
  now.erase(std::remove(now.begin(), now.end(), ':'), now.end());
  const std::size_t dot = name.rfind('.');
  const std::string start = name.substr(0, dot) + "-" + now + "-replaced";
  std::string copy = start + name.substr(dot);
  for (int number = 2; parts_.Disk.FileExists(std::string(folder).append("/").append(copy)); ++number) {
    copy = std::string(start).append(std::to_string(number)).append(name.substr(dot));
  }
  const std::string bytes = parts_.Disk.Read(path);
  parts_.Disk.Replace(folder + "/" + copy, bytes);
  taken.KeptAs.push_back(copy);
  parts_.Disk.BeginReplace(path, FileReaders::AsBefore);  // throws for a file that must not be replaced
}

void TakeOverWork::Place(const std::vector<std::string>& names, const OnTake& keepOn,
                         TakenOver& taken) const {
  bool isMarked = false;
  const Breathe breathe = [&keepOn] { keepOn(TakeStep::Placing); };  // it is too late to stop
  try {
    MarkTakeOver(parts_.Disk, parts_.DataFolder, names, breathe);
    isMarked = true;
    FinishTakeOver(parts_.Disk, parts_.DataFolder, breathe);
  } catch (const RuntimeError& error) {
    taken.What = TakenOver::Pending;
    taken.Reason = error.what();
    if (!isMarked && IsSurelyUnmarked(parts_.Disk, parts_.DataFolder)) {
      taken.What = TakenOver::Refused;
    }
  }
}

void TakeOverWork::DropCopies(TakenOver& taken) const {
  for (const std::string& copy : std::exchange(taken.KeptAs, {})) {
    try {
      parts_.Disk.Delete(parts_.DataFolder + "/backups/" + copy);
    } catch (const RuntimeError&) {  // a copy more than needed does no harm
    }
  }
}
