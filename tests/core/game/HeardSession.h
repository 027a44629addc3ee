#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/support/OpenSession.h"

using Change = SessionChange;

constexpr int Red0 = 1;
constexpr int Blue7 = 40;

/// A session to which a test listens.
class Sessions : public testing::Test {
 protected:
  void AddMissions() {
    ExecuteSql(venue.ScenariosFile(),
               "INSERT INTO Table1 (ID, MissionName, MissionDescription, RespawnPenalty) VALUES "
               "(3, 'Bridge', 'Hold it' || char(13) || char(10) || 'and more', 0), (5, 'Keep', '', 4), "
               "(9, 'Bridge', 'Blow it up', 0)");
  }

  void AddMember() {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, DallasID, NickName) VALUES (7, 'AB00000000000001', 'Mole')");
  }

  /// Opens the session and listens from then on.
  void Start() {
    ASSERT_TRUE(venue.Open());
    subscription = session.Listen([this](Change change) { told.push_back(change); });
  }

  std::vector<std::string> Players() const { return venue.Column(BoardList::Players, BoardColumn::Player); }

  OpenSession venue;
  Session& session = venue.session;
  std::vector<Change> told;
  Subscription subscription;
};
