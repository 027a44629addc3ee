#pragma once

#include <string>

#include "platform/Database.h"

/// The member's details that can be edited in the window. NULL becomes an empty text.
struct MemberDetails {
  std::string FirstName;
  std::string LastName;
  std::string NickName;
  std::string Clan;
  std::string Birthdate;  ///< "YYYY-MM-DD HH:MM:SS", or empty
  std::string Address;
  std::string City;
  std::string PostalCode;
  std::string EmailName;
  std::string PhoneNumber;

  bool operator==(const MemberDetails&) const = default;
};

/// The details of the current row. Throws RuntimeError as Recordset::Fields does.
MemberDetails ReadDetails(Recordset& rows);

/// Sets only those columns of the pending row in which `entered` differs from `shown`, so that a text too
/// long for its entry is not cut short. An emptied birthdate becomes NULL.
void SetChanges(Recordset& rows, const MemberDetails& shown, const MemberDetails& entered);
