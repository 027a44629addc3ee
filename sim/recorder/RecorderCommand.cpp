#include "sim/recorder/RecorderCommand.h"

#include <algorithm>
#include <array>

namespace sim {
namespace {

constexpr int Low = -1;   // low byte of the number, or all of it
constexpr int High = -2;  // its high byte

struct CommandForm {
  RecorderMode Mode;
  RecorderCommandKind Kind;
  std::size_t Length;
  std::array<int, 4> Bytes;
};

constexpr std::array<CommandForm, 9> Forms{{
    {RecorderMode::InProduct, RecorderCommandKind::Start, 2, {10, 0}},
    {RecorderMode::InProduct, RecorderCommandKind::Erase, 2, {2, 0}},
    {RecorderMode::InProduct, RecorderCommandKind::Page, 4, {1, 0, Low, High}},
    {RecorderMode::InProduct, RecorderCommandKind::End, 2, {0, 0}},
    {RecorderMode::InProduct, RecorderCommandKind::Play, 3, {14, 0, Low}},
    {RecorderMode::StandAlone, RecorderCommandKind::StartOrErase, 2, {2, 3}},
    {RecorderMode::StandAlone, RecorderCommandKind::Header, 2, {1, Low}},
    {RecorderMode::StandAlone, RecorderCommandKind::End, 2, {0, 0}},
    {RecorderMode::StandAlone, RecorderCommandKind::Play, 3, {3, 2, Low}},
}};

bool Begins(const CommandForm& form, std::span<const std::uint8_t> bytes) {
  if (bytes.size() > form.Length) {
    return false;
  }
  return std::equal(bytes.begin(), bytes.end(), form.Bytes.begin(), [](std::uint8_t byte, int expected) {
    return expected == Low || expected == High || expected == byte;
  });
}

const CommandForm* Find(RecorderMode mode, std::span<const std::uint8_t> bytes) {
  const auto* found = std::find_if(Forms.begin(), Forms.end(), [&](const CommandForm& form) {
    return form.Mode == mode && form.Length == bytes.size() && Begins(form, bytes);
  });
  return found == Forms.end() ? nullptr : found;
}

bool IsNewBeginning(RecorderCommandKind kind) {
  return kind == RecorderCommandKind::Start || kind == RecorderCommandKind::StartOrErase ||
         kind == RecorderCommandKind::Play;
}

}  // namespace

std::optional<RecorderCommand> ReadRecorderCommand(RecorderMode mode, std::span<const std::uint8_t> bytes) {
  const CommandForm* form = Find(mode, bytes);
  if (form == nullptr) {
    return std::nullopt;
  }
  RecorderCommand command{form->Kind};
  for (std::size_t i = 0; i < form->Length; ++i) {
    if (form->Bytes[i] == Low) {
      command.Number = bytes[i];
    } else if (form->Bytes[i] == High) {
      command.Number = static_cast<std::uint16_t>(command.Number + 256U * bytes[i]);
    }
  }
  return command;
}

bool BeginsRecorderCommand(RecorderMode mode, std::span<const std::uint8_t> bytes) {
  return std::any_of(Forms.begin(), Forms.end(),
                     [&](const CommandForm& form) { return form.Mode == mode && Begins(form, bytes); });
}

std::size_t NewBeginningAtEndOf(RecorderMode mode, std::span<const std::uint8_t> block) {
  for (const CommandForm& form : Forms) {
    if (form.Mode == mode && IsNewBeginning(form.Kind) && block.size() >= form.Length &&
        Begins(form, block.last(form.Length))) {
      return form.Length;
    }
  }
  return 0;
}

std::string Describe(const RecorderCommand& command) {
  switch (command.Kind) {
    case RecorderCommandKind::Start:
      return "start";
    case RecorderCommandKind::Erase:
      return "erase";
    case RecorderCommandKind::StartOrErase:
      return "start or erase";
    case RecorderCommandKind::Page:
      return "page " + std::to_string(command.Number);
    case RecorderCommandKind::Header:
      return "header of sound " + std::to_string(command.Number);
    case RecorderCommandKind::End:
      return "end";
    case RecorderCommandKind::Play:
      return "play sound " + std::to_string(command.Number);
  }
  return {};
}

}  // namespace sim
