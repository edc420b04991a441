#include <gtest/gtest.h>

#include <algorithm>
#include <nlohmann/json.hpp>

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
  struct Case {
    Words arguments;
    const char* sentence;
  };
  const Case cases[] = {
      {{"sing"}, "there is no command \"sing\"; narrel --help"},
      {{"--loud"}, "there is no option \"--loud\"; narrel --help"},
      {{"tour", "--loud"}, "there is no option \"--loud\"; narrel tour --help"},
      {{"--locale", "de_DE", "tour"}, "\"--locale\" must come after the command"},
      {{"tour", "day"}, "\"day\" is one argument too many"},
      {{"tree", "day", "--json=perhaps"}, "--json takes no value"},
      {{"read"}, "SCREEN is missing; narrel read --help"},
      {{"read", "moon"}, "there is no screen \"moon\"; the screens are: day"},
      {{"live", "moon"}, "there is no screen \"moon\""},
      {{"read", "day", "--locale"}, "--locale needs a value"},
      {{"read", "day", "--locale", "xx_YY"}, "\"xx_YY\" is not a locale"},
      {{"live", "--locales", "en_US,xx_YY"}, "\"xx_YY\" is not a locale"},
      {{"read", "day", "--timezone", "Mars"}, "\"Mars\" is not a time zone"},
      {{"read", "day", "--now", "tomorrow"}, "\"tomorrow\" is not a moment"},
      {{"read", "day", "--now", "2026-02-30T08:15"}, "\"2026-02-30T08:15\" is not a moment"},
      {{"read", "day", "--calendar", "stars"}, "\"stars\" is not a calendar"},
      {{"read", "day", "--wheelchair", "maybe"}, "\"maybe\" is not a wheelchair setting"},
      {{"read", "day", "--verbosity", "loud"}, "\"loud\" is not a verbosity"},
      {{"read", "day", "--diary", "/nowhere"}, "/nowhere: there is no such file"},
      {{"read", "day", "--bundle", "/nowhere"}, "/nowhere: there is no such bundle"},
      {{"touch", "day"}, "--at is missing"},
      {{"touch", "day", "--at", "12"}, "\"12\" is not a point"},
      {{"touch", "day", "--at", "12,3x"}, "\"12,3x\" is not a point"},
      {{"touch", "day", "--at", "nan,1"}, "\"nan,1\" is not a point"},
      {{"touch", "day", "--at", "5,5000"}, "nothing can be heard at 5,5000 on \"day\""},
      {{"activate", "day"}, "LABEL is missing"},
      {{"activate", "day", ""}, "no element of \"day\" begins with \"\""},
      {{"activate", "day", "Swim"}, "no element of \"day\" begins with \"Swim\""},
      {{"activate", "day", "TOTAL"}, "does nothing when it is activated"},
      {{"adjust", "day", "Move"}, "needs either --up or --down"},
      {{"adjust", "day", "Move", "--up", "--down"}, "needs either --up or --down"},
      {{"adjust", "day", "Move", "--up", "--times", "0"}, "\"0\" is not a number of times"},
      {{"adjust", "day", "Move", "--up"}, "\"Move, 609/500KCAL, heading\" cannot be adjusted"},
  };
  for (const Case& each : cases) {
    SCOPED_TRACE(testing::PrintToString(each.arguments));
    expectSentence(runNarrel(each.arguments), each.sentence);
  }
}

TEST(Narrel, RefusesABrokenDiaryWithOneSentence) {
  auto diary = nlohmann::json::parse(contentOf(TAVRO_SAMPLE_DIARY));
  const TemporaryFolder folder;
  const std::string path = folder.path / "diary.json";
  const auto expectRefusal = [&](const std::string& content, const std::string& part) {
    SCOPED_TRACE(part);
    std::ofstream(path) << content;
    const Finished finished = runNarrel({"tour", "--diary", path});
    expectSentence(finished, part);
    EXPECT_NE(finished.error.find(path), std::string::npos) << finished.error;
  };
  expectRefusal("", "it is empty");
  expectRefusal(R"({"person": )", "line 1");
  expectRefusal("[1, 2]", "object");
  auto wrong = diary;
  wrong["days"][0]["move"] = "much";
  expectRefusal(wrong.dump(), "days[0].move");
  diary.erase("person");
  expectRefusal(diary.dump(), "person");
}

TEST(Narrel, RefusesABrokenBundleWithOneSentence) {
  const TemporaryFolder folder;
  const fs::path bundle = folder.path / "Broken.axbundle";
  const fs::path table = bundle / "en.lproj" / "Accessibility.strings";
  struct Case {
    const char* sentence;
    void (*damage)(const fs::path& bundle, const fs::path& table);
  };
  const Case cases[] = {
      {"no string table \"Accessibility\"",
       [](const fs::path& bundle, const fs::path& /*table*/) {
         for (const auto& entry : fs::directory_iterator(bundle)) {
           if (entry.path().extension() == ".lproj") {
             fs::remove_all(entry.path());
           }
         }
       }},
      {"Accessibility.strings:2",
       [](const fs::path& /*bundle*/, const fs::path& table) {
         std::ofstream(table) << "\"today\" = \"today\";\n\"no.data\" \"no data\";\n";
       }},
      {"Info.strings", [](const fs::path& bundle,
                          const fs::path& /*table*/) { fs::remove(bundle / "Info.strings"); }},
      {"cannot be opened", [](const fs::path& bundle,
                              const fs::path& /*table*/) { fs::remove(bundle / "AXTavro.so"); }},
      {"no such bundle",
       [](const fs::path& bundle, const fs::path& /*table*/) { fs::remove_all(bundle); }},
  };
  for (const Case& each : cases) {
    SCOPED_TRACE(each.sentence);
    fs::remove_all(bundle);
    fs::copy(kBundle, bundle, fs::copy_options::recursive);
    ASSERT_EQ(runNarrel({"read", "day", "--bundle", bundle}).code, 0) << "whole, it works";
    each.damage(bundle, table);
    expectSentence(runNarrel({"read", "day", "--bundle", bundle}), each.sentence);
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
  // Without the plug-in what is drawn is silent.
  EXPECT_EQ(run({"read", "day", "--without-plugin"}).find("calories"), std::string::npos);
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
  const fs::path bundle = folder.path / "Demanding.axbundle";
  fs::copy(kBundle, bundle, fs::copy_options::recursive);
  fs::copy_file(fs::path(TAVRO_BUILD) / "lib/DemandingPlugin.so", bundle / "DemandingPlugin.so");
  std::ofstream(bundle / "Info.strings") << "\"executable\" = \"DemandingPlugin.so\";\n"
                                            "\"principal.class\" = \"DemandingPlugin\";\n";
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
