#include "firmware/pic24f/tool/ToolOptions.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <stdexcept>

namespace {

struct CommandRow {
  const char* Name;
  bool TakesFile;
  bool NeedsOut;
  bool NeedsPort;
};

constexpr std::array<CommandRow, 8> CommandRows = {{{"check", true, false, false},
                                                    {"import", true, true, false},
                                                    {"image", true, true, false},
                                                    {"identify", false, false, true},
                                                    {"erase", false, false, true},
                                                    {"write", true, false, true},
                                                    {"verify", true, false, true},
                                                    {"run", false, false, true}}};

const CommandRow& RowOf(const std::string& command) {
  const auto* row = std::find_if(CommandRows.begin(), CommandRows.end(),
                                 [&](const CommandRow& each) { return each.Name == command; });
  if (row == CommandRows.end()) {
    throw std::invalid_argument(command.empty() ? "no command" : "unknown command: " + command);
  }
  return *row;
}

std::int32_t RateOf(const std::string& text) {
  std::int32_t rate = 0;
  const char* const end = text.data() + text.size();
  const auto [rest, error] = std::from_chars(text.data(), end, rate);
  if (error != std::errc() || rest != end || rate <= 0) {
    throw std::invalid_argument("no bit rate: " + text);
  }
  return rate;
}

class Words {
 public:
  explicit Words(const std::vector<std::string>& words) : words_(words) {}

  bool AtEnd() const { return at_ == words_.size(); }
  const std::string& Next() { return words_[at_++]; }

  const std::string& ValueOf(const std::string& option) {
    if (AtEnd()) {
      throw std::invalid_argument(option + " needs a value");
    }
    return Next();
  }

 private:
  const std::vector<std::string>& words_;
  std::size_t at_ = 0;
};

/// False if `word` is no option.
bool TakeOption(const std::string& word, Words& words, ToolOptions& options) {
  if (word == "--help" || word == "-h") {
    options.Help = true;
  } else if (word == "--out") {
    options.Out = words.ValueOf(word);
  } else if (word == "--port") {
    options.Port = words.ValueOf(word);
  } else if (word == "--rate") {
    options.Rate = RateOf(words.ValueOf(word));
  } else if (word == "--device") {
    options.DeviceName = words.ValueOf(word);
  } else if (word == "--despite-warnings") {
    options.DespiteWarnings = true;
  } else if (word == "--keep-config") {
    options.KeepConfig = true;
  } else if (word.size() > 1 && word.starts_with('-')) {
    throw std::invalid_argument("unknown option: " + word);
  } else {
    return false;
  }
  return true;
}

void Check(const ToolOptions& options) {
  const CommandRow& row = RowOf(options.Command);
  const std::string command = options.Command;
  if (row.TakesFile && options.File.empty()) {
    throw std::invalid_argument(command + " needs a file");
  }
  if (!row.TakesFile && !options.File.empty()) {
    throw std::invalid_argument(command + " takes no file");
  }
  if (row.NeedsOut && options.Out.empty()) {
    throw std::invalid_argument(command + " needs --out");
  }
  if (row.NeedsPort && options.Port.empty()) {
    throw std::invalid_argument(command + " needs --port");
  }
}

}  // namespace

ToolOptions ParseToolOptions(const std::vector<std::string>& wordList) {
  ToolOptions options;
  for (Words words(wordList); !words.AtEnd();) {
    const std::string& word = words.Next();
    if (TakeOption(word, words, options)) {
      continue;
    }
    if (options.Command.empty()) {
      options.Command = word;
    } else if (options.File.empty()) {
      options.File = word;
    } else {
      throw std::invalid_argument("one file at a time: " + word);
    }
  }
  if (!options.Help) {
    Check(options);
  }
  return options;
}

std::string ToolUsage() {
  return "Usage: tessarine-pic24f COMMAND [FILE] [OPTION]...\n"
         "Checks Intel HEX files and loads them into devices with a PIC24F boot loader.\n"
         "\n"
         "  check FILE               checks a file\n"
         "  import FILE --out DIR    makes the memory images progmem.img, eedata.img and config.img in DIR,\n"
         "                           and warns of what a device would not get\n"
         "  image FILE --out FILE    makes the program image of a larger device\n"
         "  identify                 asks a device who it is\n"
         "  erase                    erases a device's program memory\n"
         "  write FILE               writes a file into an erased device, and compares\n"
         "  verify FILE              compares a device with a file\n"
         "  run                      lets a device run its program\n"
         "\n"
         "  --port DEVICE            serial port of the device, such as /dev/ttyUSB0 or COM1\n"
         "  --rate N                 its bit rate; 115200 without this option\n"
         "  --device NAME            section of P24qp.ini that describes the device; without this option "
         "the\n"
         "                           device tells its identity\n"
         "  --despite-warnings       write: also a file with warnings\n"
         "  --keep-config            erase: not the last page, with the configuration words, of devices "
         "that\n"
         "                           have them there\n"
         "  --help                   shows this text\n"
         "\n"
         "The first line that a command prints is \"code N\". check, import, write and the others end with "
         "0\n"
         "for code 1, identify for any code above 0; import ends with 2 if there are warnings. 1 is any "
         "other\n"
         "result, 3 a wrong command line.\n"
         "\n"
         "Codes: 1 done; 0 refused before anything was changed; -1 empty file, or the port does not open; "
         "-2\n"
         "no answer; -3 wrong checksum in the file, or an answer that is too short; -4 a line that is no\n"
         "record, or no such packet; -5 no end record; -6 a file or record that cannot be read; -100 "
         "stopped\n"
         "by Ctrl+C; -101 the device's content is not that of the file.\n";
}
