#pragma once

#include <QWidget>
#include <memory>
#include <optional>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "platform/SoundPlayer.h"

namespace Ui {
class OutcomeSignals;
}

/// A large sign and a sound that tell how a piece of work ended, for an operator whose eyes are on the
/// equipment. Each can be switched off; the choice is kept in the settings.
class OutcomeSignals : public QWidget {
  Q_OBJECT

 public:
  /// All of it must outlive the window.
  struct Parts {
    IniReader& Ini;
    SoundPlayer* Sounds;  ///< null if nothing can be played
    const StringTable& Strings;
  };

  explicit OutcomeSignals(QWidget* parent = nullptr);
  ~OutcomeSignals() override;

  /// Must be called once before the widget is shown.
  void SetUp(const Parts& parts);

  /// Shows the sign and starts the sound. Without a sound device the sound's switch says so.
  void Tell(bool success, const QString& text);

  /// Takes the sign away. A sound goes on to its end.
  void Clear();

 private:
  void Play(bool success);
  void KeepChoices();

  std::unique_ptr<Ui::OutcomeSignals> ui_;
  std::optional<Parts> parts_;
};
