#include <tuple>
#include <utility>
#include <vector>

#include "platform/accessibility/Speech.h"
#include "platform/foundation/NSBundle.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using ::tavro::testing::FoundationTest;

/// The tables of the project as a user's locale meets them.
class SpeakersLanguage : public FoundationTest {
 protected:
  static Ref<NSBundle> bundle(const std::string& room) {
    return NSBundle::bundleWithPath(std::string(TAVRO_SOURCE) + "/" + room + "/resources");
  }
  static Ref<NSString> format(const char* key) {
    return bundle("plugin")->localizedStringForKey(string(key), nullptr, "Accessibility");
  }
};

TEST_F(SpeakersLanguage, IsTheNearestThatExists) {
  // A language, and the locales that hear it.
  const std::pair<const char*, std::vector<const char*>> choices[] = {
      {"en", {"en_US", "en_CA", "sr_RS", "sr_Latn", "sl_SI", "bn_BD"}},
      {"en-GB", {"en_GB", "en_AU", "en_IN"}},
      {"es", {"es_ES", "es_GQ", "gl_ES"}},
      {"es-419", {"es_MX", "es_US"}},
      {"fr", {"fr_BE"}},
      {"fr-CA", {"fr_CA"}},
      {"pt-BR", {"pt"}},
      {"pt-PT", {"pt_AO", "pt_CV"}},
      {"zh-Hans", {"zh_CN", "zh_SG"}},
      {"zh-Hant", {"zh_TW", "zh_HK", "yue_HK"}},
      {"nb", {"no_NO", "nb_NO", "nn_NO"}},
      {"he", {"iw_IL"}},
      {"id", {"in_ID"}},
      {"hr", {"bs_BA"}},
      {"nl", {"af_ZA"}},
      {"ru", {"be_BY", "kk_KZ"}},
      {"ar", {"ar_MA", "ar_EG@numbers=latn"}},
      {"th", {"th_TH@calendar=buddhist"}},
  };
  for (const auto& [language, locales] : choices) {
    for (const char* const locale : locales) {
      settings_.locale = locale;
      EXPECT_EQ(bundle("plugin")->languageForTable("Accessibility"), language) << locale;
      EXPECT_EQ(bundle("reader")->languageForTable("Reader"), language) << locale;
    }
  }
}

// Integers stand in plain digits, which every voice reads; what ICU writes has the user's digits.
TEST_F(SpeakersLanguage, CountsAndMeasuresInItsOwnWay) {
  const std::tuple<const char*, std::int64_t, const char*, float, const char*> cases[] = {
      {"en_US", 1, "1 minute", 3.6, "3.6 calories"},
      {"de_DE", 40, "40 Minuten", 3.6, "3,6 Kalorien"},
      {"fr_FR", 0, "0 minute", 1234.5, "1\u202F234,5 calories"},
      {"fr_FR", 1000000, "1000000 de minutes", 2, "2 calories"},
      {"ro_RO", 20, "20 de minute", 20, "Calorii: 20"},
      {"pl_PL", 22, "22 minuty", 22, "Kalorie: 22"},
      {"pl_PL", 25, "25 minut", 0.5, "Kalorie: 0,5"},
      {"ru_RU", 21, "21 минута", 21, "Калории: 21"},
      {"pt_BR", 0, "0 minuto", 1, "1 calorias"},
      {"pt_PT", 0, "0 minutos", 0, "0 calorias"},
      {"he_IL", 1, "דקה אחת", 3.6, "3.6 קלוריות"},
      {"he_IL", 2, "שתי דקות", 2, "2 קלוריות"},
      {"ar_EG", 2, "دقيقتان", 3.6, "السعرات: ٣٫٦\u200F"},
      {"ar_EG", 40, "40 دقيقة", 40, "السعرات: ٤٠\u200F"},
      {"ar_MA", 5, "5 دقائق", 3.6, "السعرات: 3,6\u200F"},
      {"fa_IR", 40, "40 دقیقه", 3.6, "۳٫۶ کالری"},
      {"hi_IN", 40, "40 मिनट", 123456, "1,23,456 कैलोरी"},
      {"ja_JP", 40, "40分", 3.6, "3.6キロカロリー"},
  };
  for (const auto& [locale, minutes, counted, calories, measured] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(utf8(stringWithFormat(format("minutes.format"), {minutes})), counted) << locale;
    const id amount = AXFormatFloat(0, calories);
    EXPECT_EQ(utf8(stringWithFormat(format("calories.format"), {amount})), measured) << locale;
  }
}

}  // namespace
}  // namespace tavro
