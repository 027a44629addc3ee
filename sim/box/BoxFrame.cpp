#include "sim/box/BoxFrame.h"

#include <string_view>

namespace sim {
namespace {

constexpr std::array<std::uint8_t, 2> Letters{'B', 'C'};
constexpr std::array<std::string_view, 9> Types{"Medic",        "Ammo",      "Respawn Any",
                                                "Repair",       "Multi",     "Respawn Dead",
                                                "Multi-Player", "Dom. (IR)", "Dom. (iBtn)"};
constexpr std::array<std::string_view, 4> Teams{"all teams", "red", "blue", "yellow"};
constexpr unsigned MostPoints = 100;

std::size_t TeamOf(const BoxFrame& frame) {
  return frame[2] >> 4U;
}

std::size_t TypeOf(const BoxFrame& frame) {
  return frame[2] & 15U;
}

}  // namespace

std::optional<std::string> WrongIn(const BoxFrame& frame) {
  if (TeamOf(frame) >= Teams.size()) {
    return "a team of " + std::to_string(TeamOf(frame));
  }
  if (TypeOf(frame) >= Types.size()) {
    return "a type of " + std::to_string(TypeOf(frame));
  }
  for (std::size_t i = 3; i <= 5; ++i) {
    if (frame[i] > MostPoints) {
      return std::to_string(frame[i]) + " in byte " + std::to_string(i) + ", where 100 is the most";
    }
  }
  if (frame[7] > 1) {
    return std::to_string(frame[7]) + " for a yes or no";
  }
  if (frame[8] != 0 || frame[9] != 0) {
    return "something in the last two bytes";
  }
  return std::nullopt;
}

std::string Describe(const BoxFrame& frame) {
  return std::string(Types.at(TypeOf(frame))) + ", " + std::string(Teams.at(TeamOf(frame))) + ", " +
         std::to_string(frame[3]) + " points per activation, " + std::to_string(frame[4]) + " to recharge, " +
         std::to_string(frame[5]) + " to give, automatic after " + std::to_string(frame[6] * 10) + " s, " +
         (frame[7] != 0 ? "destroyable" : "not destroyable");
}

std::optional<BoxFrame> BoxFrameReader::Take(std::uint8_t byte) {
  if (count_ < Letters.size() && byte != Letters.at(count_)) {
    count_ = 0;
    if (byte != Letters[0]) {
      return std::nullopt;
    }
  }
  frame_.at(count_) = byte;
  if (++count_ < frame_.size()) {
    return std::nullopt;
  }
  count_ = 0;
  return frame_;
}

}  // namespace sim
