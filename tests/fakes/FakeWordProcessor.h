#pragma once

#include <functional>
#include <map>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/WordProcessor.h"

/// A word processor that only records. Every operation is logged ("Start", "Add /x/score_card.doc",
/// "SetBookmark Rank", "WriteCells 4", "AddPicture 1 1 1", "SaveAs /x/y.doc", "ExportPdf", "PrintOut",
/// "Close", "JoinPdfs 3 /x/z.pdf", "Quit"); one of them can be made to fail.
class FakeWordProcessor : public WordProcessor {
 public:
  struct Document {
    std::string Template;
    std::map<std::string, std::string> Bookmarks;
    std::vector<std::string> BookmarkOrder;
    std::map<int, std::vector<std::string>> Cells;  ///< by table
    std::map<int, RowSizes> Sizes;                  ///< by table
    std::string Picture;                            ///< its path
    std::string SavedAs;
    int Printed = 0;
    bool Closed = false;
  };

  std::vector<std::string> Log;
  std::vector<std::unique_ptr<Document>> Documents;

  /// What State returns; Start changes it from Ended to `AfterStart`.
  WordState Now = WordState::Ended;
  WordState AfterStart = WordState::Ready;

  /// Every operation whose log entry begins with this text fails.
  std::string FailAt;

  /// Called before each operation, with its log entry.
  std::function<void(const std::string&)> OnOperation;

  void Start() override {
    Note("Start");
    if (Now == WordState::Ended) {
      Now = AfterStart;
    }
  }

  WordState State() override { return Now; }

  std::unique_ptr<WordDocument> Add(const std::string& path) override {
    Note("Add " + path);
    if (Now != WordState::Ready) {
      throw RuntimeError(Fault::CannotCreateObject);
    }
    Documents.push_back(std::make_unique<Document>());
    Documents.back()->Template = path;
    return std::make_unique<OpenDocument>(*this, *Documents.back());
  }

  void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                const std::function<void()>& onProgress) override {
    Note("JoinPdfs " + std::to_string(parts.size()) + " " + target);
    onProgress();
  }

  void Quit() noexcept override {
    Log.emplace_back("Quit");
    Now = WordState::Ended;
  }

 private:
  class OpenDocument : public WordDocument {
   public:
    OpenDocument(FakeWordProcessor& owner, Document& document) : owner_(owner), document_(document) {}

    void SetBookmark(const std::string& name, const std::string& text) override {
      owner_.Note("SetBookmark " + name);
      document_.Bookmarks[name] = text;
      document_.BookmarkOrder.push_back(name);
    }
    void WriteCells(int table, int firstRow, int rows, const std::vector<std::string>& texts) override {
      owner_.Note("WriteCells " + std::to_string(table));
      if (firstRow != 2 || rows != 20) {
        throw std::logic_error("Hits stand in rows 2 to 21");
      }
      document_.Cells[table] = texts;
    }
    void ResizeRows(int table, int, int, const RowSizes& sizes) override {
      owner_.Note("ResizeRows " + std::to_string(table));
      document_.Sizes[table] = sizes;
    }
    void AddPicture(int table, int row, int column, const std::string& file) override {
      owner_.Note("AddPicture " + std::to_string(table) + ' ' + std::to_string(row) + ' ' +
                  std::to_string(column));
      document_.Picture = file;
    }
    void SaveAs(const std::string& path) override {
      owner_.Note("SaveAs " + path);
      document_.SavedAs = path;
    }
    void ExportPdf(const std::string&) override { owner_.Note("ExportPdf"); }
    void PrintOut() override {
      owner_.Note("PrintOut");
      ++document_.Printed;
    }
    void Close() override {
      owner_.Note("Close");
      document_.Closed = true;
    }

   private:
    FakeWordProcessor& owner_;
    Document& document_;
  };

  void Note(const std::string& operation) {
    Log.push_back(operation);
    if (const auto onOperation = OnOperation) {
      onOperation(operation);
    }
    if (!FailAt.empty() && operation.rfind(FailAt, 0) == 0) {
      throw RuntimeError(Fault::AutomationError, "Told to fail");
    }
  }
};
