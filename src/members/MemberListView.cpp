#include "members/MemberListView.h"

#include <QMouseEvent>
#include <QScopedValueRollback>

#include "members/MemberDelegate.h"
#include "members/MemberListModel.h"
#include "ui/Text.h"

MemberListView::MemberListView(QWidget* parent) : QListView(parent) {
  setUniformItemSizes(true);
  setEditTriggers(QAbstractItemView::NoEditTriggers);
  setSelectionMode(QAbstractItemView::SingleSelection);
  setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
  setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
  setItemDelegate(new MemberDelegate(this));
  setFocusPolicy(Qt::TabFocus);  // see mousePressEvent
}

void MemberListView::SetUp(Database& dbMembers, const StringTable& strings) {
  members_ = new MemberListModel(dbMembers, strings, this);
  setModel(members_);
  setAccessibleName(Text(strings, OwnText::MemberList));
  connect(selectionModel(), &QItemSelectionModel::selectionChanged, this, &MemberListView::TellChoice);
}

void MemberListView::Search(const std::string& text) {
  const QScopedValueRollback<bool> following(following_, true);
  members_->Search(text);
}

// The rows are painted anew without a signal of the model, after which the toolkit would lay out all of them.
void MemberListView::Refresh() {
  members_->Refresh();
  viewport()->update();
}

void MemberListView::ForgetPhoto(std::int64_t contactId) {
  members_->ForgetPhoto(contactId);
  viewport()->update();
}

bool MemberListView::ReadNextDetails() {
  const bool more = members_->ReadNextDetails();
  viewport()->update();
  return more;
}

bool MemberListView::IsEmpty() const {
  return members_->rowCount() == 0;
}

void MemberListView::ShowMember(std::int64_t contactId) {
  const QScopedValueRollback<bool> following(following_, true);
  const int row = contactId == 0 ? -1 : members_->RowOf(contactId);
  if (row < 0) {
    clearSelection();
    setCurrentIndex({});
  } else {
    setCurrentIndex(members_->index(row));
  }
}

void MemberListView::Enter() {
  {
    // The toolkit would make the first row the current one without selecting it.
    const QScopedValueRollback<bool> following(following_, true);
    setFocus(Qt::OtherFocusReason);
  }
  if (!selectionModel()->hasSelection() && !IsEmpty()) {
    setCurrentIndex({});
    setCurrentIndex(members_->index(0));
  }
}

// Whatever lost the focus may run its search, and the row that the form then shows is selected here. The rows
// must not move under the mouse meanwhile, so the focus is taken here rather than by the toolkit.
void MemberListView::mousePressEvent(QMouseEvent* event) {
  if (!hasFocus()) {
    const bool scrolls = hasAutoScroll();
    setAutoScroll(false);
    setFocus(Qt::MouseFocusReason);
    setAutoScroll(scrolls);
  }
  QListView::mousePressEvent(event);
}

// The toolkit takes any button for a double click, which chooses a member here.
void MemberListView::mouseDoubleClickEvent(QMouseEvent* event) {
  if (event->button() == Qt::LeftButton) {
    QListView::mouseDoubleClickEvent(event);
  }
}

void MemberListView::TellChoice() {
  if (following_) {
    return;
  }
  const QModelIndexList selected = selectionModel()->selectedIndexes();
  if (selected.isEmpty()) {
    // A click with Ctrl on the selected row, whose member stays in the form.
    const QScopedValueRollback<bool> following(following_, true);
    selectionModel()->select(currentIndex(), QItemSelectionModel::Select);
    return;
  }
  if (const std::int64_t contactId = members_->MemberIn(selected.first().row()); contactId != 0) {
    emit MemberChosen(contactId);
  }
}
