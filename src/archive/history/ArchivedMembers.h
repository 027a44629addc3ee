#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "platform/Database.h"
#include "platform/Sql.h"

/// A member who stands in the archive.
struct ArchivedMember {
  std::int32_t Number = 0;
  bool IsMember = false;    ///< is in the member table
  std::string Name = {};    ///< first and last name, and the nickname in quotes; empty for who is no member
  std::string Button = {};  ///< as the archive knows it; empty without one
};

/// All whom the archive knows, by name and then number; who is no member any more comes last. Throws
/// RuntimeError as Sql does.
std::vector<ArchivedMember> ArchivedMembers(Sql& archive, Database& members);

/// Puts a member whom the archive does not know in front of `all`; nothing if it knows him, or nobody has
/// the number. Throws RuntimeError as Sql does.
void IncludeMember(std::vector<ArchivedMember>& all, std::int32_t number, Database& members);

/// True if the number is, or the name or button holds, what the operator looks for; upper and lower case are
/// one. An empty text finds all.
bool IsFound(const ArchivedMember& member, const std::string& text);
