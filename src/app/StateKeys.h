#pragma once

/// Places in state.ini, which holds what the program remembers of itself and no setting of the operator's.
namespace State {

inline constexpr const char* File = "/state.ini";  ///< in the user's data folder

inline constexpr const char* Games = "games";
inline constexpr const char* Program = "program";
inline constexpr const char* Release = "release";         ///< of the program at its last start
inline constexpr const char* SaveFolder = "save_folder";  ///< of the game saved last

inline constexpr const char* Archive = "archive";
inline constexpr const char* YearsAnswered = "keep_years";         ///< for which the operator was asked
inline constexpr const char* MayDelete = "keep_years_may_delete";  ///< what the answer was: 1 for yes

}  // namespace State
