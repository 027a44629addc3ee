#include "check/FailureBoxes.h"

#include <algorithm>
#include <iterator>
#include <string_view>

#include "core/data/UserDatabase.h"
#include "platform/ErrorReport.h"

namespace {

/// Titles that no other box has.
constexpr std::string_view FailureTitles[] = {"Print Error",           // score sheets
                                              "Database Error",        // Commit
                                              "Mission Save Error",    // Missions
                                              "Driver Error",          // readers of buttons
                                              "Memberbership Error",   //
                                              "Button Error",          //
                                              "Communications Error",  // utility boxes
                                              "Comms error"};

/// Numbers of the titles that depend on the language: word processor, base unit's port, template.
constexpr int NumberedFailureTitles[] = {118, 122, 133};

/// Texts of boxes whose title is the program's name.
constexpr std::string_view FailureTexts[] = {
    "Checksum failed", "Timed out waiting for Data. Please try again.",
    "Timed out waiting for response from device. Check connections and retry",
    "Error occured sending data. Please try again.", "Error occured receiving data. Please try again."};

template <typename Range>
bool IsAmong(const Range& range, std::string_view text) {
  return std::find(std::begin(range), std::end(range), text) != std::end(range);
}

}  // namespace

bool TellsOfFailure(const StringTable& strings, const std::string& text, const std::string& title,
                    BoxIcon icon) {
  if (title == DatabaseBoxTitle) {  // its other boxes tell what was done
    return icon == BoxIcon::Exclamation;
  }
  const bool isReport = icon == BoxIcon::Critical && text.starts_with(ErrorReportStart);
  return isReport || IsAmong(FailureTitles, title) ||
         std::any_of(std::begin(NumberedFailureTitles), std::end(NumberedFailureTitles),
                     [&](int number) { return strings.Text(number) == title; }) ||
         (title == DefaultBoxTitle && IsAmong(FailureTexts, text));
}

BoxAnswer FailureBoxes::Show(const std::string& text, const std::string& title, BoxIcon icon,
                             BoxButtons buttons) {
  if (TellsOfFailure(strings_, text, title, icon)) {
    onFailure_();
  }
  return boxes_.Show(text, title, icon, buttons);
}
