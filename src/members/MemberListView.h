#pragma once

#include <QListView>
#include <cstdint>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Database.h"

class MemberListModel;

/// The members found, beside the form. Its selected row follows the form; what the operator selects goes to
/// the form through MemberChosen.
class MemberListView : public QListView {
  Q_OBJECT

 public:
  explicit MemberListView(QWidget* parent);

  /// Call once, before anything else. Both must outlive the view.
  void SetUp(Database& dbMembers, const StringTable& strings);

  void Search(const std::string& text);
  /// Shows the rows as they are in the database now.
  void Refresh();
  void ForgetPhoto(std::int64_t contactId);
  /// Shows the photo and the mark of one more of the rows in view. Returns false if all have theirs.
  bool ReadNextDetails();
  bool IsEmpty() const;

  /// Selects this member, or nobody if the list lacks it.
  void ShowMember(std::int64_t contactId);

  /// Takes the focus; the first member is selected, as by the operator, if no other is.
  void Enter();

  MemberListModel& Members() { return *members_; }

  /// Letters are for the search box.
  void keyboardSearch(const QString& /*letters*/) override {}

 signals:
  void MemberChosen(qint64 contactId);

 protected:
  void mousePressEvent(QMouseEvent* event) override;
  void mouseDoubleClickEvent(QMouseEvent* event) override;

 private:
  void TellChoice();

  MemberListModel* members_ = nullptr;
  bool following_ = false;  ///< the selection is not the operator's
};
