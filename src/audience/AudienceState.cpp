#include "audience/AudienceState.h"

#include <numeric>
#include <utility>

namespace {

constexpr int TurnsToAddress = 4;  ///< the last of them shows the address

}  // namespace

AudienceState::AudienceState(std::function<AudienceResults()> results, std::function<void()> changed)
    : make_(std::move(results)), changed_(std::move(changed)) {}

void AudienceState::TurnOn() {
  if (std::exchange(isOn_, true)) {
    return;
  }
  if ((follows_ && isPulled_ && !pulling_) || isShown_) {
    Take();
  }
}

void AudienceState::SetAddress(const std::string& address) {
  if (address != address_) {
    address_ = address;
    Tell(View() == AudienceView::Results);
  }
}

void AudienceState::BeginPull() {
  pulling_ = true;
  received_ = 0;
  expected_ = 0;
  Tell(false);
}

void AudienceState::TellReceived(int received, int expected) {
  const bool isNew = received != received_ || expected != expected_;
  pulling_ = true;
  received_ = received;
  expected_ = expected;
  Tell(isNew && View() == AudienceView::Incoming);
}

void AudienceState::EndPull(bool withGuns) {
  pulling_ = false;
  if (withGuns) {
    isPulled_ = true;
    isShown_ = false;
    isAwaited_ = isOn_ && follows_;
  }
  Tell(false);
}

void AudienceState::ForgetGame() {
  isAwaited_ = false;
  isPulled_ = false;
  isShown_ = false;
}

void AudienceState::TellScored() {
  const bool isWanted = isShown_ || (follows_ && isPulled_);
  isAwaited_ = false;
  if (isOn_ && isWanted && !pulling_) {
    Take();
  }
  Tell(false);
}

void AudienceState::Take() {
  AudienceResults results = make_();
  if (results.IsEmpty()) {
    return;
  }
  shown_ = std::move(results);
  isShown_ = true;
  if (chosen_ != AudienceView::Blank) {
    chosen_ = AudienceView::Results;
    Tell(true);
  }
}

void AudienceState::ChangeResults(const std::function<void(AudienceResults&)>& change) {
  change(shown_);
  Tell(View() == AudienceView::Results);
}

void AudienceState::ShowResults() {
  AudienceResults results = pulling_ ? AudienceResults() : make_();
  if (!results.IsEmpty()) {
    shown_ = std::move(results);
    isShown_ = true;
  }
  if (!shown_.IsEmpty()) {
    chosen_ = AudienceView::Results;
    Tell(true);
  }
}

void AudienceState::ShowIdle() {
  isShown_ = false;
  isPulled_ = false;
  isAwaited_ = false;
  chosen_ = AudienceView::Idle;
  Tell(false);
}

void AudienceState::ShowBlank() {
  chosen_ = AudienceView::Blank;
  Tell(false);
}

void AudienceState::Tell(bool isNew) {
  if (isNew || View() != told_) {
    told_ = View();
    changed_();
  }
}

AudienceView AudienceState::View() const {
  return chosen_ == AudienceView::Idle && (pulling_ || isAwaited_) ? AudienceView::Incoming : chosen_;
}

AudienceTurn TurnOf(int number, int pages, bool hasAddress) {
  if (!hasAddress) {
    return {AudienceView::Results, number % pages};
  }
  if (number % TurnsToAddress == TurnsToAddress - 1) {
    return {AudienceView::Phone, 0};
  }
  return {AudienceView::Results, (number - number / TurnsToAddress) % pages};
}

int TurnCount(int pages, bool hasAddress) {
  return hasAddress ? std::lcm(pages, TurnsToAddress - 1) / (TurnsToAddress - 1) * TurnsToAddress : pages;
}
