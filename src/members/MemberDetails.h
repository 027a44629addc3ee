#pragma once

#include <string>

#include "platform/Database.h"

/// What the operator can change of a member by writing into the window. NULL is empty.
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

/// Sets the columns of the pending row in which `entered` differs from `shown`, and no others: a text that an
/// entry could only show in part stays whole. An emptied birthdate becomes NULL.
void SetChanges(Recordset& rows, const MemberDetails& shown, const MemberDetails& entered);
