#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "archive/ArchiveAccess.h"
#include "core/game/HiddenNames.h"
#include "core/game/Session.h"
#include "exports/ExportSource.h"

/// The games of the archive for exports. Names of members are those of today, those of guests are
/// those of the game.
class ArchivedGames : public ExportSource {
 public:
  /// All must outlive this object; the session must be open. Names are looked up once: make an object for
  /// each export window. Names in `hidden` stand nowhere; null where none are hidden.
  ArchivedGames(ArchiveAccess& archives, Session& session, const StringTable& strings,
                const HiddenNames* hidden = nullptr);

  /// Those of these games that are there, the earliest first.
  std::vector<std::int64_t> InOrder(const std::vector<std::int64_t>& games);

  std::vector<std::int64_t> Of(const std::string& firstDay, const std::string& lastDay) override;
  void Read(std::int64_t gameId, const std::function<void(const ExportedGame&)>& take) override;
  void ReadFigures(const std::vector<std::int64_t>& games, bool fullNames,
                   const std::function<void(const PlayerFigures&)>& take) override;

 private:
  FullName FullNameOf(std::int32_t contactId);
  const FullName& KnownFullName(std::int64_t contactId);
  /// The name that is shown of a player with this member number, 0 without one, and guest name; empty where
  /// the gun stands.
  std::string NameShown(std::int64_t contactId, std::string_view guest);
  /// The member's public name; empty without one.
  const std::string& NickNameOf(std::int64_t contactId);
  /// Throws RuntimeError 9 for a record that no game has.
  const std::string& GunAt(int index) const;

  ArchiveAccess& archives_;
  Session& session_;
  const HiddenNames* const hidden_;
  std::array<std::string, PlayerCount> guns_;
  std::unordered_map<std::int64_t, std::string> names_;  ///< of members, empty for those without
  std::unordered_map<std::int64_t, FullName> fullNames_;
};
