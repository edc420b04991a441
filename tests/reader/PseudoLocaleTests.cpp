#include <algorithm>
#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <sstream>

#include "platform/foundation/NSBundle.h"
#include "reader/Output.h"
#include "reader/Session.h"
#include "tests/platform/FoundationTesting.h"

// A language that nobody speaks: each text of the tables in brackets, longer, its arguments the
// other way round. In a tour that is read in it, Latin words outside of brackets are the host's, or
// were never looked up in a table. The locale is Egyptian Arabic, in which ICU writes nothing
// Latin.

namespace tavro {
namespace {

constexpr const char* kOpen = "⟦";
constexpr const char* kClose = "⟧";

std::string replaced(std::string text, std::string_view from, std::string_view to) {
  for (std::size_t at = text.find(from); at != std::string::npos;
       at = text.find(from, at + to.size())) {
    text.replace(at, from.size(), to);
  }
  return text;
}

std::string pseudo(const Ref<NSString>& english) {
  std::string text = english->utf8();
  text = replaced(text, "%1$", "%0$");
  text = replaced(text, "%2$", "%1$");
  text = replaced(text, "%0$", text.find("%1$") == std::string::npos ? "%1$" : "%2$");
  return kOpen + text + "~~~~" + kClose;
}

/// A copy of a folder of resources in which the pseudo-language is the only one, under the name of
/// English.
void copyAsPseudo(const std::string& original, const std::string& table,
                  const TemporaryFolder& folder) {
  namespace fs = std::filesystem;
  fs::copy(original, folder.path(),
           fs::copy_options::recursive | fs::copy_options::overwrite_existing);
  for (const auto& each : fs::directory_iterator(original)) {
    if (each.path().extension() == ".lproj") {
      fs::remove_all(fs::path(folder.path()) / each.path().filename());
    }
  }
  std::string entries;
  for (const auto& [key, text] : readStringTable(original + "/en.lproj", table)) {
    const std::string escaped = replaced(replaced(pseudo(text), "\"", "\\\""), "\n", "\\n");
    entries += "\"" + key + "\" = \"" + escaped + "\";\n";
  }
  folder.write("en.lproj/" + table + ".strings", entries);
}

std::string pseudoTour() {
  const TemporaryFolder bundle;
  const TemporaryFolder words;
  copyAsPseudo(std::string(TAVRO_BUILD) + "/AXTavro.axbundle", "Accessibility", bundle);
  copyAsPseudo(std::string(TAVRO_SOURCE) + "/reader/resources", "Reader", words);
  SessionOptions options;
  options.locale = "ar_EG";
  options.diary = TAVRO_SAMPLE_DIARY;
  options.bundle = bundle.path();
  options.reader = words.path();
  Session session(options);
  return tour(session);
}

using Words = std::set<std::string>;

Words wordsOf(const std::string& text) {
  static const std::regex word("[A-Za-z]+");
  Words words;
  for (std::sregex_iterator each(text.begin(), text.end(), word), end; each != end; ++each) {
    words.insert(each->str());
  }
  return words;
}

/// Whether a quoted text is a name of the code's own rather than something to show.
bool isName(const std::string& text) {
  static const std::regex name("[a-z_][A-Za-z0-9_:]*");
  return std::regex_match(text, name);
}

/// The words of the texts in quotation marks in a file; names, JSON's too, are left out.
Words quotedWords(const std::filesystem::path& path) {
  std::ifstream file(path);
  Words words;
  for (std::string line; std::getline(file, line);) {
    std::size_t open = 0;
    while ((open = line.find('"', open)) != std::string::npos) {
      const std::size_t close = line.find('"', open + 1);
      if (close == std::string::npos) {
        break;
      }
      const std::string text = line.substr(open + 1, close - open - 1);
      if (line.substr(close + 1, 1) != ":" && !isName(text)) {
        words.merge(wordsOf(text));
      }
      open = close + 1;
    }
  }
  return words;
}

// The units that the host writes beside its numbers; in its sources they look like names.
constexpr const char* kHostUnits[] = {"hr", "kcal", "kilocalories", "kilometers", "meters", "min"};

/// What the host can say of itself: the words in its screens' and libraries' sources and its diary.
Words hostWords() {
  Words words = quotedWords(TAVRO_SAMPLE_DIARY);
  words.insert(std::begin(kHostUnits), std::end(kHostUnits));
  for (const char* const room : {"/host/screens", "/host/libraries"}) {
    const std::string folder = std::string(TAVRO_SOURCE) + room;
    for (const auto& each : std::filesystem::recursive_directory_iterator(folder)) {
      if (each.is_regular_file()) {
        words.merge(quotedWords(each.path()));
      }
    }
  }
  return words;
}

/// The lines of a tour that hold a word which is neither in brackets nor the host's.
std::vector<std::string> notLocalized(const std::string& tour) {
  static const std::regex bracketed(std::string(kOpen) + "[^]*?" + kClose);
  const Words hosts = hostWords();
  std::vector<std::string> lines;
  std::istringstream text(tour);
  std::string screen;
  for (std::string line; std::getline(text, line);) {
    if (line.starts_with('[')) {
      screen = line;
      continue;
    }
    const std::string outside = std::regex_replace(line, bracketed, "");
    if (!std::ranges::includes(hosts, wordsOf(outside)) ||
        outside.find(kOpen) != std::string::npos || outside.find(kClose) != std::string::npos) {
      lines.push_back(screen + " " + line);
    }
  }
  return lines;
}

TEST(PseudoLanguage, ReachesEveryWordThatIsNotTheHosts) {
  EXPECT_EQ(notLocalized(pseudoTour()), std::vector<std::string>{});
}

}  // namespace
}  // namespace tavro
