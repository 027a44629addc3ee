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
  const ::Game& Game;
  Recordset& RsMembers;
  MemberLookup& Members;
  const StringTable& Strings;
  const Clock& Time;
  EventPump& Events;
  Files& Disk;
  MessageBoxes& Boxes;
  WordProcessor& WordApp;
  /// Turns a picture file upright, which the word processor does not do.
  std::function<std::string(const std::string& bytes)> UprightPicture;
  SheetProgress& Progress;
  std::string UserDataFolder;
  std::string MissionName;
};

/// What a run has left on the disk.
struct SheetFiles {
  std::string Folder;  ///< of the sheets; empty if none was made
  std::string Pdf;     ///< all sheets in one file; empty if there is none
};

/// Makes one document for each chosen player from the template `score_card.doc` and saves it in the folder
/// `scores`. Output to the printer also prints each document; output to files also leaves all sheets of the
/// run in one PDF, if that succeeds.
class ScoreSheets {
 public:
  ScoreSheets(const SheetParts& parts, const PrintChoice& choice);

  /// Runs to the end, until the operator stops it or to the first failure, each of which a box reports, or
  /// until the program closes, without a box. Events are processed throughout. Finished sheets are kept in
  /// every case. Returns what there is of them.
  SheetFiles GenerateScoreSheets();

  /// True once every chosen sheet has been made.
  bool AllMade() const { return chosen_ > 0 && made_ == chosen_; }

 private:
  /// Rows of a table that hold hits.
  struct HitRows {
    int First;
    int Count;
  };

  bool IsChosen(int index) const;
  std::vector<int> ChosenPlayers() const;
  void MakeSheets();
  void MakeSheet(int index);
  void StartWordProcessor();
  void FillPlayer(WordDocument& document, int index);
  void AddPhoto(WordDocument& document, const Member& member);
  void TurnUpright(const std::string& file);
  void FillGame(WordDocument& document, int index);
  /// Gives few hits large letters, if the template's table allows it.
  static void EnlargeHits(WordDocument& document, int table, int hits, HitRows where);
  void Save(WordDocument& document);
  /// An unused path in the folder of sheets: `base` and the extension, with a number in between if needed.
  std::string FreeName(const std::string& base, const std::string& extension) const;
  void JoinSheets();
  SheetFiles Files() const;
  /// Runs one step towards the PDF of all sheets. A failure gives up the PDF, but not the run.
  void TryPdf(const std::function<void()>& step);
  void DeletePages();
  /// What the box after a run without a failure says.
  std::string ClosingText() const;
  void Write(WordDocument& document, const std::vector<std::pair<const char*, std::string>>& texts);
  /// Processes events. Ends the run if the program is closing.
  void ServeEvents();

  const SheetParts& in_;
  const PrintChoice& choice_;
  std::string folder_;
  int winner_ = 0;
  std::string sheetDate_;
  std::string sheetName_;           ///< of the current sheet
  int chosen_ = 0;                  ///< sheets to make
  int made_ = 0;                    ///< sheets that are finished
  std::string pdf_;                 ///< path of the PDF of all sheets once it is made
  bool pdfFailed_ = false;          ///< there will be no PDF of all sheets
  std::vector<std::string> pages_;  ///< each sheet of the run as PDF, in temporary files
};
