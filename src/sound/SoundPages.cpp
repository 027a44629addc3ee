#include "sound/SoundPages.h"

#include "core/text/NumberForms.h"

std::int32_t SoundChip::PagesOf(std::int64_t size) {
  return RoundToInt32(static_cast<long double>(size) / PageBytes);
}
