#pragma once

#include <string>
#include <string_view>

/// A name for the file of a game: "2026-11-21 2015 The Night Courier.game.xml", the same in every locale.
/// `received` is "YYYY-MM-DD HH:MM:SS". What a file name cannot hold on one of the usual systems becomes "-";
/// the name has at most 200 bytes.
std::string SuggestedGameName(std::string_view received, std::string_view missionName);

/// The same with another ending, or none.
std::string SuggestedFileName(std::string_view received, std::string_view missionName,
                              std::string_view ending);
