#include "members/MemberDetails.h"

#include "core/data/FieldValue.h"

namespace {

struct BoundColumn {
  const char* Name;
  std::string MemberDetails::*Detail;
};

constexpr BoundColumn BoundColumns[] = {
    {"FirstName", &MemberDetails::FirstName}, {"LastName", &MemberDetails::LastName},
    {"NickName", &MemberDetails::NickName},   {"Clan", &MemberDetails::Clan},
    {"Birthdate", &MemberDetails::Birthdate}, {"Address", &MemberDetails::Address},
    {"City", &MemberDetails::City},           {"PostalCode", &MemberDetails::PostalCode},
    {"EmailName", &MemberDetails::EmailName}, {"PhoneNumber", &MemberDetails::PhoneNumber},
};

}  // namespace

MemberDetails ReadDetails(Recordset& rows) {
  MemberDetails details;
  for (const BoundColumn& column : BoundColumns) {
    details.*column.Detail = TextOf(rows.Fields(column.Name));
  }
  return details;
}

void SetChanges(Recordset& rows, const MemberDetails& shown, const MemberDetails& entered) {
  for (const BoundColumn& column : BoundColumns) {
    const std::string& text = entered.*column.Detail;
    if (text == shown.*column.Detail) {
      continue;
    }
    const bool noDate = column.Detail == &MemberDetails::Birthdate && text.empty();
    rows.SetField(column.Name, noDate ? Value() : Value(text));
  }
}
