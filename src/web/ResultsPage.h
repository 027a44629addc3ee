#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/MessageBoxes.h"
#include "ui/Commands.h"
#include "web/ResultsHost.h"

namespace Ui {
class ResultsPage;
}

/// The page for phones: on and off, where it is, what is on it, and who is hidden. Whatever is changed here
/// holds at once.
class ResultsPage : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    ResultsHost& Host;
    HiddenNames& Hidden;
    const LocalAddresses& Addresses;
    MessageBoxes& Boxes;
    const StringTable& Strings;
    NickNames NickNameOf;
    /// Prints a poster with the address.
    std::function<void(const std::string& url)> PrintPoster;
  };

  ResultsPage(const Parts& parts, QWidget* parent);
  ~ResultsPage() override;

 private:
  void SetUpTexts();
  void ListAddresses();
  void Fill();
  void ConnectEntries();
  /// Has the host do what the entries say.
  void Apply();
  void ShowState();
  QString StateText() const;
  /// The program that serves the page has ended: why, where that is known, and what to do.
  QString PausingText(const PageServing& serving) const;
  void ListHidden();
  void ShowAgain();

  std::unique_ptr<Ui::ResultsPage> ui_;
  const Parts parts_;
  std::vector<std::string> addresses_;  ///< as in the list; the first stands for the proposed one
  std::string shownUrl_;                ///< of the QR code
  Commands commands_;
};
