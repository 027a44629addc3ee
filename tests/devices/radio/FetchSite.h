#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <map>

#include "core/line/Checksum.h"
#include "devices/radio/ScoreFetch.h"
#include "tests/devices/radio/RadioSite.h"
#include "tests/support/Frames.h"

/// The scores of Red 1 as a block of `length` bytes, 52 or more; unknown fields fill it up.
inline Bytes BlockOfRed1(std::size_t length) {
  Bytes block = FrameOfRed1();
  block.pop_back();
  block.insert(block.begin() + 45, length - block.size(), 0);
  block[0] = static_cast<std::uint8_t>(length % 256);
  block[1] = static_cast<std::uint8_t>(length / 256);
  block[2] = static_cast<std::uint8_t>((length - 11) % 256);
  block[3] = static_cast<std::uint8_t>((length - 11) / 256);
  return block;
}

/// One gun at the far end.
struct SiteGun {
  Bytes Block;
  int Total = -1;  ///< what it says when that is not the block's length
  std::function<bool(const Bytes&)> Silent = [](const Bytes&) { return false; };  ///< for these packets
};

class Fetch : public testing::Test, protected RadioSite {
 protected:
  Fetch() {
    OnPacket = [this](const Bytes& packet) { Answer(packet); };
  }

  /// A gun that a search has found.
  SiteGun& PutGun(std::uint8_t playerId, Bytes block) {
    GunEntry& gun = guns[playerId - 32U];
    gun.Present = true;
    gun.PlayerID = playerId;
    gun.Address = {playerId, 2, 1, 0x40, 0, 0xA2, 0x13, 0};
    SiteGun& there = site[playerId];
    there.Block = std::move(block);
    return there;
  }

  void GetScores() {
    RadioLink link(Port, Line, Events, [this] { return stopped; });
    ScoreFetch(link, Events, Time, Strings, game, guns, display).GetScores();
    try {
      link.ThrowIfLineLost();
    } catch (const RuntimeError& error) {
      lineFault = error.Number();
    }
  }

  int FaultOfGetScores() {
    try {
      GetScores();
    } catch (const RuntimeError& error) {
      return error.Number();
    }
    return 0;
  }

  ScoreStatus StatusOf(std::uint8_t playerId) const { return guns[playerId - 32U].ScoreStatus; }
  const Player& Red1() const { return game.Players(2); }

  /// Packets of one command, of which `command` is the number.
  int CountOf(std::uint8_t command) const {
    const std::vector<Bytes> packets = Packets();
    return static_cast<int>(std::count_if(packets.begin(), packets.end(),
                                          [&](const Bytes& packet) { return packet[5] == command; }));
  }

  void Answer(const Bytes& packet) {
    const SiteGun& gun = site.at(packet[1]);
    if (!gun.Silent(packet)) {
      Arrive(20, Received(packet[1], Alter(AnswerOf(gun, packet))));
    }
  }

  static Bytes AnswerOf(const SiteGun& gun, const Bytes& packet) {
    const std::uint8_t id = packet[1];
    if (packet[5] == 1) {
      const int total = gun.Total >= 0 ? gun.Total : static_cast<int>(gun.Block.size());
      return {4,
              id,
              0,
              0,
              5,
              1,
              static_cast<std::uint8_t>(total % 255),
              static_cast<std::uint8_t>(total / 255),
              Crc8(gun.Block)};
    }
    if (packet[5] == 3) {
      return {1, id, 0, 0, 5, 3};
    }
    const std::size_t start = packet[6];
    const std::size_t count = packet[7];
    Bytes data;
    for (std::size_t i = start; i < start + count; ++i) {
      data.push_back(i < gun.Block.size() ? gun.Block[i] : 0);
    }
    return Joined({{static_cast<std::uint8_t>(3 + count), id, 0, 0, 5, 2, static_cast<std::uint8_t>(start),
                    static_cast<std::uint8_t>(count - 1)},
                   data});
  }

  std::map<int, SiteGun> site;
  std::function<Bytes(Bytes)> Alter = [](Bytes answer) { return answer; };
  Game game{Strings};
  GunTable guns;
  FakeRadioDisplay display;
  bool stopped = false;
  int lineFault = 0;
};
