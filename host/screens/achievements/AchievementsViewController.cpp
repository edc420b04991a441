#include "host/screens/achievements/AchievementsViewController.h"

#include <algorithm>

#include "host/Application.h"
#include "host/Dates.h"
#include "host/screens/achievements/AchievementViews.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

const Registered controllerClass =
    defineClass<CHAchievementsViewController, UIViewController>()
        .method<&CHAchievementsViewController::viewDidLoad>("viewDidLoad");

constexpr double kScreenWidth = 390;
constexpr std::size_t kColumns = 3;
constexpr double kCellWidth = kScreenWidth / kColumns;
constexpr double kCellHeight = 150;

CGRect frameOfCell(std::size_t index) {
  const std::size_t column = index % kColumns;
  const std::size_t row = index / kColumns;
  return {static_cast<double>(column) * kCellWidth, static_cast<double>(row) * kCellHeight,
          kCellWidth, kCellHeight};
}

void appendHeader(UITableView& list, std::string_view title) {
  const auto header = makeView<CHAchievementsSectionHeaderView>();
  header->setTitle(title);
  list.appendRow(header, CHAchievementsSectionHeaderView::height);
}

/// The achievements that were earned last, latest first; as many as fit beside each other.
std::vector<Achievement> recentAchievements(std::vector<Achievement> achievements) {
  std::erase_if(achievements, [](const Achievement& each) { return !each.earned; });
  std::ranges::stable_sort(achievements, std::ranges::greater(), &Achievement::earned);
  achievements.resize(std::min(achievements.size(), kColumns));
  return achievements;
}

std::vector<std::string_view> sectionsOf(const std::vector<Achievement>& achievements) {
  std::vector<std::string_view> sections;
  for (const Achievement& each : achievements) {
    if (std::ranges::find(sections, each.section) == sections.end()) {
      sections.emplace_back(each.section);
    }
  }
  return sections;
}

}  // namespace

void CHAchievementsViewController::viewDidLoad() {
  const auto list = makeView<UITableView>({0, 0, kScreenWidth, 800});
  setView(list);
  navigationItem()->title = string("Awards");
  provider_ = providerFor(diary_->person);
  appendRecent(*list);
  for (const std::string_view section : sectionsOf(diary_->achievements)) {
    appendSection(*list, section);
  }
}

void CHAchievementsViewController::appendRecent(UITableView& list) {
  const std::vector<Achievement> recent = recentAchievements(diary_->achievements);
  if (recent.empty()) {
    return;
  }
  appendHeader(list, "Recently Earned");
  const auto strip = makeView<UITableViewCell>();
  for (std::size_t index = 0; index < recent.size(); ++index) {
    const auto content = makeView<CHAchievementsCellContentView>(frameOfCell(index));
    const Ref<ACHAchievement> achievement = achievementOf(recent[index]);
    content->setAchievement(*achievement, titleOf(achievement));
    strip->addSubview(content);
  }
  list.appendRow(strip, kCellHeight);
}

void CHAchievementsViewController::appendSection(UITableView& list, std::string_view section) {
  appendHeader(list, section);
  const auto grid = makeView<UIView>();
  std::size_t count = 0;
  for (const Achievement& each : diary_->achievements) {
    if (each.section == section) {
      const auto cell = makeView<CHAchievementCollectionViewCell>(frameOfCell(count++));
      const Ref<ACHAchievement> achievement = achievementOf(each);
      cell->setAchievement(achievement, titleOf(achievement));
      grid->addSubview(cell);
    }
  }
  const std::size_t rows = (count + kColumns - 1) / kColumns;
  list.appendRow(grid, static_cast<double>(rows) * kCellHeight);
}

Ref<NSString> CHAchievementsViewController::titleOf(const Ref<ACHAchievement>& achievement) const {
  return as<NSString>(send<id>(provider_, "titleForAchievement:", achievement));
}

Ref<ACHAchievement> achievementOf(const Achievement& entry) {
  auto achievement = make<ACHAchievement>();
  achievement->title = entry.title;
  achievement->wheelchairTitle = entry.wheelchairTitle.value_or("");
  achievement->progress = entry.progress;
  achievement->earnedDate = entry.earned ? noonOf(*entry.earned) : nullptr;
  return achievement;
}

Ref<AAUIAchievementLocalizationProvider> providerFor(const Person& person) {
  auto provider = make<AAUIAchievementLocalizationProvider>();
  provider->setName(string(person.firstName));
  provider->setWheelchairUser(Settings::current().wheelchairUse ==
                              static_cast<std::int64_t>(HKWheelchairUse::yes));
  return provider;
}

Ref<UIViewController> makeAchievements(const Application& application) {
  const auto controller = makeController<CHAchievementsViewController>();
  controller->setDiary(&application.diary());
  return controller;
}

}  // namespace tavro
