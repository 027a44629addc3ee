#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "archive/ArchiveAccess.h"
#include "core/game/Session.h"
#include "exports/ExportSource.h"

/// The games of the archive for exports. Names of members are those of today; guests are named by their guns.
class ArchivedGames : public ExportSource {
 public:
  /// All must outlive this object; the session must be open. Names are looked up once: make an object for
  /// each export window.
  ArchivedGames(ArchiveAccess& archives, Session& session, const StringTable& strings);

  /// Those of these games that are there, the earliest first.
  std::vector<std::int64_t> InOrder(const std::vector<std::int64_t>& games);

  std::vector<std::int64_t> Of(const std::string& firstDay, const std::string& lastDay) override;
  void Read(std::int64_t gameId, const std::function<void(const ExportedGame&)>& take) override;
  void ReadFigures(const std::vector<std::int64_t>& games, bool fullNames,
                   const std::function<void(const PlayerFigures&)>& take) override;

 private:
  FullName FullNameOf(std::int32_t contactId);
  const FullName& KnownFullName(std::int64_t contactId);
  /// The member's public name, else the gun's.
  const std::string& NameOf(std::int64_t contactId, int index);

  ArchiveAccess& archives_;
  Session& session_;
  std::array<std::string, PlayerCount> guns_;
  std::unordered_map<std::int64_t, std::string> names_;  ///< of members, empty for those without
  std::unordered_map<std::int64_t, FullName> fullNames_;
};
