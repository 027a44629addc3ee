#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/WordProcessor.h"
#include "sheets/PrintChoice.h"
#include "sheets/SheetProgress.h"

/// What a run of score sheets works with; it outlives the run.
struct SheetParts {
  const Game& Board;
  Recordset& RsMembers;
  MemberLookup& Members;
  const StringTable& Strings;
  const Clock& Time;
  EventPump& Events;
  Files& Disk;
  MessageBoxes& Boxes;
  WordProcessor& WordApp;
  SheetProgress& Progress;
  std::string UserDataFolder;
  std::string MissionName;
};

/// Makes one document for each chosen player from the template `score_card.doc`, saves it in the folder
/// `scores`, and prints it when that is wanted; when the output goes to files, all sheets of the run are left
/// as one PDF too.
class ScoreSheets {
 public:
  ScoreSheets(const SheetParts& parts, const PrintChoice& choice);

  /// Runs to the end, which a box tells; to the first failure, which a box tells too; or, without a box,
  /// until the program closes. Events are served all the while. Sheets that were made stay.
  void GenerateScoreSheets();

 private:
  bool IsChosen(int index) const;
  std::vector<int> ChosenPlayers() const;
  void MakeSheets();
  void MakeSheet(int index, int number, int count);
  void StartWordProcessor();
  void FillPlayer(WordDocument& document, int index, int number, int count);
  void AddPhoto(WordDocument& document, const Member& member);
  void FillGame(WordDocument& document, int index);
  void Save(WordDocument& document);
  /// A name in the folder of sheets that is not taken: `base` and the extension, with a number between where
  /// needed.
  std::string FreeName(const std::string& base, const std::string& extension) const;
  void JoinSheets();
  void Write(WordDocument& document, const std::vector<std::pair<const char*, std::string>>& texts);
  /// Lets events be served. Ends the run when the program closes.
  void ServeEvents();

  const SheetParts& in_;
  const PrintChoice& choice_;
  std::string folder_;
  int winner_ = 0;
  std::string sheetDate_;
  std::string sheetName_;           ///< of the present sheet
  std::vector<std::string> pages_;  ///< each sheet of the run as PDF, in temporary files
};
