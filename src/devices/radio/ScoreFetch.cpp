#include "devices/radio/ScoreFetch.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <string>
#include <utility>

#include "core/line/Checksum.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

using std::chrono::milliseconds;

namespace {

constexpr std::uint8_t ScoreSize = 1;
constexpr std::uint8_t ReadBlock = 2;
constexpr std::uint8_t CloseTransfer = 3;
constexpr int BlockLength = 90;
constexpr int MostRetries = 3;
constexpr milliseconds RetryPause{50};

bool WantsScores(const GunEntry& gun) {
  return gun.Present && (gun.ScoreStatus == ScoreStatus::Pending || gun.ScoreStatus == ScoreStatus::Failed);
}

/// The guns split the size by 255, not 256.
int TotalOf(const GunPacket& answer) {
  return answer.Payload[2] * 255 + answer.Payload[1];
}

int BlocksIn(int total) {
  const int blocks = RoundToInt32(static_cast<long double>(total) / BlockLength);
  return blocks * BlockLength < total ? blocks + 1 : blocks;
}

}  // namespace

ScoreFetch::ScoreFetch(RadioLink& link, EventPump& events, const Clock& clock, const StringTable& strings,
                       Game& game, GunTable& guns, RadioDisplay& display, std::function<void(int)> beforeGun)
    : link_(link),
      events_(events),
      clock_(clock),
      strings_(strings),
      game_(game),
      guns_(guns),
      display_(display),
      beforeGun_(std::move(beforeGun)) {}

void ScoreFetch::GetScores() {
  link_.OpenXBeePort();
  display_.SetStatus("Getting Scores...");
  const auto wanted = static_cast<int>(std::count_if(guns_.begin(), guns_.end(), WantsScores));
  int fetched = 0;
  for (int index = 0; index < GunCount && !link_.Stopped(); ++index) {
    events_.DoEvents();
    if (WantsScores(guns_[static_cast<std::size_t>(index)])) {
      display_.SetProgress(Filled(strings_.Text(OwnText::FetchProgress),
                                  {std::to_string(fetched + 1), std::to_string(wanted)}),
                           fetched, wanted);
      FetchGun(index);
      ++fetched;
    }
  }
  display_.SetStatus("Done");
  link_.XBee_CloseCommPort();
}

void ScoreFetch::FetchGun(int index) {
  GunEntry& gun = guns_[static_cast<std::size_t>(index)];
  const auto playerId = static_cast<std::uint8_t>(FirstGunId + index);
  gun.ScoreStatus = ScoreStatus::InProgress;
  display_.RefreshGunList();
  for (int retries = 0; gun.ScoreStatus == ScoreStatus::InProgress; ++retries) {
    Attempt(gun, playerId);
    if (gun.ScoreStatus != ScoreStatus::InProgress) {
      break;
    }
    if (retries == MostRetries || link_.Stopped()) {
      gun.ScoreStatus = ScoreStatus::Failed;
    } else {
      events_.Sleep(RetryPause);
    }
  }
  display_.RefreshGunList();
}

void ScoreFetch::Attempt(GunEntry& gun, std::uint8_t playerId) {
  if (!Command(gun, playerId, std::array{ScoreSize})) {
    return;
  }
  const int total = TotalOf(answer_);
  const std::uint8_t check = answer_.Payload[3];
  if (FetchBlocks(gun, playerId, total) < total ||
      Crc8(std::span(buffer_).first(static_cast<std::size_t>(total))) != check) {
    return;
  }
  if (beforeGun_) {
    beforeGun_(IndexFromId(buffer_[4]));
  }
  AnalyseData(buffer_, game_, clock_);
  if (Command(gun, playerId, std::array{CloseTransfer}) && answer_.Payload[0] == CloseTransfer) {
    gun.ScoreStatus = ScoreStatus::Ok;
  }
}

bool ScoreFetch::Command(const GunEntry& gun, std::uint8_t playerId, std::span<const std::uint8_t> payload) {
  events_.DoEvents();
  while (link_.TakeFrame()) {
    // drops late answers to earlier commands, which would pass for the answer to this one
  }
  link_.SendGunPacket(playerId, gun.Address, 0, 0, GunPacketType::Command, payload);
  if (!link_.WaitForFrame(true)) {
    return false;
  }
  // A status frame may come along with the answer: the data received last counts. It is kept, because what
  // begins behind it is written over it.
  ReceivedFrame received = link_.Frame();
  while (link_.TakeFrame()) {
    if (link_.ReceivedFrameType() == XBeeApi::Receive64) {
      received = link_.Frame();
    }
  }
  answer_ = ReadGunPacket(received);
  return answer_.Type == GunPacketType::CommandAnswer;
}

int ScoreFetch::FetchBlocks(const GunEntry& gun, std::uint8_t playerId, int total) {
  const std::uint8_t lastBlock = ByteOf(BlocksIn(total) - 1);
  int received = 0;
  int position = 0;
  for (int block = 0; block <= lastBlock && !link_.Stopped(); ++block) {
    const int count = std::min(BlockLength, total - position);
    position += count;
    const std::array request = {ReadBlock, ByteOf(block * BlockLength), ByteOf(count)};
    if (Command(gun, playerId, request) && answer_.Payload[0] == ReadBlock) {
      received += TakeBlock();
    }
  }
  return received;
}

int ScoreFetch::TakeBlock() {
  constexpr std::size_t dataOffset = 3;  // in the payload
  const std::size_t start = answer_.Payload[1];
  const std::size_t length = answer_.Payload[2] + 1U;
  if (dataOffset + length > answer_.Payload.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  std::copy_n(answer_.Payload.begin() + dataOffset, length,
              buffer_.begin() + static_cast<std::ptrdiff_t>(start));
  return static_cast<int>(length);
}
