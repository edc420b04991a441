// The diary: either it opens, and a screen that shows it speaks valid text, or it is refused with
// one sentence. An input that begins with "{" is the file itself; of any other, each four bytes are
// an edit of a small diary: a place in it and what to write there.

#include <nlohmann/json.hpp>
#include <stdexcept>

#include "platform/accessibility/BundleLoader.h"
#include "reader/Session.h"
#include "reader/SummaryDescription.h"
#include "tests/fuzz/Fuzz.h"
#include "tests/support/Process.h"

namespace tavro::fuzz {
namespace {

using Json = nlohmann::json;
using Pointer = Json::json_pointer;

/// The last two entries of each list of the sample, so that an edit is cheap.
Json smallDiary() {
  Json diary = Json::parse(contentOf(std::string(TAVRO_SOURCE) + "/host/data/diary.json"));
  for (auto& [key, list] : diary.items()) {
    while (list.is_array() && list.size() > 2) {
      list.erase(list.begin());
    }
  }
  return diary;
}

void collect(const Json& value, const Pointer& place, std::vector<Pointer>& into) {
  into.push_back(place);
  if (value.is_structured()) {
    for (const auto& [key, child] : value.items()) {
      collect(child, value.is_array() ? place / std::stoul(key) : place / key, into);
    }
  }
}

/// What an edit writes; the last of all takes the place away.
const std::vector<Json>& values() {
  static const std::vector<Json> values{nullptr,
                                        true,
                                        false,
                                        0,
                                        1,
                                        2,
                                        8,
                                        -1,
                                        0.5,
                                        24,
                                        100,
                                        86400,
                                        1e15,
                                        1e300,
                                        INT64_MAX,
                                        UINT64_MAX,
                                        "",
                                        "yes",
                                        "--",
                                        "8'05''",
                                        "\u202e\u0301",
                                        "a\nb",
                                        std::string(300, 'x'),
                                        "%d%@%%",
                                        "{name}",
                                        "2026-03-11",
                                        "2026-03-10",
                                        "9999-12-31",
                                        "0000-01-01",
                                        "2026-02-30",
                                        "2026-03-11T15:20",
                                        "2026-03-29T02:30",
                                        "1970-01-01T00:00Z",
                                        "Europe/London",
                                        "Pacific/Kiritimati",
                                        "No/Where",
                                        Json::array(),
                                        Json::object(),
                                        Json::array({1, 2}),
                                        Json::array({Json::array({0, 0}), Json::array({1, 255})})};
  return values;
}

void edit(Json& diary, const Pointer& place, std::size_t choice) {
  const std::vector<Json>& all = values();
  if (!diary.contains(place)) {
    return;  // an earlier edit took it away
  }
  if (choice < all.size()) {
    diary[place] = all[choice];
  } else if (!place.empty() && diary[place.parent_pointer()].is_object()) {
    diary[place.parent_pointer()].erase(place.back());
  } else if (!place.empty()) {
    diary[place.parent_pointer()].push_back(Json(diary[place]));  // twice
  }
}

std::string fileOf(std::string_view input) {
  if (input.starts_with('{')) {
    return std::string(input);
  }
  static const Json whole = smallDiary();
  static const std::vector<Pointer> places = [] {
    std::vector<Pointer> found;
    collect(whole, Pointer(), found);
    return found;
  }();
  Json diary = whole;
  Bytes bytes(input);
  while (!bytes.empty()) {
    const std::size_t place = bytes.next() * 256 + bytes.next();
    edit(diary, places[place % places.size()], bytes.below(values().size() + 1));
    bytes.next();
  }
  return diary.dump();
}

SessionOptions optionsFor(const std::string& path) {
  SessionOptions options;
  options.diary = path;
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  options.withPlugin = false;  // it is loaded once, before the first
  return options;
}

void readOneScreen(const std::string& path, std::size_t choice) {
  Session session(optionsFor(path));
  const auto screens = Application::screenNames();
  for (const HeardElement& element : session.read(screens[choice % screens.size()])) {
    require(string(element.utterance)->utf8() == element.utterance, "what is said is valid text",
            element.utterance);
  }
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  static const TemporaryFolder temporary;
  static const bool isLoaded = [] {
    letSummariesDescribeRings(
        loadAccessibilityBundle(std::string(TAVRO_BUILD) + "/AXTavro.axbundle"));
    return true;
  }();
  static_cast<void>(isLoaded);
  const std::string path = temporary.path() + "/diary.json";
  const std::string_view input = fuzz::textOf(data, size);
  fuzz::write(path, fuzz::fileOf(input));
  try {
    fuzz::readOneScreen(path, size + (input.empty() ? 0 : data[size - 1]));
  } catch (const FileError& error) {
    fuzz::requireOneSentence(error.what(), path + ":");
  } catch (const std::invalid_argument& error) {
    fuzz::requireOneSentence(error.what(), "\"");  // a time zone that there is not
  }
  return 0;
}
