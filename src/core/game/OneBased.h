#pragma once

#include <array>
#include <cstddef>

#include "platform/RuntimeError.h"

/// A fixed-size table indexed from 1 to `Size`. Any other index throws RuntimeError 9.
template <typename Element, int Size>
class OneBased {
 public:
  constexpr OneBased() = default;
  constexpr explicit OneBased(const std::array<Element, Size>& elements) : elements_(elements) {}

  constexpr Element& operator()(int index) { return elements_[Checked(index)]; }
  constexpr const Element& operator()(int index) const { return elements_[Checked(index)]; }

  static constexpr int Count() { return Size; }
  static constexpr bool Holds(int index) { return index >= 1 && index <= Size; }

  constexpr auto begin() { return elements_.begin(); }
  constexpr auto end() { return elements_.end(); }
  constexpr auto begin() const { return elements_.begin(); }
  constexpr auto end() const { return elements_.end(); }

 private:
  static constexpr std::size_t Checked(int index) {
    if (!Holds(index)) {
      throw RuntimeError(Fault::SubscriptOutOfRange);
    }
    return static_cast<std::size_t>(index - 1);
  }

  std::array<Element, Size> elements_{};
};
