#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

enum class WordState { Ended, Starting, Ready };

/// Sizes of the rows of a table, as multiples of what the template gives them.
struct RowSizes {
  int Used = 0;           ///< the first rows, which are in use
  double Letters = 1;     ///< of the used rows' first column, which is widened for them
  double UsedHeight = 1;  ///< of a used row
  double RestHeight = 1;  ///< of each of the other rows
};

/// A document open in the word processor. It stays open until Close or until the word processor ends. All
/// operations throw RuntimeError on failure, also if the word processor is gone. Tables are those of the
/// document's body, in document order; tables, rows and columns count from 1.
class WordDocument {
 public:
  virtual ~WordDocument() = default;

  /// Replaces the bookmark's contents with `text`. Throws if there is no such bookmark.
  virtual void SetBookmark(const std::string& name, const std::string& text) = 0;

  /// Writes `texts` into a table's cells: down the first column for `rows` rows, starting at `firstRow`, then
  /// on in the next column; in one operation if the table allows it. Other cells are not changed. Throws if
  /// the table is missing (even with nothing to write) or a cell is missing.
  virtual void WriteCells(int table, int firstRow, int rows, const std::vector<std::string>& texts) = 0;

  /// Changes the letters and heights of `rows` rows of a table, starting at `firstRow`, whose texts are all
  /// in the first column. Does nothing if the table has no lines of a fixed height or no second column whose
  /// room the first can take: then its template was laid out in another way.
  virtual void ResizeRows(int table, int firstRow, int rows, const RowSizes& sizes) = 0;

  /// Inserts the picture in `file` into a cell: in its own size (96 dots per inch if it tells none), made
  /// smaller if the cell or the page has no room for that. Throws if it is not a picture.
  virtual void AddPicture(int table, int row, int column, const std::string& file) = 0;

  /// Writes the document to `path` in Word's binary format, replacing any file there. A failure leaves no
  /// partial file.
  virtual void SaveAs(const std::string& path) = 0;

  /// Writes the document to `path` as PDF.
  virtual void ExportPdf(const std::string& path) = 0;

  /// Sends the document to the system's default printer. Throws if there is none.
  virtual void PrintOut() = 0;

  /// Closes without saving.
  virtual void Close() = 0;
};

/// The word processor, a separate process that is started in the background.
class WordProcessor {
 public:
  virtual ~WordProcessor() = default;

  /// Starts it unless it is already running, and returns at once; State() shows when it is ready. Throws
  /// RuntimeError 429 if it is not installed.
  virtual void Start() = 0;

  /// The current state. Changes are only noticed by this call, so poll it while the word processor is
  /// starting.
  virtual WordState State() = 0;

  /// Creates a document from the template at `path`. Throws RuntimeError 53 if there is no such file, 321 if
  /// it is not a document, 429 if the word processor is not ready.
  virtual std::unique_ptr<WordDocument> Add(const std::string& path) = 0;

  /// Joins the PDF files `parts` into one at `target`, in their order, calling `onProgress` now and then.
  /// Does not need a running word processor.
  virtual void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                        const std::function<void()>& onProgress) = 0;

  /// Ends it without saving anything; failures are ignored.
  virtual void Quit() noexcept = 0;
};
