#include <dlfcn.h>
#include <osl/pipe.h>
#include <stdlib.h>
#include <com/sun/star/bridge/XUnoUrlResolver.hpp>
#include <com/sun/star/connection/NoConnectException.hpp>
#include <com/sun/star/frame/XComponentLoader.hpp>
#include <com/sun/star/frame/XDesktop.hpp>
#include <com/sun/star/frame/XModel.hpp>
#include <com/sun/star/graphic/XGraphicProvider.hpp>
#include <com/sun/star/lang/XMultiComponentFactory.hpp>
#include <com/sun/star/uno/XComponentContext.hpp>
#include <com/sun/star/util/XCloseable.hpp>
#include <cppuhelper/bootstrap.hxx>

#include <filesystem>
#include <map>
#include <utility>

#include "platform/libreoffice/OfficeClient.h"
#include "platform/libreoffice/OfficeDocument.h"
#include "platform/libreoffice/PdfJoin.h"
#include "platform/libreoffice/Uno.h"

using com::sun::star::uno::UNO_QUERY;
using com::sun::star::uno::UNO_QUERY_THROW;
using com::sun::star::uno::XComponentContext;
using Uno::Any;
using Uno::OUString;
using Uno::Reference;

namespace {

/// Identifies a version of a template file: path and modification time.
using TemplateKey = std::pair<std::string, std::filesystem::file_time_type>;

/// What is known about a template, so that the next document made from it takes fewer calls.
struct Template {
  OUString Filter;  ///< the import filter; empty until the first load
  std::shared_ptr<BodyTables> Tables = std::make_shared<BodyTables>();
};

/// True for a text document in a word processor's format; sets `filter` to the import filter used. A file of
/// unknown format is loaded as plain text, and does not count.
bool IsTemplate(const Reference<com::sun::star::text::XTextDocument>& document, OUString& filter) {
  if (!document.is()) {
    return false;
  }
  OUString used;
  for (const auto& argument : document->getArgs()) {
    if (argument.Name == "FilterName") {
      argument.Value >>= used;
    }
  }
  if (used == "Text" || used == "Text (encoded)") {
    return false;
  }
  filter = used;
  return true;
}

class UnoClient : public OfficeClient {
 public:
  std::string ProgramFolder() const override {
    Dl_info info{};
    dladdr(reinterpret_cast<const void*>(&osl_createPipe), &info);
    return std::filesystem::path(info.dli_fname).parent_path();
  }

  bool Connect(const std::string& name) override;
  std::unique_ptr<WordDocument> Add(const std::string& path) override;

  void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                const std::function<void()>& onProgress) override {
    ::JoinPdfs(parts, target, onProgress);
  }

  void Disconnect() noexcept override;

 private:
  void CreateLocalContext();

  template <typename Interface>
  Reference<Interface> Create(const Reference<XComponentContext>& context, const char* service) {
    return {
        context->getServiceManager()->createInstanceWithContext(OUString::createFromAscii(service), context),
        UNO_QUERY_THROW};
  }

  Reference<XComponentContext> local_;
  Reference<com::sun::star::bridge::XUnoUrlResolver> resolver_;
  Reference<com::sun::star::frame::XDesktop> desktop_;
  OfficeServices services_;
  std::map<TemplateKey, Template> templates_;
};

void UnoClient::CreateLocalContext() {
  // Without this UNO's start-up in this process finds neither its services nor its types, and crashes.
  const std::string bootstrap = "vnd.sun.star.pathname:" + ProgramFolder() + "/fundamentalrc";
  setenv("URE_BOOTSTRAP", bootstrap.c_str(), 1);
  local_ = cppu::defaultBootstrap_InitialComponentContext();
  resolver_ = Create<com::sun::star::bridge::XUnoUrlResolver>(local_, "com.sun.star.bridge.UnoUrlResolver");
}

bool UnoClient::Connect(const std::string& name) {
  return Uno::Call([&] {
    if (!resolver_.is()) {
      CreateLocalContext();
    }
    try {
      const Reference<XComponentContext> remote(
          resolver_->resolve(Uno::ToOffice("uno:pipe,name=" + name + ";urp;StarOffice.ComponentContext")),
          UNO_QUERY_THROW);
      desktop_ = Create<com::sun::star::frame::XDesktop>(remote, "com.sun.star.frame.Desktop");
      services_ = {
          Create<com::sun::star::graphic::XGraphicProvider>(remote, "com.sun.star.graphic.GraphicProvider"),
          Create<com::sun::star::awt::XPrinterServer2>(remote, "com.sun.star.awt.PrinterServer")};
      return true;
    } catch (const com::sun::star::connection::NoConnectException&) {
      return false;
    }
  });
}

std::unique_ptr<WordDocument> UnoClient::Add(const std::string& path) {
  std::error_code failure;
  const auto changed = std::filesystem::last_write_time(path, failure);
  if (failure) {
    throw RuntimeError(Fault::FileNotFound, "File not found: " + path);
  }
  return Uno::Call([&] {
    Template& known = templates_[{path, changed}];
    const Reference<com::sun::star::frame::XComponentLoader> loader(desktop_, UNO_QUERY_THROW);
    const Reference<com::sun::star::lang::XComponent> component = loader->loadComponentFromURL(
        Uno::UrlOf(path), "_blank", 0,
        Uno::Properties(
            {{"Hidden", Any(true)}, {"AsTemplate", Any(true)}, {"FilterName", Any(known.Filter)}}));
    const Reference<com::sun::star::text::XTextDocument> document(component, UNO_QUERY);
    if (known.Filter.isEmpty() && !IsTemplate(document, known.Filter)) {
      if (const Reference<com::sun::star::util::XCloseable> open(component, UNO_QUERY); open.is()) {
        open->close(true);
      }
      throw RuntimeError(Fault::InvalidFileFormat, "Invalid file format: " + path);
    }
    return std::make_unique<OfficeDocument>(document, services_, known.Tables);
  });
}

void UnoClient::Disconnect() noexcept {
  services_ = {};
  desktop_.clear();
}

}  // namespace

extern "C" __attribute__((visibility("default"))) OfficeClient* NewOfficeClient() {
  return new UnoClient;
}
