#include "archive/copies/CopyTexts.h"

#include <cstdlib>

#include "core/text/Filled.h"

std::string TextOf(CopyKind kind, const StringTable& strings) {
  switch (kind) {
    case CopyKind::ByHand:
      return strings.Text(OwnText::CopyByHand);
    case CopyKind::BeforeRestore:
      return strings.Text(OwnText::CopyBeforeRestore);
    case CopyKind::Weekly:
      return strings.Text(OwnText::CopyWeekly);
    case CopyKind::FirstChange:
      break;
  }
  return strings.Text(OwnText::CopyBeforeChange);
}

std::string TextOf(CopyStep step, const StringTable& strings) {
  switch (step) {
    case CopyStep::Checking:
      return strings.Text(OwnText::CopyChecking);
    case CopyStep::KeepingPresent:
      return strings.Text(OwnText::CopyKeepsPresent);
    case CopyStep::Copying:
      break;
  }
  return strings.Text(OwnText::CopyCopying);
}

std::string DifferenceText(int rowsOfCopy, int rowsNow, const StringTable& strings) {
  const int difference = rowsOfCopy - rowsNow;
  if (difference == 0) {
    return strings.Text(OwnText::RowsEqual);
  }
  const std::string number = std::to_string(std::abs(difference));
  if (difference > 0) {
    return number == "1" ? strings.Text(OwnText::RowMore) : Filled(strings.Text(OwnText::RowsMore), {number});
  }
  return number == "1" ? strings.Text(OwnText::RowFewer) : Filled(strings.Text(OwnText::RowsFewer), {number});
}
