// The main window's commands on the databases as a whole: members as files, backup copies, old installations.

#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "app/WorkProgress.h"
#include "app/frmRx.h"
#include "archive/ArchiveCopies.h"
#include "archive/CopiedArchive.h"
#include "archive/copies/BackupCopies.h"
#include "archive/import/GameImport.h"
#include "core/data/FirstRun.h"
#include "core/line/CommPortSetting.h"
#include "core/text/Filled.h"
#include "members/ExportMembers.h"
#include "members/ImportMembers.h"
#include "platform/RuntimeError.h"
#include "takeover/OldInstallation.h"
#include "takeover/TakeOver.h"

namespace {

/// A line for each of the files: "PATH:LINE: REASON", without a line where none can be told.
std::vector<std::string> RefusedFileLines(const std::vector<RefusedGameFile>& files,
                                          const StringTable& strings) {
  std::vector<std::string> lines;
  lines.reserve(files.size());
  for (const RefusedGameFile& file : files) {
    std::string& text = lines.emplace_back(file.Path);
    if (file.Trouble.Line > 0) {
      text.append(":").append(std::to_string(file.Trouble.Line));
    }
    text.append(": ").append(TextOf(file.Trouble, strings));
  }
  return lines;
}

}  // namespace

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
    CheckMembers();
  }
}

std::vector<CopiedDatabase> frmRx::CopiedDatabases() {
  const std::string defaults = services_.Places.Program();
  return {{.Name = "scenarios",
           .Table = "Table1",
           .DefaultPath = defaults + "/scenarios_default.mdb",
           .Title = OwnText::CopiedMissions,
           .InUse = [this]() -> Database& { return session_.DbScenarios(); }},
          {.Name = "members",
           .Table = "Members",
           .DefaultPath = defaults + "/members_default.mdb",
           .Title = OwnText::CopiedMembers,
           .InUse = [this]() -> Database& { return session_.DbMembers(); }}};
}

CopyWork::Parts frmRx::CopyParts() const {
  return {.Engine = services_.Databases,
          .Disk = services_.Disk,
          .Time = services_.Time,
          .Strings = services_.Strings,
          .Folder = BackupFolderIn(userDataFolder_)};
}

void frmRx::CheckMembers() {
  keeping_->CheckMembers();
  CutNumbers();
  ShowOtherNames();
}

void frmRx::CutNumbers() {
  WorkProgress progress({.Window = *this, .Events = services_.Events, .Strings = services_.Strings},
                        OwnText::CuttingNumbers);
  while (keeping_->CutAPart() && progress.GoOn(keeping_->CutDone()) && !commands_.CloseRequested()) {
  }
}

void frmRx::ShowBackupCopies() {
  std::vector<CopiedDatabase> databases = CopiedDatabases();
  CopiedArchive archive({.Engine = services_.Archives != nullptr ? *services_.Archives : services_.Databases,
                         .Disk = services_.Disk,
                         .UserDataFolder = userDataFolder_,
                         .ProgramFolder = services_.Places.Program()});
  if (archive.IsThere()) {
    databases.push_back(archive.Entry());
  }
  BackupCopies({.Databases = std::move(databases),
                .Work = CopyParts(),
                .Events = services_.Events,
                .Boxes = services_.Boxes,
                .FileDialog = services_.CommonDialog1,
                .Busy = [this] { return RunningBesidesThis(); },
                .Reopen =
                    [this] {
                      session_.Reopen();
                      CheckMembers();
                    }},
               this)
      .exec();
}

ResumedTakeOver frmRx::FinishInterruptedTakeOver() {
  std::string folder;
  services_.Places.LocalAppData(folder);
  return ResumeTakeOver(services_.Disk, folder + UserDataSubfolder, services_.Boxes, services_.Strings,
                        [this] { services_.Events.DoEvents(); });  // other starts want an answer
}

std::string frmRx::WhyNoTakeOver() {
  const StringTable& strings = services_.Strings;
  if (const std::optional<OwnText> reason = RunningBesidesThis()) {
    return Filled(strings.Text(OwnText::TakeOverWaits), {strings.Text(*reason)});
  }
  const KeptState& kept = keeping_->State();
  const bool isKept = !kept.KeptAt.empty() && kept.Failure.empty();
  return desk_->Progress().Unsaved() && !isKept ? strings.Text(OwnText::TakeOverGameNotKept) : std::string();
}

TakeOverWork::Parts frmRx::TakeOverParts() {
  std::vector<TakenDatabase> databases;
  for (const CopiedDatabase& copied : CopiedDatabases()) {
    databases.push_back(
        {.What = copied.Title == OwnText::CopiedMembers ? OldItem::Members : OldItem::Missions,
         .Table = copied.Table,
         .DefaultPath = copied.DefaultPath,
         .InUse = copied.InUse,
         .KeepCopy = [copied, work = CopyWork(CopyParts())](const KeepOn& keepOn) {
           return work.KeepPresent(copied, [&keepOn](CopyStep) { return keepOn(); });
         }});
  }
  return {.Engine = services_.Databases,
          .Old = services_.Old,
          .Disk = services_.Disk,
          .Time = services_.Time,
          .Strings = services_.Strings,
          .DataFolder = userDataFolder_,
          .Databases = std::move(databases),
          .Ask = {},
          .HasPort = [this](std::int16_t number) {
            try {
              return services_.Devices.Exists(CommPortSetting(*ini_, services_.Devices).DeviceOf(number));
            } catch (const RuntimeError&) {
              return false;
            }
          }};
}

ImportedGames frmRx::ImportOldGames(const std::string& folder, FilesOfMembers members,
                                    const TakeOver::OnImport& keepOn) {
  CheckSpaceForGames(services_.Disk, userDataFolder_, services_.Strings);
  GameImport import(
      {.Archive = archive_->File(),
       .Members = session_.DbMembers(),
       .Disk = services_.Disk,
       .Time = services_.Time,
       .Strings = services_.Strings,
       .Factors = session_.Factors(),
       .UserDataFolder = userDataFolder_,
       .IsWanted = [this](const std::string& path) { return MayBeOldGame(services_.Disk, path); }},
      members == FilesOfMembers::Taken ? FilesOf::ThisTable : FilesOf::OtherTable);
  const bool isWhole = import.Run(folder, [&keepOn](const GameImport::State& state) {
    return keepOn(state.Files == 0 ? 0 : static_cast<double>(state.Done) / static_cast<double>(state.Files));
  });
  return {.Imported = import.Imported() + import.BroughtBack(),
          .Known = import.Known(),
          .Refused = import.Refused().size(),
          .Whole = isWhole,
          .RefusedFiles = RefusedFileLines(import.Refused(), services_.Strings)};
}

void frmRx::TakeOverOldInstallation() {
  if (const std::string reason = WhyNoTakeOver(); !reason.empty()) {
    services_.Boxes.Show(reason, services_.Strings.Text(OwnText::TakeOverTitle), BoxIcon::Exclamation);
    return;
  }
  TakeOver({.Work = TakeOverParts(),
            .Events = services_.Events,
            .Boxes = services_.Boxes,
            .FileDialog = services_.CommonDialog1,
            .Busy = [this] { return RunningBesidesThis(); },
            .Reopen =
                [this](const std::set<OldItem>&) {
                  session_.ClearPlayerData();
                  session_.Reopen();
                  session_.Factors() = ReadSoldieringFactors(*ini_);
                  CheckMembers();
                },
            .EndProgram = [this] { close(); },
            .ImportGames =
                [this](const std::string& folder, FilesOfMembers members, const TakeOver::OnImport& keepOn) {
                  return ImportOldGames(folder, members, keepOn);
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
