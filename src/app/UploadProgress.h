#pragma once

#include <QDialog>
#include <functional>
#include <memory>

#include "devices/baseunit/BaseUnitDownload.h"

namespace Ui {
class UploadProgress;
}

/// The small window shown during a download. Its Stop button and its close box end the download; Escape does
/// not. It leaves the keyboard to the main window.
class UploadProgress : public QDialog, public DownloadProgress {
  Q_OBJECT

 public:
  UploadProgress(const StringTable& strings, QWidget* parent);
  ~UploadProgress() override;

  void Open() override;
  void Close() override;
  bool ClosedByOperator() const override { return closedByOperator_; }
  void SetStatusText(const std::string& text) override;
  void SetMaximum(int maximum) override;
  void SetProgress(int value) override;
  void StartTransferAnim() override;
  void StopTransferAnim();

  void reject() override;

  /// Called with how many guns have come in, and of how many, before each further one.
  std::function<void(int received, int expected)> Received;

 protected:
  void keyPressEvent(QKeyEvent* event) override;

 private:
  std::unique_ptr<Ui::UploadProgress> ui_;
  bool closedByOperator_ = false;
};
