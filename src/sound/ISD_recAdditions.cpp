// What the window shows and does beyond recording: how full the chip is, what would go wrong, how loud a
// sound is, how far a job has come, and sounds of other formats.

#include <QScopeGuard>
#include <algorithm>

#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "sound/ISD_rec.h"
#include "sound/Playlist.h"
#include "sound/RecordingNotes.h"
#include "sound/RecordingTime.h"
#include "sound/SoundConversion.h"
#include "sound/SoundLevels.h"
#include "sound/SoundPages.h"
#include "ui/PollTimer.h"
#include "ui/Text.h"
#include "ui/TimeLeft.h"
#include "ui_ISD_rec.h"

using std::chrono::milliseconds;

namespace {

/// Time in the operator's words, to the minute.
std::string MinutesText(const StringTable& strings, milliseconds time, OwnText minutes, OwnText lessThanOne) {
  const auto whole = std::chrono::round<std::chrono::minutes>(time).count();
  return whole < 1 ? strings.Text(lessThanOne) : Filled(strings.Text(minutes), {std::to_string(whole)});
}

/// A note that shows where a path of any length begins and ends.
QString Shortened(const QString& note) {
  constexpr qsizetype most = 600;
  return note.size() <= most ? note : note.left(most / 2) + QChar(0x2026) + note.right(most / 2);
}

}  // namespace

void ISD_rec::SetUpAdditions() {
  const StringTable& strings = parts_.Strings;
  ui_->ConvertSound->setText(Text(strings, OwnText::ConvertSound));
  ui_->NotesLabel->setText(Text(strings, OwnText::BeforeRecording));
  ui_->ChipFill->setAccessibleName(Text(strings, OwnText::ChipFill));
  ui_->Progress->setAccessibleName(Text(strings, OwnText::JobProgress));
  ui_->Level->setAccessibleName(Text(strings, OwnText::SoundLevel));
  for (QWidget* shownInJobs : {static_cast<QWidget*>(ui_->Progress), static_cast<QWidget*>(ui_->TimeLeft)}) {
    QSizePolicy place = shownInJobs->sizePolicy();
    place.setRetainSizeWhenHidden(true);
    shownInJobs->setSizePolicy(place);
    shownInJobs->hide();
  }
  constexpr int checkMilliseconds = 100;
  tmrCheck_ = new PollTimer(commands_, checkMilliseconds, [this] { ShowPlayingTime(); });
  tmrCheck_->setObjectName(QStringLiteral("TmrCheck"));
}

void ISD_rec::ShowWhatIsNew() {
  model_->Refresh();
  pagesToSend_ = 0;
  for (const SoundRow& row : list_.Rows()) {
    pagesToSend_ += row.Pages.value_or(0);
  }
  const double share = SoundChip::SecondsOf(pagesToSend_) / SoundChip::CapacitySeconds;
  ui_->ChipFill->setValue(static_cast<int>(std::min(share, 1.0) * ui_->ChipFill->maximum()));
  QPalette colours;
  if (share > 1) {
    colours.setColor(QPalette::Highlight, QColor(0xd0, 0x20, 0x20));
  }
  ui_->ChipFill->setPalette(colours);
  ShowNotes();
  ShowEstimate();
  ShowLevel();
}

void ISD_rec::ShowNotes() {
  ui_->Notes->clear();
  for (const std::string& note : RecordingNotes(list_, parts_.Disk, SelectedRecorder(), parts_.Strings)) {
    ui_->Notes->addItem(Shortened(QString::fromStdString(note)));
  }
}

void ISD_rec::ShowEstimate() {
  ui_->Estimate->setText(
      QString::fromStdString(MinutesText(parts_.Strings, RecordingTime(pagesToSend_, SelectedRecorder()),
                                         OwnText::RecordingTakesMinutes, OwnText::RecordingTakesLess)));
}

void ISD_rec::ShowLevel() {
  if (link_ != nullptr) {
    return;  // the disk serves the job
  }
  SoundLevels levels;
  QString text;
  const auto row = SelectedRow();
  if (row && list_.Rows()[*row].Pages) {
    levels = LevelsOf(parts_.Disk, list_.Rows()[*row].File, LevelView::MostColumns);
    const std::string peak = DecibelText(levels.Peak / double{SoundChip::Silence});
    const OwnText words = peak.empty()         ? OwnText::SilentSound
                          : levels.Clipped > 0 ? OwnText::PeakClipped
                                               : OwnText::PeakLevel;
    text = QString::fromStdString(Filled(parts_.Strings.Text(words), {peak, std::to_string(levels.Clipped)}));
  }
  ui_->Level->Show(levels);
  ui_->LevelText->setText(text);
}

void ISD_rec::ShowPlayingTime() {
  if (!parts_.Player.Playing()) {
    if (!previewing_) {
      tmrCheck_->stop();
    }
    ui_->LblTime->clear();
    return;
  }
  const auto seconds = std::chrono::duration<double>(parts_.Player.Position()).count();
  ui_->LblTime->setText(QString::fromStdString(FormatFixed(seconds, 1)) + QStringLiteral(" s"));
}

void ISD_rec::BeginProgress() {
  pagesBegun_ = 0;
}

void ISD_rec::PageBegins() {
  if (pagesBegun_ == 0) {
    jobStart_ = parts_.Elapsed.Elapsed();  // erasing says nothing about the speed
  }
  ShowProgress(static_cast<double>(pagesBegun_), static_cast<double>(pagesToSend_));
  ++pagesBegun_;
}

void ISD_rec::ShowProgress(double done, double whole) {
  constexpr int steps = 1000;
  const double share = whole > 0 ? std::min(done / whole, 1.0) : 1;
  ui_->Progress->setMaximum(steps);
  ui_->Progress->setValue(static_cast<int>(share * steps));
  ui_->Progress->show();
  const auto spent = std::chrono::duration_cast<milliseconds>(parts_.Elapsed.Elapsed() - jobStart_);
  const auto left = TimeLeft(spent, done, whole);
  ui_->TimeLeft->setText(left ? QString::fromStdString(MinutesText(
                                    parts_.Strings, *left, OwnText::MinutesLeft, OwnText::LessThanMinuteLeft))
                              : QString());
  ui_->TimeLeft->show();
}

void ISD_rec::HideProgress() {
  ui_->Progress->hide();
  ui_->TimeLeft->hide();
}

void ISD_rec::ConvertOne() {
  const auto row = SelectedRow();
  if (!row) {
    return;
  }
  const StringTable& strings = parts_.Strings;
  const auto path =
      parts_.CD.ShowOpen({.Filter = strings.Text(OwnText::SoundFiles) +
                                    "|*.wav;*.flac;*.ogg;*.opus;*.mp3;*.aif;*.aiff;*.au;*.caf|" +
                                    strings.Text(OwnText::AllFiles) + "|*.*",
                          .Folder = LastFolder(),
                          .Title = strings.Text(OwnText::ConvertTitle)});
  if (!path || !MayBeKept(*path)) {
    return;
  }
  std::optional<std::string> outcome;
  if (IsWave(*path) && IsPlainChipWave(CheckWave(parts_.Disk, *path))) {
    list_.AddSoundToList(*path, *row);
  } else {
    outcome = ConvertInto(*path, *row);
  }
  if (StopRequested()) {
    return;
  }
  UpdateUtilisation();
  if (outcome) {
    ShowOutcomes({*outcome});
  }
}

std::optional<std::string> ISD_rec::ConvertInto(const std::string& path, std::size_t row) {
  jobStart_ = parts_.Elapsed.Elapsed();
  const auto ended = qScopeGuard([this] { HideProgress(); });
  const auto sound = parts_.Converter.Convert(path, SoundChip::SamplesPerSecond, [this](double done) {
    ShowProgress(done, 1);
    parts_.Events.DoEvents();
    return !StopRequested();
  });
  if (!sound) {
    return std::nullopt;
  }
  const std::string converted = ConvertedName(parts_.Disk, path);
  parts_.Disk.Replace(converted, WaveBytes(sound->Samples));
  list_.AddSoundToList(converted, row);
  const std::string peak = DecibelText(sound->Peak);
  const StringTable& strings = parts_.Strings;
  const OwnText words = peak.empty()         ? OwnText::ConvertedSilent
                        : sound->Clipped > 0 ? OwnText::ConvertedClipped
                                             : OwnText::Converted;
  return Filled(strings.Text(words), {converted, peak, std::to_string(sound->Clipped)});
}

void ISD_rec::ShowOutcomes(const std::vector<std::string>& outcomes) {
  int row = 0;
  for (const std::string& outcome : outcomes) {
    ui_->Notes->insertItem(row++, QString::fromStdString(outcome));
  }
  ui_->Notes->scrollToTop();
}

void ISD_rec::TakeDroppedFiles(int row, const QStringList& paths) {
  if (commands_.Running()) {
    return;
  }
  commands_.Run([&] {
    std::vector<std::string> outcomes;
    bool goesOn = true;
    for (qsizetype i = 0; i < paths.size() && row + i < model_->rowCount() && goesOn; ++i) {
      // A failure ends the rest, but what was done until then is shown.
      goesOn = commands_.Run([&] {
        if (const auto outcome =
                PlaceDroppedFile(paths[i].toStdString(), static_cast<std::size_t>(row + i))) {
          outcomes.push_back(*outcome);
        }
      });
      goesOn = goesOn && !StopRequested();
      model_->Refresh();
    }
    if (!StopRequested()) {
      UpdateUtilisation();
      ShowOutcomes(outcomes);
    }
  });
}

std::optional<std::string> ISD_rec::PlaceDroppedFile(const std::string& path, std::size_t row) {
  if (parts_.Disk.FolderExists(path) || !MayBeKept(path)) {
    return std::nullopt;
  }
  SelectRow(row);
  const WaveCheck check = IsWave(path) ? CheckWave(parts_.Disk, path) : WaveCheck();
  const bool fits = IsWave(path) ? IsPlainChipWave(check) : IsRawSamples(path);
  if (!fits && parts_.Converter.CanRead(path)) {
    const BoxAnswer answer = parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::ConvertQuestion), {path}),
                                               DefaultBoxTitle, BoxIcon::Question, BoxButtons::YesNo);
    return answer == BoxAnswer::Yes ? ConvertInto(path, row) : std::nullopt;
  }
  if (check.Error == WaveError::None) {
    list_.AddSoundToList(path, row);
  } else {
    ShowWaveError(parts_.Boxes, check.Error);
  }
  return std::nullopt;
}
