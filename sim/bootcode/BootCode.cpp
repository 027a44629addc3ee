#include "sim/bootcode/BootCode.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "sim/bootcode/Qvm2Dialect.h"
#include "sim/bootcode/QvmDialect.h"

namespace sim {
namespace {

constexpr int LineBaud = 19200;
constexpr std::uint8_t LineNoise = 0xF8;
constexpr std::size_t ReplyOfProduct = 3;
// How soon an opening is noticed; only where it is watched for.
constexpr std::chrono::milliseconds WatchInterval{10};

void Check(const BootTrouble& trouble) {
  const BootFailureInfo& info = BootFailures.at(static_cast<std::size_t>(trouble.Failure));
  if (info.Place != FailurePlace::None && trouble.Place == 0) {
    throw std::invalid_argument(info.Place == FailurePlace::Frame ? "There is no packet 0"
                                                                  : "There is no reply 0");
  }
}

BootCodeSettings Checked(BootCodeSettings settings) {
  Check(settings.Trouble);
  return settings;
}

std::unique_ptr<BootDialect> MakeDialect(const BootCodeSettings& settings) {
  if (settings.Product == BootProduct::Qvm) {
    return std::make_unique<QvmDialect>(settings.FlashFile);
  }
  return std::make_unique<Qvm2Dialect>(settings.FlashFile);
}

std::vector<std::uint8_t> Boot() {
  return {'B', 'O', 'O', 'T'};
}

}  // namespace

BootCode::BootCode(BootCodeSettings settings)
    : Device({.LogName = "boot-code",
              .Understood = {{.Baud = LineBaud}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(Checked(std::move(settings))),
      dialect_(MakeDialect(settings_)),
      session_(*dialect_, [this](std::size_t packet) { return SpoiltAnswer(packet); }),
      openings_(settings_.PowerOnAfterOpening ? std::optional<OpenWatch>(std::in_place, DevicePath())
                                              : std::nullopt) {}

void BootCode::PowerOn(std::optional<BootTrouble> trouble) {
  if (trouble) {
    Check(*trouble);
  }
  {
    const std::scoped_lock lock(switchMutex_);
    switched_ = true;
    switchedWith_ = trouble;
  }
  Line().Nudge();
}

void BootCode::Run() {
  while (Line().IsUp()) {
    SwitchWhenDue();
    if (const std::optional<std::uint8_t> byte = Line().ReadByte(UntilDue())) {
      Take(*byte);
    } else if (session_.AwaitsQuiet() && Clock::now() - latest_ >= settings_.Gap) {
      Deal(session_.Quiet());
    }
    if (sender_) {
      sender_->SendDue();
    }
  }
}

std::optional<std::chrono::nanoseconds> BootCode::UntilDue() const {
  std::optional<std::chrono::nanoseconds> due = sender_ ? sender_->UntilDue() : std::nullopt;
  const auto notBefore = [&](std::chrono::nanoseconds other) {
    other = std::max(other, std::chrono::nanoseconds(0));
    due = due ? std::min(*due, other) : other;
  };
  if (session_.AwaitsQuiet()) {
    notBefore(latest_ + settings_.Gap - Clock::now());
  }
  if (openings_) {
    notBefore(WatchInterval);
  }
  return due;
}

void BootCode::SwitchWhenDue() {
  if (openings_ && openings_->TakeOpening()) {
    powerOnDue_ = Clock::now() + *settings_.PowerOnAfterOpening;
  }
  bool switched = powerOnDue_ && *powerOnDue_ <= Clock::now();
  std::optional<BootTrouble> with;
  {
    const std::scoped_lock lock(switchMutex_);
    switched = std::exchange(switched_, false) || switched;
    with = std::exchange(switchedWith_, std::nullopt);
  }
  if (switched) {
    powerOnDue_.reset();
    const bool troubled = settings_.Runs == 0 || powerOns_ < settings_.Runs;
    Start(with ? *with : troubled ? settings_.Trouble : BootTrouble{});
  }
}

void BootCode::Start(const BootTrouble& trouble) {
  trouble_ = trouble;
  ++powerOns_;
  replies_ = 0;
  heard_.clear();
  session_.SwitchOn();
  sender_.emplace(Line(), [this](const LinePiece& piece) {
    Log().ToHost(piece.Bytes);
    if (piece.LineEndsBehind) {
      Log().Note("line pulled out");
    }
  });
  Log().Note("switched on");
  Announce();
  traffic_.Note([&](BootCodeTraffic& traffic) {
    traffic.PowerOns = powerOns_;
    traffic.Replies = replies_;
  });
}

void BootCode::Announce() {
  ++replies_;
  if (Fails(BootFailure::NoiseBeforeBoot)) {
    Send({.Bytes = {0x00, LineNoise, 0x80, 0x0A}});
  } else if (Fails(BootFailure::StrayLetter)) {
    Send({.Bytes = {'B'}});
  }
  if (Strikes(BootFailure::Silence)) {
    return;
  }
  if (Strikes(BootFailure::Unplugged)) {
    Send({.Bytes = {'B', 'O'}, .LineEndsBehind = true});
    return;
  }
  if (Strikes(BootFailure::OtherReply)) {
    Send({.Bytes = {'?'}});
    return;
  }
  if (Strikes(BootFailure::NoiseBeforeReply)) {
    Send({.Bytes = {LineNoise}});
  }
  const bool late = Strikes(BootFailure::LateReply);
  Send({.Bytes = Boot(), .Torn = Fails(BootFailure::BootTorn)},
       late ? settings_.Late : std::chrono::milliseconds(0));
  if (Fails(BootFailure::BootTwice) || Strikes(BootFailure::DoubleReply)) {
    Send({.Bytes = Boot()});
  }
}

void BootCode::Take(std::uint8_t byte) {
  latest_ = Clock::now();
  heard_.push_back(byte);
  const std::optional<BootStep> step = session_.Take(byte);
  if (Fails(BootFailure::UnpluggedInPacket) && session_.PacketBytes() == 1 &&
      session_.Packet() == trouble_.Place) {
    Log().FromHost(heard_, "");
    HangUp();
  } else if (step) {
    Deal(*step);
  }
}

void BootCode::Deal(const BootStep& step) {
  Log().FromHost(std::exchange(heard_, {}), step.Note);
  if (!step.Fault.empty()) {
    NoteHostFault("the host " + step.Fault);
  }
  if (step.Answer) {
    Reply(*step.Answer);
  }
  traffic_.Note([&](BootCodeTraffic& traffic) {
    traffic.Replies = replies_;
    traffic.Downloads += step.Finished ? 1 : 0;
  });
}

void BootCode::Reply(std::uint8_t answer) {
  ++replies_;
  if (Fails(BootFailure::Silence) && replies_ >= trouble_.Place) {
    Log().Note("no reply");
    return;
  }
  if (Strikes(BootFailure::Unplugged)) {
    HangUp();
    return;
  }
  if (Fails(BootFailure::WrongProduct) && replies_ == ReplyOfProduct) {
    answer = answer == 'p' ? 'd' : 'p';
  }
  LinePiece piece{.Bytes = {Strikes(BootFailure::OtherReply) ? std::uint8_t{'?'} : answer}};
  if (Strikes(BootFailure::DoubleReply)) {
    piece.Bytes.push_back(answer);
  } else if (Strikes(BootFailure::NoiseBeforeReply)) {
    piece.Bytes.insert(piece.Bytes.begin(), LineNoise);
  }
  const bool late = Strikes(BootFailure::LateReply);
  Send(std::move(piece), late ? settings_.Late : std::chrono::milliseconds(0));
}

void BootCode::Send(LinePiece piece, std::chrono::milliseconds after) {
  sender_->Add(Clock::now() + after, std::move(piece));
}

void BootCode::HangUp() {
  Log().Note("line pulled out");
  Line().HangUp();
}

std::optional<std::uint8_t> BootCode::SpoiltAnswer(std::size_t packet) const {
  if (Fails(BootFailure::AsksAgain) && packet >= trouble_.Place &&
      packet < trouble_.Place + settings_.Times) {
    return 'c';
  }
  if (Fails(BootFailure::BadAddress) && packet == trouble_.Place) {
    return 'e';
  }
  return std::nullopt;
}

}  // namespace sim
