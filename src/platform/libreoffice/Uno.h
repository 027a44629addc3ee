#pragma once

#include <com/sun/star/beans/PropertyValue.hpp>
#include <com/sun/star/uno/Exception.hpp>
#include <com/sun/star/uno/Reference.hxx>
#include <initializer_list>
#include <osl/file.hxx>
#include <rtl/string.hxx>
#include <rtl/ustring.hxx>
#include <string>
#include <utility>

#include "platform/RuntimeError.h"

/// Conversions shared by the module: LibreOffice's texts, URLs and exceptions in the program's terms.
namespace Uno {

using com::sun::star::beans::PropertyValue;
using com::sun::star::uno::Any;
using com::sun::star::uno::Reference;
using com::sun::star::uno::Sequence;
using rtl::OUString;

inline OUString ToOffice(const std::string& text) {
  return OUString::fromUtf8(rtl::OString(text.data(), static_cast<sal_Int32>(text.size())));
}

inline std::string FromOffice(const OUString& text) {
  const rtl::OString bytes = text.toUtf8();
  return {bytes.getStr(), static_cast<std::size_t>(bytes.getLength())};
}

inline OUString UrlOf(const std::string& path) {
  OUString url;
  if (osl::FileBase::getFileURLFromSystemPath(ToOffice(path), url) != osl::FileBase::E_None) {
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
  return url;
}

/// Named arguments, as LibreOffice takes them.
inline Sequence<PropertyValue> Properties(std::initializer_list<std::pair<const char*, Any>> values) {
  Sequence<PropertyValue> properties(static_cast<sal_Int32>(values.size()));
  PropertyValue* next = properties.getArray();
  for (const auto& [name, value] : values) {
    next->Name = OUString::createFromAscii(name);
    next->Value = value;
    ++next;
  }
  return properties;
}

/// Runs `operation`; an exception from LibreOffice, or its death, becomes RuntimeError 440.
template <typename Operation>
auto Call(Operation&& operation) {
  try {
    return operation();
  } catch (const com::sun::star::uno::Exception& failure) {
    throw RuntimeError(Fault::AutomationError, "Automation error: " + FromOffice(failure.Message));
  }
}

}  // namespace Uno
