#include "platform/libreoffice/PdfJoin.h"

#include <filesystem>
#include <functional>
#include <memory>
#include <qpdf/QPDF.hh>
#include <qpdf/QPDFPageDocumentHelper.hh>
#include <qpdf/QPDFWriter.hh>

#include "platform/RuntimeError.h"

namespace {

class Reporter : public QPDFWriter::ProgressReporter {
 public:
  explicit Reporter(const std::function<void()>& onProgress) : onProgress_(onProgress) {}
  void reportProgress(int /*percent*/) override { onProgress_(); }

 private:
  const std::function<void()>& onProgress_;
};

void Remove(const std::string& path) {
  std::error_code ignored;
  std::filesystem::remove(path, ignored);
}

}  // namespace

void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
              const std::function<void()>& onProgress) {
  try {
    QPDF whole;
    whole.emptyPDF();
    QPDFPageDocumentHelper pages(whole);
    std::vector<std::shared_ptr<QPDF>> sources;  // kept open: write() copies their streams
    for (const std::string& part : parts) {
      sources.push_back(std::make_shared<QPDF>());
      sources.back()->processFile(part.c_str());
      for (auto& page : QPDFPageDocumentHelper(*sources.back()).getAllPages()) {
        pages.addPage(page, false);
      }
      onProgress();
    }
    QPDFWriter writer(whole, target.c_str());
    writer.registerProgressReporter(std::make_shared<Reporter>(onProgress));
    writer.write();
  } catch (const std::exception& failure) {
    Remove(target);
    throw RuntimeError(Fault::PathAccess, failure.what());
  } catch (...) {
    Remove(target);  // `onProgress` threw to cancel
    throw;
  }
}
