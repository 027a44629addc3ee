#pragma once

#include <QLineEdit>
#include <string>

/// An entry for a date that may be empty, with a calendar behind its arrow (Alt+Down). Shows the system's
/// short form with all digits of the year; takes that form, with two digits of the year too, and
/// year-month-day. A text that is no date is given up for the last good one when the entry is left.
class DatePicker : public QLineEdit {
  Q_OBJECT

 public:
  explicit DatePicker(QWidget* parent);

  /// What an assistive program calls the button that opens the calendar.
  void SetCalendarName(const QString& name);

  /// Shows a date as the database keeps it, "YYYY-MM-DD HH:MM:SS"; nothing for any other text.
  void SetStored(const std::string& stored);

  /// The date as the database keeps it: what was shown when it was not changed, empty for none.
  const std::string& Stored() const { return stored_; }

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void focusOutEvent(QFocusEvent* event) override;

 private:
  void TakeText(const QString& text);
  void Finish();
  void TakeDate(QDate date);
  void ShowStored();
  void OpenCalendar();

  std::string stored_;
  std::string finished_;  ///< what stands when the text in the entry is no date
};
