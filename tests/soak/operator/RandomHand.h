#pragma once

#include <QFileDialog>
#include <QMessageBox>
#include <QPointer>
#include <QString>
#include <QWidget>
#include <filesystem>
#include <functional>
#include <random>
#include <string>
#include <vector>

/// Does one thing at random to whatever window is in front: a key, a click, a text, a menu item, an answer to
/// a box or to a file dialog, a close. Nothing is done to files outside of `folder`.
class RandomHand {
 public:
  /// `note` is called with each command before it is given.
  RandomHand(std::filesystem::path folder, unsigned seed, std::function<void(const std::string&)> note);

  /// Does something. The windows that this opens may keep it from returning for long.
  void DoSomething();

  /// Leaves the window in front in the shortest way, to bring the program to its end. False if there is none.
  bool Leave();

 private:
  int Below(int count) { return std::uniform_int_distribution(0, count - 1)(random_); }
  template <typename Element>
  Element AnyOf(const std::vector<Element>& elements) {
    return elements[static_cast<std::size_t>(Below(static_cast<int>(elements.size())))];
  }

  QWidget* WindowInFront();
  void Answer(QMessageBox& box);
  void Answer(QFileDialog& dialog);
  QString AnyFileName();
  void UseWindow(QWidget& window);
  void Click(QWidget& window);
  void PressKey(QWidget& window);
  void TypeText(QWidget& window);
  void TriggerMenu(QWidget& window);
  void Resize(QWidget& window);
  void Close(QWidget& window);

  std::filesystem::path folder_;
  std::mt19937 random_;
  std::function<void(const std::string&)> note_;
};
