#pragma once

#include <gmock/gmock.h>

#include <QLineEdit>
#include <QTableView>
#include <QTest>
#include <algorithm>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "audience/GuestNameEntry.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"
#include "web/ResultsPage.h"

/// What the programs report that serve the pages and ask for them.
inline const std::string ServedAt8080("P\x90\x1F\x00\x00", 5);
inline const std::string ServedAt8081("P\x91\x1F\x00\x00", 5);
inline const std::string PageAnswered("A\x01\x00\x00\x00", 5);
inline const std::string PageUnanswered("A\x00\x00\x00\x00", 5);

/// The main window with its results page; the other programs are played by the test. "today" is a date of
/// this evening.
class ResultsVenue : public testing::TestWithParam<Language> {
 protected:
  ResultsVenue() {
    venue.Time.Stamps["today"] = "2013-05-21 14:20:00";
    venue.Start();
    QCoreApplication::processEvents();
  }

  void StartAgain() {
    venue.Window->close();
    venue.Window.reset();
    venue.Start();
    QCoreApplication::processEvents();
  }

  ResultsHost& Host() const { return *venue.Window->findChild<ResultsHost*>(); }
  AudienceBoard& Board() const { return *venue.Window->findChild<AudienceBoard*>(); }

  void Set(const std::function<void(PageSetup&)>& change) const {
    PageSetup setup = Host().Setup();
    change(setup);
    Host().SetSetup(setup);
  }
  void SwitchOn() const {
    Set([](PageSetup& setup) { setup.On = true; });
  }
  void ShowNames() const {
    Set([](PageSetup& setup) { setup.Names = NamesShown::OnBoardAndPage; });
  }

  FakePipedProgram& Server() { return venue.Piped.At(0); }
  FakePipedProgram& Asker() { return venue.Piped.At(1); }

  /// Waits until the evening's earlier games are on the page.
  void AwaitEarlierGames() const {
    EXPECT_TRUE(QTest::qWaitFor([this] { return !Host().IsReading(); }, 20'000));
  }

  void Serve() {
    SwitchOn();
    AwaitEarlierGames();
    Server().OnOutput(ServedAt8080);
    Asker().OnOutput(PageAnswered);
  }

  /// The pages that the serving program has by now.
  std::map<std::string, std::string> Served() {
    std::map<std::string, std::string> pages;
    PageFrameReader reader;
    reader.Add(Server().Input);
    while (const auto frame = reader.Next()) {
      if (frame->Order == PageOrder::Put) {
        pages[frame->Path] = frame->Body;
      } else if (frame->Order == PageOrder::Remove) {
        pages.erase(frame->Path);
      }
    }
    EXPECT_FALSE(reader.Broken());
    return pages;
  }

  bool AnyServed(const std::string& text) {
    return std::ranges::any_of(Served(),
                               [&](const auto& page) { return page.second.find(text) != text.npos; });
  }

  bool IsServed(const std::string& path) { return Served().contains(path); }

  std::vector<std::string> NamesOnBoard() const {
    std::vector<std::string> names;
    for (const Standing& player : Board().State().Results().Players) {
      names.push_back(player.PublicName);
    }
    return names;
  }

  void NameGuest(const char* entry, const char* name) {
    const WhileModal<GuestNameEntry> window([&](GuestNameEntry& names) {
      Find<QLineEdit>(names, entry).setText(QString::fromUtf8(name));
      ::Press(names, "SaveExit");
    });
    venue.Trigger("mnuGuestNames");
    EXPECT_EQ(window.Runs(), 1);
  }

  void Hide(int row) {
    venue.Find<QTableView>("ScoreDisplay").selectRow(row);
    venue.Boxes.Answers = {BoxAnswer::Ok};
    venue.Trigger("mnuHidePlayer");
  }

  void LookAt(const std::function<void(ResultsPage&)>& look) const {
    const WhileModal<ResultsPage> open([&look](ResultsPage& window) {
      look(window);
      window.close();
    });
    venue.Trigger("mnuResultsPage");
    EXPECT_EQ(open.Runs(), 1);
  }

  Venue venue{GetParam()};
};
