// The main window's commands on the databases as a whole: members as files, backup copies.

#include <optional>

#include "app/frmRx.h"
#include "archive/ArchiveCopies.h"
#include "archive/CopiedArchive.h"
#include "archive/copies/BackupCopies.h"
#include "core/text/Filled.h"
#include "members/ExportMembers.h"
#include "members/ImportMembers.h"

void frmRx::ExportMemberFile() {
  ExportMembers({.DbMembers = session_.DbMembers(),
                 .Boxes = services_.Boxes,
                 .CommonDialog1 = services_.CommonDialog1,
                 .Disk = services_.Disk,
                 .Events = services_.Events,
                 .Time = services_.Time,
                 .Strings = services_.Strings},
                this)
      .exec();
}

void frmRx::ImportMemberFile() {
  constexpr std::uint64_t mostMegabytes = 256;
  constexpr std::uint64_t megabyte = 1U << 20U;
  const StringTable& strings = services_.Strings;
  const auto refuse = [this](const std::string& text) {
    services_.Boxes.Show(text, DefaultBoxTitle, BoxIcon::Exclamation);
  };
  if (RunningBesidesThis()) {  // it may use the cursors that an import closes
    refuse(strings.Text(OwnText::ImportWhileBusy));
    return;
  }
  const std::optional<std::string> path = services_.CommonDialog1.ShowOpen(
      {.Filter = strings.Text(OwnText::CsvFilter), .Title = strings.Text(OwnText::ImportMembersTitle)});
  if (!path) {
    return;
  }
  if (services_.Disk.FileLen(*path) > mostMegabytes * megabyte) {
    refuse(Filled(strings.Text(OwnText::CsvFileTooLarge), {*path, std::to_string(mostMegabytes)}));
    return;
  }
  bool hasImported = false;
  {
    ImportMembers window({.DbMembers = session_.DbMembers(),
                          .Boxes = services_.Boxes,
                          .Events = services_.Events,
                          .Time = services_.Time,
                          .Strings = strings,
                          .BackUp = [this](const KeepOn& keepOn) { return session_.BackUpMembers(keepOn); }},
                         *path, services_.Disk.Read(*path), this);
    window.exec();
    hasImported = window.HasImported();
  }
  if (hasImported) {
    session_.Reopen();
    keeping_->CheckMembers();
  }
}

void frmRx::ShowBackupCopies() {
  const std::string defaults = services_.Places.Program();
  std::vector<CopiedDatabase> databases = {
      {.Name = "scenarios",
       .Table = "Table1",
       .DefaultPath = defaults + "/scenarios_default.mdb",
       .Title = OwnText::CopiedMissions,
       .InUse = [this]() -> Database& { return session_.DbScenarios(); }},
      {.Name = "members",
       .Table = "Members",
       .DefaultPath = defaults + "/members_default.mdb",
       .Title = OwnText::CopiedMembers,
       .InUse = [this]() -> Database& { return session_.DbMembers(); }}};
  CopiedArchive archive({.Engine = services_.Archives != nullptr ? *services_.Archives : services_.Databases,
                         .Disk = services_.Disk,
                         .UserDataFolder = userDataFolder_,
                         .ProgramFolder = defaults});
  if (archive.IsThere()) {
    databases.push_back(archive.Entry());
  }
  BackupCopies({.Databases = std::move(databases),
                .Work = {.Engine = services_.Databases,
                         .Disk = services_.Disk,
                         .Time = services_.Time,
                         .Strings = services_.Strings,
                         .Folder = BackupFolderIn(userDataFolder_)},
                .Events = services_.Events,
                .Boxes = services_.Boxes,
                .FileDialog = services_.CommonDialog1,
                .Busy = [this] { return RunningBesidesThis(); },
                .Reopen =
                    [this] {
                      session_.Reopen();
                      keeping_->CheckMembers();
                    }},
               this)
      .exec();
}

std::optional<OwnText> frmRx::RunningBesidesThis() const {
  if (downloading_) {
    return OwnText::ScoresComeIn;
  }
  return commands_.Nested() ? std::optional(OwnText::CommandRuns) : std::nullopt;
}
