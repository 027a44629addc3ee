#pragma once

#include <functional>
#include <string>
#include <utility>

#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"

/// True for a box that tells of a failure whose cause can lie in what System Check looks at: ports, printing,
/// the word processor, the disk, the databases. Mistakes in entries and files of a wrong kind do not count.
bool TellsOfFailure(const StringTable& strings, const std::string& text, const std::string& title,
                    BoxIcon icon);

/// Message boxes that make such failures known to the program, whichever window shows them.
class FailureBoxes : public MessageBoxes {
 public:
  /// `onFailure` is called before the box opens. The others must outlive this object.
  FailureBoxes(MessageBoxes& boxes, const StringTable& strings, std::function<void()> onFailure)
      : boxes_(boxes), strings_(strings), onFailure_(std::move(onFailure)) {}

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override;

 private:
  MessageBoxes& boxes_;
  const StringTable& strings_;
  const std::function<void()> onFailure_;
};
