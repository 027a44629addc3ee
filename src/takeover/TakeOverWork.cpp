#include "takeover/TakeOverWork.h"

#include <algorithm>
#include <memory>
#include <string_view>
#include <utility>

#include "core/data/OldConversion.h"
#include "core/text/Filled.h"
#include "platform/Letters.h"
#include "platform/RuntimeError.h"
#include "takeover/TakeOverMark.h"
#include "takeover/TakeOverNames.h"
#include "takeover/TakenRows.h"

namespace {

/// Of copies of the old files as they are.
constexpr const char* CopiedPrefix = "old-";
/// How every document of that kind begins.
constexpr std::string_view DocumentMark = "\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1";
/// Empty where it cannot be told.
std::string TimeOfFile(const Files& disk, const std::string& path) {
  try {
    return disk.TimeOfChange(path);
  } catch (const RuntimeError&) {
    return {};
  }
}

bool HasColumn(const std::vector<std::string>& columns, const std::string& wanted) {
  return std::any_of(columns.begin(), columns.end(), [&wanted](const std::string& name) {
    return std::equal(name.begin(), name.end(), wanted.begin(), wanted.end(),
                      [](char a, char b) { return LowerAscii(a) == LowerAscii(b); });
  });
}

const std::string& PathOf(OldItem item, const OldInstallation& old) {
  switch (item) {
    case OldItem::Members:
      return old.Members;
    case OldItem::Missions:
      return old.Missions;
    case OldItem::Template:
      return old.Template;
    case OldItem::Settings:
      return old.Settings;
    case OldItem::Games:
      break;
  }
  return old.GamesFolder;
}

}  // namespace

/// Asks about values that cannot be read whole. The file beside the data is not the operator's, so the old
/// one's path is told.
class TakeOverWork::Conversion : public ConversionSteps {
 public:
  Conversion(const Parts& parts, const std::string& path, const ::KeepOn& keepOn)
      : parts_(parts), path_(path), keepOn_(keepOn) {}

  bool GoOnWithout(const std::vector<NotTakenOver>& values) override {
    return parts_.Ask(
        Filled(parts_.Strings.Text(OwnText::OldValuesUnreadable), {path_, LinesOf(values, parts_.Strings)}));
  }
  bool AddInterimRows(std::int64_t /*rows*/) override { return false; }
  bool KeepOn() override { return keepOn_(); }
  bool ShowsProgress() const override { return true; }
  void BeforeReplacing(const OldDatabaseReport& /*report*/) override {}

 private:
  const Parts& parts_;
  const std::string& path_;
  const ::KeepOn& keepOn_;
};

TakeOverWork::~TakeOverWork() {
  try {
    if (!HasTakeOverMark(parts_.Disk, parts_.DataFolder)) {
      ForgetTakeOver(parts_.Disk, parts_.DataFolder);
    }
  } catch (const RuntimeError&) {  // the next start tells the same
  }
}

std::string TakeOverWork::MadePath(const std::string& name) const {
  return TakeOverFolder(parts_.DataFolder) + "/" + name;
}

void TakeOverWork::Delete(const std::string& path) const {
  if (parts_.Disk.FileExists(path)) {
    parts_.Disk.Delete(path);
  }
}

std::vector<FoundItem> TakeOverWork::Look(const OldInstallation& old, const OnLook& keepOn) {
  const std::string folder = TakeOverFolder(parts_.DataFolder);
  parts_.Disk.MakePrivateFolder(folder);  // the members in it are nobody else's business
  ForgetTakeOver(parts_.Disk, parts_.DataFolder);
  ready_.clear();
  std::vector<FoundItem> all;
  for (const OldItem item :
       {OldItem::Members, OldItem::Missions, OldItem::Template, OldItem::Settings, OldItem::Games}) {
    FoundItem found{.What = item};
    if (!keepOn(item) || !LookAt(old, found, [&keepOn, item] { return keepOn(item); })) {
      return {};
    }
    TellPresent(found);
    all.push_back(std::move(found));
  }
  return all;
}

bool TakeOverWork::LookAt(const OldInstallation& old, FoundItem& found, const KeepOn& keepOn) {
  const std::string& path = PathOf(found.What, old);
  if (path.empty()) {
    return true;
  }
  if (found.What == OldItem::Games) {
    return LookAtGames(path, found, keepOn);
  }
  try {
    found.Changed = TimeOfFile(parts_.Disk, path);
    if (found.What == OldItem::Template) {
      LookAtTemplate(path, found);
    } else if (found.What == OldItem::Settings) {
      LookAtSettings(path, found);
    } else {
      const auto database =
          std::find_if(parts_.Databases.begin(), parts_.Databases.end(),
                       [&found](const TakenDatabase& each) { return each.What == found.What; });
      if (!LookAtDatabase(*database, path, found, keepOn)) {
        return false;
      }
    }
    found.State = FoundItem::Usable;
    ready_.insert(found.What);
  } catch (const OldDatabaseRefused& error) {
    found.State = FoundItem::Unusable;
    found.Remark = ReasonOf(error, parts_.Strings);
  } catch (const RuntimeError& error) {
    found.State = FoundItem::Unusable;
    found.Remark = error.what();
  }
  return true;
}

bool TakeOverWork::CopyOldFile(const std::string& path, const std::string& target,
                               const KeepOn& keepOn) const {
  constexpr std::size_t pieceBytes = std::size_t{1} << 20U;
  Delete(target);
  parts_.Disk.Write(target, {});
  std::uint64_t offset = 0;
  for (std::string piece; !(piece = parts_.Disk.ReadPart(path, offset, pieceBytes)).empty();
       offset += piece.size()) {
    if (!keepOn()) {
      return false;
    }
    parts_.Disk.Append(target, piece);
  }
  return true;
}

bool TakeOverWork::LookAtDatabase(const TakenDatabase& database, const std::string& path, FoundItem& found,
                                  const KeepOn& keepOn) const {
  constexpr std::uint64_t copiesOfIt = 3;  // as it is, converted, and checked
  const std::uint64_t needed = copiesOfIt * parts_.Disk.FileLen(path) + RoomAfterTakeOver;
  if (parts_.Disk.FreeSpace(parts_.DataFolder) < needed) {
    throw RuntimeError(Fault::DiskFull, "Disk full: " + parts_.DataFolder);
  }
  DeleteCopied();  // a journal of another file must not be played back into this one
  const std::string copied = MadePath(CopiedPrefix + FileNameIn(database.InUse().Path()));
  if (!CopyOldFile(path, copied, keepOn)) {
    return false;
  }
  const std::string folder = path.substr(0, path.rfind('/'));
  for (const char* ending : {"-journal", "-wal"}) {
    const std::string journal = FileInFolder(parts_.Disk, folder, FileNameIn(path) + ending);
    if (!journal.empty() && !CopyOldFile(journal, copied + ending, keepOn)) {
      return false;
    }
  }
  const bool made = MakeDatabase(database, path, copied, found, keepOn);
  DeleteCopied();
  return made;
}

void TakeOverWork::DeleteCopied() const {
  for (const std::string& file : parts_.Disk.FileNames(TakeOverFolder(parts_.DataFolder))) {
    if (file.starts_with(CopiedPrefix)) {
      parts_.Disk.Delete(MadePath(file));
    }
  }
}

bool TakeOverWork::MakeDatabase(const TakenDatabase& database, const std::string& path,
                                const std::string& copied, FoundItem& found, const KeepOn& keepOn) const {
  if (parts_.Old.IsOld(copied)) {
    Conversion steps(parts_, path, keepOn);
    try {
      const OldDatabaseReport report =
          parts_.Old.Convert({copied, database.Table, database.DefaultPath, MadePath("none.mdb")}, steps);
      found.Remark = LinesOf(report.NotTaken, parts_.Strings);
    } catch (const OldDatabaseStopped&) {
      return false;
    }
  }
  const std::unique_ptr<Database> made = parts_.Engine.OpenDatabase(copied);
  if (!made->CheckWhole(keepOn)) {
    return false;
  }
  CheckColumns(*made, database);
  found.Count = made->OpenRecordset(database.Table)->RecordCount();
  const std::string target = MadePath(FileNameIn(database.InUse().Path()));
  Delete(target);
  parts_.Engine.OpenDatabase(database.DefaultPath)->CopyTo(target);
  return TakeRows(*made, *parts_.Engine.OpenDatabase(target), database.Table, parts_.Strings, keepOn);
}

void TakeOverWork::CheckColumns(Database& made, const TakenDatabase& database) const {
  const std::vector<std::string> there = made.ColumnNames(database.Table);
  for (const std::string& needed :
       parts_.Engine.OpenDatabase(database.DefaultPath)->ColumnNames(database.Table)) {
    if (!HasColumn(there, needed)) {
      throw RuntimeError(Fault::ItemNotFound,
                         Filled(parts_.Strings.Text(OwnText::CopyLacksColumn), {database.Table, needed}));
    }
  }
}

void TakeOverWork::LookAtTemplate(const std::string& path, FoundItem& found) const {
  constexpr std::uint64_t mostBytes = std::uint64_t{64} << 20U;
  if (parts_.Disk.FileLen(path) > mostBytes ||
      !parts_.Disk.ReadPart(path, 0, DocumentMark.size()).starts_with(DocumentMark)) {
    throw RuntimeError(Fault::InvalidFileFormat, "Invalid file format: " + path);
  }
  parts_.Disk.Replace(MadePath(TemplateName), parts_.Disk.Read(path));
  found.Count = 1;
}

void TakeOverWork::LookAtSettings(const std::string& path, FoundItem& found) {
  const IniReader inUse(parts_.Disk, parts_.DataFolder + "/" + SettingsName);
  settings_ = ReadOldSettings(parts_.Disk, path, inUse, parts_.HasPort);
  found.Count = static_cast<std::int64_t>(settings_.Taken.size());
  found.Different = static_cast<std::int64_t>(settings_.Different());
  if (settings_.PortLeftOut) {
    found.Remark =
        Filled(parts_.Strings.Text(OwnText::TakeOverNoPort), {std::to_string(*settings_.PortLeftOut)});
  }
  if (!settings_.FactorsLeftOut.empty()) {
    std::string keys;
    for (const std::string& key : settings_.FactorsLeftOut) {
      keys.append(keys.empty() ? "" : ", ").append(key);
    }
    found.Remark.append(found.Remark.empty() ? "" : " ")
        .append(Filled(parts_.Strings.Text(OwnText::TakeOverNoNumber), {keys}));
  }
}

bool TakeOverWork::LookAtGames(const std::string& folder, FoundItem& found, const KeepOn& keepOn) const {
  const std::optional<OldGameFiles> games = CountGameFiles(parts_.Disk, folder, keepOn);
  if (games && games->Count > 0) {
    found.State = FoundItem::Usable;
    found.Count = static_cast<std::int64_t>(games->Count);
    found.Changed = games->First;
    found.Latest = games->Last;
  }
  return games.has_value();
}

void TakeOverWork::TellPresent(FoundItem& found) const {
  for (const TakenDatabase& database : parts_.Databases) {
    if (database.What == found.What) {
      Database& inUse = database.InUse();
      found.CountNow = inUse.OpenRecordset(database.Table)->RecordCount();
      found.ChangedNow = TimeOfFile(parts_.Disk, inUse.Path());
    }
  }
  if (found.What == OldItem::Template || found.What == OldItem::Settings) {
    found.ChangedNow =
        TimeOfFile(parts_.Disk,
                   parts_.DataFolder + "/" + (found.What == OldItem::Template ? TemplateName : SettingsName));
  }
}
