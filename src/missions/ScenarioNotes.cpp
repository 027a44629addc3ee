#include "missions/ScenarioNotes.h"

#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QStringList>
#include <QStyle>
#include <QTabBar>
#include <QTextDocument>

#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "core/text/TextEncoding.h"
#include "missions/MissionNotes.h"
#include "ui/Announce.h"
#include "ui/Text.h"

namespace {

bool IsLineBreak(QChar character) {
  return character == QChar::ParagraphSeparator || character == QChar::LineSeparator;
}

/// Place in a document's raw text of the character that is saved at `position`, counted from 1: a line break
/// is saved as two characters, and what the toolkit keeps as a pair of surrogates as one.
int PlaceOf(const QString& raw, std::size_t position) {
  std::size_t saved = 0;
  for (int i = 0; i < raw.size(); ++i) {
    saved += IsLineBreak(raw[i]) ? 2 : raw[i].isLowSurrogate() ? 0 : 1;
    if (saved >= position) {
      return i;
    }
  }
  return static_cast<int>(raw.size());
}

/// Shows the note beside an entry, or hides it. Screen readers say it when it appears, and tell it with the
/// entry, after the first line of the description, which is the entry's own.
void ShowNote(QLabel& note, QWidget& entry, const QString& text) {
  const QString own = entry.accessibleDescription().section(u'\n', 0, 0);
  entry.setAccessibleDescription(text.isEmpty() ? own : own + u'\n' + text);
  const bool appears = note.isHidden() && !text.isEmpty();
  note.setText(text);
  note.setVisible(!text.isEmpty());
  if (appears && note.isVisible()) {
    Announce(note);
  }
}

}  // namespace

// Not from toPlainText, which turns no-break spaces into blanks.
std::string TextIn(const QPlainTextEdit& box) {
  QString text = box.document()->toRawText();
  for (const QChar lineBreak : {QChar(QChar::ParagraphSeparator), QChar(QChar::LineSeparator)}) {
    text.replace(lineBreak, QStringLiteral("\r\n"));
  }
  return text.toStdString();
}

ScenarioNotes::ScenarioNotes(const Controls& controls, const StringTable& strings, QObject* parent)
    : QObject(parent), controls_(controls), strings_(strings) {
  controls_.DescriptionCount->setAccessibleName(Text(strings, OwnText::DescriptionLength));
  const auto showPenalties = [this] {
    ShowPenalty(*controls_.RespawnPenalty, *controls_.RespawnNote);
    ShowPenalty(*controls_.HealPenalty, *controls_.HealNote);
  };
  connect(controls_.Description, &QPlainTextEdit::textChanged, this, &ScenarioNotes::ShowDescription);
  connect(controls_.RespawnPenalty, &QLineEdit::textChanged, this, showPenalties);
  connect(controls_.HealPenalty, &QLineEdit::textChanged, this, showPenalties);
  connect(controls_.Tabs, &QTabBar::currentChanged, this, &ScenarioNotes::ShowPoints);
  for (const auto& entries : {controls_.PrimaryPoints, controls_.SecondaryPoints}) {
    for (const QLineEdit* entry : entries) {
      connect(entry, &QLineEdit::textChanged, this, &ScenarioNotes::ShowPoints);
    }
  }
  ShowDescription();
  showPenalties();
  ShowPoints();
}

void ScenarioNotes::ShowDescription() {
  const std::string description = TextIn(*controls_.Description);
  const std::size_t length = CharacterCount(description);
  controls_.DescriptionCount->setText(QStringLiteral("%1 / %2").arg(length).arg(MostOfDescription));
  QFont font = controls_.DescriptionCount->font();
  font.setBold(length > MostOfDescription);
  controls_.DescriptionCount->setFont(font);
  QStringList lost;
  for (const LostCharacter& character : LostCharacters(description)) {
    lost << QString::fromStdString(Filled(strings_.Text(OwnText::LosesCharacter),
                                          {std::to_string(character.Position), InItsPlace(character)}));
  }
  ShowNote(*controls_.DescriptionNote, *controls_.Description, lost.join(u'\n'));
  MarkLostCharacters();
}

void ScenarioNotes::MarkLostCharacters() {
  QTextDocument& document = *controls_.Description->document();
  const QString raw = document.toRawText();
  QList<QTextEdit::ExtraSelection> marks;
  for (const LostCharacter& lost : LostCharacters(TextIn(*controls_.Description))) {
    QTextEdit::ExtraSelection mark;
    mark.cursor = QTextCursor(&document);
    mark.cursor.setPosition(PlaceOf(raw, lost.Position));
    mark.cursor.movePosition(QTextCursor::NextCharacter, QTextCursor::KeepAnchor);
    mark.format.setBackground(QColor(0xff, 0xd1, 0x66));
    mark.format.setForeground(Qt::black);
    mark.format.setFontStrikeOut(true);
    marks << mark;
  }
  controls_.Description->setExtraSelections(marks);
}

void ScenarioNotes::ShowPenalty(QLineEdit& entry, QLabel& note) {
  const std::optional<double> saved = PenaltySavedAs(entry.text().toStdString());
  ShowNote(note, entry,
           saved ? QString::fromStdString(Filled(strings_.Text(OwnText::SavedAs), {PlainDecimal(*saved)}))
                 : QString());
}

// Empty points are saved as 0. The other sets are behind the one in front, so their tabs get a sign.
void ScenarioNotes::ShowPoints() {
  const QString saved = QString::fromStdString(Filled(strings_.Text(OwnText::SavedAs), {"0"}));
  const auto noteOf = [&saved](const QLineEdit* entry) {
    return entry->text().isEmpty() ? saved : QString();
  };
  for (int set = 0; set < controls_.Tabs->count(); ++set) {
    const auto i = static_cast<std::size_t>(set);
    const QString primary = noteOf(controls_.PrimaryPoints[i]);
    const QString secondary = noteOf(controls_.SecondaryPoints[i]);
    const bool marked = !primary.isEmpty() || !secondary.isEmpty();
    controls_.Tabs->setTabIcon(
        set, marked ? controls_.Tabs->style()->standardIcon(QStyle::SP_MessageBoxWarning) : QIcon());
    controls_.Tabs->setTabToolTip(set, marked ? saved : QString());
    if (set == controls_.Tabs->currentIndex()) {
      ShowNote(*controls_.PrimaryNote, *controls_.PrimaryPoints[i], primary);
      ShowNote(*controls_.SecondaryNote, *controls_.SecondaryPoints[i], secondary);
    }
  }
}
