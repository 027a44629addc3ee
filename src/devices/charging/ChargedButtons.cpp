#include "devices/charging/ChargedButtons.h"

bool ChargedButtons::Add(const ChargedButton& button) {
  const bool again = touching_ && button.Result == ChargeResult::NotRead && !buttons_.empty() &&
                     buttons_.back().Result == ChargeResult::NotRead &&
                     buttons_.back().DallasID == button.DallasID;
  if (again) {
    return false;
  }
  if (buttons_.size() == Most) {
    buttons_.erase(buttons_.begin());
  }
  buttons_.push_back(button);
  ++count_;
  touching_ = true;
  return true;
}
