#include <cstdio>
#include <exception>

#include "host/Application.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"

// Opens every screen of a diary and counts its views: the application on its own.
int main(int argumentCount, char** arguments) {
  using namespace tavro;
  if (argumentCount != 2) {
    std::fprintf(stderr, "usage: tavro-host DIARY\n");
    return 2;
  }
  try {
    Diary diary = Diary::read(arguments[1]);
    Settings::current().timeZone = diary.timeZone;
    Settings::current().now = secondsFromIso(diary.now.iso).value();
    Application application(std::move(diary));
    for (const std::string_view name : Application::screenNames()) {
      application.showScreen(name);
      std::size_t views = 0;
      application.window().findSubviewDescendants([&](const id&) { return ++views != 0; });
      std::printf("%.*s: %zu views\n", static_cast<int>(name.size()), name.data(), views);
    }
    return 0;
  } catch (const std::exception& error) {
    std::fprintf(stderr, "tavro-host: %s\n", error.what());
    return 2;
  }
}
