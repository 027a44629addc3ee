// The list of members beside the form.

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScopeGuard>
#include <algorithm>

#include "members/MemberListModel.h"
#include "members/MemberListView.h"
#include "members/MemberQueries.h"
#include "members/Members.h"
#include "ui_Members.h"

void Members::SetUpList() {
  constexpr int pauseInTyping = 150;  // milliseconds
  constexpr int betweenDetails = 10;
  MemberListView& list = *ui_->MemberHits;
  list.SetUp(parts_.DbMembers, parts_.Strings);
  // Large letters, in which the form takes more, must leave the list room for names.
  constexpr int lettersAcross = 160;
  resize(std::max(width(), lettersAcross * fontMetrics().averageCharWidth()), height());
  listTimer_ = new PollTimer(commands_, pauseInTyping, [this] { ListHits(); });
  detailTimer_ = new PollTimer(commands_, betweenDetails, [this] {
    if (!ui_->MemberHits->ReadNextDetails()) {
      detailTimer_->stop();
    }
  });
  connect(ui_->SearchText, &QLineEdit::textChanged, listTimer_, [this] { listTimer_->start(); });
  connect(&list.Members(), &MemberListModel::DetailsWanted, detailTimer_, [this] {
    if (!detailTimer_->isActive()) {
      detailTimer_->start();
    }
  });
  connect(&list, &MemberListView::MemberChosen, this, [this](qint64 contactId) {
    commands_.Run([this, contactId] { ShowHit(contactId); });
    ShowMemberInList();  // if the form could not leave its row
  });
  connect(&list, &QAbstractItemView::doubleClicked, ui_->OK, &QAbstractButton::click);
}

void Members::ListHits() {
  listTimer_->stop();
  ui_->MemberHits->Search(ui_->SearchText->text().toStdString());
  ShowMemberInList();
}

void Members::ShowMemberInList() {
  ui_->MemberHits->ShowMember(ui_->Dummy->text().toLongLong());
}

// Not after each step from row to row, which would have to read all rows in view.
void Members::RefreshList() {
  if (writtenBack_ != data1_->WrittenBack()) {
    writtenBack_ = data1_->WrittenBack();
    ui_->MemberHits->Refresh();
  }
}

void Members::ShowHit(std::int64_t contactId) {
  data1_->WalkTo(contactId);
  if (!data1_->HasRow()) {
    // The form still holds the rows of another search, or of one that failed.
    data1_->Refresh(HitsQuery(ui_->SearchText->text().toStdString()));
    data1_->WalkTo(contactId);
  }
}

void Members::EnterList() {
  if (listTimer_->isActive()) {
    ListHits();
  }
  if (!ui_->MemberHits->IsEmpty()) {
    ui_->MemberHits->Enter();
  }
}

void Members::SearchByCommand() {
  const auto list = qScopeGuard([this] { ListHits(); });
  RunSearch();
}
