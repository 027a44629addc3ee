#include "core/game/DeskEntries.h"

#include <initializer_list>
#include <string_view>

#include "core/text/Filled.h"

namespace {

class Writer {
 public:
  explicit Writer(const StringTable& strings) : strings_(strings) {}

  void Tell(DeskTopic topic, std::string text) { entries_.push_back({topic, std::move(text)}); }
  void Link(DeskTopic topic, std::string text, std::string tip) {
    entries_.push_back({topic, std::move(text), true, std::move(tip)});
  }

  std::string Text(OwnText text, std::initializer_list<std::string_view> values = {}) const {
    return Filled(strings_.Text(text), values);
  }

  std::vector<DeskEntry> Entries() { return std::move(entries_); }

 private:
  const StringTable& strings_;
  std::vector<DeskEntry> entries_;
};

std::string GameText(const DeskFacts& facts, const Writer& writer) {
  if (!facts.Present) {
    return writer.Text(OwnText::DeskNoGame);
  }
  const std::string players = std::to_string(facts.Players);
  return facts.Time.empty() ? writer.Text(OwnText::DeskUndatedGame, {players, facts.Mission})
                            : writer.Text(OwnText::DeskGame, {players, facts.Time, facts.Mission});
}

void TellOfScores(const DeskFacts& facts, Writer& writer) {
  if (facts.LowestFirst) {
    writer.Link(DeskTopic::LowestFirst, writer.Text(OwnText::DeskLowestFirst),
                writer.Text(OwnText::DeskHighestFirst));
  }
  if (facts.Change) {
    writer.Link(DeskTopic::MissionChanged,
                writer.Text(OwnText::DeskMissionChanged,
                            {facts.Change->From, facts.Change->To, std::to_string(facts.Change->Rescored)}),
                writer.Text(OwnText::DeskMissionBack, {facts.Change->From}));
  }
  if (!facts.SharedMembers.empty()) {
    std::string names;
    for (const std::string& name : facts.SharedMembers) {
      names += (names.empty() ? "" : ", ") + name;
    }
    writer.Link(DeskTopic::SharedMembers, writer.Text(OwnText::DeskSharedMembers, {names}),
                writer.Text(OwnText::DeskShowRows));
  }
}

void TellOfGame(const DeskFacts& facts, Writer& writer) {
  if (facts.CountedTwice > 0) {
    writer.Link(DeskTopic::CountedTwice,
                writer.Text(OwnText::DeskCountedTwice, {std::to_string(facts.CountedTwice)}),
                writer.Text(OwnText::DeskShowRows));
  }
  if (facts.Unsaved) {
    writer.Link(DeskTopic::Unsaved, writer.Text(OwnText::DeskUnsaved), writer.Text(OwnText::DeskSave));
  }
  if (facts.Commits.Of > 0) {
    const std::string text = writer.Text(
        OwnText::DeskCommitted, {std::to_string(facts.Commits.Done), std::to_string(facts.Commits.Of)});
    if (facts.Commits.Done < facts.Commits.Of) {
      writer.Link(DeskTopic::Committed, text, writer.Text(OwnText::DeskCommit));
    } else {
      writer.Tell(DeskTopic::Committed, text);
    }
  }
  TellOfScores(facts, writer);
  if (facts.NotKept.empty() && !facts.KeptAt.empty()) {
    writer.Tell(DeskTopic::Kept, writer.Text(OwnText::DeskKept, {facts.KeptAt}));
  }
}

void TellOfArchive(const DeskFacts& facts, Writer& writer) {
  if (!facts.NotKept.empty()) {
    writer.Tell(DeskTopic::NotKept, writer.Text(OwnText::DeskNotKept, {facts.NotKept}));
  }
  if (!facts.UnusableArchive.empty()) {
    writer.Tell(DeskTopic::ArchiveUnusable,
                writer.Text(OwnText::DeskArchiveUnusable, {facts.UnusableArchive}));
  }
  if (facts.CutGames > 0) {
    writer.Tell(DeskTopic::CutGames, writer.Text(OwnText::DeskCutGames, {std::to_string(facts.CutGames)}));
  }
  if (!facts.WeeklyCopyFailure.empty()) {
    writer.Tell(DeskTopic::WeeklyCopyFailed,
                writer.Text(OwnText::DeskWeeklyCopyFailed, {facts.WeeklyCopyFailure}));
  }
  if (facts.BackupLacksRoom) {
    writer.Tell(DeskTopic::BackupLacksRoom, writer.Text(OwnText::DeskBackupLacksRoom));
  }
}

}  // namespace

std::vector<DeskEntry> DeskEntries(const DeskFacts& facts, const StringTable& strings) {
  Writer writer(strings);
  writer.Tell(DeskTopic::Game, GameText(facts, writer));
  if (facts.Present) {
    TellOfGame(facts, writer);
  }
  if (!facts.FileOfCancel.empty()) {
    writer.Tell(DeskTopic::FileOfCancel, writer.Text(OwnText::DeskFileOfCancel, {facts.FileOfCancel}));
  }
  if (!facts.UnsavedSettings.empty()) {
    writer.Tell(DeskTopic::Settings, writer.Text(OwnText::DeskSettingsUnsaved, {facts.UnsavedSettings}));
  }
  TellOfArchive(facts, writer);
  return writer.Entries();
}
