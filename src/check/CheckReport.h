#pragma once

#include <string>
#include <vector>

#include "core/text/StringTable.h"

/// What a check is about, in the order in which they are told.
enum class CheckSubject {
  Ports,
  BaseUnit,
  Reader,
  WordProcessor,
  Printer,
  Chinese,
  Screens,
  Disk,
  Clock,
  Missions,
  Members,
  Games
};
inline constexpr int CheckSubjectCount = 12;

/// What was found about it.
struct CheckItem {
  CheckSubject Subject = CheckSubject::Ports;
  bool Fine = true;
  std::string Text;  ///< what there is, or what to do

  bool operator==(const CheckItem&) const = default;
};

/// What the operator calls the subject.
std::string NameOf(CheckSubject subject, const StringTable& strings);

/// "Fine" or "To do".
std::string StateOf(const CheckItem& item, const StringTable& strings);

/// `text` without the user's name: "~" in place of the home folder, and in place of a folder that is called
/// like the user. Both may be empty.
std::string WithoutUser(std::string text, const std::string& homeFolder, const std::string& userName);

/// The items as a text to pass on, a line each, behind lines of facts about program and system.
std::string CheckReport(const std::vector<std::string>& facts, const std::vector<CheckItem>& items,
                        const StringTable& strings);
