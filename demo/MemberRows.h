#pragma once

#include <QDate>
#include <QString>
#include <string>
#include <vector>

#include "demo/DemoMembers.h"
#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// Where the rows and the photographs of members go.
struct MemberStore {
  Database& DbMembers;
  Files& Disk;
  MessageBoxes& Boxes;
};

/// Adds all members or, if one fails, none. `buttons` has a number for each. Throws RuntimeError if the
/// database refuses a row, std::runtime_error if a photograph cannot be made.
void AddMembers(const MemberStore& store, const std::vector<DemoMember>& members,
                const std::vector<std::string>& buttons, const QDate& today);

/// Who owns which button: a header and a line for each row, with tabs between button, member number, nickname
/// and names.
QString ButtonOwners(Recordset& members);
