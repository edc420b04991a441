#include <gtest/gtest.h>

#include "platform/foundation/NSBundle.h"
#include "reader/Output.h"
#include "reader/Session.h"

namespace tavro {
namespace {

SessionOptions optionsWith(const std::string& activity) {
  SessionOptions options;
  options.diary = TAVRO_SAMPLE_DIARY;
  options.bundle = std::string(TAVRO_BUILD) + "/AXTavro.axbundle";
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  options.activity = activity;
  return options;
}

TEST(Activity, IsReadAsTheLatestWorkout) {
  Session session(optionsWith(TAVRO_SOURCE "/tests/data/loop.gpx"));
  const std::string heard = transcript(session.read("workout"));
  // The file says UTC; the person of the diary lives in New York.
  EXPECT_NE(heard.find("2:00\u2009–\u20092:02\u202fAM, 90 beats per minute\n"
                       "2:02\u2009–\u20092:05\u202fAM\n"),
            std::string::npos)
      << heard;
  EXPECT_NE(heard.find("\nLake loop, button, Shows the route on a larger map\n"), std::string::npos)
      << heard;
}

TEST(Activity, ABrokenFileIsAnError) {
  EXPECT_THROW(Session session(optionsWith(TAVRO_SAMPLE_DIARY)), FileError);
}

}  // namespace
}  // namespace tavro
