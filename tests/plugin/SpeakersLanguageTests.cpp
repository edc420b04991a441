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
  constexpr std::pair<const char*, const char*> kChoices[] = {
      {"en_US", "en"},
      {"en_CA", "en"},
      {"en_AU", "en-GB"},
      {"en_IN", "en-GB"},
      {"en_GB", "en-GB"},
      {"es_ES", "es"},
      {"es_MX", "es-419"},
      {"es_US", "es-419"},
      {"es_GQ", "es"},
      {"fr_BE", "fr"},
      {"fr_CA", "fr-CA"},
      {"pt", "pt-BR"},
      {"pt_AO", "pt-PT"},
      {"pt_CV", "pt-PT"},
      {"zh_CN", "zh-Hans"},
      {"zh_SG", "zh-Hans"},
      {"zh_TW", "zh-Hant"},
      {"zh_HK", "zh-Hant"},
      {"yue_HK", "zh-Hant"},
      {"no_NO", "nb"},
      {"nb_NO", "nb"},
      {"nn_NO", "nb"},
      {"iw_IL", "he"},
      {"in_ID", "id"},
      {"fa_AF", "fa"},
      {"ar_MA", "ar"},
      {"ro_MD", "ro"},
      {"bs_BA", "hr"},
      {"ca_ES", "ca"},
      {"gl_ES", "es"},
      {"af_ZA", "nl"},
      {"de_CH", "de"},
      {"be_BY", "ru"},
      {"kk_KZ", "ru"},
      {"sr_RS", "en"},
      {"sr_Latn", "en"},
      {"sl_SI", "en"},
      {"bn_BD", "en"},
      {"th_TH@calendar=buddhist", "th"},
      {"ar_EG@numbers=latn", "ar"},
  };
  for (const auto& [locale, language] : kChoices) {
    settings_.locale = locale;
    EXPECT_EQ(bundle("plugin")->languageForTable("Accessibility"), language) << locale;
    EXPECT_EQ(bundle("reader")->languageForTable("Reader"), language) << locale;
  }
}

// Integers stand in plain digits, which every voice reads; what ICU writes has the user's digits.
TEST_F(SpeakersLanguage, CountsAndMeasuresInItsOwnWay) {
  struct Spoken {
    const char* locale;
    std::int64_t minutes;
    const char* counted;
    float calories;
    const char* measured;
  };
  constexpr Spoken kSpoken[] = {
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
  for (const Spoken& spoken : kSpoken) {
    settings_.locale = spoken.locale;
    EXPECT_EQ(utf8(stringWithFormat(format("minutes.format"), {spoken.minutes})), spoken.counted)
        << spoken.locale;
    const Ref<NSString> amount = AXFormatFloat(0, spoken.calories);
    EXPECT_EQ(utf8(stringWithFormat(format("calories.format"), {id(amount)})), spoken.measured)
        << spoken.locale;
  }
}

}  // namespace
}  // namespace tavro
