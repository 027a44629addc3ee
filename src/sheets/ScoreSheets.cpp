#include "sheets/ScoreSheets.h"

#include <chrono>
#include <optional>
#include <string_view>
#include <utility>

#include "core/data/Photo.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"
#include "sheets/SheetTexts.h"

using std::chrono::milliseconds;

namespace {

/// Thrown when a stage of the run fails: the box to show.
struct StageFailure {
  std::string Text;
  std::string Title;
};

/// Thrown when the program is closing.
struct ProgramCloses {};

constexpr const char* FailureTitle = "Print Error";

/// Runs one stage of a sheet; a failure in it ends the run with `text` and `title`.
template <typename Operation>
void Stage(const std::string& text, const std::string& title, Operation&& operation) {
  try {
    operation();
  } catch (const RuntimeError&) {
    throw StageFailure{text, title};
  }
}

template <typename Operation>
void Stage(const std::string& text, Operation&& operation) {
  Stage(text, FailureTitle, std::forward<Operation>(operation));
}

/// Throws RuntimeError 75 for a file name that is invalid on any system the sheet may be copied to.
void CheckFileName(const std::string& name) {
  constexpr std::size_t longest = 255;
  bool valid = name.size() <= longest;
  for (const char c : name) {
    valid = valid && static_cast<unsigned char>(c) >= 0x20 && c != 0x7F &&
            std::string_view("\\/:*?\"<>|").find(c) == std::string_view::npos;
  }
  if (!valid) {
    throw RuntimeError(Fault::PathAccess);
  }
}

}  // namespace

ScoreSheets::ScoreSheets(const SheetParts& parts, const PrintChoice& choice)
    : in_(parts),
      choice_(choice),
      folder_(parts.UserDataFolder + "/scores"),
      winner_(WinningTeam(parts.Game)),
      sheetDate_(WithoutWeekday(parts.Time.LongDate(parts.Game.GameDate))) {}

SheetFiles ScoreSheets::GenerateScoreSheets() {
  std::optional<StageFailure> failure;
  bool closing = false;
  try {
    MakeSheets();
  } catch (const StageFailure& stage) {
    failure = stage;
  } catch (const ProgramCloses&) {
    closing = true;
  }
  in_.Progress.Close();
  DeletePages();
  if (closing) {
    return {};
  }
  if (failure) {
    in_.Boxes.Show(failure->Text, failure->Title, BoxIcon::Exclamation, BoxButtons::OkCancel);
  } else {
    in_.Boxes.Show(ClosingText(), in_.Strings.Text(131), BoxIcon::Information);
  }
  return Files();
}

SheetFiles ScoreSheets::Files() const {
  return made_ > 0 ? SheetFiles{folder_, pdf_} : SheetFiles{};
}

void ScoreSheets::DeletePages() {
  for (const std::string& page : pages_) {
    try {
      in_.Disk.Delete(page);
    } catch (const RuntimeError&) {
      // The sheets are complete without it, and the system empties its temporary folder.
      continue;
    }
  }
}

std::string ScoreSheets::ClosingText() const {
  const bool stopped = made_ < chosen_;
  std::string text = stopped ? Filled(in_.Strings.Text(OwnText::PrintingStopped),
                                      {std::to_string(made_), std::to_string(chosen_)})
                             : in_.Strings.Text(130);
  if (choice_.OutputTarget == OutputTarget::Files && (made_ > 0 || !stopped)) {
    text += " Files saved to " + folder_ + ".";
  }
  if (pdfFailed_) {
    text += "\n\n" + in_.Strings.Text(OwnText::PdfOfSheetsFailed);
  }
  return text;
}

bool ScoreSheets::IsChosen(int index) const {
  const std::uint8_t id = IdFromIndex(index);
  const bool inTeam = TeamFromId(id) == choice_.SelectedTeam;
  switch (choice_.SheetSelection) {
    case SheetSelection::All:
      return true;
    case SheetSelection::Active:
      return in_.Game.Players(index).Active;
    case SheetSelection::Team:
      return inTeam;
    case SheetSelection::OnePlayer:
      return inTeam && PlayerNumberFromId(id) == choice_.SelectedNumber;
    default:
      return false;
  }
}

std::vector<int> ScoreSheets::ChosenPlayers() const {
  std::vector<int> chosen;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (IsChosen(index)) {
      chosen.push_back(index);
    }
  }
  return chosen;
}

void ScoreSheets::MakeSheets() {
  const std::vector<int> chosen = ChosenPlayers();
  if (chosen.empty()) {
    return;
  }
  chosen_ = static_cast<int>(chosen.size());
  in_.Progress.Open();
  Stage("Could not locate score template file.", [this] { StartWordProcessor(); });
  for (const int index : chosen) {
    if (in_.Progress.Stopped()) {
      break;
    }
    MakeSheet(index);
    ++made_;
  }
  if (!pages_.empty()) {
    TryPdf([this] { JoinSheets(); });
  }
}

void ScoreSheets::StartWordProcessor() {
  in_.WordApp.Start();
  constexpr milliseconds step(60);
  constexpr int steps = 1000;
  for (int i = 0; i < steps && in_.WordApp.State() == WordState::Starting && !in_.Progress.Stopped(); ++i) {
    if (in_.Events.WaitFor([] { return false; }, step) == WaitResult::Ended) {
      throw ProgramCloses{};
    }
  }
}

void ScoreSheets::MakeSheet(int index) {
  std::unique_ptr<WordDocument> document;
  Stage("Could not locate score template file.",
        [&] { document = in_.WordApp.Add(in_.UserDataFolder + "/score_card.doc"); });
  ServeEvents();
  Stage(in_.Strings.Text(132), in_.Strings.Text(133), [&] {
    FillPlayer(*document, index);
    FillGame(*document, index);
  });
  Save(*document);
  Stage("Error occured during printing.", [&] {
    if (choice_.OutputTarget == OutputTarget::Printer) {
      document->PrintOut();
    }
    document->Close();
  });
  ServeEvents();
}

void ScoreSheets::FillPlayer(WordDocument& document, int index) {
  Write(document, ResultTexts(in_.Game, index, winner_));
  const std::int32_t contactId = in_.Game.Players(index).MemberIndex;
  const std::optional<Member> member = contactId == 0 ? std::nullopt : in_.Members.LoadMember(contactId);
  const BookmarkTexts texts =
      member ? MemberTexts(*member, in_.Members.LoadHistory(contactId)) : GuestTexts();
  const std::string& name = texts.front().second;
  const std::uint8_t id = IdFromIndex(index);
  const std::string player =
      in_.Game.TeamNames(TeamFromId(id)) + Str(std::int32_t{PlayerNumberFromId(id)}) + "-" + name;
  sheetName_ = player + "-" + sheetDate_ + "-" + in_.MissionName;
  in_.Progress.ShowSheet(made_ + 1, chosen_, player);
  ServeEvents();
  Write(document, texts);
  if (member) {
    Stage("Error occured getting Memmber photo.", [&] { AddPhoto(document, *member); });
  }
}

void ScoreSheets::AddPhoto(WordDocument& document, const Member& member) {
  // Events were served since the member was looked up, and a command given meanwhile moves the cursor.
  in_.RsMembers.WalkTo("ContactID", std::int64_t{member.ContactId});
  const std::string file = in_.Disk.MakeTempFileName();
  // The temporary file of a member without a photo is not deleted.
  if (ExportPhoto(in_.RsMembers, "Photograph", "PhotographLength", file, in_.Disk)) {
    TurnUpright(file);
    document.AddPicture(1, 1, 1, file);
    in_.Disk.Delete(file);
  }
  ServeEvents();
}

void ScoreSheets::TurnUpright(const std::string& file) {
  const std::string photo = in_.Disk.Read(file);
  const std::string upright = in_.UprightPicture(photo);
  if (upright != photo) {
    in_.Disk.Write(file, upright);
  }
}

void ScoreSheets::FillGame(WordDocument& document, int index) {
  const Player& player = in_.Game.Players(index);
  const std::string rank = choice_.RankHidden ? in_.Strings.Text(129) : Str(std::int32_t{player.Rank});
  Write(document, GameTexts(player, in_.MissionName, sheetDate_, rank));
  constexpr HitRows where{.First = 2, .Count = 20};
  const auto write = [&](int table, const CellTexts& hits) {
    document.WriteCells(table, where.First, where.Count, hits);
    EnlargeHits(document, table, static_cast<int>(hits.size()), where);
    ServeEvents();
  };
  write(4, HitsScored(in_.Game, index, in_.Members));
  write(5, HitsTaken(in_.Game, index, in_.Members));
}

void ScoreSheets::EnlargeHits(WordDocument& document, int table, int hits, HitRows where) {
  const std::optional<RowSizes> sizes = SizesForHits(hits, where.Count);
  if (!sizes) {
    return;
  }
  try {
    document.ResizeRows(table, where.First, where.Count, *sizes);
  } catch (const RuntimeError&) {
    return;  // the sheet is complete in small letters too
  }
}

void ScoreSheets::Write(WordDocument& document, const BookmarkTexts& texts) {
  for (const auto& [name, text] : texts) {
    document.SetBookmark(name, text);
  }
  ServeEvents();
}

void ScoreSheets::Save(WordDocument& document) {
  Stage("Failed to create sub folder for score saving.", [this] {
    if (!in_.Disk.FolderExists(folder_)) {
      in_.Disk.CreateFolder(folder_);
    }
  });
  Stage("Error occured during file saving.", [&] {
    document.SaveAs(FreeName(sheetName_, ".doc"));
    ServeEvents();
  });
  if (choice_.OutputTarget == OutputTarget::Files) {
    TryPdf([&] {
      pages_.push_back(in_.Disk.MakeTempFileName());
      document.ExportPdf(pages_.back());
      ServeEvents();
    });
  }
}

void ScoreSheets::TryPdf(const std::function<void()>& step) {
  if (pdfFailed_) {
    return;
  }
  try {
    step();
  } catch (const RuntimeError&) {
    pdfFailed_ = true;  // the closing box tells it
  }
}

std::string ScoreSheets::FreeName(const std::string& base, const std::string& extension) const {
  const std::string folder = folder_ + "/";
  std::string name = base + extension;
  std::int32_t n = 0;
  while (in_.Disk.FileExists(folder + name)) {
    name = base;
    name += Str(++n);
    name += extension;
  }
  CheckFileName(name);
  return folder + name;
}

void ScoreSheets::JoinSheets() {
  const std::string pdf = FreeName("Score sheets-" + sheetDate_ + "-" + in_.MissionName, ".pdf");
  in_.WordApp.JoinPdfs(pages_, pdf, [this] { ServeEvents(); });
  pdf_ = pdf;
}

void ScoreSheets::ServeEvents() {
  if (in_.Events.WaitFor([] { return false; }, milliseconds(0)) == WaitResult::Ended) {
    throw ProgramCloses{};
  }
}
