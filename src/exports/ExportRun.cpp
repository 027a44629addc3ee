#include "exports/ExportRun.h"

#include <algorithm>

#include "platform/RuntimeError.h"

namespace {

double PartOf(std::size_t done, std::size_t whole) {
  return static_cast<double>(done) / static_cast<double>(whole);
}

bool IsFaultOfGame(int number) {
  return number == Fault::FileNotFound || number == Fault::InvalidFileFormat || number == Fault::Overflow;
}

/// Reads each game's file.
ExportOutcome ExportWhole(ExportSource& past, const std::vector<std::int64_t>& games, GameWriter& writer,
                          NewFile& file, const ExportStep& goOn) {
  ExportOutcome outcome;
  for (std::size_t place = 0; place < games.size(); ++place) {
    if (!goOn(PartOf(place, games.size()))) {
      return outcome;
    }
    try {
      past.Read(games[place], [&writer](const ExportedGame& game) { writer.Add(game); });
      ++outcome.Written;
    } catch (const RuntimeError& error) {
      if (!IsFaultOfGame(error.Number())) {
        throw;
      }
      ++outcome.LeftOut;
    }
    file.Write(writer.Take());
  }
  outcome.Complete = true;
  return outcome;
}

/// Reads the players' rows alone.
ExportOutcome ExportFigures(ExportSource& past, const std::vector<std::int64_t>& games, FiguresCsv& writer,
                            bool fullNames, NewFile& file, const ExportStep& goOn) {
  ExportOutcome outcome;
  for (std::size_t place = 0; place < games.size(); place += ExportSource::FiguresAtOnce) {
    if (!goOn(PartOf(place, games.size()))) {
      return outcome;
    }
    const std::size_t count = std::min(ExportSource::FiguresAtOnce, games.size() - place);
    const auto first = games.begin() + static_cast<std::ptrdiff_t>(place);
    past.ReadFigures({first, first + static_cast<std::ptrdiff_t>(count)}, fullNames,
                     [&writer](const PlayerFigures& figures) { writer.Add(figures); });
    file.Write(writer.Take());
  }
  file.Write(writer.Take());  // the headers, where there are no games
  outcome.Written = static_cast<std::size_t>(writer.Games());
  outcome.Complete = true;
  return outcome;
}

}  // namespace

ExportOutcome ExportPastGames(ExportSource& past, const std::vector<std::int64_t>& games,
                              const ExportChoice& choice, const StringTable& strings, NewFile& file,
                              const ExportStep& goOn) {
  ExportOutcome outcome;
  if (choice.Format == ExportFormat::Figures) {
    FiguresCsv writer(choice.Csv, choice.Personal);
    outcome = ExportFigures(past, games, writer, choice.Personal.FullNames, file, goOn);
  } else {
    const std::unique_ptr<GameWriter> writer = MakeGameWriter(choice, strings);
    outcome = ExportWhole(past, games, *writer, file, goOn);
    writer->End();
    file.Write(writer->Take());
  }
  if (outcome.Complete) {
    file.Finish();
  }
  return outcome;
}
