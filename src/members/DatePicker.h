#pragma once

#include <QLineEdit>
#include <string>

/// An entry for an optional date, with a calendar that its icon or Alt+Down opens. Shows the system's short
/// date format with a four-digit year; accepts that format, also with a two-digit year (1930 to 2029), and
/// year-month-day. When the focus leaves, a text that is not a date is replaced by the last valid one.
class DatePicker : public QLineEdit {
  Q_OBJECT

 public:
  explicit DatePicker(QWidget* parent);

  /// The accessible name of the button that opens the calendar.
  void SetCalendarName(const QString& name);

  /// Shows a date in the database's form, "YYYY-MM-DD HH:MM:SS"; shows nothing for any other text.
  void SetStored(const std::string& stored);

  /// The date in the database's form: the one passed to SetStored if unchanged, empty for none.
  const std::string& Stored() const { return stored_; }

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void focusOutEvent(QFocusEvent* event) override;

 private:
  void TakeText(const QString& text);
  void Finish();
  void TakeDate(QDate date);
  void ShowStored();
  /// Below the entry, or above it where the screen ends.
  QPoint PlaceOfCalendar(const QSize& calendar) const;
  void OpenCalendar();

  std::string stored_;
  std::string finished_;  ///< the last finished date, used while the text is not a date
};
