#include "core/data/FieldValue.h"

#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

std::string TextOf(const Value& value) {
  if (const auto* text = std::get_if<std::string>(&value)) {
    return *text;
  }
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    return std::to_string(*integer);
  }
  if (const auto* number = std::get_if<double>(&value)) {
    std::string text = Str(*number);
    return text.front() == ' ' ? text.substr(1) : text;
  }
  if (std::holds_alternative<Blob>(value)) {
    throw RuntimeError(Fault::TypeMismatch);
  }
  return {};
}

double NumberOf(const Value& value) {
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    return static_cast<double>(*integer);
  }
  if (const auto* number = std::get_if<double>(&value)) {
    return *number;
  }
  if (std::holds_alternative<std::monostate>(value)) {
    return 0;
  }
  return ToDouble(TextOf(value));
}
