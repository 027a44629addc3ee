#pragma once

#include <QDialog>
#include <memory>
#include <string>
#include <vector>

#include "audience/AudienceSetup.h"
#include "core/text/StringTable.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class AudienceSettings;
}

/// Edits what is set for the audience board. Below the entries stands what follows from them.
class AudienceSettings : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    ::MessageBoxes& Boxes;
    FileDialog& Dialogs;
    const Files& Disk;
    const StringTable& Strings;
  };

  AudienceSettings(const AudienceSetup& setup, const Parts& parts, QWidget* parent);
  ~AudienceSettings() override;

  /// What the entries hold.
  AudienceSetup Setup() const;

 protected:
  void showEvent(QShowEvent* event) override;

 private:
  void SetUpTexts();
  void ListScreens(const std::string& chosen);
  void Fill(const AudienceSetup& setup);
  void ChoosePicture();
  void ShowPicture(const std::string& path);
  void ShowConsequence();
  /// A longer text below the entries makes the window higher, and no entry lower.
  void MakeRoom();

  std::unique_ptr<Ui::AudienceSettings> ui_;
  const Parts parts_;
  std::vector<std::string> screens_;  ///< as in the list; the first stands for any
  std::string picture_;
  Commands commands_;
};
