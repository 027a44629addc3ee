#pragma once

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/MessageBoxes.h"

enum class CommitResult {
  Committed,
  SomeWereAlready,  ///< players were left out because their game had already been added
  Failed            ///< the database refused a player; those before it are committed, those after it are not
};

/// Adds the game of each active player with a member to that member's lifetime figures, and marks the player
/// `Committed`. A player whose member is gone is reported in a box and left out. All rows written are durable
/// on return, usually after a single wait for the disk. If the database fails on a player's row, the player
/// is marked although the row is unchanged: the game is then left out rather than counted twice. Whoever is
/// not marked is not in the file.
CommitResult CommitPlayers(Game& game, Database& dbMembers, Recordset& rsMembers, MemberLookup& members,
                           const Clock& clock);

/// Shows the operator the result.
void TellCommitResult(CommitResult result, MessageBoxes& boxes);
