#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <vector>

#include "core/text/StringTable.h"
#include "exports/ExportSource.h"
#include "exports/GameExport.h"
#include "platform/Files.h"

/// What has become of an export of past games.
struct ExportOutcome {
  std::size_t Written = 0;  ///< games
  std::size_t LeftOut = 0;  ///< games that cannot be read
  bool Complete = false;    ///< false if it was stopped
};

/// Asked between games with the part done, 0 to 1; may process events. False stops the export.
using ExportStep = std::function<bool(double done)>;

/// Writes these past games into a file in the making, piece by piece, and finishes it unless it was stopped.
/// Throws RuntimeError as ExportSource and NewFile do.
ExportOutcome ExportPastGames(ExportSource& past, const std::vector<std::int64_t>& games,
                              const ExportChoice& choice, const StringTable& strings, NewFile& file,
                              const ExportStep& goOn);
