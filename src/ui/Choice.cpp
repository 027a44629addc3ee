#include "ui/Choice.h"

#include <QComboBox>
#include <QTimer>
#include <memory>
#include <utility>

void OnChoice(QComboBox& list, const std::function<void(int)>& choose) {
  // The toolkit emits `activated` for the operator's choices only, and `currentIndexChanged` for all that
  // change the entry, by the operator directly before `activated`. So `activated` is ignored if it follows at
  // once.
  const auto justChosen = std::make_shared<bool>(false);
  QObject::connect(&list, &QComboBox::currentIndexChanged, &list, [&list, choose, justChosen](int index) {
    choose(index);
    *justChosen = true;
    QTimer::singleShot(0, &list, [justChosen] { *justChosen = false; });
  });
  QObject::connect(&list, &QComboBox::activated, &list, [choose, justChosen](int index) {
    if (!std::exchange(*justChosen, false)) {
      choose(index);
    }
  });
}
