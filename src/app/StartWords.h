#pragma once

#include <string>
#include <vector>

/// What the words behind the program's name ask for.
struct StartWords {
  enum class Kind {
    Run,
    Version,
    Help,
    Unknown  ///< `Word` is the first one that nothing is known about
  };

  Kind Asked = Kind::Run;
  std::string File = {};  ///< of a game to load, as given; empty for none
  std::string Word = {};
};

/// A word that begins with "-" is an option, unless it stands behind "--". An option that asks for something
/// takes no file.
StartWords ReadStartWords(const std::vector<std::string>& words);
