// The bound of a whole program: formats a day's texts with ICU alone, in one locale. With
// TAVRO_DIARY it reads the diary before, as whoever shows a day must.

#include "bench/IcuTexts.h"
#ifdef TAVRO_DIARY
#include "host/Diary.h"
#endif

int main([[maybe_unused]] int count, [[maybe_unused]] char** arguments) {
  using namespace tavro::bench;
#ifdef TAVRO_DIARY
  const tavro::Diary diary = tavro::Diary::read(count > 1 ? arguments[1] : "");
#endif
  IcuTexts icu;
  icu.date(u"EEEEMMMMd", kMidnight);
  for (const float ring : {1.22F, 1.53F, 0.67F}) {
    icu.percent(ring);
  }
  formatSlices(icu);  // energy
  formatSlices(icu);  // minutes, which are counted
  for (int slice = 0; slice < kSlices; ++slice) {
    icu.plural(slice);
  }
  formatHours(icu);
  return 0;
}
