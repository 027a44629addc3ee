#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "sim/line/PacedSender.h"
#include "sim/radio/RadioFailure.h"
#include "sim/radio/RadioGun.h"

namespace sim {

/// Which failure strikes whom and how often.
struct RadioTroubleSettings {
  RadioFailure Failure = RadioFailure::None;
  std::size_t Gun = 1;  ///< from 1, in the order of the player ids; 0: every gun
  int Times = 0;        ///< how many answers of each gun it strikes; 0: all
};

/// Makes the guns' answers, with the failure built in.
class RadioTrouble {
 public:
  /// Lengthens the scores of the stricken `guns` if that is the failure. Throws std::invalid_argument if
  /// there is no such gun.
  RadioTrouble(const RadioTroubleSettings& settings, std::vector<RadioGun>& guns);

  /// What the modem sends, in this order, when `gun` answers `request`.
  std::vector<LinePiece> Answer(const RadioGun& gun, const GunRequest& request);

  /// Hands over what was kept back for the next search, to be sent before the answer to that.
  std::vector<LinePiece> KeptBack();

 private:
  bool Strikes(const RadioGun& gun, const GunRequest& request);
  std::vector<LinePiece> Spoil(const RadioGun& gun, const GunRequest& request,
                               std::vector<std::uint8_t> packet);

  RadioTroubleSettings settings_;
  std::optional<GunCommand> concerned_;
  std::optional<std::uint8_t> stricken_;  // player id; none: every gun
  std::map<std::uint8_t, int> strikes_;   // by player id
  std::map<std::uint8_t, std::vector<std::uint8_t>> latestPackets_;
  std::vector<LinePiece> keptBack_;
};

}  // namespace sim
