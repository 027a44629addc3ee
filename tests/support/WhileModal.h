#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <QTimer>
#include <functional>

/// Runs `act` as soon as a modal window of type `Window` is shown, with that window. Counts how often it ran.
template <typename Window>
class WhileModal {
 public:
  explicit WhileModal(std::function<void(Window&)> act) : act_(std::move(act)) {
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] {
      if (auto* window = qobject_cast<Window*>(QApplication::activeModalWidget())) {
        timer_.stop();
        ++runs_;
        act_(*window);
      }
    });
    timer_.start(0);
  }

  int Runs() const { return runs_; }

 private:
  std::function<void(Window&)> act_;
  int runs_ = 0;
  QTimer timer_;
};
