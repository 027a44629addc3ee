#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "archive/history/Rankings.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/Programs.h"
#include "ui/Commands.h"

class HistoryRows;

namespace Ui {
class RankingWindow;
}

/// The members ranked by what they did in a month, a year or all time. First and last names stand only in
/// what is printed or exported, and have to be ticked each time.
class RankingWindow : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    /// Statements on the archive as it is now. May throw RuntimeError.
    std::function<Sql&()> Archive;
    Database& DbMembers;
    HidesName Hides;
    MessageBoxes& Boxes;
    FileDialog& CommonDialog1;
    Files& Disk;
    Programs& OtherPrograms;
    EventPump& Events;
    const StringTable& Strings;
    std::string PrintedPage;  ///< path of the file that is opened in the browser to be printed
  };

  RankingWindow(const Parts& parts, QWidget* parent);
  ~RankingWindow() override;

  void reject() override;

 private:
  void SetTexts();
  /// The months and years of the archive, and all time.
  void FillPeriods();
  void Refresh();
  /// Nothing if the operator stopped it.
  std::optional<std::vector<RankedFigures>> Read(RankedBy by);
  /// While games of many months are read, the window is painted and takes nothing but Stop.
  std::optional<std::vector<RankedFigures>> InSteps(
      const std::function<std::optional<std::vector<RankedFigures>>(const RankingStep& goOn)>& read);
  void EnableAll(bool enabled);
  std::string Title() const;
  bool TakeFullNames();
  void Print();
  void Export();
  bool MayReplace(const std::string& path);
  void Tell(const std::string& text);

  const Parts parts_;
  std::unique_ptr<Ui::RankingWindow> ui_;
  Commands commands_;
  HistoryRows* rows_;
  std::vector<RankedMember> ranked_;
  bool stopped_ = false;
};
