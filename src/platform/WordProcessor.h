#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

enum class WordState { Ended, Starting, Ready };

/// One document that is open in the word processor. It stays open there until Close or until the word
/// processor ends. All operations throw RuntimeError when they fail, also when the word processor is gone.
/// Tables are those of the document's body, in its order; tables, rows and columns count from 1.
class WordDocument {
 public:
  virtual ~WordDocument() = default;

  /// Puts `text` in the place of what the bookmark encloses. Throws when there is no such bookmark.
  virtual void SetBookmark(const std::string& name, const std::string& text) = 0;

  /// Writes `texts` into cells of a table, down each column from row `firstRow` for `rows` rows, then on in
  /// the next column, all of it as one operation where the table allows it. Other cells stay. Throws when the
  /// table is missing, also when there is nothing to write, and when a cell is missing.
  virtual void WriteCells(int table, int firstRow, int rows, const std::vector<std::string>& texts) = 0;

  /// Puts the picture in `file` into a cell, as large as the cell is wide. Throws when it is no picture.
  virtual void AddPicture(int table, int row, int column, const std::string& file) = 0;

  /// Writes the document to `path` in the binary format of Word, replacing a file there. A failure leaves no
  /// half file.
  virtual void SaveAs(const std::string& path) = 0;

  /// Writes the document's pages to `path`.
  virtual void ExportPdf(const std::string& path) = 0;

  /// Sends the document to the system's default printer. Throws when there is none.
  virtual void PrintOut() = 0;

  /// Closes without saving.
  virtual void Close() = 0;
};

/// The word processor: a process of its own that is started in the background.
class WordProcessor {
 public:
  virtual ~WordProcessor() = default;

  /// Starts it unless it runs already, and returns at once; State() tells how far it is. Throws RuntimeError
  /// 429 when it is not installed.
  virtual void Start() = 0;

  /// What it does now; asking is what notices a change, so ask from time to time while it is starting.
  virtual WordState State() = 0;

  /// A new document made from the template at `path`. Throws RuntimeError 53 when there is no such file, 321
  /// when it is no document, 429 when the word processor is not ready.
  virtual std::unique_ptr<WordDocument> Add(const std::string& path) = 0;

  /// Joins the PDF files `parts` into one at `target`, in their order, and calls `onProgress` now and
  /// then. Works without a running word
  /// processor.
  virtual void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                        const std::function<void()>& onProgress) = 0;

  /// Ends it without saving anything; failures are of no interest.
  virtual void Quit() noexcept = 0;
};
