#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <cstdlib>
#include <fstream>
#include <sstream>

#include "reader/Output.h"
#include "reader/Session.h"

namespace tavro {
namespace {

/// A tour of the sample application as a golden file holds it.
struct Golden {
  const char* file;
  const char* locale;
  bool withPlugin;
};

constexpr Golden kGoldens[] = {
    {"tour.en_US", "en_US", true}, {"tour.en_US.without-plugin", "en_US", false},
    {"tour.de_DE", "de_DE", true}, {"tour.ar_EG", "ar_EG", true},
    {"tour.he_IL", "he_IL", true}, {"tour.ja_JP", "ja_JP", true},
    {"tour.ru_RU", "ru_RU", true}, {"tour.pl_PL", "pl_PL", true},
    {"tour.hi_IN", "hi_IN", true}, {"tour.zh_Hans_CN", "zh_Hans_CN", true},
};

// How a case is called in lists of tests.
void PrintTo(const Golden& golden, std::ostream* stream) { *stream << golden.file; }

std::string pathOf(const Golden& golden) {
  return std::string(TAVRO_SOURCE) + "/tests/golden/" + golden.file + ".txt";
}

std::string tourOf(const Golden& golden) {
  SessionOptions options;
  options.locale = golden.locale;
  options.withPlugin = golden.withPlugin;
  options.diary = TAVRO_SAMPLE_DIARY;
  options.bundle = std::string(TAVRO_BUILD) + "/AXTavro.axbundle";
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  Session session(options);
  return tour(session);
}

class GoldenTour : public testing::TestWithParam<Golden> {};

// Run with TAVRO_WRITE_GOLDEN set, a case writes its file instead of comparing with it.
TEST_P(GoldenTour, SoundsAsItDid) {
  // A tour of its own process: the plug-in stays loaded once it is.
  const std::string path = pathOf(GetParam());
  if (std::getenv("TAVRO_WRITE_GOLDEN") != nullptr) {
    std::ofstream(path) << tourOf(GetParam());
    return;
  }
  std::ifstream file(path);
  ASSERT_TRUE(file) << path << " is missing; ./dev golden writes it";
  std::stringstream expected;
  expected << file.rdbuf();
  EXPECT_EQ(tourOf(GetParam()), expected.str());
}

INSTANTIATE_TEST_SUITE_P(Tours, GoldenTour, testing::ValuesIn(kGoldens), [](const auto& info) {
  std::string name = info.param.file;
  std::replace_if(
      name.begin(), name.end(), [](char c) { return std::isalnum(c) == 0; }, '_');
  return name;
});

}  // namespace
}  // namespace tavro
