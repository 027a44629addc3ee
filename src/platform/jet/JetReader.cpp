// tessarine-jet-reader FILE TABLE: writes the rows of one table of a Jet file to standard output, in the
// format described in JetStream.h. The main program kills this one if it hangs. Exits with 0 when all rows
// were read.

#include <glib.h>
#include <mdbtools.h>
#include <sys/resource.h>

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <string_view>
#include <system_error>

#include "platform/jet/JetDate.h"
#include "platform/jet/JetLongValue.h"
#include "platform/jet/JetRows.h"
#include "platform/jet/JetText.h"
#include "platform/jet/ReaderOutput.h"

namespace {

/// Tells that a table cannot be read, and ends the program. An empty name stands for the list of tables.
[[noreturn]] void Fail(ReaderOutput& output, std::string_view table, std::uint64_t read = 0,
                       std::uint64_t counted = 0) {
  output.Tag('F');
  output.Text(table);
  output.Number(read, 8);
  output.Number(counted, 8);
  output.Flush();
  std::_Exit(1);
}

/// A number of type T at the start of `bytes`.
template <typename T>
T NumberIn(std::string_view bytes) {
  T number{};
  std::memcpy(&number, bytes.data(), sizeof number);
  return number;
}

/// Bytes of a number of one of Jet's types; 0 for a type of any size.
std::size_t SizeOf(int type) {
  switch (type) {
    case MDB_BYTE:
      return 1;
    case MDB_INT:
      return 2;
    case MDB_LONGINT:
    case MDB_FLOAT:
      return 4;
    case MDB_MONEY:
    case MDB_DOUBLE:
    case MDB_DATETIME:
      return 8;
    default:
      return 0;
  }
}

/// A 32-bit float as the double nearest to its shortest decimal form: 0.1f becomes 0.1.
double Widened(float value) {
  char text[32];
  const auto written = std::to_chars(text, text + sizeof text, value);
  double wide = value;
  std::from_chars(text, written.ptr, wide);
  return wide;
}

/// Before version 4 texts are in the file's code page, which the library knows.
JetText DecodeInCodePage(MdbHandle* mdb, std::string_view bytes) {
  if (bytes.empty()) {
    return {};
  }
  constexpr std::size_t mostBytesOfCharacter = 4;
  std::string text(bytes.size() * mostBytesOfCharacter + 1, '\0');
  const int size = mdb_unicode2ascii(mdb, bytes.data(), bytes.size(), text.data(), text.size());
  text.resize(static_cast<std::size_t>(size));
  // The library puts a question mark where it knows no character.
  const auto marks = [](std::string_view where) { return std::count(where.begin(), where.end(), '?'); };
  const bool whole = marks(text) == marks(bytes);
  return {std::move(text), whole};
}

class TableWriter {
 public:
  TableWriter(MdbTableDef* table, ReaderOutput& output)
      : mdb_(table->entry->mdb), output_(output), rows_(table) {}

  /// Writes all rows; returns their number, which is at most one more than `most`.
  std::uint64_t WriteRows(std::uint64_t most) {
    std::uint64_t count = 0;
    while (count <= most && rows_.Next()) {
      output_.Tag('R');
      for (unsigned int i = 0; i < rows_.ColumnCount(); ++i) {
        WriteColumn(i);
      }
      ++count;
    }
    return count;
  }

 private:
  void WriteColumn(unsigned int i) {
    const int type = rows_.Column(i).col_type;
    if (type == MDB_BOOL) {  // stored as the mark of a value that is there
      output_.Integer(rows_.IsNull(i) ? 0 : 1);
    } else if (rows_.IsNull(i)) {
      output_.Null();
    } else if (type == MDB_OLE || type == MDB_MEMO) {
      WriteLong(rows_.Bytes(i), type == MDB_MEMO);
    } else if (type == MDB_NUMERIC) {
      output_.Text(rows_.DecimalText(i));
    } else if (type == MDB_TEXT) {
      WriteText(rows_.Bytes(i));
    } else if (rows_.Bytes(i).size() < SizeOf(type)) {
      WriteUnread();
    } else if (!WriteNumber(type, rows_.Bytes(i))) {
      output_.Binary(rows_.Bytes(i));
    }
  }

  void WriteUnread() {
    output_.Tag('U');
    output_.Null();
  }

  bool WriteNumber(int type, std::string_view bytes) {
    constexpr double moneyUnits = 10000;
    switch (type) {
      case MDB_BYTE:
        output_.Integer(NumberIn<std::uint8_t>(bytes));
        return true;
      case MDB_INT:
        output_.Integer(NumberIn<std::int16_t>(bytes));
        return true;
      case MDB_LONGINT:
        output_.Integer(NumberIn<std::int32_t>(bytes));
        return true;
      case MDB_MONEY:
        output_.Real(static_cast<double>(NumberIn<std::int64_t>(bytes)) / moneyUnits);
        return true;
      case MDB_FLOAT:
        output_.Real(Widened(NumberIn<float>(bytes)));
        return true;
      case MDB_DOUBLE:
        output_.Real(NumberIn<double>(bytes));
        return true;
      case MDB_DATETIME:
        WriteDate(NumberIn<double>(bytes));
        return true;
      default:
        return false;
    }
  }

  void WriteDate(double date) {
    if (IsJetDate(date)) {
      output_.Text(JetDateText(date));
    } else {
      WriteUnread();
    }
  }

  void WriteText(std::string_view bytes) {
    const JetText text = IS_JET3(mdb_) ? DecodeInCodePage(mdb_, bytes) : DecodeJetText(bytes);
    if (!text.Whole) {
      output_.Tag('U');
    }
    output_.Text(text.Utf8);
  }

  void WriteLong(std::string_view reference, bool isText) {
    const auto value = ReadLongValue(mdb_, reference);
    if (!value) {
      WriteUnread();
    } else if (isText) {
      WriteText(*value);
    } else {
      output_.Binary(*value);
    }
  }

  MdbHandle* mdb_;
  ReaderOutput& output_;
  JetRows rows_;
};

void WriteTable(MdbTableDef* table, ReaderOutput& output) {
  output.Tag('T');
  output.Text(table->name);
  output.Number(table->num_cols, 4);
  for (unsigned int i = 0; i < table->num_cols; ++i) {
    output.Text(static_cast<MdbColumn*>(g_ptr_array_index(table->columns, i))->name);
  }
  const std::uint64_t count = TableWriter(table, output).WriteRows(table->num_rows);
  if (count != table->num_rows) {
    Fail(output, table->name, count, table->num_rows);
  }
  output.Tag('E');
}

/// The table of an entry of the catalog, with its columns; nullptr if it cannot be read.
MdbTableDef* ReadTable(MdbCatalogEntry* entry) {
  MdbTableDef* const table = mdb_read_table(entry);
  return table == nullptr || table->num_cols > MDB_MAX_COLS || mdb_read_columns(table) == nullptr ? nullptr
                                                                                                  : table;
}

/// The library takes what it can read of the list of tables; the list counts its rows as every table does.
bool CatalogIsWhole(MdbHandle* mdb) {
  MdbCatalogEntry* const entry = mdb_get_catalogentry_by_name(mdb, "MSysObjects");
  MdbTableDef* const table = entry == nullptr ? nullptr : ReadTable(entry);
  if (table == nullptr) {
    return false;
  }
  JetRows rows(table);
  unsigned int count = 0;
  while (count <= table->num_rows && rows.Next()) {
    ++count;
  }
  return count == table->num_rows;
}

/// Writes the names of the other tables of the user, and returns the wanted one.
MdbTableDef* WriteOtherTables(MdbHandle* mdb, const char* name, ReaderOutput& output) {
  MdbTableDef* wanted = nullptr;
  for (unsigned int i = 0; i < mdb->num_catalog; ++i) {
    auto* const entry = static_cast<MdbCatalogEntry*>(g_ptr_array_index(mdb->catalog, i));
    if (entry->object_type != MDB_TABLE || mdb_is_user_table(entry) == 0) {
      continue;
    }
    MdbTableDef* const table = ReadTable(entry);
    if (table == nullptr) {
      Fail(output, entry->object_name);
    }
    if (g_ascii_strcasecmp(entry->object_name, name) == 0) {
      wanted = table;
    } else {
      output.Tag('O');
      output.Text(entry->object_name);
      output.Number(table->num_rows, 8);
    }
  }
  return wanted;
}

#ifdef __has_feature
#define HAS_FEATURE(name) __has_feature(name)
#else
#define HAS_FEATURE(name) 0
#endif

/// A damaged file can make the library ask for more and more memory.
void LimitMemory() {
#if !HAS_FEATURE(address_sanitizer)  // which reserves terabytes of address space
  constexpr rlim_t mostMemory = rlim_t{2} << 30U;
  const rlimit limit{mostMemory, mostMemory};
  setrlimit(RLIMIT_AS, &limit);
#endif
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 3) {
    std::fprintf(stderr, "usage: tessarine-jet-reader FILE TABLE\n");
    return 2;
  }
  LimitMemory();
  ReaderOutput output;
  MdbHandle* const mdb = mdb_open(argv[1], MDB_NOFLAGS);
  if (mdb == nullptr || mdb_read_catalog(mdb, MDB_TABLE) == nullptr || !CatalogIsWhole(mdb)) {
    Fail(output, "");
  }
  MdbTableDef* const wanted = WriteOtherTables(mdb, argv[2], output);
  if (wanted == nullptr) {
    Fail(output, argv[2]);
  }
  WriteTable(wanted, output);
  output.Flush();
  // The library's own clean-up is not needed, and is not safe after reading a damaged file.
  std::_Exit(0);
}
