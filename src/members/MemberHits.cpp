#include "members/MemberHits.h"

#include <string_view>

#include "core/data/FieldValue.h"
#include "core/data/Photo.h"
#include "members/MemberQueries.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

MemberHit ReadHit(Recordset& row) {
  const auto text = [&row](const char* column) { return TextOf(row.Fields(column)); };
  MemberHit hit;
  hit.ContactId = static_cast<std::int64_t>(NumberOf(row.Fields("ContactID")));
  hit.FirstName = text("FirstName");
  hit.LastName = text("LastName");
  hit.NickName = text("NickName");
  hit.LastPlayed = text("LastPlayedDate");
  hit.HasPhoto = NumberOf(row.Fields("PhotographLength")) != 0;
  return hit;
}

}  // namespace

std::vector<std::int32_t> MembersCalled(Database& dbMembers, const std::string& text) {
  const std::string query =
      "SELECT ContactID FROM Members" + HitsQuery(text).substr(std::string_view(AllMembers).size());
  std::vector<std::int32_t> numbers;
  try {
    dbMembers.Statements().Query(query, {}, [&numbers](const SqlRow& row) {
      numbers.push_back(static_cast<std::int32_t>(row.Integer(0)));
    });
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::InvalidPattern) {
      throw;
    }
    numbers.clear();  // an incomplete pattern
  }
  return numbers;
}

void MemberHits::Search(const std::string& text) {
  try {
    rows_ = dbMembers_.OpenRecordset(HitsQuery(text));
  } catch (const RuntimeError&) {
    rows_.reset();  // the search itself reports what is wrong, once the operator starts it
  }
}

std::optional<MemberHit> MemberHits::At(int position) {
  return Try(std::optional<MemberHit>(), [&]() -> std::optional<MemberHit> {
    rows_->MoveTo(position);
    const ReadScope scope(dbMembers_);
    return ReadHit(*rows_);
  });
}

int MemberHits::PositionOf(std::int64_t contactId) {
  return Try(-1, [&] { return rows_->WalkTo("ContactID", contactId) ? rows_->AbsolutePosition() : -1; });
}

bool MemberHits::SharesName(const MemberHit& hit) {
  return Try(false, [&] {
    return dbMembers_.OpenRecordset(NameQuery(hit.FirstName, hit.LastName))->RecordCount() > 1;
  });
}

std::string MemberHits::Photo(int position) {
  return Try(std::string(), [&] {
    rows_->MoveTo(position);
    return StoredPhoto(*rows_, "Photograph", "PhotographLength");
  });
}

template <typename Result, typename Operation>
Result MemberHits::Try(Result missing, const Operation& operation) {
  if (!rows_) {
    return missing;
  }
  try {
    return operation();
  } catch (const RuntimeError& error) {
    // Each try on a file that another program has locked takes seconds, and a list reads many rows.
    const bool isGone = error.Number() == Fault::RecordDeleted || error.Number() == Fault::NoCurrentRecord;
    if (!isGone) {
      rows_.reset();
    }
    return missing;
  }
}
