#include "check/SystemChecks.h"

#include <algorithm>
#include <chrono>
#include <ctime>
#include <iomanip>
#include <sstream>
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

/// The day before that of the package's version, which is told in another time zone: "2026-11-19" for
/// "... (3.54+20261120.1203)". Empty without such a version.
std::string DayBeforeRelease(const std::string& release) {
  constexpr std::size_t digits = 8;
  const std::size_t plus = release.find('+');
  const std::string day = plus == std::string::npos ? std::string() : release.substr(plus + 1, digits);
  if (day.size() != digits || day.find_first_not_of("0123456789") != std::string::npos) {
    return {};
  }
  using std::chrono::year_month_day;
  const auto number = [&day](std::size_t start, std::size_t count) {
    return std::stoi(day.substr(start, count));
  };
  const year_month_day made(std::chrono::year(number(0, 4)),
                            std::chrono::month(static_cast<unsigned>(number(4, 2))),
                            std::chrono::day(static_cast<unsigned>(number(6, 2))));
  if (!made.ok()) {
    return {};
  }
  const year_month_day before(std::chrono::sys_days(made) - std::chrono::days(1));
  const auto twoDigits = [](unsigned value) { return (value < 10 ? "0" : "") + std::to_string(value); };
  return std::to_string(static_cast<int>(before.year())) + "-" +
         twoDigits(static_cast<unsigned>(before.month())) + "-" +
         twoDigits(static_cast<unsigned>(before.day()));
}

/// An hour after `stamp` ("YYYY-MM-DD HH:MM:SS"), by which clocks are put back in autumn: "2026-10-25
/// 02:59:00" can be younger than "2026-10-25 02:01:00". Without a date the same text.
std::string AnHourAfter(const std::string& stamp) {
  std::tm time{};
  std::istringstream text(stamp);
  text >> std::get_time(&time, "%Y-%m-%d %H:%M:%S");
  if (text.fail()) {
    return stamp;
  }
  const std::time_t later = timegm(&time) + std::chrono::seconds(std::chrono::hours(1)).count();
  std::ostringstream result;
  result << std::put_time(gmtime_r(&later, &time), "%Y-%m-%d %H:%M:%S");
  return result.str();
}

/// True for a serial port of the computer's own, which nobody can unplug.
bool IsBoardPort(const std::string& device) {
  return device.starts_with("/dev/ttyS");
}

std::string NameIn(const std::string& path) {
  return path.substr(path.rfind('/') + 1);
}

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
      return {Port(subject, CommPortSetting(parts_.Ini, parts_.Devices).Number(), keepOn)};
    case CheckSubject::Reader:
      return {Reader(keepOn)};
    case CheckSubject::WordProcessor:
      return {Word()};
    case CheckSubject::Printer:
      return {Printer(keepOn)};
    case CheckSubject::Chinese:
      return {found(parts_.ChineseLetters(), OwnText::CheckNoChinese)};
    case CheckSubject::Screens:
      return {Screens()};
    case CheckSubject::Disk:
      return Disk();
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
  items.reserve(devices.size());
  for (const std::string& device : devices) {
    items.push_back(Device(CheckSubject::Ports, device, device, users));
  }
  return items;
}

CheckItem SystemChecks::Device(CheckSubject subject, const std::string& device, const std::string& fineText,
                               const std::vector<DeviceUser>& users) const {
  if (!parts_.Computer.MayUse(device)) {
    return {
        subject, false,
        Text(IsBoardPort(device) ? OwnText::CheckBoardPortForbidden : OwnText::CheckPortForbidden, {device})};
  }
  std::vector<std::string> holders;
  for (const DeviceUser& user : users) {
    if (user.Device == device) {
      holders.push_back(user.Program);
    }
  }
  return holders.empty() ? CheckItem{subject, true, fineText}
                         : CheckItem{subject, false, Text(OwnText::CheckPortHeld, {device, Joined(holders)})};
}

CheckItem SystemChecks::Port(CheckSubject subject, std::int16_t number, const KeepOn& keepOn) const {
  const EnumPorts ports(parts_.Ini, parts_.Devices);
  const std::string text = std::to_string(number);
  if (!ports.PortExists(number)) {
    return {subject, false, Text(OwnText::CheckPortMissing, {text})};
  }
  const std::string device = ports.DeviceOf(number);
  return Device(subject, device, Text(OwnText::CheckPortIs, {text, device}),
                parts_.Computer.UsersOf({device}, keepOn));
}

CheckItem SystemChecks::Reader(const KeepOn& keepOn) const {
  const std::optional<std::int16_t> port = parts_.ReaderPort();
  if (!port) {
    return {CheckSubject::Reader, false, Text(OwnText::CheckNoReader)};
  }
  if (const CommPortSetting setting(parts_.Ini, parts_.Devices); setting.Number() == *port) {
    return {CheckSubject::Reader, false, Text(OwnText::CheckReaderShares, {std::to_string(*port)})};
  }
  return Port(CheckSubject::Reader, *port, keepOn);
}

CheckItem SystemChecks::Word() const {
  constexpr CheckSubject subject = CheckSubject::WordProcessor;
  switch (parts_.WordProcessor()) {
    case WordFinding::Missing:
      return {subject, false, Text(OwnText::CheckWordMissing)};
    case WordFinding::Untried:
      return {subject, false, Text(OwnText::CheckWordUntried)};
    case WordFinding::Ended:
      return {subject, false, Text(OwnText::CheckWordEnded)};
    case WordFinding::Ready:
      break;
  }
  return {subject, true, "LibreOffice Writer"};
}

CheckItem SystemChecks::Printer(const KeepOn& keepOn) const {
  try {
    const std::vector<std::string> printers = parts_.Computer.Printers(keepOn);
    return printers.empty() ? CheckItem{CheckSubject::Printer, false, Text(OwnText::CheckNoPrinter)}
                            : CheckItem{CheckSubject::Printer, true, Joined(printers)};
  } catch (const RuntimeError& error) {
    return {CheckSubject::Printer, false, Text(OwnText::CheckPrintingSilent, {error.what()})};
  }
}

CheckItem SystemChecks::Screens() const {
  const std::vector<std::string> screens = parts_.Screens();
  return screens.size() > 1 ? CheckItem{CheckSubject::Screens, true, Joined(screens)}
                            : CheckItem{CheckSubject::Screens, false, Text(OwnText::CheckOneScreen)};
}

SystemChecks::Items SystemChecks::Disk() const {
  constexpr std::uint64_t bytesOfMegabyte = 1'000'000;
  Items items;
  for (const char* name :
       {"", "/backups", "/scenarios.mdb", "/members.mdb", "/games.mdb", "/tessarine.ini"}) {
    const std::string path = parts_.UserDataFolder + name;
    const bool isThere = parts_.Disk.FolderExists(path) || parts_.Disk.FileExists(path);
    if (isThere && !parts_.Computer.MayUse(path)) {
      items.push_back({CheckSubject::Disk, false, Text(OwnText::CheckNotWritable, {path})});
    }
  }
  const std::uint64_t free = parts_.Disk.FreeSpace(parts_.UserDataFolder) / bytesOfMegabyte;
  const bool isFine = free >= LeastFreeMegabytes;
  items.push_back({CheckSubject::Disk, isFine,
                   Text(isFine ? OwnText::CheckDiskFree : OwnText::CheckDiskFull, {std::to_string(free)})});
  return items;
}

CheckItem SystemChecks::Clock() const {
  const std::string now = parts_.Time.Now();
  if (now < std::max(std::string(EarliestTime), DayBeforeRelease(parts_.Release))) {
    return {CheckSubject::Clock, false, Text(OwnText::CheckClockEarly, {now})};
  }
  if (HasDataAfter(now)) {
    return {CheckSubject::Clock, false, Text(OwnText::CheckClockWrong, {now})};
  }
  // A computer without a network has no other clock, so that is no fault.
  const bool isAlone = !parts_.Computer.ClockIsSynchronised().value_or(true);
  return {CheckSubject::Clock, true, isAlone ? Text(OwnText::CheckClockUnsynchronised, {now}) : now};
}

bool SystemChecks::HasDataAfter(const std::string& now) const {
  const std::string latest = AnHourAfter(now);
  const std::vector<BackupCopy> copies = CopiesIn(parts_.Disk, parts_.UserDataFolder + "/backups");
  if (std::any_of(copies.begin(), copies.end(), [&](const BackupCopy& copy) { return copy.Time > latest; })) {
    return true;
  }
  for (const CheckSubject subject : {CheckSubject::Missions, CheckSubject::Members, CheckSubject::Games}) {
    const std::string path = parts_.UserDataFolder + "/" + FileOf(subject).Name + ".mdb";
    if (parts_.Disk.FileExists(path) && parts_.Disk.TimeOfChange(path) > latest) {
      return true;
    }
  }
  return false;
}

SystemChecks::Items SystemChecks::DatabaseOf(CheckSubject subject, const KeepOn& keepOn) const {
  const CheckedDatabase file = FileOf(subject);
  const std::string usual = parts_.UserDataFolder + "/" + file.Name + ".mdb";
  if (subject == CheckSubject::Games) {
    if (!parts_.Disk.FileExists(usual)) {
      return {{subject, true, Text(OwnText::CheckNoCopy)}};  // no game was kept
    }
    const CheckItem games = DatabaseAt(subject, usual, file.Table, keepOn);
    return games.Text.empty() ? Items() : Items{games};
  }
  const std::string inUse = parts_.PathInUse(subject);
  Items items = {DatabaseAt(subject, inUse, file.Table, keepOn)};
  if (items.front().Text.empty()) {
    return {};
  }
  for (CheckItem& item : PutAside(subject, usual, inUse, keepOn)) {
    items.push_back(std::move(item));
  }
  return items;
}

CheckItem SystemChecks::DatabaseAt(CheckSubject subject, const std::string& path, const char* table,
                                   const KeepOn& keepOn) const {
  try {
    const std::unique_ptr<Database> database = parts_.Databases.OpenDatabase(path);
    if (!database->CheckWhole(keepOn)) {
      return {subject, false, {}};
    }
    const std::int64_t rows =
        WholeNumber(database->Statements(), "SELECT count(*) FROM " + std::string(table));
    const std::string name = NameIn(path);
    return {subject, true,
            Text(OwnText::CheckRows, {std::to_string(rows), LastCopyOf(name.substr(0, name.rfind('.')))})};
  } catch (const RuntimeError& error) {
    return {subject, false, Text(OwnText::CheckDamaged, {NameOf(subject, parts_.Strings), error.what()})};
  }
}

SystemChecks::Items SystemChecks::PutAside(CheckSubject subject, const std::string& path,
                                           const std::string& inUse, const KeepOn& keepOn) const {
  if (NameIn(path) == NameIn(inUse) || !parts_.Disk.FileExists(path)) {
    return {};
  }
  try {
    parts_.Databases.OpenDatabase(path)->CheckWhole(keepOn);
    return {};  // the next start uses it again
  } catch (const RuntimeError& error) {
    return {{subject, false, Text(OwnText::CheckPutAside, {NameIn(path), error.what(), NameIn(inUse)})}};
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
