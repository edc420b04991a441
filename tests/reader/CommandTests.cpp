#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <iterator>
#include <nlohmann/json.hpp>

#include "tests/support/Cases.h"
#include "tests/support/Process.h"

namespace tavro {
namespace {

namespace fs = std::filesystem;
using Words = std::vector<std::string>;

const fs::path kBundle = fs::path(TAVRO_BUILD) / "AXTavro.axbundle";

/// A failed command says one sentence on standard error and nothing else.
void expectSentence(const Finished& finished, const std::string& part) {
  EXPECT_EQ(finished.code, 2);
  EXPECT_EQ(finished.output, "");
  EXPECT_EQ(finished.error.rfind("narrel: ", 0), 0U) << finished.error;
  EXPECT_EQ(std::ranges::count(finished.error, '\n'), 1) << finished.error;
  EXPECT_EQ(finished.error.find("narrel: ", 1), std::string::npos) << finished.error;
  EXPECT_NE(finished.error.find(part), std::string::npos) << finished.error;
}

TEST(Narrel, RefusesWrongArgumentsWithOneSentence) {
  for (const auto& [request, sentence] : casesOf<2>("refusals.txt")) {
    SCOPED_TRACE(request);
    std::istringstream words(request);
    Words arguments{std::istream_iterator<std::string>(words), {}};
    std::ranges::replace(arguments, "''", "");
    expectSentence(runNarrel(arguments), sentence);
  }
}

TEST(Narrel, RefusesABrokenDiaryWithOneSentence) {
  const TemporaryFolder folder;
  const std::pair<const char*, const char*> cases[] = {
      {"", "it is empty"}, {R"({"person": )", "line 1"}, {"[1, 2]", "object"}};
  for (const auto& [content, part] : cases) {
    const std::string path = folder.file("diary.json", content);
    expectSentence(runNarrel({"tour", "--diary", path}), path);
    expectSentence(runNarrel({"tour", "--diary", path}), part);
  }
}

TEST(Narrel, RefusesABrokenBundleWithOneSentence) {
  const TemporaryFolder folder;
  const fs::path bundle = fs::path(folder.path()) / "Broken.axbundle";
  const std::pair<const char*, std::function<void()>> cases[] = {
      {"no string table \"Accessibility\"",
       [&] {
         for (const auto& entry : fs::directory_iterator(bundle)) {
           if (entry.path().extension() == ".lproj") {
             fs::remove_all(entry.path());
           }
         }
       }},
      {"Accessibility.strings:2",
       [&] {
         folder.write("Broken.axbundle/en.lproj/Accessibility.strings",
                      "\"today\" = \"today\";\n\"no.data\" \"no data\";\n");
       }},
      {"Info.strings", [&] { fs::remove(bundle / "Info.strings"); }},
      {"cannot be opened", [&] { fs::remove(bundle / "AXTavro.so"); }},
      {"no such bundle", [&] { fs::remove_all(bundle); }},
  };
  for (const auto& [sentence, damage] : cases) {
    SCOPED_TRACE(sentence);
    fs::remove_all(bundle);
    fs::copy(kBundle, bundle, fs::copy_options::recursive);
    ASSERT_EQ(runNarrel({"read", "day", "--bundle", bundle}).code, 0) << "whole, it works";
    damage();
    expectSentence(runNarrel({"read", "day", "--bundle", bundle}), sentence);
    const Finished without = runNarrel({"read", "day", "--bundle", bundle, "--without-plugin"});
    EXPECT_EQ(without.code, 0) << "the application needs no bundle";
  }
}

TEST(Narrel, PrintsHelpWhenAskedForNothing) {
  const Finished alone = runNarrel({});
  EXPECT_EQ(alone.code, 0);
  EXPECT_EQ(alone.error, "");
  for (const char* command :
       {"tour", "read", "tree", "touch", "activate", "adjust", "live", "validate"}) {
    EXPECT_NE(alone.output.find(command), std::string::npos) << command;
    const Finished help = runNarrel({command, "--help"});
    EXPECT_EQ(help.code, 0) << command;
    EXPECT_NE(help.output.find("--locale"), std::string::npos) << command;
  }
}

TEST(Narrel, ReadsTouchesAndNamesContainers) {
  const Words fixed{"--now", "2026-03-11T15:20", "--timezone", "Europe/Lisbon"};
  const auto run = [&](Words words) {
    words.insert(words.end(), fixed.begin(), fixed.end());
    const Finished finished = runNarrel(words);
    EXPECT_EQ(finished.code, 0) << finished.error;
    return finished.output;
  };
  EXPECT_EQ(run({"read", "day", "--headings"}),
            "Wednesday, March 11, heading\n"
            "Move, 609/500KCAL, heading\n"
            "Exercise, 46/30MIN, heading\n"
            "Stand, 8/12HRS, heading\n");
  EXPECT_EQ(run({"touch", "day", "--at", "200,350"}), "12\u2009–\u20093\u202FPM, 91 calories\n");
  EXPECT_EQ(run({"touch", "day", "--at", "200,20.5"}), "Wednesday, March 11, heading\n");
  const std::string entered = run({"read", "day", "--verbosity", "containers"});
  EXPECT_NE(entered.find("heading\nchart\n12\u2009–\u20093\u202FAM, 3.6 calories, 1 of 8\n"),
            std::string::npos)
      << entered;
  EXPECT_EQ(run({"tour", "--verbosity", "containers"}).find("[day]\n" + entered), 0U);
}

TEST(Narrel, ValidatesTheHostContract) {
  const Finished clean = runNarrel({"validate"});
  EXPECT_EQ(clean.code, 0);
  EXPECT_NE(clean.output.find(" 0 failed"), std::string::npos);
  const auto report = nlohmann::json::parse(runNarrel({"validate", "--json"}).output);
  EXPECT_EQ(report["target"], "AX Tavro");
  ASSERT_FALSE(report["checks"].empty());
  EXPECT_TRUE(std::ranges::all_of(report["checks"],
                                  [](const auto& check) { return check["passed"] == true; }));
}

TEST(Narrel, ACategoryThatFailsStopsNoOther) {
  const TemporaryFolder folder;
  const fs::path bundle = fs::path(folder.path()) / "Demanding.axbundle";
  fs::copy(kBundle, bundle, fs::copy_options::recursive);
  fs::copy_file(fs::path(TAVRO_BUILD) / "lib/DemandingPlugin.so", bundle / "DemandingPlugin.so");
  folder.write("Demanding.axbundle/Info.strings",
               "\"executable\" = \"DemandingPlugin.so\";\n"
               "\"principal.class\" = \"DemandingPlugin\";\n");
  const Finished failed = runNarrel({"validate", "--bundle", bundle});
  EXPECT_EQ(failed.code, 1);
  EXPECT_EQ(failed.error, "");
  // What failed, and in whom; the others are installed.
  const std::pair<const char*, const char*> rows[] = {
      {"(process)", "NoClassOfTheApplication"},
      {"DemandingRaisingChecks", "FAILED: it raises"},
      {"DemandingRaisingChecks", "-accessibilityHint   intercepts"},
      {"DemandingRaisingTarget", "not installed: asking for its target class raises"},
      {"DemandingUnregistered", "not loaded: the class \"NoSuchSuperclass\" is not loaded"},
      {"DemandingMissingTarget", "not installed: the target class is not loaded"},
      {"DemandingWrongType", "FAILED: the host's method has the signature @, the category's q"},
      {"DemandingSound", "-accessibilityValue  intercepts"},
  };
  for (const auto& [category, outcome] : rows) {
    bool isSaid = false;
    std::istringstream lines(failed.output);
    for (std::string line; std::getline(lines, line);) {
      isSaid = isSaid || (line.starts_with(category) && line.find(outcome) != std::string::npos);
    }
    EXPECT_TRUE(isSaid) << category << " " << outcome << "\n" << failed.output;
  }
  const Finished heard = runNarrel({"read", "day", "--bundle", bundle});
  EXPECT_NE(heard.output.find(", sound"), std::string::npos) << "what is installed speaks";
}

TEST(Narrel, TheTreeHoldsEveryFact) {
  const auto tree = nlohmann::json::parse(runNarrel({"tree", "day", "--json"}).output);
  EXPECT_EQ(tree["screen"], "day");
  ASSERT_GT(tree["elements"].size(), 10U);
  for (const auto& element : tree["elements"]) {
    Words members;
    for (const auto& [name, value] : element.items()) {
      members.push_back(name);
    }
    std::ranges::sort(members);
    EXPECT_EQ(members, (Words{"activationPoint", "class", "containers", "frame", "hint", "label",
                              "traits", "utterance", "value"}));
  }
  const auto& slice = tree["elements"][3];
  EXPECT_EQ(slice["label"], "12\u2009–\u20093\u202FAM");
  EXPECT_EQ(slice["value"], "3.6 calories");
  EXPECT_EQ(slice["hint"], nullptr);
  EXPECT_EQ(slice["frame"], nlohmann::json({16, 312, 44, 112}));
  EXPECT_EQ(slice["activationPoint"], nlohmann::json({38, 368}));
  EXPECT_EQ(slice["containers"].back(), "TavroApp.ActivityMoveAndExerciseChartView");
  EXPECT_EQ(tree["elements"][0]["traits"], nlohmann::json({"header"}));
}

}  // namespace
}  // namespace tavro
