#include "core/data/LoggedBoxes.h"

#include <string_view>

#include "platform/ErrorReport.h"

namespace {

std::string_view NameOf(BoxAnswer answer) {
  switch (answer) {
    case BoxAnswer::Ok:
      return "OK";
    case BoxAnswer::Cancel:
      return "Cancel";
    case BoxAnswer::Yes:
      return "Yes";
    case BoxAnswer::No:
      break;
  }
  return "No";
}

}  // namespace

BoxAnswer LoggedBoxes::Show(const std::string& text, const std::string& title, BoxIcon icon,
                            BoxButtons buttons) {
  if (icon == BoxIcon::Critical && text.starts_with(ErrorReportStart)) {
    log_.Fault(text);
  } else {
    log_.BoxOpened(title, text);
  }
  const BoxAnswer answer = boxes_.Show(text, title, icon, buttons);
  log_.BoxClosed(NameOf(answer));
  return answer;
}
