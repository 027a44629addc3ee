#include "web/ResultsHost.h"

#include <utility>
#include <vector>

#include "platform/RuntimeError.h"
#include "web/EveningTime.h"
#include "web/PageAddress.h"

using namespace std::chrono_literals;

namespace {

constexpr std::chrono::milliseconds LookEvery = 5s;
constexpr int LooksToReplace = 6;  ///< without an answer
constexpr int LooksToRanking = 12;

}  // namespace

struct ResultsHost::Running {
  explicit Running(const Parts& parts)
      : Program(parts.MakeProgram()),
        Asker(parts.MakeProgram()),
        Pages(parts.Strings.TextLanguage()),
        Server(*Program, parts.Elapsed, Pages, parts.Path),
        Probe(*Asker, parts.Path) {}

  std::unique_ptr<PipedProgram> Program;
  std::unique_ptr<PipedProgram> Asker;
  ResultsPages Pages;
  PageServer Server;
  PageProbe Probe;
  EveningGames Evening;
  bool IsListed = false;              ///< the games that were kept earlier this evening are in Earlier
  std::vector<std::int64_t> Earlier;  ///< those that are still to be read, the first one last
  QTimer Reading;
  std::string Address;  ///< at which the pages are to be served; empty for none
  std::uint16_t AskedPort = 0;
  int Looks = 0;
  int Unanswered = 0;  ///< looks in a row that found no answer
  QTimer Timer;
};

ResultsHost::ResultsHost(const Parts& parts)
    : parts_(parts),
      setup_(ReadPageSetup(parts.Ini)),
      subscription_(parts.Session.Listen([this](SessionChange change) { Hear(change); })) {}

ResultsHost::~ResultsHost() = default;

void ResultsHost::Begin() {
  if (setup_.On && !IsOn()) {
    TurnOn();
  }
}

void ResultsHost::End() {
  subscription_.End();
  setup_.On = false;  // in this run; a start that is still due finds nothing to do
  running_.reset();
}

void ResultsHost::SetSetup(const PageSetup& setup) {
  WritePageSetup(parts_.Ini, setup_, setup);
  const PageSetup before = std::exchange(setup_, setup);
  if (setup.On && !IsOn()) {
    TurnOn();
  } else if (!setup.On && IsOn()) {
    TurnOff();
  } else if (IsOn()) {
    if (setup.Address != before.Address || setup.Port != before.Port) {
      ServeAt(AddressToServe(parts_.Addresses.Private(), setup.Address));
    }
    running_->Pages.SetGames(static_cast<std::size_t>(setup.Games));
    Publish(false);
    PutAll();
  }
  if (setup.Names != before.Names) {
    emit NamesChanged();
  }
  emit Changed();
}

std::string ResultsHost::NameOnBoard(const NameHolder& holder) const {
  return setup_.Names != NamesShown::Nowhere ? parts_.Hidden.NameShown(holder) : std::string();
}

std::string ResultsHost::NameOnPage(const NameHolder& holder) const {
  return setup_.Names == NamesShown::OnBoardAndPage ? parts_.Hidden.NameShown(holder) : std::string();
}

void ResultsHost::ShowOtherNames() {
  if (IsOn()) {
    NameAnew();
    TakeGame();
    PutAll();
  }
}

void ResultsHost::Follow() {
  if (IsOn()) {
    Publish(false);
  }
}

PageServing ResultsHost::Serving() const {
  return IsOn() ? running_->Server.State() : PageServing();
}

std::string ResultsHost::Address() const {
  return IsOn() ? running_->Address : std::string();
}

std::string ResultsHost::Url() const {
  const bool isThere = IsOn() && Serving().Now == PageServing::Phase::Serving && running_->Probe.Answered();
  return isThere ? UrlOfPages(running_->Address, Serving().Port) : std::string();
}

void ResultsHost::TurnOn() {
  running_ = std::make_unique<Running>(parts_);
  running_->Pages.SetGames(static_cast<std::size_t>(setup_.Games));
  running_->Server.OnChange = [this] { HearServer(); };
  running_->Probe.OnChange = [this] { emit Changed(); };
  connect(&running_->Reading, &QTimer::timeout, this, &ResultsHost::ReadEarlier);
  running_->Reading.start(0);
  PutRanking();
  ServeWhereItBelongs();
  connect(&running_->Timer, &QTimer::timeout, this, &ResultsHost::Look);
  running_->Timer.start(LookEvery);
}

void ResultsHost::TurnOff() {
  const std::unique_ptr<Running> gone = std::move(running_);
  gone->Server.OnChange = nullptr;
  gone->Probe.OnChange = nullptr;
}

void ResultsHost::HearServer() {
  const PageServing state = Serving();
  const std::uint16_t port = state.Now == PageServing::Phase::Serving ? state.Port : std::uint16_t{0};
  if (std::exchange(running_->AskedPort, port) != port) {
    running_->Unanswered = 0;
    if (port != 0) {
      running_->Probe.Ask(running_->Address, port);
    } else {
      running_->Probe.Forget();
    }
  }
  emit Changed();
}

void ResultsHost::ServeWhereItBelongs() {
  const std::string address = AddressToServe(parts_.Addresses.Private(), setup_.Address);
  if (address != running_->Address) {
    ServeAt(address);
  }
}

void ResultsHost::ServeAt(const std::string& address) {
  running_->Address = address;
  running_->AskedPort = 0;
  running_->Probe.Forget();
  if (address.empty()) {
    running_->Server.SwitchOff();
  } else {
    running_->Server.SwitchOn(address, setup_.Port);
  }
  emit Changed();
}

void ResultsHost::Look() {
  if (!IsOn()) {
    return;
  }
  ++running_->Looks;
  const std::chrono::microseconds now = parts_.Elapsed.Elapsed();
  running_->Evening.Prune(now);
  running_->Pages.Prune(now);
  if (running_->Looks % LooksToRanking == 0) {
    PutRanking();
  }
  running_->Server.Update();
  ServeWhereItBelongs();
  if (running_->AskedPort != 0) {
    running_->Unanswered = running_->Probe.Answered() ? 0 : running_->Unanswered + 1;
    if (running_->Unanswered < LooksToReplace) {
      running_->Probe.Ask(running_->Address, running_->AskedPort);
    } else {
      running_->Server.Replace();
    }
  }
}

void ResultsHost::Hear(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      isLoaded_ = false;
      isScored_ = false;
      if (IsOn()) {
        running_->Evening.ForgetBoard();
      }
      break;
    case SessionChange::Loaded:
      isLoaded_ = true;
      isScored_ = false;
      break;
    case SessionChange::Scores:
      isScored_ = true;
      if (IsOn()) {
        TakeGame();
      }
      break;
    default:
      break;
  }
}

void ResultsHost::NameAnew() {
  Session& session = parts_.Session;
  try {
    const ReadScope scope(session.DbMembers());
    running_->Evening.NameAnew([&session](std::int32_t id) { return session.Members().NickNameOf(id); });
  } catch (const RuntimeError&) {  // what cannot be looked up may have been taken off
    running_->Evening.NameAnew([](std::int32_t) { return std::string(); });
  }
}

bool ResultsHost::IsReading() const {
  return IsOn() && running_->Reading.isActive();
}

void ResultsHost::ReadEarlier() {
  if (!std::exchange(running_->IsListed, true)) {
    ListEarlier();
  } else if (!running_->Earlier.empty()) {
    const std::int64_t game = running_->Earlier.back();
    running_->Earlier.pop_back();
    TakeEarlier(game);
  }
  if (running_->Earlier.empty()) {
    running_->Reading.stop();
    running_->Server.Update();
    TakeGame();
  }
}

void ResultsHost::ListEarlier() {
  const auto now = TimeIn(parts_.Time.Now());
  if (!now) {
    return;
  }
  try {
    running_->Earlier = parts_.Kept.Games(TextOf(*now - EveningGames::Age));
  } catch (const RuntimeError&) {
    // The archive is locked or damaged, which is told elsewhere: the evening begins with the next game.
  }
  if (running_->Earlier.size() > EveningGames::Most) {
    running_->Earlier.resize(EveningGames::Most);
  }
}

void ResultsHost::TakeEarlier(std::int64_t number) {
  int taken = 0;
  try {
    const ReadScope scope(parts_.Session.DbMembers());
    parts_.Kept.Read(number, [&](const KeptGame& kept) {
      if (const auto played = ThisEvening(kept.Played)) {
        taken = running_->Evening.TakeEarlier(
            {.Game = kept.Game,
             .Time = played->Text,
             .Played = played->Since,
             .OfMembers = [this](std::int32_t id) { return parts_.Session.Members().NickNameOf(id); },
             .OfGuests = kept.OfGuests});
      }
    });
  } catch (const RuntimeError&) {
    return;  // the other games are shown all the same
  }
  const bool isShown = running_->Earlier.size() < static_cast<std::size_t>(setup_.Games);
  if (taken != 0 && isShown) {
    Put(running_->Evening.All().at(taken));
  }
}

std::optional<ResultsHost::Moment> ResultsHost::ThisEvening(const std::string& stamp) const {
  const auto now = TimeIn(parts_.Time.Now());
  const auto time = TimeIn(stamp);
  if (now && time && *now - *time < EveningGames::Age && *time - *now < EveningGames::Age) {
    return Moment{parts_.Elapsed.Elapsed() - (*now - *time), HoursAndMinutes(stamp)};
  }
  return std::nullopt;
}

std::optional<ResultsHost::Moment> ResultsHost::Played() const {
  const std::string now = parts_.Time.Now();
  if (auto played = ThisEvening(parts_.Time.Stamp(parts_.Session.Game().GameDate))) {
    return played;
  }
  return isLoaded_ ? std::nullopt : std::optional(Moment{parts_.Elapsed.Elapsed(), HoursAndMinutes(now)});
}

void ResultsHost::TakeGame() {
  Session& session = parts_.Session;
  const auto played = Played();
  if (!isScored_ || !session.Game().DataPresent || parts_.Pulling() || IsReading() || !played) {
    return;
  }
  const auto take = [&](const NickNames& nickNames) {
    return running_->Evening.Take({.Game = session.Game(),
                                   .Time = played->Text,
                                   .Played = played->Since,
                                   .OfMembers = nickNames,
                                   .OfGuests = [this](int index) { return parts_.Guests.NameOf(index); }});
  };
  bool isNew = false;
  try {
    const ReadScope scope(session.DbMembers());
    isNew = take([&session](std::int32_t contactId) { return session.Members().NickNameOf(contactId); });
  } catch (const RuntimeError&) {  // their guns are known all the same
    isNew = take([](std::int32_t) { return std::string(); });
  }
  Publish(isNew);
}

void ResultsHost::Publish(bool hasChanged) {
  const auto found = running_->Evening.All().find(running_->Evening.OnBoard());
  if (found == running_->Evening.All().end()) {
    return;
  }
  EveningGame& game = found->second;
  if (!game.IsPublic && setup_.WithBoard && parts_.AwaitsBoard()) {
    return;
  }
  const bool appears = !std::exchange(game.IsPublic, true);
  if (appears || hasChanged) {
    Put(game);
    running_->Server.Update();
  }
}

void ResultsHost::Put(const EveningGame& game) {
  running_->Pages.Put(PublicGameOf(game, [this](const NameHolder& holder) { return NameOnPage(holder); }),
                      game.Since);
}

void ResultsHost::PutAll() {
  std::vector<const EveningGame*> games;
  for (const auto& [number, game] : running_->Evening.All()) {
    if (game.IsPublic) {
      games.push_back(&game);
    }
  }
  const auto most = static_cast<std::size_t>(setup_.Games);
  for (std::size_t at = games.size() > most ? games.size() - most : 0; at < games.size(); ++at) {
    Put(*games[at]);
  }
  PutRanking();
  running_->Server.Update();
}

void ResultsHost::PutRanking() {
  if (!setup_.Ranking || setup_.Names != NamesShown::OnBoardAndPage) {
    running_->Pages.SetRanking(std::nullopt);
    return;
  }
  try {
    const PublicRanking ranking = parts_.Ranks();
    running_->Pages.SetRanking(ResultsPages::MonthRanking{
        ranking.Month,
        RankedLines(ranking, [this](const NameHolder& holder) { return NameOnPage(holder); })});
  } catch (const RuntimeError&) {
    // The archive is locked or damaged. The ranking that was shown may hold a name that is to go.
    running_->Pages.SetRanking(std::nullopt);
  }
}
