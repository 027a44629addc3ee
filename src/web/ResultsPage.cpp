#include "web/ResultsPage.h"

#include <QScopeGuard>
#include <algorithm>
#include <optional>

#include "core/text/Filled.h"
#include "ui/Captions.h"
#include "ui/QrCode.h"
#include "ui/Text.h"
#include "ui_ResultsPage.h"
#include "web/PageAddress.h"
#include "web/ServerEnd.h"

namespace {

/// What an operator can do about the end of the program that serves the page; none where the next start may
/// well do.
std::optional<OwnText> WhyPagesEnded(int exitCode) {
  if (exitCode == PipedProgram::NotStarted) {
    return OwnText::PageProgramMissing;
  }
  switch (static_cast<ServerEnd>(exitCode)) {
    case ServerEnd::BadOrders:
      return OwnText::PagesRefused;
    case ServerEnd::NoAddress:
      return OwnText::PageNoPort;
    case ServerEnd::NotConfined:
      return OwnText::PageNotConfined;
    case ServerEnd::BadWords:
      return OwnText::PageProgramMissing;
    case ServerEnd::ParentGone:
      break;
  }
  return std::nullopt;
}

}  // namespace

ResultsPage::ResultsPage(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ResultsPage>()),
      parts_(parts),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetUpTexts();
  ListAddresses();
  Fill();
  ListHidden();
  ConnectEntries();
  connect(&parts_.Host, &ResultsHost::Changed, this, &ResultsPage::ShowState);
  ShowState();
}

ResultsPage::~ResultsPage() = default;

void ResultsPage::SetUpTexts() {
  const auto number = [](OwnText text) { return static_cast<int>(text); };
  SetCaptions(parts_.Strings, {{this, number(OwnText::ResultsPageTitle)},
                               {ui_->PageOn, number(OwnText::PageOn)},
                               {ui_->AddressLabel, number(OwnText::PageAddressLabel)},
                               {ui_->PortLabel, number(OwnText::PagePort)},
                               {ui_->GamesLabel, number(OwnText::PageGames)},
                               {ui_->NamesLabel, number(OwnText::PageNames)},
                               {ui_->NewGameLabel, number(OwnText::PageNewGame)},
                               {ui_->MonthRanking, number(OwnText::PageRanking)},
                               {ui_->HiddenLabel, number(OwnText::PageHidden)},
                               {ui_->ShowAgain, number(OwnText::PageShowAgain)},
                               {ui_->PrintPoster, number(OwnText::PagePoster)},
                               {ui_->Privacy, number(OwnText::PagePrivacy)},
                               {ui_->Close, 137}});
  ui_->QrPicture->setAccessibleName(Text(parts_.Strings, OwnText::PageQrTip));
  ui_->PageNames->addItems(TextList(parts_.Strings, OwnText::PageNameChoices));
  ui_->NewGame->addItems(TextList(parts_.Strings, OwnText::PageNewGameChoices));
}

void ResultsPage::ListAddresses() {
  const StringTable& strings = parts_.Strings;
  const std::vector<LocalAddress> present = parts_.Addresses.Private();
  const std::string proposed = AddressToServe(present, {});
  addresses_ = {std::string()};
  ui_->PageAddress->addItem(
      QString::fromStdString(Filled(strings.Text(OwnText::PageAutomatic),
                                    {proposed.empty() ? strings.Text(OwnText::PageNoNetwork) : proposed})));
  for (const LocalAddress& each : present) {
    const bool isOwn = each.Address.starts_with("127.");
    const QString where =
        isOwn ? Text(strings, OwnText::PageThisComputer) : QString::fromStdString(each.Interface);
    addresses_.push_back(each.Address);
    ui_->PageAddress->addItem(QStringLiteral("%1 (%2)").arg(QString::fromStdString(each.Address), where));
  }
  const std::string& chosen = parts_.Host.Setup().Address;
  if (std::ranges::find(addresses_, chosen) == addresses_.end()) {  // the computer does not have it now
    addresses_.push_back(chosen);
    ui_->PageAddress->addItem(QString::fromStdString(chosen));
  }
}

void ResultsPage::Fill() {
  using namespace PageLimits;
  const PageSetup& setup = parts_.Host.Setup();
  const auto chosen = std::ranges::find(addresses_, setup.Address);
  ui_->PageOn->setChecked(setup.On);
  ui_->PageAddress->setCurrentIndex(static_cast<int>(chosen - addresses_.begin()));
  ui_->PagePort->setRange(LeastPort, MostPort);
  ui_->PagePort->setValue(setup.Port);
  ui_->PagePort->setKeyboardTracking(false);  // a port that is being typed is none yet
  ui_->PageGames->setRange(LeastGames, MostGames);
  ui_->PageGames->setValue(setup.Games);
  ui_->PageGames->setKeyboardTracking(false);
  ui_->PageNames->setCurrentIndex(static_cast<int>(setup.Names));
  ui_->NewGame->setCurrentIndex(setup.WithBoard ? 1 : 0);
  ui_->MonthRanking->setChecked(setup.Ranking);
}

void ResultsPage::ConnectEntries() {
  const auto apply = [this] { commands_.Run([this] { Apply(); }); };
  connect(ui_->PageOn, &QCheckBox::toggled, this, apply);
  connect(ui_->MonthRanking, &QCheckBox::toggled, this, apply);
  for (QComboBox* list : {ui_->PageAddress, ui_->PageNames, ui_->NewGame}) {
    connect(list, &QComboBox::currentIndexChanged, this, apply);
  }
  for (QSpinBox* entry : {ui_->PagePort, ui_->PageGames}) {
    connect(entry, &QSpinBox::valueChanged, this, apply);
  }
  connect(ui_->HiddenPlayers, &QListWidget::itemSelectionChanged, this,
          [this] { ui_->ShowAgain->setEnabled(!ui_->HiddenPlayers->selectedItems().isEmpty()); });
  commands_.Connect(*ui_->ShowAgain, [this] { ShowAgain(); });
  commands_.Connect(*ui_->PrintPoster, [this] { parts_.PrintPoster(parts_.Host.Url()); });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
}

void ResultsPage::Apply() {
  PageSetup setup;
  setup.On = ui_->PageOn->isChecked();
  setup.Address = addresses_.at(static_cast<std::size_t>(ui_->PageAddress->currentIndex()));
  setup.Port = static_cast<std::uint16_t>(ui_->PagePort->value());
  setup.Names = static_cast<NamesShown>(ui_->PageNames->currentIndex());
  setup.Games = ui_->PageGames->value();
  setup.WithBoard = ui_->NewGame->currentIndex() == 1;
  setup.Ranking = ui_->MonthRanking->isChecked();
  parts_.Host.SetSetup(setup);
}

void ResultsPage::ShowState() {
  const std::string url = parts_.Host.Url();
  ui_->PageState->setText(StateText());
  ui_->PageUrl->setText(QString::fromStdString(url));
  ui_->PrintPoster->setEnabled(!url.empty());
  if (url != shownUrl_) {
    shownUrl_ = url;
    const QImage code = QrCode(url);
    constexpr int pixels = 6;  // a module
    ui_->QrPicture->setPixmap(code.isNull() ? QPixmap()
                                            : QPixmap::fromImage(code.scaled(code.size() * pixels)));
  }
}

QString ResultsPage::StateText() const {
  const StringTable& strings = parts_.Strings;
  const ResultsHost& host = parts_.Host;
  const PageServing serving = host.Serving();
  const auto filled = [&strings](OwnText text, std::initializer_list<std::string_view> values) {
    return QString::fromStdString(Filled(strings.Text(text), values));
  };
  if (!host.IsOn()) {
    return Text(strings, OwnText::PageIsOff);
  }
  switch (serving.Now) {
    case PageServing::Phase::Off:
      return Text(strings, OwnText::PageNoAddress);
    case PageServing::Phase::Starting:
      return Text(strings, OwnText::PageStarting);
    case PageServing::Phase::Pausing:
      return PausingText(serving);
    case PageServing::Phase::Serving:
      break;
  }
  if (host.Url().empty()) {
    return filled(OwnText::PageUnanswered, {UrlOfPages(host.Address(), serving.Port)});
  }
  QString text = filled(OwnText::PageServes, {std::to_string(serving.Visitors)});
  if (serving.Port != host.Setup().Port) {
    text += QLatin1Char('\n');
    text += filled(OwnText::PageOtherPort, {std::to_string(host.Setup().Port), std::to_string(serving.Port)});
  }
  return text;
}

QString ResultsPage::PausingText(const PageServing& serving) const {
  const StringTable& strings = parts_.Strings;
  std::string text = Filled(strings.Text(OwnText::PagePausing), {std::to_string(serving.Starts)});
  if (const auto why = WhyPagesEnded(serving.LastEnd)) {
    text.append("\n").append(
        Filled(strings.Text(*why), {parts_.Host.Address(), std::to_string(parts_.Host.Setup().Port)}));
  }
  return QString::fromStdString(text);
}

void ResultsPage::ListHidden() {
  ui_->HiddenPlayers->clear();
  for (const std::int32_t member : parts_.Hidden.Members()) {
    const std::string number = Filled(parts_.Strings.Text(OwnText::HiddenMember), {std::to_string(member)});
    const std::string nickName = parts_.NickNameOf(member);
    auto* item = new QListWidgetItem(QString::fromStdString(nickName.empty() ? number : nickName));
    item->setToolTip(QString::fromStdString(number));
    item->setData(Qt::UserRole, member);
    ui_->HiddenPlayers->addItem(item);
  }
  for (const std::string& guest : parts_.Hidden.Guests()) {
    ui_->HiddenPlayers->addItem(QString::fromStdString(guest));
  }
  ui_->ShowAgain->setEnabled(false);
}

void ResultsPage::ShowAgain() {
  const auto listed = qScopeGuard([this] { ListHidden(); });
  const QListWidgetItem* item = ui_->HiddenPlayers->currentItem();
  if (item == nullptr) {
    return;
  }
  if (const int member = item->data(Qt::UserRole).toInt(); member != 0) {
    parts_.Hidden.ShowMember(member);
  } else {
    parts_.Hidden.ShowGuest(item->text().toStdString());
  }
}
