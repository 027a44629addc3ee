#include "check/SystemChecks.h"

#include <algorithm>
#include <utility>

#include "archive/copies/CopyNames.h"
#include "core/line/CommPortSetting.h"
#include "core/line/EnumPorts.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

/// Nothing of the program is older.
constexpr const char* EarliestTime = "2013-05-21";

struct CheckedDatabase {
  const char* Name;
  const char* Table;
};

CheckedDatabase FileOf(CheckSubject subject) {
  switch (subject) {
    case CheckSubject::Missions:
      return {"scenarios", "Table1"};
    case CheckSubject::Members:
      return {"members", "Members"};
    default:
      return {"games", "Games"};
  }
}

std::string Joined(const std::vector<std::string>& texts) {
  std::string joined;
  for (const std::string& text : texts) {
    joined.append(joined.empty() ? "" : ", ").append(text);
  }
  return joined;
}

}  // namespace

std::string SystemChecks::Text(OwnText text, std::initializer_list<std::string_view> values) const {
  return Filled(parts_.Strings.Text(text), values);
}

std::vector<CheckItem> SystemChecks::Look(CheckSubject subject, const KeepOn& keepOn) const {
  Items items;
  try {
    items = LookAt(subject, keepOn);
  } catch (const RuntimeError& error) {
    items = {{subject, false, Text(OwnText::CheckUnknown, {error.what()})}};
  }
  for (CheckItem& item : items) {
    item.Text = WithoutUser(item.Text, parts_.Computer.HomeFolder(), parts_.Computer.UserName());
  }
  return items;
}

SystemChecks::Items SystemChecks::LookAt(CheckSubject subject, const KeepOn& keepOn) const {
  const auto found = [&](const std::string& what, OwnText missing) {
    return what.empty() ? CheckItem{subject, false, Text(missing)} : CheckItem{subject, true, what};
  };
  switch (subject) {
    case CheckSubject::Ports:
      return Ports(keepOn);
    case CheckSubject::BaseUnit:
      return {Port(subject, CommPortSetting(parts_.Ini, parts_.Devices).Number())};
    case CheckSubject::Reader:
      return {Port(subject, parts_.ReaderPort())};
    case CheckSubject::WordProcessor:
      return {found(parts_.HasWordProcessor() ? "LibreOffice Writer" : "", OwnText::CheckWordMissing)};
    case CheckSubject::Printer:
      return {Printer(keepOn)};
    case CheckSubject::Chinese:
      return {found(parts_.ChineseLetters(), OwnText::CheckNoChinese)};
    case CheckSubject::Screens:
      return {Screens()};
    case CheckSubject::Disk:
      return {Disk()};
    case CheckSubject::Clock:
      return {Clock()};
    case CheckSubject::Missions:
    case CheckSubject::Members:
    case CheckSubject::Games:
      return DatabaseOf(subject, keepOn);
  }
  return {};
}

SystemChecks::Items SystemChecks::Ports(const KeepOn& keepOn) const {
  std::vector<std::string> devices = parts_.Devices.Names();
  for (const auto& [key, device] : parts_.Ini.ReadSection("ports")) {
    if (!device.empty() && parts_.Devices.Exists(device) &&
        std::find(devices.begin(), devices.end(), device) == devices.end()) {
      devices.push_back(device);
    }
  }
  if (devices.empty()) {
    return {{CheckSubject::Ports, false, Text(OwnText::CheckNoPort)}};
  }
  const std::vector<DeviceUser> users = parts_.Computer.UsersOf(devices, keepOn);
  Items items;
  for (const std::string& device : devices) {
    std::vector<std::string> holders;
    for (const DeviceUser& user : users) {
      if (user.Device == device) {
        holders.push_back(user.Program);
      }
    }
    if (!parts_.Computer.MayUse(device)) {
      items.push_back({CheckSubject::Ports, false, Text(OwnText::CheckPortForbidden, {device})});
    } else if (!holders.empty()) {
      items.push_back({CheckSubject::Ports, false, Text(OwnText::CheckPortHeld, {device, Joined(holders)})});
    } else {
      items.push_back({CheckSubject::Ports, true, device});
    }
  }
  return items;
}

CheckItem SystemChecks::Port(CheckSubject subject, std::int16_t number) const {
  const EnumPorts ports(parts_.Ini, parts_.Devices);
  const std::string text = std::to_string(number);
  return ports.PortExists(number)
             ? CheckItem{subject, true, Text(OwnText::CheckPortIs, {text, ports.DeviceOf(number)})}
             : CheckItem{subject, false, Text(OwnText::CheckPortMissing, {text})};
}

CheckItem SystemChecks::Printer(const KeepOn& keepOn) const {
  const std::vector<std::string> printers = parts_.Computer.Printers(keepOn);
  return printers.empty() ? CheckItem{CheckSubject::Printer, false, Text(OwnText::CheckNoPrinter)}
                          : CheckItem{CheckSubject::Printer, true, Joined(printers)};
}

CheckItem SystemChecks::Screens() const {
  const std::vector<std::string> screens = parts_.Screens();
  return screens.size() > 1 ? CheckItem{CheckSubject::Screens, true, Joined(screens)}
                            : CheckItem{CheckSubject::Screens, false, Text(OwnText::CheckOneScreen)};
}

CheckItem SystemChecks::Disk() const {
  constexpr std::uint64_t bytesOfMegabyte = 1'000'000;
  const std::uint64_t free = parts_.Disk.FreeSpace(parts_.UserDataFolder) / bytesOfMegabyte;
  const bool isFine = free >= LeastFreeMegabytes;
  return {CheckSubject::Disk, isFine,
          Text(isFine ? OwnText::CheckDiskFree : OwnText::CheckDiskFull, {std::to_string(free)})};
}

CheckItem SystemChecks::Clock() const {
  const std::string now = parts_.Time.Now();
  const std::vector<BackupCopy> copies = CopiesIn(parts_.Disk, parts_.UserDataFolder + "/backups");
  const bool isFine =
      now >= EarliestTime &&
      std::none_of(copies.begin(), copies.end(), [&](const BackupCopy& copy) { return copy.Time > now; });
  return {CheckSubject::Clock, isFine, isFine ? now : Text(OwnText::CheckClockWrong, {now})};
}

SystemChecks::Items SystemChecks::DatabaseOf(CheckSubject subject, const KeepOn& keepOn) const {
  const CheckedDatabase file = FileOf(subject);
  const std::string path = parts_.UserDataFolder + "/" + file.Name + ".mdb";
  if (subject == CheckSubject::Games && !parts_.Disk.FileExists(path)) {
    return {{subject, true, Text(OwnText::CheckNoCopy)}};  // no game was kept
  }
  try {
    const std::unique_ptr<Database> database = parts_.Databases.OpenDatabase(path);
    if (!database->CheckWhole(keepOn)) {
      return {};
    }
    const std::int64_t rows =
        WholeNumber(database->Statements(), "SELECT count(*) FROM " + std::string(file.Table));
    return {{subject, true, Text(OwnText::CheckRows, {std::to_string(rows), LastCopyOf(file.Name)})}};
  } catch (const RuntimeError& error) {
    return {{subject, false, Text(OwnText::CheckDamaged, {NameOf(subject, parts_.Strings), error.what()})}};
  }
}

std::string SystemChecks::LastCopyOf(const std::string& database) const {
  std::string last;
  for (const BackupCopy& copy : CopiesIn(parts_.Disk, parts_.UserDataFolder + "/backups")) {
    if (copy.Database == database) {
      last = std::max(last, copy.Time);
    }
  }
  return last.empty() ? Text(OwnText::CheckNoCopy) : last;
}
