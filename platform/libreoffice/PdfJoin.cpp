#include "platform/libreoffice/PdfJoin.h"

#include <filesystem>
#include <memory>
#include <qpdf/QPDF.hh>
#include <qpdf/QPDFPageDocumentHelper.hh>
#include <qpdf/QPDFWriter.hh>

#include "platform/RuntimeError.h"

void JoinPdfs(const std::vector<std::string>& parts, const std::string& target) {
  try {
    QPDF whole;
    whole.emptyPDF();
    QPDFPageDocumentHelper pages(whole);
    std::vector<std::shared_ptr<QPDF>> sources;  // their streams are copied when the whole is written
    for (const std::string& part : parts) {
      sources.push_back(std::make_shared<QPDF>());
      sources.back()->processFile(part.c_str());
      for (auto& page : QPDFPageDocumentHelper(*sources.back()).getAllPages()) {
        pages.addPage(page, false);
      }
    }
    QPDFWriter(whole, target.c_str()).write();
  } catch (const std::exception& failure) {
    std::error_code ignored;
    std::filesystem::remove(target, ignored);
    throw RuntimeError(75, failure.what());
  }
}
