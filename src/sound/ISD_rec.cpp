#include "sound/ISD_rec.h"

#include <QScopeGuard>
#include <QSignalBlocker>
#include <array>
#include <filesystem>
#include <limits>

#include "core/line/EnumPorts.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "sound/Playlist.h"
#include "sound/SoundDefinition.h"
#include "sound/SoundRecording.h"
#include "ui/PollTimer.h"
#include "ui/Text.h"
#include "ui_ISD_rec.h"

namespace {

constexpr std::array DefinitionFiles = {"/sound_list_mainboard.xml", "/sound_list_maltrone.xml"};
constexpr const char* SoundFilter = "Wave Files|*.wav;|PCM Files|*.pcm;|Raw Files|*.raw;";
constexpr const char* PlaylistFilter = "Playlist Files|*.txt|All Files|*.*";

}  // namespace

ISD_rec::ISD_rec(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ISD_rec>()),
      parts_(parts),
      port_(parts.Ini, parts.Devices),
      wave_(parts.Disk, parts.Boxes),
      list_(parts.Disk, wave_),
      preview_({parts.Disk, parts.Player, parts.Events, parts.Boxes}),
      model_(new SoundListModel(list_, Text(parts.Strings, OwnText::SoundSeconds),
                                Text(parts.Strings, OwnText::SoundPages), this)),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  ui_->SoundList->setModel(model_);
  SetUpAdditions();
  try {
    FormLoad();
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::FileNotFound) {
      parts_.Boxes.Show(std::string("Error Occured: ") + error.what(), DefaultBoxTitle, BoxIcon::None);
    }
  }
  ConnectCommands();
}

ISD_rec::~ISD_rec() {
  Unload();
}

void ISD_rec::Unload() {
  preview_.Stop();
  if (parts_.MSComm1.PortOpen()) {
    parts_.MSComm1.Close();
  }
}

void ISD_rec::FormLoad() {
  ui_->RecorderSelect->setCurrentIndex(static_cast<int>(Recorder::StandAlone));
  ui_->ProductSelect->setCurrentIndex(0);
  LoadProduct();
  ShowCommPort();
}

void ISD_rec::ShowCommPort() {
  const std::string text = parts_.Ini.ReadIni(Keys::CommPort);
  const double number = NumberIn(text).value_or(0);
  const bool isPort = number >= 1 && number <= std::numeric_limits<std::int16_t>::max();
  const std::string shown = isPort ? PlainDecimal(number) : text;
  ui_->CommPortCombo->addItem(QStringLiteral("Comm %1").arg(QString::fromStdString(shown)));
  if (isPort) {
    const EnumPorts ports(parts_.Ini, parts_.Devices);
    ui_->CommPortCombo->setToolTip(QString::fromStdString(ports.DeviceOf(ToInt16(text))));
  }
}

void ISD_rec::ConnectCommands() {
  const auto connectButton = [this](QAbstractButton& button, void (ISD_rec::*command)()) {
    commands_.Connect(
        button, [this, command] { (this->*command)(); }, WhileBusy::Ignore);
  };
  connectButton(*ui_->OpenList, &ISD_rec::OpenPlaylist);
  connectButton(*ui_->SaveList, &ISD_rec::SaveList);
  connectButton(*ui_->SetSound, &ISD_rec::OpenOne);
  connectButton(*ui_->ConvertSound, &ISD_rec::ConvertOne);
  connectButton(*ui_->Preview, &ISD_rec::PreviewAll);
  connectButton(*ui_->RecordButton, &ISD_rec::Record);
  connectButton(*ui_->Test, &ISD_rec::TestAll);
  connect(ui_->RecorderSelect, &QComboBox::currentIndexChanged, this,
          [this] { commands_.Run([this] { SetupComm(); }); });
  // Not when the same product is chosen again, which would lose the files.
  connect(ui_->ProductSelect, &QComboBox::currentIndexChanged, this, &ISD_rec::ChangeProduct);
  connect(ui_->SoundList, &SoundListView::RowActivated, this, [this](int row) { PlaySelected(row); });
  connect(ui_->SoundList, &SoundListView::FilesDropped, this, &ISD_rec::TakeDroppedFiles);
  connect(ui_->SoundList->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
          [this] { ShowLevel(); });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
}

void ISD_rec::reject() {
  if (commands_.MayClose()) {
    Unload();
    QDialog::reject();
  }
}

void ISD_rec::LoadProduct() {
  shownProduct_ = ui_->ProductSelect->currentIndex();
  list_.Fill({});
  std::optional<std::vector<std::string>> events;
  try {
    events = ReadSoundDefinition(
        parts_.Disk.Read(parts_.ProgramFolder + DefinitionFiles.at(static_cast<std::size_t>(shownProduct_))));
  } catch (const RuntimeError&) {
    events.reset();
  }
  if (events) {
    list_.Fill(*events);
  }
  model_->Reset();
  if (!list_.Rows().empty()) {
    SelectRow(0);
  }
  if (!events) {
    parts_.Boxes.Show("Unable to open Sound List defintion file.", "Sound Recorder Error", BoxIcon::None);
  }
  UpdateUtilisation();
}

void ISD_rec::ChangeProduct(int index) {
  if (!commands_.Running()) {
    commands_.Run([this] { LoadProduct(); });
  } else if (index != shownProduct_) {
    // The job works on the rows as they are.
    const QSignalBlocker blocker(ui_->ProductSelect);
    ui_->ProductSelect->setCurrentIndex(shownProduct_);
  }
}

void ISD_rec::SetupComm() {
  const auto shown = qScopeGuard([this] {
    ShowNotes();
    ShowEstimate();
  });
  if (link_ != nullptr) {
    link_->SetupComm();  // a line that fails now is told of by the job
  } else if (parts_.MSComm1.PortOpen()) {
    RecorderLink link = Link();
    link.SetupComm();
    link.Job().LeaveOpen();
    link.ThrowIfLineLost();
  }
}

void ISD_rec::UpdateUtilisation() {
  // Rows and bars show what is known also when a file ends the reckoning.
  const auto shown = qScopeGuard([this] { ShowWhatIsNew(); });
  const double seconds = list_.Reckon();
  ui_->Utilisation->setText(QString::fromStdString(UtilisationText(seconds)));
}

bool ISD_rec::MayBeKept(const std::string& path) {
  const bool fits = FitsPlaylist(path);
  if (!fits) {
    parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::PathNotForPlaylist), {path}), DefaultBoxTitle,
                      BoxIcon::Exclamation);
  }
  return fits;
}

std::string ISD_rec::LastFolder() const {
  return parts_.Ini.ReadIni(Keys::LastSoundFolder);
}

void ISD_rec::OpenOne() {
  const auto row = SelectedRow();
  if (!row) {
    return;
  }
  const auto path =
      parts_.CD.ShowOpen({.Filter = SoundFilter, .Folder = LastFolder(), .Title = "Open Audio File"});
  if (!path || !MayBeKept(*path) || (IsWave(*path) && !wave_.WaveOpenFile(*path))) {
    return;
  }
  list_.AddSoundToList(*path, *row);
  parts_.Ini.WriteIni(Keys::LastSoundFolder, std::filesystem::path(*path).parent_path().string());
  UpdateUtilisation();
}

void ISD_rec::SaveList() {
  const auto path = parts_.CD.ShowSave(
      {.Filter = PlaylistFilter, .Folder = LastFolder(), .Title = "Select Play List Filename"});
  if (path) {
    parts_.Disk.Replace(*path, list_.Playlist());
  }
}

void ISD_rec::OpenPlaylist() {
  const auto path =
      parts_.CD.ShowOpen({.Filter = PlaylistFilter, .Folder = LastFolder(), .Title = "Open Play List"});
  if (!path) {
    return;
  }
  const std::string bytes = parts_.Disk.Read(*path);
  {
    const auto shown = qScopeGuard([this] { model_->Refresh(); });
    list_.TakePlaylist(bytes);
  }
  UpdateUtilisation();
}

void ISD_rec::PlaySelected(int row) {
  if (!commands_.Running()) {
    commands_.Run([this, row] {
      preview_.PlayRow(list_.Rows().at(static_cast<std::size_t>(row)).File);
      tmrCheck_->start();
    });
  }
}

void ISD_rec::PreviewAll() {
  previewing_ = true;
  const auto ended = qScopeGuard([this] { previewing_ = false; });
  tmrCheck_->start();
  preview_.PlayAll(list_, *this, [this] { return StopRequested(); });
}

void ISD_rec::Record() {
  ShowNotes();
  const Files& disk = parts_.Disk;
  pageIndexTable_.Build(list_, disk, wave_);
  WorkOnLine([this, &disk](RecorderLink& link) {
    const StayAwake awake(parts_.Awake, parts_.Strings.Text(OwnText::RecordingSounds));
    BeginProgress();
    SoundRecording recording({link, list_, pageIndexTable_, disk, wave_, *this});
    try {
      recording.Record();
    } catch (const RuntimeError&) {
      SetStatus("Recording Failed.");
      SetStatus2("");
      throw;
    }
  });
}

void ISD_rec::TestAll() {
  WorkOnLine([this](RecorderLink& link) { TestSounds(link, list_, *this); });
}

void ISD_rec::WorkOnLine(const std::function<void(RecorderLink&)>& job) {
  RecorderLink link = Link();
  link_ = &link;
  const auto ended = qScopeGuard([this] {
    link_ = nullptr;
    HideProgress();
    ShowLevel();
  });
  link.Open(port_.Device());
  job(link);
  link.ThrowIfLineLost();
}

RecorderLink ISD_rec::Link() {
  return RecorderLink({.MSComm1 = parts_.MSComm1,
                       .Events = parts_.Events,
                       .Boxes = parts_.Boxes,
                       .RecorderSelect = [this] { return SelectedRecorder(); },
                       .StopRequested = [this] { return StopRequested(); }});
}

Recorder ISD_rec::SelectedRecorder() const {
  return static_cast<Recorder>(ui_->RecorderSelect->currentIndex());
}

std::optional<std::size_t> ISD_rec::SelectedRow() const {
  const int row = ui_->SoundList->SelectedRow();
  return row < 0 ? std::nullopt : std::optional(static_cast<std::size_t>(row));
}

void ISD_rec::SetStatus(const std::string& text) {
  ui_->StatusLabel->setText(QString::fromStdString(text));
}

void ISD_rec::SetStatus2(const std::string& text) {
  ui_->Status2->setText(QString::fromStdString(text));
}

void ISD_rec::SelectRow(std::size_t row) {
  ui_->SoundList->SelectRow(static_cast<int>(row));
}
