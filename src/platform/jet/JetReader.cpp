// tessarine-jet-reader FILE TABLE: writes the rows of one table of a Jet file to standard output, in the
// format described in JetStream.h. The main program kills this one if it hangs. Exits with 0 when all rows
// were read.

#include <glib.h>
#include <mdbtools.h>
#include <sys/resource.h>

#include <charconv>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <system_error>
#include <vector>

#include "platform/jet/JetDate.h"

namespace {

constexpr std::size_t MostBytesOfText = std::size_t{8} << 20U;

[[noreturn]] void Fail(const std::string& reason) {
  std::fprintf(stderr, "%s\n", reason.c_str());
  std::exit(1);
}

void Write(const void* bytes, std::size_t size) {
  if (std::fwrite(bytes, 1, size, stdout) != size) {
    Fail("The reader of old files has lost its listener.");
  }
}

void WriteNumber(std::uint64_t number, std::size_t bytes) {
  for (std::size_t i = 0; i < bytes; ++i) {
    const char byte = static_cast<char>(number >> (8 * i));
    Write(&byte, 1);
  }
}

void WriteTag(char tag) {
  Write(&tag, 1);
}

void WriteBytes(char tag, const void* bytes, std::size_t size) {
  WriteTag(tag);
  WriteNumber(size, 4);
  Write(bytes, size);
}

void WriteText(const std::string& text) {
  WriteBytes('S', text.data(), text.size());
}

void WriteInteger(std::int64_t value) {
  WriteTag('I');
  WriteNumber(static_cast<std::uint64_t>(value), 8);
}

void WriteReal(double value) {
  WriteTag('D');
  std::uint64_t bits = 0;
  std::memcpy(&bits, &value, sizeof bits);
  WriteNumber(bits, 8);
}

/// A 32-bit float as the double nearest to its shortest decimal form: 0.1f becomes 0.1.
double Widened(float value) {
  char text[32];
  const auto written = std::to_chars(text, text + sizeof text, value);
  double wide = value;
  std::from_chars(text, written.ptr, wide);
  return wide;
}

/// Reads the columns of a table's current row.
class Row {
 public:
  explicit Row(MdbTableDef* table) : table_(table), texts_(table->num_cols), lengths_(table->num_cols) {
    for (unsigned int i = 0; i < table->num_cols; ++i) {
      texts_[i].resize(TakesText(*Column(i)) ? MostBytesOfText : MDB_BIND_SIZE);
      mdb_bind_column(table, static_cast<int>(i) + 1, texts_[i].data(), &lengths_[i]);
    }
  }

  void WriteOut() {
    int start = 0;
    std::size_t size = 0;
    std::vector<MdbField> fields(MDB_MAX_COLS);
    if (mdb_find_row(table_->entry->mdb, static_cast<int>(table_->cur_row) - 1, &start, &size) != 0 ||
        mdb_crack_row(table_, start & OffsetMask, size, fields.data()) < 0) {
      Fail("A row of the table " + std::string(table_->name) + " cannot be read.");
    }
    std::vector<bool> isNull;
    for (unsigned int i = 0; i < table_->num_cols; ++i) {
      isNull.push_back(fields[i].is_null != 0);
    }
    WriteTag('R');
    for (unsigned int i = 0; i < table_->num_cols; ++i) {
      WriteColumn(i, isNull[i]);
    }
  }

 private:
  static constexpr int OffsetMask = 0x1FFF;

  static bool TakesText(const MdbColumn& column) { return column.col_type == MDB_MEMO; }

  MdbColumn* Column(unsigned int i) const {
    return static_cast<MdbColumn*>(g_ptr_array_index(table_->columns, i));
  }

  void WriteColumn(unsigned int i, bool isNull) {
    MdbColumn& column = *Column(i);
    if (isNull && column.col_type != MDB_BOOL) {
      WriteTag('N');
      return;
    }
    unsigned char* const page = table_->entry->mdb->pg_buf;
    const int at = column.cur_value_start;
    switch (column.col_type) {
      case MDB_BOOL:
        WriteInteger(texts_[i][0] == '1' ? 1 : 0);
        break;
      case MDB_BYTE:
        WriteInteger(page[at]);
        break;
      case MDB_INT:
        WriteInteger(static_cast<std::int16_t>(mdb_get_int16(page, at)));
        break;
      case MDB_LONGINT:
        WriteInteger(static_cast<std::int32_t>(mdb_get_int32(page, at)));
        break;
      case MDB_MONEY: {
        std::int64_t tenThousandths = 0;
        std::memcpy(&tenThousandths, page + at, sizeof tenThousandths);
        WriteReal(static_cast<double>(tenThousandths) / 10000);
        break;
      }
      case MDB_FLOAT:
        WriteReal(Widened(mdb_get_single(page, at)));
        break;
      case MDB_DOUBLE:
        WriteReal(mdb_get_double(page, at));
        break;
      case MDB_DATETIME:
        WriteText(JetDateText(mdb_get_double(page, at)));
        break;
      case MDB_OLE: {
        std::size_t size = 0;
        void* bytes = mdb_ole_read_full(table_->entry->mdb, &column, &size);
        if (bytes == nullptr) {
          Fail("A picture or object in the table " + std::string(table_->name) + " cannot be read.");
        }
        WriteBytes('B', bytes, size);
        std::free(bytes);
        break;
      }
      case MDB_BINARY:
      case MDB_REPID:
        WriteBytes('B', page + at, static_cast<std::size_t>(column.cur_value_len));
        break;
      default:
        WriteBoundText(i);
        break;
    }
  }

  void WriteBoundText(unsigned int i) {
    const std::size_t length = std::strlen(texts_[i].data());
    if (length + 1 >= texts_[i].size()) {
      Fail("A text in the table " + std::string(table_->name) + " is too long.");
    }
    WriteBytes('S', texts_[i].data(), length);
  }

  MdbTableDef* table_;
  std::vector<std::vector<char>> texts_;
  std::vector<int> lengths_;
};

void WriteTable(MdbTableDef* table) {
  WriteTag('T');
  WriteText(table->name);
  WriteNumber(table->num_cols, 4);
  for (unsigned int i = 0; i < table->num_cols; ++i) {
    WriteText(static_cast<MdbColumn*>(g_ptr_array_index(table->columns, i))->name);
  }
  mdb_rewind_table(table);
  Row row(table);
  unsigned int rows = 0;
  while (mdb_fetch_row(table) != 0) {
    row.WriteOut();
    if (++rows > table->num_rows) {
      Fail("The table " + std::string(table->name) + " holds more rows than it counts.");
    }
  }
  if (rows != table->num_rows) {
    Fail("The table " + std::string(table->name) + " has " + std::to_string(table->num_rows) +
         " rows, of which " + std::to_string(rows) + " can be read.");
  }
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
    Fail("usage: tessarine-jet-reader FILE TABLE");
  }
  LimitMemory();
  MdbHandle* const mdb = mdb_open(argv[1], MDB_NOFLAGS);
  if (mdb == nullptr || mdb_read_catalog(mdb, MDB_TABLE) == nullptr) {
    Fail("Its list of tables cannot be read.");
  }
  mdb_set_bind_size(mdb, MostBytesOfText);
  MdbTableDef* wanted = nullptr;
  for (unsigned int i = 0; i < mdb->num_catalog; ++i) {
    auto* const entry = static_cast<MdbCatalogEntry*>(g_ptr_array_index(mdb->catalog, i));
    if (entry->object_type != MDB_TABLE || mdb_is_user_table(entry) == 0) {
      continue;
    }
    MdbTableDef* const table = mdb_read_table(entry);
    if (table == nullptr || mdb_read_columns(table) == nullptr) {
      Fail("The table " + std::string(entry->object_name) + " cannot be read.");
    }
    if (g_ascii_strcasecmp(entry->object_name, argv[2]) == 0) {
      wanted = table;
    } else {
      WriteTag('O');
      WriteText(entry->object_name);
      WriteNumber(table->num_rows, 8);
    }
  }
  if (wanted == nullptr) {
    Fail("It has no table " + std::string(argv[2]) + ".");
  }
  WriteTable(wanted);
  WriteTag('E');
  if (std::fflush(stdout) != 0) {
    Fail("The reader of old files has lost its listener.");
  }
  // The library's own clean-up is not needed, and is not safe after reading a damaged file.
  std::_Exit(0);
}
