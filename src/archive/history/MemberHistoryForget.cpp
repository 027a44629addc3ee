// The command of the member history that has the archive forget a member.

#include <QScopeGuard>

#include "archive/history/MemberHistoryWindow.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/RunProgress.h"
#include "ui/TimeLeftText.h"
#include "ui_MemberHistoryWindow.h"

void MemberHistoryWindow::Forget() {
  EnableEntries(false);
  const auto ended = qScopeGuard([this] {
    EnableEntries(true);
    ui_->TimeLeft->clear();
  });
  const std::int32_t member = shown_.Number;
  const std::string name = NameOf(shown_);
  ForgetMember forgetting(parts_.Forgetting, member);
  std::optional<Forgotten> forgotten;
  {
    RunProgress progress(*ui_->ForgetProgress, *ui_->StopButton, parts_.Events, stopped_);
    const ForgetMember::OnStep step = [&](const ForgetMember::State& state) {
      return ShowStep(state, progress);
    };
    begun_ = parts_.Elapsed.Elapsed();
    const std::optional<int> games = forgetting.CountGames(step);
    if (games && MayForget(name, *games)) {
      parts_.NotToKeep(forgetting.OnBoard());
      begun_ = parts_.Elapsed.Elapsed();
      forgotten = forgetting.Forget(step);
    }
  }
  Tell({});
  if (forgotten) {
    Load(forgotten->Stopped ? member : 0);
    ShowForgotten(*forgotten, name);
  }
}

bool MemberHistoryWindow::MayForget(const std::string& name, int games) {
  return parts_.Boxes.Show(Filled(Strings().Text(OwnText::ForgetQuestion), {name, std::to_string(games)}),
                           windowTitle().toStdString(), BoxIcon::Question,
                           BoxButtons::YesNo) == BoxAnswer::Yes;
}

bool MemberHistoryWindow::ShowStep(const ForgetMember::State& state, RunProgress& progress) {
  const OwnText text = state.Counting ? OwnText::ForgetCounting : OwnText::ForgetWorking;
  ui_->TellLabel->setText(QString::fromStdString(Filled(Strings().Text(text), {state.File})));
  ui_->TimeLeft->setText(
      QString::fromStdString(TimeLeftText(parts_.Elapsed.Elapsed() - begun_, state.Done, Strings())));
  return progress.GoOn(state.Done);
}

void MemberHistoryWindow::EnableEntries(bool enabled) {
  ui_->FindEntry->setEnabled(enabled);
  ui_->MemberTable->setEnabled(enabled);
  ui_->ForgetButton->setEnabled(enabled && shown_.Number != 0);
  if (enabled) {
    ui_->MemberTable->setFocus();
  } else {
    ui_->StopButton->setFocus();
  }
}

void MemberHistoryWindow::ShowForgotten(const Forgotten& forgotten, const std::string& name) {
  if (forgotten.Failures.empty()) {
    Tell(Filled(Strings().Text(OwnText::MemberForgotten), {std::to_string(forgotten.Games), name}));
    return;
  }
  std::string text;
  for (const std::string& failure : forgotten.Failures) {
    text.append(text.empty() ? "" : "\n").append(failure);
  }
  if (forgotten.Stopped) {
    text.append("\n").append(Strings().Text(OwnText::ForgetAgain));
  }
  parts_.Boxes.Show(text, windowTitle().toStdString(), BoxIcon::Exclamation);
}
