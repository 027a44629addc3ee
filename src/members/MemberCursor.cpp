#include "members/MemberCursor.h"

#include "platform/RuntimeError.h"

MemberCursor::MemberCursor(Database& dbMembers, BoundControls& controls)
    : dbMembers_(dbMembers), controls_(controls), rows_(dbMembers.OpenRecordset("Members")) {}

void MemberCursor::Refresh(const std::string& recordSource) {
  WriteBack();
  rows_ = dbMembers_.OpenRecordset(recordSource);
  Show();
}

void MemberCursor::MoveFirst() {
  WriteBack();
  rows_->MoveFirst();
  Show();
}

void MemberCursor::MovePrevious() {
  WriteBack();
  if (!rows_->Bof()) {
    rows_->MovePrevious();
  }
  if (rows_->Bof()) {
    rows_->MoveFirst();
  }
  Show();
}

void MemberCursor::MoveNext() {
  WriteBack();
  if (!rows_->Eof()) {
    rows_->MoveNext();
  }
  if (rows_->Eof()) {
    rows_->MoveLast();
  }
  Show();
}

void MemberCursor::MoveLast() {
  WriteBack();
  rows_->MoveLast();
  Show();
}

void MemberCursor::WalkTo(std::int64_t contactId) {
  WriteBack();
  rows_->WalkTo("ContactID", contactId);
  Show();
}

void MemberCursor::AddMember(const std::string& now) {
  WriteBack();
  rows_->AddNew();
  rows_->SetField("DateJoined", now);
  rows_->SetField("FirstName", "Enter Name");
  rows_->SetField("LastName", "Enter Name");
  Update();
  rows_->MoveLast();
  Show();
}

void MemberCursor::Delete() {
  rows_->Delete();
  rows_->MoveFirst();
  Show();
}

void MemberCursor::WriteBack() {
  if (!hasRow_) {
    return;
  }
  const MemberDetails entered = controls_.Entered();
  if (entered == shown_) {
    return;
  }
  try {
    rows_->Edit();
    SetChanges(*rows_, shown_, entered);
    Update();
    ++writtenBack_;
  } catch (const RuntimeError& error) {
    if (error.Number() == Fault::RecordDeleted) {
      shown_ = entered;  // gives up the change, or the cursor could never leave this row
    }
    throw;
  }
  shown_ = entered;
}

void MemberCursor::SetField(const std::string& column, const std::string& text) {
  rows_->Edit();
  rows_->SetField(column, text);
  Update();
}

void MemberCursor::Update() {
  try {
    rows_->Update();
  } catch (const RuntimeError&) {
    rows_->CancelUpdate();
    throw;
  }
}

void MemberCursor::Show() {
  hasRow_ = false;
  if (rows_->Eof() || rows_->Bof()) {
    controls_.ShowNoRow();
  } else {
    try {
      const ReadScope scope(dbMembers_);
      controls_.ShowRow(*rows_);
    } catch (const RuntimeError&) {
      controls_.ShowNoRow();
      throw;
    }
    hasRow_ = true;
  }
  shown_ = controls_.Entered();
  controls_.RowChanged();
}
